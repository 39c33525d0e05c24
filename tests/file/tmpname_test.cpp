#include <gtest/gtest.h>
#include <sys/stat.h>
#include <unistd.h>

#include "duduzu/file.h"
#include "duduzu/session.h"
#include "duduzu/system.h"
#include "file/file_test_util.h"

namespace {
// Fixes the process number at 999 (or 1000) before anything reads it.
void Pid999() { SystemSetClock([]() -> long long { return 9980; }); }
}  // namespace

TEST(FileRandomName, ProcessFieldThenCounterField) {
  Pid999();
  EXPECT_EQ(Owned(FileRandomNameNoExtension()), "p00rr000");
  EXPECT_EQ(Owned(FileRandomNameNoExtension()), "p00rr001");
  for (int i = 3; i < 38; ++i) vzl_free(FileRandomNameNoExtension());
  EXPECT_EQ(Owned(FileRandomNameNoExtension()), "p00rr011");  // the 38th
  for (int i = 39; i < 46656; ++i) vzl_free(FileRandomNameNoExtension());
  EXPECT_EQ(Owned(FileRandomNameNoExtension()), "p00rrzzz");  // the 46656th
  EXPECT_EQ(Owned(FileRandomNameNoExtension()), "p00rr000");  // wrapped
  PortTest::AllocFailureGuard guard;
  PortTest::FailAllAllocs();
  EXPECT_EQ(FileRandomNameNoExtension(), nullptr);
  EXPECT_EQ(FileCreateNameInTmpWithExtension("v"), nullptr);
  FileRemoveAllFilesInTmp();
}

TEST(FileTmpNames, MadeInTheDirectoryOpenOnesClosedAndAllRemoved) {
  Pid999();
  TempDir dir;
  KERBTmpDir = dir.path.data();
  int fds = OpenFdCount();
  std::string v = Owned(FileCreateNameInTmpWithExtension("v"));
  std::string bare = Owned(FileCreateNameInTmpWithExtension(nullptr));
  std::string tmp = Owned(FileCreateRandomName());  // freed: still registered
  EXPECT_EQ(v + " " + bare + " " + tmp, dir / "p00rr000.v " + dir / "p00rr001 " + dir / "p00rr002.tmp");
  for (const std::string& name : {v, bare, dir / "kerb999.ren", dir / "kept"}) WriteFile(name, "x");
  fputs("pending", FOPEN(tmp.c_str(), "w"));  // still open at the clean-up
  FileRemoveAllFilesInTmp();
  EXPECT_EQ(Present({v, bare, tmp, dir / "kerb999.ren", dir / "kept"}), "00001");
  EXPECT_EQ(OpenFdCount(), fds);
  KERBTmpDir = nullptr;
  ASSERT_EQ(chdir(dir.path.c_str()), 0);  // no directory: the current one
  std::string name = Owned(FileCreateNameInTmpWithExtension("v"));
  EXPECT_EQ(name, "p00rr003.v");
  WriteFile(name, "x");
  WriteFile("kerb999.ren", "x");
  FileRemoveAllFilesInTmp();
  EXPECT_EQ(Present({dir / name, dir / "kerb999.ren"}), "00");
}

TEST(FileCleanOnExit, CopiesNamesToleratesDuplicatesAndStartsAgain) {
  TempDir dir;
  std::string name = dir / "twice", mine = dir / "mine";
  for (int round = 0; round < 2; ++round) {  // the list starts again after a clean-up
    WriteFile(name, "x");
    WriteFile(dir / "mine", "x");
    FileAddFileNameForCleanOnExit(name.data());
    FileAddFileNameForCleanOnExit(name.data());
    FileAddFileNameForCleanOnExit(mine.data());
    mine.back() = 'X';  // the caller's string is the caller's
    FileAddFileNameForCleanOnExit(nullptr);
    FileRemoveAllFilesInTmp();
    EXPECT_EQ(Present({name, dir / "mine"}), round ? "01" : "00");
  }
}

TEST(FileRemoveAllFilesInTmp, ClosesTrackedHandlesInListOrder) {
  TempDir dir;
  std::string log = dir / "log";
  int fds = OpenFdCount();
  // Three appenders of one file: each close flushes its own letter.
  FILE* a = FOPEN(log.c_str(), "a");
  FILE* b = FOPEN(log.c_str(), "a");
  FILE* c = KERB_FOPEN(log.c_str(), "a");
  fputc('A', a);
  fputc('B', b);
  fputc('C', c);
  FCLOSE(a);  // the last handle takes the first place: (c, b)
  EXPECT_EQ(ReadFile(log), "A");
  FileRemoveAllFilesInTmp();
  EXPECT_EQ(ReadFile(log), "ACB");
  // A new list after the clean-up, with a handle whose close fails.
  FILE* d = FOPEN(log.c_str(), "a");
  FILE* e = FOPEN(log.c_str(), "r");
  close(fileno(e));
  PortTest::Capture cap;
  EXPECT_NE(FCLOSE(e), 0);  // off the list all the same
  fputc('D', d);
  FileRemoveAllFilesInTmp();
  EXPECT_EQ(ReadFile(log), "ACBD");
  EXPECT_EQ(OpenFdCount(), fds);
  EXPECT_EQ(cap.size(), 1u);
}

TEST(FileRemoveAllFilesInTmp, ProcessNumber1000AndALongDirectory) {
  SystemSetClock([]() -> long long { return 9990; });
  TempDir dir;
  std::string deep = dir.path;
  for (int i = 0; i < 3; ++i) ASSERT_EQ(mkdir((deep += std::string(120, 'd' + i) + "/").c_str(), 0700), 0);
  KERBTmpDir = deep.data();
  EXPECT_EQ(Owned(FileRandomNameNoExtension()), "p00rs000");
  WriteFile(deep + "kerb1000.ren", "x");
  WriteFile(deep + "kerb999.ren", "x");
  FileRemoveAllFilesInTmp();
  EXPECT_EQ(Present({deep + "kerb1000.ren", deep + "kerb999.ren"}), "01");
  KERBTmpDir = nullptr;
}

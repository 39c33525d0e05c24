#include <gtest/gtest.h>
#include <sys/stat.h>
#include <unistd.h>

#include <string>

#include "duduzu/file.h"
#include "duduzu/session.h"
#include "duduzu/system.h"
#include "file/file_test_util.h"
#include "port/port_testing.h"
#include "support/temp_dir.h"

namespace {

// Fixes the process number at 999 (or 1000) before anything reads it.
void Pid999() { SystemSetClock([]() -> long long { return 9980; }); }
void Pid1000() { SystemSetClock([]() -> long long { return 9990; }); }

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
}

TEST(FileRandomName, WithoutMemory) {
  Pid999();
  PortTest::AllocFailureGuard guard;
  PortTest::FailAllAllocs();
  EXPECT_EQ(FileRandomNameNoExtension(), nullptr);
  EXPECT_EQ(FileCreateNameInTmpWithExtension("v"), nullptr);
  FileRemoveAllFilesInTmp();
}

TEST(FileTmpNames, MadeInTheDirectoryAndRemovedAtTheEnd) {
  Pid999();
  TempDir dir;
  KERBTmpDir = dir.path.data();
  std::string v = Owned(FileCreateNameInTmpWithExtension("v"));
  std::string bare = Owned(FileCreateNameInTmpWithExtension(nullptr));
  std::string tmp = Owned(FileCreateRandomName());  // freed: still registered
  EXPECT_EQ(v, dir / "p00rr000.v");
  EXPECT_EQ(bare, dir / "p00rr001");
  EXPECT_EQ(tmp, dir / "p00rr002.tmp");
  for (const std::string& name : {v, bare, tmp, dir / "kerb999.ren", dir / "kept"})
    WriteFile(name, "x");
  FileRemoveAllFilesInTmp();
  EXPECT_FALSE(Exists(v));
  EXPECT_FALSE(Exists(bare));
  EXPECT_FALSE(Exists(tmp));
  EXPECT_FALSE(Exists(dir / "kerb999.ren"));
  EXPECT_TRUE(Exists(dir / "kept"));
  KERBTmpDir = nullptr;
}

TEST(FileTmpNames, NullDirectoryMeansTheCurrentOne) {
  Pid999();
  TempDir dir;
  ASSERT_EQ(chdir(dir.path.c_str()), 0);
  KERBTmpDir = nullptr;
  std::string name = Owned(FileCreateNameInTmpWithExtension("v"));
  EXPECT_EQ(name, "p00rr000.v");
  WriteFile(name, "x");
  WriteFile("kerb999.ren", "x");
  FileRemoveAllFilesInTmp();
  EXPECT_FALSE(Exists(dir / name));
  EXPECT_FALSE(Exists(dir / "kerb999.ren"));
}

TEST(FileCleanOnExit, CopiesNamesAndToleratesDuplicates) {
  TempDir dir;
  std::string name = dir / "twice";
  WriteFile(name, "x");
  FileAddFileNameForCleanOnExit(name.data());
  FileAddFileNameForCleanOnExit(name.data());
  std::string mine = dir / "mine";
  WriteFile(mine, "x");
  FileAddFileNameForCleanOnExit(mine.data());
  mine[mine.size() - 1] = 'X';  // the caller's string is the caller's
  FileAddFileNameForCleanOnExit(nullptr);
  PortTest::Capture cap;
  FileRemoveAllFilesInTmp();
  EXPECT_FALSE(Exists(name));
  EXPECT_FALSE(Exists(dir / "mine"));
  EXPECT_EQ(cap.size(), 0u);
  // The list starts again after a clean-up.
  WriteFile(name, "x");
  FileAddFileNameForCleanOnExit(name.data());
  FileRemoveAllFilesInTmp();
  EXPECT_FALSE(Exists(name));
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
  EXPECT_EQ(OpenFdCount(), fds);
  // A new list after the clean-up, with a handle whose close fails.
  FILE* d = FOPEN(log.c_str(), "a");
  FILE* e = FOPEN(log.c_str(), "r");
  close(fileno(e));
  PortTest::Capture cap;
  EXPECT_NE(FCLOSE(e), 0);  // off the list all the same
  EXPECT_EQ(cap.size(), 1u);
  fputc('D', d);
  FileRemoveAllFilesInTmp();
  EXPECT_EQ(ReadFile(log), "ACBD");
  EXPECT_EQ(OpenFdCount(), fds);
  EXPECT_EQ(cap.size(), 1u);
}

TEST(FileRemoveAllFilesInTmp, ClosesOpenFilesBeforeRemovingThem) {
  Pid999();
  TempDir dir;
  KERBTmpDir = dir.path.data();
  int fds = OpenFdCount();
  std::string first = Owned(FileCreateRandomName());
  std::string second = Owned(FileCreateRandomName());
  FILE* f1 = FOPEN(first.c_str(), "w");
  FILE* f2 = FOPEN(second.c_str(), "w");
  fputs("pending", f1);
  fputs("pending", f2);
  FileRemoveAllFilesInTmp();
  EXPECT_FALSE(Exists(first));
  EXPECT_FALSE(Exists(second));
  EXPECT_EQ(OpenFdCount(), fds);
  KERBTmpDir = nullptr;
}

TEST(FileRemoveAllFilesInTmp, ProcessNumber1000AndALongDirectory) {
  Pid1000();
  TempDir dir;
  std::string deep = dir.path;
  for (int i = 0; i < 3; ++i) {
    deep += std::string(120, 'd' + i) + "/";
    ASSERT_EQ(mkdir(deep.c_str(), 0700), 0);
  }
  ASSERT_GT(deep.size(), 360u);
  KERBTmpDir = deep.data();
  EXPECT_EQ(Owned(FileRandomNameNoExtension()), "p00rs000");
  WriteFile(deep + "kerb1000.ren", "x");
  WriteFile(deep + "kerb999.ren", "x");
  FileRemoveAllFilesInTmp();
  EXPECT_FALSE(Exists(deep + "kerb1000.ren"));
  EXPECT_TRUE(Exists(deep + "kerb999.ren"));
  KERBTmpDir = nullptr;
}

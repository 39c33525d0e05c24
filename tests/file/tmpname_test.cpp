#include <gtest/gtest.h>
#include <unistd.h>

#include "duduzu/file.h"
#include "duduzu/session.h"
#include "duduzu/system.h"
#include "file/file_test_util.h"

// Fixes the process number at 999 before anything reads it.
static void Pid999() { SystemSetClock([]() -> long long { return 9980; }); }

TEST(FileTmpNames, CountedNamesMadeInTheDirectoryOpenOnesClosedAndAllRemoved) {
  Pid999();
  TempDir dir;
  KERBTmpDir = dir.path.data();
  int fds = OpenFdCount();
  std::string v = Owned(FileCreateNameInTmpWithExtension("v")), bare = Owned(FileCreateNameInTmpWithExtension(nullptr));
  std::string tmp = Owned(FileCreateRandomName());  // freed: still registered
  EXPECT_EQ(v + " " + bare + " " + tmp, dir / "p00rr000.v " + dir / "p00rr001 " + dir / "p00rr002.tmp");
  for (const std::string& name : {v, bare, dir / "kerb999.ren", dir / "kept"}) WriteFile(name, "x");
  fputs("pending", FOPEN(tmp.c_str(), "w"));  // still open at the clean-up
  FileRemoveAllFilesInTmp();
  EXPECT_EQ(Present({v, bare, tmp, dir / "kerb999.ren", dir / "kept"}) + std::to_string(OpenFdCount() - fds), "000010");
  KERBTmpDir = nullptr;  // no directory: the current one
  EXPECT_EQ(Owned(FileCreateNameInTmpWithExtension("v")), "p00rr003.v");
  for (int k = 4; k < 46655; ++k) vzl_free(FileRandomNameNoExtension());
  EXPECT_EQ(Owned(FileRandomNameNoExtension()), "p00rrzzz");  // the 46656th
  EXPECT_EQ(Owned(FileRandomNameNoExtension()), "p00rr000");  // wrapped
  PortTest::AllocFailureGuard guard;
  PortTest::FailAllAllocs();
  EXPECT_TRUE(!FileRandomNameNoExtension() && !FileCreateNameInTmpWithExtension("v"));
}

TEST(FileCleanOnExit, CopiesNamesToleratesDuplicatesAndStartsAgain) {
  TempDir dir;
  std::string name = dir / "twice", mine = dir / "mine";
  for (char* s : {name.data(), name.data(), mine.data(), static_cast<char*>(nullptr)}) FileAddFileNameForCleanOnExit(s);
  mine.back() = 'X';  // the caller's string is the caller's
  for (const char* want : {"00", "11"}) {  // the list starts again after a clean-up
    WriteFile(name, "x"), WriteFile(dir / "mine", "x");
    FileRemoveAllFilesInTmp();
    EXPECT_EQ(Present({name, dir / "mine"}), want);
  }
}

// Three appenders of one file: each close flushes its own letter.
TEST(FileRemoveAllFilesInTmp, ClosesTrackedHandlesInListOrder) {
  TempDir dir;
  std::string log = dir / "log";
  int fds = OpenFdCount();
  FILE *a = FOPEN(log.c_str(), "a"), *b = FOPEN(log.c_str(), "a"), *c = KERB_FOPEN(log.c_str(), "a");
  fputc('A', a), fputc('B', b), fputc('C', c);
  FCLOSE(a);  // the last handle takes the first place: (c, b)
  FileRemoveAllFilesInTmp();
  EXPECT_EQ(ReadFile(log), "ACB");
  // A new list after the clean-up, with a handle whose close fails: off the list all the same.
  FILE *d = FOPEN(log.c_str(), "a"), *e = FOPEN(log.c_str(), "r");
  std::string before = Flags(e);
  close(fileno(e));  // the close of the descriptor will now fail
  PortTest::Capture cap;
  EXPECT_NE(FCLOSE(e), 0);
  // The stream is released by the close; its word then reads 0.
  EXPECT_EQ(Reports(cap), "2:\nCan not Close File [" + before + "/0]!\n");
  fputc('D', d);
  FileRemoveAllFilesInTmp();
  EXPECT_EQ(ReadFile(log) + std::to_string(OpenFdCount() - fds), "ACBD0");
}

TEST(FileRemoveAllFilesInTmp, ProcessNumber1000AndALongDirectory) {
  SystemSetClock([]() -> long long { return 9990; });
  TempDir dir;
  std::string deep = dir.path + std::string(120, 'd') + "/" + std::string(120, 'e') + "/" + std::string(120, 'f') + "/";
  ASSERT_TRUE(std::filesystem::create_directories(deep));
  KERBTmpDir = deep.data();
  EXPECT_EQ(Owned(FileRandomNameNoExtension()), "p00rs000");
  for (const char* name : {"kerb1000.ren", "kerb999.ren"}) WriteFile(deep + name, "x");
  FileRemoveAllFilesInTmp();
  EXPECT_EQ(Present({deep + "kerb1000.ren", deep + "kerb999.ren"}), "01");
}

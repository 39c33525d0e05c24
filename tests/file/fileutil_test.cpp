#include <gtest/gtest.h>
#include <sys/stat.h>
#include <unistd.h>

#include <cstdint>
#include <string>
#include <utility>

#include "duduzu/file.h"
#include "duduzu/session.h"
#include "file/file_test_util.h"
#include "port/port_testing.h"
#include "support/session_test.h"
#include "support/temp_dir.h"

namespace {

const std::string kBinary("\x00\x01line\n\x00\xff\r\nend", 15);  // no trailing newline

int Flags(FILE* f) { return static_cast<int16_t>(f->_flags); }

}  // namespace

TEST(FOPEN, MissingFileEndsTheSessionWithStatus5) {
  TempDir dir;
  std::string name = dir / "missing.v";
  PortTest::Capture cap;
  EXPECT_EQ(KERB_FOPEN(name.c_str(), "r"), nullptr);
  EXPECT_EQ(cap.size(), 0u);
  MainEVarReturnStatus = 0;
  EXPECT_TRUE(ExitsToSession([&] { FOPEN(name.c_str(), "r"); }));
  EXPECT_EQ(MainEVarReturnStatus, 5);
  ASSERT_EQ(cap.size(), 1u);
  EXPECT_EQ(cap[0].level, Port_Status);
  EXPECT_EQ(cap[0].unit, "../s/fileutil");
  EXPECT_EQ(cap[0].text, "\nCan not Open File : " + name + " !\n");
}

TEST(FCLOSE, ClosesTrackedAndUntrackedHandles) {
  TempDir dir;
  PortTest::Capture cap;
  int fds = OpenFdCount();
  FILE* tracked = FOPEN((dir / "a").c_str(), "w");
  FILE* plain = FileOpenWrite((dir / "b").c_str());
  fputs("x", plain);
  EXPECT_EQ(FCLOSE(plain), 0);
  EXPECT_EQ(FCLOSE(tracked), 0);
  EXPECT_EQ(OpenFdCount(), fds);
  EXPECT_EQ(ReadFile(dir / "b"), "x");
  EXPECT_EQ(cap.size(), 0u);
}

TEST(FCLOSE, FailedCloseReportsTheFlagWords) {
  TempDir dir;
  WriteFile(dir / "a", "abc");
  FILE* f = FileExistThenOpenRead((dir / "a").c_str());
  int before = Flags(f);
  close(fileno(f));  // the close of the descriptor will now fail
  PortTest::Capture cap;
  EXPECT_NE(FCLOSE(f), 0);
  ASSERT_EQ(cap.size(), 1u);
  EXPECT_EQ(cap[0].level, Port_Status);
  // The stream is released by the close; its word then reads 0.
  EXPECT_EQ(cap[0].text, "\nCan not Close File [" + std::to_string(before) + "/0]!\n");
  // A standard stream outlives its close: its word after is read.
  before = Flags(stdin);
  close(0);
  cap.clear();
  EXPECT_NE(FCLOSE(stdin), 0);
  ASSERT_EQ(cap.size(), 1u);
  EXPECT_EQ(cap[0].text, "\nCan not Close File [" + std::to_string(before) + "/" +
                             std::to_string(Flags(stdin)) + "]!\n");
}

TEST(FileOpenAlternate, FallsBackToTheDirectory) {
  TempDir dir;
  ASSERT_EQ(chdir(dir.path.c_str()), 0);
  ASSERT_EQ(mkdir("lib", 0700), 0);
  WriteFile("lib/f.v", "in lib");
  PortTest::Capture cap;
  FILE* f = FileOpenReadAlternate("f.v", "lib/", 1);
  ASSERT_NE(f, nullptr);
  EXPECT_EQ(StreamText(f), "in lib");
  FCLOSE(f);
  WriteFile("f.v", "here");
  f = FileOpenReadAlternate("f.v", "lib/", 1);
  EXPECT_EQ(StreamText(f), "here");  // the name itself comes first
  FCLOSE(f);
  EXPECT_EQ(cap.size(), 0u);
  // Neither candidate: reported with the name as passed, only when asked.
  EXPECT_EQ(FileOpenReadAlternate("g.v", "lib/", 1), nullptr);
  ASSERT_EQ(cap.size(), 1u);
  EXPECT_EQ(cap[0].level, Port_Error);
  EXPECT_EQ(cap[0].text, "File not found : g.v\n");
  EXPECT_EQ(FileOpenReadAlternate("g.v", "lib/", 0), nullptr);
  EXPECT_EQ(FileOpenReadAlternate("g.v", nullptr, 1), nullptr);
  EXPECT_EQ(FileOpenReadAlternate(nullptr, "lib/", 1), nullptr);
  EXPECT_EQ(cap.size(), 1u);
  // Writing: a name in a missing directory is created in the fall-back one.
  ASSERT_EQ(mkdir("lib/nodir", 0700), 0);
  f = FileOpenWriteAlternate("nodir/w.v", "lib/", 1);
  ASSERT_NE(f, nullptr);
  FCLOSE(f);
  EXPECT_TRUE(Exists("lib/nodir/w.v"));
  EXPECT_EQ(FileOpenWriteAlternate("nodir/w.v", "none/", 1), nullptr);
  EXPECT_EQ(cap.last().text, "File not found : nodir/w.v\n");
}

TEST(FileExist, ModesAndNullArguments) {
  TempDir dir;
  std::string name = dir / "f";
  WriteFile(name, "content");
  EXPECT_EQ(FileExist(name.c_str(), "x"), 0);
  EXPECT_EQ(ReadFile(name), "content");
  EXPECT_EQ(FileExist(name.c_str(), "R"), 1);
  EXPECT_EQ(ReadFile(name), "content");
  EXPECT_EQ(FileExist(name.c_str(), "W"), 1);  // truncates
  EXPECT_TRUE(Exists(name));
  EXPECT_EQ(ReadFile(name), "");
  EXPECT_EQ(FileExist((dir / "missing").c_str(), "r"), 0);
  EXPECT_FALSE(Exists(dir / "missing"));
  EXPECT_EQ(FileExist((dir / "new").c_str(), "w"), 1);  // creates
  EXPECT_TRUE(Exists(dir / "new"));
  EXPECT_EQ(FileExist((dir / "no/such").c_str(), "w"), 0);
  EXPECT_EQ(FileExist(nullptr, "r"), 0);
  EXPECT_EQ(FileExist(name.c_str(), nullptr), 0);
}

TEST(FileCopy, NameToNameCopiesEveryByte) {
  TempDir dir;
  std::string from = dir / "from", to = dir / "to";
  WriteFile(from, kBinary);
  WriteFile(to, std::string(100, 'z'));  // longer: truncated first
  int fds = OpenFdCount();
  EXPECT_EQ(FileCopyFileNameToFileName(from.data(), to.data()), 1);
  EXPECT_EQ(ReadFile(to), kBinary);
  EXPECT_EQ(FileCopyFileNameToFileName(from.data(), nullptr), 0);
  std::string missing = dir / "missing", badTarget = dir / "no/such";
  EXPECT_EQ(FileCopyFileNameToFileName(missing.data(), to.data()), 0);
  EXPECT_EQ(FileCopyFileNameToFileName(from.data(), badTarget.data()), 0);
  EXPECT_EQ(FileCopyFileNameToFileName(nullptr, to.data()), 0);
  EXPECT_EQ(OpenFdCount(), fds);
  EXPECT_EQ(ReadFile(to), kBinary);
}

TEST(FileCopy, NameToNameFromAPseudoFile) {
  // Its size reads 0, so the copy cannot trust the kernel's view of its end.
  TempDir dir;
  std::string from = "/proc/self/cmdline", to = dir / "to";
  EXPECT_EQ(FileCopyFileNameToFileName(from.data(), to.data()), 1);
  EXPECT_EQ(ReadFile(to), ReadFile(from));
  EXPECT_FALSE(ReadFile(to).empty());
}

TEST(FileCopy, StreamsFromTheirCurrentPositions) {
  FILE* from = tmpfile();
  FILE* to = tmpfile();
  fwrite(kBinary.data(), 1, kBinary.size(), from);
  rewind(from);
  fgetc(from);
  fputs("head:", to);
  FileCopyFileToFile(from, to);
  EXPECT_EQ(StreamText(to), "head:" + kBinary.substr(1));
  fputs("more", from);  // both stay open
  fclose(from);
  fclose(to);
}

TEST(FileCopy, NameToStreamClosesTheSource) {
  TempDir dir;
  std::string from = dir / "from";
  WriteFile(from, kBinary);
  FILE* to = tmpfile();
  int fds = OpenFdCount();
  EXPECT_EQ(FileCopyFileNameToFile(from.data(), to), 1);
  EXPECT_EQ(OpenFdCount(), fds);
  EXPECT_EQ(StreamText(to), kBinary);
  std::string missing = dir / "missing";
  EXPECT_EQ(FileCopyFileNameToFile(missing.data(), to), 0);
  EXPECT_EQ(FileCopyFileNameToFile(nullptr, to), 0);
  fclose(to);
  // Standard output as destination: the source is closed too.
  fflush(stdout);
  FILE* out = fopen((dir / "stdout").c_str(), "w");
  ASSERT_GE(dup2(fileno(out), 1), 0);
  fclose(out);
  fds = OpenFdCount();
  EXPECT_EQ(FileCopyFileNameToFile(from.data(), stdout), 1);
  EXPECT_EQ(OpenFdCount(), fds);
  fflush(stdout);
  EXPECT_EQ(ReadFile(dir / "stdout"), kBinary);
}

TEST(FileRemoveFile, RemovesExistingFilesOnly) {
  TempDir dir;
  std::string name = dir / "f";
  WriteFile(name, "x");
  FileRemoveFile(name.c_str());
  EXPECT_FALSE(Exists(name));
  FileRemoveFile(name.c_str());
  FileRemoveFile(nullptr);
}

TEST(FileNames, SplittersAndTheirDotRules) {
  using Case = std::pair<const char*, const char*>;
  for (auto [name, want] : {Case{"a.b/c.d.e", "a.b/c"}, Case{"out.tmp.v", "out"}, Case{"noext", "noext"},
                            Case{"d/.x", "d/"}, Case{"a.b\\c/d.e", "a.b\\c/d"}, Case{"", ""}})
    EXPECT_EQ(Owned(FileRemoveExtension(name)), want) << name;
  for (auto [name, want] : {Case{"name", ""}, Case{"a/b/c.v", "a/b/"}, Case{"/x", "/"},
                            Case{"a\\b/c", "a\\"}}) {  // a backslash wins
    std::string s = name;
    EXPECT_EQ(Owned(FileGetDirName(s.data())), want) << name;
  }
  for (auto [name, want] : {Case{"a.b/c", "<null>"}, Case{"c:x", "<null>"}, Case{"d\\x", "<null>"},
                            Case{"x.", ""}, Case{".v", "<null>"}, Case{"a.v", "v"}, Case{"a.b.c", "c"},
                            Case{"d.e/f.g", "g"}, Case{"x", "<null>"}, Case{"", "<null>"}}) {
    std::string s = name;
    EXPECT_EQ(Owned(FileGetFileExtension(s.data())), want) << name;
  }
  EXPECT_EQ(FileRemoveExtension(nullptr), nullptr);
  EXPECT_EQ(FileGetDirName(nullptr), nullptr);
  EXPECT_EQ(FileGetFileExtension(nullptr), nullptr);
}

#include <gtest/gtest.h>
#include <sys/stat.h>
#include <unistd.h>

#include <cstdint>
#include <utility>

#include "duduzu/file.h"
#include "duduzu/session.h"
#include "file/file_test_util.h"
#include "support/session_test.h"

namespace {
const std::string kBinary("\x00\x01line\n\x00\xff\r\nend", 15);  // no trailing newline
std::string Flags(FILE* f) { return std::to_string(static_cast<int16_t>(f->_flags)); }
}  // namespace

TEST(FOPEN, MissingFileEndsTheSessionWithStatus5) {
  TempDir dir;
  std::string name = dir / "missing.v";
  PortTest::Capture cap;
  EXPECT_EQ(KERB_FOPEN(name.c_str(), "r"), nullptr);
  EXPECT_EQ(Reports(cap), "");
  MainEVarReturnStatus = 0;
  EXPECT_TRUE(ExitsToSession([&] { FOPEN(name.c_str(), "r"); }));
  EXPECT_EQ(MainEVarReturnStatus, 5);
  EXPECT_EQ(Reports(cap), "2:\nCan not Open File : " + name + " !\n");
}

TEST(FCLOSE, ClosesAnyHandleAndReportsAFailedCloseWithTheFlagWords) {
  TempDir dir;
  int fds = OpenFdCount();
  FILE* tracked = FOPEN((dir / "a").c_str(), "w");
  FILE* plain = FileOpenWrite((dir / "b").c_str());
  fputs("x", plain);
  EXPECT_EQ(FCLOSE(plain) + FCLOSE(tracked), 0);
  EXPECT_EQ(OpenFdCount(), fds);
  EXPECT_EQ(ReadFile(dir / "b"), "x");
  FILE* f = FileExistThenOpenRead((dir / "b").c_str());
  std::string before = Flags(f);
  close(fileno(f));  // the close of the descriptor will now fail
  PortTest::Capture cap;
  EXPECT_NE(FCLOSE(f), 0);
  // The stream is released by the close; its word then reads 0.
  EXPECT_EQ(Reports(cap), "2:\nCan not Close File [" + before + "/0]!\n");
  before = Flags(stdin);  // a standard stream outlives its close: its word after is read
  close(0);
  EXPECT_NE(FCLOSE(stdin), 0);
  EXPECT_EQ(Reports(cap), "2:\nCan not Close File [" + before + "/" + Flags(stdin) + "]!\n");
}

TEST(FileOpenAlternate, FallsBackToTheDirectory) {
  TempDir dir;
  ASSERT_EQ(chdir(dir.path.c_str()), 0);
  ASSERT_EQ(mkdir("lib", 0700) + mkdir("lib/nodir", 0700), 0);
  WriteFile("lib/f.v", "in lib");
  PortTest::Capture cap;
  FILE* f = FileOpenReadAlternate("f.v", "lib/", 1);
  EXPECT_EQ(StreamText(f), "in lib");
  FCLOSE(f);
  WriteFile("f.v", "here");
  f = FileOpenReadAlternate("f.v", "lib/", 1);
  EXPECT_EQ(StreamText(f), "here");  // the name itself comes first
  FCLOSE(f);
  f = FileOpenWriteAlternate("nodir/w.v", "lib/", 1);  // a missing directory: made in the fall-back one
  FCLOSE(f);
  EXPECT_TRUE(Exists("lib/nodir/w.v"));
  EXPECT_EQ(Reports(cap), "");
  // Neither candidate: reported with the name as passed, only when asked.
  EXPECT_TRUE(!FileOpenReadAlternate("g.v", "lib/", 0) && !FileOpenReadAlternate("g.v", nullptr, 1) &&
              !FileOpenReadAlternate(nullptr, "lib/", 1) && !FileOpenReadAlternate("g.v", "lib/", 1) &&
              !FileOpenWriteAlternate("nodir/w.v", "none/", 1));
  EXPECT_EQ(Reports(cap), "4:File not found : g.v\n4:File not found : nodir/w.v\n");
}

TEST(FileExist, ModesNullArgumentsAndRemoval) {
  TempDir dir;
  std::string name = dir / "f", missing = dir / "missing", created = dir / "new";
  WriteFile(name, "content");
  EXPECT_EQ(FileExist(name.c_str(), "x") + FileExist(name.c_str(), nullptr) + FileExist(nullptr, "r") +
                FileExist(missing.c_str(), "r") + FileExist((dir / "no/such").c_str(), "w"), 0);
  EXPECT_EQ(FileExist(name.c_str(), "R") * 10 + FileExist(created.c_str(), "w"), 11);  // "w" creates
  EXPECT_EQ(ReadFile(name), "content");
  EXPECT_EQ(FileExist(name.c_str(), "W"), 1);  // and truncates
  EXPECT_EQ(ReadFile(name), "");
  FileRemoveFile(name.c_str());
  FileRemoveFile(missing.c_str());
  FileRemoveFile(nullptr);
  EXPECT_EQ(Present({name, missing, created}), "001");
}

TEST(FileCopy, NameToNameEveryByteAndFromAPseudoFile) {
  TempDir dir;
  std::string from = dir / "from", to = dir / "to", missing = dir / "missing", badTarget = dir / "no/such";
  WriteFile(from, kBinary);
  WriteFile(to, std::string(100, 'z'));  // longer: truncated first
  int fds = OpenFdCount();
  EXPECT_EQ(FileCopyFileNameToFileName(from.data(), to.data()), 1);
  EXPECT_EQ(FileCopyFileNameToFileName(from.data(), nullptr) + FileCopyFileNameToFileName(nullptr, to.data()) +
                FileCopyFileNameToFileName(missing.data(), to.data()) +
                FileCopyFileNameToFileName(from.data(), badTarget.data()),
            0);
  EXPECT_EQ(OpenFdCount(), fds);
  EXPECT_EQ(ReadFile(to), kBinary);
  std::string proc = "/proc/self/cmdline";  // its size reads 0: the kernel's view of its end is no guide
  EXPECT_EQ(FileCopyFileNameToFileName(proc.data(), to.data()), 1);
  EXPECT_EQ(ReadFile(to), ReadFile(proc));
  EXPECT_FALSE(ReadFile(to).empty());
}

TEST(FileCopy, StreamsFromTheirPositionsAndNameToStreamClosesTheSource) {
  TempDir dir;
  std::string from = dir / "from", missing = dir / "missing";
  WriteFile(from, kBinary);
  FILE* in = fopen(from.c_str(), "r");
  FILE* to = tmpfile();
  fgetc(in);
  fputs("head:", to);
  FileCopyFileToFile(in, to);
  EXPECT_EQ(StreamText(to), "head:" + kBinary.substr(1));
  EXPECT_EQ(fclose(in) + fclose(to), 0);  // both left open
  to = tmpfile();
  int fds = OpenFdCount();
  EXPECT_EQ(FileCopyFileNameToFile(from.data(), to) * 10 + FileCopyFileNameToFile(missing.data(), to) +
                FileCopyFileNameToFile(nullptr, to), 10);
  EXPECT_EQ(OpenFdCount(), fds);
  EXPECT_EQ(StreamText(to), kBinary);
  fclose(to);
  fflush(stdout);  // standard output as destination: the source is closed too
  FILE* out = fopen((dir / "stdout").c_str(), "w");
  ASSERT_GE(dup2(fileno(out), 1), 0);
  fclose(out);
  fds = OpenFdCount();
  EXPECT_EQ(FileCopyFileNameToFile(from.data(), stdout), 1);
  EXPECT_EQ(OpenFdCount(), fds);
  fflush(stdout);
  EXPECT_EQ(ReadFile(dir / "stdout"), kBinary);
}

TEST(FileNames, SplittersAndTheirDotRules) {
  using Case = std::pair<const char*, const char*>;
  auto dirName = [](std::string s) { return Owned(FileGetDirName(s.data())); };
  auto extension = [](std::string s) { return Owned(FileGetFileExtension(s.data())); };
  for (auto [name, want] : {Case{"a.b/c.d.e", "a.b/c"}, {"out.tmp.v", "out"}, {"noext", "noext"}, {"d/.x", "d/"},
                            {"a.b\\c/d.e", "a.b\\c/d"}, {"", ""}})
    EXPECT_EQ(Owned(FileRemoveExtension(name)), want) << name;
  for (auto [name, want] : {Case{"name", ""}, {"a/b/c.v", "a/b/"}, {"/x", "/"}, {"a\\b/c", "a\\"}})  // a backslash wins
    EXPECT_EQ(dirName(name), want) << name;
  for (auto [name, want] : {Case{"a.b/c", "<null>"}, {"c:x", "<null>"}, {"d\\x", "<null>"}, {"x.", ""},
                            {".v", "<null>"}, {"a.b.c", "c"}, {"d.e/f.g", "g"}, {"x", "<null>"}, {"", "<null>"}})
    EXPECT_EQ(extension(name), want) << name;
  EXPECT_TRUE(!FileRemoveExtension(nullptr) && !FileGetDirName(nullptr) && !FileGetFileExtension(nullptr));
}

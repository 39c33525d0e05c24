#include <gtest/gtest.h>
#include <unistd.h>

#include "duduzu/file.h"
#include "file/file_test_util.h"
#include "support/session_test.h"

static const std::string kBinary("\x00\x01line\n\x00\xff\r\nend", 15);  // no trailing newline
static std::string Drain(FILE* f) { std::string text = StreamText(f); return FCLOSE(f), text; }

TEST(FOPEN, MissingFileEndsTheSessionWithStatus5) {
  TempDir dir;
  std::string name = dir / "missing.v";
  PortTest::Capture cap;
  EXPECT_EQ(KERB_FOPEN(name.c_str(), "r"), nullptr);  // silent
  EXPECT_TRUE(ExitsToSession([&] { FOPEN(name.c_str(), "r"); }));
  EXPECT_EQ(std::to_string(MainEVarReturnStatus) + Reports(cap), "52:\nCan not Open File : " + name + " !\n");
}

TEST(FileOpenAlternate, FallsBackToTheDirectory) {
  TempDir dir;
  ASSERT_EQ(chdir(dir.path.c_str()), 0);
  ASSERT_TRUE(std::filesystem::create_directory("lib"));
  WriteFile("lib/f.v", "in lib");
  PortTest::Capture cap;
  EXPECT_EQ(Drain(FileOpenReadAlternate("f.v", "lib/", 1)), "in lib");
  WriteFile("f.v", "here");
  EXPECT_EQ(Drain(FileOpenReadAlternate("f.v", "lib/", 1)), "here");  // the name itself comes first
  FCLOSE(FileOpenWriteAlternate("w.v", "lib/", 1));
  // Neither candidate: reported with the name as passed, only when asked.
  EXPECT_TRUE(!FileOpenReadAlternate("g.v", "lib/", 0) && !FileOpenReadAlternate("g.v", nullptr, 1) &&
              !FileOpenReadAlternate(nullptr, "lib/", 1) && !FileOpenReadAlternate("g.v", "lib/", 1));
  EXPECT_EQ(Reports(cap) + ReadFile("w.v"), "4:File not found : g.v\n");  // the write one made here
}

TEST(FileExist, ModesNullArgumentsAndRemoval) {
  TempDir dir;
  std::string name = dir / "f", missing = dir / "missing", created = dir / "new";
  WriteFile(name, "content");
  EXPECT_EQ(FileExist(name.c_str(), "x") + FileExist(name.c_str(), nullptr) + FileExist(nullptr, "r") +
                FileExist(missing.c_str(), "r") + FileExist((dir / "no/such").c_str(), "w"), 0);
  EXPECT_EQ(FileExist(name.c_str(), "R") * 10 + FileExist(created.c_str(), "w"), 11);  // "w" creates
  EXPECT_EQ(FileExist(name.c_str(), "W"), 1);  // and truncates
  EXPECT_EQ(ReadFile(name), "");
  FileRemoveFile(name.c_str());
  FileRemoveFile(nullptr);
  EXPECT_EQ(Present({name, created}), "01");
}

TEST(FileCopy, EveryByteFromNamesPseudoFilesAndStreamPositions) {
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
  // A pseudo-file's size reads 0: the kernel's view of its end is no guide.
  EXPECT_EQ(FileCopyFileNameToFileName(C("/proc/self/cmdline"), to.data()), 1);
  EXPECT_TRUE(ReadFile(to) == ReadFile("/proc/self/cmdline") && !ReadFile(to).empty());
  FILE* in = fopen(from.c_str(), "r");
  FILE* out = tmpfile();
  fgetc(in);
  fputs("head:", out);
  FileCopyFileToFile(in, out);  // from the positions; both left open
  EXPECT_EQ(StreamText(out) + std::to_string(fclose(in)), "head:" + kBinary.substr(1) + "0");
  EXPECT_EQ(FileCopyFileNameToFile(from.data(), out) * 10 + FileCopyFileNameToFile(missing.data(), out) +
                FileCopyFileNameToFile(nullptr, out), 10);
  EXPECT_EQ(OpenFdCount(), fds + 1);  // the source closed again
  EXPECT_EQ(StreamText(out), "head:" + kBinary.substr(1) + kBinary);
}

TEST(FileNames, SplittersAndTheirDotRules) {
  using Case = std::pair<const char*, const char*>;
  for (auto [name, want] : {Case{"a.b/c.d.e", "a.b/c"}, {"out.tmp.v", "out"}, {"noext", "noext"}, {"d/.x", "d/"},
                            {"a.b\\c/d.e", "a.b\\c/d"}, {"", ""}})
    EXPECT_EQ(Owned(FileRemoveExtension(name)), want) << name;
  for (auto [name, want] : {Case{"name", ""}, {"a/b/c.v", "a/b/"}, {"/x", "/"}, {"a\\b/c", "a\\"}})  // a backslash wins
    EXPECT_EQ(Owned(FileGetDirName(C(name))), want) << name;
  for (auto [name, want] : {Case{"a.b/c", "<null>"}, {"c:x", "<null>"}, {"d\\x", "<null>"}, {"x.", ""},
                            {".v", "<null>"}, {"a.b.c", "c"}, {"d.e/f.g", "g"}, {"x", "<null>"}, {"", "<null>"}})
    EXPECT_EQ(Owned(FileGetFileExtension(C(name))), want) << name;
  EXPECT_TRUE(!FileRemoveExtension(nullptr) && !FileGetDirName(nullptr) && !FileGetFileExtension(nullptr));
}

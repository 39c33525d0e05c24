#include <gtest/gtest.h>

#include <cstdlib>
#include <cstring>
#include <filesystem>

#include "duduzu/session.h"
#include "duduzu/str.h"
#include "duduzu/system.h"
#include "support/owned.h"
#include "support/reports.h"
#include "support/temp_dir.h"

TEST(SystemIRint, HalvesAwayFromZero) {
  for (auto [x, r] : {std::pair{0.5f, 1}, {-0.5f, -1}, {1.49f, 1}, {-1.5f, -2}, {2.5f, 3}, {-2.4999f, -2}, {0.0f, 0}})
    EXPECT_EQ(SystemIRint(x), r) << x;
}

TEST(SystemGetPID, FromTheClockOnceThenCached) {
  SystemSetClock([]() -> long long { return 1234567; });
  EXPECT_EQ(SystemGetPID(), 457);
  SystemSetClock([]() -> long long { return 9980; });
  EXPECT_EQ(SystemGetPID(), 457);  // kept for the whole process
}

TEST(SystemGetPID, RealClockInRange) {
  int pid = SystemGetPID();
  EXPECT_TRUE(pid >= 1 && pid <= 1000 && SystemGetPID() == pid) << pid;
}

// Each item's bytes are reversed in the file, for any size; a short read stores whole items only.
TEST(SystemBinary, RoundTripsShortReadsAndNoMemory) {
  for (unsigned size : {1u, 2u, 4u, 16u, 32u}) {
    std::string data;
    for (unsigned i = 0; i < size * 3; ++i) data += static_cast<char>(i * 7 + 1);
    FILE* f = tmpfile();
    SystemFWrite(data.data(), size, 3, f);
    std::string file = StreamText(f), back(data.size(), '\0');
    for (unsigned i = 0; i < data.size(); ++i) EXPECT_EQ(file[i], data[i / size * size + size - 1 - i % size]) << size;
    rewind(f);
    EXPECT_EQ(SystemFRead(back.data(), size, 3, f), 3);
    EXPECT_EQ(back, data);
    fclose(f);
  }
  FILE* f = tmpfile();
  fwrite("ABCDEFGHI", 1, 9, f);  // two items and one stray byte
  rewind(f);
  char data[13] = "............";
  EXPECT_EQ(SystemFRead(data, 4, 3, f), 0);
  EXPECT_STREQ(data, "DCBAHGFE....");
  rewind(f);
  EXPECT_EQ(SystemFRead(data, 1, 12, f) * 10 + SystemFRead(data, 8, 0, f), 90);  // plain bytes: fread's count
  PortTest::AllocFailureGuard guard;
  PortTest::FailAllAllocs();
  char item[24] = {1};
  fseek(f, 0, SEEK_END);
  SystemFWrite(item, 24, 1, f);  // no memory for a large item: nothing written
  SystemFWrite(item, 16, 1, f);  // small items need no memory
  EXPECT_EQ(StreamText(f).size(), 9 + 16u);
  EXPECT_EQ(SystemFRead(item, 24, 1, f), 0);
  fclose(f);
}

TEST(SystemCd, ChangesAndPrintsToAStreamOrTheMessageManager) {
  TempDir dir;
  std::string here = std::filesystem::canonical(dir.path).string();
  FILE* f = tmpfile();
  PortTest::Capture cap;
  EXPECT_EQ(SystemCd(f, dir.path.c_str()), 1);
  EXPECT_EQ(SystemPwd(f), 1);
  // A missing directory, or a name too long for the directory buffer: not changed.
  EXPECT_EQ(SystemCd(f, (dir / "missing").c_str()) + SystemCd(f, std::string(1024, 'd').c_str()), 2);
  std::string failed = "Error - Cannot change Dir, Dir not changed\nCurrent Dir is : " + here + "\n";
  std::string printed = "Current Dir is : " + here + "\n" + here + "\n" + failed + failed;
  EXPECT_EQ(StreamText(f), printed);
  EXPECT_EQ(cap.size(), 0u);
  MainEVarOutFile = f;  // the main output: reports instead
  EXPECT_EQ(SystemCd(f, "no/such/dir"), 1);
  EXPECT_EQ(SystemPwd(f), 1);
  EXPECT_EQ(Reports(cap, "../s/system"), "4:Cannot change Dir, Dir not changed\n2:Current Dir is : " + here + "\n2:" +
                                             here + "\n");
  EXPECT_EQ(StreamText(f), printed);
  MainEVarOutFile = nullptr;
  fclose(f);
}

TEST(SystemMisc, MemoryTempPathCommandAndEnvironment) {
  FILE* f = tmpfile();
  SystemMemoryPrint(f, C("mem"));
  std::string text = StreamText(f);
  unsigned figure = 0;
  ASSERT_EQ(sscanf(text.c_str(), "\nmem : %u", &figure), 1) << text;
  EXPECT_TRUE(figure > 0 && text == "\nmem : " + std::to_string(figure) + "\n");
  fclose(f);
  for (auto [tmpdir, path] : {std::pair<std::string, std::string>{"", "/tmp/"}, {"/scratch/me", "/scratch/me/"},
                              {"/scratch/", "/scratch/"}, {std::string(1022, 'x'), std::string(1022, 'x') + "/"},
                              {std::string(1023, 'x'), ""}}) {  // no room for the '/'
    setenv("TMPDIR", tmpdir.c_str(), 1);
    EXPECT_EQ(Owned(SystemGetTempPath()), path) << tmpdir;
  }
  unsetenv("TMPDIR");
  EXPECT_EQ(Owned(SystemGetTempPath()), "/tmp/");
  TempDir dir;
  SystemCmd(("echo hi > " + (dir / "out")).c_str());
  EXPECT_EQ(ReadFile(dir / "out"), "hi\n");
  setenv("DUDUZU_SYSTEM_TEST", "v1", 1);
  EXPECT_STREQ(SystemGetEnv("DUDUZU_SYSTEM_TEST"), "v1");
  EXPECT_TRUE(!SystemGetEnv("DUDUZU_SYSTEM_TEST_UNSET") && !SystemGetEnv(nullptr));
}

#include <gtest/gtest.h>

#include <cstdlib>
#include <cstring>
#include <filesystem>
#include <string>

#include "duduzu/session.h"
#include "duduzu/str.h"
#include "duduzu/system.h"
#include "port/port_testing.h"
#include "support/temp_dir.h"

namespace {

std::string Canonical(const TempDir& dir) {
  return std::filesystem::canonical(dir.path).string();
}

std::string TempPath() {
  char* p = SystemGetTempPath();
  std::string r = p;
  StrFree(&p);
  return r;
}

}  // namespace

TEST(SystemIRint, HalvesAwayFromZero) {
  EXPECT_EQ(SystemIRint(0.5f), 1);
  EXPECT_EQ(SystemIRint(-0.5f), -1);
  EXPECT_EQ(SystemIRint(1.49f), 1);
  EXPECT_EQ(SystemIRint(-1.5f), -2);
  EXPECT_EQ(SystemIRint(2.5f), 3);
  EXPECT_EQ(SystemIRint(-2.5f), -3);
  EXPECT_EQ(SystemIRint(2.4999f), 2);
  EXPECT_EQ(SystemIRint(-2.4999f), -2);
  EXPECT_EQ(SystemIRint(0.0f), 0);
}

TEST(SystemGetPID, FromTheClockOnceThenCached) {
  SystemSetClock([]() -> long long { return 1234567; });
  EXPECT_EQ(SystemGetPID(), 457);
  SystemSetClock([]() -> long long { return 9980; });
  EXPECT_EQ(SystemGetPID(), 457);  // kept for the whole process
}

TEST(SystemGetPID, RealClockInRange) {
  int pid = SystemGetPID();
  EXPECT_GE(pid, 1);
  EXPECT_LE(pid, 1000);
  EXPECT_EQ(SystemGetPID(), pid);
}

TEST(SystemBinary, FourByteItemIsReversedInTheFile) {
  FILE* f = tmpfile();
  char item[4] = {1, 2, 3, 4};
  SystemFWrite(item, 4, 1, f);
  EXPECT_EQ(StreamText(f), std::string("\x04\x03\x02\x01", 4));
  rewind(f);
  char back[4] = {};
  EXPECT_EQ(SystemFRead(back, 4, 1, f), 1);
  EXPECT_EQ(memcmp(back, item, 4), 0);
  fclose(f);
}

TEST(SystemBinary, RoundTripsForEverySize) {
  for (unsigned size : {1u, 2u, 4u, 8u, 16u, 32u}) {
    SCOPED_TRACE(size);
    const unsigned n = 3;
    std::string data;
    for (unsigned i = 0; i < size * n; ++i) data += static_cast<char>(i * 7 + 1);
    FILE* f = tmpfile();
    SystemFWrite(data.data(), size, n, f);
    std::string file = StreamText(f);
    ASSERT_EQ(file.size(), data.size());
    // Each item's first byte is the last in the file.
    EXPECT_EQ(file[size - 1], data[0]);
    EXPECT_EQ(file[0], data[size - 1]);
    rewind(f);
    std::string back(data.size(), '\0');
    EXPECT_EQ(SystemFRead(back.data(), size, n, f), static_cast<int>(n));
    EXPECT_EQ(back, data);
    fclose(f);
  }
}

TEST(SystemBinary, ShortReadStoresWholeItemsAndGivesZero) {
  FILE* f = tmpfile();
  fwrite("ABCDEFGHI", 1, 9, f);  // two items and one stray byte
  rewind(f);
  char data[13] = "............";
  EXPECT_EQ(SystemFRead(data, 4, 3, f), 0);
  EXPECT_STREQ(data, "DCBAHGFE....");  // the incomplete third item is not stored
  rewind(f);
  EXPECT_EQ(SystemFRead(data, 1, 12, f), 9);  // plain bytes: fread's count
  EXPECT_EQ(SystemFRead(data, 8, 0, f), 0);
  fclose(f);
}

TEST(SystemBinary, LargeItemWithoutMemory) {
  FILE* f = tmpfile();
  char item[32] = {1};
  {
    PortTest::AllocFailureGuard guard;
    PortTest::FailAllAllocs();
    SystemFWrite(item, 32, 1, f);
    EXPECT_EQ(StreamText(f), "");
    SystemFWrite(item, 16, 1, f);  // small items need no memory
    EXPECT_EQ(StreamText(f).size(), 16u);
    rewind(f);
    EXPECT_EQ(SystemFRead(item, 32, 1, f), 0);
  }
  fclose(f);
}

TEST(SystemCd, ChangesAndPrintsToAStream) {
  TempDir dir;
  FILE* f = tmpfile();
  PortTest::Capture cap;
  EXPECT_EQ(SystemCd(f, dir.path.c_str()), 1);
  EXPECT_EQ(SystemPwd(f), 1);
  EXPECT_EQ(StreamText(f), "Current Dir is : " + Canonical(dir) + "\n" + Canonical(dir) + "\n");
  EXPECT_EQ(cap.size(), 0u);
  fclose(f);
}

TEST(SystemCd, FailedChangeKeepsTheDirectory) {
  TempDir dir;
  ASSERT_EQ(chdir(dir.path.c_str()), 0);
  std::string expected = "Error - Cannot change Dir, Dir not changed\nCurrent Dir is : " +
                         Canonical(dir) + "\n";
  FILE* f = tmpfile();
  EXPECT_EQ(SystemCd(f, (dir / "missing").c_str()), 1);
  EXPECT_EQ(StreamText(f), expected);
  fclose(f);
  // A name too long for the directory buffer fails the same way.
  f = tmpfile();
  std::string longName(1024, 'd');
  EXPECT_EQ(SystemCd(f, longName.c_str()), 1);
  EXPECT_EQ(StreamText(f), expected);
  fclose(f);
}

TEST(SystemCd, MainOutputGoesToTheMessageManager) {
  TempDir dir;
  ASSERT_EQ(chdir(dir.path.c_str()), 0);
  PortTest::Capture cap;
  FILE* f = tmpfile();
  MainEVarOutFile = f;
  EXPECT_EQ(SystemCd(f, "no/such/dir"), 1);
  ASSERT_EQ(cap.size(), 2u);
  EXPECT_EQ(cap[0].level, Port_Error);
  EXPECT_EQ(cap[0].text, "Cannot change Dir, Dir not changed\n");
  EXPECT_EQ(cap[0].unit, "../s/system");
  EXPECT_EQ(cap[1].level, Port_Status);
  EXPECT_EQ(cap[1].text, "Current Dir is : " + Canonical(dir) + "\n");
  EXPECT_EQ(SystemPwd(f), 1);
  ASSERT_EQ(cap.size(), 3u);
  EXPECT_EQ(cap[2].level, Port_Status);
  EXPECT_EQ(cap[2].text, Canonical(dir) + "\n");
  EXPECT_EQ(StreamText(f), "");
  MainEVarOutFile = nullptr;
  fclose(f);
}

TEST(SystemMemory, PrintFormatAndFigure) {
  FILE* f = tmpfile();
  char label[] = "mem";
  SystemMemoryPrint(f, label);
  std::string text = StreamText(f);
  unsigned figure = 0;
  ASSERT_EQ(sscanf(text.c_str(), "\nmem : %u", &figure), 1) << text;
  EXPECT_GT(figure, 0u);
  EXPECT_EQ(text, "\nmem : " + std::to_string(figure) + "\n");
  fclose(f);
}

TEST(SystemGetTempPath, EndsWithASlash) {
  unsetenv("TMPDIR");
  EXPECT_EQ(TempPath(), "/tmp/");
  setenv("TMPDIR", "", 1);
  EXPECT_EQ(TempPath(), "/tmp/");
  setenv("TMPDIR", "/scratch/me", 1);
  EXPECT_EQ(TempPath(), "/scratch/me/");
  setenv("TMPDIR", "/scratch/", 1);
  EXPECT_EQ(TempPath(), "/scratch/");  // no second slash
  setenv("TMPDIR", std::string(1022, 'x').c_str(), 1);
  EXPECT_EQ(TempPath().size(), 1023u);
  setenv("TMPDIR", std::string(1023, 'x').c_str(), 1);  // no room for the '/'
  EXPECT_EQ(TempPath(), "");
}

TEST(SystemMisc, CommandEnvironmentAndConstants) {
  TempDir dir;
  SystemCmd(("echo hi > " + (dir / "out")).c_str());
  EXPECT_EQ(ReadFile(dir / "out"), "hi\n");
  setenv("DUDUZU_SYSTEM_TEST", "v1", 1);
  EXPECT_STREQ(SystemGetEnv("DUDUZU_SYSTEM_TEST"), "v1");
  EXPECT_EQ(SystemGetEnv("DUDUZU_SYSTEM_TEST_UNSET"), nullptr);
  EXPECT_EQ(SystemGetEnv(nullptr), nullptr);
}

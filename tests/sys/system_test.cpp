#include <gtest/gtest.h>

#include <filesystem>

#include "duduzu/session.h"
#include "duduzu/system.h"
#include "support/owned.h"
#include "support/reports.h"
#include "support/temp_dir.h"

// Each item's bytes are reversed in the file, for any size; a short read stores whole items only.
TEST(SystemBinary, RoundTripsShortReadsAndNoMemory) {
  for (unsigned size : {1u, 2u, 4u, 16u, 32u}) {
    std::string data, reversed, back(size * 3, '\0');
    for (unsigned i = 0; i < size * 3; ++i)
      data += char(i * 7 + 1), reversed += char((i / size * size + size - 1 - i % size) * 7 + 1);
    FILE* f = tmpfile();
    SystemFWrite(data.data(), size, 3, f);
    EXPECT_EQ(StreamText(f), reversed) << size;
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
  PortTest::AllocFailureGuard guard;
  PortTest::FailAllAllocs();
  char item[24] = {1};
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
  EXPECT_EQ(SystemCd(f, dir.path.c_str()) + SystemPwd(f), 2);
  // A missing directory, or a name too long for the directory buffer: not changed.
  EXPECT_EQ(SystemCd(f, (dir / "missing").c_str()) + SystemCd(f, std::string(1024, 'd').c_str()), 2);
  std::string failed = "Error - Cannot change Dir, Dir not changed\nCurrent Dir is : " + here + "\n";
  EXPECT_EQ(StreamText(f), "Current Dir is : " + here + "\n" + here + "\n" + failed + failed);
  MainEVarOutFile = f;  // the main output: reports instead
  EXPECT_EQ(SystemCd(f, "no/such/dir") + SystemPwd(f), 2);
  EXPECT_EQ(Reports(cap, "../s/system"), "4:Cannot change Dir, Dir not changed\n2:Current Dir is : " + here + "\n2:" +
                                             here + "\n");
}

TEST(SystemMisc, RoundingPidMemoryAndTempPath) {
  for (auto [x, r] : {std::pair{0.5f, 1}, {-0.5f, -1}, {1.49f, 1}, {-1.5f, -2}, {2.5f, 3}, {-2.4999f, -2}, {0.0f, 0}})
    EXPECT_EQ(SystemIRint(x), r) << x;
  SystemSetClock([]() -> long long { return 1234567; });
  EXPECT_EQ(SystemGetPID(), 457);
  SystemSetClock([]() -> long long { return 9980; });
  EXPECT_EQ(SystemGetPID(), 457);  // kept for the whole process
  FILE* f = tmpfile();
  SystemMemoryPrint(f, C("mem"));
  unsigned figure = 0;
  EXPECT_EQ(sscanf(StreamText(f).c_str(), "\nmem : %u", &figure), 1);
  EXPECT_EQ(StreamText(f), "\nmem : " + std::to_string(std::max(figure, 1u)) + "\n");  // a positive figure
  for (auto [tmpdir, path] : {std::pair<std::string, std::string>{"", "/tmp/"}, {"/scratch/", "/scratch/"},
                              {std::string(1022, 'x'), std::string(1022, 'x') + "/"}, {std::string(1023, 'x'), ""}}) {
    setenv("TMPDIR", tmpdir.c_str(), 1);  // the last has no room for the '/'
    EXPECT_EQ(Owned(SystemGetTempPath()), path) << tmpdir;
  }
}

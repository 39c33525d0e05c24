#include <gtest/gtest.h>

#include <cstdlib>

#include "duduzu/strname.h"
#include "owned_strings.h"
#include "port/port_testing.h"

namespace {
std::string Compose(const char* name, const char* dir, const char* suffix, const char* ext, int mode) {
  return Take(StrComposeName(const_cast<char*>(name), dir, suffix, ext, mode));
}
std::string Expand(const char* s) { return Take(StrReplaceEnvVariable(const_cast<char*>(s))); }
}  // namespace

TEST(StrComposeName, ModeTable) {
  const char* withExt[] = {"out/top_x.log", "out/top_x.log", "src/out/top_x.log", "out/top_x.log", "out/src/_x.log"};
  const char* noExt[] = {"out/top_x", "out/top_x.v", "src/out/top_x.v", "out/top_x", "out/src/_x"};
  for (int mode = 0; mode <= 4; ++mode) {
    EXPECT_EQ(Compose("src/top.v", "out/", "_x", "log", mode), withExt[mode]) << mode;
    EXPECT_EQ(Compose("src/top.v", "out/", "_x", nullptr, mode), noExt[mode]) << mode;
    EXPECT_EQ(Compose(nullptr, "out/", "_x", "log", mode), "out/_x.log") << mode;
  }
  EXPECT_EQ(Compose("src/top.v", "out/", "_x", "log", 5), "<null>");
  EXPECT_EQ(Compose("src/top.v", "out/", "_x", "log", -1), "<null>");
}

TEST(StrComposeName, PiecesAndBoundaries) {
  EXPECT_EQ(Compose("top.v", "o/", nullptr, ".log", 0), "o/top.log");
  EXPECT_EQ(Compose("top.v", "o/", nullptr, "", 0), "o/top.");
  EXPECT_EQ(Compose("top.v", nullptr, nullptr, nullptr, 4), "<null>");
  EXPECT_EQ(Compose(nullptr, "", nullptr, nullptr, 0), "");  // an empty piece is a piece
  EXPECT_EQ(Compose("top", "../out/", "_x", "log", 2), "../out/top_x.log");
  EXPECT_EQ(Compose("a.d/top", "o/", nullptr, nullptr, 2), "a.d/o/top");
  EXPECT_EQ(Compose("a\\b/c.v", "d/", nullptr, nullptr, 0), "d/b/c");  // the backslash wins
  EXPECT_EQ(Compose("archive.tar.gz", nullptr, nullptr, "zip", 0), "archive.tar.zip");
  EXPECT_EQ(Take(StrComposeBaseName("x\\y.z.w/v")), "y");
  EXPECT_EQ(Take(StrComposeBaseName("a/")), "");
  EXPECT_EQ(StrComposeBaseName(nullptr), nullptr);
}

TEST(StrReplaceEnvVariable, References) {
  setenv("A", "1", 1);
  setenv("A$B", "v", 1);
  unsetenv("B");
  EXPECT_EQ(Expand("$A/$B"), "1/$B");
  EXPECT_EQ(Expand("$A$B/x"), "v/x");  // one name, "A$B"
  EXPECT_EQ(Expand("p\\$A\\q$A"), "p\\1\\q1");
  EXPECT_EQ(Expand("$B/x"), "<null>");
  EXPECT_EQ(Expand("abc"), "<null>");
  EXPECT_EQ(StrReplaceEnvVariable(nullptr), nullptr);
  PortTest::AllocFailureGuard guard;
  PortTest::FailNthAlloc(2);
  EXPECT_EQ(Expand("$A/x"), "<null>");  // the result; the work copy is still released
}

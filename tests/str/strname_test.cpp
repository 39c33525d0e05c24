#include <gtest/gtest.h>

#include <cstdlib>
#include <string>

#include "duduzu/str.h"
#include "duduzu/strname.h"
#include "port/port_testing.h"

namespace {

std::string Take(char* s) {
  std::string r = s ? s : "<null>";
  StrFree(&s);
  return r;
}

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
}

TEST(StrComposeName, PiecesAndBoundaries) {
  EXPECT_EQ(Compose("src/top.v", "out/", "_x", ".log", 0), "out/top_x.log");
  EXPECT_EQ(Compose("src/top.v", "out/", "_x", "", 0), "out/top_x.");
  EXPECT_EQ(Compose("src/top.v", "out/", "_x", "log", 5), "<null>");
  EXPECT_EQ(Compose("src/top.v", "out/", "_x", "log", -1), "<null>");
  EXPECT_EQ(Compose("top.v", nullptr, nullptr, nullptr, 4), "<null>");
  EXPECT_EQ(Compose(nullptr, nullptr, nullptr, nullptr, 0), "<null>");
  EXPECT_EQ(Compose(nullptr, "", nullptr, nullptr, 0), "");  // an empty piece is a piece
  EXPECT_EQ(Compose(".v", nullptr, nullptr, nullptr, 0), "");
  EXPECT_EQ(Compose("top", "../out/", "_x", "log", 2), "../out/top_x.log");
  EXPECT_EQ(Compose("a.d/top", "o/", nullptr, nullptr, 2), "a.d/o/top");
  EXPECT_EQ(Compose("a\\b/c.v", "d/", nullptr, nullptr, 0), "d/b/c");  // backslash wins
  EXPECT_EQ(Compose("archive.tar.gz", nullptr, nullptr, "zip", 0), "archive.tar.zip");
}

TEST(StrComposeBaseName, FilePartToFirstDot) {
  EXPECT_EQ(Take(StrComposeBaseName("a/b.c.d")), "b");
  EXPECT_EQ(Take(StrComposeBaseName("a/b")), "b");
  EXPECT_EQ(Take(StrComposeBaseName("a/")), "");
  EXPECT_EQ(Take(StrComposeBaseName("x\\y.z/w")), "y");
  EXPECT_EQ(StrComposeBaseName(nullptr), nullptr);
}

TEST(StrReplaceEnvVariable, References) {
  setenv("HOME", "/h", 1);
  setenv("A", "1", 1);
  setenv("A$B", "v", 1);
  unsetenv("B");
  EXPECT_EQ(Expand("$HOME/x"), "/h/x");
  EXPECT_EQ(Expand("$A/$B"), "1/$B");
  EXPECT_EQ(Expand("$A$B/x"), "v/x");
  EXPECT_EQ(Expand("p\\$A\\q$A"), "p\\1\\q1");
  EXPECT_EQ(Expand("$B/x"), "<null>");
  EXPECT_EQ(Expand("abc"), "<null>");
  EXPECT_EQ(StrReplaceEnvVariable(nullptr), nullptr);
  unsetenv("HOME");
  EXPECT_EQ(Expand("$HOME/x"), "<null>");
}

TEST(StrName, AllocationFailureGivesNull) {
  setenv("A", "1", 1);
  PortTest::AllocFailureGuard guard;
  for (long n = 1; n <= 2; ++n) {
    PortTest::FailNthAlloc(n);
    EXPECT_EQ(Expand("$A/x"), "<null>") << n;  // work copy, then result
  }
  PortTest::FailAllAllocs();
  EXPECT_EQ(Compose("src/top.v", "out/", "_x", "log", 0), "<null>");
  EXPECT_EQ(StrComposeBaseName("a/b"), nullptr);
}

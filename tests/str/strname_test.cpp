#include <gtest/gtest.h>

#include "duduzu/strname.h"
#include "port/port_testing.h"
#include "support/owned.h"

static std::string Compose(const char* name, const char* dir, const char* suffix, const char* ext, int mode) {
  return Owned(StrComposeName(C(name), dir, suffix, ext, mode));
}

TEST(StrName, ComposeModesBoundariesBaseNameAndEnvironment) {
  const char* withExt[] = {"out/top_x.log", "out/top_x.log", "src/out/top_x.log", "out/top_x.log", "out/src/_x.log"};
  const char* noExt[] = {"out/top_x", "out/top_x.v", "src/out/top_x.v", "out/top_x", "out/src/_x"};
  for (int mode = 0; mode <= 4; ++mode)
    EXPECT_EQ(Compose("src/top.v", "out/", "_x", "log", mode) + " " +
                  Compose("src/top.v", "out/", "_x", nullptr, mode) + " " + Compose(nullptr, "out/", "_x", "log", mode),
              withExt[mode] + std::string(" ") + noExt[mode] + " out/_x.log");
  EXPECT_EQ(Compose("t.v", "o/", "", "g", 5) + Compose("t.v", "o/", "", "g", -1) +
                Compose("t.v", nullptr, nullptr, nullptr, 4) + Compose("top.v", "o/", nullptr, ".log", 0) + "|" +
                Compose("top.v", "o/", nullptr, "", 0) + "|" + Compose(nullptr, "", nullptr, nullptr, 0),
            "<null><null><null>o/top.log|o/top.|");  // nothing made: no string; an empty piece is a piece
  EXPECT_EQ(Compose("a.d/top", "o/", nullptr, nullptr, 2), "a.d/o/top");  // a dot in a directory is no extension
  EXPECT_EQ(Owned(StrComposeBaseName("x\\y.z.w/v")) + "|" + Owned(StrComposeBaseName("a/")) + "|" +
                Owned(StrComposeBaseName(nullptr)),
            "y||<null>");
  setenv("A", "1", 1);
  setenv("A$B", "v", 1);
  unsetenv("B");
  auto expand = [](const char* s) { return Owned(StrReplaceEnvVariable(C(s))); };
  EXPECT_EQ(expand("$A/$B") + "|" + expand("$A$B/x"), "1/$B|v/x");  // "A$B" is one name
  EXPECT_EQ(expand("p\\$A\\q$A") + "|" + expand("$B/x") + "|" + expand("abc") + "|" + expand(nullptr),
            "p\\1\\q1|<null>|<null>|<null>");
  PortTest::AllocFailureGuard guard;
  PortTest::FailNthAlloc(2);
  EXPECT_EQ(expand("$A/x"), "<null>");  // the result; the work copy is still released
}

#include <cstring>

#include "duduzu/strname.h"
#include "str_test_util.h"

TEST(StrBase, CompareEditReadNameAndSafeCats) {
  using Pair = std::tuple<int (*)(const char*, const char*), const char*, const char*, int>;
  for (auto [fn, a, b, want] :
       {Pair{StrCmpRobust, nullptr, nullptr, 1}, {StrCmpNoCase, nullptr, "x", 1}, {StrIdentical, "a", nullptr, 0},
        {StrIdentical, "ABC", "abc", 1}, {StrCaseIdentical, "ABC", "abc", 0}, {StrCmpRobust, "\xe9", "a", 1}})
    EXPECT_EQ(fn(a, b), want) << (a ? a : "null") << " " << (b ? b : "null");
  EXPECT_LT(StrCmpNoCase("a_b", "aBc"), 0);  // lower-case forms: '_' sorts before letters
  // Null entries are passed over; the count limits the search.
  EXPECT_EQ(StrInEnumOfStrNC("b", 3, "A", nullptr, "B") + StrInEnumOfStrNC("b", 2, "a", "c", "b"), 3);
  char buf[16] = "fix";
  StrLeftCat(C("pre"), buf);  // overlapping move to the right
  EXPECT_EQ(buf + std::string(StrChrSlash("a\\b/c")), "prefix\\b/c");  // a backslash wins over a later slash
  auto cut = [](const char* in) { char* p = C(in); StrRemoveDoubleSlash(&p); return std::string(p); };
  EXPECT_EQ(cut("a/b//c/d") + "|" + cut("//abc") + "|" + cut("abc") + "|" + cut("a//"), "c/d|abc|abc|");
  for (auto [n, digits] : {std::pair{9, 1}, {10, 2}, {2147483647, 10}, {-1, -1}}) EXPECT_EQ(StrIntNbOfChar(n), digits);
  FILE* f = tmpfile();
  fputs(" abcdefgh\tx", f);
  rewind(f);
  auto read = [&](int n) { return std::to_string(StrReadName(buf, n, f)) + ":" + buf; };
  EXPECT_EQ(read(10), "32:");    // leading white space: empty word
  EXPECT_EQ(read(6), "9:abcd");  // n - 2 characters of a word that does not fit
  EXPECT_EQ(read(6), "0:x");     // end of stream: the word read so far
  PortTest::Capture cap;
  char* p = nullptr;
  StrSafeCatPX(&p, "");
  ASSERT_NE(p, nullptr);  // a new empty string, not NULL
  StrSafeCatPX(&p, "ab");
  StrSafeCatPX(&p, p);
  StrSafeCatPX(&p, nullptr);
  char fit[10] = "abcd";
  StrSafeCatTX(fit, "efgh", 10);
  EXPECT_EQ(Reports(cap) + fit, "0:Data corruption (StrSafeCatPX) - Null string\nabcdefgh");
  strcpy(fit, "abcd");
  StrSafeCatTX(fit, "efghi", 10);  // exactly fills: warned
  EXPECT_EQ(Reports(cap) + fit, "1:Name truncation in StrSafeCatTX : abcd\nabcdefghi");
  StrSafeCatTX(nullptr, "x", 4);
  EXPECT_EQ(StrSafeCopyTX(fit, "abcd", 4, 1) + StrSafeCopyTX(fit, "", 0, 1), 0);  // size 0: not even a terminator
  EXPECT_EQ(StrSafeCopyTX(nullptr, "a", 4, 1), 0);
  EXPECT_EQ(Reports(cap) + fit, "0:Data corruption (StrSafeCatTX) - Null string\n0:Data corruption (StrSafeCopyTX) - "
                                "String overflow\n0:Data corruption (StrSafeCopyTX) - String overflow\n"
                                "0:Data corruption (StrSafeCopyTX) - Null string\nabcdefghi");
  EXPECT_EQ(StrSafeCopyTX(fit, "abc", 4, 1), 1);
  EXPECT_STREQ(fit, "abc");
  PortTest::AllocFailureGuard guard;
  PortTest::FailNthAlloc(1);
  StrSafeCatPX(&p, "y");  // no memory: the string stays as it was
  EXPECT_EQ(Owned(p), "abab");
}

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

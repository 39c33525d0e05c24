#include <cstring>
#include <tuple>

#include "duduzu/session.h"
#include "str_test_util.h"
#include "support/temp_dir.h"

TEST(StrCompare, NullRulesOrderAndCase) {
  using Pair = std::tuple<int (*)(const char*, const char*), const char*, const char*, int>;
  for (auto [fn, a, b, want] :
       {Pair{StrCmpRobust, nullptr, nullptr, 1}, {StrCmpRobust, "a", nullptr, 1}, {StrCmpNoCase, nullptr, nullptr, 0},
        {StrCmpNoCase, nullptr, "x", 1}, {StrIdentical, nullptr, nullptr, 1}, {StrIdentical, "a", nullptr, 0},
        {StrIdentical, "ABC", "abc", 1}, {StrCaseIdentical, nullptr, "a", 0}, {StrCaseIdentical, "ABC", "abc", 0},
        {StrCmpRobust, "ab", "abc", -1}, {StrCmpRobust, "\xe9", "a", 1}})
    EXPECT_EQ(fn(a, b), want) << (a ? a : "null") << " " << (b ? b : "null");
  EXPECT_LT(StrCmpNoCase("a_b", "aBc"), 0);  // lower-case forms: '_' sorts before letters
  // Null entries are passed over; the count limits the search.
  EXPECT_EQ(StrInEnumOfStrNC("b", 3, "A", nullptr, "B") + StrInEnumOfStrNC("b", 2, "a", "c", "b"), 3);
}

TEST(StrEdit, PrependSlashesDigits) {
  char buf[16] = "fix";
  StrLeftCat(C("pre"), buf);  // overlapping move to the right
  EXPECT_EQ(buf + std::string(StrChrSlash("a\\b/c")), "prefix\\b/c");  // a backslash wins over a later slash
  for (auto [in, out] : {std::pair{"a/b//c/d", "c/d"}, {"//abc", "abc"}, {"abc", "abc"}, {"a//", ""}}) {
    char* p = C(in);
    StrRemoveDoubleSlash(&p);
    EXPECT_STREQ(p, out) << in;
  }
  for (auto [n, digits] : {std::pair{9, 1}, {10, 2}, {2147483647, 10}, {-1, -1}}) EXPECT_EQ(StrIntNbOfChar(n), digits);
}

TEST(StrStream, ReadNameAndPrintByMainOutputRule) {
  char buf[10];
  FILE *f = tmpfile(), *main = tmpfile();
  fputs(" abcdefgh\tx", f);
  rewind(f);
  auto read = [&](int n) { return std::to_string(StrReadName(buf, n, f)) + ":" + buf; };
  EXPECT_EQ(read(10), "32:");    // leading white space: empty word
  EXPECT_EQ(read(6), "9:abcd");  // n - 2 characters of a word that does not fit
  EXPECT_EQ(read(6), "0:x");     // end of stream: the word read so far
  MainEVarOutFile = main;
  PortTest::Capture cap;
  StrPrint(f, "50%d");
  StrPrint(main, "100%s");  // never used as a format
  EXPECT_EQ(Reports(cap), "2:100%s");
  EXPECT_EQ(StreamText(f), " abcdefgh\tx50%d");
}

TEST(StrHeap, SafeCatPXSelfAppendNullAndNoMemory) {
  char* p = nullptr;
  StrSafeCatPX(&p, "");
  ASSERT_NE(p, nullptr);  // a new empty string, not NULL
  StrSafeCatPX(&p, "ab");
  StrSafeCatPX(&p, p);
  PortTest::Capture cap;
  StrSafeCatPX(&p, nullptr);
  EXPECT_EQ(Reports(cap), "0:Data corruption (StrSafeCatPX) - Null string\n");
  PortTest::AllocFailureGuard guard;
  PortTest::FailNthAlloc(1);
  StrSafeCatPX(&p, "y");  // no memory: the string stays as it was
  EXPECT_EQ(Owned(p), "abab");
}

TEST(StrBounded, SafeCatTXAndSafeCopyTX) {
  PortTest::Capture cap;
  char buf[10] = "abcd";
  StrSafeCatTX(buf, "efgh", 10);
  StrSafeCatTX(buf, nullptr, 10);
  EXPECT_EQ(Reports(cap), "");
  for (const char* src : {"efghi", "efghij"}) {  // exactly fills, or loses one: both warned
    strcpy(buf, "abcd");
    StrSafeCatTX(buf, src, 10);
    EXPECT_EQ(Reports(cap) + buf, "1:Name truncation in StrSafeCatTX : abcd\nabcdefghi");
  }
  StrSafeCatTX(nullptr, "x", 4);
  EXPECT_EQ(StrSafeCopyTX(buf, "abcd", 4, 1) + StrSafeCopyTX(buf, "", 0, 1), 0);  // size 0: not even a terminator
  EXPECT_EQ(StrSafeCopyTX(nullptr, "a", 4, 1), 0);
  EXPECT_EQ(Reports(cap) + buf, "0:Data corruption (StrSafeCatTX) - Null string\n"
                                "0:Data corruption (StrSafeCopyTX) - String overflow\n"
                                "0:Data corruption (StrSafeCopyTX) - String overflow\n"
                                "0:Data corruption (StrSafeCopyTX) - Null string\nabcdefghi");
  EXPECT_EQ(StrSafeCopyTX(buf, "abc", 4, 1) + StrSafeCopyTX(nullptr, nullptr, 4, 1), 2);
  EXPECT_STREQ(buf, "abc");
  EXPECT_EQ(StrSafeCopyTX(buf, nullptr, 4, 1), 1);
  EXPECT_STREQ(buf, "");
}

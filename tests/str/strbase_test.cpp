#include <cstring>

#include "str_test_util.h"

TEST(StrBase, CompareEditAndReadName) {
  using Pair = std::tuple<int (*)(const char*, const char*), const char*, const char*, int>;
  for (auto [fn, a, b, want] :
       {Pair{StrCmpRobust, nullptr, nullptr, 1}, {StrCmpNoCase, nullptr, "x", 1}, {StrIdentical, "a", nullptr, 0},
        {StrIdentical, "ABC", "abc", 1}, {StrCaseIdentical, "ABC", "abc", 0}, {StrCmpRobust, "ab", "abc", -1},
        {StrCmpRobust, "\xe9", "a", 1}})
    EXPECT_EQ(fn(a, b), want) << (a ? a : "null") << " " << (b ? b : "null");
  EXPECT_LT(StrCmpNoCase("a_b", "aBc"), 0);  // lower-case forms: '_' sorts before letters
  // Null entries are passed over; the count limits the search.
  EXPECT_EQ(StrInEnumOfStrNC("b", 3, "A", nullptr, "B") + StrInEnumOfStrNC("b", 2, "a", "c", "b"), 3);
  char buf[16] = "fix";
  StrLeftCat(C("pre"), buf);  // overlapping move to the right
  EXPECT_EQ(buf + std::string(StrChrSlash("a\\b/c")), "prefix\\b/c");  // a backslash wins over a later slash
  auto undouble = [](const char* in) { char* p = C(in); StrRemoveDoubleSlash(&p); return std::string(p); };
  EXPECT_EQ(undouble("a/b//c/d") + "|" + undouble("//abc") + "|" + undouble("abc") + "|" + undouble("a//"), "c/d|abc|abc|");
  for (auto [n, digits] : {std::pair{9, 1}, {10, 2}, {2147483647, 10}, {-1, -1}}) EXPECT_EQ(StrIntNbOfChar(n), digits);
  FILE* f = tmpfile();
  fputs(" abcdefgh\tx", f);
  rewind(f);
  auto read = [&](int n) { return std::to_string(StrReadName(buf, n, f)) + ":" + buf; };
  EXPECT_EQ(read(10), "32:");    // leading white space: empty word
  EXPECT_EQ(read(6), "9:abcd");  // n - 2 characters of a word that does not fit
  EXPECT_EQ(read(6), "0:x");     // end of stream: the word read so far
}

TEST(StrSafeCat, HeapAndBoundedCopiesNullsOverflowAndNoMemory) {
  PortTest::Capture cap;
  char* p = nullptr;
  StrSafeCatPX(&p, "");
  ASSERT_NE(p, nullptr);  // a new empty string, not NULL
  StrSafeCatPX(&p, "ab");
  StrSafeCatPX(&p, p);
  StrSafeCatPX(&p, nullptr);
  char buf[10] = "abcd";
  StrSafeCatTX(buf, "efgh", 10);
  StrSafeCatTX(buf, nullptr, 10);
  EXPECT_EQ(Reports(cap) + buf, "0:Data corruption (StrSafeCatPX) - Null string\nabcdefgh");
  for (const char* src : {"efghi", "efghij"}) {  // exactly fills, or loses one: both warned
    strcpy(buf, "abcd");
    StrSafeCatTX(buf, src, 10);
    EXPECT_EQ(Reports(cap) + buf, "1:Name truncation in StrSafeCatTX : abcd\nabcdefghi");
  }
  StrSafeCatTX(nullptr, "x", 4);
  EXPECT_EQ(StrSafeCopyTX(buf, "abcd", 4, 1) + StrSafeCopyTX(buf, "", 0, 1), 0);  // size 0: not even a terminator
  EXPECT_EQ(StrSafeCopyTX(nullptr, "a", 4, 1), 0);
  EXPECT_EQ(Reports(cap) + buf, "0:Data corruption (StrSafeCatTX) - Null string\n0:Data corruption (StrSafeCopyTX) - "
                                "String overflow\n0:Data corruption (StrSafeCopyTX) - String overflow\n"
                                "0:Data corruption (StrSafeCopyTX) - Null string\nabcdefghi");
  EXPECT_EQ(StrSafeCopyTX(buf, "abc", 4, 1), 1);
  EXPECT_STREQ(buf, "abc");
  PortTest::AllocFailureGuard guard;
  PortTest::FailNthAlloc(1);
  StrSafeCatPX(&p, "y");  // no memory: the string stays as it was
  EXPECT_EQ(Owned(p), "abab");
}

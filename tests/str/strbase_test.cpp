#include <cstring>

#include "duduzu/session.h"
#include "str_test_util.h"

namespace {

struct Pair {
  int (*fn)(const char*, const char*);
  const char *a, *b;
  int want;
};

std::string Owned(char* s) {
  std::string r = s ? s : "<null>";
  StrFree(&s);
  return r;
}

}  // namespace

TEST(StrCompare, NullRulesOrderAndCase) {
  for (auto [fn, a, b, want] :
       {Pair{StrCmpRobust, nullptr, nullptr, 1}, {StrCmpRobust, "a", nullptr, 1}, {StrCmpRobust, nullptr, "a", 1},
        {StrCmpNoCase, nullptr, nullptr, 0}, {StrCmpNoCase, nullptr, "x", 1}, {StrCmpNoCase, "x", nullptr, 1},
        {StrIdentical, nullptr, nullptr, 1}, {StrIdentical, "a", nullptr, 0}, {StrIdentical, "ABC", "abc", 1},
        {StrCaseIdentical, nullptr, nullptr, 1}, {StrCaseIdentical, nullptr, "a", 0},
        {StrCaseIdentical, "ABC", "abc", 0}, {StrCmpRobust, "ab", "abc", -1}, {StrCmpRobust, "\xe9", "a", 1}})
    EXPECT_EQ(fn(a, b), want) << (a ? a : "null") << " " << (b ? b : "null");
  EXPECT_LT(StrCmpNoCase("a_b", "aBc"), 0);  // lower-case forms: '_' sorts before letters
  EXPECT_EQ(StrInEnumOfStrNC("b", 3, "A", nullptr, "B"), 3);
  EXPECT_EQ(StrInEnumOfStrNC("b", 2, "a", "c", "b") + StrInEnumOfStrNC("b", 0, "b"), 0);  // count limits
}

TEST(StrEdit, FoldPrependSlashesRemoval) {
  char s[] = "aB_9z", buf[16] = "fix";
  const char* mixed = "a\\b/c";
  StrUpper(s);
  EXPECT_STREQ(s, "AB_9Z");
  StrLeftCat(const_cast<char*>("pre"), buf);  // overlapping move to the right
  EXPECT_STREQ(buf, "prefix");
  EXPECT_EQ(StrChrSlash(mixed), mixed + 1);  // a backslash wins over a later slash
  EXPECT_EQ(Owned(StrRemoveCharInFront(const_cast<char*>("xxaxb"), 'x')), "axb");
  EXPECT_EQ(Owned(StrRemoveChar(const_cast<char*>("a.b.c"), '.')), "abc");
  for (auto [in, out] : {std::pair{"a/b//c/d", "c/d"}, {"//abc", "abc"}, {"a/b/c", "c"}, {"abc", "abc"}, {"a//", ""}}) {
    char* p = const_cast<char*>(in);
    StrRemoveDoubleSlash(&p);
    EXPECT_STREQ(p, out) << in;
  }
  for (auto [n, digits] : {std::pair{9, 1}, {10, 2}, {2147483647, 10}, {-1, -1}}) EXPECT_EQ(StrIntNbOfChar(n), digits);
}

TEST(StrStream, ReadNameWordsCutsAndEndOfStream) {
  char buf[10];
  FILE* f = tmpfile();
  fputs(" abcdefgh\tx", f);
  rewind(f);
  EXPECT_EQ(StrReadName(buf, 10, f), ' ');  // leading white space: empty word
  EXPECT_STREQ(buf, "");
  EXPECT_EQ(StrReadName(buf, 6, f), '\t');
  EXPECT_STREQ(buf, "abcd");  // n - 2 characters of a word that does not fit
  EXPECT_EQ(StrReadName(buf, 6, f), '\0');  // end of stream: the word read so far
  EXPECT_STREQ(buf, "x");
  fclose(f);
}

TEST(StrStream, PrintByMainOutputRule) {
  char buf[16];
  FILE *main = tmpfile(), *other = tmpfile();
  MainEVarOutFile = main;
  PortTest::Capture cap;
  StrPrint(other, "50%d");
  StrPrint(main, "100%s");  // never used as a format
  ExpectOneReport(cap, Port_Status, "100%s");
  rewind(other);
  EXPECT_STREQ(fgets(buf, sizeof buf, other), "50%d");
}

TEST(StrHeap, SafeCatPXSelfAppendNullAndNoMemory) {
  char* p = nullptr;
  StrSafeCatPX(&p, "");
  ASSERT_NE(p, nullptr);  // a new empty string, not NULL
  StrSafeCatPX(&p, "ab");
  StrSafeCatPX(&p, p);
  EXPECT_STREQ(p, "abab");
  PortTest::Capture cap;
  StrSafeCatPX(&p, nullptr);
  ExpectOneReport(cap, Port_Fatal, "Data corruption (StrSafeCatPX) - Null string\n");
  PortTest::AllocFailureGuard guard;
  PortTest::FailNthAlloc(1);
  StrSafeCatPX(&p, "y");  // no memory: the string stays as it was
  EXPECT_STREQ(p, "abab");
  StrFree(&p);
  EXPECT_EQ(p, nullptr);
}

TEST(StrBounded, SafeCatTXTruncatesAndWarns) {
  PortTest::Capture cap;
  char buf[10] = "abcd";
  StrSafeCatTX(buf, "efgh", 10);
  StrSafeCatTX(buf, nullptr, 10);
  EXPECT_EQ(cap.size(), 0u);
  for (const char* src : {"efghi", "efghij"}) {  // exactly fills, or loses one: both warned
    strcpy(buf, "abcd");
    StrSafeCatTX(buf, src, 10);
    ExpectOneReport(cap, Port_Warning, "Name truncation in StrSafeCatTX : abcd\n");
    EXPECT_STREQ(buf, "abcdefghi");
  }
  StrSafeCatTX(nullptr, "x", 4);
  ExpectOneReport(cap, Port_Fatal, "Data corruption (StrSafeCatTX) - Null string\n");
}

TEST(StrBounded, SafeCopyTXRefusesWhatDoesNotFit) {
  PortTest::Capture cap;
  char buf[4] = "old";
  for (int size : {4, 0}) {  // size 0: no room even for the terminator
    EXPECT_EQ(StrSafeCopyTX(buf, size ? "abcd" : "", size, 1), 0);
    ExpectOneReport(cap, Port_Fatal, "Data corruption (StrSafeCopyTX) - String overflow\n");
    EXPECT_STREQ(buf, "old");
  }
  EXPECT_EQ(StrSafeCopyTX(buf, "abc", 4, 1) + StrSafeCopyTX(nullptr, nullptr, 4, 1), 2);
  EXPECT_STREQ(buf, "abc");
  EXPECT_EQ(StrSafeCopyTX(buf, nullptr, 4, 1), 1);
  EXPECT_STREQ(buf, "");
  EXPECT_EQ(StrSafeCopyTX(nullptr, "a", 4, 1), 0);
  ExpectOneReport(cap, Port_Fatal, "Data corruption (StrSafeCopyTX) - Null string\n");
}

#include <gtest/gtest.h>

#include <cstring>
#include <string>

#include "duduzu/session.h"
#include "duduzu/str.h"
#include "str_test_util.h"

namespace {

// A temporary stream holding text, positioned at its start.
FILE* StreamOf(const char* text) {
  FILE* f = tmpfile();
  fputs(text, f);
  rewind(f);
  return f;
}

std::string Owned(char* s) {
  std::string r = s ? s : "<null>";
  StrFree(&s);
  return r;
}

}  // namespace

TEST(StrCompare, NullRules) {
  EXPECT_EQ(StrCmpRobust(nullptr, nullptr), 1);
  EXPECT_EQ(StrCmpRobust("a", nullptr), 1);
  EXPECT_EQ(StrCmpRobust(nullptr, "a"), 1);
  EXPECT_EQ(StrCmpNoCase(nullptr, nullptr), 0);
  EXPECT_EQ(StrCmpNoCase(nullptr, "x"), 1);
  EXPECT_EQ(StrCmpNoCase("x", nullptr), 1);
  EXPECT_EQ(StrIdentical(nullptr, nullptr), 1);
  EXPECT_EQ(StrIdentical("a", nullptr), 0);
  EXPECT_EQ(StrCaseIdentical(nullptr, nullptr), 1);
  EXPECT_EQ(StrCaseIdentical(nullptr, "a"), 0);
}

TEST(StrCompare, OrderAndCase) {
  EXPECT_EQ(StrCmpRobust("ab", "abc"), -1);
  EXPECT_EQ(StrCmpRobust("b", "abc"), 1);
  EXPECT_EQ(StrCmpRobust("\xe9", "a"), 1);  // bytes compare unsigned
  EXPECT_EQ(StrIdentical("ABC", "abc"), 1);
  EXPECT_EQ(StrCaseIdentical("ABC", "abc"), 0);
  EXPECT_LT(StrCmpNoCase("_", "A"), 0);  // lower-case forms: '_' before letters
  EXPECT_LT(StrCmpNoCase("a_b", "aBc"), 0);
  EXPECT_EQ(StrCmpNoCaseN("abX", "ABy", 2), 0);
  EXPECT_EQ(StrInEnumOfStrNC("b", 3, "A", nullptr, "B"), 3);
  EXPECT_EQ(StrInEnumOfStrNC("b", 0, "b"), 0);
  EXPECT_EQ(StrInEnumOfStrNC("b", 2, "a", "c", "b"), 0);  // reads no more than count
  EXPECT_EQ(StrInEnumOfStrNC(nullptr, 1, "b"), 0);
}

TEST(StrEdit, CaseReverseFillPrepend) {
  char s[] = "aB_9z";
  StrUpper(s);
  EXPECT_STREQ(s, "AB_9Z");
  StrLower(s);
  EXPECT_STREQ(s, "ab_9z");
  StrUpper(nullptr);
  EXPECT_EQ(ToLowerStr(nullptr), nullptr);
  char t[] = "XyZ";
  EXPECT_EQ(ToLowerStr(t), t);
  EXPECT_STREQ(t, "xyz");
  StrReverse(t);
  EXPECT_STREQ(t, "zyx");
  char e[] = "";
  StrReverse(e);
  EXPECT_STREQ(e, "");
  char buf[8] = "keep";
  StrInitChar(0, 'x', buf);
  EXPECT_STREQ(buf, "");
  StrInitChar(3, 'x', buf);
  EXPECT_STREQ(buf, "xxx");
  char d[16] = "fix";
  StrLeftCat(const_cast<char*>("pre"), d);
  EXPECT_STREQ(d, "prefix");
  EXPECT_EQ(StrFirstCharIsAlpha(const_cast<char*>("")), 0);
  EXPECT_NE(StrFirstCharIsAlpha(const_cast<char*>("q1")), 0);
  EXPECT_EQ(StrIntNbOfChar(0), 1);
  EXPECT_EQ(StrIntNbOfChar(9), 1);
  EXPECT_EQ(StrIntNbOfChar(10), 2);
  EXPECT_EQ(StrIntNbOfChar(2147483647), 10);
  EXPECT_EQ(StrIntNbOfChar(-1), -1);
}

TEST(StrSearch, ChrAndRemoval) {
  char abc[] = "a/b/c";
  EXPECT_EQ(StrChr(abc, '/'), abc + 3);
  EXPECT_EQ(StrChr(abc, '\0'), nullptr);
  EXPECT_EQ(StrChr(nullptr, 'a'), nullptr);
  EXPECT_EQ(StrChr(abc, 'x'), nullptr);
  const char* mixed = "a\\b/c";
  EXPECT_EQ(StrChrSlash(mixed), mixed + 1);
  const char* fwd = "a/b/c";
  EXPECT_EQ(StrChrSlash(fwd), fwd + 3);
  EXPECT_EQ(StrChrSlash("abc"), nullptr);
  EXPECT_EQ(StrChrSlash(nullptr), nullptr);
  EXPECT_EQ(Owned(StrRemoveCharInFront(const_cast<char*>("xxaxb"), 'x')), "axb");
  EXPECT_EQ(Owned(StrRemoveChar(const_cast<char*>("a.b.c"), '.')), "abc");
  EXPECT_EQ(Owned(StrRemoveChar(const_cast<char*>(""), '.')), "");
  EXPECT_EQ(Owned(StrRemoveCharInFront(const_cast<char*>(""), 'x')), "");
  EXPECT_EQ(Owned(StrRemoveChar(const_cast<char*>("ab"), '\0')), "ab");
}

TEST(StrSearch, RemoveDoubleSlash) {
  for (auto [in, out] : {std::pair{"a/b//c/d", "c/d"}, {"//abc", "abc"}, {"a///b", "b"},
                         {"a/b/c", "c"}, {"abc", "abc"}, {"a//", ""}}) {
    char* p = const_cast<char*>(in);
    StrRemoveDoubleSlash(&p);
    EXPECT_STREQ(p, out) << in;
  }
}

TEST(StrStream, ReadNameStopsAfterWhiteSpace) {
  FILE* f = StreamOf("abc def");
  char buf[10];
  EXPECT_EQ(StrReadName(buf, 10, f), ' ');
  EXPECT_STREQ(buf, "abc");
  EXPECT_EQ(fgetc(f), 'd');
  fclose(f);
  f = StreamOf(" abc");
  EXPECT_EQ(StrReadName(buf, 10, f), ' ');
  EXPECT_STREQ(buf, "");
  fclose(f);
}

TEST(StrStream, ReadNameCutsLongWordAndStopsAtEnd) {
  FILE* f = StreamOf("abcdefgh\tx");
  char buf[6];
  EXPECT_EQ(StrReadName(buf, 6, f), '\t');
  EXPECT_STREQ(buf, "abcd");  // n - 2 characters of a word that does not fit
  EXPECT_EQ(fgetc(f), 'x');
  EXPECT_EQ(StrReadName(buf, 6, f), '\0');  // end of stream: nothing read
  EXPECT_STREQ(buf, "");
  fclose(f);
  f = StreamOf("tail");
  EXPECT_EQ(StrReadName(buf, 6, f), '\0');
  EXPECT_STREQ(buf, "tail");
  fclose(f);
}

TEST(StrStream, ReadAndPrintByMainOutputRule) {
  FILE* in = StreamOf("  word next");
  char buf[16];
  StrRead(buf, in);
  EXPECT_STREQ(buf, "word");
  fclose(in);
  FILE* main = tmpfile();
  FILE* other = tmpfile();
  MainEVarOutFile = main;
  PortTest::Capture cap;
  StrPrint(other, "50%d");
  EXPECT_EQ(cap.size(), 0u);
  StrPrint(main, "100%s");
  ExpectOneReport(cap, Port_Status, "100%s");
  rewind(other);
  EXPECT_EQ(fgets(buf, sizeof buf, other), buf);
  EXPECT_STREQ(buf, "50%d");
  MainEVarOutFile = nullptr;
  fclose(main);
  fclose(other);
}

TEST(StrHeap, CopyFreeAndAllocationFailure) {
  char* s = StrCopy("abc");
  EXPECT_STREQ(s, "abc");
  StrFree(&s);
  EXPECT_EQ(s, nullptr);
  StrFree(&s);
  PortTest::AllocFailureGuard guard;
  PortTest::FailNthAlloc(1);
  EXPECT_EQ(StrCopy("abc"), nullptr);
  char* p = StrCopy("x");
  PortTest::FailNthAlloc(1);
  StrSafeCatPX(&p, "y");  // no memory: the string stays as it was
  EXPECT_STREQ(p, "x");
  StrFree(&p);
}

TEST(StrHeap, SafeCatPX) {
  char* p = nullptr;
  StrSafeCatPX(&p, "");
  ASSERT_NE(p, nullptr);
  EXPECT_STREQ(p, "");
  StrSafeCatPX(&p, "ab");
  StrSafeCatPX(&p, p);  // self-append doubles
  EXPECT_STREQ(p, "abab");
  PortTest::Capture cap;
  char* before = p;
  StrSafeCatPX(&p, nullptr);
  ExpectOneReport(cap, Port_Fatal, "Data corruption (StrSafeCatPX) - Null string\n");
  EXPECT_EQ(p, before);
  StrFree(&p);
}

TEST(StrBounded, SafeCatTXTruncation) {
  PortTest::Capture cap;
  char buf[10] = "abcd";
  StrSafeCatTX(buf, "efgh", 10);  // 8 < size - 1: no warning
  EXPECT_EQ(cap.size(), 0u);
  EXPECT_STREQ(buf, "abcdefgh");
  strcpy(buf, "abcd");
  StrSafeCatTX(buf, "efghi", 10);  // exactly fills: warned all the same
  ExpectOneReport(cap, Port_Warning, "Name truncation in StrSafeCatTX : abcd\n");
  EXPECT_STREQ(buf, "abcdefghi");
  cap.clear();
  strcpy(buf, "abcd");
  StrSafeCatTX(buf, "efghij", 10);
  ExpectOneReport(cap, Port_Warning, "Name truncation in StrSafeCatTX : abcd\n");
  EXPECT_STREQ(buf, "abcdefghi");
  cap.clear();
  StrSafeCatTX(buf, "z", 10);  // already full: nothing appended
  EXPECT_STREQ(buf, "abcdefghi");
  EXPECT_EQ(cap.size(), 1u);
}

TEST(StrBounded, SafeCatTXNullArguments) {
  PortTest::Capture cap;
  char buf[4] = "ab";
  StrSafeCatTX(buf, nullptr, 4);
  EXPECT_EQ(cap.size(), 0u);
  EXPECT_STREQ(buf, "ab");
  StrSafeCatTX(nullptr, "x", 4);
  ExpectOneReport(cap, Port_Fatal, "Data corruption (StrSafeCatTX) - Null string\n");
}

TEST(StrBounded, SafeCopyTXRefusesWhatDoesNotFit) {
  PortTest::Capture cap;
  char buf[4] = "old";
  EXPECT_EQ(StrSafeCopyTX(buf, "abcd", 4, 1), 0);
  ExpectOneReport(cap, Port_Fatal, "Data corruption (StrSafeCopyTX) - String overflow\n");
  EXPECT_STREQ(buf, "old");
  cap.clear();
  EXPECT_EQ(StrSafeCopyTX(buf, "abc", 4, 1), 1);
  EXPECT_STREQ(buf, "abc");
  EXPECT_EQ(StrSafeCopyTX(buf, "", 0, 1), 0);  // no room even for the terminator
  EXPECT_EQ(StrSafeCopyTX(buf, nullptr, 4, 1), 1);
  EXPECT_STREQ(buf, "");
  EXPECT_EQ(cap.size(), 1u);
  cap.clear();
  EXPECT_EQ(StrSafeCopyTX(nullptr, nullptr, 4, 1), 1);
  EXPECT_EQ(StrSafeCopyTX(nullptr, "a", 4, 1), 0);
  ExpectOneReport(cap, Port_Fatal, "Data corruption (StrSafeCopyTX) - Null string\n");
}

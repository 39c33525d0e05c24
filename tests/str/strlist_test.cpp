#include <cstring>
#include <random>

#include "str_test_util.h"

// Fields, tokens of random text against a reference, and word quoting.
TEST(StrList, FieldsTokensQuotedWordsFindInsertPrintAndIndexedNames) {
  EXPECT_EQ(Items(StrStringToList("a,x,X,,b", ',', "x")), (Strings{"a", "", "b"}));
  EXPECT_EQ(Items(StrStringToList(",a,,xy", ',', "")), (Strings{"a", "xy"}));
  EXPECT_EQ(Items(StrStringToList("a,b", '\0', nullptr)), Strings{"a,b"});
  std::mt19937 rng(7);
  for (int k = 0; k < 80; ++k) {
    std::string s(rng() % 24, ' '), d = ", \t";
    for (char& c : s) c = "ab,, \t\"x"[rng() % 8];
    Strings tokens;  // reference: the maximal runs of non-delimiters
    for (size_t b = s.find_first_not_of(d), e; b != std::string::npos; b = s.find_first_not_of(d, e))
      tokens.push_back(s.substr(b, (e = s.find_first_of(d, b)) - b));
    EXPECT_EQ(Items(StrToTokenList(s.c_str(), d.c_str())), tokens) << s;
  }
  char line[] = "one two";  // the caller's strtok scan survives
  EXPECT_STREQ(strtok(line, " "), "one");
  EXPECT_EQ(Items(StrToWordList("a \"b c", " ")), Strings{"a"});  // a group left open is dropped
  // A word quoted at both ends closes the group; its text waits for a closing token.
  EXPECT_EQ(Items(StrToWordList("\"a \"b\" c d\"", " ")), (Strings{"\"b\"", "c", "\"a d\""}));
  EXPECT_TRUE(!StrToTokenList(nullptr, " ") && !StrToWordList("a", nullptr));
  EXPECT_STREQ(strtok(nullptr, " "), "two");
  PortTest::AllocFailureGuard guard;
  for (long n = 1; n <= 6; ++n) {  // work copy, element array, three words, then none
    PortTest::FailNthAlloc(n);
    EXPECT_EQ(Items(StrToWordList("s \"a  b\" c", " ")), n <= 5 ? Strings{"<null>"} : Strings({"s", "\"a b\"", "c"}));
  }
  PortTest::ResetAllocFailures();
  auto nice = [](const std::string& items, int width) {
    DomList* list = StrStringToList(items.c_str(), ',', nullptr);
    std::string r = Owned(StrListNicePrint(list, ", ", "  ", width));
    return ListDelete(&list, ListElemFree), r;
  };
  EXPECT_EQ(nice("alpha,beta,gamma", 15) + "|" + nice("abcdefgh,x", 5), "  alpha, beta, \n  gamma|  abcdefgh, \n  x");
  std::string many;  // too long for a line: no break on an empty one (above); no wrapping, 4 characters each (below)
  for (int i = 0; i < 300; ++i) many += "ab,";
  std::string stopped = nice(many, -1);
  EXPECT_EQ(stopped.size(), 2 + 4 * 254 + 3u);
  EXPECT_EQ(stopped.substr(stopped.size() - 7), "ab, ...");  // the separator stays
  DomList* list = ListCreate();
  for (const char* s : {"x", "y"}) StrInsertInList(list, C(s));
  EXPECT_EQ(StrInsertInList(list, C("x")) * 100 + StrStringInList(list, C("x")) * 10 + StrStringInList(list, C("X")),
            330);
  PortTest::FailNthAlloc(1);
  EXPECT_EQ(StrInsertInList(list, C("z")), 0);
  EXPECT_EQ(Items(list), (Strings{"x", "y", "x"}));
  char* p = nullptr;
  StrCatIndexToStrPX(&p, 45L);
  EXPECT_EQ(Owned(p) + Owned(StrAppendIndexToStr(nullptr, 7)) + Owned(StrAppendIndexToStr("w", 4294967296L)),
            "457w4294967296");
  EXPECT_EQ(Items(StrCreateListHDLIndexStr("d", 0, 1)), (Strings{"d<0>", "d<1>"}));
  EXPECT_EQ(Items(StrCreateListHDLIndexStr("d", 0, 0)), Strings{"d"});
  PortTest::Capture cap;
  p = nullptr;
  StrCatIndexToStrPX(&p, -2);
  EXPECT_TRUE(!p && !StrAppendIndexToStr("b", -1L) && !StrCreateListIndexedStr("a", 3, 1) &&
              !StrCreateListHDLIndexStr("a", -1, 0));
  EXPECT_EQ(Reports(cap), "0:Data corruption (StrCatIndexToStrPX) - Negative index\n0:Data corruption "
                          "(StrAppendIndexToStr) - Negative index\n0:Data corruption (StrCreateListIndexedStr) - "
                          "Incorrect indices\n0:Data corruption (StrCreateListHDLIndexStr) - Incorrect indices\n");
}

#include <cstring>
#include <random>

#include "str_test_util.h"

TEST(StrSplit, FieldsAndTokensOfRandomText) {
  EXPECT_EQ(Items(StrStringToList(",a,", ',', nullptr)), (Strings{"", "a"}));
  EXPECT_EQ(Items(StrStringToList("a,x,X,,b", ',', "x")), (Strings{"a", "", "b"}));
  EXPECT_EQ(Items(StrStringToList(",a,,xy", ',', "")), (Strings{"a", "xy"}));
  EXPECT_EQ(Items(StrStringToList("a,b", '\0', nullptr)), Strings{"a,b"});
  std::mt19937 rng(7);
  for (int k = 0; k < 200; ++k) {
    std::string s(rng() % 24, ' '), joined, d = ", \t";
    for (char& c : s) c = "ab,, \t\"x"[rng() % 8];
    Strings tokens;  // reference: the maximal runs of non-delimiters
    for (size_t b = s.find_first_not_of(d), e; b != std::string::npos; b = s.find_first_not_of(d, e))
      tokens.push_back(s.substr(b, (e = s.find_first_of(d, b)) - b));
    EXPECT_EQ(Items(StrToTokenList(s.c_str(), d.c_str())), tokens) << s;
    while (!s.empty() && s.back() == ',') s.pop_back();  // joined back, the fields give the input
    for (const std::string& f : Items(StrStringToList(s.c_str(), ',', nullptr))) joined += f + ",";
    EXPECT_EQ(joined, s.empty() ? "" : s + ",");
  }
}

TEST(StrSplit, WordQuotingLeavesTheCallersStrtokScan) {
  char line[] = "one two";
  EXPECT_STREQ(strtok(line, " "), "one");
  EXPECT_EQ(Items(StrToWordList("set \"a  b\" c", " ")), (Strings{"set", "\"a b\"", "c"}));
  EXPECT_EQ(Items(StrToWordList("a \"b c", " ")), Strings{"a"});  // a group left open is dropped
  EXPECT_EQ(Items(StrToWordList("p\"q x\" y", " ")), (Strings{"p\"q", "x\"", "y"}));
  // A word quoted at both ends closes the group; its text waits for a closing token.
  EXPECT_EQ(Items(StrToWordList("\"a \"b\" c d\"", " ")), (Strings{"\"b\"", "c", "\"a d\""}));
  EXPECT_EQ(Items(StrToTokenList(nullptr, " ")), Strings{"<null>"});
  EXPECT_EQ(Items(StrToWordList("a", nullptr)), Strings{"<null>"});
  EXPECT_STREQ(strtok(nullptr, " "), "two");
  PortTest::AllocFailureGuard guard;
  for (long n = 1; n <= 6; ++n) {  // work copy, element array, three words, then none
    PortTest::FailNthAlloc(n);
    Strings words = Items(StrToWordList("a \"b c\" d", " "));
    EXPECT_EQ(words, n <= 5 ? Strings{"<null>"} : Strings({"a", "\"b c\"", "d"})) << n;
  }
}

TEST(StrList, FindInsertAndWrappedPrint) {
  auto nice = [](const Strings& items, int width) {
    DomList* list = ListCreate();
    for (const std::string& s : items) StrInsertInList(list, C(s.c_str()));
    std::string r = Owned(StrListNicePrint(list, ", ", "  ", width));
    Items(list);
    return r;
  };
  EXPECT_EQ(nice({"alpha", "beta", "gamma"}, 15), "  alpha, beta, \n  gamma");
  EXPECT_EQ(nice({"abcdefgh", "x"}, 5), "  abcdefgh, \n  x");  // too long: no break on an empty line
  std::string stopped = nice(Strings(300, "ab"), -1);  // no wrapping; each element adds 4 characters
  EXPECT_EQ(stopped.size(), 2 + 4 * 254 + 3u);
  EXPECT_EQ(stopped.substr(stopped.size() - 7), "ab, ...");  // the separator stays
  DomList* list = ListCreate();
  for (const char* s : {"x", "y"}) StrInsertInList(list, C(s));
  EXPECT_EQ(StrInsertInList(list, C("x")) * 10 + StrStringInList(list, C("x")), 33);
  EXPECT_EQ(StrStringInList(list, C("X")), 0);
  PortTest::AllocFailureGuard guard;
  PortTest::FailNthAlloc(1);
  EXPECT_EQ(StrInsertInList(list, C("z")), 0);
  EXPECT_EQ(Items(list), (Strings{"x", "y", "x"}));
}

TEST(StrIndexedNames, NamesRangesAndRefusals) {
  char* p = nullptr;
  StrCatIndexToStrPX(&p, 3);
  StrCatIndexToStrPX(&p, 45L);
  EXPECT_EQ(Owned(p) + Owned(StrAppendIndexToStr(nullptr, 7)) + Owned(StrAppendIndexToStr("w", 4294967296L)),
            "3457w4294967296");
  EXPECT_EQ(Items(StrCreateListIndexedStr("a", 2, 4)), (Strings{"a2", "a3", "a4"}));
  EXPECT_EQ(Items(StrCreateListHDLIndexStr("d", 0, 2)), (Strings{"d<0>", "d<1>", "d<2>"}));
  EXPECT_EQ(Items(StrCreateListHDLIndexStr("d", 0, 0)), Strings{"d"});
  PortTest::Capture cap;
  p = nullptr;
  StrCatIndexToStrPX(&p, -2);
  EXPECT_TRUE(!p && !StrAppendIndexToStr("b", -1L) && !StrCreateListIndexedStr("a", 3, 1) &&
              !StrCreateListHDLIndexStr("a", -1, 0));
  EXPECT_EQ(Reports(cap), "0:Data corruption (StrCatIndexToStrPX) - Negative index\n"
                          "0:Data corruption (StrAppendIndexToStr) - Negative index\n"
                          "0:Data corruption (StrCreateListIndexedStr) - Incorrect indices\n"
                          "0:Data corruption (StrCreateListHDLIndexStr) - Incorrect indices\n");
}

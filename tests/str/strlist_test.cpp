#include <gtest/gtest.h>

#include <cstring>
#include <functional>
#include <random>
#include <string>
#include <vector>

#include "duduzu/str.h"
#include "duduzu/strlist.h"
#include "str_test_util.h"

namespace {

using Strings = std::vector<std::string>;

// The strings of a list, which is then released; {"<null>"} for no list.
Strings Items(DomList* list) {
  if (!list) return {"<null>"};
  Strings r;
  for (int i = 0; i < list->count; ++i) r.push_back(reinterpret_cast<char*>(list->elements[i]));
  ListDelete(&list, ListElemFree);
  return r;
}

std::string Take(char* s) {
  std::string r = s ? s : "<null>";
  StrFree(&s);
  return r;
}

DomList* ListOf(const Strings& items) {
  DomList* list = ListCreate();
  for (const std::string& s : items) StrInsertInList(list, const_cast<char*>(s.c_str()));
  return list;
}

// Random text over an alphabet rich in separators, blanks and quotes.
std::string RandomText(std::mt19937& rng) {
  static const char alphabet[] = "ab,, \t\"x";
  std::string s(rng() % 24, ' ');
  for (char& c : s) c = alphabet[rng() % (sizeof alphabet - 1)];
  return s;
}

}  // namespace

TEST(StrStringToList, Fields) {
  EXPECT_EQ(Items(StrStringToList("a,,b", ',', nullptr)), (Strings{"a", "", "b"}));
  EXPECT_EQ(Items(StrStringToList(",a", ',', nullptr)), (Strings{"", "a"}));
  EXPECT_EQ(Items(StrStringToList("a,b,", ',', nullptr)), (Strings{"a", "b"}));
  EXPECT_EQ(Items(StrStringToList("", ',', nullptr)), Strings{});
  EXPECT_EQ(Items(StrStringToList("a,x,X,b", ',', "x")), (Strings{"a", "b"}));
  EXPECT_EQ(Items(StrStringToList(",a,,xy", ',', "")), (Strings{"a", "xy"}));
  EXPECT_EQ(Items(StrStringToList("a,b", '\0', nullptr)), Strings{"a,b"});
}

TEST(StrStringToList, JoinReproducesInput) {
  std::mt19937 rng(7);
  for (int k = 0; k < 500; ++k) {
    std::string s = RandomText(rng);
    while (!s.empty() && s.back() == ',') s.pop_back();
    std::string joined;
    for (const std::string& f : Items(StrStringToList(s.c_str(), ',', nullptr))) joined += f + ",";
    if (!joined.empty()) joined.pop_back();
    EXPECT_EQ(joined, s);
  }
}

TEST(StrSplit, TokensNeverHoldDelimiters) {
  EXPECT_EQ(Items(StrToTokenList("  a  b ", " ")), (Strings{"a", "b"}));
  EXPECT_EQ(Items(StrToTokenList(" ,, ", ", ")), Strings{});
  EXPECT_EQ(Items(StrToTokenList(nullptr, " ")), Strings{"<null>"});
  EXPECT_EQ(Items(StrToWordList("a", nullptr)), Strings{"<null>"});
  std::mt19937 rng(11);
  for (int k = 0; k < 500; ++k)
    for (const std::string& t : Items(StrToTokenList(RandomText(rng).c_str(), ", \t"))) {
      EXPECT_FALSE(t.empty());
      EXPECT_EQ(t.find_first_of(", \t"), std::string::npos) << t;
    }
}

TEST(StrSplit, WordQuoting) {
  EXPECT_EQ(Items(StrToWordList("set \"a  b\" c", " ")), (Strings{"set", "\"a b\"", "c"}));
  EXPECT_EQ(Items(StrToWordList("\"x\"", " ")), Strings{"\"x\""});
  EXPECT_EQ(Items(StrToWordList("a \" b \"", " ")), (Strings{"a", "\" b \""}));
  EXPECT_EQ(Items(StrToWordList("a \"b c", " ")), Strings{"a"});  // a group left open is dropped
  EXPECT_EQ(Items(StrToWordList("x\" y", " ")), (Strings{"x\"", "y"}));
  // A word quoted at both ends closes the group; its text waits for a closing token.
  EXPECT_EQ(Items(StrToWordList("\"a \"b\" c d\"", " ")), (Strings{"\"b\"", "c", "\"a d\""}));
  EXPECT_EQ(Items(StrToWordList("p\"q \"r s\"", " \t")), (Strings{"p\"q", "\"r s\""}));
}

TEST(StrSplit, CallerStrtokScanSurvives) {
  char line[] = "one two three";
  EXPECT_STREQ(strtok(line, " "), "one");
  EXPECT_EQ(Items(StrToTokenList("x y", " ")), (Strings{"x", "y"}));
  EXPECT_STREQ(strtok(nullptr, " "), "two");
  EXPECT_EQ(Items(StrToWordList("\"p q\" r", " ")), (Strings{"\"p q\"", "r"}));
  EXPECT_STREQ(strtok(nullptr, " "), "three");
}

TEST(StrSplit, AllocationFailureReleasesEverything) {
  PortTest::AllocFailureGuard guard;
  Items(StrToTokenList("", " "));  // the list-record pool is in place
  int failures = 0;
  for (long n = 1; n <= 8; ++n) {
    PortTest::FailNthAlloc(n);
    Strings words = Items(StrToWordList("a \"b c\" d", " "));
    bool failed = words == Strings{"<null>"};
    failures += failed;
    EXPECT_TRUE(failed || words == (Strings{"a", "\"b c\"", "d"})) << n;
  }
  EXPECT_EQ(failures, 5);  // work copy, element array, three words
  PortTest::FailNthAlloc(2);
  EXPECT_EQ(Items(StrCreateListIndexedStr("a", 0, 2)), Strings{"<null>"});
}

TEST(StrList, FindInsertPrint) {
  DomList* list = ListOf({"x", "y"});
  EXPECT_EQ(StrInsertInList(list, const_cast<char*>("x")), 3);
  EXPECT_EQ(StrStringInList(list, const_cast<char*>("x")), 3);
  EXPECT_EQ(StrStringInList(list, const_cast<char*>("X")), 0);
  EXPECT_EQ(StrStringInList(nullptr, const_cast<char*>("x")), 0);
  FILE* f = tmpfile();
  StrListPrint(f, list, "-");
  char buf[16] = {};
  rewind(f);
  ASSERT_NE(fgets(buf, sizeof buf, f), nullptr);
  EXPECT_STREQ(buf, "x-y-x");
  fclose(f);
  PortTest::AllocFailureGuard guard;
  PortTest::FailNthAlloc(1);
  EXPECT_EQ(StrInsertInList(list, const_cast<char*>("z")), 0);
  EXPECT_EQ(Items(list), (Strings{"x", "y", "x"}));
}

TEST(StrListNicePrint, Wrapping) {
  auto nice = [](const Strings& items, int width) {
    DomList* list = ListOf(items);
    std::string r = Take(StrListNicePrint(list, ", ", "  ", width));
    Items(list);
    return r;
  };
  EXPECT_EQ(nice({"alpha", "beta", "gamma"}, 15), "  alpha, beta, \n  gamma");
  EXPECT_EQ(nice({"abcdefgh", "x"}, 5), "  abcdefgh, \n  x");  // too long: no break on an empty line
  EXPECT_EQ(nice({"x", "abcdefgh"}, 5), "  x, \n  abcdefgh");
  EXPECT_EQ(nice({"alpha", "beta", "gamma"}, -1), "  alpha, beta, gamma");
  EXPECT_EQ(Take(StrListNicePrint(nullptr, ", ", "> ", 10)), "> ");
  std::string stopped = nice(Strings(300, "ab"), -1);  // each element adds 4 characters
  EXPECT_EQ(stopped.size(), 2 + 4 * 254 + 3u);
  EXPECT_EQ(stopped.substr(stopped.size() - 7), "ab, ...");  // the separator stays
}

TEST(StrIndexedNames, Names) {
  EXPECT_EQ(Take(StrAppendIndexToStr("bit", 12)), "bit12");
  EXPECT_EQ(Take(StrAppendIndexToStr(nullptr, 7)), "7");
  EXPECT_EQ(Take(StrAppendIndexToStr("w", 4294967296L)), "w4294967296");
  char* p = nullptr;
  StrCatIndexToStrPX(&p, 3);
  StrCatIndexToStrPX(&p, 45L);
  EXPECT_EQ(Take(p), "345");
  EXPECT_EQ(Items(StrCreateListIndexedStr("a", 2, 4)), (Strings{"a2", "a3", "a4"}));
  EXPECT_EQ(Items(StrCreateListIndexedStr(nullptr, 0, 1)), (Strings{"0", "1"}));
  EXPECT_EQ(Items(StrCreateListHDLIndexStr("d", 0, 2)), (Strings{"d<0>", "d<1>", "d<2>"}));
  EXPECT_EQ(Items(StrCreateListHDLIndexStr("d", 0, 0)), Strings{"d"});
  EXPECT_EQ(Items(StrCreateListHDLIndexStr("d", 1, 1)), Strings{"d<1>"});
}

TEST(StrIndexedNames, RefusalsAreFatalReports) {
  struct Case {
    std::function<bool()> call;  // true when the result is as refused
    const char* text;
  } cases[] = {
      {[] { return StrAppendIndexToStr("bit", -1) == nullptr; }, "Data corruption (StrAppendIndexToStr) - Negative index\n"},
      {[] { return StrAppendIndexToStr("bit", -1L) == nullptr; }, "Data corruption (StrAppendIndexToStr) - Negative index\n"},
      {[] { char* p = nullptr; StrCatIndexToStrPX(&p, -2); return p == nullptr; }, "Data corruption (StrCatIndexToStrPX) - Negative index\n"},
      {[] { return !StrCreateListIndexedStr("a", 3, 1); }, "Data corruption (StrCreateListIndexedStr) - Incorrect indices\n"},
      {[] { return !StrCreateListIndexedStr("a", -1, 1); }, "Data corruption (StrCreateListIndexedStr) - Incorrect indices\n"},
      {[] { return !StrCreateListHDLIndexStr("a", 0, -1); }, "Data corruption (StrCreateListHDLIndexStr) - Incorrect indices\n"},
  };
  for (const Case& c : cases) {
    PortTest::Capture cap;
    EXPECT_TRUE(c.call()) << c.text;
    ExpectOneReport(cap, Port_Fatal, c.text);
  }
}

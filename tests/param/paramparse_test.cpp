#include "param_test_util.h"

// Outcome of a check and the list it left.
static std::string Check(const char* command, const char* params, const char* d1, const char* d2 = "") {
  DomList* list = nullptr;
  int r = ParamCheckParamList(C(command), C(params), C(d1), C(d2), &list);
  std::string s = std::to_string(r) + " " + Show(list);
  DeleteList(&list);
  return s;
}

TEST(ParamWords, ThreeExtractorsAndTheCutAt999) {
  char text[] = "  top \t\"a b\" \"\" x\"y \"abc";
  char *c = text, buffer[16], *word = buffer;
  for (const char* want : {"top", "a b", "<null>", "x\"y", "abc", "<null>"})
    EXPECT_EQ(Owned(ParamExtractWordFromStr(&c)), want);
  EXPECT_EQ(c, text + sizeof(text) - 1);
  c = text;
  for (auto want : {std::make_pair(1, "top"), {1, "\"a b\""}, {1, "\"\""}, {1, "x\"y"}, {0, "\"abc"}, {0, ""}})
    EXPECT_EQ(std::to_string(ParamExtractWordFromStrQuote(&c, &word)) + buffer, std::to_string(want.first) + want.second);
  PortTest::Capture cap;
  std::string cut = "\"" + std::string(1500, 'w') + "\" next";
  c = &cut[0];
  EXPECT_EQ(Owned(ParamExtractWordFromStr(&c)), std::string(999, 'w'));
  EXPECT_EQ(Owned(ParamExtractWordFromStr(&c)), "next");  // the cut part is consumed
  EXPECT_EQ(Reports(cap, "../s/strutil"), "1:Name truncation in StrSafeCatTX : \n");
}

TEST(ParamParse, GrammarDescriptorAcceptanceAndTopCheck) {
  EXPECT_EQ(Check("run", "top -depth 3 -v -name \"a b\"", ""), "1 =top;depth=3;v=;name=\"a b\"");
  EXPECT_EQ(Check("kerb", "a \"b c\" - x", "-a 1 2"), "1 =a;=\"b c\";=x");  // descriptors unread
  EXPECT_EQ(Check("macro", " \t\n", "") + Check("ENV", nullptr, "") + Check("run", "-a 1 2", ""),
            "1 <null>1 <null>0 <null>");
  PortTest::Capture cap;
  EXPECT_EQ(Check("run", ("-" + std::string(255, 'n') + " 1").c_str(), ""), "0 <null>");  // name too long
  const char* d = "S -depth I -v";
  std::string outcomes;
  for (const char* params :
       {"top -depth 3 -v", "-depth 3", "top extra", "top -depth", "top -v 1", "top -v -v", "top -v -V", "top -depth x"})
    outcomes += Check("c", params, d)[0];
  outcomes += Check("c", "top -depth 3", "S", "-DEPTH I")[0];
  // A rejected list stays.
  EXPECT_EQ(Check("c", "", "-v") + Check("c", "", "S -v") + Check("c", "x", ""), "1 <null>0 <null>0 =x");
  EXPECT_EQ(Check("c", "top -unknown 1 -depth -5", d), "1 =top;unknown=1;depth=;5=");
  DomList* list = MakeList({{"opt", "Fast"}, {"v", ""}});  // the top check: the list's names first, then the others
  for (const char* params : {"-v -OPT fast", "", "-a 1 2", "-other 1 -opt slow", "-opt fast -other 1"})
    outcomes += std::to_string(ParamTopCheckParamList(list, C(params)));
  EXPECT_EQ(outcomes + std::to_string(ParamTopCheckParamList(nullptr, C("-a"))), "100100101100000");
  EXPECT_EQ(Reports(cap), "4:Parameter name too long (255 characters, at most 254) : " + std::string(255, 'n') +
                              "\n1:skipping parameter : unknown\n1:skipping parameter : 5\n"
                              "2:Illegal parameter value for opt\n2:Illegal parameter value for other\n"
                              "2:Illegal parameter value for a\n");
  DeleteList(&list);
}

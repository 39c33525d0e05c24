#include <gtest/gtest.h>

#include <string>

#include "param_test_util.h"

namespace {

// The parameters as parsed by the check of a command that is never checked.
std::string Parsed(const char* text, int* ok = nullptr) {
  DomList* list = reinterpret_cast<DomList*>(1);
  int r = ParamCheckParamList(const_cast<char*>("run"), const_cast<char*>(text), nullptr, nullptr, &list);
  if (ok) *ok = r;
  std::string s = Show(list);
  DeleteList(&list);
  return s;
}

// Outcome of checking `params` against the descriptors; the parsed list is released.
int Check(const char* params, const char* d1, const char* d2 = "") {
  DomList* list = nullptr;
  int r = ParamCheckParamList(const_cast<char*>("cmd"), const_cast<char*>(params), const_cast<char*>(d1),
                              const_cast<char*>(d2), &list);
  DeleteList(&list);
  return r;
}

}  // namespace

TEST(ParamWords, Extract) {
  char text[] = "  top \t\"a b\" \"\" x\"y ";
  char* c = text;
  EXPECT_EQ(Owned(ParamExtractWordFromStr(&c)), "top");
  EXPECT_EQ(*c, ' ');
  EXPECT_EQ(Owned(ParamExtractWordFromStr(&c)), "a b");
  EXPECT_EQ(Owned(ParamExtractWordFromStr(&c)), "<null>");  // empty quoted word, consumed
  EXPECT_EQ(Owned(ParamExtractWordFromStr(&c)), "x\"y");
  EXPECT_EQ(ParamExtractWordFromStr(&c), nullptr);
  EXPECT_EQ(c, text + sizeof(text) - 1);
  c = text;
  EXPECT_EQ(Owned(ParamExtractWordFromStrWithQuote(&c)), "top");
  EXPECT_EQ(Owned(ParamExtractWordFromStrWithQuote(&c)), "\"a b\"");
  EXPECT_EQ(Owned(ParamExtractWordFromStrWithQuote(&c)), "\"\"");
  char open[] = " \"abc";
  c = open;
  EXPECT_EQ(Owned(ParamExtractWordFromStr(&c)), "abc");
  EXPECT_EQ(*c, '\0');
  c = open;
  EXPECT_EQ(Owned(ParamExtractWordFromStrWithQuote(&c)), "\"abc");
  char* none = nullptr;
  EXPECT_EQ(ParamExtractWordFromStr(&none), nullptr);
}

TEST(ParamWords, ExtractIntoBuffer) {
  char text[] = " \"a b\"c \"open end";
  char buffer[32];
  char* word = buffer;
  char* c = text;
  EXPECT_EQ(ParamExtractWordFromStrQuote(&c, &word), 1);
  EXPECT_STREQ(buffer, "\"a b\"");
  EXPECT_EQ(word, buffer);
  EXPECT_EQ(ParamExtractWordFromStrQuote(&c, &word), 1);
  EXPECT_STREQ(buffer, "c");
  EXPECT_EQ(ParamExtractWordFromStrQuote(&c, &word), 0);
  EXPECT_STREQ(buffer, "\"open end");
  EXPECT_EQ(ParamExtractWordFromStrQuote(&c, &word), 0);
  EXPECT_STREQ(buffer, "");
}

TEST(ParamWords, LongWordsAreCutAt999) {
  for (bool quoted : {false, true}) {
    std::string body(1500, 'w');
    std::string text = quoted ? "\"" + body + "\" next" : body + " next";
    char* c = &text[0];
    PortTest::Capture cap;
    char* word = ParamExtractWordFromStr(&c);
    EXPECT_EQ(std::string(word), std::string(999, 'w'));
    vzl_free(word);
    ASSERT_EQ(cap.size(), 1u);
    EXPECT_EQ(cap[0].level, Port_Warning);
    EXPECT_EQ(cap[0].text, "Name truncation in StrSafeCatTX : \n");
    EXPECT_EQ(Owned(ParamExtractWordFromStr(&c)), "next");  // the cut part is consumed
  }
  std::string text998(998, 'w');
  char* c = &text998[0];
  PortTest::Capture cap;
  EXPECT_EQ(Owned(ParamExtractWordFromStrWithQuote(&c)).size(), 998u);
  EXPECT_EQ(cap.size(), 0u);
}

TEST(ParamParse, Grammar) {
  int ok = 0;
  EXPECT_EQ(Parsed("top -depth 3 -v -name \"a b\"", &ok), "=top;depth=3;v=;name=\"a b\"");
  EXPECT_EQ(ok, 1);
  EXPECT_EQ(Parsed("-n -5"), "n=;5=");
  EXPECT_EQ(Parsed("a \"b c\" - x"), "=a;=\"b c\";=x");
  EXPECT_EQ(Parsed(""), "<null>");
  EXPECT_EQ(Parsed(" \t\n", &ok), "<null>");
  EXPECT_EQ(ok, 1);
  EXPECT_EQ(Parsed("-a 1 2", &ok), "<null>");
  EXPECT_EQ(ok, 0);
  EXPECT_EQ(Parsed("-a x top", &ok), "<null>");
  EXPECT_EQ(ok, 0);
  EXPECT_EQ(Parsed(nullptr, &ok), "<null>");
  EXPECT_EQ(ok, 1);
}

TEST(ParamParse, OverlongNameFailsTheParse) {
  std::string text = "-" + std::string(255, 'n') + " 1";
  PortTest::Capture cap;
  int ok = 1;
  EXPECT_EQ(Parsed(text.c_str(), &ok), "<null>");
  EXPECT_EQ(ok, 0);
  ASSERT_EQ(cap.size(), 1u);
  EXPECT_EQ(cap[0].level, Port_Error);
  EXPECT_EQ(Parsed(("-" + std::string(254, 'n') + " 1").c_str(), &ok), std::string(254, 'n') + "=1");
}

TEST(ParamCheck, DescriptorTable) {
  const char* d = "S -depth I -v";
  EXPECT_EQ(Check("top -depth 3 -v", d), 1);
  EXPECT_EQ(Check("-depth 3", d), 0);
  EXPECT_EQ(Check("top extra", d), 0);
  EXPECT_EQ(Check("top -depth x", d), 0);
  EXPECT_EQ(Check("top -depth", d), 1);
  EXPECT_EQ(Check("top -v 1", d), 0);
  EXPECT_EQ(Check("top -v -v", d), 0);
  EXPECT_EQ(Check("top -v -V", d), 1);
  EXPECT_EQ(Check("top -depth -5", d), 1);  // an empty depth, then the undeclared option 5
  EXPECT_EQ(Check("top", "S", "-depth I"), 1);
  EXPECT_EQ(Check("top -depth 3", "S", "-DEPTH I"), 1);
  EXPECT_EQ(Check("top -depth x", "S -depth Q"), 0);  // unknown type code
}

TEST(ParamCheck, UnknownOptionIsSkippedWithAWarning) {
  PortTest::Capture cap;
  DomList* list = nullptr;
  EXPECT_EQ(ParamCheckParamList(const_cast<char*>("cmd"), const_cast<char*>("top -unknown 1"),
                                const_cast<char*>("S -depth I -v"), const_cast<char*>(""), &list),
            1);
  ExpectOneReport(cap, Port_Warning, "skipping parameter : unknown\n");
  EXPECT_EQ(Show(list), "=top;unknown=1");  // kept in the list
  DeleteList(&list);
}

TEST(ParamCheck, EmptyStringsAndUncheckedCommands) {
  EXPECT_EQ(Check("", "-v"), 1);
  EXPECT_EQ(Check("", "S -v"), 0);
  EXPECT_EQ(Check("", ""), 1);
  EXPECT_EQ(Check("x", ""), 0);
  EXPECT_EQ(Check("-x", "", ""), 0);
  EXPECT_EQ(Check("top", "-v", "-a 1 2"), 0);  // malformed descriptor
  for (const char* command : {"RUN", "Kerb", "macro", "ENV"}) {
    DomList* list = nullptr;
    EXPECT_EQ(ParamCheckParamList(const_cast<char*>(command), const_cast<char*>("a b -c"),
                                  const_cast<char*>("-a 1 2"), nullptr, &list), 1);
    EXPECT_EQ(Show(list), "=a;=b;c=");
    DeleteList(&list);
  }
  DomList* list = nullptr;
  EXPECT_EQ(ParamCheckParamList(const_cast<char*>("cmd"), const_cast<char*>("x y"), const_cast<char*>("-v"),
                                const_cast<char*>(""), &list), 0);
  EXPECT_EQ(Show(list), "=x;=y");  // a rejected list stays with the caller
  DeleteList(&list);
}

TEST(ParamTopCheck, ComparesWithAList) {
  DomList* list = MakeList({{"opt", "Fast"}, {"v", ""}});
  PortTest::Capture cap;
  EXPECT_EQ(ParamTopCheckParamList(list, const_cast<char*>("-OPT fast")), 1);
  EXPECT_EQ(ParamTopCheckParamList(list, const_cast<char*>("-v -opt FAST")), 1);
  EXPECT_EQ(cap.size(), 0u);
  EXPECT_EQ(ParamTopCheckParamList(list, const_cast<char*>("-opt slow")), 0);
  ExpectOneReport(cap, Port_Status, "Illegal parameter value for opt\n");
  cap.clear();
  EXPECT_EQ(ParamTopCheckParamList(list, const_cast<char*>("-other 1 -opt slow")), 0);
  ExpectOneReport(cap, Port_Status, "Illegal parameter value for opt\n");  // list order first
  cap.clear();
  EXPECT_EQ(ParamTopCheckParamList(list, const_cast<char*>("-opt fast -other 1")), 0);
  ExpectOneReport(cap, Port_Status, "Illegal parameter value for other\n");
  cap.clear();
  EXPECT_EQ(ParamTopCheckParamList(list, const_cast<char*>("")), 0);
  EXPECT_EQ(ParamTopCheckParamList(list, const_cast<char*>("-a 1 2")), 0);
  EXPECT_EQ(cap.size(), 0u);
  EXPECT_EQ(ParamTopCheckParamList(nullptr, const_cast<char*>("-a")), 0);
  ExpectOneReport(cap, Port_Status, "Illegal parameter value for a\n");
  DeleteList(&list);
}

#include <gtest/gtest.h>

#include <cstring>
#include <string>

#include "param_test_util.h"

TEST(ParamRecord, LayoutCreateCopyFree) {
  static_assert(sizeof(DomParam) == 255 + 1020, "two fields, nothing else");
  DomParam* p = ParamCreateParam("Opt", "Fast");
  ASSERT_NE(p, nullptr);
  EXPECT_STREQ(reinterpret_cast<char*>(p), "Opt");  // the name comes first
  EXPECT_STREQ(p->CharParam, "Fast");
  for (size_t i = 4; i < sizeof(p->CharParamQual); ++i) ASSERT_EQ(p->CharParamQual[i], 0);
  for (size_t i = 5; i < sizeof(p->CharParam); ++i) ASSERT_EQ(p->CharParam[i], 0);
  DomParam* q = ParamCopy(p);
  ASSERT_NE(q, p);
  EXPECT_EQ(memcmp(p, q, sizeof(DomParam)), 0);
  ParamFree(&p);
  EXPECT_EQ(p, nullptr);
  ParamFree(&q);
  EXPECT_EQ(ParamCopy(nullptr), nullptr);
  DomParam* e = ParamCreateParam(nullptr, nullptr);
  EXPECT_STREQ(e->CharParamQual, "");
  EXPECT_STREQ(e->CharParam, "");
  EXPECT_EQ(ParamIdenticalName(e, ""), 1);
  EXPECT_EQ(ParamIdenticalName(e, nullptr), 0);
  ParamFree(&e);
}

TEST(ParamRecord, FieldLimits) {
  std::string name254(254, 'n'), value1019(1019, 'v');
  DomParam* p = ParamCreateParam(name254.c_str(), value1019.c_str());
  ASSERT_NE(p, nullptr);
  EXPECT_EQ(name254, p->CharParamQual);
  EXPECT_EQ(value1019, p->CharParam);
  ParamFree(&p);
  {
    PortTest::Capture cap;
    std::string name255(255, 'n');
    EXPECT_EQ(ParamCreateParam(name255.c_str(), "v"), nullptr);
    ExpectOneReport(cap, Port_Error,
                    "Parameter name too long (255 characters, at most 254) : " + name255 + "\n");
  }
  PortTest::Capture cap;
  EXPECT_EQ(ParamCreateParam("opt", std::string(1020, 'v').c_str()), nullptr);
  ExpectOneReport(cap, Port_Error,
                  "Parameter value too long (1020 characters, at most 1019) for opt\n");
}

TEST(ParamRecord, AllocationFailure) {
  PortTest::AllocFailureGuard guard;
  PortTest::Capture cap;
  PortTest::FailNthAlloc(1);
  EXPECT_EQ(ParamCreateParam("a", "b"), nullptr);
  ExpectOneReport(cap, Port_Error, "Memory Full (ParamCreateParam)\n");
  DomList* list = MakeList({{"a", "1"}});
  cap.clear();
  PortTest::FailNthAlloc(1);
  ParamChangeParamValue(list, "A", "2");  // the old record stays
  EXPECT_EQ(Show(list), "a=1");
  PortTest::FailNthAlloc(1);
  ParamMoveParamName(list, "a", "b");
  EXPECT_EQ(Show(list), "a=1");
  PortTest::FailNthAlloc(1);
  EXPECT_EQ(ParamFindNamedParam(list, "a"), nullptr);
  EXPECT_EQ(cap.size(), 2u);
  DeleteList(&list);
}

TEST(ParamLookup, FindAndTestValues) {
  DomList* list = MakeList({{"Opt", "Fast"}, {"opt", "second"}});
  char* v = ParamFindNamedParam(list, "OPT");
  EXPECT_STREQ(v, "Fast");
  EXPECT_NE(v, reinterpret_cast<DomParam*>(list->elements[0])->CharParam);  // a fresh copy
  vzl_free(v);
  EXPECT_EQ(ParamFindNamedParam(list, "none"), nullptr);
  EXPECT_EQ(ParamFindNamedParam(nullptr, "opt"), nullptr);
  EXPECT_EQ(ParamFindParamValue(list, "opt", "FAST"), 1);
  EXPECT_EQ(ParamFindParamValue(list, "opt", "second"), 0);  // the first record decides
  EXPECT_EQ(ParamFindParamValue(list, "opt", nullptr), 0);
  EXPECT_EQ(ParamFindParamValue(list, "speed", "x"), 2);
  EXPECT_EQ(ParamFindParamValue(nullptr, "opt", "Fast"), 0);
  DeleteList(&list);
}

// The two parameters of a file-copy command fetched the way the command does.
TEST(ParamLookup, FileCopyParameters) {
  DomList* list = MakeList({{"IFN", "in.txt"}, {"ofn", "out.txt"}});
  char* in = ParamFindNamedParam(list, "ifn");
  char* out = ParamFindNamedParam(list, "OFN");
  DeleteList(&list);  // the copies outlive the list
  EXPECT_STREQ(in, "in.txt");
  EXPECT_STREQ(out, "out.txt");
  vzl_free(in);
  vzl_free(out);
}

TEST(ParamLookup, NameSets) {
  DomList* list = MakeList({{"a", "1"}, {"B", "2"}});
  EXPECT_EQ(ParamCheckInList(list, 2, "A", "b"), 1);
  EXPECT_EQ(ParamCheckInList(list, 1, "a"), 0);
  EXPECT_EQ(ParamCheckInList(list, 0), 0);
  EXPECT_EQ(ParamCheckInList(nullptr, 0), 1);
  DomList* empty = ListCreate();
  EXPECT_EQ(ParamCheckInList(empty, 0), 1);
  EXPECT_EQ(ParamCheckAtLeastInList(empty, 0), 1);
  EXPECT_EQ(ParamCheckAtLeastInList(nullptr, 0), 1);
  EXPECT_EQ(ParamCheckAtLeastInList(nullptr, 1, "a"), 0);
  EXPECT_EQ(ParamCheckAtLeastInList(list, 1, "b"), 1);
  EXPECT_EQ(ParamCheckAtLeastInList(list, 2, "a", "a"), 0);  // one record per required name
  EXPECT_EQ(ParamCheckAtLeastInList(list, 3, "b", "A", "c"), 0);
  DomList* twice = MakeList({{"a", "1"}, {"A", "2"}});
  EXPECT_EQ(ParamCheckAtLeastInList(twice, 2, "a", "a"), 1);
  DeleteList(&twice);
  DeleteList(&empty);
  DeleteList(&list);
}

TEST(ParamLookup, CheckParamValue) {
  DomList* list = MakeList({{"opt", "SLOW"}});
  PortTest::Capture cap;
  EXPECT_EQ(ParamCheckParamValue(list, "OPT", nullptr, 2, "fast", "slow"), 2);
  EXPECT_EQ(cap.size(), 0u);
  ParamChangeParamValue(list, "opt", "medium");
  EXPECT_EQ(ParamCheckParamValue(list, "opt", nullptr, 2, "fast", "slow"), 0);
  ExpectOneReport(cap, Port_Error, "Unknown parameter value : allowed values for -opt are fast/slow\n");
  cap.clear();
  EXPECT_EQ(ParamCheckParamValue(list, "opt", "fast", 1, "fast"), 0);
  ExpectOneReport(cap, Port_Error, "Unknown parameter value : allowed values for -opt are fast\n");
  EXPECT_EQ(Show(list), "opt=medium");
  ParamRemoveExistingParam(list, "opt");
  cap.clear();
  EXPECT_EQ(ParamCheckParamValue(list, "opt", nullptr, 2, "fast", "slow"), 1);
  EXPECT_EQ(Show(list), "");
  EXPECT_EQ(ParamCheckParamValue(list, "opt", "medium", 2, "fast", "slow"), 0);
  ExpectOneReport(cap, Port_Error, "Unknown parameter value : bad default value medium for parameter opt\n");
  EXPECT_EQ(ParamCheckParamValue(list, "opt", "SLOW", 2, "fast", "slow"), 1);  // 1, not the position
  EXPECT_EQ(Show(list), "opt=SLOW");
  EXPECT_EQ(ParamCheckParamValue(nullptr, "opt", "fast", 1, "fast"), 0);
  DeleteList(&list);
}

TEST(ParamLookup, YesNo) {
  DomList* list = MakeList({{"a", "yes"}, {"b", "No"}, {"c", "maybe"}});
  PortTest::Capture cap;
  EXPECT_EQ(ParamCheckParamYesNo(list, "A", 0), 1);
  EXPECT_EQ(ParamCheckParamYesNo(list, "b", 1), 0);
  EXPECT_EQ(ParamCheckParamYesNo(list, "d", 7), 7);
  EXPECT_EQ(ParamCheckParamYesNo(nullptr, "a", 5), 5);
  EXPECT_EQ(cap.size(), 0u);
  EXPECT_EQ(ParamCheckParamYesNo(list, "c", 3), 3);
  ExpectOneReport(cap, Port_Warning, "allowed values for -c for are yes/no ; Default value is used!");
  DeleteList(&list);
}

TEST(ParamChange, RemoveKeepsOrder) {
  DomList* list = MakeList({{"a", "1"}, {"b", "2"}, {"B", "3"}, {"c", "4"}});
  ParamRemoveExistingParam(list, "b");
  EXPECT_EQ(Show(list), "a=1;B=3;c=4");
  ParamRemoveExistingParam(list, "zz");
  ParamRemoveExistingParam(nullptr, "a");
  ParamRemoveExistingParamIfValue(list, const_cast<char*>("a"), const_cast<char*>("2"));
  EXPECT_EQ(Show(list), "a=1;B=3;c=4");
  ParamRemoveExistingParamIfValue(list, const_cast<char*>("C"), const_cast<char*>("4"));
  EXPECT_EQ(Show(list), "a=1;B=3");
  DeleteList(&list);
}

TEST(ParamChange, ChangeValueInPlace) {
  DomList* list = MakeList({{"Opt", "Fast"}, {"z", "1"}});
  ParamChangeParamValue(list, "OPT", "x");
  EXPECT_EQ(Show(list), "OPT=x;z=1");
  ParamChangeParamValue(list, "new", nullptr);
  EXPECT_EQ(Show(list), "OPT=x;z=1;new=");
  PortTest::Capture cap;
  ParamChangeParamValue(list, "z", std::string(1020, 'v').c_str());
  EXPECT_EQ(cap.size(), 1u);
  EXPECT_EQ(Show(list), "OPT=x;z=1;new=");  // refused: the old value stays
  ParamChangeParamValue(nullptr, "a", "b");
  DeleteList(&list);
}

TEST(ParamChange, MovesGoToTheEnd) {
  DomList* list = MakeList({{"Opt", "Fast"}, {"z", "1"}});
  ParamMoveParamName(list, "opt", "speed");
  EXPECT_EQ(Show(list), "z=1;speed=Fast");
  ParamMoveParamName(list, "none", "x");
  ParamMoveParamName(list, "z", "speed");  // no search for the new name
  EXPECT_EQ(Show(list), "speed=Fast;speed=1");
  ParamMoveParamValue(list, "SPEED", "fast", "slow");
  EXPECT_EQ(Show(list), "speed=1;SPEED=slow");
  ParamMoveParamValue(list, "speed", "2", "3");
  EXPECT_EQ(Show(list), "speed=1;SPEED=slow");
  ParamMoveParamName(nullptr, "a", "b");
  ParamMoveParamValue(nullptr, "a", "b", "c");
  DeleteList(&list);
}

TEST(ParamChange, MoveFromList) {
  DomList* from = MakeList({{"opt", "Fast"}, {"k", "1"}});
  DomList* to = MakeList({{"OPT", "fast"}, {"m", "2"}});
  PortTest::Capture cap;
  ParamMoveFromList(from, to, "Opt");  // equal ignoring case: silent
  EXPECT_EQ(cap.size(), 0u);
  EXPECT_EQ(Show(to), "m=2;Opt=Fast");
  ParamChangeParamValue(from, "opt", "slow");
  ParamMoveFromList(from, to, "opt");
  ExpectOneReport(cap, Port_Warning, "Overwritting parameter opt\n");
  EXPECT_EQ(Show(to), "m=2;opt=slow");
  EXPECT_EQ(Show(from), "opt=slow;k=1");
  cap.clear();
  ParamMoveFromList(from, to, "absent");
  ParamMoveFromList(nullptr, to, "k");
  ParamMoveFromList(from, nullptr, "k");
  ParamMoveFromListWithDefault(from, to, "absent", nullptr);
  EXPECT_EQ(Show(to), "m=2;opt=slow");
  ParamMoveFromListWithDefault(from, to, "M", "3");
  ExpectOneReport(cap, Port_Warning, "Overwritting parameter M\n");
  EXPECT_EQ(Show(to), "opt=slow;M=3");
  ParamMoveFromListWithDefault(from, to, "k", "9");
  EXPECT_EQ(Show(to), "opt=slow;M=3;k=1");
  ParamMoveFromList(to, to, "opt");  // a list into itself
  EXPECT_EQ(Show(to), "M=3;k=1;opt=slow");
  DeleteList(&from);
  DeleteList(&to);
}

TEST(ParamChange, ExpandParam) {
  char original[] = "text";
  char* text = original;
  DomList* list = ListCreate();
  ParamExpandParam(&text, list);
  ParamExpandParam(&text, nullptr);
  EXPECT_EQ(text, original);
  DeleteList(&list);
  list = MakeList({{"a", "1"}});
  ParamExpandParam(&text, list);
  EXPECT_STREQ(text, "");
  EXPECT_STREQ(original, "text");
  DeleteList(&list);
}

TEST(ParamPrint, BothFormats) {
  DomList* list = MakeList({{"a", "1"}, {"B", ""}});
  PortTest::Capture cap;
  DomParamLPrint(list);
  ParamNicePrint(list);
  ASSERT_EQ(cap.size(), 6u);
  for (size_t i = 0; i < cap.size(); ++i) {
    EXPECT_EQ(cap[i].level, Port_Status);
    EXPECT_EQ(cap[i].unit, "../s/paramutl");
  }
  EXPECT_EQ(cap.text(), "CharParamQual = a\nCharParam     = 1\nCharParamQual = B\nCharParam     = \n"
                        "a\t1\nB\t\n");
  DomList* empty = ListCreate();
  cap.clear();
  DomParamLPrint(empty);
  ParamNicePrint(empty);
  DomParamLPrint(nullptr);
  EXPECT_EQ(cap.size(), 0u);
  DeleteList(&empty);
  DeleteList(&list);
}

TEST(ParamChange, ExpandEnvVar) {
  setenv("DUDUZU_PARAM_DIR", "/h", 1);
  unsetenv("DUDUZU_PARAM_UNSET");
  DomList* list = MakeList({{"a", "x"}, {"b", "$DUDUZU_PARAM_UNSET/y"}, {"A", "$DUDUZU_PARAM_DIR/z"}});
  EXPECT_EQ(ParamExpandEnvVar(list), 1);
  // The expanded record keeps its place, and the earlier record of the same name is untouched.
  EXPECT_EQ(Show(list), "a=x;b=$DUDUZU_PARAM_UNSET/y;A=/h/z");
  EXPECT_EQ(ParamExpandEnvVar(list), 0);
  EXPECT_EQ(ParamExpandEnvVar(nullptr), 0);
  setenv("DUDUZU_PARAM_DIR", std::string(1020, 'd').c_str(), 1);
  DomList* longer = MakeList({{"a", "$DUDUZU_PARAM_DIR"}});
  PortTest::Capture cap;
  EXPECT_EQ(ParamExpandEnvVar(longer), 0);  // too long for the field: kept as it was
  EXPECT_EQ(cap.size(), 1u);
  EXPECT_EQ(Show(longer), "a=$DUDUZU_PARAM_DIR");
  DeleteList(&longer);
  DeleteList(&list);
}

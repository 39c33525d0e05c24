#include <cstdlib>
#include <cstring>

#include "param_test_util.h"

TEST(ParamRecord, LimitsCopyAndNoMemory) {
  std::string name254(254, 'n'), value1019(1019, 'v');
  DomParam* p = ParamCreateParam(name254.c_str(), value1019.c_str());
  DomParam* q = ParamCopy(p);
  EXPECT_TRUE(q != p && memcmp(p, q, sizeof(DomParam)) == 0 && reinterpret_cast<char*>(q) == name254);
  ParamFree(&p);
  ParamFree(&q);
  EXPECT_TRUE(p == nullptr && ParamCopy(nullptr) == nullptr);
  p = ParamCreateParam(nullptr, nullptr);
  EXPECT_EQ(std::string(p->CharParamQual) + p->CharParam, "");
  ParamFree(&p);
  PortTest::Capture cap;
  EXPECT_EQ(ParamCreateParam((name254 + "n").c_str(), "v"), nullptr);
  EXPECT_EQ(ParamCreateParam("opt", (value1019 + "v").c_str()), nullptr);
  DomList* list = MakeList({{"a", "1"}});
  PortTest::AllocFailureGuard guard;
  PortTest::FailNthAlloc(1);
  ParamChangeParamValue(list, "A", "2");  // nothing made: the list stays as it was
  EXPECT_EQ(Reports(cap), "4:Parameter name too long (255 characters, at most 254) : " + name254 +
                              "n\n4:Parameter value too long (1020 characters, at most 1019) for opt\n"
                              "4:Memory Full (ParamCreateParam)\n");
  EXPECT_EQ(Show(list), "a=1");
  DeleteList(&list);
}

TEST(ParamLookup, FindCheckAllowedValuesAndYesNo) {
  DomList* list = MakeList({{"Opt", "SLOW"}, {"opt", "second"}, {"y", "yes"}, {"n", "No"}, {"m", "maybe"}});
  char* in = ParamFindNamedParam(list, "OPT");
  EXPECT_TRUE(!ParamFindNamedParam(list, "ofn") && !ParamFindNamedParam(nullptr, "opt"));
  // The first record decides; 2 for no record, 0 for no list.
  EXPECT_EQ(ParamFindParamValue(list, "opt", "slow") * 100 + ParamFindParamValue(list, "opt", "second") * 10 +
                ParamFindParamValue(list, "speed", "x") + ParamFindParamValue(nullptr, "opt", "SLOW"),
            102);
  EXPECT_EQ(ParamCheckInList(list, 4, "OPT", "y", "N", "m") * 10 + ParamCheckInList(list, 1, "opt"), 10);
  EXPECT_EQ(ParamCheckAtLeastInList(list, 2, "opt", "Opt") * 10 + ParamCheckAtLeastInList(list, 2, "y", "y"), 10);
  EXPECT_EQ(ParamCheckInList(nullptr, 0) * 10 + ParamCheckAtLeastInList(nullptr, 1, "a"), 10);
  PortTest::Capture cap;
  EXPECT_EQ(ParamCheckParamValue(list, "OPT", nullptr, 2, "fast", "slow"), 2);
  EXPECT_EQ(ParamCheckParamValue(list, "m", nullptr, 2, "fast", "slow"), 0);
  EXPECT_EQ(ParamCheckParamValue(list, "x", nullptr, 2, "fast", "slow"), 1);  // absent, no default: nothing added
  EXPECT_EQ(ParamCheckParamValue(list, "x", "medium", 2, "fast", "slow"), 0);
  EXPECT_EQ(ParamCheckParamValue(list, "x", "SLOW", 2, "fast", "slow"), 1);  // default added: 1, not the position
  EXPECT_EQ(ParamCheckParamYesNo(list, "Y", 0) * 10 + ParamCheckParamYesNo(list, "n", 1), 10);
  EXPECT_EQ(ParamCheckParamYesNo(list, "z", 7) + ParamCheckParamYesNo(nullptr, "y", 5), 12);
  EXPECT_EQ(ParamCheckParamYesNo(list, "m", 3), 3);
  EXPECT_EQ(Reports(cap), "4:Unknown parameter value : allowed values for -m are fast/slow\n"
                          "4:Unknown parameter value : bad default value medium for parameter x\n"
                          "1:allowed values for -m for are yes/no ; Default value is used!");
  EXPECT_EQ(Show(list), "Opt=SLOW;opt=second;y=yes;n=No;m=maybe;x=SLOW");
  DeleteList(&list);
  EXPECT_EQ(Owned(in), "SLOW");  // a fresh copy outlives the list
}

TEST(ParamChange, InPlaceOrMovedToTheEnd) {
  DomList* list = MakeList({{"a", "1"}, {"Opt", "Fast"}, {"b", "2"}, {"c", "4"}});
  ParamRemoveExistingParam(list, "B");
  ParamRemoveExistingParamIfValue(list, C("a"), C("2"));
  ParamRemoveExistingParamIfValue(list, C("C"), C("4"));
  ParamChangeParamValue(list, "A", "x");  // in place, with the caller's case
  ParamChangeParamValue(list, "new", nullptr);
  ParamMoveParamName(list, "opt", "speed");
  ParamMoveParamName(list, "new", "SPEED");  // no search for the new name
  ParamMoveParamValue(list, "speed", "fast", "slow");
  ParamMoveParamValue(list, "a", "y", "z");
  PortTest::Capture cap;
  ParamChangeParamValue(list, "A", std::string(1020, 'v').c_str());
  ParamMoveParamValue(list, "A", "x", std::string(1020, 'v').c_str());
  EXPECT_EQ(cap.size(), 2u);
  cap.clear();
  EXPECT_EQ(Show(list), "A=x;SPEED=;speed=slow");  // the long values refused
  DomList* to = MakeList({{"A", "X"}, {"m", "2"}, {"k", "1"}});
  ParamMoveFromList(list, to, "a");  // equal ignoring case: silent
  ParamMoveFromList(list, to, "absent");
  ParamMoveFromList(nullptr, to, "speed");
  ParamMoveFromListWithDefault(list, to, "M", "3");
  ParamMoveFromList(to, to, "k");  // a list into itself
  EXPECT_EQ(Show(to) + " " + Show(list), "a=x;M=3;k=1 A=x;SPEED=;speed=slow");
  EXPECT_EQ(Reports(cap), "1:Overwritting parameter M\n");
  DeleteList(&to);
  DeleteList(&list);
}

TEST(ParamChange, ExpandEnvVarExpandParamAndPrint) {
  setenv("DUDUZU_PARAM_DIR", "/h", 1);
  unsetenv("DUDUZU_PARAM_UNSET");
  DomList* list = MakeList({{"a", "x"}, {"b", "$DUDUZU_PARAM_UNSET/y"}, {"A", "$DUDUZU_PARAM_DIR/z"}});
  EXPECT_EQ(ParamExpandEnvVar(list), 1);
  // The expanded record keeps its place; the earlier record of the same name is untouched.
  EXPECT_EQ(Show(list), "a=x;b=$DUDUZU_PARAM_UNSET/y;A=/h/z");
  EXPECT_EQ(ParamExpandEnvVar(list) + ParamExpandEnvVar(nullptr), 0);
  char original[] = "text";
  char* text = original;
  ParamExpandParam(&text, nullptr);
  EXPECT_EQ(text, original);
  ParamExpandParam(&text, list);
  EXPECT_EQ(std::string(text) + original, "text");
  PortTest::Capture cap;
  ParamRemoveExistingParam(list, "b");
  DomParamLPrint(list);
  ParamNicePrint(list);
  EXPECT_EQ(Reports(cap), "2:CharParamQual = a\n2:CharParam     = x\n2:CharParamQual = A\n"
                          "2:CharParam     = /h/z\n2:a\tx\n2:A\t/h/z\n");
  DeleteList(&list);
}

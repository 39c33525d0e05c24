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
  PortTest::Capture cap;
  EXPECT_TRUE(!ParamCreateParam((name254 + "n").c_str(), "v") && !ParamCreateParam("opt", (value1019 + "v").c_str()));
  DomList* list = MakeList({{"a", "1"}, {nullptr, nullptr}});  // no name, no value: empty ones
  PortTest::AllocFailureGuard guard;
  PortTest::FailNthAlloc(1);
  ParamChangeParamValue(list, "new", "2");  // nothing made: the list stays as it was
  DomParamLPrint(list);
  EXPECT_EQ(Reports(cap), "4:Parameter name too long (255 characters, at most 254) : " + name254 +
                              "n\n4:Parameter value too long (1020 characters, at most 1019) for opt\n"
                              "4:Memory Full (ParamCreateParam)\n2:CharParamQual = a\n2:CharParam     = 1\n"
                              "2:CharParamQual = \n2:CharParam     = \n");
  DeleteList(&list);
}

TEST(ParamLookup, FindCheckAllowedValuesAndYesNo) {
  DomList* list = MakeList({{"Opt", "SLOW"}, {"opt", "second"}, {"y", "yes"}, {"n", "No"}, {"m", "maybe"}});
  EXPECT_EQ(Owned(ParamFindNamedParam(list, "OPT")), "SLOW");  // a copy: the list still frees its own
  // The first record decides; 2 for no record, 0 for no list.
  EXPECT_EQ(ParamFindParamValue(list, "opt", "slow") * 100 + ParamFindParamValue(list, "opt", "second") * 10 +
                ParamFindParamValue(list, "speed", "x") + ParamFindParamValue(nullptr, "opt", "SLOW"),
            102);
  EXPECT_EQ(ParamCheckInList(list, 4, "OPT", "y", "N", "m") * 1000 + ParamCheckInList(list, 1, "opt") * 100 +
                ParamCheckAtLeastInList(list, 2, "opt", "Opt") * 10 + ParamCheckAtLeastInList(list, 2, "y", "y"),
            1010);
  PortTest::Capture cap;
  // An absent name without default adds nothing (1); a good default is added (1, not its position).
  for (auto [name, def, want] : {std::tuple<const char*, const char*, int>{"OPT", nullptr, 2}, {"m", nullptr, 0},
                                 {"x", nullptr, 1}, {"x", "medium", 0}, {"x", "SLOW", 1}})
    EXPECT_EQ(ParamCheckParamValue(list, name, def, 2, "fast", "slow"), want) << name;
  EXPECT_EQ(ParamCheckParamYesNo(list, "Y", 0) * 10 + ParamCheckParamYesNo(list, "n", 1), 10);
  EXPECT_EQ(ParamCheckParamYesNo(list, "z", 7) + ParamCheckParamYesNo(nullptr, "y", 5), 12);
  EXPECT_EQ(ParamCheckParamYesNo(list, "m", 3), 3);
  EXPECT_EQ(Reports(cap) + Show(list), "4:Unknown parameter value : allowed values for -m are fast/slow\n"
                                       "4:Unknown parameter value : bad default value medium for parameter x\n"
                                       "1:allowed values for -m for are yes/no ; Default value is used!"
                                       "Opt=SLOW;opt=second;y=yes;n=No;m=maybe;x=SLOW");
  DeleteList(&list);
}

TEST(ParamChange, InPlaceMovedToTheEndExpandedAndPrinted) {
  setenv("DUDUZU_PARAM_DIR", "/h", 1);
  DomList* list = MakeList({{"a", "1"}, {"Opt", "Fast"}, {"b", "2"}, {"A", "$DUDUZU_PARAM_DIR/z"}});
  ParamRemoveExistingParamIfValue(list, C("B"), C("2"));
  ParamRemoveExistingParamIfValue(list, C("a"), C("2"));
  ParamChangeParamValue(list, "A", "x");  // in place, with the caller's case
  ParamChangeParamValue(list, "new", nullptr);
  ParamMoveParamName(list, "opt", "speed");
  ParamMoveParamName(list, "new", "SPEED");  // no search for the new name
  ParamMoveParamValue(list, "speed", "fast", "slow");
  EXPECT_EQ(ParamExpandEnvVar(list), 1);
  EXPECT_EQ(ParamExpandEnvVar(list) + ParamExpandEnvVar(nullptr), 0);
  DomList* to = MakeList({{"A", "X"}, {"m", "2"}, {"k", "1"}});
  PortTest::Capture cap;
  ParamMoveFromList(list, to, "a");  // equal ignoring case: silent
  ParamMoveFromList(nullptr, to, "speed");
  ParamMoveFromListWithDefault(list, to, "M", "3");
  ParamMoveFromList(to, to, "k");  // a list into itself
  // The expanded record keeps its place; the earlier record of the same name is untouched.
  EXPECT_EQ(Show(to) + " " + Show(list), "a=x;M=3;k=1 A=x;A=/h/z;SPEED=;speed=slow");
  ParamNicePrint(to);
  EXPECT_EQ(Reports(cap), "1:Overwritting parameter M\n2:a\tx\n2:M\t3\n2:k\t1\n");
  char original[] = "text", *text = original, *emptied = original;
  ParamExpandParam(&text, nullptr);  // no list: untouched; a list: the empty text
  ParamExpandParam(&emptied, list);
  EXPECT_EQ(std::string(text) + "|" + emptied + "|" + original, "text||text");
  DeleteList(&to);
  DeleteList(&list);
}

TEST(ParamDef, StateSetGetOrderAndPrint) {
  PortTest::Capture cap;
  EXPECT_TRUE(ParamDefGetInt("x") == -1 && ParamDefGetFloat("x") == -1.0f && !ParamDefGetStr("x"));
  ParamDefPrint();  // no list: the title only
  ParamDefSetStr("a", "1");
  ParamDefFree();  // "a" then no longer printed
  ParamDefSetStr("opt", "12");
  ParamDefSetStr("b", "x");
  ParamDefSetStr("OPT", "7");  // moves to the end with the latest case
  ParamDefSetInt("n", 0);
  ParamDefSetInt("b", -1);  // a negative int (an empty value): removed
  ParamDefSetStr("f", "2.5e1");
  EXPECT_EQ(ParamDefGetFloat("f") * 10 + ParamDefGetInt("f"), 252.0f);  // as atof and atoi read it
  ParamDefSetStr("f", std::string(1020, 'v').c_str());  // refused: the old value stays
  ParamDefPrint();
  EXPECT_EQ(Reports(cap), "2:--- Global Param List:\n4:Parameter value too long (1020 characters, at most 1019) for f\n"
                          "2:--- Global Param List:\n2:OPT\t7\n2:n\t0\n2:f\t2.5e1\n");
}

#include <gtest/gtest.h>

#include <string>

#include "param_test_util.h"

TEST(ParamDef, ReadingWithoutDefaults) {
  PortTest::Capture cap;
  EXPECT_EQ(ParamDefGetInt("x"), -1);
  EXPECT_EQ(ParamDefGetFloat("x"), -1.0f);
  EXPECT_EQ(ParamDefGetStr("x"), nullptr);
  ParamDefPrint();  // only the heading: reading created no list
  ExpectOneReport(cap, Port_Status, "--- Global Param List:\n");
  cap.clear();
  ParamDefPrintFormatted();
  ParamDefFree();
  EXPECT_EQ(cap.size(), 0u);
}

TEST(ParamDef, SettingAgainMovesToTheEnd) {
  ParamDefSetStr("opt", "12");
  ParamDefSetStr("b", "x");
  ParamDefSetStr("OPT", "7");
  EXPECT_EQ(ParamDefGetInt("opt"), 7);
  EXPECT_EQ(Owned(ParamDefGetStr("Opt")), "7");
  PortTest::Capture cap;
  ParamDefPrint();
  EXPECT_EQ(cap.text(), "--- Global Param List:\nb\tx\nOPT\t7\n");
  for (size_t i = 0; i < cap.size(); ++i) EXPECT_EQ(cap[i].level, Port_Status);
  cap.clear();
  ParamDefPrintFormatted();
  EXPECT_EQ(cap.text(), "b\tx\nOPT\t7\n");
  ParamDefFree();
}

TEST(ParamDef, IntsFloatsAndRemoval) {
  ParamDefSetInt("n", 0);
  EXPECT_EQ(Owned(ParamDefGetStr("n")), "0");
  ParamDefSetInt("n", 2147483647);
  EXPECT_EQ(ParamDefGetInt("N"), 2147483647);
  ParamDefSetInt("n", -1);
  EXPECT_EQ(ParamDefGetStr("n"), nullptr);
  ParamDefSetStr("f", "2.5e1");
  EXPECT_EQ(ParamDefGetFloat("f"), 25.0f);
  EXPECT_EQ(ParamDefGetInt("f"), 2);  // as atoi reads it
  ParamDefSetStr("w", "word");
  EXPECT_EQ(ParamDefGetInt("w"), 0);
  EXPECT_EQ(ParamDefGetFloat("w"), 0.0f);
  ParamDefSetStr("w", "");
  ParamDefSetStr("f", nullptr);
  EXPECT_EQ(ParamDefGetStr("w"), nullptr);
  EXPECT_EQ(ParamDefGetStr("f"), nullptr);
  PortTest::Capture cap;
  ParamDefPrint();
  EXPECT_EQ(cap.text(), "--- Global Param List:\n");
  ParamDefFree();
}

TEST(ParamDef, FreeThenSetAgain) {
  ParamDefSetStr("e", "");  // creates the empty list, adds nothing
  PortTest::Capture cap;
  ParamDefPrint();
  EXPECT_EQ(cap.size(), 1u);
  ParamDefSetStr("a", "1");
  ParamDefFree();
  EXPECT_EQ(ParamDefGetStr("a"), nullptr);
  ParamDefFree();
  ParamDefSetStr("a", "2");
  EXPECT_EQ(ParamDefGetInt("a"), 2);
  ParamDefFree();
}

TEST(ParamDef, RefusedValueKeepsTheOldDefault) {
  ParamDefSetStr("a", "1");
  PortTest::Capture cap;
  ParamDefSetStr("a", std::string(1020, 'v').c_str());
  ExpectOneReport(cap, Port_Error, "Parameter value too long (1020 characters, at most 1019) for a\n");
  EXPECT_EQ(Owned(ParamDefGetStr("a")), "1");
  ParamDefSetStr("a", std::string(1019, 'v').c_str());
  EXPECT_EQ(Owned(ParamDefGetStr("a")).size(), 1019u);
  ParamDefFree();
}

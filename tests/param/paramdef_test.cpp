#include "param_test_util.h"

TEST(ParamDef, StateSetGetOrderAndPrint) {
  PortTest::Capture cap;
  EXPECT_EQ(ParamDefGetInt("x") + ParamDefGetFloat("x"), -2.0f);
  EXPECT_EQ(ParamDefGetStr("x"), nullptr);
  ParamDefPrintFormatted();
  ParamDefPrint();  // no list: the title only
  ParamDefSetStr("a", "1");
  ParamDefFree();
  EXPECT_EQ(ParamDefGetStr("a"), nullptr);
  ParamDefSetStr("opt", "12");
  ParamDefSetStr("b", "x");
  ParamDefSetStr("OPT", "7");  // moves to the end with the latest case
  ParamDefPrintFormatted();
  ParamDefSetInt("n", 0);
  EXPECT_EQ(Owned(ParamDefGetStr("N")), "0");
  ParamDefSetInt("n", -1);  // a negative int, a null or empty value: removed
  ParamDefSetStr("b", nullptr);
  ParamDefSetStr("f", "2.5e1");
  EXPECT_EQ(ParamDefGetFloat("f") * 10 + ParamDefGetInt("f"), 252.0f);  // as atof and atoi read it
  ParamDefSetStr("f", "word");
  EXPECT_EQ(ParamDefGetInt("f") + ParamDefGetFloat("f"), 0.0f);
  EXPECT_EQ(Reports(cap), "2:--- Global Param List:\n2:b\tx\n2:OPT\t7\n");
  ParamDefSetStr("f", std::string(1020, 'v').c_str());  // refused: the old value stays
  cap.clear();
  ParamDefPrint();
  EXPECT_EQ(Reports(cap), "2:--- Global Param List:\n2:OPT\t7\n2:f\tword\n");
  ParamDefFree();
}

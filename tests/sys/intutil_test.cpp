#include <gtest/gtest.h>

#include <climits>
#include <cmath>
#include <cstdint>
#include <string>

#include "duduzu/intutil.h"
#include "duduzu/session.h"
#include "port/port_testing.h"

namespace {

std::string Owned(char* s) {
  std::string r = s ? s : "<null>";
  vzl_free(s);
  return r;
}

}  // namespace

TEST(IntCompare, ComparatorsAndMembership) {
  EXPECT_EQ(Max(3, 2), 3);
  EXPECT_EQ(Max(-3, 2), 2);
  EXPECT_EQ(LongCopy(-5L), -5L);
  EXPECT_EQ(IntIdentical(4, 4), 1);
  EXPECT_EQ(IntIdentical(4, 5), 0);
  int x = 0, y = 0;
  EXPECT_EQ(PtrIdentical(&x, &x), 1);
  EXPECT_EQ(PtrIdentical(&x, &y), 0);
  EXPECT_EQ(IntCompare(-1, 1), -1);
  EXPECT_EQ(IntCompare(INT_MAX, INT_MIN), 1);
  EXPECT_EQ(LongCompare(LONG_MIN, LONG_MIN), 0);
  EXPECT_EQ(UnsLessOrEqual(4294967295u, 1), 0);
  EXPECT_EQ(UnsLessOrEqual(1, 4294967295u), 1);
  DomList* list = ListCreate();
  for (intptr_t v : {5, 9, 12}) ListAddElt(list, reinterpret_cast<int*>(v));
  EXPECT_EQ(IntMemberOfList(list, 12), 1);  // found third: still 1, not a position
  EXPECT_EQ(IntMemberOfList(list, 7), 0);
  ListQuickDelete(&list);
}

TEST(IntPrint, MainOutputRule) {
  PortTest::Capture cap;
  MainEVarOutFile = nullptr;
  IntPrint(nullptr, -17);  // null stream equals the null main output
  ASSERT_EQ(cap.size(), 1u);
  EXPECT_EQ(cap[0].level, Port_Status);
  EXPECT_EQ(cap[0].text, "-17");
  EXPECT_EQ(cap[0].unit, "../s/intutil");
  FILE* f = tmpfile();
  IntPrint(f, 42);
  rewind(f);
  char buf[8] = {};
  EXPECT_EQ(fgets(buf, sizeof buf, f), buf);
  EXPECT_STREQ(buf, "42");
  EXPECT_EQ(cap.size(), 1u);
  fclose(f);
}

TEST(IntLog, LogarithmsAtPowerBoundaries) {
  EXPECT_EQ(IntSupLog2(0), -1);
  EXPECT_EQ(IntSupLog2(1), 0);
  EXPECT_EQ(IntSupLog2(3), 2);
  EXPECT_EQ(IntSupLog2(5), 3);
  EXPECT_EQ(IntSupLog2(1024), 10);
  EXPECT_EQ(IntSupLog2(1025), 11);
  EXPECT_EQ(IntSupLog2(1u << 31), 31);
  EXPECT_EQ(IntInfLog2(0), -1);
  EXPECT_EQ(IntInfLog2(1), 0);
  EXPECT_EQ(IntInfLog2(1023), 9);
  EXPECT_EQ(IntInfLog2(1u << 31), 31);
  EXPECT_EQ(IntInfLog2(4294967295u), 31);
  EXPECT_EQ(IntSupLog10(0), -1);
  EXPECT_EQ(IntSupLog10(1), 0);
  EXPECT_EQ(IntSupLog10(11), 2);
  EXPECT_EQ(IntSupLog10(1000), 3);
  EXPECT_EQ(IntSupLog10(1001), 4);
  EXPECT_EQ(IntSupLog10(1000000000), 9);
  EXPECT_EQ(IntInfLog10(-5), -1);
  EXPECT_EQ(IntInfLog10(9), 0);
  EXPECT_EQ(IntInfLog10(10), 1);
  EXPECT_EQ(IntInfLog10(999), 2);
  EXPECT_EQ(IntInfLog10(1000000000), 9);
  EXPECT_EQ(IntSupLogk(27, 3), 3);
  EXPECT_EQ(IntSupLogk(28, 3), 4);
  EXPECT_EQ(IntSupLogk(0, 3), -1);
  EXPECT_EQ(IntSupLogk(5, 1), -1);  // no logarithm in base 1: returns at once
  EXPECT_EQ(IntSupLog2f(1.0), 0);
  EXPECT_EQ(IntSupLog2f(8.0), 3);
  EXPECT_EQ(IntSupLog2f(8.5), 4);
  EXPECT_EQ(IntSupLog2f(-3.0), 0);
  EXPECT_EQ(IntSupLog2f(NAN), 0);
  EXPECT_EQ(IntSupLog2f(INFINITY), 0);
}

TEST(IntBits, PowerOf2AndFirstBit) {
  unsigned e = 99;
  EXPECT_EQ(IntIsPowerOf2(64, &e), 1);
  EXPECT_EQ(e, 6u);
  EXPECT_EQ(IntIsPowerOf2(1, &e), 1);
  EXPECT_EQ(e, 0u);
  EXPECT_EQ(IntIsPowerOf2(1 << 30, &e), 1);
  EXPECT_EQ(e, 30u);
  e = 99;
  EXPECT_EQ(IntIsPowerOf2(96, &e), 0);
  EXPECT_EQ(e, 0u);
  EXPECT_EQ(IntIsPowerOf2(0, &e), 0);
  EXPECT_EQ(IntIsPowerOf2(INT_MIN, &e), 0);
  EXPECT_EQ(IntLocateFirstBit1(12), 3);
  EXPECT_EQ(IntLocateFirstBit1(1), 1);
  EXPECT_EQ(IntLocateFirstBit1(0), 0);
  EXPECT_EQ(IntLocateFirstBit1(INT_MIN), 32);
}

TEST(FloatCompare, DecimalPlaces) {
  EXPECT_EQ(FloatEq(1.234f, 1.236f, 2), 1);
  EXPECT_EQ(FloatEq(1.234f, 1.236f, 3), 0);
  EXPECT_EQ(FloatLess(1.234f, 1.236f, 3), 1);
  EXPECT_EQ(FloatLess(1.234f, 1.236f, 2), 0);
  EXPECT_EQ(FloatGreat(1.236f, 1.234f, 3), 1);
  EXPECT_EQ(FloatGreat(1.234f, 1.236f, 3), 0);
  EXPECT_EQ(FloatEq(0.0f, 0.5f, 0), 0);  // the bound is strict
  EXPECT_EQ(FloatEq(0.0f, 0.49999997f, 0), 1);
  float a = 1.0f, b = 2.0f;
  EXPECT_EQ(FloatPtrCmp(&a, &b, 1), -1);
  EXPECT_EQ(FloatPtrCmp(&b, &a, 1), 1);
  EXPECT_EQ(FloatPtrCmp(&a, &b, 0), -1);
  b = 1.4f;
  EXPECT_EQ(FloatPtrCmp(&a, &b, 0), 0);
  EXPECT_EQ(FloatEq(3.0f, 3.0f, 60), 1);  // scale overflows, equal stays equal
  EXPECT_EQ(FloatEq(3.0f, 3.0000002f, 60), 0);
}

TEST(FloatCompare, SinglePrecisionRoundingEdges) {
  // 0.005f is just below 0.005, but its product with 100 rounds to 0.5 in
  // single precision: not equal at two places. The float below it is.
  EXPECT_EQ(FloatEq(0x1.47ae14p-8f, 0.0f, 2), 0);
  EXPECT_EQ(FloatEq(0x1.47ae12p-8f, 0.0f, 2), 1);
  // At 25 places the scale made by 25 single-precision products exceeds the
  // float nearest 1e25; this difference sits between the two.
  EXPECT_EQ(FloatEq(0x1.ef2d0ep-85f, 0.0f, 25), 0);
  EXPECT_EQ(FloatEq(0x1.ef2d0cp-85f, 0.0f, 25), 1);
  EXPECT_EQ(FloatGreat(0x1.ef2d0ep-85f, 0.0f, 25), 1);
}

TEST(FloatRoot, NewtonWithinOneHundredth) {
  EXPECT_NEAR(FloatSquareRoot(4.0), 2.0, 0.01);
  EXPECT_EQ(FloatSquareRoot(-4.0), -1.0);
  EXPECT_EQ(FloatSquareRoot(0.0), 0.0);
  for (double x : {2.0, 0.25, 1e6, 12345.678, 1e300})
    EXPECT_NEAR(FloatSquareRoot(x), std::sqrt(x), 0.01 + 1e-12 * std::sqrt(x)) << x;
  EXPECT_EQ(FloatSquareRoot(INFINITY), INFINITY);
  EXPECT_TRUE(std::isnan(FloatSquareRoot(NAN)));
}

TEST(IntText, QuotedNumbers) {
  EXPECT_EQ(Owned(IntToHexa(255, 4)), "\"00ff\"");
  EXPECT_EQ(Owned(IntToHexa(255, 0)), "\"ff\"");
  EXPECT_EQ(Owned(IntToHexa(-1, 2)), "\"ffffffff\"");
  EXPECT_EQ(Owned(IntToStr(-42)), "\"-42\"");
  EXPECT_EQ(Owned(IntToStr(7)).size(), 3u);
  EXPECT_EQ(Owned(IntToStr(INT_MIN)), "\"-2147483648\"");
  std::string wide = Owned(IntToHexa(0xabc, 5000));  // far beyond any fixed buffer
  ASSERT_EQ(wide.size(), 5002u);
  EXPECT_EQ(wide, "\"" + std::string(4997, '0') + "abc\"");
  PortTest::AllocFailureGuard guard;
  PortTest::FailNthAlloc(1);
  EXPECT_EQ(IntToStr(1), nullptr);
}

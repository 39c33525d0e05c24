#include <gtest/gtest.h>

#include <climits>
#include <cmath>

#include "duduzu/intutil.h"
#include "support/owned.h"
#include "support/reports.h"

TEST(IntCompare, SignedUnsignedMembershipPrintAndText) {
  EXPECT_EQ(IntCompare(INT_MIN, INT_MAX) + UnsLessOrEqual(4294967295u, 1), -1);
  DomList* list = ListCreate();
  for (intptr_t v : {5, 9, 12}) ListAddElt(list, reinterpret_cast<int*>(v));
  EXPECT_EQ(IntMemberOfList(list, 12) * 10 + IntMemberOfList(list, 7), 10);  // found third: 1, not a position
  ListQuickDelete(&list);
  PortTest::Capture cap;
  IntPrint(nullptr, -17);  // a null stream is the null main output
  EXPECT_EQ(Reports(cap, "../s/intutil"), "2:-17");
  EXPECT_EQ(Owned(IntToHexa(255, 4)) + Owned(IntToHexa(-1, 2)) + Owned(IntToStr(-42)), "\"00ff\"\"ffffffff\"\"-42\"");
  EXPECT_EQ(Owned(IntToHexa(0xabc, 5000)), "\"" + std::string(4997, '0') + "abc\"");  // beyond any fixed buffer
  PortTest::AllocFailureGuard guard;
  PortTest::FailNthAlloc(1);
  EXPECT_EQ(IntToStr(1), nullptr);
}

TEST(IntLog, LogarithmsAtPowerBoundaries) {
  for (auto [n, sup, inf] : {std::tuple{0u, -1, -1}, {1u, 0, 0}, {1024u, 10, 10}, {1025u, 11, 10}, {~0u, 32, 31}})
    EXPECT_EQ(std::pair(IntSupLog2(n), IntInfLog2(n)), std::pair(sup, inf)) << n;
  EXPECT_EQ(std::tuple(IntSupLog10(9), IntInfLog10(9), IntSupLog10(10), IntInfLog10(10), IntSupLog10(1001)),
            std::tuple(1, 0, 1, 1, 4));  // the same search as base 2
  EXPECT_EQ(IntSupLogk(27, 3) * 100 + IntSupLogk(28, 3) * 10 + IntSupLogk(5, 1), 339);  // base 1: -1 at once
  for (auto [x, r] : {std::pair{8.0, 3}, {8.5, 4}, {-3.0, 0}, {NAN, 0}, {INFINITY, 0}}) EXPECT_EQ(IntSupLog2f(x), r);
  auto pow2 = [](int n) { unsigned e = 99; return IntIsPowerOf2(n, &e) * 100 + e; };
  for (auto [n, yes, exp] : {std::tuple{64, 1, 6u}, {1, 1, 0u}, {1 << 30, 1, 30u}, {96, 0, 0u}, {INT_MIN, 0, 0u}})
    EXPECT_EQ(pow2(n), yes * 100 + exp) << n;
  for (auto [n, bit] : {std::pair{12, 3}, {0, 0}, {INT_MIN, 32}}) EXPECT_EQ(IntLocateFirstBit1(n), bit) << n;
}

TEST(FloatCompare, DecimalPlacesRoundingEdgesAndRoot) {
  EXPECT_EQ(FloatEq(1.234f, 1.236f, 2) + FloatLess(1.234f, 1.236f, 3) + FloatGreat(1.236f, 1.234f, 3), 3);
  EXPECT_EQ(FloatEq(1.234f, 1.236f, 3) + FloatLess(1.234f, 1.236f, 2) + FloatEq(0.0f, 0.5f, 0), 0);
  float a = 1.0f, b = 2.0f, c = 1.4f;
  EXPECT_EQ(FloatPtrCmp(&a, &b, 1) * 10 + FloatPtrCmp(&b, &a, 0) + FloatPtrCmp(&a, &c, 0), -9);
  EXPECT_EQ(FloatEq(3.0f, 3.0f, 60), 1);  // the scale overflows; equal stays equal
  // 0.005f lies just below 0.005, yet its product with 100 rounds to 0.5 in
  // single precision: not equal at two places. The float below it is.
  EXPECT_EQ(FloatEq(0x1.47ae14p-8f, 0.0f, 2) * 10 + FloatEq(0x1.47ae12p-8f, 0.0f, 2), 1);
  // The scale made by 25 single-precision products exceeds the float nearest
  // 1e25; this difference lies between the two bounds.
  EXPECT_EQ(FloatEq(0x1.ef2d0ep-85f, 0.0f, 25) * 10 + FloatEq(0x1.ef2d0cp-85f, 0.0f, 25), 1);
  EXPECT_EQ(FloatSquareRoot(-4.0) * 10 + FloatSquareRoot(0.0), -10.0);
  for (double x : {2.0, 0.25, 1e300}) EXPECT_NEAR(FloatSquareRoot(x), std::sqrt(x), 0.01 + 1e-12 * std::sqrt(x)) << x;
  EXPECT_TRUE(FloatSquareRoot(INFINITY) == INFINITY && std::isnan(FloatSquareRoot(NAN)));
}

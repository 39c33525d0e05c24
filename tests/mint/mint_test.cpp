// Mint storage, bits, logic operations, comparisons, counts and bit printers.
#include <gtest/gtest.h>

#include <functional>
#include <random>
#include <vector>

#include "duduzu/mint.h"
#include "mint/mint_test_util.h"

namespace {

TEST(MintStorage, BitsAreNumberedFromOne) {
  unsigned int m[2] = {0, 0};
  MintSetBitValue(m, 33);
  EXPECT_EQ(m[0], 0u);
  EXPECT_EQ(m[1], 1u);
  MintSetBitValue(m, 1);
  MintSetBitValue(m, 32);
  MintResetBitValue(m, 1);
  MintInvBitValue(m, 64);
  EXPECT_EQ(Cells(m, m + 2), (Cells{0x80000000u, 0x80000001u}));
  EXPECT_EQ(MintBitValue(m, 32) + MintBitValue(m, 31), 1);
}

TEST(MintStorage, CreatedSizesAndValues) {  // ASan catches a short allocation
  unsigned int src[3] = {1, 2, 3}, dst[3] = {7, 7, 7};
  EXPECT_EQ(take(MintCreateNoInit(2), 3), (Cells{0, 0, 0}));
  EXPECT_EQ(take(MintCreateInitValue(2, 7), 2), (Cells{7, 7}));
  EXPECT_EQ(take(MintCreateInit0(1), 1), (Cells{0}));
  EXPECT_EQ(take(MintCopy(src, 3), 3), (Cells{1, 2, 3}));
  EXPECT_EQ(MintCopyNoCr(src, dst, 0) + 10 * MintCopyNoCr(src, dst, 3), 10);
  EXPECT_EQ(MintCopyNoCr(Cells(3, 0).data(), dst, 3), 0);
  MintInitWithValue(dst, 2, 9);
  EXPECT_EQ(Cells(dst, dst + 3), (Cells{9, 9, 0}));
}

TEST(MintStorage, AllocationFailureReportsTheCreator) {
  static unsigned int a[2] = {1, 2}, b[2] = {3, 4};
  const std::vector<std::pair<const char*, std::function<unsigned int*()>>> creators = {
      {"MintCreateNoInit", [] { return MintCreateNoInit(2); }},
      {"MintCreateNoInit", [] { return MintNOT(a, 2); }},
      {"MintCreateNoInit", [] { return MintAND(a, b, 2); }},
      {"MintCreateNoInit", [] { return MintOR(a, b, 2); }},
      {"MintCreateNoInit", [] { return MintXNOR(a, b, 2); }},
      {"MintCreateInitValue", [] { return MintCreateInitValue(2, 1); }},
      {"MintCreateInitValue", [] { return MintCreateInit0(2); }},
      {"MintCopy", [] { return MintCopy(a, 2); }},
  };
  for (const auto& [creator, create] : creators) {
    PortTest::AllocFailureGuard guard;
    PortTest::Capture cap;
    PortTest::FailNthAlloc(1);
    EXPECT_EQ(create(), nullptr);
    expectMemoryFull(cap, creator);
  }
}

TEST(MintLogic, IdentitiesOnRandomMintsWithAliasing) {
  std::mt19937 rng(5);
  unsigned int zero[1] = {0}, ones[2] = {~0u, ~0u}, narrow[2] = {~0u, 0x7FFFFFFFu}, r[2];
  EXPECT_EQ(take(MintNOT(zero, 1), 2), (Cells{~0u, 0}));  // the spare cell stays zero
  EXPECT_EQ(MintNOTNoCreate(ones, r, 2), 0);
  EXPECT_EQ(MintNOTNoCreate(narrow, r, 2), 1);
  EXPECT_EQ(r[1], 0x80000000u);  // unused high bits are set, not masked
  EXPECT_EQ(MintANDNoCreate(ones, ones, r, 0) + MintNORNoCreate(ones, zero, r, 1), 0);
  for (int cells = 1; cells <= 40; ++cells) {
    Cells a = randomCells(rng, cells), b = randomCells(rng, cells), x = a, y = b, z = a;
    // De Morgan, in place: NOT(a AND b) == NOT a OR NOT b.
    MintANDNoCreate(x.data(), b.data(), x.data(), cells);
    EXPECT_EQ(MintNOTNoCreate(x.data(), x.data(), cells), MintNotNull(x.data(), cells));
    MintNOTNoCreate(z.data(), z.data(), cells);
    MintNOTNoCreate(y.data(), y.data(), cells);
    EXPECT_EQ(MintORNoCreate(z.data(), y.data(), y.data(), cells), 1);
    EXPECT_EQ(x, y);
    Cells notOr = take(MintOR(a.data(), b.data(), cells), cells);
    MintNOTNoCreate(notOr.data(), notOr.data(), cells);
    MintNORNoCreate(a.data(), b.data(), x.data(), cells);
    EXPECT_EQ(x, notOr);
    Cells xnor = take(MintXNOR(a.data(), b.data(), cells), cells + 1);
    EXPECT_EQ(xnor.back(), 0u);
    MintXORNoCreate(a.data(), b.data(), y.data(), cells);
    MintXNORNoCreate(y.data(), xnor.data(), y.data(), cells);  // (a^b) XNOR NOT(a^b) is 0
    EXPECT_EQ(MintNotNull(y.data(), cells), 0);
    EXPECT_EQ(take(MintNOT(take(MintNOT(a.data(), cells), cells).data(), cells), cells), a);
    MintXORNoCreate(z.data(), z.data(), z.data(), cells);
    EXPECT_EQ(MintNotNull(z.data(), cells), 0);
    Cells both = take(MintAND(a.data(), b.data(), cells), cells);
    EXPECT_EQ(MintIncluded(both.data(), b.data(), cells), 1);
    EXPECT_EQ(MintIncluded(a.data(), both.data(), cells), MintIdentical(a.data(), both.data(), cells));
  }
}

TEST(MintCompare, EdgeCasesAndGmp) {
  unsigned int a[2] = {0, 1}, b[2] = {5, 0}, zero[2] = {0, 0};
  EXPECT_EQ(MintLess(a, b, 2) * 4 + MintLess(b, a, 2) * 2 + MintLess(a, a, 2), 2);
  EXPECT_EQ(MintIncluded(zero, a, 2) * 2 + MintIncluded(a, b, 2), 2);
  EXPECT_EQ(MintIdentical(a, b, 0) + MintIncluded(a, b, 0) + MintNotNull(a, 0) + MintLess(b, a, 0), 2);
  std::mt19937 rng(7);
  for (int n = 0; n < 300; ++n) {
    int cells = 1 + n % 6;
    Cells x = randomCells(rng, cells), y = x;
    y[rng() % cells] = rng() % 3;
    int order = Mpz(x).compare(Mpz(y));
    EXPECT_EQ(MintLess(x.data(), y.data(), cells), order < 0);
    EXPECT_EQ(MintIdentical(x.data(), y.data(), cells), order == 0);
  }
}

TEST(MintCount, CardinalsAndLocateVisitEverySetBit) {
  unsigned int m[2] = {~0u, 1}, v[3] = {8, 6, 0}, mask = 77;
  int cell = -1;
  EXPECT_EQ(MintCardinalAllCells(m, 2), 33);
  EXPECT_EQ(MintLocateFirst1(v, 3, &cell, &mask), 1);
  EXPECT_EQ(cell * 100 + static_cast<int>(mask), 102);
  EXPECT_EQ(MintLocateFirst1(v, 0, &cell, &mask) + MintLocateFirst1(Cells(3, 0).data(), 3, &cell, &mask), 0);
  EXPECT_EQ(cell * 100 + static_cast<int>(mask), 102);  // untouched
  std::mt19937 rng(11);
  Cells r = randomCells(rng, 9);
  r[4] = 0;
  int visits = 0, expected = MintCardinalAllCells(r.data(), 9);
  for (; MintLocateFirst1(r.data(), 9, &cell, &mask); ++visits) {
    ASSERT_EQ(MintCardinalOneCell(mask), 1);
    r[static_cast<size_t>(cell)] &= ~mask;
  }
  EXPECT_EQ(visits, expected);
}

TEST(MintArith, CarriesOfAddAndIncrement) {
  unsigned int c = ~0u, d = ~0u, e = 0x80000000u;
  EXPECT_EQ(MintAddOneCell(&c, 1) * 2 + MintAddOneCell(&d, 0), 2u);
  EXPECT_EQ(MintAddOneCell(&e, 0x7FFFFFFFu) * 2 + MintAddOneCell(&e, 0x80000001u), 1u);
  EXPECT_EQ(Cells({c, d, e}), (Cells{0, ~0u, 0x80000000u}));
  Cells full(2, ~0u);
  EXPECT_EQ(MintIncrement(full.data(), 2), 1u);
  EXPECT_EQ(full, (Cells{0, 0}));
  for (size_t chain = 0; chain < 9; ++chain) {
    Cells v(10, ~0u), want(chain, 0);
    v[chain] = 41;
    want.push_back(42);
    want.resize(10, ~0u);
    EXPECT_EQ(MintIncrement(v.data(), 10), 0u);
    EXPECT_EQ(v, want);
  }
}

TEST(MintPrintBits, StreamAndMainOutput) {
  unsigned int m[2] = {5, 1};
  EXPECT_EQ(printed([&](FILE* f) { MintPrintBitsEqualTo1(f, m, 2); }), " 1 3 33");
  EXPECT_EQ(printed([](FILE* f) { PrintBitsEqualTo1(f, 0x80000001u, 64); }), " 65 96");
  PortTest::Capture cap;
  EXPECT_EQ(printedToMainOutput([&] { MintPrintBitsEqualTo1(MainEVarOutFile, m, 2); }, cap), 3u);
  EXPECT_EQ(cap.text(), " 1 3 33");
}

}  // namespace

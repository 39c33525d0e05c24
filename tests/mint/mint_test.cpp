// Mint storage, bits, logic operations, comparisons, counts and bit printers.
#include <gtest/gtest.h>

#include <random>
#include <utility>

#include "duduzu/mint.h"
#include "mint/mint_test_util.h"

namespace {

TEST(MintStorage, BitsCreationAndCopies) {  // ASan catches a short allocation
  unsigned int m[2] = {0, 0}, src[3] = {1, 2, 3}, dst[3] = {7, 7, 7};
  for (int bit : {33, 1, 32}) MintSetBitValue(m, bit);  // numbered from 1
  MintResetBitValue(m, 1);
  MintInvBitValue(m, 64);
  EXPECT_EQ(Cells(m, m + 2), (Cells{0x80000000u, 0x80000001u}));
  EXPECT_EQ(MintBitValue(m, 32) * 2 + MintBitValue(m, 31), 2);
  EXPECT_EQ((Mints{take(MintCreateNoInit(2), 3), take(MintCreateInitValue(2, 7), 2), take(MintCreateInit0(1), 1),
                   take(MintCopy(src, 3), 3)}),
            (Mints{{0, 0, 0}, {7, 7}, {0}, {1, 2, 3}}));  // MintCreateNoInit adds a spare cell
  EXPECT_EQ(MintCopyNoCr(src, dst, 0) + 10 * MintCopyNoCr(src, dst, 3) + 100 * MintCopyNoCr(Cells(3, 0).data(), dst, 2), 10);
  MintInitWithValue(dst, 1, 9);
  EXPECT_EQ(Cells(dst, dst + 3), (Cells{9, 0, 3}));
}

TEST(MintStorage, AllocationFailureReportsTheCreator) {
  static unsigned int a[2] = {1, 2};
  using Create = unsigned int* (*)();
  const std::pair<const char*, Create> creators[] = {
      {"MintCreateNoInit", [] { return MintCreateNoInit(2); }}, {"MintCreateNoInit", [] { return MintXNOR(a, a, 2); }},
      {"MintCreateInitValue", [] { return MintCreateInitValue(2, 1); }},
      {"MintCreateInitValue", [] { return MintCreateInit0(2); }}, {"MintCopy", [] { return MintCopy(a, 2); }}};
  for (const auto& [creator, create] : creators) {
    PortTest::AllocFailureGuard guard;
    PortTest::Capture cap;
    PortTest::FailNthAlloc(1);
    EXPECT_EQ(create(), nullptr);
    expectMemoryFull(cap, creator);
  }
}

TEST(MintLogic, CellByCellWithTheResultAliasingAnOperand) {
  unsigned int ones[2] = {~0u, ~0u}, zero[1] = {0}, narrow[2] = {~0u, 0x7FFFFFFFu}, r[2];
  EXPECT_EQ(MintNOTNoCreate(ones, r, 2) + MintANDNoCreate(ones, ones, r, 0) + MintNORNoCreate(ones, zero, r, 1), 0);
  EXPECT_EQ(MintNOTNoCreate(narrow, r, 2), 1);
  EXPECT_EQ(r[1], 0x80000000u);  // unused high bits are set, not masked
  std::mt19937 rng(5);
  for (int cells : {1, 2, 7}) {
    Cells a = randomCells(rng, cells), b = randomCells(rng, cells), want[6], got[6] = {a, a, a, a, a, a};
    for (size_t i = 0; i < a.size(); ++i) {
      unsigned int results[6] = {~a[i], a[i] & b[i], a[i] | b[i], ~(a[i] | b[i]), a[i] ^ b[i], ~(a[i] ^ b[i])};
      for (int k = 0; k < 6; ++k) want[k].push_back(results[k]);
    }
    EXPECT_EQ((std::vector<int>{MintNOTNoCreate(got[0].data(), got[0].data(), cells),
                                MintANDNoCreate(got[1].data(), b.data(), got[1].data(), cells),
                                MintORNoCreate(b.data(), got[2].data(), got[2].data(), cells),
                                MintNORNoCreate(got[3].data(), b.data(), got[3].data(), cells)}),
              std::vector<int>(4, 1));  // some result cell is non-zero
    MintXORNoCreate(got[4].data(), b.data(), got[4].data(), cells);
    MintXNORNoCreate(b.data(), got[5].data(), got[5].data(), cells);
    EXPECT_EQ(Mints(got, got + 6), Mints(want, want + 6));
    for (int k : {0, 1, 2, 5}) want[k].push_back(0);  // the created forms' spare cell
    EXPECT_EQ((Mints{take(MintNOT(a.data(), cells), cells + 1), take(MintAND(a.data(), b.data(), cells), cells + 1),
                     take(MintOR(a.data(), b.data(), cells), cells + 1), take(MintXNOR(a.data(), b.data(), cells), cells + 1)}),
              (Mints{want[0], want[1], want[2], want[5]}));
  }
}

TEST(MintCompare, TestsAndCountsAgainstGmp) {
  unsigned int a[2] = {0, 1}, b[2] = {5, 0}, v[3] = {8, 6, 0}, mask = 77;
  int cell = -1;
  EXPECT_EQ(MintIdentical(a, b, 0) + MintIncluded(a, b, 0) + MintNotNull(a, 0) + MintLess(b, a, 0), 2);
  EXPECT_EQ(MintLocateFirst1(v, 3, &cell, &mask), 1);
  EXPECT_EQ(cell * 100 + static_cast<int>(mask), 102);  // the top non-zero cell, its lowest bit
  EXPECT_EQ(MintLocateFirst1(v, 0, &cell, &mask) + MintLocateFirst1(Cells(3, 0).data(), 3, &cell, &mask), 0);
  EXPECT_EQ(cell * 100 + static_cast<int>(mask), 102);  // untouched
  std::mt19937 rng(7);
  for (int n = 0; n < 300; ++n) {
    int cells = 1 + n % 6;
    Cells x = randomCells(rng, cells), y = x;
    y[rng() % cells] = rng() % 3;
    if (n % 2) x[rng() % cells] &= y[rng() % cells];  // often included
    Mpz mx(x), my(y), common(Cells(cells, 0));
    mpz_and(common.z, mx.z, my.z);
    EXPECT_EQ(MintLess(x.data(), y.data(), cells), mpz_cmp(mx.z, my.z) < 0);
    EXPECT_EQ(MintIdentical(x.data(), y.data(), cells), mpz_cmp(mx.z, my.z) == 0);
    EXPECT_EQ(MintIncluded(x.data(), y.data(), cells), mpz_cmp(common.z, mx.z) == 0);
    EXPECT_EQ(MintNotNull(y.data(), cells), mpz_sgn(my.z) != 0);
    EXPECT_EQ(MintCardinalAllCells(x.data(), cells), static_cast<int>(mpz_popcount(mx.z)));
  }
}

TEST(MintArith, CarriesOfAddAndIncrement) {
  unsigned int c = ~0u, d = ~0u, e = 0x80000000u;
  EXPECT_EQ(MintAddOneCell(&c, 1) * 2 + MintAddOneCell(&d, 0), 2u);
  EXPECT_EQ(MintAddOneCell(&e, 0x7FFFFFFFu) * 2 + MintAddOneCell(&e, 0x80000001u), 1u);
  Cells full(2, ~0u), chain = {~0u, ~0u, 41, ~0u};
  EXPECT_EQ(MintIncrement(full.data(), 2) * 2 + MintIncrement(chain.data(), 4), 2u);
  EXPECT_EQ((Mints{{c, d, e}, full, chain}), (Mints{{0, ~0u, 0x80000000u}, {0, 0}, {0, 0, 42, ~0u}}));  // carries stop at 41
}

TEST(MintPrintBits, StreamAndMainOutput) {
  unsigned int m[2] = {5, 1};
  size_t reports = 0;
  EXPECT_EQ(printed([&](FILE* f) { MintPrintBitsEqualTo1(f, m, 2); }, &reports), " 1 3 33");
  EXPECT_EQ(reports, 3u);
  EXPECT_EQ(printed([](FILE* f) { PrintBitsEqualTo1(f, 0x80000001u, 64); }), " 65 96");
}

}  // namespace

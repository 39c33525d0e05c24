// Mint storage, bits, logic operations, comparisons, counts and bit printers.
#include "duduzu/mint.h"
#include "mint/mint_test_util.h"

TEST(MintStorage, BitsCreationCopiesAndAllocationFailure) {  // ASan catches a short allocation
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
  unsigned int a[2] = {1, 2};  // a failed creation reports its creator
  EXPECT_EQ(failing("MintCreateNoInit", [&] { return MintXNOR(a, a, 2); }), nullptr);
  EXPECT_EQ(failing("MintCreateInitValue", [] { return MintCreateInit0(2); }), nullptr);
  EXPECT_EQ(failing("MintCopy", [&] { return MintCopy(a, 2); }), nullptr);
}

TEST(MintLogic, CellByCellWithTheResultAliasingAnOperand) {
  unsigned int ones[2] = {~0u, ~0u}, zero[1] = {0}, narrow[2] = {~0u, 0x7FFFFFFFu}, r[2];
  EXPECT_EQ(MintNOTNoCreate(ones, r, 2) + MintANDNoCreate(ones, ones, r, 0) + MintNORNoCreate(ones, zero, r, 1), 0);
  EXPECT_EQ(MintNOTNoCreate(narrow, r, 2), 1);
  EXPECT_EQ(r[1], 0x80000000u);  // unused high bits are set, not masked
  Cells a = {0xC, 5}, b = {0xA, 3};
  Mints got(6, a);
  EXPECT_EQ(MintNOTNoCreate(got[0].data(), got[0].data(), 2) + MintANDNoCreate(got[1].data(), b.data(), got[1].data(), 2) +
                MintORNoCreate(b.data(), got[2].data(), got[2].data(), 2) + MintNORNoCreate(got[3].data(), b.data(), got[3].data(), 2),
            4);  // some result cell is non-zero
  MintXORNoCreate(got[4].data(), b.data(), got[4].data(), 2);
  MintXNORNoCreate(b.data(), got[5].data(), got[5].data(), 2);
  EXPECT_EQ(got, (Mints{{~0xCu, ~5u}, {8, 1}, {0xE, 7}, {~0xEu, ~7u}, {6, 6}, {~6u, ~6u}}));
  EXPECT_EQ((Mints{take(MintNOT(a.data(), 2), 3), take(MintAND(a.data(), b.data(), 2), 3), take(MintXNOR(a.data(), b.data(), 2), 3)}),
            (Mints{{~0xCu, ~5u, 0}, {8, 1, 0}, {~6u, ~6u, 0}}));  // with the spare cell
}

TEST(MintCompare, TestsCountsAndCarries) {
  unsigned int a[2] = {0, 1}, b[2] = {5, 0}, v[3] = {8, 6, 0}, mask = 77;
  int cell = -1;
  EXPECT_EQ(MintIdentical(a, b, 0) + MintIncluded(a, b, 0) + MintNotNull(a, 0) + MintLess(b, a, 0), 2);
  EXPECT_EQ(MintLocateFirst1(v, 3, &cell, &mask), 1);
  EXPECT_EQ(cell * 100 + static_cast<int>(mask), 102);  // the top non-zero cell, its lowest bit
  EXPECT_EQ(MintLocateFirst1(v, 0, &cell, &mask) + MintLocateFirst1(Cells(3, 0).data(), 3, &cell, &mask) + cell * 100 +
                static_cast<int>(mask), 102);  // none found: untouched
  std::mt19937 rng(7);
  for (int n = 0; n < 120; ++n) {
    int cells = 1 + n % 4;
    Cells x = randomCells(rng, cells), y = x;
    y[rng() % cells] = rng() % 3;
    if (n % 2) x[rng() % cells] &= y[rng() % cells];  // often included
    Mpz mx(x), my(y), common(Cells(cells, 0));
    mpz_and(common.z, mx.z, my.z);
    EXPECT_EQ((std::vector<int>{MintLess(x.data(), y.data(), cells), MintIdentical(x.data(), y.data(), cells),
                                MintIncluded(x.data(), y.data(), cells), MintNotNull(y.data(), cells), MintCardinalAllCells(x.data(), cells)}),
              (std::vector<int>{mpz_cmp(mx.z, my.z) < 0, mpz_cmp(mx.z, my.z) == 0, mpz_cmp(common.z, mx.z) == 0,
                                mpz_sgn(my.z) != 0, static_cast<int>(mpz_popcount(mx.z))}));
  }
  unsigned int c = ~0u, d = ~0u, e = 0x80000000u;  // carries
  EXPECT_EQ(MintAddOneCell(&c, 1) * 2 + MintAddOneCell(&d, 0), 2u);
  EXPECT_EQ(MintAddOneCell(&e, 0x7FFFFFFFu) * 2 + MintAddOneCell(&e, 0x80000001u), 1u);
  Cells full(2, ~0u), chain = {~0u, ~0u, 41, ~0u};
  EXPECT_EQ(MintIncrement(full.data(), 2) * 2 + MintIncrement(chain.data(), 4), 2u);
  EXPECT_EQ((Mints{{c, d, e}, full, chain}), (Mints{{0, ~0u, 0x80000000u}, {0, 0}, {0, 0, 42, ~0u}}));  // carries stop at 41
}

// Mint storage, bits, logic operations, comparisons, counts and bit printers.
#include <gmp.h>
#include <gtest/gtest.h>

#include <cstdlib>
#include <functional>
#include <random>
#include <string>
#include <vector>

#include "duduzu/mint.h"
#include "duduzu/session.h"
#include "port/port_testing.h"

namespace {

constexpr unsigned int kOnes = 0xFFFFFFFFu;
using Cells = std::vector<unsigned int>;

Cells take(unsigned int* m, int cells) {
  Cells v(m, m + cells);
  vzl_free(m);
  return v;
}

Cells randomCells(std::mt19937& rng, int cells) {
  Cells v(static_cast<size_t>(cells));
  for (auto& c : v) c = rng();
  return v;
}

// Text printed to a real stream by f.
std::string printed(const std::function<void(FILE*)>& f) {
  FILE* s = tmpfile();
  f(s);
  rewind(s);
  std::string text;
  for (int c; (c = fgetc(s)) != EOF;) text += static_cast<char>(c);
  fclose(s);
  return text;
}

TEST(MintBits, NumberedFromOneAcrossCells) {
  unsigned int m[2] = {0, 0};
  MintSetBitValue(m, 33);
  EXPECT_EQ(m[0], 0u);
  EXPECT_EQ(m[1], 1u);
  MintSetBitValue(m, 1);
  MintSetBitValue(m, 32);
  EXPECT_EQ(m[0], 0x80000001u);
  EXPECT_EQ(MintBitValue(m, 32), 1);
  EXPECT_EQ(MintBitValue(m, 31), 0);
  MintResetBitValue(m, 1);
  EXPECT_EQ(m[0], 0x80000000u);
  MintInvBitValue(m, 64);
  MintInvBitValue(m, 33);
  EXPECT_EQ(m[1], 0x80000000u);
  EXPECT_EQ(MintBitValue(m, 64), 1);
}

TEST(MintCreate, CellCountsAndValues) {
  // ASan catches a read past a short allocation.
  EXPECT_EQ(take(MintCreateNoInit(2), 3), (Cells{0, 0, 0}));
  EXPECT_EQ(take(MintCreateInitValue(2, 7), 2), (Cells{7, 7}));
  EXPECT_EQ(take(MintCreateInit0(3), 3), (Cells{0, 0, 0}));
  unsigned int src[3] = {1, 2, 3};
  unsigned int* copy = MintCopy(src, 3);
  src[1] = 9;
  EXPECT_EQ(take(copy, 3), (Cells{1, 2, 3}));
}

TEST(MintCreate, CopyNoCrAndInit) {
  unsigned int src[2] = {0, 4}, dst[2] = {7, 7};
  EXPECT_EQ(MintCopyNoCr(src, dst, 2), 1);
  EXPECT_EQ(dst[1], 4u);
  src[1] = 0;
  EXPECT_EQ(MintCopyNoCr(src, dst, 2), 0);
  dst[0] = 5;
  EXPECT_EQ(MintCopyNoCr(src, dst, 0), 0);
  EXPECT_EQ(dst[0], 5u);
  MintInitWithValue(dst, 2, 9);
  EXPECT_EQ(dst[1], 9u);
  MintInitWithValue(dst, 0, 1);
  EXPECT_EQ(dst[0], 9u);
}

struct Creator {
  const char* argument;
  std::function<unsigned int*()> create;
};

TEST(MintCreate, AllocationFailureReportsItsCreator) {
  static unsigned int a[2] = {1, 2}, b[2] = {3, 4};
  const std::vector<Creator> creators = {
      {"Function MintCreateNoInit", [] { return MintCreateNoInit(2); }},
      {"Function MintCreateNoInit", [] { return MintNOT(a, 2); }},
      {"Function MintCreateNoInit", [] { return MintAND(a, b, 2); }},
      {"Function MintCreateNoInit", [] { return MintOR(a, b, 2); }},
      {"Function MintCreateNoInit", [] { return MintXNOR(a, b, 2); }},
      {"Function MintCreateInitValue", [] { return MintCreateInitValue(2, 1); }},
      {"Function MintCreateInitValue", [] { return MintCreateInit0(2); }},
      {"Function MintCopy", [] { return MintCopy(a, 2); }},
  };
  for (const Creator& c : creators) {
    PortTest::AllocFailureGuard guard;
    PortTest::Capture cap;
    PortTest::FailNthAlloc(1);
    EXPECT_EQ(c.create(), nullptr) << c.argument;
    ASSERT_EQ(cap.size(), 1u) << c.argument;
    EXPECT_EQ(cap[0].level, Port_Error);
    EXPECT_EQ(cap[0].module, "DuduzuRorez");
    EXPECT_EQ(cap[0].unit, "../s/multint");
    EXPECT_EQ(cap[0].text, std::string("Memory Full (") + c.argument + ")\n");
  }
  EXPECT_EQ(a[0], 1u);  // the operands are left alone
}

TEST(MintLogic, CreatingFormsHaveASpareZeroCell) {
  unsigned int zero[1] = {0};
  EXPECT_EQ(take(MintNOT(zero, 1), 2), (Cells{kOnes, 0}));
  unsigned int a[2] = {0xF0F0F0F0u, 1}, b[2] = {0xFF00FF00u, 3};
  EXPECT_EQ(take(MintAND(a, b, 2), 3), (Cells{0xF000F000u, 1, 0}));
  EXPECT_EQ(take(MintOR(a, b, 2), 3), (Cells{0xFFF0FFF0u, 3, 0}));
  EXPECT_EQ(take(MintXNOR(a, b, 2), 3), (Cells{~0x0FF00FF0u, ~2u, 0}));
}

TEST(MintLogic, NoCreateResultsAndReturnValues) {
  unsigned int ones[2] = {kOnes, kOnes}, r[2];
  EXPECT_EQ(MintNOTNoCreate(ones, r, 2), 0);
  unsigned int narrow[2] = {kOnes, 0x7FFFFFFFu};  // 63 bits used, top bit clear
  EXPECT_EQ(MintNOTNoCreate(narrow, r, 2), 1);
  EXPECT_EQ(r[1], 0x80000000u);  // unused high bits are set, not masked
  unsigned int a[2] = {1, 0}, b[2] = {2, 0};
  EXPECT_EQ(MintANDNoCreate(a, b, r, 2), 0);
  EXPECT_EQ(MintORNoCreate(a, b, r, 2), 1);
  EXPECT_EQ(MintNORNoCreate(a, b, r, 2), 1);
  EXPECT_EQ(r[0], ~3u);
  EXPECT_EQ(MintNORNoCreate(ones, a, r, 2), 0);
  r[0] = 5;
  EXPECT_EQ(MintANDNoCreate(ones, ones, r, 0), 0);
  EXPECT_EQ(MintNOTNoCreate(a, r, 0), 0);
  EXPECT_EQ(r[0], 5u);
}

TEST(MintLogic, IdentitiesOnRandomMintsWithAliasing) {
  std::mt19937 rng(5);
  for (int cells = 1; cells <= 40; ++cells) {
    Cells a = randomCells(rng, cells), b = randomCells(rng, cells);
    unsigned int *pa = a.data(), *pb = b.data();
    // De Morgan: NOT(a AND b) == NOT a OR NOT b, computed in place.
    Cells lhs = a, na = a, nb = b;
    MintANDNoCreate(lhs.data(), pb, lhs.data(), cells);
    MintNOTNoCreate(lhs.data(), lhs.data(), cells);
    MintNOTNoCreate(na.data(), na.data(), cells);
    MintNOTNoCreate(nb.data(), nb.data(), cells);
    MintORNoCreate(na.data(), nb.data(), nb.data(), cells);
    EXPECT_EQ(lhs, nb);
    // NOR is NOT of OR.
    Cells nor(a.size()), orr = take(MintOR(pa, pb, cells), cells);
    MintNORNoCreate(pa, pb, nor.data(), cells);
    MintNOTNoCreate(orr.data(), orr.data(), cells);
    EXPECT_EQ(nor, orr);
    // XNOR is NOT of XOR; into the second operand.
    Cells x = a, y = b;
    MintXORNoCreate(x.data(), y.data(), x.data(), cells);
    Cells xn = b;
    MintXNORNoCreate(pa, xn.data(), xn.data(), cells);
    MintNOTNoCreate(x.data(), x.data(), cells);
    EXPECT_EQ(xn, x);
    EXPECT_EQ(take(MintXNOR(pa, pb, cells), cells), x);
    // NOT twice gives back the Mint.
    Cells twice = take(MintNOT(pa, cells), cells);
    EXPECT_EQ(take(MintNOT(twice.data(), cells), cells), a);
    // XOR with self into self clears it.
    Cells self = a;
    MintXORNoCreate(self.data(), self.data(), self.data(), cells);
    EXPECT_EQ(MintNotNull(self.data(), cells), 0);
    // a AND b is included in a, which is included in a OR b.
    Cells both = take(MintAND(pa, pb, cells), cells), either = take(MintOR(pa, pb, cells), cells);
    EXPECT_EQ(MintIncluded(both.data(), pa, cells), 1);
    EXPECT_EQ(MintIncluded(pa, either.data(), cells), 1);
  }
}

TEST(MintCompare, EdgeCases) {
  unsigned int a[2] = {0, 1}, b[2] = {5, 0}, zero[2] = {0, 0};
  EXPECT_EQ(MintLess(a, b, 2), 0);
  EXPECT_EQ(MintLess(b, a, 2), 1);
  EXPECT_EQ(MintLess(a, a, 2), 0);
  EXPECT_EQ(MintLess(b, a, 0), 0);
  EXPECT_EQ(MintIncluded(zero, a, 2), 1);
  EXPECT_EQ(MintIncluded(a, b, 2), 0);
  EXPECT_EQ(MintIncluded(a, b, 0), 1);
  EXPECT_EQ(MintIdentical(a, b, 0), 1);
  EXPECT_EQ(MintIdentical(a, b, 2), 0);
  unsigned int c[2] = {0, 1};
  EXPECT_EQ(MintIdentical(a, c, 2), 1);
  EXPECT_EQ(MintNotNull(a, 0), 0);
  EXPECT_EQ(MintNotNull(zero, 2), 0);
  EXPECT_EQ(MintNotNull(a, 2), 1);
}

TEST(MintCompare, LessAgreesWithGmp) {
  std::mt19937 rng(7);
  mpz_t x, y;
  mpz_inits(x, y, nullptr);
  for (int n = 0; n < 300; ++n) {
    int cells = 1 + n % 6;
    Cells a = randomCells(rng, cells), b = a;
    b[rng() % cells] = rng() % 3;  // often equal in the high cells
    mpz_import(x, cells, -1, sizeof(unsigned int), 0, 0, a.data());
    mpz_import(y, cells, -1, sizeof(unsigned int), 0, 0, b.data());
    EXPECT_EQ(MintLess(a.data(), b.data(), cells), mpz_cmp(x, y) < 0 ? 1 : 0);
    EXPECT_EQ(MintIdentical(a.data(), b.data(), cells), mpz_cmp(x, y) == 0 ? 1 : 0);
  }
  mpz_clears(x, y, nullptr);
}

TEST(MintCount, CardinalsAndLocate) {
  EXPECT_EQ(MintCardinalOneCell(0), 0);
  EXPECT_EQ(MintCardinalOneCell(kOnes), 32);
  unsigned int m[2] = {kOnes, 1};
  EXPECT_EQ(MintCardinalAllCells(m, 2), 33);
  EXPECT_EQ(MintCardinalAllCells(m, 0), 0);
  unsigned int v[3] = {8, 6, 0};
  int cell = -1;
  unsigned int mask = 77;
  EXPECT_EQ(MintLocateFirst1(v, 3, &cell, &mask), 1);
  EXPECT_EQ(cell, 1);
  EXPECT_EQ(mask, 2u);
  unsigned int zero[3] = {0, 0, 0};
  cell = -1;
  mask = 77;
  EXPECT_EQ(MintLocateFirst1(zero, 3, &cell, &mask), 0);
  EXPECT_EQ(MintLocateFirst1(v, 0, &cell, &mask), 0);
  EXPECT_EQ(cell, -1);
  EXPECT_EQ(mask, 77u);
}

TEST(MintCount, LocateAndClearVisitsEverySetBitOnce) {
  std::mt19937 rng(11);
  Cells m = randomCells(rng, 9);
  m[4] = 0;
  int expected = MintCardinalAllCells(m.data(), 9);
  int visits = 0, cell;
  unsigned int mask;
  while (MintLocateFirst1(m.data(), 9, &cell, &mask)) {
    ASSERT_EQ(MintCardinalOneCell(mask), 1);
    m[static_cast<size_t>(cell)] &= ~mask;
    ++visits;
  }
  EXPECT_EQ(visits, expected);
}

TEST(MintArith, AddOneCellCarry) {
  unsigned int c = kOnes;
  EXPECT_EQ(MintAddOneCell(&c, 1), 1u);
  EXPECT_EQ(c, 0u);
  c = kOnes;
  EXPECT_EQ(MintAddOneCell(&c, 0), 0u);
  EXPECT_EQ(c, kOnes);
  c = 0x80000000u;
  EXPECT_EQ(MintAddOneCell(&c, 0x7FFFFFFFu), 0u);
  EXPECT_EQ(MintAddOneCell(&c, 0x80000001u), 1u);
  EXPECT_EQ(c, 0x80000000u);
}

TEST(MintArith, IncrementCarryChains) {
  unsigned int m[2] = {kOnes, 5};
  EXPECT_EQ(MintIncrement(m, 2), 0u);
  EXPECT_EQ(m[0], 0u);
  EXPECT_EQ(m[1], 6u);
  unsigned int full[2] = {kOnes, kOnes};
  EXPECT_EQ(MintIncrement(full, 2), 1u);
  EXPECT_EQ(full[0] | full[1], 0u);
  for (int chain = 0; chain < 8; ++chain) {
    Cells v(10, kOnes);
    v[static_cast<size_t>(chain)] = 41;
    v[9] = 3;
    EXPECT_EQ(MintIncrement(v.data(), 10), 0u);
    for (int i = 0; i < chain; ++i) EXPECT_EQ(v[static_cast<size_t>(i)], 0u);
    EXPECT_EQ(v[static_cast<size_t>(chain)], 42u);
    EXPECT_EQ(v[chain + 1u], kOnes);
  }
}

TEST(MintPrintBits, ToAStream) {
  unsigned int m[2] = {5, 1};
  EXPECT_EQ(printed([&](FILE* f) { MintPrintBitsEqualTo1(f, m, 2); }), " 1 3 33");
  EXPECT_EQ(printed([](FILE* f) { PrintBitsEqualTo1(f, 0x80000001u, 64); }), " 65 96");
  EXPECT_EQ(printed([&](FILE* f) { MintPrintBitsEqualTo1(f, m, 0); }), "");
}

TEST(MintPrintBits, MainOutputBecomesStatusReports) {
  FILE* saved = MainEVarOutFile;
  MainEVarOutFile = stdout;
  unsigned int m[2] = {5, 1};
  PortTest::Capture cap;
  MintPrintBitsEqualTo1(stdout, m, 2);
  MainEVarOutFile = saved;
  ASSERT_EQ(cap.size(), 3u);
  EXPECT_EQ(cap[0].level, Port_Status);
  EXPECT_EQ(cap[0].unit, "../s/multint");
  EXPECT_EQ(cap.text(), " 1 3 33");
}

}  // namespace

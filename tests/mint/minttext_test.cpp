// Mint text forms: reading, writing, decimal steps, printing and list search.
#include <gmp.h>
#include <gtest/gtest.h>

#include <algorithm>
#include <cstdint>
#include <cstdio>
#include <cstdlib>
#include <random>
#include <string>
#include <vector>

#include "duduzu/list.h"
#include "duduzu/mint.h"
#include "duduzu/session.h"
#include "port/port_testing.h"

namespace {

using Cells = std::vector<unsigned int>;

struct Read {
  int ok;
  Cells value;
};

// MintFromStr, checking that a refusal leaves the outputs alone.
Read read(const std::string& text, int base) {
  unsigned int sentinel[1] = {0};
  unsigned int* m = sentinel;
  int cells = -7;
  int ok = MintFromStr(text.c_str(), &m, &cells, base);
  if (!ok) {
    EXPECT_EQ(m, sentinel) << text;
    EXPECT_EQ(cells, -7) << text;
    return {0, {}};
  }
  Cells v(m, m + cells + 1);  // the spare cell is there and zero
  EXPECT_EQ(v.back(), 0u) << text;
  v.pop_back();
  vzl_free(m);
  return {1, v};
}

// The value read equals m as a number (either may have more, zero, cells).
void expectValue(Read r, Cells m, const std::string& text) {
  ASSERT_EQ(r.ok, 1) << text;
  size_t cells = std::max(r.value.size(), m.size());
  r.value.resize(cells);
  m.resize(cells);
  EXPECT_EQ(r.value, m) << text;
}

std::string write(Cells m, int width, int base, int prefix) {
  std::string text(8 + 32 * m.size() + static_cast<size_t>(width > 0 ? width : 0), '#');
  MintToStr(m.data(), static_cast<int>(m.size()), width, base, prefix, &text[0]);
  return text.substr(0, text.find('\0'));
}

std::string gmpText(const Cells& m, int base) {
  mpz_t z;
  mpz_init(z);
  mpz_import(z, m.size(), -1, sizeof(unsigned int), 0, 0, m.data());
  char* s = mpz_get_str(nullptr, base, z);
  std::string text(s);
  for (char& c : text) c = static_cast<char>(toupper(c));
  free(s);
  mpz_clear(z);
  return text;
}

Cells randomCells(std::mt19937& rng, int cells) {
  Cells v(static_cast<size_t>(cells));
  for (auto& c : v) c = rng();
  return v;
}

std::string printed(void (*print)(FILE*, void*), void* arg) {
  FILE* s = tmpfile();
  print(s, arg);
  rewind(s);
  std::string text;
  for (int c; (c = fgetc(s)) != EOF;) text += static_cast<char>(c);
  fclose(s);
  return text;
}

const Cells k255 = {255};

TEST(MintFromStr, HexadecimalForms) {
  for (const char* t : {"8'hFF", "'hff", "%HFF", "%hff", "FF", "16'HfF"})
    EXPECT_EQ(read(t, 16).value, k255) << t;
  EXPECT_EQ(read("%HFF", 0).value, k255);
  EXPECT_EQ(read("%hff", 0).value, k255);
  for (const char* t : {"8'hFF", "FF", "%H", "'hFF"}) EXPECT_EQ(read(t, 0).ok, 0) << t;
  for (const char* t : {"8'hG", "8h'F", "x'hF", "8'bF", "%BFF", "%", "1 F", "%H8'hFF", "'h1'hF"})
    EXPECT_EQ(read(t, 16).ok, 0) << t;
  EXPECT_EQ(read("000000001", 16).value, (Cells{1, 0}));
  EXPECT_EQ(read("FFFFFFFF", 16).value, (Cells{0xFFFFFFFFu}));
  EXPECT_EQ(read("'h", 16).value, (Cells{0}));
}

TEST(MintFromStr, BinaryForms) {
  for (const char* t : {"%B101", "%b101", "4'b101", "'B101", "101", "0000101"})
    EXPECT_EQ(read(t, 2).value, (Cells{5})) << t;
  EXPECT_EQ(read("%b", 2).value, (Cells{0}));
  EXPECT_EQ(read("", 2).value, (Cells{0}));
  EXPECT_EQ(read("%b", 0).ok, 0);
  EXPECT_EQ(read("%b1", 0).value, (Cells{1}));
  for (const char* t : {"102", "4'h1", "a'b1", "%X1", "4'b1'b0", "%B1'b1"}) EXPECT_EQ(read(t, 2).ok, 0) << t;
  // 33 binary digits take two cells, the leading 1 is bit 33.
  EXPECT_EQ(read("1" + std::string(32, '0'), 2).value, (Cells{0, 1}));
}

TEST(MintFromStr, OctalDecimalAndAutomatic) {
  EXPECT_EQ(read("%O17", 8).value, (Cells{15}));
  EXPECT_EQ(read("%o17", 8).value, (Cells{15}));
  EXPECT_EQ(read("17", 8).value, (Cells{15}));
  EXPECT_EQ(read("%O", 8).value, (Cells{0}));
  for (const char* t : {"8'o17", "18", "%D17"}) EXPECT_EQ(read(t, 8).ok, 0) << t;
  EXPECT_EQ(read("4294967296", 10).value, (Cells{0, 1}));
  EXPECT_EQ(read("%d4294967295", 10).value, (Cells{0xFFFFFFFFu}));
  for (const char* t : {"1a", "-1", " 1", "%H1", "8'd1"}) EXPECT_EQ(read(t, 10).ok, 0) << t;
  // Leading zeros count: 33 decimal characters give at least 33 binary digits.
  EXPECT_EQ(read(std::string(32, '0') + "7", 10).value, (Cells{7, 0}));
  EXPECT_EQ(read("12", 0).value, (Cells{12}));
  EXPECT_EQ(read("%D12", 0).value, (Cells{12}));
  EXPECT_EQ(read("%o12", 0).value, (Cells{10}));
  for (const char* t : {"12x", "", "%Z12", "%D", "x12", "%D1x"}) EXPECT_EQ(read(t, 0).ok, 0) << t;
  for (int base : {1, 3, 9, 15, 17, 36, -2}) EXPECT_EQ(read("1", base).ok, 0) << base;
}

TEST(MintFromStr, BinaryFormLimitOf9999Digits) {
  EXPECT_EQ(read(std::string(2499, 'F'), 16).value.size(), 313u);
  EXPECT_EQ(read(std::string(2500, 'F'), 16).ok, 0);
  EXPECT_EQ(read("%H" + std::string(2500, '0'), 0).ok, 0);
  EXPECT_EQ(read(std::string(3333, '7'), 8).value.size(), 313u);
  EXPECT_EQ(read(std::string(3334, '7'), 8).ok, 0);
  EXPECT_EQ(read(std::string(9999, '0'), 10).value, Cells(313, 0));
  EXPECT_EQ(read(std::string(10000, '0'), 10).ok, 0);
  EXPECT_EQ(read(std::string(20000, '9'), 10).ok, 0);
  // 2^9999 - 1 has 9999 bits and is read; 2^9999 has 10000 and is refused.
  mpz_t z;
  mpz_init(z);
  mpz_ui_pow_ui(z, 2, 9999);
  char* over = mpz_get_str(nullptr, 10, z);
  mpz_sub_ui(z, z, 1);
  char* under = mpz_get_str(nullptr, 10, z);
  Read r = read(under, 10);
  EXPECT_EQ(r.value.size(), 313u);
  EXPECT_EQ(r.value.back(), 0x7FFFu);
  EXPECT_EQ(read(over, 10).ok, 0);
  free(over);
  free(under);
  mpz_clear(z);
  // Binary text is not widened and has no such limit.
  EXPECT_EQ(read(std::string(20000, '1'), 2).value.size(), 625u);
}

TEST(MintFromStr, AllocationFailureReportsCreateNoInit) {
  PortTest::AllocFailureGuard guard;
  PortTest::Capture cap;
  unsigned int* m = reinterpret_cast<unsigned int*>(&cap);
  int cells = -7;
  PortTest::FailAllAllocs();
  EXPECT_EQ(MintFromStr("%HFF", &m, &cells, 0), 0);
  EXPECT_EQ(m, nullptr);
  EXPECT_EQ(cells, -7);
  ASSERT_GE(cap.size(), 1u);
  EXPECT_EQ(cap.last().level, Port_Error);
  EXPECT_EQ(cap.last().unit, "../s/multint");
  EXPECT_EQ(cap.last().text, "Memory Full (Function MintCreateNoInit)\n");
}

TEST(MintFromStr, DecimalWorkingMemoryFailureIsARefusal) {
  PortTest::AllocFailureGuard guard;
  PortTest::Capture cap;
  PortTest::FailNthAlloc(1);  // the converter's working copy, not the Mint
  EXPECT_EQ(read("12", 10).ok, 0);
  EXPECT_EQ(cap.size(), 0u);
  EXPECT_EQ(read("12", 10).value, (Cells{12}));
}

TEST(MintToStr, EveryBaseOf255) {
  EXPECT_EQ(write(k255, 0, 16, 0), "FF");
  EXPECT_EQ(write(k255, 0, 2, 0), "11111111");
  EXPECT_EQ(write(k255, 0, 8, 0), "377");
  EXPECT_EQ(write(k255, 0, 10, 0), "255");
  EXPECT_EQ(write(k255, 0, 0, 0), "255");
  EXPECT_EQ(write(k255, 4, 16, 1), "%H00FF");
  EXPECT_EQ(write(k255, 1, 10, 0), "2");
  EXPECT_EQ(write(k255, 2, 2, 1), "%B11");
  EXPECT_EQ(write(k255, -3, 8, 1), "%O377");
  EXPECT_EQ(write(k255, 3, 8, 0), "377");
}

TEST(MintToStr, OctalGroupsSpanCells) {
  EXPECT_EQ(write({0x80000000u}, 0, 8, 0), "20000000000");
  EXPECT_EQ(write({0, 1}, 0, 8, 0), "40000000000");
  EXPECT_EQ(write({0x40000000u, 1}, 0, 8, 0), "50000000000");  // bits 31 and 33
  EXPECT_EQ(write({0xFFFFFFFFu, 7}, 0, 8, 0), "377777777777");
}

TEST(MintToStr, ZeroAndOddBases) {
  EXPECT_EQ(write({0, 0}, 0, 0, 1), "%D0");
  for (int base : {2, 8, 16}) EXPECT_EQ(write({0, 0, 0}, 0, base, 0), "0");
  EXPECT_EQ(write({}, 0, 16, 0), "0");
  EXPECT_EQ(write({}, 0, 10, 0), "0");
  EXPECT_EQ(write({0}, 3, 2, 0), "000");
  for (int base : {1, 3, 7, 32, -1}) EXPECT_EQ(write(k255, 4, base, 1), "") << base;
}

TEST(MintToStr, DecimalCopyFailureWritesNoDigits) {
  PortTest::AllocFailureGuard guard;
  PortTest::Capture cap;
  PortTest::FailNthAlloc(1);
  EXPECT_EQ(write({1, 2}, 5, 10, 1), "");
  ASSERT_EQ(cap.size(), 1u);
  EXPECT_EQ(cap[0].level, Port_Error);
  EXPECT_EQ(cap[0].text, "Memory Full (Function MintCopy)\n");
}

TEST(MintText, RoundTripsInEveryBaseAgainstGmp) {
  std::mt19937 rng(42);
  for (int cells = 1; cells <= 40; ++cells) {
    Cells m = randomCells(rng, cells);
    if (cells % 5 == 0) m.back() = 0;                  // leading zero cells
    if (cells % 7 == 0) m.back() &= 0x1FFu;            // partial top cell
    for (int base : {2, 8, 10, 16}) {
      std::string text = write(m, 0, base, 0);
      ASSERT_EQ(text, gmpText(m, base)) << base << " " << cells;
      expectValue(read(text, base), m, text);
      std::string prefixed = write(m, static_cast<int>(text.size()) + 9, base, 1);
      EXPECT_EQ(prefixed.substr(2 + 9), text);
      expectValue(read(prefixed, 0), m, prefixed);
    }
  }
}

TEST(MintToStr, DecimalAroundNineDigitChunks) {
  for (Cells m : {Cells{999999999u}, Cells{1000000000u}, Cells{0xA7640000u, 0x0DE0B6B3u},
                  Cells{0xA763FFFFu, 0x0DE0B6B3u}, Cells{0xFFFFFFFFu, 0xFFFFFFFFu}, Cells{0, 1}, Cells{7, 0, 0}})
    EXPECT_EQ(write(m, 0, 10, 0), gmpText(m, 10));
}

TEST(MintText, DecimalFromGmpText) {
  std::mt19937 rng(3);
  mpz_t z;
  mpz_init(z);
  for (int cells = 1; cells <= 40; ++cells) {
    Cells m = randomCells(rng, cells);
    m.back() |= 0x80000000u;  // exactly `cells` cells of binary digits
    mpz_import(z, m.size(), -1, sizeof(unsigned int), 0, 0, m.data());
    char* s = mpz_get_str(nullptr, 10, z);
    EXPECT_EQ(read(s, 10).value, m);
    free(s);
  }
  mpz_clear(z);
}

TEST(MintDecimalSteps, AgainstWideArithmetic) {
  std::mt19937 rng(9);
  std::vector<unsigned int> samples = {0, 1, 9, 10, 0x7FFFFFFFu, 0x80000000u, 0xFFFFFFFFu, 0x19999999u};
  for (int i = 0; i < 2000; ++i) samples.push_back(rng());
  for (unsigned int v : samples) {
    for (unsigned int carry : {0u, 1u, 9u, 0xFFFFFFFFu, static_cast<unsigned int>(rng())}) {
      uint64_t wide = uint64_t{v} * 10 + carry;
      unsigned int cell = v;
      EXPECT_EQ(MintMultiplyOneCellBy10(&cell, carry), static_cast<unsigned int>(wide >> 32));
      EXPECT_EQ(cell, static_cast<unsigned int>(wide));
    }
    for (unsigned int rem = 0; rem < 10; ++rem) {
      uint64_t dividend = (uint64_t{rem} << 32) | v;
      unsigned int cell = v;
      EXPECT_EQ(MintDivideOneCellBy10(&cell, rem), dividend % 10);
      EXPECT_EQ(cell, dividend / 10);
    }
  }
}

TEST(MintPrint, CellsFromTheTop) {
  static unsigned int m[2] = {5, 1};
  EXPECT_EQ(printed([](FILE* f, void*) { MintPrint(f, m, 2); }, nullptr), "1,5,");
  EXPECT_EQ(printed([](FILE* f, void*) { MintPrint(f, m, 0); }, nullptr), "");
  FILE* saved = MainEVarOutFile;
  MainEVarOutFile = stderr;
  PortTest::Capture cap;
  MintPrint(stderr, m, 2);
  MainEVarOutFile = saved;
  ASSERT_EQ(cap.size(), 2u);
  EXPECT_EQ(cap[0].level, Port_Status);
  EXPECT_EQ(cap[0].text, "1,");
  EXPECT_EQ(cap[1].text, "5,");
}

TEST(MintListPrint, HexadecimalLinesIncludingLongOnes) {
  std::mt19937 rng(1);
  Cells a = randomCells(rng, 200), b(200, 0);  // 1600 hex digits
  a.back() |= 0x10000000u;
  DomList* list = ListCreate();
  ListAddElt(list, reinterpret_cast<int*>(a.data()));
  ListAddElt(list, reinterpret_cast<int*>(b.data()));
  std::string expected = gmpText(a, 16) + "\n0\n";
  EXPECT_EQ(printed([](FILE* f, void* l) { MintListPrint(f, static_cast<DomList*>(l), 200); }, list),
            expected);
  FILE* saved = MainEVarOutFile;
  MainEVarOutFile = nullptr;
  PortTest::Capture cap;
  MintListPrint(nullptr, list, 200);
  MintListPrint(nullptr, nullptr, 200);
  ListQuickDelete(&list);
  list = ListCreate();
  MintListPrint(nullptr, list, 200);
  MainEVarOutFile = saved;
  ASSERT_EQ(cap.size(), 2u);
  EXPECT_EQ(cap[0].level, Port_Status);
  EXPECT_EQ(cap[0].text + cap[1].text, expected);
  ListQuickDelete(&list);
}

TEST(MintExistsInHeap, SearchesTheFirstCountElements) {
  unsigned int m[2] = {1, 2}, other[2] = {1, 3}, same[2] = {1, 2};
  DomList* list = ListCreate();
  ListAddElt(list, reinterpret_cast<int*>(other));
  ListAddElt(list, nullptr);
  ListAddElt(list, reinterpret_cast<int*>(same));
  EXPECT_EQ(MintExistsInHeap(m, 2, list, 3), 1);
  EXPECT_EQ(MintExistsInHeap(m, 2, list, 2), 0);  // null skipped, 3rd ignored
  EXPECT_EQ(MintExistsInHeap(m, 1, list, 1), 1);  // only cell 0 compared
  EXPECT_EQ(MintExistsInHeap(m, 0, list, 2), 1);
  EXPECT_EQ(MintExistsInHeap(m, 2, list, 0), 0);
  ListQuickDelete(&list);
}

}  // namespace

// Mint text forms: reading, writing, decimal steps, printing and list search.
#include <algorithm>
#include <cstdint>

#include "duduzu/list.h"
#include "duduzu/mint.h"
#include "mint/mint_test_util.h"

namespace {

// MintFromStr as text: "-" for a refusal (outputs then untouched), else the
// cell count and the hexadecimal value, e.g. "2:100000000".
std::string read(const std::string& text, int base) {
  unsigned int sentinel = 0, *m = &sentinel;
  int cells = -7;
  if (!MintFromStr(text.c_str(), &m, &cells, base)) {
    EXPECT_TRUE(m == &sentinel && cells == -7) << text;
    return "-";
  }
  EXPECT_EQ(m[cells], 0u) << text;  // the spare cell
  return std::to_string(cells) + ":" + Mpz(take(m, cells)).text(16);
}

std::string write(Cells m, int width, int base, int prefix) {
  std::string text(8 + 32 * m.size() + static_cast<size_t>(std::max(width, 0)), '#');
  MintToStr(m.data(), static_cast<int>(m.size()), width, base, prefix, &text[0]);
  return text.substr(0, text.find('\0'));
}

TEST(MintText, FormsReadAcceptedRefusedAndWritten) {
  const std::pair<const char*, int> fifteen[] = {{"8'hF", 16}, {"'hf", 16}, {"%hf", 16}, {"4'b1111", 2}, {"'B1111", 2},
      {"%o17", 8}, {"%d15", 10}, {"%hf", 0}, {"%b1111", 0}, {"%o17", 0}, {"15", 0}};
  for (const auto& [text, base] : fifteen) EXPECT_EQ(read(text, base), "1:F") << text << " " << base;
  EXPECT_EQ(read("000000001", 16) + read("FFFFFFFF", 16) + read("1" + std::string(32, '0'), 2), "2:11:FFFFFFFF2:100000000");
  EXPECT_EQ(read("4294967296", 10) + read(std::string(32, '0') + "7", 10), "2:1000000002:7");  // 33 digits, 2 cells
  EXPECT_EQ(read("%b", 2) + read("", 2) + read("'h", 16) + read("%O", 8), "1:01:01:01:0");
  const std::pair<const char*, int> refused[] = {{"8'hFF", 0}, {"FF", 0}, {"%b", 0}, {"", 0}, {"%Z12", 0}, {"%D1x", 0},
      {"8'hG", 16}, {"8h'F", 16}, {"x'hF", 16}, {"8'bF", 16}, {"%", 16}, {"1 F", 16}, {"102", 2}, {"4'h1", 2},
      {"8'o17", 8}, {"18", 8}, {"-1", 10}, {"'h1'hF", 16}, {"%b1'b1", 0}, {"1", 1}, {"1", 9}, {"1", 17}, {"1", -2}};  // 'h1'hF: a second apostrophe
  for (const auto& [text, base] : refused) EXPECT_EQ(read(text, base), "-") << text << " " << base;
  const Cells k255 = {255};  // and written back
  EXPECT_EQ(write(k255, 0, 0, 0) + write(k255, 4, 16, 1) + write(k255, 1, 10, 0) + write(k255, 2, 2, 1), "255%H00FF2%B11");
  EXPECT_EQ(write(k255, -3, 8, 1) + write(k255, 3, 8, 0), "%O377377");
  EXPECT_EQ(write({0, 0}, 0, 0, 1) + write({0, 0}, 0, 2, 0) + write({}, 0, 16, 0) + write({0}, 3, 2, 0), "%D000000");
  for (int base : {1, 3, 7, 32, -1}) EXPECT_EQ(write(k255, 4, base, 1), "") << base;
}

TEST(MintFromStr, BinaryFormLimitOf9999Digits) {
  EXPECT_EQ(read(std::string(2499, 'F'), 16).substr(0, 4) + read(std::string(3333, '7'), 8).substr(0, 4) +
                read(std::string(9999, '0'), 10), "313:313:313:0");
  for (const std::string& t : {std::string(2500, 'F'), "%H" + std::string(2500, '0'), std::string(3334, '7'),
                               std::string(10000, '0'), std::string(20000, '9')})
    EXPECT_EQ(read(t, t.size() == 3334 ? 8 : t.size() > 9999 ? 10 : 16), "-") << t.size();
  Cells under(313, ~0u), over(313, 0);  // 2^9999 - 1 has 9999 bits and is read; 2^9999 has 10000
  under.back() = 0x7FFFu;
  over.back() = 0x8000u;
  EXPECT_EQ(read(Mpz(under).text(10), 10) + read(Mpz(over).text(10), 10), "313:7FFF" + std::string(2496, 'F') + "-");
  EXPECT_EQ(read(std::string(20000, '1'), 2).substr(0, 4), "625:");  // binary text is not widened
}

TEST(MintText, MemoryFailures) {
  EXPECT_EQ(failing("", [] { return read("12", 10); }), "-");  // the decimal converter's working copy: silent
  unsigned int sentinel = 0, *m = &sentinel, one[1] = {1};
  int cells = -7;
  EXPECT_EQ(failing("MintCreateNoInit", [&] { return MintFromStr("%HFF", &m, &cells, 0); }), 0);
  EXPECT_TRUE(m == nullptr && cells == -7);
  EXPECT_EQ(failing("MintCopy", [] { return write({1, 2}, 5, 10, 1); }), "");  // MintToStr's decimal working copy
  DomList* list = ListCreate();
  ListAddElt(list, reinterpret_cast<int*>(one));
  EXPECT_EQ(failing("MintListPrint", [&] { return printed([&](FILE* f) { MintListPrint(f, list, 1); }); }), "");
  ListQuickDelete(&list);
}

TEST(MintText, RoundTripsInEveryBaseAgainstGmp) {
  std::mt19937 rng(42);
  std::vector<Cells> values = {{999999999u}, {1000000000u}, {0xA7640000u, 0x0DE0B6B3u},  // 10^18
                               {0xA763FFFFu, 0x0DE0B6B3u}, {~0u, ~0u}, {7, 0, 0}};
  for (int cells : {1, 2, 3, 5, 7, 13, 40}) values.push_back(randomCells(rng, cells));
  for (Cells& m : values) {
    int cells = static_cast<int>(m.size());
    if (cells % 5 == 0) m.back() = 0;        // a leading zero cell
    if (cells % 7 == 0) m.back() &= 0x1FFu;  // a partial top cell
    for (int base : {2, 8, 10, 16}) {
      std::string text = write(m, 0, base, 0), padded = write(m, static_cast<int>(text.size()) + 9, base, 1);
      ASSERT_EQ(text, Mpz(m).text(base)) << base;
      for (const std::string& v : {read(text, base), read(padded, 0)}) EXPECT_EQ(v.substr(v.find(':') + 1), Mpz(m).text(16));
    }
  }
}

TEST(MintDecimalSteps, AgainstWideArithmetic) {
  for (unsigned int v : {0u, 1u, 9u, 10u, 0x7FFFFFFFu, 0x80000000u, ~0u, 0x19999999u, 0x9ABCDEF1u})
    for (unsigned int carry : {0u, 3u, 9u, ~0u}) {
      unsigned int product = v, quotient = v;
      uint64_t wide = uint64_t{v} * 10 + carry, dividend = uint64_t{carry % 10} << 32 | v;
      EXPECT_EQ((std::vector<uint64_t>{MintMultiplyOneCellBy10(&product, carry), product, MintDivideOneCellBy10(&quotient, carry % 10), quotient}),
                (std::vector<uint64_t>{wide >> 32, wide & ~0u, dividend % 10, dividend / 10})) << v << " " << carry;
    }
}

TEST(MintPrint, BitsCellsListsAndSearch) {
  unsigned int m[2] = {1, 2}, other[2] = {1, 3}, same[2] = {1, 2}, bits[2] = {5, 1};
  size_t reports[3] = {0, 0, 0};
  EXPECT_EQ(printed([&](FILE* f) { MintPrintBitsEqualTo1(f, bits, 2); }, &reports[2]) +
                printed([](FILE* f) { PrintBitsEqualTo1(f, 0x80000001u, 64); }), " 1 3 33 65 96");
  EXPECT_EQ(printed([&](FILE* f) { MintPrint(f, m, 2); }, &reports[0]) + printed([&](FILE* f) { MintPrint(f, m, 0); }), "2,1,");
  Cells a(200, 0x9ABCDEF1u), zero(200, 0);  // 1600 hexadecimal digits
  DomList* list = ListCreate();
  for (Cells* e : {&a, &zero}) ListAddElt(list, reinterpret_cast<int*>(e->data()));
  EXPECT_EQ(printed([&](FILE* f) { MintListPrint(f, list, 200); }, &reports[1]) +
                printed([](FILE* f) { MintListPrint(f, nullptr, 1); }), Mpz(a).text(16) + "\n0\n");
  EXPECT_EQ(reports[0] * 100 + reports[1] * 10 + reports[2], 223u);
  list->count = 0;
  for (unsigned int* e : {other, static_cast<unsigned int*>(nullptr), same}) ListAddElt(list, reinterpret_cast<int*>(e));
  EXPECT_EQ(MintExistsInHeap(m, 2, list, 3) * 1000 + MintExistsInHeap(m, 2, list, 2) * 100 +  // null skipped
                MintExistsInHeap(m, 1, list, 1) * 10 + MintExistsInHeap(m, 0, list, 2) + MintExistsInHeap(m, 2, list, 0),
            1011);  // cells compared: 1, 0; the third ignored when only two are searched
  ListQuickDelete(&list);
}

}  // namespace

#include <gmp.h>
#include <gtest/gtest.h>

#include <random>
#include <string>

#include "duduzu/str.h"
#include "str_test_util.h"

namespace {

template <class Convert>
std::string Converted(const std::string& in, size_t room, Convert convert) {
  std::string out(room + 1, '#');
  convert(in.c_str(), out.data());
  return out.c_str();
}

std::string DecimalToBin(const std::string& dec) {
  return Converted(dec, 4 * dec.size(), StrDecimalToBin);
}

// Reference: GMP's binary text, padded with zeros to the decimal length.
std::string GmpDecimalToBin(const std::string& dec) {
  if (dec.empty()) return "";
  mpz_t z;
  mpz_init_set_str(z, dec.c_str(), 10);
  std::string bits(mpz_sizeinbase(z, 2) + 2, '\0');
  mpz_get_str(bits.data(), 2, z);
  mpz_clear(z);
  bits = bits.c_str();
  if (bits == "0") bits.clear();
  return std::string(dec.size() > bits.size() ? dec.size() - bits.size() : 0, '0') + bits;
}

struct Radix {
  int width;
  void (*toText)(const char*, char*, int);
  void (*toBits)(const char*, char*);
};

}  // namespace

TEST(RadixCheck, PlainAndSizedForms) {
  for (const char* yes : {"101", "4'b1010", "'B", "", "12'B01", "4'b"}) EXPECT_EQ(StrIsBinary(yes), 1) << yes;
  for (const char* no : {"102", "4'h1", "a'b1", "4'b12", "1'b'1"})
    EXPECT_EQ(StrIsBinary(no), 0) << no;
  for (const char* yes : {"8'hfF", "DEAD", "'hFF", ""}) EXPECT_EQ(StrIsHexa(yes), 1) << yes;
  for (const char* no : {"8'hG", "8h'F", "x'h1", "4'd9"}) EXPECT_EQ(StrIsHexa(no), 0) << no;
  EXPECT_EQ(StrIsOctal("01234567"), 1);
  EXPECT_EQ(StrIsOctal("8'o7"), 0);
  EXPECT_EQ(StrIsOctal("8"), 0);
  EXPECT_EQ(StrIsDecimal("0123456789"), 1);
  EXPECT_EQ(StrIsDecimal(""), 1);
  for (const char* no : {"-1", "1 2", "+3", "1a"}) EXPECT_EQ(StrIsDecimal(no), 0) << no;
  EXPECT_EQ(CharIsBinary('1'), 1);
  EXPECT_EQ(CharIsBinary('2'), 0);
  EXPECT_EQ(CharIsOctal('7'), 1);
  EXPECT_EQ(CharIsOctal('8'), 0);
}

TEST(RadixConvert, Examples) {
  EXPECT_EQ(Converted("A", 4, StrHexaToBin), "1010");
  EXPECT_EQ(Converted("a", 4, StrHexaToBin), "1010");
  EXPECT_EQ(Converted("0f", 8, StrHexaToBin), "00001111");
  EXPECT_EQ(Converted("07", 6, StrOctalToBin), "000111");
  EXPECT_EQ(Converted("", 0, StrOctalToBin), "");
  auto hex = [](const char* b, int n) { return Converted(b, 8, [n](const char* i, char* o) { StrBinToHexa(i, o, n); }); };
  auto oct = [](const char* b, int n) { return Converted(b, 8, [n](const char* i, char* o) { StrBinToOctal(i, o, n); }); };
  EXPECT_EQ(hex("11111", 5), "1F");
  EXPECT_EQ(hex("11111", 0), "1F");
  EXPECT_EQ(hex("101011", 6), "2B");
  EXPECT_EQ(hex("", 0), "");
  EXPECT_EQ(hex("", 3), "");  // a wrong n never reads past the string
  EXPECT_EQ(oct("1010", 4), "12");
  EXPECT_EQ(oct("111", 3), "7");
  for (const char* dec : {"10", "255", "0", "007", "0001", "", "4294967296"})
    EXPECT_EQ(DecimalToBin(dec), GmpDecimalToBin(dec)) << dec;
  EXPECT_EQ(DecimalToBin("4294967296"), "1" + std::string(32, '0'));
  EXPECT_EQ(DecimalToBin("0001"), "0001");
}

TEST(RadixConvert, RandomBitsThroughOctalAndHexa) {
  std::mt19937 rng(7);
  for (int round = 0; round < 500; ++round) {
    std::string bits(1 + rng() % 200, '0');
    for (char& c : bits) c = static_cast<char>('0' + rng() % 2);
    int n = static_cast<int>(bits.size());
    for (const Radix& r : {Radix{3, StrBinToOctal, StrOctalToBin}, Radix{4, StrBinToHexa, StrHexaToBin}}) {
      auto [width, toText, toBits] = r;
      std::string text = Converted(bits, bits.size(), [&](const char* i, char* o) { toText(i, o, n); });
      ASSERT_EQ(text.size(), static_cast<size_t>((n + width - 1) / width));
      std::string back = Converted(text, width * text.size(), toBits);
      EXPECT_EQ(back.substr(back.size() - bits.size()), bits);
      EXPECT_TRUE(StrIsAllZero(back.substr(0, back.size() - bits.size()).data()));
    }
  }
}

TEST(RadixConvert, DecimalOfAnyLengthMatchesGmp) {
  std::mt19937 rng(11);
  for (int round = 0; round < 300; ++round) {
    std::string dec(1 + rng() % (round < 250 ? 60 : 1500), '0');
    size_t zeros = rng() % 4 == 0 ? rng() % dec.size() : 0;
    for (size_t i = zeros; i < dec.size(); ++i) dec[i] = static_cast<char>('0' + rng() % 10);
    ASSERT_EQ(DecimalToBin(dec), GmpDecimalToBin(dec)) << dec;
  }
  std::string nines(3000, '9');
  EXPECT_EQ(DecimalToBin(nines), GmpDecimalToBin(nines));
}

TEST(RadixConvert, DecimalWithoutMemoryGivesEmptyText) {
  PortTest::AllocFailureGuard guard;
  PortTest::FailNthAlloc(1);
  EXPECT_EQ(DecimalToBin("12"), "");
}

TEST(RadixUInt, LimitsAndReports) {
  PortTest::Capture cap;
  unsigned out = 7;
  EXPECT_EQ(StrToUInt(&out, const_cast<char*>("4294967295")), 1);
  EXPECT_EQ(out, 4294967295u);
  EXPECT_EQ(StrToUInt(&out, const_cast<char*>("")), 1);
  EXPECT_EQ(out, 0u);
  EXPECT_EQ(cap.size(), 0u);
  out = 7;
  for (const char* big : {"4294967296", "10000000000", "99999999999999999999999"}) {
    EXPECT_EQ(StrToUInt(&out, const_cast<char*>(big)), 0);
    ExpectOneReport(cap, Port_Error, std::string("Overflow unsigned integer : ") + big + "\n");
    cap.clear();
  }
  for (const char* bad : {"-1", "1 2"}) {
    EXPECT_EQ(StrToUInt(&out, const_cast<char*>(bad)), 0);
    ExpectOneReport(cap, Port_Error, std::string("Not an unsigned integer : ") + bad + "\n");
    cap.clear();
  }
  EXPECT_EQ(out, 7u);
}

TEST(RadixBits, AllZeroAllOne) {
  char s[] = "0110";
  EXPECT_EQ(StrIsAllOne(s, 1, 3), 1);
  EXPECT_EQ(StrIsAllOne(s, 0, 3), 0);
  EXPECT_EQ(StrIsAllOne(s, 2, 2), 1);
  EXPECT_EQ(StrIsAllOne(s, 3, 1), 1);
  EXPECT_EQ(StrIsAllOne(nullptr, 2, 2), 0);
  EXPECT_EQ(StrIsAllZero(const_cast<char*>("000")), 1);
  EXPECT_EQ(StrIsAllZero(const_cast<char*>("")), 1);
  EXPECT_EQ(StrIsAllZero(const_cast<char*>("010")), 0);
  EXPECT_EQ(StrIsAllZero(nullptr), 0);
}

#include <gmp.h>

#include <random>

#include "str_test_util.h"

namespace {

// Runs a converter (with n for the bit groupers) into a buffer of room characters.
std::string Conv(void (*fn)(const char*, char*), const std::string& in, size_t room) {
  std::string out(room + 1, '#');
  fn(in.c_str(), out.data());
  return out.c_str();
}
std::string Conv(void (*fn)(const char*, char*, int), const std::string& in, int n) {
  std::string out(in.size() + 1, '#');
  fn(in.c_str(), out.data(), n);
  return out.c_str();
}

// Reference: GMP's binary text (empty for zero), padded with zeros to the decimal length.
std::string GmpDecimalToBin(const std::string& dec) {
  mpz_t z;
  mpz_init_set_str(z, dec.c_str(), 10);
  std::string bits(mpz_sizeinbase(z, 2) + 2, '\0');
  mpz_get_str(bits.data(), 2, z);
  bits = mpz_sgn(z) ? bits.c_str() : "";
  mpz_clear(z);
  return std::string(dec.size() > bits.size() ? dec.size() - bits.size() : 0, '0') + bits;
}

}  // namespace

TEST(RadixCheck, PlainAndSizedForms) {
  for (const char* s : {"101", "4'b1010", "'B", "", "4'b"}) EXPECT_EQ(StrIsBinary(s), 1) << s;
  for (const char* s : {"102", "4'h1", "a'b1", "1'b'1"}) EXPECT_EQ(StrIsBinary(s), 0) << s;
  for (const char* s : {"8'hfF", "DEAD", "'hFF", ""}) EXPECT_EQ(StrIsHexa(s), 1) << s;
  for (const char* s : {"8'hG", "8h'F", "4'd9"}) EXPECT_EQ(StrIsHexa(s), 0) << s;
  EXPECT_EQ(StrIsOctal("8'o7") + StrIsOctal("8") + StrIsDecimal("-1") + StrIsDecimal("1 2"), 0);
}

TEST(RadixConvert, Examples) {
  EXPECT_EQ(Conv(StrHexaToBin, "Aa", 8), "10101010");
  EXPECT_EQ(Conv(StrOctalToBin, "07", 6), "000111");
  EXPECT_EQ(Conv(StrBinToHexa, "11111", 0), "1F");
  EXPECT_EQ(Conv(StrBinToHexa, "", 3), "");  // a wrong n never reads past the string
  EXPECT_EQ(Conv(StrBinToOctal, "1010", 4), "12");
  for (auto [dec, bin] : {std::pair{"10", "1010"}, {"0", "0"}, {"007", "111"}, {"0001", "0001"}, {"", ""},
                          {"4294967296", "100000000000000000000000000000000"}})
    EXPECT_EQ(Conv(StrDecimalToBin, dec, 40), bin) << dec;
}

TEST(RadixConvert, RandomBitsThroughOctalAndHexa) {
  std::mt19937 rng(7);
  for (int round = 0; round < 500; ++round) {
    std::string bits(1 + rng() % 200, '0');
    for (char& c : bits) c = static_cast<char>('0' + rng() % 2);
    int n = static_cast<int>(bits.size());
    for (auto [width, back] : {std::pair{3, Conv(StrOctalToBin, Conv(StrBinToOctal, bits, n), 3 * bits.size())},
                               {4, Conv(StrHexaToBin, Conv(StrBinToHexa, bits, n), 4 * bits.size())}}) {
      size_t pad = (width - n % width) % width;  // zero bits of the first digit
      EXPECT_EQ(back, std::string(pad, '0') + bits);
    }
  }
}

TEST(RadixConvert, DecimalOfAnyLengthMatchesGmp) {
  std::mt19937 rng(11);
  for (int round = 0; round < 300; ++round) {
    std::string dec(1 + rng() % (round < 250 ? 60 : 3000), '0');
    for (size_t i = rng() % 4 ? 0 : rng() % dec.size(); i < dec.size(); ++i) dec[i] = static_cast<char>('0' + rng() % 10);
    ASSERT_EQ(Conv(StrDecimalToBin, dec, 4 * dec.size()), GmpDecimalToBin(dec)) << dec;
  }
  PortTest::AllocFailureGuard guard;
  PortTest::FailNthAlloc(1);
  EXPECT_EQ(Conv(StrDecimalToBin, "12", 4), "");  // no working memory: empty text, no crash
}

TEST(RadixUInt, LimitsAndReports) {
  PortTest::Capture cap;
  unsigned out = 7;
  EXPECT_EQ(StrToUInt(&out, const_cast<char*>("4294967295")), 1);
  EXPECT_EQ(out, 4294967295u);
  EXPECT_EQ(cap.size(), 0u);
  for (std::string big : {"4294967296", "99999999999999999999999"}) {
    EXPECT_EQ(StrToUInt(&out, big.data()), 0);
    ExpectOneReport(cap, Port_Error, "Overflow unsigned integer : " + big + "\n");
  }
  for (std::string bad : {"-1", "1 2"}) {
    EXPECT_EQ(StrToUInt(&out, bad.data()), 0);
    ExpectOneReport(cap, Port_Error, "Not an unsigned integer : " + bad + "\n");
  }
  EXPECT_EQ(out, 4294967295u);
}

TEST(RadixBits, AllZeroAllOne) {
  char s[] = "0110";
  EXPECT_EQ(StrIsAllOne(s, 1, 3) + StrIsAllOne(s, 2, 2) + StrIsAllZero(const_cast<char*>("")), 3);
  EXPECT_EQ(StrIsAllOne(s, 0, 3) + StrIsAllOne(nullptr, 2, 2) + StrIsAllZero(s) + StrIsAllZero(nullptr), 0);
}

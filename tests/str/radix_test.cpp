#include <gmp.h>

#include <cstdlib>
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
  char* text = mpz_get_str(nullptr, 2, z);
  std::string bits = mpz_sgn(z) ? text : "";
  free(text);
  mpz_clear(z);
  return std::string(dec.size() > bits.size() ? dec.size() - bits.size() : 0, '0') + bits;
}

}  // namespace

TEST(RadixCheck, PlainAndSizedForms) {
  for (const char* s : {"101", "4'b1010", "'B", "", "4'b"}) EXPECT_EQ(StrIsBinary(s), 1) << s;
  for (const char* s : {"102", "4'h1", "a'b1", "1'b'1"}) EXPECT_EQ(StrIsBinary(s), 0) << s;
  EXPECT_EQ(StrIsHexa("8'hfF") + StrIsHexa("DEAD"), 2);
  for (const char* s : {"8'hG", "8h'F", "4'd9", "8'o7"}) EXPECT_EQ(StrIsHexa(s) + StrIsOctal(s), 0) << s;
  EXPECT_EQ(StrIsOctal("8") + StrIsDecimal("-1") + StrIsDecimal("1 2"), 0);
}

// Random decimals of any length against GMP; their bits back through octal and hexadecimal digits.
TEST(RadixConvert, DecimalMatchesGmpAndBitsRoundTrip) {
  EXPECT_EQ(Conv(StrDecimalToBin, "", 4) + Conv(StrDecimalToBin, "007", 12) + Conv(StrHexaToBin, "Aa", 8),
            "11110101010");
  EXPECT_EQ(Conv(StrBinToHexa, "11111", 0) + Conv(StrBinToHexa, "", 3), "1F");  // a wrong n never reads past the end
  std::mt19937 rng(11);
  for (int round = 0; round < 150; ++round) {
    std::string dec(1 + rng() % (round < 130 ? 60 : 3000), '0');
    for (size_t i = rng() % 4 ? 0 : rng() % dec.size(); i < dec.size(); ++i)  // some with leading zeros
      dec[i] = static_cast<char>('0' + rng() % 10);
    std::string bits = Conv(StrDecimalToBin, dec, 4 * dec.size());
    ASSERT_EQ(bits, GmpDecimalToBin(dec)) << dec;
    int n = static_cast<int>(bits.size());
    for (auto [width, back] : {std::pair{3, Conv(StrOctalToBin, Conv(StrBinToOctal, bits, n), 3 * bits.size())},
                               {4, Conv(StrHexaToBin, Conv(StrBinToHexa, bits, n), 4 * bits.size())}})
      EXPECT_EQ(back, std::string((width - n % width) % width, '0') + bits);  // zero bits of the first digit
  }
  PortTest::AllocFailureGuard guard;
  PortTest::FailNthAlloc(1);
  EXPECT_EQ(Conv(StrDecimalToBin, "12", 4), "");  // no working memory: empty text, no crash
}

TEST(RadixUInt, LimitsReportsAndBitRuns) {
  PortTest::Capture cap;
  unsigned out = 7;
  EXPECT_EQ(StrToUInt(&out, C("4294967295")), 1);
  for (const char* s : {"4294967296", "99999999999999999999999", "-1"}) EXPECT_EQ(StrToUInt(&out, C(s)), 0) << s;
  EXPECT_EQ(out, 4294967295u);
  EXPECT_EQ(Reports(cap), "4:Overflow unsigned integer : 4294967296\n4:Overflow unsigned integer : "
                          "99999999999999999999999\n4:Not an unsigned integer : -1\n");
  char s[] = "0110";  // all-one ranges (an empty one counts), all-zero strings
  EXPECT_EQ(StrIsAllOne(s, 1, 3) + StrIsAllOne(s, 2, 2) + StrIsAllZero(C("")), 3);
  EXPECT_EQ(StrIsAllOne(s, 0, 3) + StrIsAllOne(nullptr, 2, 2) + StrIsAllZero(s) + StrIsAllZero(nullptr), 0);
}

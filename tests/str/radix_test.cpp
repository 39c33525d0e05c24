#include <gmp.h>

#include <cstring>
#include <random>

#include "str_test_util.h"

// Runs a converter (with n for the bit groupers) into a buffer of room characters.
template <class... N>
static std::string Conv(void (*fn)(const char*, char*, N...), const std::string& in, size_t room, N... n) {
  std::string out(room + 1, '#');
  fn(in.c_str(), out.data(), n...);
  return out.c_str();
}

// Random decimals of any length against GMP (binary text padded with zeros to the
// decimal length); their bits back through octal and hexadecimal digits.
TEST(Radix, DecimalMatchesGmpBitsRoundTripChecksAndLimits) {
  EXPECT_EQ(Conv(StrDecimalToBin, "", 4) + Conv(StrDecimalToBin, "007", 12) + Conv(StrHexaToBin, "Aa", 8),
            "11110101010");
  EXPECT_EQ(Conv(StrBinToHexa, "11111", 5, 0) + Conv(StrBinToHexa, "", 0, 3), "1F");  // a wrong n: no read past the end
  std::mt19937 rng(11);
  for (int round = 0; round < 60; ++round) {
    std::string dec(1 + rng() % (round < 50 ? 60 : 3000), '0');
    for (char& c : dec) c = static_cast<char>('0' + rng() % 10);
    mpz_t z;
    mpz_init_set_str(z, dec.c_str(), 10);
    std::string ref(mpz_sizeinbase(z, 2) + 2, '\0'), bits = Conv(StrDecimalToBin, dec, 4 * dec.size());
    ref.resize(strlen(mpz_get_str(ref.data(), 2, z)));
    mpz_clear(z);
    ASSERT_EQ(bits, std::string(dec.size() > ref.size() ? dec.size() - ref.size() : 0, '0') + ref) << dec;
    int n = static_cast<int>(bits.size());  // the first digit may add zero bits
    std::string oct = Conv(StrBinToOctal, bits, bits.size(), n), hex = Conv(StrBinToHexa, bits, bits.size(), n);
    EXPECT_EQ(Conv(StrOctalToBin, oct, 3 * bits.size()), std::string((3 - n % 3) % 3, '0') + bits);
    EXPECT_EQ(Conv(StrHexaToBin, hex, 4 * bits.size()), std::string((4 - n % 4) % 4, '0') + bits);
  }
  PortTest::AllocFailureGuard guard;
  PortTest::FailNthAlloc(1);
  EXPECT_EQ(Conv(StrDecimalToBin, "12", 4), "");  // no working memory: empty text, no crash
  for (const char* s : {"101", "4'b1010", "'B", "", "4'b"}) EXPECT_EQ(StrIsBinary(s), 1) << s;
  for (const char* s : {"102", "4'h1", "a'b1", "1'b'1"}) EXPECT_EQ(StrIsBinary(s), 0) << s;
  EXPECT_EQ(StrIsHexa("8'hfF") + StrIsHexa("DEAD") + StrIsHexa("8'hG") + StrIsOctal("8") + StrIsDecimal("1 2"), 2);
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

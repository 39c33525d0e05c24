// Checks arbitrary text with each radix check and, when it passes, converts
// the digits into bits and back: octal and hexadecimal digits must come back
// unchanged (hexadecimal in upper case), decimal digits through a Mint.
#include <cctype>
#include <cstddef>
#include <cstdint>
#include <cstring>
#include <string>
#include <vector>

#include "duduzu/mint.h"
#include "duduzu/str.h"
#include "port/port.h"

namespace {
void Check(bool ok) {
  if (!ok) __builtin_trap();
}

std::string Upper(std::string s) {
  for (char& c : s) c = static_cast<char>(toupper(static_cast<unsigned char>(c)));
  return s;
}

// Bits of `digits` written back by `regroup`, compared with the digits.
template <class ToBin, class Regroup>
void RoundTrip(const std::string& digits, size_t width, ToBin toBin, Regroup regroup) {
  std::vector<char> bin(width * digits.size() + 1), back(digits.size() + 1);
  toBin(digits.c_str(), bin.data());
  Check(strlen(bin.data()) == width * digits.size());
  regroup(bin.data(), back.data(), 0);
  Check(back.data() == Upper(digits));
}
}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size) {
  std::string text(reinterpret_cast<const char*>(data), size);
  text.resize(strlen(text.c_str()));  // up to a NUL byte
  const char* s = text.c_str();
  // The digits of a sized constant follow the apostrophe and radix letter.
  const char* tick = strchr(s, '\'');
  std::string digits = tick && tick[1] ? tick + 2 : s;

  if (StrIsBinary(s)) Check(digits.find_first_not_of("01") == std::string::npos);
  if (StrIsOctal(s)) RoundTrip(digits, 3, StrOctalToBin, StrBinToOctal);
  if (StrIsHexa(s)) RoundTrip(digits, 4, StrHexaToBin, StrBinToHexa);
  if (StrIsDecimal(s)) {
    // At most 4 bits per digit, at least one per digit.
    std::vector<char> bin(4 * text.size() + 1), back(text.size() + 3);
    StrDecimalToBin(s, bin.data());
    size_t n = strlen(bin.data());
    Check(n >= text.size() && n <= 4 * text.size());
    unsigned int* m = nullptr;
    int cells = 0;
    if (n > 0 && n < 10000 && MintFromStr(bin.data(), &m, &cells, 2)) {
      MintToStr(m, cells, static_cast<int>(text.size()), 10, 0, back.data());
      Check(back.data() == text);
      vzl_free(m);
    }
  }
  return 0;
}

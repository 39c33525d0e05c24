// Radix digit strings: checks (with sized constants such as 8'hFF), expansion
// of octal, hexadecimal and decimal text into bits, regrouping of bits into
// octal and hexadecimal digits, and unsigned decimal parsing.
#include <cctype>
#include <cstdint>
#include <cstring>

#include "duduzu/str.h"
#include "frame/unit.h"

namespace {

constexpr const char* kUnit = "../s/strutil";

bool isBinaryDigit(int c) { return c == '0' || c == '1'; }

template <class Digit>
bool allDigits(const char* s, Digit digit) {
  for (; *s; ++s)
    if (!digit(static_cast<unsigned char>(*s))) return false;
  return true;
}

// Bare digits, or a sized constant: optional width, apostrophe, radix letter, digits.
template <class Digit>
int checkSized(const char* s, char letter, Digit digit) {
  if (strchr(s, '\'')) {
    while (isdigit(static_cast<unsigned char>(*s))) ++s;
    if (s[0] != '\'' || tolower(static_cast<unsigned char>(s[1])) != letter) return 0;
    s += 2;
  }
  return allDigits(s, digit);
}

// Writes each digit's value as `width` bits, most significant first.
template <class Value>
void expandDigits(const char* digits, char* bin, int width, Value value) {
  for (; *digits; ++digits) {
    unsigned v = static_cast<unsigned>(value(*digits));
    for (int b = width - 1; b >= 0; --b) *bin++ = static_cast<char>('0' + ((v >> b) & 1));
  }
  *bin = '\0';
}

// Regroups bits into digits of `width` bits from the right: the first group
// takes n mod width bits (a full group when that is 0). A group is cut short
// at the end of the string, which a wrong n can reach early.
void groupBits(const char* bin, char* out, int n, int width) {
  if (n < 1) n = static_cast<int>(strlen(bin));
  int take = n % width ? n % width : width;
  while (*bin) {
    unsigned v = 0;
    for (int i = 0; i < take && *bin; ++i) v = 2 * v + (*bin++ == '1');
    *out++ = "0123456789ABCDEF"[v];
    take = width;
  }
  *out = '\0';
}

// 8 bit characters for each byte value, most significant first.
struct ByteBits {
  char text[256][8];
  constexpr ByteBits() : text() {
    for (int v = 0; v < 256; ++v)
      for (int b = 0; b < 8; ++b) text[v][b] = static_cast<char>('0' + ((v >> (7 - b)) & 1));
  }
};
constexpr ByteBits kByteBits;

constexpr int kChunkDigits = 19;  // 10^19 is the largest power of ten in 64 bits
constexpr uint64_t kChunkScale = 10000000000000000000ull;

uint64_t chunkValue(const char* d, int len) {
  uint64_t v = 0;
  for (int i = 0; i < len; ++i) v = 10 * v + static_cast<uint64_t>(d[i] - '0');
  return v;
}

// Writes the `count` low bits of v, most significant first.
char* putBits(char* out, uint64_t v, int count) {
  for (; count % 8; --count) *out++ = static_cast<char>('0' + ((v >> (count - 1)) & 1));
  for (; count; count -= 8, out += 8) memcpy(out, kByteBits.text[(v >> (count - 8)) & 0xff], 8);
  return out;
}

}  // namespace

int CharIsBinary(char c) { return isBinaryDigit(c); }

int CharIsOctal(char c) { return c >= '0' && c <= '7'; }

int StrIsBinary(const char* s) { return checkSized(s, 'b', isBinaryDigit); }

int StrIsOctal(const char* s) {
  return allDigits(s, [](int c) { return c >= '0' && c <= '7'; });
}

int StrIsDecimal(const char* s) {
  return allDigits(s, [](int c) { return isdigit(c) != 0; });
}

int StrIsHexa(const char* s) {
  return checkSized(s, 'h', [](int c) { return isxdigit(c) != 0; });
}

void StrOctalToBin(const char* oct, char* bin) {
  expandDigits(oct, bin, 3, [](char c) { return c - '0'; });
}

void StrHexaToBin(const char* hex, char* bin) {
  expandDigits(hex, bin, 4, [](char c) {
    return c <= '9' ? c - '0' : c <= 'Z' ? c - 55 : c - 87;
  });
}

// The number is read into 64-bit limbs (least significant first), 19 decimal
// digits at a time, then written out bit by bit; leading zeros pad the result
// to at least the number of decimal characters.
void StrDecimalToBin(const char* dec, char* bin) {
  int len = static_cast<int>(strlen(dec));
  uint64_t* limb =
      static_cast<uint64_t*>(vzl_malloc(sizeof(uint64_t) * static_cast<size_t>(len / kChunkDigits + 1)));
  if (!limb) {
    *bin = '\0';
    return;
  }
  int used = 0;
  for (int at = 0, take = len % kChunkDigits ? len % kChunkDigits : kChunkDigits; at < len;
       at += take, take = kChunkDigits) {
    uint64_t carry = chunkValue(dec + at, take);
    for (int i = 0; i < used; ++i) {
      unsigned __int128 t = static_cast<unsigned __int128>(limb[i]) * kChunkScale + carry;
      limb[i] = static_cast<uint64_t>(t);
      carry = static_cast<uint64_t>(t >> 64);
    }
    if (carry) limb[used++] = carry;
  }
  int top = used ? 64 - __builtin_clzll(limb[used - 1]) : 0;
  int bits = used ? 64 * (used - 1) + top : 0;
  int pad = len > bits ? len - bits : 0;
  memset(bin, '0', static_cast<size_t>(pad));
  char* out = bin + pad;
  if (used) out = putBits(out, limb[used - 1], top);
  for (int i = used - 2; i >= 0; --i) out = putBits(out, limb[i], 64);
  *out = '\0';
  vzl_free(limb);
}

void StrBinToOctal(const char* bin, char* oct, int n) { groupBits(bin, oct, n, 3); }

void StrBinToHexa(const char* bin, char* hex, int n) { groupBits(bin, hex, n, 4); }

int StrToUInt(unsigned int* out, char* s) {
  if (!StrIsDecimal(s)) {
    DZ_REPORT(Error, "Not an unsigned integer : %s\n", s);
    return 0;
  }
  uint64_t value = 0;
  for (const char* c = s; *c; ++c) {
    value = 10 * value + static_cast<uint64_t>(*c - '0');
    if (value > UINT32_MAX) {
      DZ_REPORT(Error, "Overflow unsigned integer : %s\n", s);
      return 0;
    }
  }
  *out = static_cast<unsigned int>(value);
  return 1;
}

int StrIsAllZero(char* s) {
  return s && allDigits(s, [](int c) { return c == '0'; });
}

int StrIsAllOne(char* s, int from, int to) {
  if (!s) return 0;
  for (int i = from; i < to; ++i)
    if (s[i] != '1') return 0;
  return 1;
}

// Mint text forms: reading and writing in bases 2, 8, 10 and 16, the one-cell
// decimal steps, printing, and the search in a list of Mints.
#include <algorithm>
#include <cctype>
#include <cstdint>
#include <cstring>

#include "duduzu/list.h"
#include "duduzu/mint.h"
#include "duduzu/str.h"
#include "frame/unit.h"

namespace {

constexpr const char* kUnit = "../s/multint";

// Octal, decimal and hexadecimal text is widened into binary digits in a
// buffer of this many characters, so at most kBinLimit - 1 binary digits.
constexpr int kBinLimit = 10000;
// Decimal text of more significant digits than this has a value of more than
// kBinLimit - 1 bits (10^3011 > 2^10002), and this many digits give at most
// 10003 bits (3011 * log2 10 < 10003): the buffer below holds every candidate.
constexpr int kDecimalSignificantLimit = 3011;
constexpr int kDecimalBinRoom = 10004;

const char kDigits[] = "0123456789ABCDEF";
constexpr uint64_t kChunk = 1000000000;  // nine decimal digits

bool isLetter(char c, char upper) { return c == upper || c == upper + ('a' - 'A'); }

// Digits of base-2 or base-16 text: after "%" and the letter, after an
// optional decimal width, an apostrophe and the letter, or the whole text.
// Null when the prefix is malformed.
const char* sizedDigits(const char* text, char letter) {
  if (text[0] == '%') return isLetter(text[1], letter) ? text + 2 : nullptr;
  if (!strchr(text, '\'')) return text;
  while (isdigit(static_cast<unsigned char>(*text))) ++text;
  return text[0] == '\'' && isLetter(text[1], letter) ? text + 2 : nullptr;
}

// Digits after an optional "%" and the letter (bases 8 and 10).
const char* prefixedDigits(const char* text, char letter) {
  return text[0] == '%' && isLetter(text[1], letter) ? text + 2 : text;
}

// The digits of `text` read in `base` (0 selects it from the text), with the
// base they are in; null when the text does not fit the base. An apostrophe
// left in the digits is refused: it is not a digit of any base.
const char* digitsOf(const char* text, int* base) {
  if (*base == 0) {
    if (isdigit(static_cast<unsigned char>(text[0]))) {
      *base = 10;
      return StrIsDecimal(text) ? text : nullptr;
    }
    if (text[0] != '%' || text[1] == '\0' || text[2] == '\0') return nullptr;
    switch (toupper(static_cast<unsigned char>(text[1]))) {
      case 'B': *base = 2; break;
      case 'O': *base = 8; break;
      case 'D': *base = 10; break;
      case 'H': *base = 16; break;
      default: return nullptr;
    }
  }
  const char* digits = nullptr;
  switch (*base) {
    case 2: digits = sizedDigits(text, 'B'); break;
    case 8: digits = prefixedDigits(text, 'O'); break;
    case 10: digits = prefixedDigits(text, 'D'); break;
    case 16: digits = sizedDigits(text, 'H'); break;
    default: return nullptr;
  }
  if (!digits || strchr(digits, '\'')) return nullptr;
  bool valid = *base == 2    ? StrIsBinary(digits)
               : *base == 8  ? StrIsOctal(digits)
               : *base == 10 ? StrIsDecimal(digits)
                             : StrIsHexa(digits);
  return valid ? digits : nullptr;
}

// Whether the binary form of valid digits can fit the conversion buffer.
bool fitsBuffer(const char* digits, int base) {
  size_t n = strlen(digits);
  if (base == 8) return n * 3 < kBinLimit;
  if (base == 16) return n * 4 < kBinLimit;
  size_t significant = n - strspn(digits, "0");
  return n < kBinLimit && significant <= kDecimalSignificantLimit;
}

// A new Mint whose bit 1 is the last binary digit; a digit other than 1 is a
// 0 bit. Null after the memory report.
unsigned int* mintOfBinary(const char* bin, int* cells) {
  int length = static_cast<int>(strlen(bin));
  *cells = length > 32 ? (length + 31) / 32 : 1;
  unsigned int* m = MintCreateNoInit(*cells);
  if (!m) return nullptr;
  // Cell c holds the (up to) 32 digits that end 32 * c digits before the end.
  for (int c = 0, end = length; end > 0; ++c, end -= 32) {
    unsigned int v = 0;
    for (int k = end > 32 ? end - 32 : 0; k < end; ++k) v = v << 1 | (bin[k] == '1');
    m[c] = v;
  }
  return m;
}

// Index (from 0) of the highest set bit, -1 for a zero Mint.
int highestBit(const unsigned int* m, int cells) {
  for (int i = cells - 1; i >= 0; --i)
    if (m[i]) return 32 * i + 31 - __builtin_clz(m[i]);
  return -1;
}

// The groups of `bits` bits from the most significant non-zero one down, one
// digit each; returns the number of digits.
int writePowerOfTwo(const unsigned int* m, int cells, int bits, char* out) {
  int highest = highestBit(m, cells);
  if (highest < 0) {
    out[0] = '0';
    return 1;
  }
  int groups = highest / bits + 1;
  for (int g = groups - 1, n = 0; g >= 0; --g, ++n) {
    int first = g * bits, cell = first >> 5, shift = first & 31;
    unsigned int v = m[cell] >> shift;
    if (shift + bits > 32 && cell + 1 < cells) v |= m[cell + 1] << (32 - shift);
    out[n] = kDigits[v & ((1u << bits) - 1)];
  }
  return groups;
}

// Decimal digits by repeated long division of a copy, by 10^9 so that each
// pass over the cells yields nine digits; -1 when the copy cannot be made.
int writeDecimal(unsigned int* m, int cells, char* out) {
  unsigned int* copy = MintCopy(m, cells);
  if (!copy) return -1;
  int top = cells - 1, n = 0;
  while (top >= 0 && copy[top] == 0) --top;
  do {
    uint64_t remainder = 0;
    for (int i = top; i >= 0; --i) {
      uint64_t dividend = remainder << 32 | copy[i];
      copy[i] = static_cast<unsigned int>(dividend / kChunk);
      remainder = dividend % kChunk;
    }
    while (top >= 0 && copy[top] == 0) --top;
    // Nine digits, least significant first; the last chunk without leading zeros.
    for (int k = 0; k < 9 && (top >= 0 || remainder || n == 0); ++k, remainder /= 10)
      out[n++] = static_cast<char>('0' + remainder % 10);
  } while (top >= 0);
  vzl_free(copy);
  std::reverse(out, out + n);
  return n;
}

}  // namespace

int MintFromStr(char const* text, unsigned int** result, int* cells, int base) {
  const char* digits = digitsOf(text, &base);
  if (!digits) return 0;
  char buffer[kDecimalBinRoom];
  const char* bin = digits;  // binary text is used as it is
  if (base != 2) {
    if (!fitsBuffer(digits, base)) return 0;
    if (base == 8) StrOctalToBin(digits, buffer);
    if (base == 10) StrDecimalToBin(digits, buffer);
    if (base == 16) StrHexaToBin(digits, buffer);
    // An empty form of non-empty digits means the converter lacked memory.
    size_t length = strlen(buffer);
    if (length >= kBinLimit || (length == 0 && *digits)) return 0;
    bin = buffer;
  }
  int count = 0;
  *result = mintOfBinary(bin, &count);
  if (!*result) return 0;
  *cells = count;
  return 1;
}

void MintToStr(unsigned int* m, int cells, int width, int base, int prefix, char* text) {
  char letter;
  switch (base) {
    case 0: case 10: letter = 'D'; break;
    case 2: letter = 'B'; break;
    case 8: letter = 'O'; break;
    case 16: letter = 'H'; break;
    default: text[0] = '\0'; return;
  }
  char* digits = prefix ? text + 2 : text;
  int n = letter == 'D' ? writeDecimal(m, cells, digits)
                        : writePowerOfTwo(m, cells, base == 2 ? 1 : base == 8 ? 3 : 4, digits);
  if (n < 0) {
    text[0] = '\0';
    return;
  }
  if (width > 0 && n < width) {
    memmove(digits + (width - n), digits, static_cast<size_t>(n));
    memset(digits, '0', static_cast<size_t>(width - n));
  }
  if (width > 0) n = width;
  digits[n] = '\0';
  if (prefix) {
    text[0] = '%';
    text[1] = letter;
  }
}

// cell * 10 + carry from the low 4 and high 28 bits of the cell, each
// product within 32 bits; the returned high part is the carry out.
unsigned int MintMultiplyOneCellBy10(unsigned int* cell, unsigned int carry) {
  unsigned int high = (*cell >> 4) * 10u;  // below 2^32
  unsigned int low = (high & 0x0FFFFFFFu) << 4;
  unsigned int out = high >> 28;
  out += MintAddOneCell(&low, (*cell & 15u) * 10u);
  out += MintAddOneCell(&low, carry);
  *cell = low;
  return out;
}

// (remainder * 2^32 + cell) / 10 with 2^31 = 10 * 214748364 + 8: the dividend
// is h * 2^31 + x, h = remainder * 2 + top bit (below 20), x the low 31 bits.
unsigned int MintDivideOneCellBy10(unsigned int* cell, unsigned int remainder) {
  unsigned int h = (remainder << 1) | (*cell >> 31);
  unsigned int x = *cell & 0x7FFFFFFFu;
  unsigned int rest = 8u * h + x % 10u;
  *cell = h * 214748364u + x / 10u + rest / 10u;
  return rest % 10u;
}

void MintPrint(FILE* f, unsigned int* m, int cells) {
  for (int i = cells - 1; i >= 0; --i) DZ_OUT(f, "%u,", m[i]);
}

void MintListPrint(FILE* f, DomList* list, int cells) {
  if (!list || list->count == 0) return;
  // Room for every hexadecimal digit of `cells` cells and the terminator.
  char* text = static_cast<char*>(vzl_malloc(8 * static_cast<size_t>(cells > 0 ? cells : 0) + 4));
  if (!text) {
    DZ_REPORT(Error, "Memory Full (%s)\n", "Function MintListPrint");
    return;
  }
  for (int i = 0; i < list->count; ++i) {
    MintToStr(reinterpret_cast<unsigned int*>(list->elements[i]), cells, 0, 16, 0, text);
    DZ_OUT(f, "%s\n", text);
  }
  vzl_free(text);
}

int MintExistsInHeap(unsigned int* m, int cells, DomList* list, int count) {
  for (int pos = count; pos >= 1; --pos) {
    unsigned int* e = reinterpret_cast<unsigned int*>(list->elements[pos - 1]);
    if (e && MintIdentical(e, m, cells)) return 1;
  }
  return 0;
}

// Reads arbitrary text as a Mint in every base and writes it back. The first
// byte picks the base (one of them refused) and how many times the last
// character is repeated, so that texts reach the length limits; every Mint
// read is written in each base and, where that text is within the base's
// digit limit, must read back to the same value.
#include "duduzu/mint.h"

#include <cstddef>
#include <cstdint>
#include <cstring>
#include <string>
#include <vector>

#include "port/port.h"

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size) {
  if (size < 2) return 0;
  static const int bases[] = {0, 2, 8, 10, 16, 3};
  int base = bases[data[0] % 6];
  std::string text(reinterpret_cast<const char*>(data + 1), size - 1);
  text.append(static_cast<size_t>(data[0] / 6) * 300, text.back());

  unsigned int* m = nullptr;
  int cells = 0;
  if (!MintFromStr(text.c_str(), &m, &cells, base)) return 0;
  std::vector<char> out(32 * static_cast<size_t>(cells) + 3);
  static const struct {
    int base;
    size_t limit;  // digits that read back in a 10000-digit binary form
  } forms[] = {{2, 9999}, {8, 3333}, {10, 3010}, {16, 2499}};
  for (auto form : forms) {
    MintToStr(m, cells, 0, form.base, 1, out.data());
    unsigned int* back = nullptr;
    int backCells = 0;
    if (!MintFromStr(out.data(), &back, &backCells, 0)) {
      if (strlen(out.data()) - 2 <= form.limit) __builtin_trap();
      continue;
    }
    for (int i = 0; i < (cells > backCells ? cells : backCells); ++i)
      if ((i < cells ? m[i] : 0) != (i < backCells ? back[i] : 0)) __builtin_trap();
    vzl_free(back);
  }
  vzl_free(m);
  return 0;
}

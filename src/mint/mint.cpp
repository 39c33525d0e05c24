// Mint storage: creation, single bits, logic operations, comparisons, counts,
// increments and the set-bit printers.
#include <cstring>

#include "duduzu/mint.h"
#include "frame/unit.h"

namespace {

constexpr const char* kUnit = "../s/multint";

// Zero-filled cells, or null after the error report naming `creator`.
unsigned int* allocCells(int cells, const char* creator) {
  void* m = vzl_calloc(static_cast<size_t>(cells), sizeof(unsigned int));
  if (!m) DZ_REPORT(Error, "Memory Full (%s)\n", creator);
  return static_cast<unsigned int*>(m);
}

// result[i] = op(i) for every cell, a whole cell at a time. Each cell is read
// by `op` before it is written, so result may be an operand. 1 if any result
// cell is non-zero.
template <class Op>
int applyCells(unsigned int* result, int cells, Op op) {
  unsigned int any = 0;
  for (int i = 0; i < cells; ++i) {
    unsigned int v = op(i);
    result[i] = v;
    any |= v;
  }
  return any != 0;
}

// The creating form of a logic operation: a MintCreateNoInit result filled by op.
template <class Op>
unsigned int* createWith(int cells, Op op) {
  unsigned int* result = MintCreateNoInit(cells);
  if (result) applyCells(result, cells, op);
  return result;
}

constexpr unsigned int cellOf(int bit) { return static_cast<unsigned int>(bit - 1) >> 5; }
constexpr unsigned int maskOf(int bit) { return 1u << (static_cast<unsigned int>(bit - 1) & 31u); }

}  // namespace

unsigned int* MintCreateNoInit(int cells) { return allocCells(cells + 1, "Function MintCreateNoInit"); }

unsigned int* MintCreateInitValue(int cells, unsigned int value) {
  unsigned int* m = allocCells(cells, "Function MintCreateInitValue");
  if (m) MintInitWithValue(m, cells, value);
  return m;
}

unsigned int* MintCreateInit0(int cells) { return MintCreateInitValue(cells, 0); }

unsigned int* MintCopy(unsigned int* m, int cells) {
  unsigned int* copy = allocCells(cells, "Function MintCopy");
  if (copy && cells > 0) memcpy(copy, m, sizeof(unsigned int) * static_cast<size_t>(cells));
  return copy;
}

int MintCopyNoCr(unsigned int* m, unsigned int* result, int cells) {
  return applyCells(result, cells, [m](int i) { return m[i]; });
}

void MintInitWithValue(unsigned int* m, int cells, unsigned int value) {
  for (int i = 0; i < cells; ++i) m[i] = value;
}

int MintBitValue(unsigned int* m, int bit) { return (m[cellOf(bit)] & maskOf(bit)) != 0; }
void MintSetBitValue(unsigned int* m, int bit) { m[cellOf(bit)] |= maskOf(bit); }
void MintResetBitValue(unsigned int* m, int bit) { m[cellOf(bit)] &= ~maskOf(bit); }
void MintInvBitValue(unsigned int* m, int bit) { m[cellOf(bit)] ^= maskOf(bit); }

int MintNotNull(unsigned int* m, int cells) {
  for (int i = 0; i < cells; ++i)
    if (m[i]) return 1;
  return 0;
}

int MintIdentical(unsigned int* a, unsigned int* b, int cells) {
  for (int i = cells - 1; i >= 0; --i)
    if (a[i] != b[i]) return 0;
  return 1;
}

int MintLess(unsigned int* a, unsigned int* b, int cells) {
  for (int i = cells - 1; i >= 0; --i)
    if (a[i] != b[i]) return a[i] < b[i];
  return 0;
}

int MintIncluded(unsigned int* a, unsigned int* b, int cells) {
  for (int i = 0; i < cells; ++i)
    if (a[i] & ~b[i]) return 0;
  return 1;
}

// Clears the lowest set bit until none is left: work follows the set bits.
int MintCardinalOneCell(unsigned int cell) {
  int n = 0;
  for (; cell; cell &= cell - 1) ++n;
  return n;
}

int MintCardinalAllCells(unsigned int* m, int cells) {
  int n = 0;
  for (int i = 0; i < cells; ++i) n += MintCardinalOneCell(m[i]);
  return n;
}

int MintLocateFirst1(unsigned int* m, int cells, int* cellIndex, unsigned int* bitMask) {
  for (int i = cells - 1; i >= 0; --i) {
    if (!m[i]) continue;
    *cellIndex = i;
    *bitMask = m[i] & ~(m[i] - 1);
    return 1;
  }
  return 0;
}

unsigned int* MintNOT(unsigned int* a, int cells) {
  return createWith(cells, [a](int i) { return ~a[i]; });
}
unsigned int* MintAND(unsigned int* a, unsigned int* b, int cells) {
  return createWith(cells, [a, b](int i) { return a[i] & b[i]; });
}
unsigned int* MintOR(unsigned int* a, unsigned int* b, int cells) {
  return createWith(cells, [a, b](int i) { return a[i] | b[i]; });
}
unsigned int* MintXNOR(unsigned int* a, unsigned int* b, int cells) {
  return createWith(cells, [a, b](int i) { return ~(a[i] ^ b[i]); });
}

int MintNOTNoCreate(unsigned int* a, unsigned int* result, int cells) {
  return applyCells(result, cells, [a](int i) { return ~a[i]; });
}
int MintANDNoCreate(unsigned int* a, unsigned int* b, unsigned int* result, int cells) {
  return applyCells(result, cells, [a, b](int i) { return a[i] & b[i]; });
}
int MintORNoCreate(unsigned int* a, unsigned int* b, unsigned int* result, int cells) {
  return applyCells(result, cells, [a, b](int i) { return a[i] | b[i]; });
}
int MintNORNoCreate(unsigned int* a, unsigned int* b, unsigned int* result, int cells) {
  return applyCells(result, cells, [a, b](int i) { return ~(a[i] | b[i]); });
}
void MintXORNoCreate(unsigned int* a, unsigned int* b, unsigned int* result, int cells) {
  applyCells(result, cells, [a, b](int i) { return a[i] ^ b[i]; });
}
void MintXNORNoCreate(unsigned int* a, unsigned int* b, unsigned int* result, int cells) {
  applyCells(result, cells, [a, b](int i) { return ~(a[i] ^ b[i]); });
}

unsigned int MintAddOneCell(unsigned int* cell, unsigned int value) {
  unsigned int carry = *cell > ~0u - value;
  *cell += value;
  return carry;
}

unsigned int MintIncrement(unsigned int* m, int cells) {
  for (int i = 0; i < cells; ++i)
    if (++m[i] != 0) return 0;
  return 1;
}

void PrintBitsEqualTo1(FILE* f, unsigned int cell, int offset) {
  for (int position = 0; position < 32; ++position)
    if (cell & (1u << position)) DZ_OUT(f, " %d", offset + position + 1);
}

void MintPrintBitsEqualTo1(FILE* f, unsigned int* m, int cells) {
  for (int i = 0; i < cells; ++i) PrintBitsEqualTo1(f, m[i], 32 * i);
}

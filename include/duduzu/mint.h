// Mint: a bit vector of any length, also read as an unsigned integer of any
// width. It is a plain array of 32-bit cells, least significant cell first,
// whose cell count the caller keeps. Bits are numbered from 1: bit b lies in
// cell (b - 1) / 32 at position (b - 1) % 32. Created Mints are zero-filled,
// belong to the caller and are released with vzl_free.
#pragma once

#include <cstdio>

#include "duduzu/export.h"

// Creation and copying. MintCreateNoInit allocates one spare zero cell beyond
// `cells`; the others allocate exactly `cells` cells. Null after a
// "Memory Full" error report.
DUDUZU_API unsigned int* MintCreateNoInit(int cells);
DUDUZU_API unsigned int* MintCreateInitValue(int cells, unsigned int value);
DUDUZU_API unsigned int* MintCreateInit0(int cells);
DUDUZU_API unsigned int* MintCopy(unsigned int* m, int cells);
// Copies m into result; 1 if any copied cell is non-zero.
DUDUZU_API int MintCopyNoCr(unsigned int* m, unsigned int* result, int cells);
DUDUZU_API void MintInitWithValue(unsigned int* m, int cells, unsigned int value);

// Single bits, numbered from 1.
DUDUZU_API int MintBitValue(unsigned int* m, int bit);
DUDUZU_API void MintSetBitValue(unsigned int* m, int bit);
DUDUZU_API void MintResetBitValue(unsigned int* m, int bit);
DUDUZU_API void MintInvBitValue(unsigned int* m, int bit);

// Tests, counts and search.
DUDUZU_API int MintNotNull(unsigned int* m, int cells);
DUDUZU_API int MintIdentical(unsigned int* a, unsigned int* b, int cells);
DUDUZU_API int MintLess(unsigned int* a, unsigned int* b, int cells);
DUDUZU_API int MintIncluded(unsigned int* a, unsigned int* b, int cells);
DUDUZU_API int MintCardinalOneCell(unsigned int cell);
DUDUZU_API int MintCardinalAllCells(unsigned int* m, int cells);
// Most significant non-zero cell and the lowest set bit in it: 1 and both
// outputs filled, or 0 with the outputs untouched for a zero Mint.
DUDUZU_API int MintLocateFirst1(unsigned int* m, int cells, int* cellIndex, unsigned int* bitMask);

// Logic operations creating their result: `cells` + 1 cells, the spare one zero.
DUDUZU_API unsigned int* MintNOT(unsigned int* a, int cells);
DUDUZU_API unsigned int* MintAND(unsigned int* a, unsigned int* b, int cells);
DUDUZU_API unsigned int* MintOR(unsigned int* a, unsigned int* b, int cells);
DUDUZU_API unsigned int* MintXNOR(unsigned int* a, unsigned int* b, int cells);

// Logic operations into `result`, which may be `a` or `b`. The int forms
// return 1 if any result cell is non-zero.
DUDUZU_API int MintNOTNoCreate(unsigned int* a, unsigned int* result, int cells);
DUDUZU_API int MintANDNoCreate(unsigned int* a, unsigned int* b, unsigned int* result, int cells);
DUDUZU_API int MintORNoCreate(unsigned int* a, unsigned int* b, unsigned int* result, int cells);
DUDUZU_API int MintNORNoCreate(unsigned int* a, unsigned int* b, unsigned int* result, int cells);
DUDUZU_API void MintXORNoCreate(unsigned int* a, unsigned int* b, unsigned int* result, int cells);
DUDUZU_API void MintXNORNoCreate(unsigned int* a, unsigned int* b, unsigned int* result, int cells);

// Arithmetic: both return the carry out (1 on overflow).
DUDUZU_API unsigned int MintAddOneCell(unsigned int* cell, unsigned int value);
DUDUZU_API unsigned int MintIncrement(unsigned int* m, int cells);

// The numbers of the set bits, each as " %d", by the main-output rule.
DUDUZU_API void PrintBitsEqualTo1(FILE* f, unsigned int cell, int offset);
DUDUZU_API void MintPrintBitsEqualTo1(FILE* f, unsigned int* m, int cells);

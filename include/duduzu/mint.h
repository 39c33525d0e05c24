// Mint: a bit vector of any length, also read as an unsigned integer of any
// width. It is a plain array of 32-bit cells, least significant cell first,
// whose cell count the caller keeps. Bits are numbered from 1: bit b lies in
// cell (b - 1) / 32 at position (b - 1) % 32. Created Mints are zero-filled,
// belong to the caller and are released with vzl_free.
#pragma once

#include <cstdio>

#include "duduzu/export.h"
#include "duduzu/list.h"

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

// Text forms. Bases 2, 8, 10 and 16; prefixes "%B", "%O", "%D", "%H"; bases 2
// and 16 also read as width'b... and width'h... (the width is ignored).
//
// Reads `text` in `base` (0: decimal when it starts with a digit, else by its
// prefix). On success stores a new Mint (MintCreateNoInit-sized) and its cell
// count and returns 1; returns 0 leaving both untouched for text that does not
// fit, for a binary form beyond 9999 digits and for any other base.
DUDUZU_API int MintFromStr(char const* text, unsigned int** result, int* cells, int base);
// Writes m in `base` (0 and 10 decimal; 2, 8, 16) without leading zeros, hex
// in upper case; `width` > 0 pads with zeros or keeps the leading digits;
// `prefix` adds the base prefix. `text` holds max(digits, width) + 3 chars.
// Any other base writes the empty text.
DUDUZU_API void MintToStr(unsigned int* m, int cells, int width, int base, int prefix, char* text);
// cell = low 32 bits of cell * 10 + carry; returns the high part.
DUDUZU_API unsigned int MintMultiplyOneCellBy10(unsigned int* cell, unsigned int carry);
// cell = (remainder * 2^32 + cell) / 10 for remainder < 10; returns the new remainder.
DUDUZU_API unsigned int MintDivideOneCellBy10(unsigned int* cell, unsigned int remainder);

// Printing by the main-output rule: "%u," per cell from the top down; and the
// hexadecimal text of each Mint of a list, one per line.
DUDUZU_API void MintPrint(FILE* f, unsigned int* m, int cells);
DUDUZU_API void MintListPrint(FILE* f, DomList* list, int cells);
// 1 if one of the first `count` elements of `list` (null ones skipped) equals m.
DUDUZU_API int MintExistsInHeap(unsigned int* m, int cells, DomList* list, int count);

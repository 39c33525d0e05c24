// Integer and float helpers: comparators in the shapes the list callbacks
// expect, integer logarithms and bit tests, float comparison to a number of
// decimal places, a Newton square root and quoted number strings.
#pragma once

#include <cstdio>

#include "duduzu/export.h"
#include "duduzu/list.h"

// Comparisons and identities.
DUDUZU_API int Max(int a, int b);
DUDUZU_API long LongCopy(long x);
DUDUZU_API int IntIdentical(int a, int b);
DUDUZU_API int PtrIdentical(int* p, int* q);
DUDUZU_API int IntCompare(int a, int b);
DUDUZU_API int LongCompare(long a, long b);
DUDUZU_API int UnsLessOrEqual(unsigned a, unsigned b);
// 1 when some element of the list equals v (a yes/no answer, not a position).
DUDUZU_API int IntMemberOfList(DomList* list, int v);

// Writes n with "%d" by the main-output rule.
DUDUZU_API void IntPrint(FILE* stream, int n);

// Integer logarithms (-1 for arguments without one) and bit tests.
DUDUZU_API int IntSupLog2(unsigned n);
DUDUZU_API int IntInfLog2(unsigned n);
DUDUZU_API int IntSupLog10(int n);
DUDUZU_API int IntInfLog10(int n);
DUDUZU_API int IntSupLogk(int n, int k);
DUDUZU_API int IntSupLog2f(double x);
DUDUZU_API int IntIsPowerOf2(int n, unsigned* exponent);
// 1-based index of the lowest set bit; 0 for 0.
DUDUZU_API int IntLocateFirstBit1(int n);

// Single-precision comparison to `precision` decimal places.
DUDUZU_API int FloatEq(float a, float b, int precision);
DUDUZU_API int FloatLess(float a, float b, int precision);
DUDUZU_API int FloatGreat(float a, float b, int precision);
DUDUZU_API int FloatPtrCmp(float* a, float* b, int precision);

// Newton's square root to within 0.01; -1.0 for a negative x.
DUDUZU_API double FloatSquareRoot(double x);

// New strings (vzl_calloc, released with vzl_free) holding the number between
// double-quote characters: IntToHexa zero-pads lower-case hexadecimal digits to
// at least `width`; IntToStr gives the decimal form.
DUDUZU_API char* IntToHexa(int value, int width);
DUDUZU_API char* IntToStr(int value);

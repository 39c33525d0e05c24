// Integer and float helpers: comparators, integer logarithms, bit tests,
// float comparison to a number of decimal places, Newton's square root and
// quoted number strings.
#include <cmath>
#include <cstdarg>

#include "duduzu/intutil.h"
#include "frame/unit.h"
#include "str/strbuild.h"

namespace {

constexpr const char* kUnit = "../s/intutil";

// Smallest r >= 0 with base^r >= n; -1 for n <= 0.
int supLog(long long n, long long base) {
  if (n <= 0) return -1;
  int r = 0;
  for (long long p = 1; p < n; p *= base) ++r;
  return r;
}

// Largest r with base^r <= n; -1 for n <= 0.
int infLog(long long n, long long base) {
  if (n <= 0) return -1;
  int r = 0;
  for (long long p = 1; p <= n; p *= base) ++r;
  return r - 1;
}

// 10^precision built by repeated single-precision products, as the
// comparisons define it (it differs from the nearest float to 10^p for some p).
float scaleOf(int precision) {
  float s = 1.0f;
  for (int i = 0; i < precision && s < INFINITY; ++i) s *= 10.0f;
  return s;
}

template <class T>
int threeWay(T a, T b) {
  return (a > b) - (a < b);
}

}  // namespace

int Max(int a, int b) { return a > b ? a : b; }

long LongCopy(long x) { return x; }

int IntIdentical(int a, int b) { return a == b; }

int PtrIdentical(int* p, int* q) { return p == q; }

int IntCompare(int a, int b) { return threeWay(a, b); }

int LongCompare(long a, long b) { return threeWay(a, b); }

int UnsLessOrEqual(unsigned a, unsigned b) { return a <= b; }

int IntMemberOfList(DomList* list, int v) { return ListMemberOfListInt(list, v) != 0; }

void IntPrint(FILE* stream, int n) { DZ_OUT(stream, "%d", n); }

int IntSupLog2(unsigned n) { return supLog(n, 2); }

int IntInfLog2(unsigned n) { return infLog(n, 2); }

int IntSupLog10(int n) { return supLog(n, 10); }

int IntInfLog10(int n) { return infLog(n, 10); }

// A base below 2 has no logarithm: -1.
int IntSupLogk(int n, int k) { return k < 2 ? -1 : supLog(n, k); }

int IntSupLog2f(double x) {
  int r = 0;
  for (; std::isfinite(x) && x > 1; x /= 2) ++r;
  return r;
}

int IntIsPowerOf2(int n, unsigned* exponent) {
  *exponent = 0;
  if (n <= 0) return 0;
  unsigned r = 0;
  long long p = 1;
  for (; r < 32 && p < n; ++r) p *= 2;
  if (p != n) return 0;
  *exponent = r;
  return 1;
}

int IntLocateFirstBit1(int n) { return n ? __builtin_ctz(static_cast<unsigned>(n)) + 1 : 0; }

// Equal values are equal at any precision, even where the scale overflows.
int FloatEq(float a, float b, int precision) {
  float d = std::fabs(a - b);
  return d == 0.0f || d * scaleOf(precision) < 0.5f;
}

int FloatLess(float a, float b, int precision) { return !FloatEq(a, b, precision) && a < b; }

int FloatGreat(float a, float b, int precision) { return !FloatEq(a, b, precision) && a > b; }

int FloatPtrCmp(float* a, float* b, int precision) {
  return FloatEq(*a, *b, precision) ? 0 : threeWay(*a, *b);
}

// Newton's iteration from 1, stopping once a step is below 0.01. Infinite and
// not-a-number arguments are returned as they are (the iteration would not end).
double FloatSquareRoot(double x) {
  if (x == 0) return 0;
  if (x < 0) return -1.0;
  if (!std::isfinite(x)) return x;
  for (double y = 1;;) {
    double next = y / 2 + x / (2 * y);
    if (std::trunc(100 * (next - y)) == 0) return next;
    y = next;
  }
}

char* IntToHexa(int value, int width) { return dz::HeapPrintf("\"%0*x\"", width, static_cast<unsigned>(value)); }

char* IntToStr(int value) { return dz::HeapPrintf("\"%d\"", value); }

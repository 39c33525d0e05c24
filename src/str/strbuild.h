// Building heap strings in one exact allocation, from pieces or from a format.
#pragma once

#include <cstring>

#include "port/port.h"

namespace dz {

// Heap string of the pieces that produce(emit) hands to emit(text, length), in
// order. produce runs twice, once to measure and once to fill, and must emit
// the same pieces both times. Null when no piece at all was emitted (an empty
// piece counts) or when memory is out.
template <class Produce>
char* BuildString(Produce produce) {
  size_t length = 0;
  bool any = false;
  produce([&](const char*, size_t n) {
    length += n;
    any = true;
  });
  if (!any) return nullptr;
  char* text = static_cast<char*>(vzl_calloc(length + 1, 1));
  if (!text) return nullptr;
  char* w = text;
  produce([&](const char* p, size_t n) {
    memcpy(w, p, n);
    w += n;
  });
  return text;
}

// Heap string holding the printf result, sized to fit (null when memory is out).
char* HeapPrintf(const char* fmt, ...) __attribute__((format(printf, 1, 2)));

// Heap string of the n characters at p (null when memory is out).
inline char* CopyChars(const char* p, size_t n) {
  return BuildString([&](auto emit) { emit(p, n); });
}

}  // namespace dz

// Shared helpers of the list tests: integer elements in pointer cells, owned
// lists, recording callbacks and random data.
#pragma once

#include <gtest/gtest.h>

#include <cstdint>
#include <memory>
#include <random>
#include <utility>
#include <vector>

#include "duduzu/duduzu.h"

using Vals = std::vector<long>;
using Calls = std::vector<std::pair<long, long>>;

inline int* P(long v) { return reinterpret_cast<int*>(static_cast<intptr_t>(v)); }
inline long V(const int* p) { return static_cast<long>(reinterpret_cast<intptr_t>(p)); }

struct ListDeleter {
  void operator()(DomList* list) const { ListQuickDelete(&list); }
};
using Owned = std::unique_ptr<DomList, ListDeleter>;

inline Owned Make(const Vals& values, int size = 16) {
  DomList* list = ListCreateWithSize(size);
  for (long v : values) ListAddElt(list, P(v));
  return Owned(list);
}

inline Vals Of(const DomList* list) {
  Vals out;
  for (int i = 0; list && i < list->count; ++i) out.push_back(V(list->elements[i]));
  return out;
}

// The recording callbacks append (first argument, second argument) to `calls`.
inline Calls calls;
inline int* lastContext = nullptr;
template <class F>
Calls Recorded(F f) {
  calls.clear();
  f();
  return calls;
}

inline int Eq(int* x, int* v) { return V(x) == V(v); }
inline int EqRec(int* x, int* v) {
  calls.push_back({V(x), V(v)});
  return Eq(x, v);
}
inline int CtxEqRec(int* x, int* v, int* context) {
  lastContext = context;
  return EqRec(x, v);
}
// Three-way comparison of keys: value / 1000, so that elements of equal keys differ.
inline int Cmp(int* a, int* b) { return (V(a) / 1000 > V(b) / 1000) - (V(a) / 1000 < V(b) / 1000); }
inline int CmpRec(int* a, int* b) {
  calls.push_back({V(a), V(b)});
  return Cmp(a, b);
}
inline int CtxCmpRec(int* a, int* b, int* context) {
  lastContext = context;
  return CmpRec(a, b);
}

// size values key * 1000 + id: keys from 1 to range, ids firstId, firstId + 1, ...
inline Vals Keyed(std::mt19937& rng, int size, long range, long firstId = 0) {
  std::uniform_int_distribution<long> key(1, range);
  Vals out;
  for (int i = 0; i < size; ++i) out.push_back(key(rng) * 1000 + firstId + i);
  return out;
}

// Shared helpers of the list tests: integer elements in pointer cells,
// owned lists, and recording callbacks.
#pragma once

#include <gtest/gtest.h>

#include <cstdint>
#include <memory>
#include <random>
#include <utility>
#include <vector>

#include "duduzu/duduzu.h"

using Vals = std::vector<long>;
using Call = std::pair<long, long>;

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

// Every callback call, in order, as (first argument, second argument).
inline std::vector<Call> calls;
inline int* lastContext = nullptr;

inline int EqRec(int* x, int* v) {
  calls.push_back({V(x), V(v)});
  return V(x) == V(v);
}
inline int CtxEqRec(int* x, int* v, int* context) {
  lastContext = context;
  return EqRec(x, v);
}
inline int Cmp(int* a, int* b) { return (V(a) > V(b)) - (V(a) < V(b)); }
inline int CmpRec(int* a, int* b) {
  calls.push_back({V(a), V(b)});
  return Cmp(a, b);
}

inline Vals RandomVals(std::mt19937& rng, int size, long range) {
  std::uniform_int_distribution<long> pick(1, range);
  Vals out(static_cast<size_t>(size));
  for (long& v : out) v = pick(rng);
  return out;
}

// Compares keys only (value / 1000), so that elements of equal keys can be told apart.
inline int KeyCmp(int* a, int* b) { return (V(a) / 1000 > V(b) / 1000) - (V(a) / 1000 < V(b) / 1000); }
inline int KeyCmpRec(int* a, int* b) {
  calls.push_back({V(a), V(b)});
  return KeyCmp(a, b);
}
inline int CtxKeyCmpRec(int* a, int* b, int* context) {
  lastContext = context;
  return KeyCmpRec(a, b);
}

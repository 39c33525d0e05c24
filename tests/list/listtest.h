// Shared helpers of the list tests: integer elements in pointer cells, owned
// lists, recording callbacks, report checks and random data.
#pragma once

#include <gtest/gtest.h>

#include <climits>
#include <cstdint>
#include <random>

#include "duduzu/duduzu.h"
#include "support/reports.h"

using Vals = std::vector<long>;
using Calls = std::vector<std::pair<long, long>>;
using Ints = std::vector<int>;  // several results compared at once

inline int* P(long v) { return reinterpret_cast<int*>(static_cast<intptr_t>(v)); }
inline long V(const int* p) { return static_cast<long>(reinterpret_cast<intptr_t>(p)); }

struct ListDeleter { void operator()(DomList* list) const { ListQuickDelete(&list); } };
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
// The values of a new list (null: none), which is then released.
inline Vals Take(DomList* list) { return Of(Owned(list).get()); }
// The values and the capacity of a list.
using Shape = std::pair<Vals, int>;
inline Shape ShapeOf(const DomList* list) { return {Of(list), list->capacity}; }

// Exactly these reports, each of `level` and of the list unit.
inline void ExpectReports(PortTest::Capture& cap, Port_MsgLevel level, const std::vector<std::string>& texts) {
  std::string want;
  for (const std::string& text : texts) want += std::to_string(level) + ":" + text;
  EXPECT_EQ(Reports(cap, "../s/listutil"), want);
}

// The recording callbacks append (first argument, second argument) to `calls`.
inline Calls calls;
inline int* lastContext = nullptr;
template <class F>
Calls Recorded(F f) { return calls.clear(), f(), calls; }

inline int Eq(int* x, int* v) { return V(x) == V(v); }
inline int EqRec(int* x, int* v) { return calls.push_back({V(x), V(v)}), Eq(x, v); }
inline int CtxEqRec(int* x, int* v, int* context) { return lastContext = context, EqRec(x, v); }
// Three-way comparison of keys: value / 1000, so that elements of equal keys differ.
inline int Cmp(int* a, int* b) { return (V(a) / 1000 > V(b) / 1000) - (V(a) / 1000 < V(b) / 1000); }
inline int CmpRec(int* a, int* b) { return calls.push_back({V(a), V(b)}), Cmp(a, b); }
inline int CtxCmpRec(int* a, int* b, int* context) { return lastContext = context, CmpRec(a, b); }

// Up to maxSize values key * 1000 + id: keys from 1 to range, ids firstId, firstId + 1, ...
inline Vals Keyed(std::mt19937& rng, int maxSize, long range, long firstId = 0) {
  Vals out(rng() % static_cast<unsigned>(maxSize + 1));
  for (size_t i = 0; i < out.size(); ++i) out[i] = static_cast<long>(1 + rng() % range) * 1000 + firstId + static_cast<long>(i);
  return out;
}

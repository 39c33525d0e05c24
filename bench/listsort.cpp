// Sorting, unsorted set operations and sorted merges of DomLists, each beside
// the standard-library equivalent driven by the same callback pointer.
#include <benchmark/benchmark.h>

#include <algorithm>
#include <cstdint>
#include <iterator>
#include <numeric>
#include <random>
#include <vector>

#include "duduzu/duduzu.h"

namespace {

long V(int* p) { return static_cast<long>(reinterpret_cast<intptr_t>(p)); }
int* P(long v) { return reinterpret_cast<int*>(static_cast<intptr_t>(v)); }

int CompareInts(int* a, int* b) { return (V(a) > V(b)) - (V(a) < V(b)); }
int EqualInts(int* a, int* b) { return V(a) == V(b); }
int* SameElt(int* e) { return e; }

// Read through volatile so that neither side can inline the callback.
ListCompareFn volatile compareFn = CompareInts;
ListEqualFn volatile equalFn = EqualInts;

// n distinct values from [0, range), in random order.
std::vector<int*> Distinct(int n, long range, unsigned seed) {
  std::mt19937 rng(seed);
  std::vector<long> all(static_cast<size_t>(range));
  std::iota(all.begin(), all.end(), 0);
  std::shuffle(all.begin(), all.end(), rng);
  std::vector<int*> out;
  for (int i = 0; i < n; ++i) out.push_back(P(all[static_cast<size_t>(i)]));
  return out;
}

DomList* ToList(const std::vector<int*>& v) {
  DomList* list = ListCreateWithSize(static_cast<int>(v.size()));
  for (int* e : v) ListAddElt(list, e);
  return list;
}

constexpr int kSortSize = 1000000;

void BM_Sort1M_duduzu(benchmark::State& state) {
  DomList* src = ToList(Distinct(kSortSize, 4L * kSortSize, 1));
  ListCompareFn compare = compareFn;
  for (auto _ : state) {
    DomList* sorted = ListSort(src, 1, compare, SameElt);
    benchmark::DoNotOptimize(sorted->elements);
    ListQuickDelete(&sorted);
  }
  ListQuickDelete(&src);
}
BENCHMARK(BM_Sort1M_duduzu)->Unit(benchmark::kMillisecond);

void BM_Sort1M_peer(benchmark::State& state) {
  std::vector<int*> src = Distinct(kSortSize, 4L * kSortSize, 1);
  ListCompareFn compare = compareFn;
  for (auto _ : state) {
    std::vector<int*> sorted = src;
    std::stable_sort(sorted.begin(), sorted.end(),
                     [=](int* a, int* b) { return compare(a, b) < 0; });
    benchmark::DoNotOptimize(sorted.data());
  }
}
BENCHMARK(BM_Sort1M_peer)->Unit(benchmark::kMillisecond);

// Two 10,000-element lists sharing half of their values.
constexpr int kSetSize = 10000;
std::vector<int*> SetA() { return Distinct(kSetSize, 3 * kSetSize / 2, 2); }
std::vector<int*> SetB() {
  std::vector<int*> b = SetA();
  for (int i = 0; i < kSetSize / 2; ++i) b[static_cast<size_t>(i)] = P(2 * kSetSize + i);
  std::shuffle(b.begin(), b.end(), std::mt19937(3));
  return b;
}

void BM_Intersection10k_duduzu(benchmark::State& state) {
  DomList* a = ToList(SetA());
  DomList* b = ToList(SetB());
  ListEqualFn equal = equalFn;
  for (auto _ : state) {
    DomList* common = ListIntersectionNoEltCr(a, b, equal);
    benchmark::DoNotOptimize(common->count);
    ListQuickDelete(&common);
  }
  ListQuickDelete(&a);
  ListQuickDelete(&b);
}
BENCHMARK(BM_Intersection10k_duduzu)->Unit(benchmark::kMillisecond);

void BM_Intersection10k_peer(benchmark::State& state) {
  std::vector<int*> a = SetA(), b = SetB();
  ListEqualFn equal = equalFn;
  for (auto _ : state) {
    std::vector<int*> common;
    for (int* x : a)
      if (std::find_if(b.begin(), b.end(), [=](int* y) { return equal(y, x) != 0; }) != b.end())
        common.push_back(x);
    benchmark::DoNotOptimize(common.data());
  }
}
BENCHMARK(BM_Intersection10k_peer)->Unit(benchmark::kMillisecond);

// Two ascending 500,000-element lists of distinct values, overlapping by a third.
constexpr int kMergeSize = 500000;
std::vector<int*> Ascending(unsigned seed) {
  std::vector<int*> v = Distinct(kMergeSize, 3L * kMergeSize / 2, seed);
  std::sort(v.begin(), v.end(), [](int* a, int* b) { return V(a) < V(b); });
  return v;
}

void BM_Union500k_duduzu(benchmark::State& state) {
  DomList* a = ToList(Ascending(4));
  DomList* b = ToList(Ascending(5));
  ListCompareFn compare = compareFn;
  for (auto _ : state) {
    DomList* merged = ListUnionOfSortedList(a, b, compare);
    benchmark::DoNotOptimize(merged->elements);
    ListQuickDelete(&merged);
  }
  ListQuickDelete(&a);
  ListQuickDelete(&b);
}
BENCHMARK(BM_Union500k_duduzu)->Unit(benchmark::kMillisecond);

void BM_Union500k_peer(benchmark::State& state) {
  std::vector<int*> a = Ascending(4), b = Ascending(5);
  ListCompareFn compare = compareFn;
  for (auto _ : state) {
    std::vector<int*> merged;
    std::set_union(a.begin(), a.end(), b.begin(), b.end(), std::back_inserter(merged),
                   [=](int* x, int* y) { return compare(x, y) < 0; });
    benchmark::DoNotOptimize(merged.data());
  }
}
BENCHMARK(BM_Union500k_peer)->Unit(benchmark::kMillisecond);

}  // namespace

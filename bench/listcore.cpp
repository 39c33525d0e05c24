// List core and element pool against their standard peers.
#include <benchmark/benchmark.h>

#include <cstdlib>
#include <vector>

#include "duduzu/list.h"
#include "duduzu/pool.h"

static void BM_ListAddElt1M_duduzu(benchmark::State& state) {
  for (auto _ : state) {
    DomList* list = ListCreate();
    for (int i = 0; i < 1000000; ++i) ListAddElt(list, reinterpret_cast<int*>(list));
    benchmark::DoNotOptimize(list->elements);
    ListQuickDelete(&list);
  }
}
static void BM_ListAddElt1M_peer(benchmark::State& state) {
  for (auto _ : state) {
    std::vector<int*> v;
    for (int i = 0; i < 1000000; ++i) v.push_back(reinterpret_cast<int*>(&v));
    benchmark::DoNotOptimize(v.data());
  }
}
BENCHMARK(BM_ListAddElt1M_duduzu)->Unit(benchmark::kMillisecond);
BENCHMARK(BM_ListAddElt1M_peer)->Unit(benchmark::kMillisecond);

static void BM_CreateDelete_duduzu(benchmark::State& state) {
  for (auto _ : state) {
    DomList* list = ListCreate();
    benchmark::DoNotOptimize(list);
    ListQuickDelete(&list);
  }
}
static void BM_CreateDelete_peer(benchmark::State& state) {
  for (auto _ : state) {
    auto* v = new std::vector<int*>;
    v->reserve(16);
    benchmark::DoNotOptimize(v->data());
    delete v;
  }
}
BENCHMARK(BM_CreateDelete_duduzu);
BENCHMARK(BM_CreateDelete_peer);

static void BM_PoolGetRelease24_duduzu(benchmark::State& state) {
  DomPool* pool = PoolInit(8192, 1, 24);
  for (auto _ : state) {
    char* e = PoolGetNewElt(pool);
    benchmark::DoNotOptimize(e);
    PoolReleaseElt(pool, e);
  }
  PoolKill(&pool);
}
static void BM_PoolGetRelease24_peer(benchmark::State& state) {
  for (auto _ : state) {
    void* e = malloc(24);
    benchmark::DoNotOptimize(e);
    free(e);
  }
}
BENCHMARK(BM_PoolGetRelease24_duduzu);
BENCHMARK(BM_PoolGetRelease24_peer);

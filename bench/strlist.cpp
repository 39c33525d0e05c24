// Splitting a long line into tokens against a plain strtok_r loop.
#include <benchmark/benchmark.h>

#include <cstdlib>
#include <cstring>
#include <string>
#include <vector>

#include "duduzu/strlist.h"

namespace {

// About 1 MB of blank-separated words of 1 to 12 letters.
const std::string& Line() {
  static const std::string line = [] {
    std::string s;
    unsigned seed = 1;
    while (s.size() < (1u << 20)) {
      seed = seed * 1103515245u + 12345u;
      s.append(1 + (seed >> 16) % 12, static_cast<char>('a' + (seed >> 8) % 26));
      s += ' ';
    }
    return s;
  }();
  return line;
}

}  // namespace

static void BM_TokenList1MB_duduzu(benchmark::State& state) {
  for (auto _ : state) {
    DomList* list = StrToTokenList(Line().c_str(), " ");
    benchmark::DoNotOptimize(list->elements);
    ListDelete(&list, ListElemFree);
  }
}
static void BM_TokenList1MB_peer(benchmark::State& state) {
  for (auto _ : state) {
    char* work = strdup(Line().c_str());
    std::vector<char*> tokens;
    char* position = nullptr;
    for (char* t = strtok_r(work, " ", &position); t; t = strtok_r(nullptr, " ", &position))
      tokens.push_back(strdup(t));
    free(work);
    benchmark::DoNotOptimize(tokens.data());
    for (char* t : tokens) free(t);
  }
}
BENCHMARK(BM_TokenList1MB_duduzu)->Unit(benchmark::kMillisecond);
BENCHMARK(BM_TokenList1MB_peer)->Unit(benchmark::kMillisecond);

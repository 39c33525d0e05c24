// Checking a command's parameter string against its descriptors, against
// tokenising the same string into words with the standard library.
#include <benchmark/benchmark.h>

#include <sstream>
#include <string>
#include <vector>

#include "duduzu/list.h"
#include "duduzu/param.h"

namespace {

void FreeSlot(int** slot) { ParamFree(reinterpret_cast<DomParam**>(slot)); }

// 30 declarations: two positional arguments, 18 typed options, 10 flags.
std::string Descriptor() {
  std::string d = "S S";
  for (int i = 0; i < 18; ++i) d += " -opt" + std::to_string(i) + (i % 2 ? " I" : " S");
  for (int i = 0; i < 10; ++i) d += " -flag" + std::to_string(i);
  return d;
}

// Two positional words and 20 options: 12 with values, 8 flags.
std::string Parameters() {
  std::string p = "design.edf top";
  for (int i = 0; i < 12; ++i) p += " -opt" + std::to_string(i) + (i % 2 ? " 42" : " \"a b\"");
  for (int i = 0; i < 8; ++i) p += " -flag" + std::to_string(i);
  return p;
}

void BM_CheckParamList_duduzu(benchmark::State& state) {
  std::string d = Descriptor(), p = Parameters();
  char command[] = "map";
  for (auto _ : state) {
    DomList* list = nullptr;
    int ok = ParamCheckParamList(command, &p[0], &d[0], const_cast<char*>(""), &list);
    benchmark::DoNotOptimize(ok);
    ListDelete(&list, FreeSlot);
  }
}

void BM_CheckParamList_peer(benchmark::State& state) {
  std::string p = Parameters();
  for (auto _ : state) {
    std::istringstream in(p);
    std::vector<std::string> words;
    for (std::string w; in >> w;) words.push_back(w);
    benchmark::DoNotOptimize(words.data());
  }
}

BENCHMARK(BM_CheckParamList_duduzu);
BENCHMARK(BM_CheckParamList_peer);

}  // namespace

// Whole-file copy against a 64 KB fread/fwrite loop and std::filesystem::copy_file.
// The 64 MB source lives in $TMPDIR (or /tmp) and is removed at exit.
#include <benchmark/benchmark.h>
#include <unistd.h>

#include <cstdio>
#include <cstdlib>
#include <filesystem>
#include <random>
#include <string>
#include <vector>

#include "duduzu/file.h"

namespace {

// A 64 MB file of random bytes (NULs included) and a target name beside it.
struct CopyFiles {
  std::string from, to;
  CopyFiles() {
    const char* dir = getenv("TMPDIR");
    std::string base = std::string(dir && *dir ? dir : "/tmp") + "/duduzu-bench-" +
                       std::to_string(getpid());
    from = base + ".src";
    to = base + ".dst";
    std::vector<unsigned> block(1 << 14);
    std::mt19937 random(7);
    FILE* f = fopen(from.c_str(), "wb");
    for (int i = 0; i < 1024; ++i) {
      for (unsigned& w : block) w = random();
      fwrite(block.data(), sizeof(unsigned), block.size(), f);
    }
    fclose(f);
  }
  ~CopyFiles() {
    remove(from.c_str());
    remove(to.c_str());
  }
};

const CopyFiles& Files() {
  static CopyFiles files;
  return files;
}

void CopyWithDuduzu(benchmark::State& state) {
  const CopyFiles& f = Files();
  for (auto _ : state)
    benchmark::DoNotOptimize(FileCopyFileNameToFileName(const_cast<char*>(f.from.c_str()),
                                                        const_cast<char*>(f.to.c_str())));
  state.SetBytesProcessed(state.iterations() * (64 << 20));
}

}  // namespace

static void BM_Copy_duduzu(benchmark::State& state) { CopyWithDuduzu(state); }
static void BM_Copy_peer(benchmark::State& state) {
  const CopyFiles& f = Files();
  std::vector<char> buf(64 << 10);
  for (auto _ : state) {
    FILE* in = fopen(f.from.c_str(), "rb");
    FILE* out = fopen(f.to.c_str(), "wb");
    for (size_t n; (n = fread(buf.data(), 1, buf.size(), in)) > 0;) fwrite(buf.data(), 1, n, out);
    fclose(in);
    fclose(out);
  }
  state.SetBytesProcessed(state.iterations() * (64 << 20));
}
BENCHMARK(BM_Copy_duduzu)->Unit(benchmark::kMillisecond);
BENCHMARK(BM_Copy_peer)->Unit(benchmark::kMillisecond);

static void BM_CopyFs_duduzu(benchmark::State& state) { CopyWithDuduzu(state); }
static void BM_CopyFs_peer(benchmark::State& state) {
  const CopyFiles& f = Files();
  for (auto _ : state)
    benchmark::DoNotOptimize(std::filesystem::copy_file(
        f.from, f.to, std::filesystem::copy_options::overwrite_existing));
  state.SetBytesProcessed(state.iterations() * (64 << 20));
}
BENCHMARK(BM_CopyFs_duduzu)->Unit(benchmark::kMillisecond);
BENCHMARK(BM_CopyFs_peer)->Unit(benchmark::kMillisecond);

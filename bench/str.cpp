// String benchmarks: decimal to binary text against GMP, bounded append and
// copy against snprintf into the same buffer.
#include <benchmark/benchmark.h>
#include <gmp.h>

#include <cstdio>
#include <cstring>
#include <random>
#include <string>

#include "duduzu/str.h"

namespace {

std::string Decimal(int digits) {
  std::mt19937 rng(static_cast<unsigned>(digits));
  std::string s(static_cast<size_t>(digits), '0');
  for (char& c : s) c = static_cast<char>('0' + rng() % 10);
  s[0] = '7';
  return s;
}

void BM_DecimalToBin_duduzu(benchmark::State& state) {
  std::string dec = Decimal(static_cast<int>(state.range(0)));
  std::string bin(4 * dec.size() + 1, '\0');
  for (auto _ : state) {
    StrDecimalToBin(dec.c_str(), bin.data());
    benchmark::DoNotOptimize(bin.data());
  }
}

void BM_DecimalToBin_peer(benchmark::State& state) {
  std::string dec = Decimal(static_cast<int>(state.range(0)));
  std::string bin(4 * dec.size() + 2, '\0');
  mpz_t z;
  mpz_init(z);
  for (auto _ : state) {
    mpz_set_str(z, dec.c_str(), 10);
    mpz_get_str(bin.data(), 2, z);
    benchmark::DoNotOptimize(bin.data());
  }
  mpz_clear(z);
}

BENCHMARK(BM_DecimalToBin_duduzu)->Arg(100)->Arg(1000)->Arg(3000);
BENCHMARK(BM_DecimalToBin_peer)->Arg(100)->Arg(1000)->Arg(3000);

// Appending a name to a path prefix in a 1000-byte buffer, no truncation.
// The texts are runtime values so that no call is folded at compile time.
constexpr int kSize = 1000;
const std::string kHeadText = "/home/user/project/netlists/";
const std::string kTailText = "alu_core_stage3_mapped.edf";
const char* kHead = kHeadText.c_str();
const char* kTail = kTailText.c_str();

void BM_SafeCatTX_duduzu(benchmark::State& state) {
  char buf[kSize];
  size_t head = strlen(kHead);
  memcpy(buf, kHead, head + 1);
  for (auto _ : state) {
    buf[head] = '\0';
    StrSafeCatTX(buf, kTail, kSize);
    benchmark::DoNotOptimize(buf);
  }
}

void BM_SafeCatTX_peer(benchmark::State& state) {
  char buf[kSize];
  size_t head = strlen(kHead);
  memcpy(buf, kHead, head + 1);
  for (auto _ : state) {
    buf[head] = '\0';
    size_t len = strlen(buf);
    snprintf(buf + len, kSize - len, "%s", kTail);
    benchmark::DoNotOptimize(buf);
  }
}

void BM_SafeCopyTX_duduzu(benchmark::State& state) {
  char buf[kSize];
  for (auto _ : state) {
    StrSafeCopyTX(buf, kTail, kSize, 1);
    benchmark::DoNotOptimize(buf);
  }
}

void BM_SafeCopyTX_peer(benchmark::State& state) {
  char buf[kSize];
  for (auto _ : state) {
    snprintf(buf, kSize, "%s", kTail);
    benchmark::DoNotOptimize(buf);
  }
}

BENCHMARK(BM_SafeCatTX_duduzu);
BENCHMARK(BM_SafeCatTX_peer);
BENCHMARK(BM_SafeCopyTX_duduzu);
BENCHMARK(BM_SafeCopyTX_peer);

}  // namespace

// Mint text conversions and logic operations side by side with GMP.
#include <benchmark/benchmark.h>
#include <gmp.h>

#include <cstdlib>
#include <random>
#include <string>
#include <vector>

#include "duduzu/mint.h"
#include "port/port.h"

namespace {

std::vector<unsigned int> randomCells(int cells, unsigned seed) {
  std::mt19937 rng(seed);
  std::vector<unsigned int> v(static_cast<size_t>(cells));
  for (auto& c : v) c = rng();
  v.back() |= 1u;
  return v;
}

struct Peer {
  mpz_t z;
  explicit Peer(const std::vector<unsigned int>& m) {
    mpz_init(z);
    mpz_import(z, m.size(), -1, sizeof(unsigned int), 0, 0, m.data());
  }
  ~Peer() { mpz_clear(z); }
};

std::string decimalText(int cells) {
  Peer p(randomCells(cells, 1));
  char* s = mpz_get_str(nullptr, 10, p.z);
  std::string text(s);
  free(s);
  return text;
}

void BM_ToStrDecimal_duduzu(benchmark::State& state) {
  auto m = randomCells(static_cast<int>(state.range(0)), 1);
  std::string text(m.size() * 10 + 4, '\0');
  for (auto _ : state) {
    MintToStr(m.data(), static_cast<int>(m.size()), 0, 10, 0, &text[0]);
    benchmark::DoNotOptimize(text.data());
  }
}
void BM_ToStrDecimal_peer(benchmark::State& state) {
  Peer p(randomCells(static_cast<int>(state.range(0)), 1));
  std::string text(static_cast<size_t>(state.range(0)) * 10 + 4, '\0');
  for (auto _ : state) {
    mpz_get_str(&text[0], 10, p.z);
    benchmark::DoNotOptimize(text.data());
  }
}
BENCHMARK(BM_ToStrDecimal_duduzu)->Arg(4)->Arg(40);
BENCHMARK(BM_ToStrDecimal_peer)->Arg(4)->Arg(40);

void BM_ToStrHexa_duduzu(benchmark::State& state) {
  auto m = randomCells(static_cast<int>(state.range(0)), 1);
  std::string text(m.size() * 8 + 4, '\0');
  for (auto _ : state) {
    MintToStr(m.data(), static_cast<int>(m.size()), 0, 16, 0, &text[0]);
    benchmark::DoNotOptimize(text.data());
  }
}
void BM_ToStrHexa_peer(benchmark::State& state) {
  Peer p(randomCells(static_cast<int>(state.range(0)), 1));
  std::string text(static_cast<size_t>(state.range(0)) * 8 + 4, '\0');
  for (auto _ : state) {
    mpz_get_str(&text[0], 16, p.z);
    benchmark::DoNotOptimize(text.data());
  }
}
BENCHMARK(BM_ToStrHexa_duduzu)->Arg(40);
BENCHMARK(BM_ToStrHexa_peer)->Arg(40);

void BM_FromStrDecimal_duduzu(benchmark::State& state) {
  std::string text = decimalText(static_cast<int>(state.range(0)));
  for (auto _ : state) {
    unsigned int* m = nullptr;
    int cells = 0;
    MintFromStr(text.c_str(), &m, &cells, 10);
    benchmark::DoNotOptimize(m);
    vzl_free(m);
  }
}
void BM_FromStrDecimal_peer(benchmark::State& state) {
  std::string text = decimalText(static_cast<int>(state.range(0)));
  mpz_t z;
  mpz_init(z);
  for (auto _ : state) {
    mpz_set_str(z, text.c_str(), 10);
    benchmark::DoNotOptimize(z);
  }
  mpz_clear(z);
}
BENCHMARK(BM_FromStrDecimal_duduzu)->Arg(4)->Arg(40);
BENCHMARK(BM_FromStrDecimal_peer)->Arg(4)->Arg(40);

// Logic operations on 1000-cell Mints into a separate result and in place.
template <class Op>
void mintLogic(benchmark::State& state, Op op) {
  auto a = randomCells(1000, 1), b = randomCells(1000, 2), r = a;
  for (auto _ : state) {
    op(a.data(), b.data(), state.range(0) ? a.data() : r.data());
    benchmark::ClobberMemory();
  }
}
template <class Op>
void peerLogic(benchmark::State& state, Op op) {
  Peer a(randomCells(1000, 1)), b(randomCells(1000, 2)), r(randomCells(1000, 3));
  for (auto _ : state) {
    op(state.range(0) ? a.z : r.z, a.z, b.z);
    benchmark::ClobberMemory();
  }
}

void BM_And1000_duduzu(benchmark::State& state) {
  mintLogic(state, [](unsigned int* a, unsigned int* b, unsigned int* r) { MintANDNoCreate(a, b, r, 1000); });
}
void BM_And1000_peer(benchmark::State& state) { peerLogic(state, mpz_and); }
void BM_Xor1000_duduzu(benchmark::State& state) {
  mintLogic(state, [](unsigned int* a, unsigned int* b, unsigned int* r) { MintXORNoCreate(a, b, r, 1000); });
}
void BM_Xor1000_peer(benchmark::State& state) { peerLogic(state, mpz_xor); }
// Arg 0: separate result; 1: result is the first operand.
BENCHMARK(BM_And1000_duduzu)->Arg(0)->Arg(1);
BENCHMARK(BM_And1000_peer)->Arg(0)->Arg(1);
BENCHMARK(BM_Xor1000_duduzu)->Arg(0)->Arg(1);
BENCHMARK(BM_Xor1000_peer)->Arg(0)->Arg(1);

}  // namespace

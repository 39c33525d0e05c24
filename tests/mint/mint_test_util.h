// Shared helpers of the Mint tests: cell vectors, GMP values, captured output.
#pragma once

#include <gmp.h>
#include <cstdlib>
#include <random>
#include <utility>
#include <vector>

#include "duduzu/session.h"
#include "support/reports.h"
#include "support/temp_dir.h"

using Cells = std::vector<unsigned int>;
using Mints = std::vector<Cells>;  // several results compared at once

// The first `cells` cells of a created Mint, which is then released.
inline Cells take(unsigned int* m, int cells) {
  Cells v(m, m + cells);
  return vzl_free(m), v;
}

inline Cells randomCells(std::mt19937& rng, int cells) {
  Cells v(static_cast<size_t>(cells));
  for (auto& c : v) c = rng();
  return v;
}

// The value of a cell vector as a GMP integer.
struct Mpz {
  mpz_t z;
  explicit Mpz(const Cells& m) {
    mpz_init(z);
    mpz_import(z, m.size(), -1, sizeof(unsigned int), 0, 0, m.data());
  }
  ~Mpz() { mpz_clear(z); }
  std::string text(int base) const {  // upper-case digits
    char* s = mpz_get_str(nullptr, -base, z);
    std::string t(s);
    free(s);
    return t;
  }
};

// What `print` writes to a real stream, then what it writes as the main
// output: status reports of the unit, counted in `reports`.
template <class F>
std::string printed(F print, size_t* reports = nullptr) {
  FILE* s = tmpfile();
  print(s);
  std::string text = StreamText(s);
  fclose(s);
  if (!reports) return text;
  PortTest::Capture cap;
  FILE* saved = std::exchange(MainEVarOutFile, stderr);
  print(MainEVarOutFile);
  MainEVarOutFile = saved;
  for (const Port_Report& r : cap.reports()) EXPECT_EQ(std::to_string(r.level) + r.unit, "2../s/multint");
  EXPECT_EQ(cap.text(), text);
  *reports = cap.size();
  return text;
}

// What `f` returns when the next allocation fails; its reports must be exactly
// "Memory Full (Function <creator>)\n" of the unit (none for an empty creator).
template <class F>
auto failing(const std::string& creator, F f) {
  PortTest::AllocFailureGuard guard;
  PortTest::Capture cap;
  PortTest::FailNthAlloc(1);
  auto result = f();
  EXPECT_EQ(Reports(cap, "../s/multint"), creator.empty() ? "" : "4:Memory Full (Function " + creator + ")\n");
  return result;
}

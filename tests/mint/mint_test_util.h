// Shared helpers of the Mint tests: cell vectors, GMP values, captured output.
#pragma once

#include <gmp.h>
#include <gtest/gtest.h>

#include <cctype>
#include <cstdio>
#include <cstdlib>
#include <random>
#include <string>
#include <vector>

#include "duduzu/session.h"
#include "port/port_testing.h"

using Cells = std::vector<unsigned int>;
using Mints = std::vector<Cells>;  // several results compared at once

// The first `cells` cells of a created Mint, which is then released.
inline Cells take(unsigned int* m, int cells) {
  Cells v(m, m + cells);
  vzl_free(m);
  return v;
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
    char* s = mpz_get_str(nullptr, base, z);
    std::string t(s);
    free(s);
    for (char& c : t) c = static_cast<char>(toupper(c));
    return t;
  }
};

// What `print` writes to a real stream, then what it writes as the main
// output: status reports of the unit, counted in `reports`.
template <class F>
std::string printed(F print, size_t* reports = nullptr) {
  FILE* s = tmpfile();
  print(s);
  rewind(s);
  std::string text;
  for (int c; (c = fgetc(s)) != EOF;) text += static_cast<char>(c);
  fclose(s);
  if (!reports) return text;
  PortTest::Capture cap;
  FILE* saved = MainEVarOutFile;
  MainEVarOutFile = stderr;
  print(MainEVarOutFile);
  MainEVarOutFile = saved;
  for (const Port_Report& r : cap.reports()) {
    EXPECT_EQ(r.level, Port_Status);
    EXPECT_EQ(r.unit, "../s/multint");
  }
  EXPECT_EQ(cap.text(), text);
  *reports = cap.size();
  return text;
}

// Exactly one error report "Memory Full (Function <creator>)\n" of the unit.
inline void expectMemoryFull(const PortTest::Capture& cap, const std::string& creator) {
  ASSERT_EQ(cap.size(), 1u) << creator;
  EXPECT_EQ(cap[0].level, Port_Error);
  EXPECT_EQ(cap[0].module, "DuduzuRorez");
  EXPECT_EQ(cap[0].unit, "../s/multint");
  EXPECT_EQ(cap[0].text, "Memory Full (Function " + creator + ")\n");
}

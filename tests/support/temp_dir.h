// Shared test support: a fresh temporary directory per test, and whole-file
// reads and writes.
#pragma once

#include <unistd.h>

#include <cstdio>
#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <iterator>
#include <string>

// A new directory under $TMPDIR (or /tmp), removed with its content at the end.
// path ends with '/', so file names can be appended directly.
class TempDir {
 public:
  TempDir() {
    const char* base = getenv("TMPDIR");
    std::string pattern = std::string(base && *base ? base : "/tmp") + "/duduzu-XXXXXX";
    path = mkdtemp(pattern.data()) ? pattern + "/" : "";
  }
  ~TempDir() { std::filesystem::remove_all(path); }
  TempDir(const TempDir&) = delete;
  TempDir& operator=(const TempDir&) = delete;

  std::string operator/(const std::string& name) const { return path + name; }
  std::string path;
};

inline void WriteFile(const std::string& path, const std::string& bytes) {
  std::ofstream(path, std::ios::binary) << bytes;
}

inline std::string ReadFile(const std::string& path) {
  std::ifstream in(path, std::ios::binary);
  return std::string(std::istreambuf_iterator<char>(in), std::istreambuf_iterator<char>());
}

inline bool Exists(const std::string& path) { return access(path.c_str(), F_OK) == 0; }

// Everything written to the stream so far.
inline std::string StreamText(FILE* f) {
  fflush(f);
  rewind(f);
  std::string text;
  for (int c; (c = fgetc(f)) != EOF;) text += static_cast<char>(c);
  return text;
}

// Helpers of the file tests.
#pragma once

#include <filesystem>
#include <initializer_list>
#include <iterator>
#include <string>

#include "support/owned.h"
#include "support/reports.h"
#include "support/temp_dir.h"

inline std::string Reports(PortTest::Capture& cap) { return Reports(cap, "../s/fileutil"); }

// The flag word of a stream, as a failed close reports it.
inline std::string Flags(FILE* f) { return std::to_string(static_cast<int16_t>(f->_flags)); }

// Number of open descriptors of the process.
inline long OpenFdCount() { return std::distance(std::filesystem::directory_iterator("/proc/self/fd"), {}); }

// One character per file: '1' when it exists, '0' when not.
inline std::string Present(std::initializer_list<std::string> names) {
  std::string s;
  for (const std::string& name : names) s += Exists(name) ? '1' : '0';
  return s;
}

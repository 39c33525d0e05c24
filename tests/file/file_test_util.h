// Helpers of the file tests.
#pragma once

#include <filesystem>
#include <string>

#include "duduzu/str.h"

// Number of open descriptors of the process.
inline int OpenFdCount() {
  int n = 0;
  for (auto it = std::filesystem::directory_iterator("/proc/self/fd");
       it != std::filesystem::directory_iterator(); ++it)
    ++n;
  return n;
}

// The heap string's text ("<null>" for null), releasing it.
inline std::string Owned(char* s) {
  std::string r = s ? s : "<null>";
  StrFree(&s);
  return r;
}

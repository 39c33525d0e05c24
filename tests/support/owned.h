// Shared test support: taking over the heap strings the library returns.
#pragma once

#include <string>

#include "port/port.h"

// The text of s, which is then released; "<null>" for no string.
inline std::string Owned(char* s) {
  std::string r = s ? s : "<null>";
  vzl_free(s);
  return r;
}

// For the entry points that take a writable string but only read it.
inline char* C(const char* s) { return const_cast<char*>(s); }

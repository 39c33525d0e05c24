// Helpers shared by the string tests.
#pragma once

#include "duduzu/str.h"
#include "duduzu/strlist.h"
#include "support/owned.h"
#include "support/reports.h"

using Strings = std::vector<std::string>;

inline std::string Reports(PortTest::Capture& cap) { return Reports(cap, "../s/strutil"); }

// The strings of a list, which is then released with them; {"<null>"} for no list.
inline Strings Items(DomList* list) {
  if (!list) return {"<null>"};
  char** e = reinterpret_cast<char**>(list->elements);
  Strings r(e, e + list->count);
  ListDelete(&list, ListElemFree);
  return r;
}

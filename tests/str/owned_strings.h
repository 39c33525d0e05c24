// Taking over the heap strings and string lists the library returns.
#pragma once

#include <string>
#include <vector>

#include "duduzu/str.h"
#include "duduzu/strlist.h"

using Strings = std::vector<std::string>;

// The text of s, which is then freed; "<null>" for no string.
inline std::string Take(char* s) {
  std::string r = s ? s : "<null>";
  StrFree(&s);
  return r;
}

// The strings of a list, which is then released with them; {"<null>"} for no list.
inline Strings Items(DomList* list) {
  if (!list) return {"<null>"};
  char** e = reinterpret_cast<char**>(list->elements);
  Strings r(e, e + list->count);
  ListDelete(&list, ListElemFree);
  return r;
}

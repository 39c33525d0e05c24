// Drives word splitting, name composition and environment substitution with
// arbitrary text. The first byte picks the mode and the delimiters; the rest is
// cut at '\1' into the name, directory, suffix and extension pieces (a missing
// piece is null).
#include <cstddef>
#include <cstdint>
#include <cstdlib>
#include <string>

#include "duduzu/str.h"
#include "duduzu/strlist.h"
#include "duduzu/strname.h"

extern "C" int LLVMFuzzerInitialize(int*, char***) {
  setenv("A", "1", 1);
  setenv("B", "/long/value/", 1);
  setenv("A$B", "$", 1);
  return 0;
}

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size) {
  if (size == 0) return 0;
  static const char* const delims[] = {" ", " \t", "\"", ""};
  int mode = data[0] % 7 - 1;  // -1 .. 5, both ends refused
  std::string text(reinterpret_cast<const char*>(data + 1), size - 1);

  DomList* words = StrToWordList(text.c_str(), delims[data[0] >> 6]);
  char* wrapped = StrListNicePrint(words, ", ", "  ", data[0] % 40 - 5);
  StrFree(&wrapped);
  ListDelete(&words, ListElemFree);

  std::string pieces[4];
  int count = 0;
  for (char c : text) {
    if (c == '\1' && count < 3) ++count;
    else pieces[count] += c;
  }
  auto piece = [&](int i) { return i <= count ? const_cast<char*>(pieces[i].c_str()) : nullptr; };
  char* name = StrComposeName(piece(0), piece(1), piece(2), piece(3), mode);
  char* expanded = StrReplaceEnvVariable(name);
  char* direct = StrReplaceEnvVariable(const_cast<char*>(text.c_str()));
  char* base = StrComposeBaseName(expanded);
  StrFree(&name);
  StrFree(&expanded);
  StrFree(&direct);
  StrFree(&base);
  return 0;
}

// Splits arbitrary text into words with the buffer form of the quoted word
// extraction, given a buffer just large enough for any word of the text, and
// compares each word and cursor with the allocating form.
#include <cstddef>
#include <cstdint>
#include <cstring>
#include <string>
#include <vector>

#include "duduzu/param.h"
#include "duduzu/str.h"

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size) {
  std::string text(reinterpret_cast<const char*>(data), size);
  // A word, quotes kept, is at most the whole text: room for it and the terminator.
  std::vector<char> buffer(text.size() + 1);
  char* a = &text[0];
  std::string copy = text;
  char* b = &copy[0];
  for (;;) {
    char* word = buffer.data();
    int complete = ParamExtractWordFromStrQuote(&a, &word);
    char* kept = ParamExtractWordFromStrWithQuote(&b);
    if (a - text.c_str() != b - copy.c_str()) __builtin_trap();
    if (!kept) {
      if (complete || buffer[0] != '\0') __builtin_trap();
      break;
    }
    size_t n = strlen(buffer.data());
    if (n < 1000 ? strcmp(kept, buffer.data()) != 0 : strlen(kept) < 999) __builtin_trap();
    if (complete != (buffer[0] != '"' || (n > 1 && buffer[n - 1] == '"'))) __builtin_trap();
    StrFree(&kept);
    if (!complete) break;
  }
  return 0;
}

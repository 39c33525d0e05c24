// Feeds arbitrary parameter and descriptor strings to the command checks.
// The input is split at NUL bytes into the parameters, the two descriptors
// and a second parameter string compared with the parsed list, whose values
// then go through environment substitution.
#include <cstddef>
#include <cstdint>
#include <string>

#include "duduzu/list.h"
#include "duduzu/param.h"

namespace {
void FreeSlot(int** slot) { ParamFree(reinterpret_cast<DomParam**>(slot)); }
}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size) {
  std::string parts[4];
  size_t k = 0;
  for (size_t i = 0; i < size; ++i) {
    if (data[i] == 0 && k < 3)
      ++k;
    else
      parts[k] += static_cast<char>(data[i] ? data[i] : ' ');
  }
  char command[] = "cmd";
  DomList* list = nullptr;
  ParamCheckParamList(command, &parts[0][0], &parts[1][0], &parts[2][0], &list);
  ParamTopCheckParamList(list, &parts[3][0]);
  ParamTopCheckParamList(list, &parts[0][0]);
  ParamExpandEnvVar(list);
  ListDelete(&list, FreeSlot);
  return 0;
}

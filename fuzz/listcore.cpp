// Drives the list core with an arbitrary sequence of operations.
#include <cstddef>
#include <cstdint>

#include "duduzu/list.h"

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size) {
  DomList* list = ListCreateWithSize(size ? data[0] % 4 : 0);
  for (size_t i = 1; i + 1 < size; i += 2) {
    int arg = static_cast<int8_t>(data[i + 1]);
    int* e = reinterpret_cast<int*>(static_cast<intptr_t>(arg));
    switch (data[i] % 8) {
      case 0: ListAddElt(list, e); break;
      case 1: ListInsertInList(list, e, arg); break;
      case 2: ListDelShift(list, arg); break;
      case 3: ListDelInsert(list, arg); break;
      case 4: if (arg >= 0) ListSetRealloc(list, e, arg); break;
      case 5: ListCompact(list); break;
      case 6: if (list->count < 4096) ListAddNoEltCr(list, list); break;
      case 7: ListMemberOfListInt(list, arg); break;
    }
  }
  ListQuickDelete(&list);
  return 0;
}

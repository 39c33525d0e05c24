// DomList core: creation, growth, removal, search by position, copy, print.
#include <algorithm>
#include <climits>
#include <cstdint>
#include <cstring>

#include "duduzu/list.h"
#include "duduzu/pool.h"
#include "list/keptlist.h"
#include "list/listgrow.h"
#include "frame/unit.h"

namespace {

constexpr const char* kUnit = "../s/listutil";

DomPool* recordPool = nullptr;  // every DomList record, 8192 per block
KeptList* keptLists = nullptr;  // every kept list, registered at load

template <class Free>
void deleteWith(DomList** list, Free freeSlot) {
  if (!*list) return;
  for (int i = 0; i < (*list)->count; ++i) freeSlot(&(*list)->elements[i]);
  ListQuickDelete(list);
}

template <class Match>
int findWith(DomList* list, Match match) {
  if (!list) return 0;
  int** end = list->elements + list->count;
  int** at = std::find_if(list->elements, end, match);  // unrolled scan
  return at == end ? 0 : static_cast<int>(at - list->elements) + 1;
}

template <class Copy>
DomList* copyWith(DomList* src, Copy copy) {
  if (!src) return nullptr;
  DomList* list = ListCreateWithSize(src->count);
  if (!list) return nullptr;
  for (int i = 0; i < src->count; ++i) list->elements[i] = copy(src->elements[i]);
  list->count = src->count;
  return list;
}

template <class Print>
void printWith(FILE* stream, DomList* list, const char* separator, Print print) {
  if (!list || list->count == 0) return;
  print(list->elements[0]);
  for (int i = 1; i < list->count; ++i) {
    DZ_OUT(stream, "%s", separator);
    print(list->elements[i]);
  }
}

void shiftDown(DomList* list, int pos) {
  memmove(&list->elements[pos - 1], &list->elements[pos],
          sizeof(int*) * static_cast<size_t>(list->count - pos));
  --list->count;
}

void fillFromLast(DomList* list, int pos) { list->elements[pos - 1] = list->elements[--list->count]; }

// The four removals: a position below 1 does nothing, one past the end is the
// operation's Bad Index report; otherwise the slot is freed (when asked) and removed.
int removeAt(DomList* list, int pos, const char* badIndexText, ListFreeFn freeElt,
             void (*remove)(DomList*, int)) {
  if (pos < 1) return 1;
  if (!list || pos > list->count) {
    DZ_REPORT(Fatal, badIndexText);
    return 0;
  }
  if (freeElt) freeElt(&list->elements[pos - 1]);
  remove(list, pos);
  return 1;
}

}  // namespace

void ListGrowTo(DomList* list, int slots) {
  if (slots <= list->capacity) return;
  long capacity = list->capacity > 0 ? list->capacity : 1;
  while (capacity < slots) capacity *= 2;
  void* grown = capacity <= INT_MAX
                    ? vzl_realloc(list->elements, sizeof(int*) * static_cast<size_t>(capacity))
                    : nullptr;
  if (!grown) {
    DZ_REPORT(Fatal, "Data corruption (ListAddElt) - Memory Full\n");
    ExitToSession(3);
  }
  list->elements = static_cast<int**>(grown);
  list->capacity = static_cast<int>(capacity);
}

DomList* ListCreateWithSize(int size) {
  if (size < 0) {
    DZ_REPORT(Fatal, "Data corruption (ListCreateWithSize) - Negative index\n");
    return nullptr;
  }
  if (!recordPool) recordPool = PoolInit(8192, 1, sizeof(DomList));
  auto* list = recordPool ? reinterpret_cast<DomList*>(PoolGetNewElt(recordPool)) : nullptr;
  if (!list) {
    DZ_REPORT(Fatal, "Data corruption (ListCreateWithSize) - Memory Full\n");
    return nullptr;
  }
  list->capacity = size > 0 ? size : 1;
  list->count = 0;
  // Zero-filled array; malloc + memset is markedly faster than calloc for the
  // small arrays most lists start with.
  list->elements = static_cast<int**>(vzl_malloc(sizeof(int*) * static_cast<size_t>(list->capacity)));
  if (list->elements) memset(list->elements, 0, sizeof(int*) * static_cast<size_t>(list->capacity));
  if (!list->elements) {
    DZ_REPORT(Fatal, "Data corruption (ListCreateWithSize) - Memory Full\n");
    PoolReleaseElt(recordPool, reinterpret_cast<char*>(list));
    return nullptr;
  }
  return list;
}

DomList* ListCreate() { return ListCreateWithSize(16); }

void ListQuickDelete(DomList** list) {
  if (!*list) return;
  vzl_free((*list)->elements);
  PoolReleaseElt(recordPool, reinterpret_cast<char*>(*list));
  *list = nullptr;
}

void ListDelete(DomList** list, ListFreeFn freeElt) { deleteWith(list, freeElt); }

void ListContextualDelete(DomList** list, ListContextualFreeFn freeElt, int* context) {
  deleteWith(list, [=](int** slot) { freeElt(slot, context); });
}

void ListElemFree(int** slot) {
  vzl_free(*slot);
  *slot = nullptr;
}

KeptList::KeptList(ListFreeFn freeElt) : freeElt_(freeElt), next_(keptLists) { keptLists = this; }

void KeptList::releaseAll() {
  for (KeptList* kept = keptLists; kept; kept = kept->next_) {
    if (kept->freeElt_)
      ListDelete(&kept->list_, kept->freeElt_);
    else
      ListQuickDelete(&kept->list_);
  }
}

void ListKill() {
  KeptList::releaseAll();
  PoolKill(&recordPool);
}

void ListAddElt(DomList* list, int* e) {
  if (__builtin_expect(list->count == list->capacity, 0)) ListGrowTo(list, list->count + 1);
  list->elements[list->count++] = e;
}

void ListSetRealloc(DomList* list, int* e, int index) {
  if (index < 0) {
    DZ_REPORT(Fatal, "Data corruption (ListAddElt) - Negative index\n");
    return;
  }
  if (index == INT_MAX) {
    DZ_REPORT(Fatal, "Data corruption (ListAddElt) - Memory Full\n");
    ExitToSession(3);
  }
  ListGrowTo(list, index + 1);
  if (index >= list->count) {
    // Slots skipped over hold null, never stale memory.
    memset(&list->elements[list->count], 0, sizeof(int*) * static_cast<size_t>(index - list->count));
    list->count = index + 1;
  }
  list->elements[index] = e;
}

int ListInsertInList(DomList* list, int* e, int pos) {
  if (!list || pos < 1 || pos > list->count + 1) {
    DZ_REPORT(Error, "%s\n", "in ListInsertInList !!\n");
    return 0;
  }
  ListGrowTo(list, list->count + 1);
  memmove(&list->elements[pos], &list->elements[pos - 1],
          sizeof(int*) * static_cast<size_t>(list->count - pos + 1));
  list->elements[pos - 1] = e;
  ++list->count;
  return 1;
}

int ListDelShift(DomList* list, int pos) {
  return removeAt(list, pos, "Data corruption (ListDelShift) - Bad Index\n", nullptr, shiftDown);
}

int ListDelShiftFree(DomList* list, int pos, ListFreeFn freeElt) {
  return removeAt(list, pos, "Data corruption (ListDelShiftFree) - Bad Index\n", freeElt, shiftDown);
}

int ListDelInsert(DomList* list, int pos) {
  return removeAt(list, pos, "Data corruption (ListDelInsert) - Bad Index\n", nullptr, fillFromLast);
}

int ListDelInsertFree(DomList* list, int pos, ListFreeFn freeElt) {
  return removeAt(list, pos, "Data corruption (ListDelInsertFree) - Bad Index\n", freeElt,
                  fillFromLast);
}

int ListMemberOfList(DomList* list, int* v, ListEqualFn equal) {
  return findWith(list, [=](int* x) { return equal(x, v) != 0; });
}

int ListMemberOfList(DomList* list, int* v) {
  return findWith(list, [=](int* x) { return x == v; });
}

int ListMemberOfListInt(DomList* list, int v) {
  return findWith(list, [=](int* x) { return static_cast<int>(reinterpret_cast<intptr_t>(x)) == v; });
}

int ListContextualMemberOfList(DomList* list, int* v, ListContextualEqualFn equal, int* context) {
  return findWith(list, [=](int* x) { return equal(x, v, context) != 0; });
}

int ListCompact(DomList* list) {
  if (!list) return 0;
  int kept = 0;
  for (int i = 0; i < list->count; ++i)
    if (list->elements[i]) list->elements[kept++] = list->elements[i];
  list->count = kept;
  return kept;
}

DomList* ListCopy(DomList* list, ListCopyFn copy) { return copyWith(list, copy); }

DomList* ListContextualCopy(DomList* list, ListContextualCopyFn copy, int* context) {
  return copyWith(list, [=](int* e) { return copy(e, context); });
}

DomList* ListCopyNoEltCr(DomList* list) {
  return copyWith(list, [](int* e) { return e; });
}

void ListAddNoEltCr(DomList* dest, DomList* src) {
  if (!src) return;
  int n = src->count;  // src may be dest itself
  ListGrowTo(dest, dest->count + n);
  memcpy(&dest->elements[dest->count], src->elements, sizeof(int*) * static_cast<size_t>(n));
  dest->count += n;
}

void ListAppend(DomList* dest, DomList** src) {
  if (!*src) return;
  ListAddNoEltCr(dest, *src);
  ListQuickDelete(src);
}

void ListAdd(DomList* dest, DomList* src, ListCopyFn copy) {
  if (!src) return;
  int n = src->count;
  ListGrowTo(dest, dest->count + n);
  for (int i = 0; i < n; ++i) dest->elements[dest->count++] = copy(src->elements[i]);
}

void ListPrint(FILE* stream, DomList* list, ListPrintFn print, const char* separator) {
  printWith(stream, list, separator, [=](int* e) { print(stream, e); });
}

void ListContextualPrint(FILE* stream, DomList* list, ListContextualPrintFn print,
                         const char* separator, int* context) {
  printWith(stream, list, separator, [=](int* e) { print(stream, e, context); });
}

void ListDisplay(DomList* list) {
  printf("Taille %d, Elt %d, Adresse %x\n", list->capacity, list->count,
         static_cast<unsigned>(reinterpret_cast<uintptr_t>(list->elements)));
  for (int i = 0; i < list->count; ++i)
    printf("%8lx", static_cast<unsigned long>(reinterpret_cast<uintptr_t>(list->elements[i])));
  printf("\n");
}

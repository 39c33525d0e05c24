// Set operations on unsorted DomLists: identity, inclusion, duplicates, set
// algebra, sums and extremes. Every test is a linear membership scan.
//
// The shared helpers take a `member(list, v)` callable (position of the first
// element x of list with a match (x, v), or 0), so that each plain and
// Contextual pair of operations shares one body.
#include "duduzu/listset.h"
#include "frame/unit.h"

namespace {

// This unit makes no report of its own; clang warns of the unused name.
[[maybe_unused]] constexpr const char* kUnit = "../s/listutil";

int countOf(const DomList* list) { return list ? list->count : 0; }

auto memberBy(ListEqualFn equal) {
  return [=](DomList* list, int* v) { return ListMemberOfList(list, v, equal); };
}

auto memberBy(ListContextualEqualFn equal, int* context) {
  return [=](DomList* list, int* v) { return ListContextualMemberOfList(list, v, equal, context); };
}

int* sameElt(int* e) { return e; }

// Releases an empty list; null stays null.
DomList* nullIfEmpty(DomList* list) {
  if (list && list->count == 0) ListQuickDelete(&list);
  return list;
}

// Appends to `into` copy(x) for each element x of `src` that passes `keep`.
// A null `into` (creation failed) or `src` adds nothing.
template <class Keep, class Copy>
DomList* appendIf(DomList* into, DomList* src, Keep keep, Copy copy) {
  if (!into || !src) return into;
  for (int i = 0; i < src->count; ++i)
    if (keep(src->elements[i])) ListAddElt(into, copy(src->elements[i]));
  return into;
}

template <class Member>
int identicalWith(DomList* a, DomList* b, Member member) {
  int na = countOf(a), nb = countOf(b);
  if (na == 0 || nb == 0) return na == nb;
  for (int i = 0; i < na; ++i)
    if (!member(b, a->elements[i])) return 0;
  for (int i = 0; i < nb; ++i)
    if (!member(a, b->elements[i])) return 0;
  return 1;
}

// Position of the first element with a later match, pairs tried as (earlier, later).
template <class Equal>
int firstDuplicate(DomList* list, Equal equal) {
  for (int i = 0; i < countOf(list); ++i)
    for (int j = i + 1; j < list->count; ++j)
      if (equal(list->elements[i], list->elements[j])) return i + 1;
  return 0;
}

// Removes every later match of each element with remove(position).
template <class Remove>
void removeDuplicates(DomList* list, ListEqualFn equal, Remove remove) {
  for (int i = 0; i < countOf(list); ++i) {
    int j = i + 1;
    while (j < list->count) {
      if (equal(list->elements[i], list->elements[j]))
        remove(j + 1);
      else
        ++j;
    }
  }
}

template <class Member, class Copy>
DomList* intersectionWith(DomList* a, DomList* b, int capacity, Member member, Copy copy) {
  if (!a || !b) return nullptr;
  auto inB = [&](int* x) { return member(b, x) != 0; };
  return nullIfEmpty(appendIf(ListCreateWithSize(capacity), a, inB, copy));
}

// All of a (copied by copyList), then each element of b without a match in a.
template <class CopyList, class Member, class Copy>
DomList* unionWith(DomList* a, DomList* b, CopyList copyList, Member member, Copy copy) {
  DomList* result = copyList(a ? a : b);
  if (a && b) appendIf(result, b, [&](int* y) { return member(a, y) == 0; }, copy);
  return nullIfEmpty(result);
}

template <class Member>
DomList* complementWith(DomList* a, DomList* b, Member member) {
  auto notInB = [&](int* x) { return member(b, x) == 0; };
  return appendIf(ListCreateWithSize(16), a, notInB, sameElt);
}

template <class Value>
int sumWith(DomList* list, Value value) {
  unsigned sum = 0;  // wraps like 32-bit signed arithmetic, without overflow
  for (int i = 0; i < countOf(list); ++i) sum += static_cast<unsigned>(value(list->elements[i]));
  return static_cast<int>(sum);
}

}  // namespace

int ListIdentical(DomList* a, DomList* b, ListEqualFn equal) {
  return identicalWith(a, b, memberBy(equal));
}

int ListContextualIdentical(DomList* a, DomList* b, ListContextualEqualFn equal, int* context) {
  return identicalWith(a, b, memberBy(equal, context));
}

int ListIdenticalQuick(DomList* a, DomList* b, ListEqualFn equal, int allowDuplicates) {
  if (countOf(a) == 0 || countOf(b) == 0) return countOf(a) == countOf(b);
  for (int i = 0; i < a->count; ++i) {
    int* x = a->elements[i];
    bool removed = false;
    for (int j = 0; j < b->count;) {
      if (!equal(b->elements[j], x)) {
        ++j;
        continue;
      }
      ListDelShift(b, j + 1);
      removed = true;
      if (!allowDuplicates) break;
    }
    if (!removed) return 0;
    if (!allowDuplicates) continue;
    for (int k = i + 1; k < a->count;) {
      if (equal(a->elements[k], x))
        ListDelShift(a, k + 1);
      else
        ++k;
    }
  }
  return b->count == 0;
}

int ListIncludeInList(DomList* a, DomList* b, ListEqualFn equal) {
  for (int i = 0; i < countOf(b); ++i)
    if (!ListMemberOfList(a, b->elements[i], equal)) return 0;
  return 1;
}

int ListCheckNoDuplication(DomList* list, ListEqualFn equal) {
  return firstDuplicate(list, equal) == 0;
}

int ListContextualCheckNoDuplication(DomList* list, ListContextualEqualFn equal, int* context) {
  return firstDuplicate(list, [=](int* x, int* y) { return equal(x, y, context); }) == 0;
}

int ListSortedCheckNoDuplication(DomList* list, ListEqualFn equal) {
  for (int i = 0; i + 1 < countOf(list); ++i)
    if (equal(list->elements[i + 1], list->elements[i])) return 0;
  return 1;
}

int ListSearchDuplication(DomList* list, ListEqualFn equal) { return firstDuplicate(list, equal); }

void ListRemoveDuplicElem(DomList* list, ListEqualFn equal) {
  removeDuplicates(list, equal, [=](int pos) { ListDelShift(list, pos); });
}

void ListRemoveFreeDuplicElem(DomList* list, ListEqualFn equal, ListFreeFn freeElt) {
  removeDuplicates(list, equal, [=](int pos) { ListDelShiftFree(list, pos, freeElt); });
}

void ListAddEltNoDupl(DomList* list, int* e, ListEqualFn equal) {
  if (!ListMemberOfList(list, e, equal)) ListAddElt(list, e);
}

int ListRemoveElt(DomList* list, int* e, ListEqualFn equal) {
  int pos = ListMemberOfList(list, e, equal);
  ListDelShift(list, pos);  // a position of 0 changes nothing
  return pos;
}

DomList* ListIntersectionNoEltCr(DomList* a, DomList* b, ListEqualFn equal) {
  return intersectionWith(a, b, 16, memberBy(equal), sameElt);
}

DomList* ListContextualIntersectionNoEltCr(DomList* a, DomList* b, ListContextualEqualFn equal,
                                           int* context) {
  return intersectionWith(a, b, 16, memberBy(equal, context), sameElt);
}

DomList* ListContextualIntersectionWithEltCr(DomList* a, DomList* b, ListContextualEqualFn equal,
                                             ListContextualCopyFn copy, int* context) {
  return intersectionWith(a, b, 2, memberBy(equal, context),
                          [=](int* x) { return copy(x, context); });
}

DomList* ListUnionNoEltCr(DomList* a, DomList* b, ListEqualFn equal) {
  return unionWith(a, b, ListCopyNoEltCr, memberBy(equal), sameElt);
}

DomList* ListContextualUnionNoEltCr(DomList* a, DomList* b, ListContextualEqualFn equal,
                                    int* context) {
  return unionWith(a, b, ListCopyNoEltCr, memberBy(equal, context), sameElt);
}

DomList* ListUnion(DomList* a, DomList* b, ListEqualFn equal, ListCopyFn copy) {
  return unionWith(a, b, [=](DomList* l) { return ListCopy(l, copy); }, memberBy(equal), copy);
}

void ListUnionNoEltCrNoLCr(DomList** a, DomList* b, ListEqualFn equal) {
  if (!*a) {
    *a = ListCopyNoEltCr(b);
    return;
  }
  int n = countOf(b);  // b may be *a itself
  for (int i = 0; i < n; ++i) ListAddEltNoDupl(*a, b->elements[i], equal);
}

DomList* ListComplement(DomList* a, DomList* b, ListEqualFn equal) {
  if (countOf(b) == 0) return ListCopyNoEltCr(a);
  return complementWith(a, b, memberBy(equal));
}

DomList* ListContextualComplement(DomList* a, DomList* b, ListContextualEqualFn equal,
                                  int* context) {
  return complementWith(a, b, memberBy(equal, context));
}

DomList* ListInverseNoEltCr(DomList* list) {
  if (countOf(list) == 0) return nullptr;
  DomList* result = ListCreateWithSize(16);
  for (int i = list->count - 1; result && i >= 0; --i) ListAddElt(result, list->elements[i]);
  return result;
}

int ListEltSum(DomList* list, ListEltValueFn value) { return sumWith(list, value); }

int ListContextualEltSum(DomList* list, ListContextualEltValueFn value, int* context) {
  return sumWith(list, [=](int* e) { return value(e, context); });
}

int* ListMaxMinElt(DomList* list, int mode, ListCompareFn compare) {
  if (countOf(list) == 0) return nullptr;
  int* best = list->elements[0];
  if (mode != 0 && mode != 1) return best;
  for (int i = 1; i < list->count; ++i) {
    int r = compare(list->elements[i], best);
    if (mode == 0 ? r > 0 : r < 0) best = list->elements[i];
  }
  return best;
}

int ListMemberOfDoubleList(DomList* list, int* key, ListEqualFn equal) {
  for (int i = 0; i < countOf(list); i += 2)
    if (equal(list->elements[i], key)) return i + 1;
  return 0;
}

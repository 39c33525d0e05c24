// Sorted DomLists: merge sort, ordered insertion, binary search and the linear
// merges of two ascending lists. Callers may watch the comparison callback, so
// each algorithm makes exactly its documented sequence of calls, repeated
// comparisons of the same pair included.
#include <cstring>
#include <utility>

#include "duduzu/listsort.h"
#include "frame/unit.h"

namespace {

// This unit makes no report of its own; clang warns of the unused name.
[[maybe_unused]] constexpr const char* kUnit = "../s/listutil";

int countOf(const DomList* list) { return list ? list->count : 0; }

void moveSlots(int** to, int** from, int n) { memmove(to, from, sizeof(int*) * static_cast<size_t>(n)); }

// True when a pair whose comparison gave r is out of the requested order.
bool outOfOrder(int r, bool ascending) { return ascending ? r > 0 : r < 0; }

// True when an element comparing r against the sought one lies on or after it
// in the search's sense: the half [lo, mid] still holds the answer.
bool searchLeft(int r, bool ascending) { return ascending ? r > 0 : r <= 0; }

// Merges the sorted runs [i, mid] and [mid + 1, hi]; after(x, y) tells that x
// must follow y, and equal elements keep the left one first.
template <class After>
void mergeRuns(int** e, int i, int mid, int hi, After& after) {
  int n = mid + 1 - i;
  DomList* left = ListCreateWithSize(n);
  if (!left) {
    // No memory for the copy of the left run: rotate each element taken from
    // the right run into place. Same comparisons, quadratic moves.
    for (int p = i, q = mid + 1; p < q && q <= hi; ++p) {
      if (!after(e[p], e[q])) continue;
      int* x = e[q];
      moveSlots(e + p + 1, e + p, q - p);
      e[p] = x;
      ++q;
    }
    return;
  }
  moveSlots(left->elements, e + i, n);
  left->count = n;
  int **l = left->elements, **lEnd = l + n, **r = e + mid + 1, **rEnd = e + hi + 1, **out = e + i;
  while (l < lEnd && r < rEnd) {
    // Branch-free choice, as the outcome is unpredictable on unordered input.
    int* choice[2] = {*l, *r};
    bool takeRight = after(*l, *r);
    *out++ = choice[takeRight];
    r += takeRight;
    l += !takeRight;
  }
  // The rest of the left run fills the gap; the rest of the right run is in place.
  moveSlots(out, l, static_cast<int>(lEnd - l));
  ListQuickDelete(&left);
}

// Sorts slots [lo, hi] (at least two) with compare(x, y), the raw three-way
// callback; sortThree(slots, after) handles ranges of exactly three.
template <class Compare, class SortThree>
void sortRange(int** e, int lo, int hi, bool ascending, Compare& compare, SortThree& sortThree) {
  auto after = [&](int* x, int* y) { return outOfOrder(compare(x, y), ascending); };
  if (hi == lo + 1) {
    if (after(e[lo], e[hi])) std::swap(e[lo], e[hi]);
    return;
  }
  if (hi == lo + 2) {
    sortThree(e + lo, after);
    return;
  }
  int mid = lo + (hi - lo) / 2;
  sortRange(e, lo, mid, ascending, compare, sortThree);
  sortRange(e, mid + 1, hi, ascending, compare, sortThree);
  int i = lo;  // the prefix of the left run already in place stays untouched
  while (i <= mid && !after(e[i], e[mid + 1])) ++i;
  if (i <= mid) mergeRuns(e, i, mid, hi, after);
}

template <class Compare, class SortThree>
void sortList(DomList* list, int ascending, Compare compare, SortThree sortThree) {
  if (countOf(list) < 2) return;
  sortRange(list->elements, 0, list->count - 1, ascending != 0, compare, sortThree);
}

// Decision tree of ListSelfSort for three elements (not stable): the
// ascending order, reversed for descending.
void sortThreeByTree(int** s, bool ascending, ListCompareFn compare) {
  int *a = s[0], *b = s[1], *c = s[2];
  int* order[3];
  auto set = [&](int* x, int* y, int* z) {
    order[0] = x, order[1] = y, order[2] = z;
  };
  if (compare(a, b) > 0) {
    if (compare(a, c) <= 0)
      set(b, a, c);
    else if (compare(b, c) >= 0)
      set(c, b, a);
    else
      set(b, c, a);
  } else if (compare(a, c) >= 0) {
    set(c, a, b);
  } else if (compare(b, c) >= 0) {
    set(a, c, b);
  } else {
    set(a, b, c);
  }
  for (int k = 0; k < 3; ++k) s[k] = order[ascending ? k : 2 - k];
}

// Stable insertion of ListContextualSelfSort for three elements.
template <class After>
void sortThreeByInsertion(int** s, After& after) {
  if (after(s[0], s[1])) std::swap(s[0], s[1]);
  if (!after(s[1], s[2])) return;
  if (after(s[0], s[2])) {
    int* third = s[2];
    s[2] = s[1];
    s[1] = s[0];
    s[0] = third;
  } else {
    std::swap(s[1], s[2]);
  }
}

template <class Compare>
int searchWith(DomList* list, int* e, bool ascending, Compare compare) {
  if (countOf(list) == 0) return 0;
  int lo = 0, hi = list->count - 1;
  while (lo < hi) {
    int mid = lo + (hi - lo) / 2;
    if (compare(list->elements[mid], e) == 0) return mid + 1;
    if (searchLeft(compare(list->elements[mid], e), ascending))
      hi = mid;
    else
      lo = mid + 1;
  }
  return compare(list->elements[lo], e) == 0 ? lo + 1 : 0;
}

template <class Compare>
int insertWith(DomList* list, int* e, bool ascending, Compare compare) {
  int at = 0;
  if (list->count > 0) {
    int lo = 0, hi = list->count - 1;
    while (lo < hi) {
      int mid = lo + (hi - lo) / 2;
      if (searchLeft(compare(list->elements[mid], e), ascending))
        hi = mid;
      else
        lo = mid + 1;
    }
    int r = compare(list->elements[lo], e);
    at = (ascending ? r < 0 : r > 0) ? lo + 1 : lo;
  }
  ListAddElt(list, e);
  moveSlots(list->elements + at + 1, list->elements + at, list->count - 1 - at);
  list->elements[at] = e;
  return at + 1;
}

// A new list (capacity 16) of every element of src; null for a null or empty src.
DomList* allOf(DomList* src) {
  if (countOf(src) == 0) return nullptr;
  DomList* result = ListCreateWithSize(16);
  if (result) ListAddNoEltCr(result, src);
  return result;
}

// Walks two ascending lists: an element of b smaller than that of a is
// skipped; otherwise a second comparison tells an element of a alone
// (onlyA(x)) from an equal pair (both(x), x from a). Stops when either list
// ends and returns the index reached in a.
template <class OnlyA, class Both>
int walkSorted(DomList* a, DomList* b, ListCompareFn compare, OnlyA onlyA, Both both) {
  int i = 0, j = 0;
  while (i < a->count && j < b->count) {
    int* x = a->elements[i];
    if (compare(x, b->elements[j]) > 0) {
      ++j;
    } else if (compare(x, b->elements[j]) < 0) {
      onlyA(x);
      ++i;
    } else {
      both(x);
      ++i, ++j;
    }
  }
  return i;
}

void appendFrom(DomList* dest, DomList* src, int from) {
  for (int i = from; i < src->count; ++i) ListAddElt(dest, src->elements[i]);
}

}  // namespace

void ListSelfSort(DomList* list, int ascending, ListCompareFn compare) {
  sortList(list, ascending, compare,
           [=](int** s, auto&) { sortThreeByTree(s, ascending != 0, compare); });
}

void ListContextualSelfSort(DomList* list, int ascending, ListContextualCompareFn compare,
                            int* context) {
  sortList(list, ascending, [=](int* x, int* y) { return compare(x, y, context); },
           [](int** s, auto& after) { sortThreeByInsertion(s, after); });
}

DomList* ListSort(DomList* list, int ascending, ListCompareFn compare, ListCopyFn copy) {
  DomList* sorted = ListCopy(list, copy);
  ListSelfSort(sorted, ascending, compare);
  return sorted;
}

int ListInsertInSortedList(DomList* list, int* e, ListCompareFn compare, int ascending) {
  return insertWith(list, e, ascending != 0, compare);
}

int ListContextualInsertInSortedList(DomList* list, int* e, ListContextualCompareFn compare,
                                     int ascending, int* context) {
  return insertWith(list, e, ascending != 0,
                    [=](int* x, int* y) { return compare(x, y, context); });
}

void ListAddEltInSLNoDupl(DomList* list, int* e, ListCompareFn compare, int ascending) {
  if (!ListMemberOfSortedList(list, e, compare, ascending))
    ListInsertInSortedList(list, e, compare, ascending);
}

int ListMemberOfSortedList(DomList* list, int* e, ListCompareFn compare, int ascending) {
  return searchWith(list, e, ascending != 0, compare);
}

int ListContextualMemberOfSortedList(DomList* list, int* e, ListContextualCompareFn compare,
                                     int ascending, int* context) {
  return searchWith(list, e, ascending != 0,
                    [=](int* x, int* y) { return compare(x, y, context); });
}

int ListCheckIfSortedList(DomList* list, ListCompareFn compare, int ascending) {
  for (int i = 0; i + 1 < countOf(list); ++i) {
    if (outOfOrder(compare(list->elements[i], list->elements[i + 1]), ascending != 0)) return 0;
  }
  return 1;
}

int ListIdenticalSortedList(DomList* a, DomList* b, ListEqualFn equal) {
  if (countOf(a) != countOf(b)) return 0;
  for (int i = 0; i < countOf(a); ++i)
    if (!equal(a->elements[i], b->elements[i])) return 0;
  return 1;
}

DomList* ListIntersectionOfSortedList(DomList* a, DomList* b, ListCompareFn compare) {
  if (!a || !b) return nullptr;
  DomList* result = ListCreateWithSize(16);
  if (result)
    walkSorted(a, b, compare, [](int*) {}, [=](int* x) { ListAddElt(result, x); });
  return result;
}

DomList* ListComplementOfSortedList(DomList* a, DomList* b, ListCompareFn compare) {
  if (!b) return allOf(a);
  if (!a) return nullptr;
  DomList* result = ListCreateWithSize(16);
  if (!result) return nullptr;
  int i = walkSorted(a, b, compare, [=](int* x) { ListAddElt(result, x); }, [](int*) {});
  appendFrom(result, a, i);
  return result;
}

DomList* ListUnionOfSortedList(DomList* a, DomList* b, ListCompareFn compare) {
  if (!a || !b) return allOf(a ? a : b);
  DomList* result = ListCreateWithSize(16);
  if (!result) return nullptr;
  int i = 0, j = 0;
  while (i < a->count && j < b->count) {
    int* x = a->elements[i];
    int* y = b->elements[j];
    if (compare(x, y) < 0) {
      ListAddElt(result, x);
      ++i;
    } else if (compare(x, y) > 0) {
      ListAddElt(result, y);
      ++j;
    } else {
      ListAddElt(result, x);
      ++i, ++j;
    }
  }
  appendFrom(result, a, i);
  appendFrom(result, b, j);
  return result;
}

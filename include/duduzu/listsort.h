// Sorted DomLists: sorting, ordered insertion, binary search and linear merges.
// `ascending` non-zero keeps each element <= its successor, 0 keeps it >=.
// The comparison callback may be called more than once on the same pair.
#pragma once

#include "duduzu/list.h"

// Merge sort in place (not stable: three equal-keyed elements may swap).
DUDUZU_API void ListSelfSort(DomList* list, int ascending, ListCompareFn compare);
// The same, and stable.
DUDUZU_API void ListContextualSelfSort(DomList* list, int ascending,
                                       ListContextualCompareFn compare, int* context);
// A sorted copy; null for a null list.
DUDUZU_API DomList* ListSort(DomList* list, int ascending, ListCompareFn compare,
                             ListCopyFn copy);

// Inserts e in order and returns its position.
DUDUZU_API int ListInsertInSortedList(DomList* list, int* e, ListCompareFn compare, int ascending);
DUDUZU_API int ListContextualInsertInSortedList(DomList* list, int* e,
                                                ListContextualCompareFn compare, int ascending,
                                                int* context);
// Inserts e in order unless an equal element is already there.
DUDUZU_API void ListAddEltInSLNoDupl(DomList* list, int* e, ListCompareFn compare, int ascending);
// Binary search: the position of an element equal to e, or 0.
DUDUZU_API int ListMemberOfSortedList(DomList* list, int* e, ListCompareFn compare, int ascending);
DUDUZU_API int ListContextualMemberOfSortedList(DomList* list, int* e,
                                                ListContextualCompareFn compare, int ascending,
                                                int* context);
DUDUZU_API int ListCheckIfSortedList(DomList* list, ListCompareFn compare, int ascending);
// Same count and equal element by element.
DUDUZU_API int ListIdenticalSortedList(DomList* a, DomList* b, ListEqualFn equal);

// Merges of two ascending lists, sharing their elements (multiset semantics).
DUDUZU_API DomList* ListIntersectionOfSortedList(DomList* a, DomList* b, ListCompareFn compare);
DUDUZU_API DomList* ListComplementOfSortedList(DomList* a, DomList* b, ListCompareFn compare);
DUDUZU_API DomList* ListUnionOfSortedList(DomList* a, DomList* b, ListCompareFn compare);

// Set operations on unsorted DomLists under an equality callback. A list
// element is always passed first to the callback. Returned lists are new and
// belong to the caller; NoEltCr results share the elements of their inputs.
#pragma once

#include "duduzu/list.h"

typedef int (*ListEltValueFn)(int* e);
typedef int (*ListContextualEltValueFn)(int* e, int* context);

// Identity and inclusion (1 or 0). Multiplicity does not count; two empty
// (or null) lists are identical, an empty and a non-empty one are not.
DUDUZU_API int ListIdentical(DomList* a, DomList* b, ListEqualFn equal);
DUDUZU_API int ListContextualIdentical(DomList* a, DomList* b, ListContextualEqualFn equal,
                                       int* context);
// Consumes b: each element of a removes its first match from b (every match,
// and its own later repeats from a, when allowDuplicates is non-zero).
DUDUZU_API int ListIdenticalQuick(DomList* a, DomList* b, ListEqualFn equal, int allowDuplicates);
// 1 when every element of b has a match in a.
DUDUZU_API int ListIncludeInList(DomList* a, DomList* b, ListEqualFn equal);

// Duplicates.
DUDUZU_API int ListCheckNoDuplication(DomList* list, ListEqualFn equal);
DUDUZU_API int ListContextualCheckNoDuplication(DomList* list, ListContextualEqualFn equal,
                                                int* context);
// Neighbours only: the answer of ListCheckNoDuplication for a sorted list.
DUDUZU_API int ListSortedCheckNoDuplication(DomList* list, ListEqualFn equal);
// Position of the first element that has a later match, or 0.
DUDUZU_API int ListSearchDuplication(DomList* list, ListEqualFn equal);
// Keep the first occurrence of each element, in order.
DUDUZU_API void ListRemoveDuplicElem(DomList* list, ListEqualFn equal);
DUDUZU_API void ListRemoveFreeDuplicElem(DomList* list, ListEqualFn equal, ListFreeFn freeElt);
DUDUZU_API void ListAddEltNoDupl(DomList* list, int* e, ListEqualFn equal);
// Removes the first match of e; its former position, or 0.
DUDUZU_API int ListRemoveElt(DomList* list, int* e, ListEqualFn equal);

// Set algebra, in the order of the source. Intersections and unions return
// null instead of an empty list; complements return an empty list.
DUDUZU_API DomList* ListIntersectionNoEltCr(DomList* a, DomList* b, ListEqualFn equal);
DUDUZU_API DomList* ListContextualIntersectionNoEltCr(DomList* a, DomList* b,
                                                      ListContextualEqualFn equal, int* context);
DUDUZU_API DomList* ListContextualIntersectionWithEltCr(DomList* a, DomList* b,
                                                        ListContextualEqualFn equal,
                                                        ListContextualCopyFn copy, int* context);
DUDUZU_API DomList* ListUnionNoEltCr(DomList* a, DomList* b, ListEqualFn equal);
DUDUZU_API DomList* ListContextualUnionNoEltCr(DomList* a, DomList* b, ListContextualEqualFn equal,
                                               int* context);
DUDUZU_API DomList* ListUnion(DomList* a, DomList* b, ListEqualFn equal, ListCopyFn copy);
// Appends to *a each element of b without a match in the growing *a.
DUDUZU_API void ListUnionNoEltCrNoLCr(DomList** a, DomList* b, ListEqualFn equal);
DUDUZU_API DomList* ListComplement(DomList* a, DomList* b, ListEqualFn equal);
DUDUZU_API DomList* ListContextualComplement(DomList* a, DomList* b, ListContextualEqualFn equal,
                                             int* context);
// The elements from last to first; null for a null or empty list.
DUDUZU_API DomList* ListInverseNoEltCr(DomList* list);

// Sums (32-bit wrap-around) and extremes.
DUDUZU_API int ListEltSum(DomList* list, ListEltValueFn value);
DUDUZU_API int ListContextualEltSum(DomList* list, ListContextualEltValueFn value, int* context);
// mode 0: the first maximum, 1: the first minimum, otherwise the first element.
DUDUZU_API int* ListMaxMinElt(DomList* list, int mode, ListCompareFn compare);
// Keys at positions 1, 3, 5, ... of a list of (key, value) pairs.
DUDUZU_API int ListMemberOfDoubleList(DomList* list, int* key, ListEqualFn equal);

// DomList: growable array of word-sized elements, positions counted from 1.
#pragma once

#include <cstdio>

#include "duduzu/export.h"

class DomList {
 public:
  int capacity;     // slots allocated, at least 1
  int count;        // slots in use
  int** elements;   // slots 0 .. count - 1
};

// Element callbacks; the Contextual forms pass a context pointer through.
typedef void (*ListFreeFn)(int** slot);
typedef void (*ListContextualFreeFn)(int** slot, int* context);
typedef int (*ListEqualFn)(int* listElt, int* value);
typedef int (*ListContextualEqualFn)(int* listElt, int* value, int* context);
typedef int* (*ListCopyFn)(int* e);
typedef int* (*ListContextualCopyFn)(int* e, int* context);
typedef void (*ListPrintFn)(FILE* stream, int* e);
typedef void (*ListContextualPrintFn)(FILE* stream, int* e, int* context);
// Three-way comparison: negative when a sorts before b, 0 when equal, positive after.
typedef int (*ListCompareFn)(int* a, int* b);
typedef int (*ListContextualCompareFn)(int* a, int* b, int* context);

// Creation and destruction.
DUDUZU_API DomList* ListCreateWithSize(int size);
DUDUZU_API DomList* ListCreate();
DUDUZU_API void ListQuickDelete(DomList** list);
DUDUZU_API void ListDelete(DomList** list, ListFreeFn freeElt);
DUDUZU_API void ListContextualDelete(DomList** list, ListContextualFreeFn freeElt, int* context);
DUDUZU_API void ListElemFree(int** slot);
// Destroys the record pool: every list record still in existence becomes invalid
// at once (their element arrays are not freed). The library's own lists (open
// files, clean-up names, parameter defaults, redirection stacks) are released
// first, so ParamDefFree or FileRemoveAllFilesInTmp may still follow; tracked
// handles left open then stay open and registered names are forgotten.
DUDUZU_API void ListKill();

// Adding.
DUDUZU_API void ListAddElt(DomList* list, int* e);
DUDUZU_API void ListSetRealloc(DomList* list, int* e, int index);
DUDUZU_API int ListInsertInList(DomList* list, int* e, int pos);

// Removing by position: 1 on success (or pos < 1), 0 after a Bad Index report.
DUDUZU_API int ListDelShift(DomList* list, int pos);
DUDUZU_API int ListDelShiftFree(DomList* list, int pos, ListFreeFn freeElt);
DUDUZU_API int ListDelInsert(DomList* list, int pos);
DUDUZU_API int ListDelInsertFree(DomList* list, int pos, ListFreeFn freeElt);

// Finding: position of the first match, 0 when absent.
DUDUZU_API int ListMemberOfList(DomList* list, int* v, ListEqualFn equal);
DUDUZU_API int ListMemberOfList(DomList* list, int* v);
DUDUZU_API int ListMemberOfListInt(DomList* list, int v);
DUDUZU_API int ListContextualMemberOfList(DomList* list, int* v, ListContextualEqualFn equal,
                                          int* context);

// Maintenance.
DUDUZU_API int ListCompact(DomList* list);

// Copying and joining.
DUDUZU_API DomList* ListCopy(DomList* list, ListCopyFn copy);
DUDUZU_API DomList* ListContextualCopy(DomList* list, ListContextualCopyFn copy, int* context);
DUDUZU_API DomList* ListCopyNoEltCr(DomList* list);
DUDUZU_API void ListAppend(DomList* dest, DomList** src);
DUDUZU_API void ListAdd(DomList* dest, DomList* src, ListCopyFn copy);
DUDUZU_API void ListAddNoEltCr(DomList* dest, DomList* src);

// Printing.
DUDUZU_API void ListPrint(FILE* stream, DomList* list, ListPrintFn print, const char* separator);
DUDUZU_API void ListContextualPrint(FILE* stream, DomList* list, ListContextualPrintFn print,
                                    const char* separator, int* context);
DUDUZU_API void ListDisplay(DomList* list);

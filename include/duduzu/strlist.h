// String lists and indexed names.
//
// A string list is a DomList of heap strings. Every list these routines create,
// and every string they put into a list, belongs to the caller; release a list
// with ListDelete(&list, ListElemFree). Input strings are copied, never kept.
// The routines that allocate answer null (0 for StrInsertInList) when memory
// runs out, having released whatever they had built.
#pragma once

#include <cstdio>

#include "duduzu/export.h"
#include "duduzu/list.h"

// The fields of s between occurrences of sep (a NUL sep never matches). Empty
// fields count, but an empty last field is never added, so a trailing sep adds
// nothing; fields equal to skip ignoring case are left out when skip is not null.
DUDUZU_API DomList* StrStringToList(const char* s, char sep, const char* skip);
// The tokens of s separated by runs of characters of delims (never empty ones);
// null if s or delims is null. A caller's own strtok scan is not disturbed.
DUDUZU_API DomList* StrToTokenList(const char* s, const char* delims);
// As StrToTokenList, but a group of tokens in double quotes becomes one word
// (quotes kept, the tokens joined by one blank); a group left open at the end
// of s is dropped.
DUDUZU_API DomList* StrToWordList(const char* s, const char* delims);

// Position (from 1) of the last element equal to s, case included; 0 if none.
DUDUZU_API int StrStringInList(DomList* list, char* s);
// Appends a heap copy of s and returns its position (the new element count).
DUDUZU_API int StrInsertInList(DomList* list, char* s);

// Prints the elements separated by sep (main-output rule for MainEVarOutFile).
DUDUZU_API void StrListPrint(FILE* f, DomList* list, const char* sep);
// New heap string of the elements joined by sep, wrapped at width with every
// line starting with indent; ends in "..." where the text would pass 1020
// characters. A negative width never wraps.
DUDUZU_API char* StrListNicePrint(DomList* list, const char* sep, const char* indent, int width);

// Indexed names: base followed by the index ("bit12"), or the index alone when
// base is null. A negative index is refused with a fatal report (null result,
// *p unchanged).
DUDUZU_API char* StrAppendIndexToStr(const char* base, int i);
DUDUZU_API char* StrAppendIndexToStr(const char* base, long i);
DUDUZU_API void StrCatIndexToStrPX(char** p, long i);
// Lists of indexed names for from .. to ascending; a descending or negative
// range is refused with a fatal report and null. The bus form gives "d<3>",
// except that the range 0 .. 0 gives a plain copy of base.
DUDUZU_API DomList* StrCreateListIndexedStr(const char* base, int from, int to);
DUDUZU_API DomList* StrCreateListHDLIndexStr(const char* base, int from, int to);

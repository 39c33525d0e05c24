// Parameters: name/value records, parameter lists, command-string parsing and
// checking, and the process-wide table of parameter defaults.
//
// A parameter list is a DomList of DomParam pointers that owns its records.
// Names and values are compared ignoring case. Values returned by lookups are
// fresh heap strings owned by the caller (release with vzl_free or StrFree).
#pragma once

#include "duduzu/export.h"
#include "duduzu/list.h"

// The name comes first, so a record pointer is also its name as a C string.
class DomParam {
 public:
  char CharParamQual[255];  // name: at most 254 characters
  char CharParam[1020];     // value: at most 1019 characters, empty when none
};

// Records. A name or value that does not fit its field is refused with an
// error report: ParamCreateParam then returns null and the changing operations
// leave the list as it was.
DUDUZU_API DomParam* ParamCreateParam(const char* name, const char* value);
DUDUZU_API DomParam* ParamCopy(DomParam* param);
DUDUZU_API void ParamFree(DomParam** param);
DUDUZU_API int ParamIdenticalName(DomParam* param, const char* name);

// Lookup and tests.
DUDUZU_API char* ParamFindNamedParam(DomList* list, const char* name);
// 0 for a null list, 2 when absent, 1 when the value matches, else 0.
DUDUZU_API int ParamFindParamValue(DomList* list, const char* name, const char* value);
// Every record's name is among the `count` names that follow.
DUDUZU_API int ParamCheckInList(DomList* list, int count, ...);
// Every one of the `count` names that follow is matched by a record of its own.
DUDUZU_API int ParamCheckAtLeastInList(DomList* list, int count, ...);
// Position of the value among the `count` allowed values that follow, 1 when
// absent (the allowed default is then added), 0 after an error report.
DUDUZU_API int ParamCheckParamValue(DomList* list, const char* name, const char* defaultValue,
                                    int count, ...);
DUDUZU_API int ParamCheckParamYesNo(DomList* list, const char* name, int defaultValue);

// Changing lists. The Move operations append the new record at the end;
// ParamChangeParamValue replaces in place (or appends when the name is new).
DUDUZU_API void ParamRemoveExistingParam(DomList* list, const char* name);
DUDUZU_API void ParamRemoveExistingParamIfValue(DomList* list, char* name, char* value);
DUDUZU_API void ParamChangeParamValue(DomList* list, const char* name, const char* value);
// Substitutes $NAME environment references in every value; returns the
// number of records changed.
DUDUZU_API int ParamExpandEnvVar(DomList* list);
DUDUZU_API void ParamMoveParamName(DomList* list, const char* oldName, const char* newName);
DUDUZU_API void ParamMoveParamValue(DomList* list, const char* name, const char* oldValue,
                                    const char* newValue);
DUDUZU_API void ParamMoveFromList(DomList* from, DomList* to, const char* name);
DUDUZU_API void ParamMoveFromListWithDefault(DomList* from, DomList* to, const char* name,
                                             const char* defaultValue);
// Points *text at a constant empty string (never to be released) when the
// list holds a record.
DUDUZU_API void ParamExpandParam(char** text, DomList* list);

// Printing, one status report per line.
DUDUZU_API void DomParamLPrint(DomList* list);
DUDUZU_API void ParamNicePrint(DomList* list);

// Word extraction: each call skips white space, reads one word (a double quote
// starts a word that runs to the next double quote or the end) and leaves
// *cursor behind it. The allocating forms keep at most 999 characters.
DUDUZU_API char* ParamExtractWordFromStr(char** cursor);
DUDUZU_API char* ParamExtractWordFromStrWithQuote(char** cursor);
// Writes the word, quotes kept, into the caller's buffer *word, which must
// hold it. 1 for a complete word; 0 at the end or for an unclosed quote.
DUDUZU_API int ParamExtractWordFromStrQuote(char** cursor, char** word);

// Parses `parameters` into *list (null when empty or malformed) and checks it
// against the two descriptor strings; 1 when accepted.
DUDUZU_API int ParamCheckParamList(char* command, char* const parameters, char* const descriptor1,
                                   char* const descriptor2, DomList** list);
// 1 when every parameter of `parameters` is in `list` with the same value.
DUDUZU_API int ParamTopCheckParamList(DomList* list, char* parameters);

// Global defaults, by name. Setting an empty value or a negative int removes
// the default; the getters give null, -1 or -1.0 when there is none.
DUDUZU_API void ParamDefSetStr(const char* name, const char* value);
DUDUZU_API char* ParamDefGetStr(const char* name);
DUDUZU_API void ParamDefSetInt(const char* name, int value);
DUDUZU_API int ParamDefGetInt(const char* name);
DUDUZU_API float ParamDefGetFloat(const char* name);
DUDUZU_API void ParamDefFree(void);
DUDUZU_API void ParamDefPrint(void);
DUDUZU_API void ParamDefPrintFormatted(void);

// Internal helpers shared by the parameter units.
#pragma once

#include "duduzu/param.h"

// Release callback for the slots of a parameter list.
void ParamFreeSlot(int** slot);

// True when name and value fit a record's fields; otherwise reports the one
// that does not and returns false. Null counts as empty.
bool ParamFits(const char* name, const char* value);

// Position (from 1) of the first record whose name equals `name` ignoring
// case; 0 when absent or when there is no list.
int ParamPosition(DomList* list, const char* name);

inline DomParam* ParamAt(DomList* list, int pos) {
  return reinterpret_cast<DomParam*>(list->elements[pos - 1]);
}

// Growth of a DomList's element array, shared by every list operation that adds.
#pragma once

#include "duduzu/list.h"

// Doubles the capacity until it holds `slots` elements (one reallocation).
// When memory is short: the fatal Memory Full report of ListAddElt, then
// ExitToSession(3).
void ListGrowTo(DomList* list, int slots);

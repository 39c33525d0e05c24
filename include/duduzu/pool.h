// Element pool: fixed-size zero-filled elements carved from large blocks.
#pragma once

#include "duduzu/export.h"

// Growable table of pointers (the layout of DomList).
class DomPoolTbl {
 public:
  int capacity;
  int count;
  void** elements;
};

class DomPool {
 public:
  DomPoolTbl* blocks;    // every block allocated so far
  DomPoolTbl* freeElts;  // released elements, used as a stack
  char* next;            // next unused element of the newest block
  char* end;             // end of the newest block
  int eltsPerBlock;
  unsigned itemSize;
  int itemsPerElt;       // an element is itemsPerElt * itemSize bytes
};

// A new pool with no block yet; null when memory is short.
DUDUZU_API DomPool* PoolInit(int eltsPerBlock, int itemsPerElt, unsigned itemSize);
// An element, released ones first (last in, first out, first itemSize bytes
// cleared); null when a new block cannot be had.
DUDUZU_API char* PoolGetNewElt(DomPool* pool);
// Gives elt back for reuse. It must come from this pool and not be released twice.
DUDUZU_API void PoolReleaseElt(DomPool* pool, char* elt);
// Frees the pool with all its blocks and sets *pool to null.
DUDUZU_API void PoolKill(DomPool** pool);

// Element pool: one allocator call per block, constant-time release and reuse.
#include <cstring>

#include "duduzu/pool.h"
#include "frame/unit.h"

namespace {

DomPoolTbl* tblCreate(int capacity) {
  auto* tbl = static_cast<DomPoolTbl*>(vzl_calloc(1, sizeof(DomPoolTbl)));
  if (!tbl) return nullptr;
  tbl->elements = static_cast<void**>(vzl_calloc(capacity, sizeof(void*)));
  if (!tbl->elements) {
    vzl_free(tbl);
    return nullptr;
  }
  tbl->capacity = capacity;
  return tbl;
}

// Zeroes n bytes; the small sizes of list records and similar items are cleared
// with a few inline stores instead of a call.
inline void clearBytes(char* p, size_t n) {
  if (n >= 16 && n <= 32) {
    memset(p, 0, 16);
    memset(p + n - 16, 0, 16);
  } else if (n >= 8 && n < 16) {
    memset(p, 0, 8);
    memset(p + n - 8, 0, 8);
  } else {
    memset(p, 0, n);
  }
}

void tblFree(DomPoolTbl* tbl) {
  if (!tbl) return;
  vzl_free(tbl->elements);
  vzl_free(tbl);
}

// Doubles a full table; false (table unchanged) when it cannot grow.
bool tblGrow(DomPoolTbl* tbl) {
  if (tbl->capacity > (1 << 29)) return false;
  int capacity = tbl->capacity * 2;
  void* grown = vzl_realloc(tbl->elements, sizeof(void*) * capacity);
  if (!grown) return false;
  tbl->elements = static_cast<void**>(grown);
  tbl->capacity = capacity;
  return true;
}

// Appends p; false (table unchanged) when it cannot grow.
[[gnu::noinline]] bool tblPush(DomPoolTbl* tbl, void* p) {
  if (tbl->count == tbl->capacity && !tblGrow(tbl)) return false;
  tbl->elements[tbl->count++] = p;
  return true;
}

// Takes the next element of the newest block, starting a new block when it is used up.
[[gnu::noinline]] char* carveElt(DomPool* pool) {
  if (pool->next == pool->end) {
    size_t items = static_cast<size_t>(pool->eltsPerBlock) * pool->itemsPerElt;
    char* block = static_cast<char*>(vzl_calloc(items, pool->itemSize));
    if (!block) return nullptr;
    if (!tblPush(pool->blocks, block)) {
      vzl_free(block);
      return nullptr;
    }
    pool->next = block;
    pool->end = block + items * pool->itemSize;
  }
  char* elt = pool->next;
  pool->next += static_cast<size_t>(pool->itemsPerElt) * pool->itemSize;
  return elt;
}

}  // namespace

DomPool* PoolInit(int eltsPerBlock, int itemsPerElt, unsigned itemSize) {
  if (eltsPerBlock < 1 || itemsPerElt < 1 || itemSize == 0) return nullptr;
  auto* pool = static_cast<DomPool*>(vzl_calloc(1, sizeof(DomPool)));
  if (!pool) return nullptr;
  pool->blocks = tblCreate(16);
  pool->freeElts = tblCreate(eltsPerBlock);
  if (!pool->blocks || !pool->freeElts) {
    tblFree(pool->blocks);
    tblFree(pool->freeElts);
    vzl_free(pool);
    return nullptr;
  }
  pool->eltsPerBlock = eltsPerBlock;
  pool->itemSize = itemSize;
  pool->itemsPerElt = itemsPerElt;
  return pool;
}

char* PoolGetNewElt(DomPool* pool) {
  DomPoolTbl* freeElts = pool->freeElts;
  if (freeElts->count == 0) return carveElt(pool);
  char* elt = static_cast<char*>(freeElts->elements[--freeElts->count]);
  clearBytes(elt, pool->itemSize);
  return elt;
}

void PoolReleaseElt(DomPool* pool, char* elt) {
  DomPoolTbl* freeElts = pool->freeElts;
  if (freeElts->count < freeElts->capacity)
    freeElts->elements[freeElts->count++] = elt;
  else
    tblPush(freeElts, elt);  // when the stack cannot grow, elt stays unused until PoolKill
}

void PoolKill(DomPool** pool) {
  if (!*pool) return;
  DomPool* p = *pool;
  tblFree(p->freeElts);
  for (int i = 0; i < p->blocks->count; ++i) vzl_free(p->blocks->elements[i]);
  tblFree(p->blocks);
  vzl_free(p);
  *pool = nullptr;
}

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

void tblFree(DomPoolTbl* tbl) {
  if (!tbl) return;
  vzl_free(tbl->elements);
  vzl_free(tbl);
}

// Appends p, doubling the table when full; false (table unchanged) when it cannot grow.
bool tblPush(DomPoolTbl* tbl, void* p) {
  if (tbl->count == tbl->capacity) {
    if (tbl->capacity > (1 << 29)) return false;
    int capacity = tbl->capacity * 2;
    void* grown = vzl_realloc(tbl->elements, sizeof(void*) * capacity);
    if (!grown) return false;
    tbl->elements = static_cast<void**>(grown);
    tbl->capacity = capacity;
  }
  tbl->elements[tbl->count++] = p;
  return true;
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
  if (freeElts->count > 0) {
    char* elt = static_cast<char*>(freeElts->elements[--freeElts->count]);
    memset(elt, 0, pool->itemSize);
    return elt;
  }
  size_t eltBytes = static_cast<size_t>(pool->itemsPerElt) * pool->itemSize;
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
  pool->next += eltBytes;
  return elt;
}

void PoolReleaseElt(DomPool* pool, char* elt) {
  // When the free stack cannot grow the element stays unused until PoolKill.
  tblPush(pool->freeElts, elt);
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

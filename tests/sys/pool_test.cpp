// Element pool: block carving, LIFO reuse with partial clearing, failure.
#include <gtest/gtest.h>

#include <cstring>

#include "duduzu/pool.h"
#include "port/port_testing.h"

TEST(Pool, CarvesBlocksReusesLastReleasedFirstAndClearsOnlyTheFirstItem) {
  DomPool* pool = PoolInit(4, 1, 16);
  EXPECT_EQ(pool->blocks->capacity * 10 + pool->freeElts->capacity, 164);
  char* first = PoolGetNewElt(pool);
  for (int i = 1; i < 4; ++i) EXPECT_EQ(PoolGetNewElt(pool), first + 16 * i);
  char* fifth = PoolGetNewElt(pool);  // from a second block
  EXPECT_TRUE(pool->blocks->count == 2 && fifth == static_cast<char*>(pool->blocks->elements[1]));
  EXPECT_EQ(std::string(fifth, 16), std::string(16, '\0'));
  PoolKill(&pool);
  PoolKill(&pool);  // the first set it to null (or this frees twice): nothing
  pool = PoolInit(2, 3, 4);  // 12-byte elements, 24-byte blocks, a free stack of 2
  char* e[5];
  for (char*& p : e) p = PoolGetNewElt(pool);
  memset(e[0], 0xAB, 12);
  memset(e[1], 0xCD, 12);
  for (char* p : e) PoolReleaseElt(pool, p);
  EXPECT_EQ(pool->freeElts->count * 10 + pool->freeElts->capacity, 58);  // the free stack grows past its capacity
  for (int i = 4; i >= 0; --i) EXPECT_EQ(PoolGetNewElt(pool), e[i]);
  EXPECT_EQ(std::string(e[0], 12) + std::string(e[1], 12),
            std::string(4, '\0') + std::string(8, '\xAB') + std::string(4, '\0') + std::string(8, '\xCD'));
  PoolKill(&pool);
}

TEST(Pool, FailedBlockLeavesThePoolAsItWas) {
  PortTest::AllocFailureGuard guard;
  EXPECT_EQ(PoolInit(0, 1, 8), nullptr);  // nothing valid to hand out
  DomPool* pool = PoolInit(2, 1, 8);
  PortTest::FailNthAlloc(1);
  EXPECT_EQ(PoolGetNewElt(pool), nullptr);
  EXPECT_TRUE(pool->blocks->count == 0 && pool->next == nullptr);
  EXPECT_NE(PoolGetNewElt(pool), nullptr);  // a later call tries again
  PortTest::FailAllAllocs();
  EXPECT_EQ(PoolInit(2, 1, 8), nullptr);
  PoolKill(&pool);
}

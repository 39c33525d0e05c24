// Element pool: block carving, LIFO reuse with partial clearing, failure.
#include <gtest/gtest.h>

#include <cstring>

#include "duduzu/pool.h"
#include "port/port_testing.h"

TEST(Pool, CarvesBlocksAndCountsThem) {
  DomPool* pool = PoolInit(4, 1, 16);
  ASSERT_NE(pool, nullptr);
  EXPECT_EQ(pool->blocks->capacity, 16);
  EXPECT_EQ(pool->freeElts->capacity, 4);
  EXPECT_EQ(pool->next, nullptr);
  char* first = PoolGetNewElt(pool);
  EXPECT_EQ(pool->blocks->count, 1);
  for (int i = 1; i < 4; ++i) EXPECT_EQ(PoolGetNewElt(pool), first + 16 * i);
  EXPECT_EQ(pool->next, pool->end);
  char* fifth = PoolGetNewElt(pool);
  EXPECT_EQ(pool->blocks->count, 2);
  EXPECT_EQ(fifth, static_cast<char*>(pool->blocks->elements[1]));
  for (int i = 0; i < 16; ++i) EXPECT_EQ(fifth[i], 0);
  PoolKill(&pool);
  EXPECT_EQ(pool, nullptr);
  PoolKill(&pool);  // null: nothing
}

TEST(Pool, ReusesLastReleasedFirstAndClearsOnlyTheFirstItem) {
  DomPool* pool = PoolInit(8, 3, 4);  // 12-byte elements, 96-byte blocks
  char* e1 = PoolGetNewElt(pool);
  char* e2 = PoolGetNewElt(pool);
  EXPECT_EQ(e2 - e1, 12);
  memset(e1, 0xAB, 12);
  memset(e2, 0xCD, 12);
  PoolReleaseElt(pool, e1);
  PoolReleaseElt(pool, e2);
  EXPECT_EQ(PoolGetNewElt(pool), e2);
  EXPECT_EQ(PoolGetNewElt(pool), e1);
  for (int i = 0; i < 4; ++i) EXPECT_EQ(e1[i], 0);
  for (int i = 4; i < 12; ++i) EXPECT_EQ(static_cast<unsigned char>(e1[i]), 0xAB);
  for (int i = 4; i < 12; ++i) EXPECT_EQ(static_cast<unsigned char>(e2[i]), 0xCD);
  PoolKill(&pool);
}

TEST(Pool, ReleasesBeyondTheFreeStackCapacityGrowIt) {
  DomPool* pool = PoolInit(2, 1, 8);
  char* e[5];
  for (char*& p : e) p = PoolGetNewElt(pool);
  for (char* p : e) PoolReleaseElt(pool, p);
  EXPECT_EQ(pool->freeElts->count, 5);
  EXPECT_EQ(pool->freeElts->capacity, 8);
  for (int i = 4; i >= 0; --i) EXPECT_EQ(PoolGetNewElt(pool), e[i]);
  PoolKill(&pool);
}

TEST(Pool, FailedBlockLeavesThePoolAsItWas) {
  PortTest::AllocFailureGuard guard;
  EXPECT_EQ(PoolInit(0, 1, 8), nullptr);  // nothing valid to hand out
  DomPool* pool = PoolInit(2, 1, 8);
  PortTest::FailNthAlloc(1);
  EXPECT_EQ(PoolGetNewElt(pool), nullptr);
  EXPECT_EQ(pool->blocks->count, 0);
  EXPECT_EQ(pool->next, nullptr);
  EXPECT_NE(PoolGetNewElt(pool), nullptr);  // a later call tries again
  PortTest::FailAllAllocs();
  EXPECT_EQ(PoolInit(2, 1, 8), nullptr);
  PortTest::ResetAllocFailures();
  PoolKill(&pool);
}

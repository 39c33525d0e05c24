// Element pool: block carving, LIFO reuse with partial clearing, failure.
#include <gtest/gtest.h>

#include <cstring>
#include <string>

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
  EXPECT_EQ(std::string(fifth, 16), std::string(16, '\0'));
  PoolKill(&pool);
  EXPECT_EQ(pool, nullptr);
  PoolKill(&pool);  // null: nothing
}

TEST(Pool, ReusesLastReleasedFirstAndClearsOnlyTheFirstItem) {
  DomPool* pool = PoolInit(2, 3, 4);  // 12-byte elements, 24-byte blocks, a free stack of 2
  char* e[5];
  for (char*& p : e) p = PoolGetNewElt(pool);
  EXPECT_EQ(e[1] - e[0], 12);
  memset(e[0], 0xAB, 12);
  memset(e[1], 0xCD, 12);
  for (char* p : e) PoolReleaseElt(pool, p);
  EXPECT_EQ(pool->freeElts->count, 5);  // the free stack grows past its capacity
  EXPECT_EQ(pool->freeElts->capacity, 8);
  for (int i = 4; i >= 0; --i) EXPECT_EQ(PoolGetNewElt(pool), e[i]);
  EXPECT_EQ(std::string(e[0], 12), std::string(4, '\0') + std::string(8, '\xAB'));
  EXPECT_EQ(std::string(e[1], 12), std::string(4, '\0') + std::string(8, '\xCD'));
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

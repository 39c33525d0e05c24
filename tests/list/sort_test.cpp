// Sorted lists: sorts against std::stable_sort, pinned comparison sequences,
// ordered insertion, binary search and the merges against std algorithms.
#include <algorithm>

#include "listtest.h"
#include "port/port_testing.h"

namespace {

// Random elements key * 1000 + id: keys from 1 to range, ids firstId, firstId + 1, ...
Vals Keyed(std::mt19937& rng, int size, long range, long firstId = 0) {
  Vals out = RandomVals(rng, size, range);
  for (size_t i = 0; i < out.size(); ++i) out[i] = out[i] * 1000 + firstId + static_cast<long>(i);
  return out;
}

bool KeyLess(long a, long b) { return a / 1000 < b / 1000; }
bool KeyGreater(long a, long b) { return a / 1000 > b / 1000; }

Vals StableSorted(Vals v, bool ascending) {
  std::stable_sort(v.begin(), v.end(), ascending ? KeyLess : KeyGreater);
  return v;
}

void ContextualSort(DomList* list, int ascending) {
  static int context;
  ListContextualSelfSort(list, ascending, CtxKeyCmpRec, &context);
  EXPECT_TRUE(list->count < 2 || lastContext == &context);
}

TEST(ListSelfSort, MatchesStableSortOnDistinctKeys) {
  std::mt19937 rng(7);
  for (int round = 0; round < 400; ++round) {
    int size = static_cast<int>(rng() % 201);
    Vals v = Keyed(rng, size, 1000000);
    std::sort(v.begin(), v.end());
    v.erase(std::unique(v.begin(), v.end(), [](long a, long b) { return a / 1000 == b / 1000; }),
            v.end());
    std::shuffle(v.begin(), v.end(), rng);
    for (int ascending : {1, 0}) {
      Owned list = Make(v);
      ListSelfSort(list.get(), ascending, KeyCmp);
      EXPECT_EQ(Of(list.get()), StableSorted(v, ascending));
      Owned copy(ListSort(Make(v).get(), ascending, KeyCmp, [](int* e) { return e; }));
      EXPECT_EQ(Of(copy.get()), StableSorted(v, ascending));
    }
  }
}

TEST(ListSelfSort, SortsRepeatedKeysIntoAPermutation) {
  std::mt19937 rng(8);
  for (int round = 0; round < 400; ++round) {
    Vals v = Keyed(rng, static_cast<int>(rng() % 201), 1 + rng() % 20);
    for (int ascending : {1, 0}) {
      Owned list = Make(v);
      ListSelfSort(list.get(), ascending, KeyCmp);
      Vals got = Of(list.get()), want = v;
      EXPECT_TRUE(std::is_sorted(got.begin(), got.end(), ascending ? KeyLess : KeyGreater));
      std::sort(got.begin(), got.end());
      std::sort(want.begin(), want.end());
      EXPECT_EQ(got, want);
    }
  }
}

TEST(ListContextualSelfSort, IsStableOnRepeatedKeys) {
  std::mt19937 rng(9);
  for (int round = 0; round < 400; ++round) {
    Vals v = Keyed(rng, static_cast<int>(rng() % 201), 1 + rng() % 20);
    for (int ascending : {1, 0}) {
      Owned list = Make(v);
      ContextualSort(list.get(), ascending);
      EXPECT_EQ(Of(list.get()), StableSorted(v, ascending));
    }
  }
}

TEST(ListSelfSort, ThreeEqualEndsSwapButContextualSortKeepsOrder) {
  calls.clear();
  Owned list = Make({1001, 2002, 1003});
  ListSelfSort(list.get(), 1, KeyCmpRec);
  EXPECT_EQ(Of(list.get()), (Vals{1003, 1001, 2002}));
  EXPECT_EQ(calls, (std::vector<Call>{{1001, 2002}, {1001, 1003}}));
  calls.clear();
  list = Make({1001, 2002, 1003});
  ContextualSort(list.get(), 1);
  EXPECT_EQ(Of(list.get()), (Vals{1001, 1003, 2002}));
  EXPECT_EQ(calls, (std::vector<Call>{{1001, 2002}, {2002, 1003}, {1001, 1003}}));
}

TEST(ListSelfSort, ComparisonSequenceOnSmallInputs) {
  calls.clear();
  Owned list = Make({5, 1, 4, 2, 3});
  ListSelfSort(list.get(), 1, CmpRec);
  EXPECT_EQ(Of(list.get()), (Vals{1, 2, 3, 4, 5}));
  EXPECT_EQ(calls, (std::vector<Call>{
                       {5, 1}, {5, 4}, {1, 4}, {2, 3}, {1, 2}, {4, 2}, {4, 2}, {4, 3}}));
  calls.clear();
  list = Make({5, 1, 4, 2, 3});
  ListSelfSort(list.get(), 0, CmpRec);
  EXPECT_EQ(Of(list.get()), (Vals{5, 4, 3, 2, 1}));
  EXPECT_EQ(calls, (std::vector<Call>{
                       {5, 1}, {5, 4}, {1, 4}, {2, 3}, {5, 3}, {4, 3}, {1, 3}, {1, 3}, {1, 2}}));
  calls.clear();
  list = Make({2, 1});
  ListSelfSort(list.get(), 1, CmpRec);
  EXPECT_EQ(Of(list.get()), (Vals{1, 2}));
  EXPECT_EQ(calls, (std::vector<Call>{{2, 1}}));
}

TEST(ListSelfSort, InPlacePrefixIsSkippedWithoutCopy) {
  calls.clear();
  Owned list = Make({1, 2, 3, 4});
  long before = PortTest::AllocCount();
  ListSelfSort(list.get(), 1, CmpRec);
  EXPECT_EQ(PortTest::AllocCount(), before);
  EXPECT_EQ(calls, (std::vector<Call>{{1, 2}, {3, 4}, {1, 3}, {2, 3}}));
  calls.clear();
  list = Make({1, 3, 2, 4});
  before = PortTest::AllocCount();
  ListSelfSort(list.get(), 1, CmpRec);
  EXPECT_EQ(PortTest::AllocCount(), before + 1);  // one temporary list for [3]
  EXPECT_EQ(Of(list.get()), (Vals{1, 2, 3, 4}));
  EXPECT_EQ(calls, (std::vector<Call>{{1, 3}, {2, 4}, {1, 2}, {3, 2}, {3, 2}, {3, 4}}));
}

TEST(ListContextualSelfSort, ComparisonSequenceOnSmallInput) {
  calls.clear();
  Owned list = Make({5000, 1000, 4000, 2000, 3000});
  ContextualSort(list.get(), 0);
  EXPECT_EQ(Of(list.get()), (Vals{5000, 4000, 3000, 2000, 1000}));
  EXPECT_EQ(calls, (std::vector<Call>{{5000, 1000}, {1000, 4000}, {5000, 4000}, {2000, 3000},
                                      {5000, 3000}, {4000, 3000}, {1000, 3000}, {1000, 3000},
                                      {1000, 2000}}));
}

TEST(ListSelfSort, MergesInPlaceWhenNoTemporaryListCanBeMade) {
  std::mt19937 rng(10);
  Vals v = Keyed(rng, 150, 30);
  Owned list = Make(v);
  calls.clear();
  ListSelfSort(list.get(), 1, KeyCmpRec);
  std::vector<Call> normal = calls;
  Vals sorted = Of(list.get());

  list = Make(v);
  calls.clear();
  PortTest::Capture cap;
  {
    PortTest::AllocFailureGuard guard;
    PortTest::FailAllAllocs();
    ListSelfSort(list.get(), 1, KeyCmpRec);
  }
  EXPECT_EQ(calls, normal);
  EXPECT_EQ(Of(list.get()), sorted);
  ASSERT_GT(cap.size(), 0u);
  for (const auto& r : cap.reports()) {
    EXPECT_EQ(r.level, Port_Fatal);
    EXPECT_EQ(r.text, "Data corruption (ListCreateWithSize) - Memory Full\n");
  }
}

TEST(ListSort, NullShortAndUnchangedSource) {
  calls.clear();
  EXPECT_EQ(ListSort(nullptr, 1, CmpRec, [](int* e) { return e; }), nullptr);
  Owned one = Make({4});
  Owned copy(ListSort(one.get(), 1, CmpRec, [](int* e) { return P(V(e) + 1); }));
  EXPECT_EQ(Of(copy.get()), Vals{5});
  EXPECT_TRUE(calls.empty());
  Owned src = Make({3, 1, 2});
  copy.reset(ListSort(src.get(), 1, Cmp, [](int* e) { return e; }));
  EXPECT_EQ(Of(copy.get()), (Vals{1, 2, 3}));
  EXPECT_EQ(Of(src.get()), (Vals{3, 1, 2}));
  ListSelfSort(nullptr, 1, Cmp);
}

TEST(ListInsertInSortedList, PlacementAmongEqualElements) {
  Owned list = Make({1, 3, 7});
  calls.clear();
  EXPECT_EQ(ListInsertInSortedList(list.get(), P(5), CmpRec, 1), 3);
  EXPECT_EQ(calls, (std::vector<Call>{{3, 5}, {7, 5}}));
  EXPECT_EQ(ListInsertInSortedList(list.get(), P(0), Cmp, 1), 1);
  EXPECT_EQ(ListInsertInSortedList(list.get(), P(9), Cmp, 1), 6);
  EXPECT_EQ(Of(list.get()), (Vals{0, 1, 3, 5, 7, 9}));

  list = Make({2000, 4001, 4002, 8003});
  EXPECT_EQ(ListInsertInSortedList(list.get(), P(4009), KeyCmp, 1), 4);
  list = Make({2000, 4001, 4002});
  EXPECT_EQ(ListInsertInSortedList(list.get(), P(4009), KeyCmp, 1), 3);
  EXPECT_EQ(Of(list.get()), (Vals{2000, 4001, 4009, 4002}));
  list = Make({8000, 4001, 2002});
  int context;
  EXPECT_EQ(ListContextualInsertInSortedList(list.get(), P(4009), CtxKeyCmpRec, 0, &context), 2);
  EXPECT_EQ(lastContext, &context);
  list = Make({}, 0);
  EXPECT_EQ(ListInsertInSortedList(list.get(), P(1), CmpRec, 0), 1);
}

TEST(ListInsertInSortedList, RandomInsertionsMatchReferencePlacement) {
  std::mt19937 rng(11);
  for (int round = 0; round < 100; ++round) {
    for (int ascending : {1, 0}) {
      Owned list = Make({}, 1);
      Vals ref;
      for (long e : Keyed(rng, static_cast<int>(rng() % 201), 1 + rng() % 30)) {
        auto at = ascending ? std::upper_bound(ref.begin(), ref.end(), e, KeyLess)
                            : std::lower_bound(ref.begin(), ref.end(), e, KeyGreater);
        if (ascending && at == ref.end() && !ref.empty() && ref.back() / 1000 == e / 1000) --at;
        long pos = at - ref.begin() + 1;
        ref.insert(at, e);
        ASSERT_EQ(ListInsertInSortedList(list.get(), P(e), KeyCmp, ascending), pos);
      }
      EXPECT_EQ(Of(list.get()), ref);
    }
  }
}

TEST(ListMemberOfSortedList, EdgeCasesAndDoubleComparison) {
  Owned list = Make({1, 3, 5, 7, 9});
  calls.clear();
  EXPECT_EQ(ListMemberOfSortedList(list.get(), P(7), CmpRec, 1), 4);
  EXPECT_EQ(calls, (std::vector<Call>{{5, 7}, {5, 7}, {7, 7}}));
  EXPECT_EQ(ListMemberOfSortedList(list.get(), P(6), Cmp, 1), 0);
  EXPECT_EQ(ListMemberOfSortedList(Make({9, 7, 5}).get(), P(5), Cmp, 0), 3);
  EXPECT_EQ(ListMemberOfSortedList(nullptr, P(5), Cmp, 1), 0);
  calls.clear();
  EXPECT_EQ(ListMemberOfSortedList(Make({}).get(), P(5), CmpRec, 1), 0);
  EXPECT_TRUE(calls.empty());

  list = Make({9, 5, 1});
  ListAddEltInSLNoDupl(list.get(), P(5), Cmp, 0);
  EXPECT_EQ(Of(list.get()), (Vals{9, 5, 1}));
  ListAddEltInSLNoDupl(list.get(), P(4), Cmp, 0);
  EXPECT_EQ(Of(list.get()), (Vals{9, 5, 4, 1}));
}

TEST(ListMemberOfSortedList, FindsExactlyThePresentKeysOnRandomLists) {
  std::mt19937 rng(12);
  for (int round = 0; round < 200; ++round) {
    long range = 1 + rng() % 100;
    for (int ascending : {1, 0}) {
      Owned list = Make(StableSorted(Keyed(rng, static_cast<int>(rng() % 201), range), ascending));
      for (long key = 0; key <= range + 1; ++key) {
        int context;
        int pos = ListContextualMemberOfSortedList(list.get(), P(key * 1000), CtxKeyCmpRec,
                                                   ascending, &context);
        bool present = false;
        for (long v : Of(list.get())) present |= v / 1000 == key;
        ASSERT_EQ(pos != 0, present);
        if (pos) {
          EXPECT_EQ(V(list->elements[pos - 1]) / 1000, key);
        }
      }
    }
  }
}

TEST(ListCheckIfSortedList, NeighbourPairs) {
  Owned list = Make({1, 1, 2});
  EXPECT_EQ(ListCheckIfSortedList(list.get(), Cmp, 1), 1);
  calls.clear();
  EXPECT_EQ(ListCheckIfSortedList(list.get(), CmpRec, 0), 0);
  EXPECT_EQ(calls, (std::vector<Call>{{1, 1}, {1, 2}}));
  EXPECT_EQ(ListCheckIfSortedList(Make({3, 2, 2}).get(), Cmp, 0), 1);
  EXPECT_EQ(ListCheckIfSortedList(nullptr, Cmp, 1), 1);
  EXPECT_EQ(ListCheckIfSortedList(Make({4}).get(), Cmp, 0), 1);
}

TEST(ListIdenticalSortedList, CountsAndPairs) {
  Owned a = Make({1, 2}), b = Make({1, 3});
  calls.clear();
  EXPECT_EQ(ListIdenticalSortedList(a.get(), b.get(), EqRec), 0);
  EXPECT_EQ(calls, (std::vector<Call>{{1, 1}, {2, 3}}));
  EXPECT_EQ(ListIdenticalSortedList(a.get(), Make({1, 2}).get(), EqRec), 1);
  EXPECT_EQ(ListIdenticalSortedList(a.get(), Make({1}).get(), EqRec), 0);
  EXPECT_EQ(ListIdenticalSortedList(nullptr, Make({}).get(), EqRec), 1);
}

TEST(ListSortedMerges, EdgeCasesAndComparisonSequence) {
  Owned a = Make({1, 2, 2}), b = Make({2, 3});
  calls.clear();
  Owned u(ListUnionOfSortedList(a.get(), b.get(), CmpRec));
  EXPECT_EQ(Of(u.get()), (Vals{1, 2, 2, 3}));
  EXPECT_EQ(calls, (std::vector<Call>{{1, 2}, {2, 2}, {2, 2}, {2, 3}}));
  calls.clear();
  Owned i(ListIntersectionOfSortedList(a.get(), b.get(), CmpRec));
  EXPECT_EQ(Of(i.get()), Vals{2});
  EXPECT_EQ(calls, (std::vector<Call>{{1, 2}, {1, 2}, {2, 2}, {2, 2}, {2, 3}, {2, 3}}));
  Owned c(ListComplementOfSortedList(a.get(), b.get(), Cmp));
  EXPECT_EQ(Of(c.get()), (Vals{1, 2}));

  Owned one = Make({1}), two = Make({2}), empty = Make({});
  i.reset(ListIntersectionOfSortedList(one.get(), two.get(), Cmp));
  ASSERT_NE(i, nullptr);
  EXPECT_EQ(i->count, 0);
  EXPECT_EQ(ListIntersectionOfSortedList(nullptr, two.get(), Cmp), nullptr);
  EXPECT_EQ(ListUnionOfSortedList(nullptr, empty.get(), Cmp), nullptr);
  EXPECT_EQ(ListUnionOfSortedList(nullptr, nullptr, Cmp), nullptr);
  u.reset(ListUnionOfSortedList(one.get(), nullptr, Cmp));
  EXPECT_EQ(Of(u.get()), Vals{1});
  EXPECT_EQ(u->capacity, 16);
  u.reset(ListUnionOfSortedList(empty.get(), empty.get(), Cmp));
  ASSERT_NE(u, nullptr);
  EXPECT_EQ(u->count, 0);
  EXPECT_EQ(ListComplementOfSortedList(nullptr, two.get(), Cmp), nullptr);
  EXPECT_EQ(ListComplementOfSortedList(empty.get(), nullptr, Cmp), nullptr);
  c.reset(ListComplementOfSortedList(one.get(), nullptr, Cmp));
  EXPECT_EQ(Of(c.get()), Vals{1});
  c.reset(ListComplementOfSortedList(empty.get(), two.get(), Cmp));
  ASSERT_NE(c, nullptr);
  EXPECT_EQ(c->count, 0);
  c.reset(ListComplementOfSortedList(two.get(), one.get(), Cmp));  // b ends first
  EXPECT_EQ(Of(c.get()), Vals{2});
}

TEST(ListSortedMerges, MultisetArithmeticOnRandomLists) {
  std::mt19937 rng(13);
  for (int round = 0; round < 400; ++round) {
    long range = 1 + rng() % 50;
    Vals a = StableSorted(Keyed(rng, static_cast<int>(rng() % 201), range), 1);
    Vals b = StableSorted(Keyed(rng, static_cast<int>(rng() % 201), range, 500), 1);
    Owned la = Make(a), lb = Make(b);
    Vals want;
    std::set_union(a.begin(), a.end(), b.begin(), b.end(), std::back_inserter(want), KeyLess);
    EXPECT_EQ(Of(Owned(ListUnionOfSortedList(la.get(), lb.get(), KeyCmp)).get()), want);
    want.clear();
    std::set_intersection(a.begin(), a.end(), b.begin(), b.end(), std::back_inserter(want),
                          KeyLess);
    EXPECT_EQ(Of(Owned(ListIntersectionOfSortedList(la.get(), lb.get(), KeyCmp)).get()), want);
    want.clear();
    std::set_difference(a.begin(), a.end(), b.begin(), b.end(), std::back_inserter(want), KeyLess);
    EXPECT_EQ(Of(Owned(ListComplementOfSortedList(la.get(), lb.get(), KeyCmp)).get()), want);
  }
}

}  // namespace

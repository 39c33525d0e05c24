// Sorted lists: sorts against std::stable_sort, pinned comparison sequences,
// ordered insertion, binary search and merges against std algorithms. The
// comparison sees keys (value / 1000) only.
#include <algorithm>

#include "listtest.h"
#include "port/port_testing.h"

namespace {

bool KeyLess(long a, long b) { return a / 1000 < b / 1000; }
bool KeyGreater(long a, long b) { return a / 1000 > b / 1000; }
int* SameElt(int* e) { return e; }

Vals StableSorted(Vals v, int ascending) {
  std::stable_sort(v.begin(), v.end(), ascending ? KeyLess : KeyGreater);
  return v;
}

int context;
void ContextualSort(DomList* list, int ascending) {
  ListContextualSelfSort(list, ascending, CtxCmpRec, &context);
}

TEST(ListSort, MatchesStableSortOnRandomLists) {
  std::mt19937 rng(7);
  for (int round = 0; round < 300; ++round) {
    Vals distinct = Keyed(rng, static_cast<int>(rng() % 201), 1000000);
    std::sort(distinct.begin(), distinct.end(), KeyLess);
    distinct.erase(std::unique(distinct.begin(), distinct.end(),
                               [](long a, long b) { return a / 1000 == b / 1000; }),
                   distinct.end());
    std::shuffle(distinct.begin(), distinct.end(), rng);
    Vals repeated = Keyed(rng, static_cast<int>(rng() % 201), 1 + rng() % 20);
    for (int ascending : {1, 0}) {
      Owned list = Make(distinct), stable = Make(repeated);
      ListSelfSort(list.get(), ascending, Cmp);
      EXPECT_EQ(Of(list.get()), StableSorted(distinct, ascending));
      Owned copy(ListSort(Make(distinct).get(), ascending, Cmp, SameElt));
      EXPECT_EQ(Of(copy.get()), StableSorted(distinct, ascending));
      ContextualSort(stable.get(), ascending);
      EXPECT_EQ(Of(stable.get()), StableSorted(repeated, ascending));
    }
  }
}

TEST(ListSort, ComparisonSequences) {
  Owned list = Make({5000, 1000, 4000, 2000, 3000});
  EXPECT_EQ(Recorded([&] { ListSelfSort(list.get(), 0, CmpRec); }),
            (Calls{{5000, 1000}, {5000, 4000}, {1000, 4000}, {2000, 3000}, {5000, 3000},
                   {4000, 3000}, {1000, 3000}, {1000, 3000}, {1000, 2000}}));
  EXPECT_EQ(Of(list.get()), (Vals{5000, 4000, 3000, 2000, 1000}));
  list = Make({5000, 1000, 4000, 2000, 3000});
  EXPECT_EQ(Recorded([&] { ContextualSort(list.get(), 0); }),  // inserting instead of the tree
            (Calls{{5000, 1000}, {1000, 4000}, {5000, 4000}, {2000, 3000}, {5000, 3000},
                   {4000, 3000}, {1000, 3000}, {1000, 3000}, {1000, 2000}}));
  EXPECT_EQ(lastContext, &context);
  EXPECT_EQ(Of(list.get()), (Vals{5000, 4000, 3000, 2000, 1000}));

  list = Make({1001, 2002, 1003});  // equal ends: the tree swaps them, the insertion does not
  EXPECT_EQ(Recorded([&] { ListSelfSort(list.get(), 1, CmpRec); }),
            (Calls{{1001, 2002}, {1001, 1003}}));
  EXPECT_EQ(Of(list.get()), (Vals{1003, 1001, 2002}));
  list = Make({2001, 1002, 1003});
  ListSelfSort(list.get(), 1, Cmp);
  EXPECT_EQ(Of(list.get()), (Vals{1003, 1002, 2001}));
  list = Make({1001, 2002, 1003});
  EXPECT_EQ(Recorded([&] { ContextualSort(list.get(), 1); }),
            (Calls{{1001, 2002}, {2002, 1003}, {1001, 1003}}));
  EXPECT_EQ(Of(list.get()), (Vals{1001, 1003, 2002}));

  list = Make({1000, 2000, 3000, 4000});  // halves in order: no temporary list
  long allocs = PortTest::AllocCount();
  EXPECT_EQ(Recorded([&] { ListSelfSort(list.get(), 1, CmpRec); }),
            (Calls{{1000, 2000}, {3000, 4000}, {1000, 3000}, {2000, 3000}}));
  EXPECT_EQ(PortTest::AllocCount(), allocs);
  list = Make({1000, 3000, 2000, 4000});  // only [3000] is copied out
  allocs = PortTest::AllocCount();
  EXPECT_EQ(Recorded([&] { ListSelfSort(list.get(), 1, CmpRec); }),
            (Calls{{1000, 3000}, {2000, 4000}, {1000, 2000}, {3000, 2000}, {3000, 2000},
                   {3000, 4000}}));
  EXPECT_EQ(PortTest::AllocCount(), allocs + 1);
}

TEST(ListSort, MergesInPlaceWhenNoTemporaryListCanBeMade) {
  std::mt19937 rng(10);
  Vals v = Keyed(rng, 150, 30);
  Owned list = Make(v);
  Calls normal = Recorded([&] { ListSelfSort(list.get(), 1, CmpRec); });
  Vals sorted = Of(list.get());
  list = Make(v);
  PortTest::Capture cap;
  PortTest::AllocFailureGuard guard;
  PortTest::FailAllAllocs();
  EXPECT_EQ(Recorded([&] { ListSelfSort(list.get(), 1, CmpRec); }), normal);
  PortTest::ResetAllocFailures();
  EXPECT_EQ(Of(list.get()), sorted);
  ASSERT_GT(cap.size(), 0u);
  EXPECT_EQ(cap.last().text, "Data corruption (ListCreateWithSize) - Memory Full\n");
}

TEST(ListSort, NullAndShortLists) {
  EXPECT_EQ(ListSort(nullptr, 1, CmpRec, SameElt), nullptr);
  Owned one = Make({4000}), src = Make({3000, 1000, 2000}), copy;
  EXPECT_TRUE(Recorded([&] { copy.reset(ListSort(one.get(), 1, CmpRec, SameElt)); }).empty());
  EXPECT_EQ(Of(copy.get()), Vals{4000});
  copy.reset(ListSort(src.get(), 1, Cmp, SameElt));
  EXPECT_EQ(Of(src.get()), (Vals{3000, 1000, 2000}));
  ListSelfSort(nullptr, 1, Cmp);
}

TEST(ListSortedInsert, PlacementAmongEqualElements) {
  Owned list = Make({1000, 3000, 7000});
  EXPECT_EQ(Recorded([&] { EXPECT_EQ(ListInsertInSortedList(list.get(), P(5000), CmpRec, 1), 3); }),
            (Calls{{3000, 5000}, {7000, 5000}}));
  EXPECT_EQ(ListInsertInSortedList(list.get(), P(0), Cmp, 1), 1);
  EXPECT_EQ(ListInsertInSortedList(list.get(), P(9000), Cmp, 1), 6);
  list = Make({2000, 4001, 4002, 8003});
  EXPECT_EQ(ListInsertInSortedList(list.get(), P(4009), Cmp, 1), 4);
  list = Make({2000, 4001, 4002});  // equal elements end the list
  EXPECT_EQ(ListInsertInSortedList(list.get(), P(4009), Cmp, 1), 3);
  list = Make({8000, 4001, 2002});
  EXPECT_EQ(ListContextualInsertInSortedList(list.get(), P(4009), CtxCmpRec, 0, &context), 2);
  EXPECT_EQ(lastContext, &context);

  std::mt19937 rng(11);
  for (int round = 0; round < 200; ++round) {
    int ascending = round % 2;
    Owned sorted = Make({}, 0);
    Vals ref;
    for (long e : Keyed(rng, static_cast<int>(rng() % 201), 1 + rng() % 30)) {
      auto at = ascending ? std::upper_bound(ref.begin(), ref.end(), e, KeyLess)
                          : std::lower_bound(ref.begin(), ref.end(), e, KeyGreater);
      if (ascending && at == ref.end() && !ref.empty() && !KeyLess(ref.back(), e)) --at;
      long pos = at - ref.begin() + 1;
      ref.insert(at, e);
      ASSERT_EQ(ListInsertInSortedList(sorted.get(), P(e), Cmp, ascending), pos);
    }
    EXPECT_EQ(Of(sorted.get()), ref);
  }
}

TEST(ListSortedSearch, BinarySearchAndSortedness) {
  Owned list = Make({1000, 3000, 5000, 7000, 9000});
  EXPECT_EQ(Recorded([&] { EXPECT_EQ(ListMemberOfSortedList(list.get(), P(7000), CmpRec, 1), 4); }),
            (Calls{{5000, 7000}, {5000, 7000}, {7000, 7000}}));
  EXPECT_EQ(ListMemberOfSortedList(list.get(), P(6000), Cmp, 1), 0);
  EXPECT_EQ(ListMemberOfSortedList(Make({9000, 7000, 5000}).get(), P(5000), Cmp, 0), 3);
  EXPECT_EQ(ListMemberOfSortedList(nullptr, P(5000), Cmp, 1), 0);
  list = Make({9000, 5000, 1000});
  ListAddEltInSLNoDupl(list.get(), P(5001), Cmp, 0);
  ListAddEltInSLNoDupl(list.get(), P(4000), Cmp, 0);
  EXPECT_EQ(Of(list.get()), (Vals{9000, 5000, 4000, 1000}));

  list = Make({1000, 1001, 2000});
  EXPECT_EQ(ListCheckIfSortedList(list.get(), Cmp, 1), 1);
  EXPECT_EQ(Recorded([&] { EXPECT_EQ(ListCheckIfSortedList(list.get(), CmpRec, 0), 0); }),
            (Calls{{1000, 1001}, {1001, 2000}}));
  EXPECT_EQ(ListCheckIfSortedList(nullptr, Cmp, 1), 1);
  EXPECT_EQ(Recorded([&] { EXPECT_EQ(ListIdenticalSortedList(list.get(), Make({1000, 5, 2000}).get(), EqRec), 0); }),
            (Calls{{1000, 1000}, {1001, 5}}));
  EXPECT_EQ(ListIdenticalSortedList(list.get(), Make({1000, 1001}).get(), Eq), 0);
  EXPECT_EQ(ListIdenticalSortedList(nullptr, Make({}).get(), Eq), 1);

  std::mt19937 rng(12);
  for (int round = 0; round < 200; ++round) {
    long range = 1 + rng() % 100;
    int ascending = round % 2;
    list = Make(StableSorted(Keyed(rng, static_cast<int>(rng() % 201), range), ascending));
    Vals v = Of(list.get());
    for (long key = 0; key <= range + 1; ++key) {
      int pos = ListContextualMemberOfSortedList(list.get(), P(key * 1000), CtxCmpRec, ascending,
                                                 &context);
      bool present = std::any_of(v.begin(), v.end(), [=](long x) { return x / 1000 == key; });
      ASSERT_EQ(pos != 0, present);
      ASSERT_TRUE(!pos || v[static_cast<size_t>(pos - 1)] / 1000 == key);
    }
  }
}

TEST(ListSortedMerges, NullEmptyResultsAndSequence) {
  Owned a = Make({1000, 2000, 2001}), b = Make({2002, 3000}), r;
  EXPECT_EQ(Recorded([&] { r.reset(ListUnionOfSortedList(a.get(), b.get(), CmpRec)); }),
            (Calls{{1000, 2002}, {2000, 2002}, {2000, 2002}, {2001, 3000}}));
  EXPECT_EQ(Of(r.get()), (Vals{1000, 2000, 2001, 3000}));
  EXPECT_EQ(Recorded([&] { r.reset(ListIntersectionOfSortedList(a.get(), b.get(), CmpRec)); }),
            (Calls{{1000, 2002}, {1000, 2002}, {2000, 2002}, {2000, 2002}, {2001, 3000},
                   {2001, 3000}}));
  EXPECT_EQ(Of(r.get()), Vals{2000});
  r.reset(ListComplementOfSortedList(a.get(), b.get(), Cmp));
  EXPECT_EQ(Of(r.get()), (Vals{1000, 2001}));

  Owned one = Make({1000}), two = Make({2000}), empty = Make({});
  EXPECT_EQ(ListIntersectionOfSortedList(nullptr, two.get(), Cmp), nullptr);
  EXPECT_EQ(ListUnionOfSortedList(nullptr, empty.get(), Cmp), nullptr);
  EXPECT_EQ(ListComplementOfSortedList(nullptr, two.get(), Cmp), nullptr);
  EXPECT_EQ(ListComplementOfSortedList(empty.get(), nullptr, Cmp), nullptr);
  for (DomList* e : {ListIntersectionOfSortedList(one.get(), two.get(), Cmp),
                     ListUnionOfSortedList(empty.get(), empty.get(), Cmp),
                     ListComplementOfSortedList(empty.get(), two.get(), Cmp)}) {
    ASSERT_NE(e, nullptr);
    EXPECT_EQ(e->count, 0);
    ListQuickDelete(&e);
  }
  r.reset(ListUnionOfSortedList(nullptr, one.get(), Cmp));
  EXPECT_EQ(Of(r.get()), Vals{1000});
  EXPECT_EQ(r->capacity, 16);
  r.reset(ListComplementOfSortedList(one.get(), nullptr, Cmp));
  EXPECT_EQ(Of(r.get()), Vals{1000});
  r.reset(ListComplementOfSortedList(one.get(), two.get(), Cmp));  // a ends before b
  EXPECT_EQ(Of(r.get()), Vals{1000});
}

TEST(ListSortedMerges, MultisetArithmeticOnRandomLists) {
  std::mt19937 rng(13);
  for (int round = 0; round < 300; ++round) {
    long range = 1 + rng() % 50;
    Vals a = StableSorted(Keyed(rng, static_cast<int>(rng() % 201), range), 1);
    Vals b = StableSorted(Keyed(rng, static_cast<int>(rng() % 201), range, 500), 1);
    Owned la = Make(a), lb = Make(b);
    Vals u, i, c;
    std::set_union(a.begin(), a.end(), b.begin(), b.end(), std::back_inserter(u), KeyLess);
    std::set_intersection(a.begin(), a.end(), b.begin(), b.end(), std::back_inserter(i), KeyLess);
    std::set_difference(a.begin(), a.end(), b.begin(), b.end(), std::back_inserter(c), KeyLess);
    EXPECT_EQ(Of(Owned(ListUnionOfSortedList(la.get(), lb.get(), Cmp)).get()), u);
    EXPECT_EQ(Of(Owned(ListIntersectionOfSortedList(la.get(), lb.get(), Cmp)).get()), i);
    EXPECT_EQ(Of(Owned(ListComplementOfSortedList(la.get(), lb.get(), Cmp)).get()), c);
  }
}

}  // namespace

// Sorted lists: sorts against std::stable_sort, pinned comparison sequences,
// ordered insertion, binary search and merges against std algorithms. The
// comparison sees keys (value / 1000) only.
#include <algorithm>

#include "listtest.h"

bool KeyLess(long a, long b) { return a / 1000 < b / 1000; }
int* SameElt(int* e) { return e; }

Vals StableSorted(Vals v, int ascending) {
  std::stable_sort(v.begin(), v.end(), [=](long a, long b) { return ascending ? KeyLess(a, b) : KeyLess(b, a); });
  return v;
}

int context;

TEST(ListSort, AgreesWithStdAlgorithmsOnRandomLists) {
  std::mt19937 rng(7);
  for (int round = 0; round < 60; ++round) {
    long range = 1 + rng() % (round < 30 ? 30 : 1000000);  // many or hardly any equal keys
    Vals v = Keyed(rng, 120, range);
    Owned list = Make(v);
    ListContextualSelfSort(list.get(), round % 2, CtxCmpRec, &context);  // stable, ascending in odd rounds
    EXPECT_EQ(Of(list.get()), StableSorted(v, round % 2));
    Vals a = StableSorted(v, 1), b = StableSorted(Keyed(rng, 120, range, 500), 1), u, i, c;
    std::set_union(a.begin(), a.end(), b.begin(), b.end(), std::back_inserter(u), KeyLess);
    std::set_intersection(a.begin(), a.end(), b.begin(), b.end(), std::back_inserter(i), KeyLess);
    std::set_difference(a.begin(), a.end(), b.begin(), b.end(), std::back_inserter(c), KeyLess);
    Owned la = Make(a), lb = Make(b);
    DomList *x = la.get(), *y = lb.get();
    EXPECT_EQ((std::vector<Vals>{Take(ListUnionOfSortedList(x, y, Cmp)), Take(ListIntersectionOfSortedList(x, y, Cmp)),
                                 Take(ListComplementOfSortedList(x, y, Cmp))}), (std::vector<Vals>{u, i, c}));
  }
}

TEST(ListSort, SequencesTemporaryListsInsertionSearchAndMerges) {
  // contextual, ascending, input, output, comparisons, temporary lists made
  const std::tuple<bool, int, Vals, Vals, Calls, long> cases[] = {
      // Equal ends: the tree swaps them, the insertion does not.
      {false, 1, {1001, 2002, 1003}, {1003, 1001, 2002}, {{1001, 2002}, {1001, 1003}}, 0},
      {true, 1, {1001, 2002, 1003}, {1001, 1003, 2002}, {{1001, 2002}, {2002, 1003}, {1001, 1003}}, 0},
      {false, 1, {1000, 3000, 2000, 4000}, {1000, 2000, 3000, 4000},  // only [3000] is copied out
       {{1000, 3000}, {2000, 4000}, {1000, 2000}, {3000, 2000}, {3000, 2000}, {3000, 4000}}, 1}};
  for (const auto& [contextual, ascending, in, out, calls, temporaries] : cases) {
    Owned sorted = Make(in);
    long allocs = PortTest::AllocCount();
    EXPECT_EQ(Recorded([&, c = contextual, up = ascending, l = sorted.get()] {
                c ? ListContextualSelfSort(l, up, CtxCmpRec, &context) : ListSelfSort(l, up, CmpRec); }), calls);
    EXPECT_EQ(Of(sorted.get()), out);
    EXPECT_EQ(PortTest::AllocCount(), allocs + temporaries);
  }
  EXPECT_EQ(lastContext, &context);
  Owned src = Make({3000, 1000, 2000});  // a sorted copy, the source unchanged
  EXPECT_EQ((std::vector<Vals>{Take(ListSort(src.get(), 1, Cmp, SameElt)), Of(src.get())}), (std::vector<Vals>{{1000, 2000, 3000}, {3000, 1000, 2000}}));
  ListSelfSort(nullptr, 1, Cmp);
  EXPECT_EQ(ListSort(nullptr, 1, Cmp, SameElt), nullptr);
  Vals v;
  for (long i = 0; i < 150; ++i) v.push_back((i * 37 % 30 + 1) * 1000 + i);
  Owned list = Make(v);  // without temporary lists the merges run in place, with the same comparisons
  Calls normal = Recorded([&] { ListSelfSort(list.get(), 1, CmpRec); });
  list = Make(v);
  PortTest::Capture cap;
  PortTest::AllocFailureGuard guard;
  PortTest::FailAllAllocs();
  EXPECT_EQ(Recorded([&] { ListSelfSort(list.get(), 1, CmpRec); }), normal);
  PortTest::ResetAllocFailures();
  EXPECT_EQ(Of(list.get()), StableSorted(v, 1));
  EXPECT_EQ(cap.size() ? cap.last().text : "", "Data corruption (ListCreateWithSize) - Memory Full\n");
  list = Make({1000, 3000, 7000});
  EXPECT_EQ(Recorded([&] { EXPECT_EQ(ListInsertInSortedList(list.get(), P(5000), CmpRec, 1), 3); }),
            (Calls{{3000, 5000}, {7000, 5000}}));
  EXPECT_EQ((Ints{ListInsertInSortedList(list.get(), P(9000), Cmp, 1), ListInsertInSortedList(Make({1000, 2000, 3000}).get(), P(2005), Cmp, 1),
                  ListInsertInSortedList(Make({1000, 2000}).get(), P(2005), Cmp, 1)}),
            (Ints{5, 3, 2}));  // after the last equal key, except at the very end of an ascending list
  EXPECT_EQ(Recorded([&] { EXPECT_EQ(ListContextualMemberOfSortedList(list.get(), P(7000), CtxCmpRec, 1, &context), 4); }),
            (Calls{{5000, 7000}, {5000, 7000}, {7000, 7000}}));
  EXPECT_EQ(ListMemberOfSortedList(list.get(), P(6000), Cmp, 1) + ListMemberOfSortedList(nullptr, P(1), Cmp, 1), 0);
  list = Make({8000, 4001, 2002});
  EXPECT_EQ(ListInsertInSortedList(list.get(), P(4009), Cmp, 0), 2);  // descending: before the equal key
  EXPECT_EQ(Of(list.get()), (Vals{8000, 4009, 4001, 2002}));
  list = Make({1000, 1001, 2000});
  EXPECT_EQ(ListCheckIfSortedList(list.get(), Cmp, 1) + ListCheckIfSortedList(nullptr, Cmp, 1), 2);
  EXPECT_EQ(Recorded([&] { EXPECT_EQ(ListCheckIfSortedList(list.get(), CmpRec, 0), 0); }), (Calls{{1000, 1001}, {1001, 2000}}));
  EXPECT_EQ(Recorded([&] { EXPECT_EQ(ListIdenticalSortedList(list.get(), Make({1000, 5, 2000}).get(), EqRec), 0); }),
            (Calls{{1000, 1000}, {1001, 5}}));
  EXPECT_EQ(ListIdenticalSortedList(list.get(), Make({1000, 1001}).get(), Eq) * 2 + ListIdenticalSortedList(nullptr, Make({}).get(), Eq), 1);
  Owned a = Make({1000, 2000, 2001}), b = Make({2002, 3000}), one = Make({1000}), two = Make({2000}), empty = Make({});
  EXPECT_EQ(Recorded([&] { EXPECT_EQ(Take(ListUnionOfSortedList(a.get(), b.get(), CmpRec)), (Vals{1000, 2000, 2001, 3000})); }),
            (Calls{{1000, 2002}, {2000, 2002}, {2000, 2002}, {2001, 3000}}));
  EXPECT_EQ(Recorded([&] { EXPECT_EQ(Take(ListIntersectionOfSortedList(a.get(), b.get(), CmpRec)), Vals{2000}); }),
            (Calls{{1000, 2002}, {1000, 2002}, {2000, 2002}, {2000, 2002}, {2001, 3000}, {2001, 3000}}));
  for (DomList* none : {ListIntersectionOfSortedList(nullptr, two.get(), Cmp), ListUnionOfSortedList(nullptr, empty.get(), Cmp),
                        ListComplementOfSortedList(nullptr, two.get(), Cmp), ListComplementOfSortedList(empty.get(), nullptr, Cmp)})
    EXPECT_EQ(none, nullptr);
  for (DomList* e : {ListIntersectionOfSortedList(one.get(), two.get(), Cmp), ListUnionOfSortedList(empty.get(), empty.get(), Cmp),
                     ListComplementOfSortedList(empty.get(), two.get(), Cmp), ListUnionOfSortedList(nullptr, one.get(), Cmp)})
    EXPECT_EQ(ShapeOf(Owned(e).get()), Shape(e->count ? Vals{1000} : Vals{}, 16));  // empty lists, not null
  EXPECT_EQ(Take(ListComplementOfSortedList(one.get(), two.get(), Cmp)), Vals{1000});  // a ends before b
}


// Set operations on unsorted lists: results against std references on random
// lists, null/empty results, capacities and the order of callback arguments.
#include <algorithm>
#include <climits>
#include <set>

#include "listtest.h"
#include "port/port_testing.h"
#include "support/session_test.h"

namespace {

int CtxEq(int* x, int* v, int*) { return Eq(x, v); }
int* Plus100(int* e) { return P(V(e) + 100); }
int* CtxPlus100(int* e, int* context) {
  lastContext = context;
  return Plus100(e);
}

std::set<long> SetOf(const Vals& v) { return {v.begin(), v.end()}; }
bool Has(const Vals& v, long x) { return std::find(v.begin(), v.end(), x) != v.end(); }
Vals Dedup(const Vals& v) {
  Vals out;
  for (long x : v)
    if (!Has(out, x)) out.push_back(x);
  return out;
}

// Random values in [1, range] (sizes 0 to 200).
Vals Small(std::mt19937& rng, long range) {
  Vals v = Keyed(rng, static_cast<int>(rng() % 201), range);
  for (long& x : v) x /= 1000;
  return v;
}

// Pairs of random lists that are often equal as sets or as multisets.
template <class Check>
void ForRandomPairs(Check check) {
  std::mt19937 rng(4);
  for (int round = 0; round < 300; ++round) {
    Vals a = Small(rng, 1 + rng() % 60), b = a;
    std::shuffle(b.begin(), b.end(), rng);
    if (rng() % 2 && !a.empty()) b.push_back(a[rng() % a.size()]);
    if (rng() % 3 == 0) b = Small(rng, 1 + rng() % 60);
    check(a, b);
  }
}

TEST(ListIdentity, AgreesWithSetReferencesOnRandomLists) {
  ForRandomPairs([](const Vals& a, const Vals& b) {
    std::set<long> sa = SetOf(a), sb = SetOf(b);
    Vals ma = a, mb = b;
    std::sort(ma.begin(), ma.end());
    std::sort(mb.begin(), mb.end());
    Owned la = Make(a), lb = Make(b);
    EXPECT_EQ(ListIdentical(la.get(), lb.get(), Eq), sa == sb);
    EXPECT_EQ(ListContextualIdentical(la.get(), lb.get(), CtxEq, nullptr), sa == sb);
    EXPECT_EQ(ListIncludeInList(la.get(), lb.get(), Eq),
              std::includes(sa.begin(), sa.end(), sb.begin(), sb.end()));
    EXPECT_EQ(ListIdenticalQuick(la.get(), Make(b).get(), Eq, 0), ma == mb);
    EXPECT_EQ(Of(la.get()), a);  // untouched without allowDuplicates
    int same = ListIdenticalQuick(la.get(), lb.get(), Eq, 1);
    EXPECT_EQ(same, sa == sb);
    if (same) {
      EXPECT_EQ(lb->count, 0);
      EXPECT_EQ(Of(la.get()), Dedup(a));
    }
  });
}

TEST(ListIdentity, EmptyCasesConsumptionAndArgumentOrder) {
  Owned empty = Make({}), x = Make({7});
  EXPECT_EQ(ListIdentical(nullptr, empty.get(), Eq), 1);
  EXPECT_EQ(ListIdentical(x.get(), nullptr, Eq), 0);
  EXPECT_EQ(ListContextualIdentical(empty.get(), nullptr, CtxEq, nullptr), 1);
  EXPECT_EQ(ListIdentical(Make({1, 1, 2}).get(), Make({2, 1}).get(), Eq), 1);
  EXPECT_EQ(ListIncludeInList(nullptr, empty.get(), Eq), 1);
  EXPECT_EQ(ListIncludeInList(nullptr, x.get(), Eq), 0);

  Owned a = Make({9, 9}), b = Make({9});
  EXPECT_EQ(ListIdenticalQuick(a.get(), b.get(), Eq, 0), 0);
  EXPECT_EQ(b->count, 0);
  a = Make({9}), b = Make({9, 9});
  EXPECT_EQ(ListIdenticalQuick(a.get(), b.get(), Eq, 0), 0);
  EXPECT_EQ(Of(b.get()), Vals{9});

  int context;
  a = Make({1, 2}), b = Make({2, 1});
  EXPECT_EQ(Recorded([&] { ListContextualIdentical(a.get(), b.get(), CtxEqRec, &context); }),
            (Calls{{2, 1}, {1, 1}, {2, 2}, {1, 2}, {2, 2}, {1, 1}}));
  EXPECT_EQ(lastContext, &context);
  EXPECT_EQ(Recorded([&] { ListIncludeInList(Make({5, 6}).get(), Make({6}).get(), EqRec); }),
            (Calls{{5, 6}, {6, 6}}));
  a = Make({1, 3, 2}), b = Make({2, 1, 4});  // stops at 3, b consumed so far
  EXPECT_EQ(Recorded([&] { EXPECT_EQ(ListIdenticalQuick(a.get(), b.get(), EqRec, 0), 0); }),
            (Calls{{2, 1}, {1, 1}, {2, 3}, {4, 3}}));
  EXPECT_EQ(Of(b.get()), (Vals{2, 4}));
}

TEST(ListDuplicates, AgreeWithReferencesOnRandomLists) {
  std::mt19937 rng(5);
  for (int round = 0; round < 300; ++round) {
    Vals v = Small(rng, 1 + rng() % 400), sorted = v;
    std::sort(sorted.begin(), sorted.end());
    int first = 0;
    while (first < static_cast<int>(v.size()) && !Has(Vals(v.begin() + first + 1, v.end()), v[first]))
      ++first;
    bool distinct = SetOf(v).size() == v.size();
    Owned list = Make(v);
    EXPECT_EQ(ListCheckNoDuplication(list.get(), Eq), distinct);
    EXPECT_EQ(ListContextualCheckNoDuplication(list.get(), CtxEq, nullptr), distinct);
    EXPECT_EQ(ListSortedCheckNoDuplication(Make(sorted).get(), Eq), distinct);
    EXPECT_EQ(ListSearchDuplication(list.get(), Eq), distinct ? 0 : first + 1);
    ListRemoveDuplicElem(list.get(), Eq);
    EXPECT_EQ(Of(list.get()), Dedup(v));
  }
}

int HeapEq(int* x, int* v) { return *x == *v; }

TEST(ListDuplicates, PairOrderEdgeCasesAndRelease) {
  Owned list = Make({1, 2, 3});
  EXPECT_EQ(Recorded([&] { ListCheckNoDuplication(list.get(), EqRec); }),
            (Calls{{1, 2}, {1, 3}, {2, 3}}));
  EXPECT_EQ(Recorded([&] { ListSortedCheckNoDuplication(list.get(), EqRec); }),
            (Calls{{2, 1}, {3, 2}}));
  EXPECT_EQ(ListCheckNoDuplication(nullptr, Eq) + ListSortedCheckNoDuplication(nullptr, Eq), 2);
  EXPECT_EQ(ListSearchDuplication(Make({1, 2, 3, 2}).get(), Eq), 2);
  list = Make({1, 2, 1});
  EXPECT_EQ(ListRemoveElt(list.get(), P(1), Eq), 1);
  EXPECT_EQ(ListRemoveElt(list.get(), P(5), Eq), 0);
  ListAddEltNoDupl(list.get(), P(2), Eq);
  ListAddEltNoDupl(list.get(), P(4), Eq);
  EXPECT_EQ(Of(list.get()), (Vals{2, 1, 4}));

  DomList* heap = ListCreate();  // ASan reports a leaked or twice-freed element
  for (int v : {4, 5, 4, 4, 5, 6}) {
    ListAddElt(heap, static_cast<int*>(vzl_malloc(sizeof(int))));
    *heap->elements[heap->count - 1] = v;
  }
  int* kept[] = {heap->elements[0], heap->elements[1], heap->elements[5]};
  ListRemoveFreeDuplicElem(heap, HeapEq, ListElemFree);
  ASSERT_EQ(heap->count, 3);
  EXPECT_TRUE(std::equal(kept, kept + 3, heap->elements));
  ListDelete(&heap, ListElemFree);
}

TEST(ListSetAlgebra, AgreesWithReferencesOnRandomLists) {
  ForRandomPairs([](const Vals& a, const Vals& b) {
    Vals inter, comp, uni = a, grown = a;
    for (long x : a) (Has(b, x) ? inter : comp).push_back(x);
    for (long y : b) {
      if (!Has(a, y)) uni.push_back(y);
      if (!Has(grown, y)) grown.push_back(y);
    }
    Owned la = Make(a), lb = Make(b), into = Make(a);
    EXPECT_EQ(Of(Owned(ListIntersectionNoEltCr(la.get(), lb.get(), Eq)).get()), inter);
    EXPECT_EQ(Of(Owned(ListUnionNoEltCr(la.get(), lb.get(), Eq)).get()), uni);
    EXPECT_EQ(Of(Owned(ListComplement(la.get(), lb.get(), Eq)).get()), comp);
    EXPECT_EQ(Of(Owned(ListContextualComplement(la.get(), lb.get(), CtxEq, nullptr)).get()), comp);
    DomList* raw = into.release();
    ListUnionNoEltCrNoLCr(&raw, lb.get(), Eq);
    into.reset(raw);
    EXPECT_EQ(Of(into.get()), grown);
  });
}

TEST(ListSetAlgebra, NullEmptyResultsCapacitiesAndRepeats) {
  Owned x = Make({1}), y = Make({2}), yy = Make({2, 2}), empty = Make({});
  EXPECT_EQ(ListIntersectionNoEltCr(x.get(), nullptr, Eq), nullptr);
  EXPECT_EQ(ListIntersectionNoEltCr(x.get(), y.get(), Eq), nullptr);
  EXPECT_EQ(ListContextualIntersectionNoEltCr(nullptr, x.get(), CtxEq, nullptr), nullptr);
  EXPECT_EQ(ListUnionNoEltCr(empty.get(), nullptr, Eq), nullptr);
  EXPECT_EQ(ListUnion(empty.get(), empty.get(), Eq, Plus100), nullptr);
  EXPECT_EQ(ListInverseNoEltCr(empty.get()), nullptr);
  EXPECT_EQ(ListComplement(nullptr, empty.get(), Eq), nullptr);
  for (DomList* c : {ListComplement(x.get(), x.get(), Eq), ListComplement(nullptr, x.get(), Eq),
                     ListContextualComplement(nullptr, nullptr, CtxEq, nullptr)}) {
    ASSERT_NE(c, nullptr);
    EXPECT_EQ(c->count, 0);
    EXPECT_EQ(c->capacity, 16);
    ListQuickDelete(&c);
  }
  Owned r(ListComplement(x.get(), empty.get(), Eq));  // a copy of a, sized to it
  EXPECT_EQ(r->capacity, 1);

  r.reset(ListUnionNoEltCr(x.get(), yy.get(), Eq));
  EXPECT_EQ(Of(r.get()), (Vals{1, 2, 2}));
  EXPECT_EQ(r->capacity, 4);  // the copy of a (capacity 1) doubled twice
  r.reset(ListContextualUnionNoEltCr(nullptr, yy.get(), CtxEq, nullptr));
  EXPECT_EQ(Of(r.get()), (Vals{2, 2}));
  DomList* grown = ListCopyNoEltCr(x.get());
  ListUnionNoEltCrNoLCr(&grown, yy.get(), Eq);
  EXPECT_EQ(Of(grown), (Vals{1, 2}));
  ListQuickDelete(&grown);
  ListUnionNoEltCrNoLCr(&grown, yy.get(), Eq);  // a null *a becomes a copy of b
  EXPECT_EQ(Of(grown), (Vals{2, 2}));
  ListQuickDelete(&grown);

  Owned a = Make({1, 2, 3}), b = Make({3, 1});
  r.reset(ListUnion(a.get(), Make({4, 2}).get(), Eq, Plus100));
  EXPECT_EQ(Of(r.get()), (Vals{101, 102, 103, 104}));
  int context;
  EXPECT_EQ(Recorded([&] {
              r.reset(ListContextualIntersectionWithEltCr(a.get(), b.get(), CtxEqRec, CtxPlus100,
                                                          &context));
            }),
            (Calls{{3, 1}, {1, 1}, {3, 2}, {1, 2}, {3, 3}}));
  EXPECT_EQ(lastContext, &context);
  EXPECT_EQ(Of(r.get()), (Vals{101, 103}));
  EXPECT_EQ(r->capacity, 2);
  r.reset(ListInverseNoEltCr(a.get()));
  EXPECT_EQ(Of(r.get()), (Vals{3, 2, 1}));
  EXPECT_EQ(r->capacity, 16);
}

TEST(ListSetAlgebra, GrowthFailureExitsToSession) {
  Owned a = Make(Vals(17, 5)), b = Make({5});
  PortTest::Capture cap;
  PortTest::AllocFailureGuard guard;
  PortTest::FailNthAlloc(2);  // the result's array is allocated, its growth fails
  EXPECT_TRUE(ExitsToSession([&] { ListIntersectionNoEltCr(a.get(), b.get(), Eq); }));
  EXPECT_EQ(MainEVarReturnStatus, 3);
  ASSERT_EQ(cap.size(), 1u);
  EXPECT_EQ(cap[0].level, Port_Fatal);
  EXPECT_EQ(cap[0].text, "Data corruption (ListAddElt) - Memory Full\n");
}

int Value(int* e) { return static_cast<int>(V(e)); }
int CtxValue(int* e, int* context) { return Value(e) * *context; }

TEST(ListSums, SumsExtremesAndPairs) {
  int three = 3;
  EXPECT_EQ(ListEltSum(nullptr, Value), 0);
  EXPECT_EQ(ListEltSum(Make({INT_MAX, 1, 2}).get(), Value), INT_MIN + 2);
  EXPECT_EQ(ListContextualEltSum(Make({1, 2}).get(), CtxValue, &three), 9);

  Owned list = Make({3000, 7000, 7001, 1000});
  EXPECT_EQ(V(ListMaxMinElt(list.get(), 0, Cmp)), 7000);  // ties keep the earlier
  EXPECT_EQ(Recorded([&] { EXPECT_EQ(V(ListMaxMinElt(list.get(), 1, CmpRec)), 1000); }),
            (Calls{{7000, 3000}, {7001, 3000}, {1000, 3000}}));
  EXPECT_TRUE(Recorded([&] { EXPECT_EQ(V(ListMaxMinElt(list.get(), 2, CmpRec)), 3000); }).empty());
  EXPECT_EQ(ListMaxMinElt(nullptr, 0, Cmp), nullptr);

  list = Make({10, 11, 20, 21});
  EXPECT_EQ(Recorded([&] { EXPECT_EQ(ListMemberOfDoubleList(list.get(), P(20), EqRec), 3); }),
            (Calls{{10, 20}, {20, 20}}));
  EXPECT_EQ(ListMemberOfDoubleList(list.get(), P(11), Eq), 0);
  EXPECT_EQ(ListMemberOfDoubleList(nullptr, P(11), Eq), 0);
}

}  // namespace

// Set operations on unsorted lists: results against std references on random
// lists, null/empty results, capacities and the order of callback arguments.
#include <algorithm>
#include <climits>
#include <set>

#include "listtest.h"
#include "port/port_testing.h"
#include "support/session_test.h"

namespace {

int Eq(int* x, int* v) { return V(x) == V(v); }
int CtxEq(int* x, int* v, int*) { return V(x) == V(v); }
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

// Pairs of random lists (sizes 0 to 200) that are often equal as sets or multisets.
template <class Check>
void ForRandomPairs(Check check) {
  std::mt19937 rng(4);
  for (int round = 0; round < 300; ++round) {
    Vals a = RandomVals(rng, static_cast<int>(rng() % 201), 1 + rng() % 60);
    Vals b = a;
    std::shuffle(b.begin(), b.end(), rng);
    if (rng() % 2 && !a.empty()) b.push_back(a[rng() % a.size()]);
    if (rng() % 3 == 0) b = RandomVals(rng, static_cast<int>(rng() % 201), 1 + rng() % 60);
    check(a, b);
  }
}

TEST(ListIdentical, EmptyCasesAndMultiplicity) {
  Owned empty = Make({}), x = Make({7}), a = Make({1, 1, 2}), b = Make({2, 1});
  EXPECT_EQ(ListIdentical(nullptr, empty.get(), Eq), 1);
  EXPECT_EQ(ListIdentical(x.get(), nullptr, Eq), 0);
  EXPECT_EQ(ListIdentical(empty.get(), x.get(), Eq), 0);
  EXPECT_EQ(ListIdentical(a.get(), b.get(), Eq), 1);
  EXPECT_EQ(ListContextualIdentical(empty.get(), nullptr, CtxEq, nullptr), 1);
  EXPECT_EQ(ListIncludeInList(nullptr, empty.get(), Eq), 1);
  EXPECT_EQ(ListIncludeInList(nullptr, x.get(), Eq), 0);
}

TEST(ListIdentical, ListElementComesFirstInBothPasses) {
  calls.clear();
  Owned a = Make({1, 2}), b = Make({2, 1});
  int context = 0;
  EXPECT_EQ(ListContextualIdentical(a.get(), b.get(), CtxEqRec, &context), 1);
  EXPECT_EQ(lastContext, &context);
  // Pass 1: each element of a sought in b; pass 2: each element of b sought in a.
  EXPECT_EQ(calls, (std::vector<Call>{{2, 1}, {1, 1}, {2, 2}, {1, 2}, {2, 2}, {1, 1}}));
  calls.clear();
  Owned big = Make({5, 6}), small = Make({6});
  EXPECT_EQ(ListIncludeInList(big.get(), small.get(), EqRec), 1);
  EXPECT_EQ(calls, (std::vector<Call>{{5, 6}, {6, 6}}));
}

TEST(ListIdentical, AgreesWithSetReferenceOnRandomLists) {
  ForRandomPairs([](const Vals& a, const Vals& b) {
    Owned la = Make(a), lb = Make(b);
    bool same = SetOf(a) == SetOf(b);
    std::set<long> sa = SetOf(a), sb = SetOf(b);
    EXPECT_EQ(ListIdentical(la.get(), lb.get(), Eq), same);
    EXPECT_EQ(ListContextualIdentical(la.get(), lb.get(), CtxEq, nullptr), same);
    EXPECT_EQ(ListIncludeInList(la.get(), lb.get(), Eq),
              std::includes(sa.begin(), sa.end(), sb.begin(), sb.end()));
    EXPECT_EQ(Of(la.get()), a);
    EXPECT_EQ(Of(lb.get()), b);
  });
}

TEST(ListIdenticalQuick, EdgeCasesConsumeTheirInput) {
  Owned a = Make({9, 9}), b = Make({9});
  EXPECT_EQ(ListIdenticalQuick(a.get(), b.get(), Eq, 0), 0);
  EXPECT_EQ(b->count, 0);
  a = Make({9, 9}), b = Make({9});
  EXPECT_EQ(ListIdenticalQuick(a.get(), b.get(), Eq, 1), 1);
  EXPECT_EQ(Of(a.get()), Vals{9});
  a = Make({9}), b = Make({9, 9});
  EXPECT_EQ(ListIdenticalQuick(a.get(), b.get(), Eq, 0), 0);
  EXPECT_EQ(Of(b.get()), Vals{9});
  b = Make({9, 9});
  EXPECT_EQ(ListIdenticalQuick(a.get(), b.get(), Eq, 1), 1);
  EXPECT_EQ(ListIdenticalQuick(nullptr, Make({}).get(), Eq, 0), 1);
}

TEST(ListIdenticalQuick, StopsAtTheFirstUnmatchedElementWithBElementFirst) {
  calls.clear();
  Owned a = Make({1, 3, 2}), b = Make({2, 1, 4});
  EXPECT_EQ(ListIdenticalQuick(a.get(), b.get(), EqRec, 0), 0);
  EXPECT_EQ(calls, (std::vector<Call>{{2, 1}, {1, 1}, {2, 3}, {4, 3}}));
  EXPECT_EQ(Of(b.get()), (Vals{2, 4}));
  EXPECT_EQ(Of(a.get()), (Vals{1, 3, 2}));
}

TEST(ListIdenticalQuick, MultisetOrSetEqualityOnRandomLists) {
  ForRandomPairs([](const Vals& a, const Vals& b) {
    Vals sa = a, sb = b;
    std::sort(sa.begin(), sa.end());
    std::sort(sb.begin(), sb.end());
    Owned la = Make(a), lb = Make(b);
    EXPECT_EQ(ListIdenticalQuick(la.get(), lb.get(), Eq, 0), sa == sb);
    EXPECT_EQ(Of(la.get()), a);
    la = Make(a), lb = Make(b);
    int same = ListIdenticalQuick(la.get(), lb.get(), Eq, 1);
    EXPECT_EQ(same, SetOf(a) == SetOf(b));
    if (same) {
      EXPECT_EQ(Of(la.get()), Dedup(a));
    }
  });
}

TEST(ListDuplicates, AgreeWithReferenceOnRandomLists) {
  std::mt19937 rng(5);
  for (int round = 0; round < 300; ++round) {
    Vals v = RandomVals(rng, static_cast<int>(rng() % 201), 1 + rng() % 400);
    size_t first = 0;
    while (first < v.size() && !Has(Vals(v.begin() + first + 1, v.end()), v[first])) ++first;
    Owned list = Make(v);
    bool distinct = SetOf(v).size() == v.size();
    EXPECT_EQ(ListCheckNoDuplication(list.get(), Eq), distinct);
    EXPECT_EQ(ListContextualCheckNoDuplication(list.get(), CtxEq, nullptr), distinct);
    EXPECT_EQ(ListSearchDuplication(list.get(), Eq), first < v.size() ? static_cast<int>(first) + 1 : 0);
    Vals sorted = v;
    std::sort(sorted.begin(), sorted.end());
    EXPECT_EQ(ListSortedCheckNoDuplication(Make(sorted).get(), Eq), distinct);
    ListRemoveDuplicElem(list.get(), Eq);
    EXPECT_EQ(Of(list.get()), Dedup(v));
  }
}

TEST(ListDuplicates, PairOrderAndEdgeCases) {
  calls.clear();
  Owned list = Make({1, 2, 3});
  EXPECT_EQ(ListCheckNoDuplication(list.get(), EqRec), 1);
  EXPECT_EQ(calls, (std::vector<Call>{{1, 2}, {1, 3}, {2, 3}}));
  calls.clear();
  EXPECT_EQ(ListSortedCheckNoDuplication(list.get(), EqRec), 1);
  EXPECT_EQ(calls, (std::vector<Call>{{2, 1}, {3, 2}}));
  EXPECT_EQ(ListCheckNoDuplication(nullptr, Eq), 1);
  EXPECT_EQ(ListSortedCheckNoDuplication(nullptr, Eq), 1);
  EXPECT_EQ(ListSearchDuplication(nullptr, Eq), 0);
  EXPECT_EQ(ListSearchDuplication(Make({1, 2, 3, 2}).get(), Eq), 2);
  ListRemoveDuplicElem(nullptr, Eq);

  list = Make({1, 2, 1});
  EXPECT_EQ(ListRemoveElt(list.get(), P(1), Eq), 1);
  EXPECT_EQ(Of(list.get()), (Vals{2, 1}));
  EXPECT_EQ(ListRemoveElt(list.get(), P(5), Eq), 0);
  ListAddEltNoDupl(list.get(), P(2), Eq);
  ListAddEltNoDupl(list.get(), P(4), Eq);
  EXPECT_EQ(Of(list.get()), (Vals{2, 1, 4}));
}

int HeapEq(int* x, int* v) { return *x == *v; }

TEST(ListDuplicates, RemoveFreeReleasesEachRemovedElement) {
  DomList* list = ListCreate();
  for (int v : {4, 5, 4, 4, 5, 6}) {
    int* e = static_cast<int*>(vzl_malloc(sizeof(int)));
    *e = v;
    ListAddElt(list, e);
  }
  int* kept[] = {list->elements[0], list->elements[1], list->elements[5]};
  ListRemoveFreeDuplicElem(list, HeapEq, ListElemFree);  // ASan reports any leak or double free
  ASSERT_EQ(list->count, 3);
  for (int i = 0; i < 3; ++i) EXPECT_EQ(list->elements[i], kept[i]);
  ListDelete(&list, ListElemFree);
}

TEST(ListSetAlgebra, AgreesWithReferenceOnRandomLists) {
  ForRandomPairs([](const Vals& a, const Vals& b) {
    Vals inter, comp, uni = a;
    for (long x : a) (Has(b, x) ? inter : comp).push_back(x);
    for (long y : b)
      if (!Has(a, y)) uni.push_back(y);
    Owned la = Make(a), lb = Make(b);
    EXPECT_EQ(Of(Owned(ListIntersectionNoEltCr(la.get(), lb.get(), Eq)).get()), inter);
    EXPECT_EQ(Of(Owned(ListUnionNoEltCr(la.get(), lb.get(), Eq)).get()), uni);
    EXPECT_EQ(Of(Owned(ListComplement(la.get(), lb.get(), Eq)).get()), comp);
    EXPECT_EQ(Of(Owned(ListContextualComplement(la.get(), lb.get(), CtxEq, nullptr)).get()), comp);
    DomList* grown = ListCopyNoEltCr(la.get());
    ListUnionNoEltCrNoLCr(&grown, lb.get(), Eq);
    Vals expected = a;
    for (long y : b)
      if (!Has(expected, y)) expected.push_back(y);
    EXPECT_EQ(Of(grown), expected);
    ListQuickDelete(&grown);
  });
}

TEST(ListSetAlgebra, NullAndEmptyResults) {
  Owned x = Make({1}), y = Make({2}), empty = Make({});
  EXPECT_EQ(ListIntersectionNoEltCr(x.get(), nullptr, Eq), nullptr);
  EXPECT_EQ(ListIntersectionNoEltCr(x.get(), y.get(), Eq), nullptr);
  EXPECT_EQ(ListContextualIntersectionNoEltCr(nullptr, x.get(), CtxEq, nullptr), nullptr);
  EXPECT_EQ(ListUnionNoEltCr(nullptr, nullptr, Eq), nullptr);
  EXPECT_EQ(ListUnionNoEltCr(empty.get(), nullptr, Eq), nullptr);
  EXPECT_EQ(ListUnion(empty.get(), empty.get(), Eq, Plus100), nullptr);
  EXPECT_EQ(ListInverseNoEltCr(empty.get()), nullptr);
  EXPECT_EQ(ListInverseNoEltCr(nullptr), nullptr);
  EXPECT_EQ(ListComplement(nullptr, empty.get(), Eq), nullptr);

  Owned comp(ListComplement(x.get(), x.get(), Eq));
  ASSERT_NE(comp, nullptr);
  EXPECT_EQ(comp->count, 0);
  comp.reset(ListComplement(nullptr, x.get(), Eq));
  ASSERT_NE(comp, nullptr);
  EXPECT_EQ(comp->count, 0);
  comp.reset(ListContextualComplement(nullptr, nullptr, CtxEq, nullptr));
  ASSERT_NE(comp, nullptr);
  EXPECT_EQ(comp->capacity, 16);
  comp.reset(ListComplement(x.get(), empty.get(), Eq));  // a copy of a, sized to it
  EXPECT_EQ(Of(comp.get()), Vals{1});
  EXPECT_EQ(comp->capacity, 1);
}

TEST(ListSetAlgebra, UnionsAppendRepeatsUnlessGrowingInPlace) {
  Owned x = Make({1}), yy = Make({2, 2});
  Owned u(ListUnionNoEltCr(x.get(), yy.get(), Eq));
  EXPECT_EQ(Of(u.get()), (Vals{1, 2, 2}));
  EXPECT_EQ(u->capacity, 4);  // the copy of a had capacity 1, doubled twice
  u.reset(ListContextualUnionNoEltCr(nullptr, yy.get(), CtxEq, nullptr));
  EXPECT_EQ(Of(u.get()), (Vals{2, 2}));
  DomList* grown = ListCopyNoEltCr(x.get());
  ListUnionNoEltCrNoLCr(&grown, yy.get(), Eq);
  EXPECT_EQ(Of(grown), (Vals{1, 2}));
  ListQuickDelete(&grown);
  ListUnionNoEltCrNoLCr(&grown, yy.get(), Eq);  // null *a becomes a copy of b
  EXPECT_EQ(Of(grown), (Vals{2, 2}));
  ListUnionNoEltCrNoLCr(&grown, nullptr, Eq);
  EXPECT_EQ(Of(grown), (Vals{2, 2}));
  ListQuickDelete(&grown);
}

TEST(ListSetAlgebra, CopiesCapacitiesAndCallbackOrder) {
  calls.clear();
  Owned a = Make({1, 2, 3}), b = Make({3, 1});
  Owned u(ListUnion(a.get(), Make({4, 2}).get(), Eq, Plus100));
  EXPECT_EQ(Of(u.get()), (Vals{101, 102, 103, 104}));
  int context = 0;
  Owned i(ListContextualIntersectionWithEltCr(a.get(), b.get(), CtxEqRec, CtxPlus100, &context));
  EXPECT_EQ(Of(i.get()), (Vals{101, 103}));
  EXPECT_EQ(i->capacity, 2);
  EXPECT_EQ(lastContext, &context);
  EXPECT_EQ(calls, (std::vector<Call>{{3, 1}, {1, 1}, {3, 2}, {1, 2}, {3, 3}}));
  i.reset(ListIntersectionNoEltCr(a.get(), b.get(), Eq));
  EXPECT_EQ(i->capacity, 16);
  Owned inv(ListInverseNoEltCr(a.get()));
  EXPECT_EQ(Of(inv.get()), (Vals{3, 2, 1}));
  EXPECT_EQ(inv->capacity, 16);
}

TEST(ListSetAlgebra, GrowthFailureExitsToSession) {
  Vals many(17, 5);
  Owned a = Make(many), b = Make({5});
  PortTest::Capture cap;
  PortTest::AllocFailureGuard guard;
  PortTest::FailNthAlloc(2);  // the result's array is allocated, its growth fails
  EXPECT_TRUE(ExitsToSession([&] { ListIntersectionNoEltCr(a.get(), b.get(), Eq); }));
  EXPECT_EQ(MainEVarReturnStatus, 3);
  ASSERT_EQ(cap.size(), 1u);
  EXPECT_EQ(cap[0].level, Port_Fatal);
  EXPECT_STREQ(cap[0].text.c_str(), "Data corruption (ListAddElt) - Memory Full\n");
}

int Value(int* e) { return static_cast<int>(V(e)); }
int CtxValue(int* e, int* context) { return Value(e) * *context; }

TEST(ListSums, WrapAroundAndContext) {
  EXPECT_EQ(ListEltSum(nullptr, Value), 0);
  EXPECT_EQ(ListEltSum(Make({INT_MAX, 1, 2}).get(), Value), INT_MIN + 2);
  int three = 3;
  EXPECT_EQ(ListContextualEltSum(Make({1, 2}).get(), CtxValue, &three), 9);
}

TEST(ListMaxMinElt, FirstOfTiesAndOtherModes) {
  calls.clear();
  Owned list = Make({3, 7, 7, 1});
  int* firstSeven = list->elements[1];
  EXPECT_EQ(ListMaxMinElt(list.get(), 0, Cmp), firstSeven);
  EXPECT_EQ(V(ListMaxMinElt(list.get(), 1, Cmp)), 1);
  EXPECT_EQ(V(ListMaxMinElt(list.get(), 2, CmpRec)), 3);
  EXPECT_TRUE(calls.empty());
  EXPECT_EQ(ListMaxMinElt(Make({}).get(), 0, Cmp), nullptr);
  calls.clear();
  ListMaxMinElt(list.get(), 1, CmpRec);
  EXPECT_EQ(calls, (std::vector<Call>{{7, 3}, {7, 3}, {1, 3}}));
}

TEST(ListMemberOfDoubleList, TestsKeysOnly) {
  calls.clear();
  Owned list = Make({10, 11, 20, 21});
  EXPECT_EQ(ListMemberOfDoubleList(list.get(), P(20), EqRec), 3);
  EXPECT_EQ(calls, (std::vector<Call>{{10, 20}, {20, 20}}));
  EXPECT_EQ(ListMemberOfDoubleList(list.get(), P(11), Eq), 0);
  EXPECT_EQ(ListMemberOfDoubleList(nullptr, P(11), Eq), 0);
}

}  // namespace

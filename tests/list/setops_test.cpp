// Set operations on unsorted lists: results against std references on random
// lists, null/empty results, capacities and the order of callback arguments.
#include <algorithm>
#include <set>

#include "listtest.h"

int* Plus100(int* e) { return P(V(e) + 100); }
bool Has(const Vals& v, long x) { return std::find(v.begin(), v.end(), x) != v.end(); }

TEST(ListSetOps, AgreeWithReferencesOnRandomLists) {
  std::mt19937 rng(4);
  for (int round = 0; round < 80; ++round) {
    long range = 1 + rng() % 30;  // b often equals a as a set or as a multiset
    Vals a(rng() % 41), b, distinct, inter, comp, uni;
    for (long& x : a) x = 1 + static_cast<long>(rng() % range);
    b = uni = a;
    std::shuffle(b.begin(), b.end(), rng);
    if (rng() % 2 && !a.empty()) b.push_back(a[rng() % a.size()]);
    if (rng() % 3 == 0) for (long& y : b) y = 1 + static_cast<long>(rng() % range);
    std::set<long> sa(a.begin(), a.end()), sb(b.begin(), b.end());
    for (long x : a) (Has(b, x) ? inter : comp).push_back(x), Has(distinct, x) ? void() : distinct.push_back(x);
    std::copy_if(b.begin(), b.end(), std::back_inserter(uni), [&](long y) { return !Has(a, y); });
    Owned la = Make(a), lb = Make(b), dedup = Make(a);
    ListRemoveDuplicElem(dedup.get(), Eq);
    EXPECT_EQ((std::vector<Vals>{Take(ListIntersectionNoEltCr(la.get(), lb.get(), Eq)), Take(ListUnionNoEltCr(la.get(), lb.get(), Eq)),
                                 Take(ListComplement(la.get(), lb.get(), Eq)), Of(dedup.get())}),
              (std::vector<Vals>{inter, uni, comp, distinct}));
    EXPECT_EQ((Ints{ListIdentical(la.get(), lb.get(), Eq), ListIncludeInList(la.get(), lb.get(), Eq),
                    ListIdenticalQuick(la.get(), Make(b).get(), Eq, 0), ListCheckNoDuplication(la.get(), Eq)}),
              (Ints{sa == sb, std::includes(sa.begin(), sa.end(), sb.begin(), sb.end()),
                    std::is_permutation(a.begin(), a.end(), b.begin(), b.end()), distinct.size() == a.size()}));
    EXPECT_EQ(ListIdenticalQuick(la.get(), lb.get(), Eq, 1), sa == sb);  // a untouched until here
    EXPECT_TRUE(sa != sb || (Of(la.get()) == distinct && lb->count == 0));  // repeats dropped from a, all of b consumed
  }
}

int HeapEq(int* x, int* v) { return *x == *v; }
int Value(int* e) { return static_cast<int>(V(e)); }

TEST(ListSetOps, NullAndEmptyListsCapacitiesAndCallbackArgumentOrder) {
  Owned empty = Make({}), x = Make({7}), a = Make({1, 2}), b = Make({2, 1}), y = Make({2}), yy = Make({2, 2}), r;
  EXPECT_EQ((Ints{ListIdentical(nullptr, empty.get(), Eq), ListContextualIdentical(empty.get(), nullptr, CtxEqRec, nullptr),
                  ListIdentical(x.get(), nullptr, Eq), ListIncludeInList(nullptr, empty.get(), Eq),
                  ListIncludeInList(nullptr, x.get(), Eq), ListCheckNoDuplication(nullptr, Eq),
                  ListSortedCheckNoDuplication(nullptr, Eq), ListSearchDuplication(Make({1, 2, 3, 2}).get(), Eq),
                  ListSearchDuplication(Make({1, 2}).get(), Eq), ListSearchDuplication(nullptr, Eq)}),
            (Ints{1, 1, 0, 1, 0, 1, 1, 2, 0, 0}));  // ListSearchDuplication: the first element with a later match
  int context;
  EXPECT_EQ(Recorded([&] { ListContextualIdentical(a.get(), b.get(), CtxEqRec, &context); }),
            (Calls{{2, 1}, {1, 1}, {2, 2}, {1, 2}, {2, 2}, {1, 1}}));
  EXPECT_EQ(lastContext, &context);
  a = Make({1, 3, 2}), b = Make({2, 1, 4});  // stops at 3, b consumed so far
  EXPECT_EQ(Recorded([&] { EXPECT_EQ(ListIdenticalQuick(a.get(), b.get(), EqRec, 0), 0); }),
            (Calls{{2, 1}, {1, 1}, {2, 3}, {4, 3}}));
  EXPECT_EQ(Of(b.get()), (Vals{2, 4}));
  a = Make({1, 2, 3});
  EXPECT_EQ(Recorded([&] { ListCheckNoDuplication(a.get(), EqRec); }), (Calls{{1, 2}, {1, 3}, {2, 3}}));
  EXPECT_EQ(Recorded([&] { ListSortedCheckNoDuplication(a.get(), EqRec); }), (Calls{{2, 1}, {3, 2}}));
  x = Make({1}), a = Make({1, 2, 3}), b = Make({3, 1});
  for (DomList* none : {ListIntersectionNoEltCr(x.get(), nullptr, Eq), ListIntersectionNoEltCr(x.get(), y.get(), Eq),
                        ListIntersectionNoEltCr(nullptr, x.get(), Eq),
                        ListUnionNoEltCr(empty.get(), nullptr, Eq), ListUnion(empty.get(), empty.get(), Eq, Plus100),
                        ListInverseNoEltCr(empty.get()), ListComplement(nullptr, empty.get(), Eq)})
    EXPECT_EQ(none, nullptr);
  EXPECT_EQ(ShapeOf(Owned(ListComplement(x.get(), x.get(), Eq)).get()), Shape({}, 16));
  EXPECT_EQ(ShapeOf(Owned(ListComplement(x.get(), empty.get(), Eq)).get()), Shape({1}, 1));  // a copy of a
  EXPECT_EQ(ShapeOf(Owned(ListUnionNoEltCr(x.get(), yy.get(), Eq)).get()), Shape({1, 2, 2}, 4));
  DomList* grown = nullptr;  // a null *a becomes a copy of b, then gains what it lacks
  ListUnionNoEltCrNoLCr(&grown, yy.get(), Eq);
  ListUnionNoEltCrNoLCr(&grown, Make({3, 2, 3}).get(), Eq);
  EXPECT_EQ(Take(grown), (Vals{2, 2, 3}));
  auto plus = [](int* e, int* c) { return lastContext = c, Plus100(e); };
  EXPECT_EQ(Recorded([&] { r.reset(ListContextualIntersectionWithEltCr(a.get(), b.get(), CtxEqRec, plus, &context)); }),
            (Calls{{3, 1}, {1, 1}, {3, 2}, {1, 2}, {3, 3}}));
  EXPECT_EQ(lastContext, &context);
  EXPECT_EQ(ShapeOf(r.get()), Shape({101, 103}, 2));
  EXPECT_EQ(ShapeOf(Owned(ListInverseNoEltCr(a.get())).get()), Shape({3, 2, 1}, 16));
  Owned list = Make({1, 2, 1});
  EXPECT_EQ(ListRemoveElt(list.get(), P(1), Eq) * 10 + ListRemoveElt(list.get(), P(5), Eq), 10);
  EXPECT_EQ(Of(list.get()), (Vals{2, 1}));
  DomList* heap = ListCreate();  // ASan reports a leaked or twice-freed element
  for (int v : {4, 5, 4, 4, 5, 6}) ListAddElt(heap, new (vzl_malloc(sizeof(int))) int(v));
  int* kept[] = {heap->elements[0], heap->elements[1], heap->elements[5]};
  ListRemoveFreeDuplicElem(heap, HeapEq, ListElemFree);
  EXPECT_EQ(std::vector<int*>(heap->elements, heap->elements + heap->count), std::vector<int*>(kept, kept + 3));
  ListDelete(&heap, ListElemFree);
  ListDelete(&heap, ListElemFree);  // null: nothing
  int three = 3;
  EXPECT_EQ((Ints{ListEltSum(nullptr, Value), ListEltSum(Make({INT_MAX, 1, 2}).get(), Value),
                  ListContextualEltSum(Make({1, 2}).get(), [](int* e, int* c) { return Value(e) * *c; }, &three)}),
            (Ints{0, INT_MIN + 2, 9}));  // wrapping like 32-bit arithmetic
  list = Make({3000, 7000, 7001, 1000});
  EXPECT_EQ((Vals{V(ListMaxMinElt(list.get(), 0, Cmp)), V(ListMaxMinElt(nullptr, 0, Cmp))}), (Vals{7000, 0}));  // ties: the earlier
  EXPECT_EQ(Recorded([&] { EXPECT_EQ(V(ListMaxMinElt(list.get(), 1, CmpRec)), 1000); }),
            (Calls{{7000, 3000}, {7001, 3000}, {1000, 3000}}));
  EXPECT_TRUE(Recorded([&] { EXPECT_EQ(V(ListMaxMinElt(list.get(), 2, CmpRec)), 3000); }).empty());
  list = Make({10, 11, 20, 21});
  EXPECT_EQ(Recorded([&] { EXPECT_EQ(ListMemberOfDoubleList(list.get(), P(20), EqRec), 3); }), (Calls{{10, 20}, {20, 20}}));
  EXPECT_EQ(ListMemberOfDoubleList(list.get(), P(11), Eq) + ListMemberOfDoubleList(nullptr, P(11), Eq), 0);
}



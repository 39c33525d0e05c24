// List core: growth, removal, search, compaction, copies, printing, failures.
#include "listtest.h"
#include "support/session_test.h"

Vals freed;
void RecordFree(int** slot) { freed.push_back(V(*slot)), *slot = nullptr; }

TEST(ListCore, RemovalsCreationAndGrowthFailures) {
  const std::tuple<std::string, int (*)(DomList*, int), Vals> removals[] = {
      {"ListDelShift", ListDelShift, {1, 3}}, {"ListDelInsert", ListDelInsert, {1, 4}},
      {"ListDelShiftFree", [](DomList* l, int pos) { return ListDelShiftFree(l, pos, RecordFree); }, {1, 3}},
      {"ListDelInsertFree", [](DomList* l, int pos) { return ListDelInsertFree(l, pos, RecordFree); }, {1, 4}}};
  for (const auto& [name, remove, after] : removals) {
    const std::string text = "Data corruption (" + name + ") - Bad Index\n";
    Owned list = Make({1, 2, 3, 4});
    PortTest::Capture cap;
    EXPECT_EQ(remove(list.get(), 0) + remove(list.get(), -3) + remove(nullptr, 0), 3) << text;  // no-ops
    EXPECT_EQ(remove(list.get(), 5) + remove(nullptr, 1), 0) << text;  // a null list counts as empty
    ExpectReports(cap, Port_Fatal, {text, text});
    EXPECT_EQ(remove(list.get(), 2) + remove(list.get(), 3), 2);  // then the last one
    EXPECT_EQ(Of(list.get()), after) << text;
  }
  EXPECT_EQ(freed, (Vals{2, 4, 2, 3}));
  PortTest::AllocFailureGuard guard;
  DomList *list = ListCreate(), *first = list;
  ListQuickDelete(&list);
  PortTest::Capture cap;
  PortTest::FailNthAlloc(1);  // the element array: the record goes back to the pool
  EXPECT_EQ(ListCreateWithSize(4), nullptr);
  EXPECT_EQ(Owned(ListCreate()).get(), first);  // the last released record comes back first
  ListKill();
  PortTest::FailNthAlloc(1);  // the record pool itself
  EXPECT_EQ(ListCreate(), nullptr);
  EXPECT_EQ(ListCreateWithSize(-1), nullptr);
  const char* full = "Data corruption (ListCreateWithSize) - Memory Full\n";
  ExpectReports(cap, Port_Fatal, {full, full, "Data corruption (ListCreateWithSize) - Negative index\n"});
  static DomList* grown;  // a fresh pool after the kill; growth failure ends the session with code 3
  grown = Make(Vals(16, 1)).release();
  PortTest::FailAllAllocs();
  for (void (*grow)() : {+[] { ListAddElt(grown, P(9)); }, +[] { ListSetRealloc(grown, P(9), INT_MAX); }}) {
    MainEVarReturnStatus = 0;
    EXPECT_TRUE(ExitsToSession(grow));
    EXPECT_EQ(MainEVarReturnStatus, 3);
  }
  ExpectReports(cap, Port_Fatal, {"Data corruption (ListAddElt) - Memory Full\n", "Data corruption (ListAddElt) - Memory Full\n"});
  EXPECT_EQ(ShapeOf(grown), Shape(Vals(16, 1), 16));
  PortTest::ResetAllocFailures();
  ListQuickDelete(&grown);
}

int SameParity(int* x, int* v) { return (V(x) & 1) == (V(v) & 1); }

TEST(ListCore, GrowthInsertionMembershipAndCompaction) {  // growth only doubles; ListSetRealloc nulls the gap
  Owned tiny(ListCreateWithSize(0)), grown = Make(Vals{1, 2, 3, 4, 5, 6, 7, 8, 9, 10, 11, 12, 13, 14, 15, 16, 17});
  EXPECT_EQ(tiny->elements[0], nullptr);
  for (int i = 1; i <= 3; ++i) ListAddElt(tiny.get(), P(i));
  EXPECT_EQ((Ints{tiny->capacity, grown->capacity}), (Ints{4, 32}));  // 1, 2, 4 and 16, 32
  Vals want = Of(grown.get());
  want.resize(41);
  ListSetRealloc(grown.get(), P(want[40] = 9), 40);  // slots 17 to 39 become null
  PortTest::Capture cap;
  ListSetRealloc(grown.get(), P(1), -1);
  ExpectReports(cap, Port_Fatal, {"Data corruption (ListAddElt) - Negative index\n"});
  EXPECT_EQ(ShapeOf(grown.get()), Shape(want, 64));
  Owned list = Make({1, 2}), full = Make({1}, 1);
  EXPECT_EQ((Ints{ListInsertInList(list.get(), P(7), 2), ListInsertInList(list.get(), P(8), 4),
                  ListInsertInList(list.get(), P(9), 1), ListInsertInList(full.get(), P(2), 1),
                  ListInsertInList(list.get(), P(5), 0), ListInsertInList(list.get(), P(5), 7),
                  ListInsertInList(nullptr, P(5), 1)}),
            (Ints{1, 1, 1, 1, 0, 0, 0}));
  const char* refused = "in ListInsertInList !!\n\n";
  ExpectReports(cap, Port_Error, {refused, refused, refused});
  EXPECT_EQ(Of(list.get()), (Vals{9, 1, 7, 2, 8}));
  EXPECT_EQ(ShapeOf(full.get()), Shape({2, 1}, 2));  // a full array grows

  list = Make({10, 20, 10, -5});
  EXPECT_EQ((Ints{ListMemberOfList(list.get(), P(10)), ListMemberOfList(list.get(), P(99)),
                  ListMemberOfList(nullptr, P(10)), ListMemberOfList(list.get(), P(3), SameParity),
                  ListMemberOfListInt(list.get(), -5), ListMemberOfListInt(nullptr, 10)}),
            (Ints{1, 0, 0, 4, 4, 0}));
  EXPECT_EQ(Recorded([&] { EXPECT_EQ(ListMemberOfList(list.get(), P(20), EqRec), 2); }), (Calls{{10, 20}, {20, 20}}));
  list = Make({1, 0, 2, 0});
  EXPECT_EQ((Ints{ListCompact(list.get()), ListCompact(nullptr)}), (Ints{2, 0}));
  EXPECT_EQ(ShapeOf(list.get()), Shape({1, 2}, 16));
}

int* Double(int* e) { return P(V(e) * 2); }
std::string printed;

TEST(ListCore, CopiesJoinsDeletionAndPrinting) {  // printing separates elements by the main-output rule
  Owned src = Make({1, 2, 3}), copy(ListCopy(src.get(), Double)), shared(ListCopyNoEltCr(src.get()));
  EXPECT_EQ(ShapeOf(copy.get()), Shape({2, 4, 6}, 3));  // sized to the source
  EXPECT_EQ(ShapeOf(Owned(ListCopy(Make({}).get(), Double)).get()), Shape({}, 1));
  EXPECT_TRUE(shared->elements != src->elements && ListCopy(nullptr, Double) == nullptr && ListCopyNoEltCr(nullptr) == nullptr);
  ListAdd(copy.get(), src.get(), Double);
  ListAddNoEltCr(src.get(), src.get());  // a list joined to itself
  EXPECT_EQ(Of(src.get()), (Vals{1, 2, 3, 1, 2, 3}));
  DomList* moved = shared.release();
  ListAppend(copy.get(), &moved);  // LeakSanitizer checks that the source is released
  EXPECT_EQ(moved, nullptr);
  ListAppend(copy.get(), &moved);  // null sources add nothing
  ListAddNoEltCr(copy.get(), nullptr);
  EXPECT_EQ(ShapeOf(copy.get()), Shape({2, 4, 6, 2, 4, 6, 1, 2, 3}, 12));
  static long seen = 0;  // deletion visits every slot in order; ListDelete frees: see the duplicate tests
  int ctx = 42;
  moved = Make({4, 5}).release();
  ListContextualDelete(&moved, [](int** slot, int* c) { seen = seen * 100 + V(*slot) + *c; }, &ctx);
  EXPECT_EQ(seen, 4647);
  EXPECT_EQ(moved, nullptr);
  MainEVarOutFile = stdout;
  PortTest::Capture cap;
  ListPrint(stdout, src.get(), [](FILE*, int* e) { printed += std::to_string(V(e)); }, ", ");
  ListPrint(stdout, nullptr, nullptr, ", ");
  ctx = 0;
  ListContextualPrint(stdout, src.get(), [](FILE*, int*, int* c) { ++*c; }, "/", &ctx);
  EXPECT_EQ(printed + std::to_string(ctx) + cap.text(Port_Status) + std::to_string(cap.size()), "1231236, , , , , /////10");
  MainEVarOutFile = nullptr;
}


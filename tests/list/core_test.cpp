// List core: growth, removal, search, compaction, copies, printing, failures.
#include <gtest/gtest.h>

#include <cstdint>
#include <string>
#include <vector>

#include "duduzu/duduzu.h"
#include "port/port_testing.h"
#include "support/session_test.h"

namespace {

int* I(intptr_t v) { return reinterpret_cast<int*>(v); }

DomList* make(std::initializer_list<intptr_t> values) {
  DomList* list = ListCreate();
  for (intptr_t v : values) ListAddElt(list, I(v));
  return list;
}

std::vector<intptr_t> items(const DomList* list) {
  std::vector<intptr_t> out;
  for (int i = 0; i < list->count; ++i) out.push_back(reinterpret_cast<intptr_t>(list->elements[i]));
  return out;
}

using V = std::vector<intptr_t>;

std::vector<int*> freed;
void recordFree(int** slot) {
  freed.push_back(*slot);
  *slot = nullptr;
}

}  // namespace

TEST(ListCore, CapacityStartsAtSizeAndOnlyDoubles) {
  DomList* list = ListCreateWithSize(0);
  EXPECT_EQ(list->capacity, 1);
  EXPECT_EQ(list->elements[0], nullptr);
  int seen[3];
  for (int i = 0; i < 3; ++i) {
    ListAddElt(list, I(i + 1));
    seen[i] = list->capacity;
  }
  EXPECT_EQ(seen[0], 1);
  EXPECT_EQ(seen[1], 2);
  EXPECT_EQ(seen[2], 4);
  ListQuickDelete(&list);
  EXPECT_EQ(list, nullptr);

  list = ListCreate();
  EXPECT_EQ(list->capacity, 16);
  for (int i = 0; i < 16; ++i) ListAddElt(list, I(i));
  EXPECT_EQ(list->capacity, 16);
  ListAddElt(list, I(16));
  EXPECT_EQ(list->capacity, 32);
  EXPECT_EQ(list->count, 17);
  ListQuickDelete(&list);
}

TEST(ListCore, SetReallocGrowsPastTheIndexAndNullsTheGap) {
  DomList* list = make({1, 2, 3});
  ListSetRealloc(list, I(9), 40);
  EXPECT_EQ(list->capacity, 64);
  EXPECT_EQ(list->count, 41);
  for (int i = 3; i < 40; ++i) EXPECT_EQ(list->elements[i], nullptr);
  EXPECT_EQ(list->elements[40], I(9));
  ListSetRealloc(list, I(7), 5);
  EXPECT_EQ(list->count, 41);
  EXPECT_EQ(list->elements[5], I(7));

  PortTest::Capture cap;
  ListSetRealloc(list, I(1), -1);
  ASSERT_EQ(cap.size(), 1u);
  EXPECT_EQ(cap[0].level, Port_Fatal);
  EXPECT_EQ(cap[0].text, "Data corruption (ListAddElt) - Negative index\n");
  EXPECT_EQ(list->count, 41);
  ListQuickDelete(&list);
}

TEST(ListCore, InsertAtEveryValidPositionAndRefuseOthers) {
  DomList* list = make({1, 2});
  EXPECT_EQ(ListInsertInList(list, I(7), 2), 1);
  EXPECT_EQ(items(list), (V{1, 7, 2}));
  EXPECT_EQ(ListInsertInList(list, I(8), 4), 1);
  EXPECT_EQ(items(list), (V{1, 7, 2, 8}));
  EXPECT_EQ(ListInsertInList(list, I(9), 1), 1);
  EXPECT_EQ(items(list), (V{9, 1, 7, 2, 8}));

  PortTest::Capture cap;
  EXPECT_EQ(ListInsertInList(list, I(5), 0), 0);
  EXPECT_EQ(ListInsertInList(list, I(5), 7), 0);
  EXPECT_EQ(ListInsertInList(nullptr, I(5), 1), 0);  // no list to insert into
  ASSERT_EQ(cap.size(), 3u);
  for (const Port_Report& r : cap.reports()) {
    EXPECT_EQ(r.level, Port_Error);
    EXPECT_EQ(r.text, "in ListInsertInList !!\n\n");
  }
  EXPECT_EQ(items(list), (V{9, 1, 7, 2, 8}));

  DomList* full = ListCreateWithSize(1);
  ListAddElt(full, I(1));
  EXPECT_EQ(ListInsertInList(full, I(2), 1), 1);  // insertion into a full array grows it
  EXPECT_EQ(items(full), (V{2, 1}));
  EXPECT_EQ(full->capacity, 2);
  ListQuickDelete(&full);
  ListQuickDelete(&list);
}

TEST(ListCore, RemovalsKeepOrderOrFillFromTheEnd) {
  DomList* list = make({1, 2, 3, 4});
  EXPECT_EQ(ListDelShift(list, 2), 1);
  EXPECT_EQ(items(list), (V{1, 3, 4}));
  ListQuickDelete(&list);
  list = make({1, 2, 3, 4});
  EXPECT_EQ(ListDelInsert(list, 2), 1);
  EXPECT_EQ(items(list), (V{1, 4, 3}));
  EXPECT_EQ(ListDelInsert(list, 3), 1);  // the last one
  EXPECT_EQ(items(list), (V{1, 4}));

  freed.clear();
  EXPECT_EQ(ListDelShiftFree(list, 1, recordFree), 1);
  EXPECT_EQ(ListDelInsertFree(list, 1, recordFree), 1);
  EXPECT_EQ(freed, (std::vector<int*>{I(1), I(4)}));
  EXPECT_EQ(list->count, 0);
  ListQuickDelete(&list);
}

TEST(ListCore, RemovalAtPositionZeroOrBelowIsANoOp) {
  DomList* list = make({1, 2});
  PortTest::Capture cap;
  freed.clear();
  EXPECT_EQ(ListDelShift(list, 0), 1);
  EXPECT_EQ(ListDelInsert(list, -3), 1);
  EXPECT_EQ(ListDelShiftFree(list, 0, recordFree), 1);
  EXPECT_EQ(ListDelInsertFree(nullptr, 0, recordFree), 1);
  EXPECT_EQ(ListDelShift(nullptr, 0), 1);
  EXPECT_EQ(items(list), (V{1, 2}));
  EXPECT_TRUE(freed.empty());
  EXPECT_EQ(cap.size(), 0u);
  ListQuickDelete(&list);
}

TEST(ListCore, BadIndexIsFatalAndChangesNothing) {
  DomList* list = make({1, 2, 3, 4});
  PortTest::Capture cap;
  freed.clear();
  EXPECT_EQ(ListDelShift(list, 5), 0);
  EXPECT_EQ(ListDelShiftFree(list, 5, recordFree), 0);
  EXPECT_EQ(ListDelInsert(list, 5), 0);
  EXPECT_EQ(ListDelInsertFree(list, 5, recordFree), 0);
  EXPECT_EQ(ListDelInsert(nullptr, 1), 0);
  EXPECT_EQ(ListDelInsertFree(nullptr, 1, recordFree), 0);
  EXPECT_EQ(ListDelShift(nullptr, 1), 0);  // a null list counts as empty
  EXPECT_EQ(ListDelShiftFree(nullptr, 2, recordFree), 0);
  const char* expected[] = {
      "Data corruption (ListDelShift) - Bad Index\n",
      "Data corruption (ListDelShiftFree) - Bad Index\n",
      "Data corruption (ListDelInsert) - Bad Index\n",
      "Data corruption (ListDelInsertFree) - Bad Index\n",
      "Data corruption (ListDelInsert) - Bad Index\n",
      "Data corruption (ListDelInsertFree) - Bad Index\n",
      "Data corruption (ListDelShift) - Bad Index\n",
      "Data corruption (ListDelShiftFree) - Bad Index\n",
  };
  ASSERT_EQ(cap.size(), 8u);
  for (size_t i = 0; i < 8; ++i) {
    EXPECT_EQ(cap[i].level, Port_Fatal);
    EXPECT_EQ(cap[i].unit, "../s/listutil");
    EXPECT_EQ(cap[i].text, expected[i]);
  }
  EXPECT_EQ(items(list), (V{1, 2, 3, 4}));
  EXPECT_TRUE(freed.empty());
  ListQuickDelete(&list);
}

static int sameParity(int* listElt, int* value) {
  return (reinterpret_cast<intptr_t>(listElt) & 1) == (reinterpret_cast<intptr_t>(value) & 1);
}

static std::vector<std::pair<int*, int*>> calls;
static int recordEqual(int* a, int* b, int* context) {
  calls.emplace_back(a, b);
  return a == b && context != nullptr;
}

TEST(ListCore, MembershipFindsTheFirstMatchWithTheElementFirst) {
  DomList* list = make({10, 20, 10, -5});
  EXPECT_EQ(ListMemberOfList(list, I(10)), 1);
  EXPECT_EQ(ListMemberOfList(list, I(20)), 2);
  EXPECT_EQ(ListMemberOfList(list, I(99)), 0);
  EXPECT_EQ(ListMemberOfList(nullptr, I(10)), 0);
  EXPECT_EQ(ListMemberOfList(list, I(3), sameParity), 4);
  EXPECT_EQ(ListMemberOfListInt(list, -5), 4);
  EXPECT_EQ(ListMemberOfListInt(nullptr, 10), 0);
  int ctx;
  calls.clear();
  EXPECT_EQ(ListContextualMemberOfList(list, I(20), recordEqual, &ctx), 2);
  ASSERT_EQ(calls.size(), 2u);
  EXPECT_EQ(calls[0], std::make_pair(I(10), I(20)));
  EXPECT_EQ(calls[1], std::make_pair(I(20), I(20)));
  ListQuickDelete(&list);
}

TEST(ListCore, CompactRemovesNullsAndKeepsCapacity) {
  DomList* list = make({1, 0, 2, 0});
  EXPECT_EQ(ListCompact(list), 2);
  EXPECT_EQ(items(list), (V{1, 2}));
  EXPECT_EQ(list->capacity, 16);
  EXPECT_EQ(ListCompact(nullptr), 0);
  ListQuickDelete(&list);
}

static int* doubleIt(int* e) { return I(reinterpret_cast<intptr_t>(e) * 2); }
static int* addContext(int* e, int* context) {
  return I(reinterpret_cast<intptr_t>(e) + *context);
}

TEST(ListCore, CopiesAndJoins) {
  DomList* src = make({1, 2, 3});
  DomList* copy = ListCopy(src, doubleIt);
  EXPECT_EQ(items(copy), (V{2, 4, 6}));
  EXPECT_EQ(copy->capacity, 3);
  int ten = 10;
  DomList* ctxCopy = ListContextualCopy(src, addContext, &ten);
  EXPECT_EQ(items(ctxCopy), (V{11, 12, 13}));
  DomList* shared = ListCopyNoEltCr(src);
  EXPECT_EQ(items(shared), items(src));
  EXPECT_NE(shared->elements, src->elements);
  DomList* empty = ListCreate();
  DomList* emptyCopy = ListCopy(empty, doubleIt);
  EXPECT_EQ(emptyCopy->capacity, 1);
  EXPECT_EQ(emptyCopy->count, 0);
  EXPECT_EQ(ListCopy(nullptr, doubleIt), nullptr);
  EXPECT_EQ(ListCopyNoEltCr(nullptr), nullptr);

  ListAdd(copy, src, doubleIt);
  EXPECT_EQ(items(copy), (V{2, 4, 6, 2, 4, 6}));
  EXPECT_EQ(copy->capacity, 6);
  ListAddNoEltCr(src, src);  // a list joined to itself
  EXPECT_EQ(items(src), (V{1, 2, 3, 1, 2, 3}));
  ListAppend(copy, &shared);
  EXPECT_EQ(shared, nullptr);
  EXPECT_EQ(items(copy), (V{2, 4, 6, 2, 4, 6, 1, 2, 3}));
  EXPECT_EQ(copy->capacity, 12);
  ListAppend(copy, &shared);  // null source: nothing
  ListAdd(copy, nullptr, doubleIt);
  ListAddNoEltCr(copy, nullptr);
  EXPECT_EQ(copy->count, 9);

  for (DomList** l : {&src, &copy, &ctxCopy, &empty, &emptyCopy}) ListQuickDelete(l);
}

TEST(ListCore, DeleteCallsTheFreeCallbackOnEverySlotInOrder) {
  DomList* list = make({1, 2, 3});
  freed.clear();
  ListDelete(&list, recordFree);
  EXPECT_EQ(list, nullptr);
  EXPECT_EQ(freed, (std::vector<int*>{I(1), I(2), I(3)}));
  ListDelete(&list, recordFree);  // null: nothing
  EXPECT_EQ(freed.size(), 3u);

  DomList* heap = ListCreate();
  for (int i = 0; i < 3; ++i) ListAddElt(heap, static_cast<int*>(vzl_malloc(8)));
  ListDelete(&heap, ListElemFree);  // ASan checks that every element is released

  static int seenContext = 0;
  list = make({4, 5});
  int ctx = 42;
  ListContextualDelete(
      &list, [](int**, int* context) { seenContext += *context; }, &ctx);
  EXPECT_EQ(seenContext, 84);
  EXPECT_EQ(list, nullptr);
}

TEST(ListCore, RecordsAreReusedAndKillStartsAFreshPool) {
  DomList* a = ListCreate();
  DomList* keep = a;
  ListQuickDelete(&a);
  DomList* b = ListCreate();
  EXPECT_EQ(b, keep);  // the released record comes back first
  EXPECT_EQ(b->count, 0);
  ListQuickDelete(&b);
  ListKill();
  DomList* c = ListCreateWithSize(3);
  ASSERT_NE(c, nullptr);
  ListAddElt(c, I(1));
  EXPECT_EQ(c->count, 1);
  ListQuickDelete(&c);
  ListKill();
}

TEST(ListCore, CreationFailuresAreFatalAndReturnNull) {
  PortTest::AllocFailureGuard guard;
  PortTest::Capture cap;
  DomList* warm = ListCreate();  // the record pool exists from here on
  ListQuickDelete(&warm);
  PortTest::FailNthAlloc(1);  // the element array
  EXPECT_EQ(ListCreateWithSize(4), nullptr);
  ListKill();
  PortTest::FailNthAlloc(1);  // the record pool itself
  EXPECT_EQ(ListCreate(), nullptr);
  EXPECT_EQ(ListCreateWithSize(-1), nullptr);
  ASSERT_EQ(cap.size(), 3u);
  EXPECT_EQ(cap[0].text, "Data corruption (ListCreateWithSize) - Memory Full\n");
  EXPECT_EQ(cap[1].text, "Data corruption (ListCreateWithSize) - Memory Full\n");
  EXPECT_EQ(cap[2].text, "Data corruption (ListCreateWithSize) - Negative index\n");
  for (const Port_Report& r : cap.reports()) EXPECT_EQ(r.level, Port_Fatal);
  // The record given back after a failed array is the next one handed out.
  DomList* list = ListCreate();
  ASSERT_NE(list, nullptr);
  ListQuickDelete(&list);
}

TEST(ListCore, GrowthFailureEndsTheSessionWithCode3) {
  PortTest::AllocFailureGuard guard;
  PortTest::Capture cap;
  static DomList* list;
  list = ListCreate();
  for (int i = 0; i < 16; ++i) ListAddElt(list, I(i));
  PortTest::FailAllAllocs();
  EXPECT_TRUE(ExitsToSession([] { ListAddElt(list, I(99)); }));
  EXPECT_EQ(MainEVarReturnStatus, 3);
  EXPECT_TRUE(ExitsToSession([] { ListSetRealloc(list, I(99), 100); }));
  MainEVarReturnStatus = 0;
  EXPECT_TRUE(ExitsToSession([] { ListInsertInList(list, I(99), 1); }));
  EXPECT_EQ(MainEVarReturnStatus, 3);
  ASSERT_EQ(cap.size(), 3u);
  for (const Port_Report& r : cap.reports()) {
    EXPECT_EQ(r.level, Port_Fatal);
    EXPECT_EQ(r.text, "Data corruption (ListAddElt) - Memory Full\n");
  }
  EXPECT_EQ(list->count, 16);
  EXPECT_EQ(list->capacity, 16);
  PortTest::ResetAllocFailures();
  ListQuickDelete(&list);
}

static std::string printed;
static void printCollect(FILE*, int* e) { printed += std::to_string(reinterpret_cast<intptr_t>(e)); }

TEST(ListCore, PrintSeparatesElementsOnly) {
  FILE* devnull = fopen("/dev/null", "w");
  MainEVarOutFile = devnull;
  PortTest::Capture cap;
  DomList* list = make({1, 2, 3});
  printed.clear();
  ListPrint(devnull, list, printCollect, ", ");
  EXPECT_EQ(printed, "123");
  EXPECT_EQ(cap.text(), ", , ");
  DomList* empty = ListCreate();
  ListPrint(devnull, empty, printCollect, ", ");
  ListPrint(devnull, nullptr, printCollect, ", ");
  int ctx = 0;
  ListContextualPrint(
      devnull, list, [](FILE*, int*, int* c) { ++*c; }, "/", &ctx);
  EXPECT_EQ(ctx, 3);
  EXPECT_EQ(cap.text(), ", , //");
  EXPECT_EQ(printed, "123");
  MainEVarOutFile = nullptr;
  fclose(devnull);
  ListQuickDelete(&list);
  ListQuickDelete(&empty);
}

TEST(ListCore, DisplayDumpsCapacityCountAndElements) {
  DomList* list = make({0x1f, 0x2});
  testing::internal::CaptureStdout();
  ListDisplay(list);
  std::string text = testing::internal::GetCapturedStdout();
  EXPECT_EQ(text.rfind("Taille 16, Elt 2, Adresse ", 0), 0u);
  EXPECT_NE(text.find("\n      1f       2\n"), std::string::npos);
  ListQuickDelete(&list);
}

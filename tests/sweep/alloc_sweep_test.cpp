// Allocation-failure sweep: each creating operation is run with its 1st, 2nd,
// ... allocation failing until it makes no more allocations than the one that
// fails, i.e. until it succeeds. Every failure must give the operation's own
// result (null, 0 or an unchanged object) with one of its reports, or, for a
// list that cannot grow, the Memory Full report and the exit to the session;
// never a crash. What was made is released after each attempt, so the
// sanitizer build's leak checker sees any block a failing operation lost.
// Inputs are small enough that no list built inside an operation has to grow
// (that exit would lose the partial result); growth is swept on lists the
// test owns.
#include <gtest/gtest.h>

#include <cstdlib>
#include <cstring>
#include <string>
#include <vector>

#include "duduzu/file.h"
#include "duduzu/list.h"
#include "duduzu/listset.h"
#include "duduzu/listsort.h"
#include "duduzu/mint.h"
#include "duduzu/param.h"
#include "duduzu/session.h"
#include "duduzu/str.h"
#include "duduzu/strlist.h"
#include "duduzu/strname.h"
#include "port/port_testing.h"
#include "support/session_test.h"

namespace {

const char kListMemory[] = "0:Data corruption (ListCreateWithSize) - Memory Full\n";
const char kGrowth[] = "0:Data corruption (ListAddElt) - Memory Full\n";
const char kMintNoInit[] = "4:Memory Full (Function MintCreateNoInit)\n";
const char kMintInit[] = "4:Memory Full (Function MintCreateInitValue)\n";
const char kMintCopy[] = "4:Memory Full (Function MintCopy)\n";
const char kParamCreate[] = "4:Memory Full (ParamCreateParam)\n";

// Inputs of the operation and what it made. Lists hold heap strings (made
// shares the elements of a and b; owned owns its own).
struct Held {
  DomList *a = nullptr, *b = nullptr, *made = nullptr, *owned = nullptr;
  char* text = nullptr;
  unsigned int* mint = nullptr;
  int cells = 0;  // of mint
  DomParam *param = nullptr, *copy = nullptr;
  int result = 0;
  char buffer[64];
} held;

unsigned int mintIn[3] = {0xF0F0F0F0u, 7u, 0x80000000u};

DomList* Strings(std::vector<const char*> texts, int capacity) {
  DomList* list = ListCreateWithSize(capacity);
  for (const char* t : texts) ListAddElt(list, reinterpret_cast<int*>(StrCopy(t)));
  return list;
}

void Release() {
  ListQuickDelete(&held.made);
  for (DomList** list : {&held.owned, &held.a, &held.b}) ListDelete(list, ListElemFree);
  StrFree(&held.text);
  vzl_free(held.mint);
  held.mint = nullptr;
  ParamFree(&held.param);
  ParamFree(&held.copy);
  ParamDefFree();
  held.result = held.cells = 0;
  held.buffer[0] = '\0';
}

int* Same(int* e) { return e; }
int Equal(int* x, int* y) { return strcmp(reinterpret_cast<char*>(x), reinterpret_cast<char*>(y)) == 0; }
int Compare(int* x, int* y) { return strcmp(reinterpret_cast<char*>(x), reinterpret_cast<char*>(y)); }

void SetAB() {
  held.a = Strings({"d", "a", "c", "b"}, 4);
  held.b = Strings({"c", "e"}, 4);
}
// A full list of one element: adding to it (null elements) must grow its array.
void SetFull() { held.a = Strings({"x"}, 1); }
void SetSorted() {
  SetAB();
  ListSelfSort(held.a, 1, Compare);
}

bool Text(const char* expected) { return held.text && strcmp(held.text, expected) == 0; }
bool Count(DomList* list, int n) { return list && list->count == n; }

struct Op {
  const char* name;
  void (*setup)();                   // null: nothing to set up
  void (*run)();                     // the operation, under the injected failure
  bool (*made)();                    // whether it succeeded, checked once failures are off
  std::vector<const char*> reports;  // the reports a failure may give ("" none)
  bool recovers = false;             // a failure may be worked around (with its report)
};

// One row per distinct allocation path; operations that only reach a path
// already swept here (copies, set operations and merges of one kind, wrappers
// over StrCopy or MintCreateNoInit) are left to their families' own tests.
const Op kOps[] = {
    // Lists.
    {"ListCreate", nullptr, [] { held.made = ListCreate(); }, [] { return Count(held.made, 0); }, {kListMemory}},
    {"ListCopy", SetAB, [] { held.made = ListCopy(held.a, Same); }, [] { return Count(held.made, 4); },
     {kListMemory}},
    {"ListAddElt", SetFull, [] { ListAddElt(held.a, nullptr); }, [] { return Count(held.a, 2); }, {}},
    {"ListUnionNoEltCr", SetAB, [] { held.made = ListUnionNoEltCr(held.a, held.b, Equal); },
     [] { return Count(held.made, 5); }, {kListMemory}},
    {"ListSort", SetAB, [] { held.made = ListSort(held.a, 1, Compare, Same); },
     [] { return Count(held.made, 4) && Compare(held.made->elements[0], held.made->elements[3]) < 0; },
     {kListMemory}, true},
    {"ListUnionOfSortedList", SetSorted, [] { held.made = ListUnionOfSortedList(held.a, held.b, Compare); },
     [] { return Count(held.made, 5); }, {kListMemory}},
    // Mints.
    {"MintCreateNoInit", nullptr, [] { held.mint = MintCreateNoInit(3); }, [] { return held.mint != nullptr; },
     {kMintNoInit}},
    {"MintCreateInitValue", nullptr, [] { held.mint = MintCreateInitValue(3, 9); },
     [] { return held.mint && held.mint[0] == 9; }, {kMintInit}},
    {"MintCopy", nullptr, [] { held.mint = MintCopy(mintIn, 3); },
     [] { return held.mint && MintIdentical(held.mint, mintIn, 3); }, {kMintCopy}},
    {"MintFromStrDecimal", nullptr,
     [] { held.result = MintFromStr("%D123456789012345678901234567890", &held.mint, &held.cells, 0); },
     [] { return held.result == 1 && held.mint && held.mint[0] == 0x4E3F0AD2u && held.cells == 4; },
     {kMintNoInit, ""}},
    {"MintToStrDecimal", nullptr, [] { MintToStr(mintIn, 3, 0, 10, 1, held.buffer); },
     [] { return strncmp(held.buffer, "%D", 2) == 0; }, {kMintCopy}},
    // Strings.
    {"StrCopy", nullptr, [] { held.text = StrCopy("abc"); }, [] { return Text("abc"); }, {""}},
    {"StrToWordList", nullptr, [] { held.owned = StrToWordList("a \"b c\" d", " "); },
     [] { return Count(held.owned, 3); }, {"", kListMemory}},
    {"StrCreateListIndexedStr", nullptr, [] { held.owned = StrCreateListIndexedStr("d", 0, 2); },
     [] { return Count(held.owned, 3); }, {"", kListMemory}},
    {"StrComposeName", nullptr,
     [] { held.text = StrComposeName(const_cast<char*>("src/top.v"), "out/", "_x", "vhd", 2); },
     [] { return Text("src/out/top_x.vhd"); }, {""}},
    {"StrReplaceEnvVariable", [] { setenv("DZ_SWEEP", "value", 1); },
     [] { held.text = StrReplaceEnvVariable(const_cast<char*>("$DZ_SWEEP/x")); },
     [] { return Text("value/x"); }, {""}},
    // Parameters.
    {"ParamCreateParam", nullptr, [] { held.param = ParamCreateParam("opt", "v"); },
     [] { return held.param != nullptr; }, {kParamCreate}},
    {"ParamCopy", [] { held.param = ParamCreateParam("opt", "v"); }, [] { held.copy = ParamCopy(held.param); },
     [] { return held.copy != nullptr; }, {"4:Memory Full (ParamCopy)\n"}},
    {"ParamCheckParamList", nullptr,
     [] {
       char params[] = "a -n 3 -f";
       held.result = ParamCheckParamList(const_cast<char*>("cmd"), params, const_cast<char*>("S -n I"),
                                         const_cast<char*>("-f"), &held.owned);
     },
     [] { return held.result == 1 && Count(held.owned, 3); }, {kListMemory, kParamCreate}},
    {"ParamDefSetInt", nullptr, [] { ParamDefSetInt("level", 5); }, [] { return ParamDefGetInt("level") == 5; },
     {kListMemory, kParamCreate}},
    // Temporary names: the random name, the path, the clean-up list's copy.
    {"FileCreateNameInTmpWithExtension", nullptr, [] { held.text = FileCreateNameInTmpWithExtension("v"); },
     [] { return held.text && strlen(held.text) == 10 && strcmp(held.text + 8, ".v") == 0; },
     {"", kListMemory}},
};

void PrintTo(const Op& op, std::ostream* os) { *os << op.name; }

std::string Reports(const PortTest::Capture& cap) {
  std::string all;
  for (const Port_Report& r : cap.reports()) all += std::to_string(r.level) + ":" + r.text;
  return all;
}

class AllocSweep : public testing::TestWithParam<Op> {};

TEST_P(AllocSweep, EachFailureGivesItsResultUntilTheOperationSucceeds) {
  const Op& op = GetParam();
  long n = 1;
  for (;; ++n) {
    ASSERT_LT(n, 100) << "no success";
    if (op.setup) op.setup();
    PortTest::Capture cap;
    MainEVarReturnStatus = 0;
    long before = PortTest::AllocCount();
    PortTest::FailNthAlloc(n);
    bool exited = ExitsToSession(op.run);
    PortTest::ResetAllocFailures();
    bool failed = PortTest::AllocCount() - before >= n;
    bool made = !exited && op.made();
    std::string reports = Reports(cap);
    Release();
    if (!failed) {
      EXPECT_TRUE(made) << op.name << " without a failure";
      EXPECT_EQ(reports, "");
      break;
    }
    SCOPED_TRACE(std::string(op.name) + ", allocation " + std::to_string(n) + " failed");
    if (exited) {
      EXPECT_EQ(reports, kGrowth);
      EXPECT_EQ(MainEVarReturnStatus, 3);
      continue;
    }
    EXPECT_TRUE(!made || op.recovers);
    bool documented = false;
    for (const char* r : op.reports) documented |= reports == r;
    EXPECT_TRUE(documented) << reports;
  }
  EXPECT_GT(n, 1) << op.name << " makes no allocation";
}

INSTANTIATE_TEST_SUITE_P(Creating, AllocSweep, testing::ValuesIn(kOps),
                         [](const testing::TestParamInfo<Op>& info) { return info.param.name; });

}  // namespace

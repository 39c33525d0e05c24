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

// Inputs of the operation and what it made. Lists hold heap strings (or, for
// a list sharing another's elements, nothing of their own).
struct Held {
  DomList* a = nullptr;
  DomList* b = nullptr;
  DomList* made = nullptr;   // shares the elements of a and b
  DomList* moved = nullptr;  // likewise, to be appended to made
  DomList* owned = nullptr;  // owns its elements
  char* text = nullptr;
  unsigned int* mint = nullptr;
  int cells = 0;  // of mint
  DomParam* param = nullptr;
  DomParam* copy = nullptr;
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
  ListQuickDelete(&held.moved);
  ListDelete(&held.owned, ListElemFree);
  ListDelete(&held.a, ListElemFree);
  ListDelete(&held.b, ListElemFree);
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
int* SameIn(int* e, int*) { return e; }
int Equal(int* x, int* y) {
  return strcmp(reinterpret_cast<char*>(x), reinterpret_cast<char*>(y)) == 0;
}
int Compare(int* x, int* y) {
  return strcmp(reinterpret_cast<char*>(x), reinterpret_cast<char*>(y));
}

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
void SetMoved() {
  SetAB();
  held.moved = ListCopyNoEltCr(held.a);
}
void SetText() { held.text = StrCopy("abc"); }
void SetParams() {
  char params[] = "a -n 3";
  ParamCheckParamList(const_cast<char*>("cmd"), params, const_cast<char*>("S -n I"),
                      const_cast<char*>(""), &held.owned);
}
void SetNothing() {}

bool Text(const char* expected) { return held.text && strcmp(held.text, expected) == 0; }
bool Count(DomList* list, int n) { return list && list->count == n; }
bool MintIs(unsigned int low, int cells) {
  return held.mint && held.mint[0] == low && held.cells == cells;
}

struct Op {
  const char* name;
  void (*setup)();
  void (*run)();                     // the operation, under the injected failure
  bool (*made)();                    // whether it succeeded, checked once failures are off
  std::vector<const char*> reports;  // the reports a failure may give ("" none)
  bool recovers = false;             // a failure may be worked around (with its report)
};

const Op kOps[] = {
    // Lists.
    {"ListCreate", SetNothing,
     [] { held.made = ListCreate(); }, [] { return Count(held.made, 0); }, {kListMemory}},
    {"ListCopy", SetAB,
     [] { held.made = ListCopy(held.a, Same); }, [] { return Count(held.made, 4); }, {kListMemory}},
    {"ListContextualCopy", SetAB,
     [] { held.made = ListContextualCopy(held.a, SameIn, nullptr); }, [] { return Count(held.made, 4); },
     {kListMemory}},
    {"ListCopyNoEltCr", SetAB,
     [] { held.made = ListCopyNoEltCr(held.a); }, [] { return Count(held.made, 4); }, {kListMemory}},
    {"ListAddElt", SetFull, [] { ListAddElt(held.a, nullptr); }, [] { return Count(held.a, 2); }, {}},
    {"ListSetRealloc", SetFull,
     [] { ListSetRealloc(held.a, nullptr, 40); }, [] { return Count(held.a, 41); }, {}},
    {"ListInsertInList", SetFull,
     [] { held.result = ListInsertInList(held.a, nullptr, 1); },
     [] { return held.result == 1 && Count(held.a, 2); }, {}},
    {"ListAddNoEltCr", SetAB,
     [] {
       held.made = ListCopyNoEltCr(held.b);
       if (held.made) ListAddNoEltCr(held.made, held.a);
     },
     [] { return Count(held.made, 6); }, {kListMemory}},
    {"ListAppend", SetMoved,
     [] {
       held.made = ListCopyNoEltCr(held.b);
       if (held.made) ListAppend(held.made, &held.moved);
     },
     [] { return Count(held.made, 6); }, {kListMemory}},
    {"ListUnionNoEltCr", SetAB,
     [] { held.made = ListUnionNoEltCr(held.a, held.b, Equal); }, [] { return Count(held.made, 5); },
     {kListMemory}},
    {"ListIntersectionNoEltCr", SetAB,
     [] { held.made = ListIntersectionNoEltCr(held.a, held.b, Equal); }, [] { return Count(held.made, 1); },
     {kListMemory}},
    {"ListComplement", SetAB,
     [] { held.made = ListComplement(held.a, held.b, Equal); }, [] { return Count(held.made, 3); },
     {kListMemory}},
    {"ListInverseNoEltCr", SetAB,
     [] { held.made = ListInverseNoEltCr(held.a); }, [] { return Count(held.made, 4); }, {kListMemory}},
    {"ListSort", SetAB,
     [] { held.made = ListSort(held.a, 1, Compare, Same); },
     [] {
       return Count(held.made, 4) && Compare(held.made->elements[0], held.made->elements[3]) < 0;
     },
     {kListMemory}, true},
    {"ListUnionOfSortedList", SetSorted,
     [] { held.made = ListUnionOfSortedList(held.a, held.b, Compare); }, [] { return Count(held.made, 5); },
     {kListMemory}},
    {"ListIntersectionOfSortedList", SetSorted,
     [] { held.made = ListIntersectionOfSortedList(held.a, held.b, Compare); },
     [] { return Count(held.made, 1); }, {kListMemory}},
    {"ListComplementOfSortedList", SetSorted,
     [] { held.made = ListComplementOfSortedList(held.a, held.b, Compare); },
     [] { return Count(held.made, 3); }, {kListMemory}},
    // Mints.
    {"MintCreateNoInit", SetNothing,
     [] { held.mint = MintCreateNoInit(3); }, [] { return held.mint != nullptr; }, {kMintNoInit}},
    {"MintCreateInitValue", SetNothing,
     [] { held.mint = MintCreateInitValue(3, 9); }, [] { return held.mint && held.mint[0] == 9; },
     {kMintInit}},
    {"MintCreateInit0", SetNothing,
     [] { held.mint = MintCreateInit0(3); }, [] { return held.mint && !MintNotNull(held.mint, 3); },
     {kMintInit}},
    {"MintCopy", SetNothing,
     [] { held.mint = MintCopy(mintIn, 3); }, [] { return held.mint && MintIdentical(held.mint, mintIn, 3); },
     {kMintCopy}},
    {"MintNOT", SetNothing,
     [] { held.mint = MintNOT(mintIn, 3); }, [] { return held.mint && held.mint[0] == ~mintIn[0]; },
     {kMintNoInit}},
    {"MintAND", SetNothing,
     [] { held.mint = MintAND(mintIn, mintIn, 3); },
     [] { return held.mint && MintIdentical(held.mint, mintIn, 3); }, {kMintNoInit}},
    {"MintOR", SetNothing,
     [] { held.mint = MintOR(mintIn, mintIn, 3); },
     [] { return held.mint && MintIdentical(held.mint, mintIn, 3); }, {kMintNoInit}},
    {"MintXNOR", SetNothing,
     [] { held.mint = MintXNOR(mintIn, mintIn, 3); }, [] { return held.mint && held.mint[2] == ~0u; },
     {kMintNoInit}},
    {"MintFromStrDecimal", SetNothing,
     [] {
       held.result = MintFromStr("%D123456789012345678901234567890", &held.mint, &held.cells, 0);
     },
     [] { return held.result == 1 && MintIs(0x4E3F0AD2u, 4); }, {kMintNoInit, ""}},
    {"MintFromStrHexa", SetNothing,
     [] { held.result = MintFromStr("8'hFF", &held.mint, &held.cells, 16); },
     [] { return held.result == 1 && MintIs(255, 1); }, {kMintNoInit}},
    {"MintToStrDecimal", SetNothing,
     [] { MintToStr(mintIn, 3, 0, 10, 1, held.buffer); }, [] { return strncmp(held.buffer, "%D", 2) == 0; },
     {kMintCopy}},
    // Strings.
    {"StrCopy", SetNothing, [] { held.text = StrCopy("abc"); }, [] { return Text("abc"); }, {""}},
    {"StrSafeCatPX", SetText, [] { StrSafeCatPX(&held.text, "def"); }, [] { return Text("abcdef"); }, {""}},
    {"StrRemoveChar", SetNothing,
     [] { held.text = StrRemoveChar(const_cast<char*>("a-b-c"), '-'); }, [] { return Text("abc"); }, {""}},
    {"StrRemoveCharInFront", SetNothing,
     [] { held.text = StrRemoveCharInFront(const_cast<char*>("--abc"), '-'); }, [] { return Text("abc"); },
     {""}},
    {"StrToWordList", SetNothing,
     [] { held.owned = StrToWordList("a \"b c\" d", " "); }, [] { return Count(held.owned, 3); },
     {"", kListMemory}},
    {"StrToTokenList", SetNothing,
     [] { held.owned = StrToTokenList("a,b;c", ",;"); }, [] { return Count(held.owned, 3); },
     {"", kListMemory}},
    {"StrStringToList", SetNothing,
     [] { held.owned = StrStringToList("a,,b,c", ',', "c"); }, [] { return Count(held.owned, 3); },
     {"", kListMemory}},
    {"StrInsertInList", SetAB,
     [] { held.result = StrInsertInList(held.b, const_cast<char*>("f")); }, [] { return held.result == 3; },
     {""}},
    {"StrListNicePrint", SetAB,
     [] { held.text = StrListNicePrint(held.a, ", ", "  ", 6); },
     [] { return Text("  d, \n  a, \n  c, \n  b"); }, {""}},
    {"StrAppendIndexToStr", SetNothing,
     [] { held.text = StrAppendIndexToStr("d", 12); }, [] { return Text("d12"); }, {""}},
    {"StrCatIndexToStrPX", SetText,
     [] { StrCatIndexToStrPX(&held.text, 7L); }, [] { return Text("abc7"); }, {""}},
    {"StrCreateListIndexedStr", SetNothing,
     [] { held.owned = StrCreateListIndexedStr("d", 0, 2); }, [] { return Count(held.owned, 3); },
     {"", kListMemory}},
    {"StrCreateListHDLIndexStr", SetNothing,
     [] { held.owned = StrCreateListHDLIndexStr("d", 1, 2); }, [] { return Count(held.owned, 2); },
     {"", kListMemory}},
    {"StrComposeName", SetNothing,
     [] { held.text = StrComposeName(const_cast<char*>("src/top.v"), "out/", "_x", "vhd", 2); },
     [] { return Text("src/out/top_x.vhd"); }, {""}},
    {"StrComposeBaseName", SetNothing,
     [] { held.text = StrComposeBaseName("dir/a.tar.gz"); }, [] { return Text("a"); }, {""}},
    {"StrReplaceEnvVariable", [] { setenv("DZ_SWEEP", "value", 1); },
     [] { held.text = StrReplaceEnvVariable(const_cast<char*>("$DZ_SWEEP/x")); },
     [] { return Text("value/x"); }, {""}},
    {"FileRemoveExtension", SetNothing,
     [] { held.text = FileRemoveExtension("dir/a.b"); }, [] { return Text("dir/a"); }, {""}},
    {"FileGetDirName", SetNothing,
     [] { held.text = FileGetDirName(const_cast<char*>("dir/a.b")); }, [] { return Text("dir/"); }, {""}},
    {"FileGetFileExtension", SetNothing,
     [] { held.text = FileGetFileExtension(const_cast<char*>("dir/a.b.c")); }, [] { return Text("c"); },
     {""}},
    // Parameters.
    {"ParamCreateParam", SetNothing,
     [] { held.param = ParamCreateParam("opt", "v"); }, [] { return held.param != nullptr; }, {kParamCreate}},
    {"ParamCopy", [] { held.param = ParamCreateParam("opt", "v"); },
     [] { held.copy = ParamCopy(held.param); }, [] { return held.copy != nullptr; },
     {"4:Memory Full (ParamCopy)\n"}},
    {"ParamCheckParamList", SetNothing,
     [] {
       char params[] = "a -n 3 -f";
       held.result =
           ParamCheckParamList(const_cast<char*>("cmd"), params, const_cast<char*>("S -n I"),
                               const_cast<char*>("-f"), &held.owned);
     },
     [] { return held.result == 1 && Count(held.owned, 3); }, {kListMemory, kParamCreate}},
    {"ParamTopCheckParamList", SetParams,
     [] {
       char params[] = "-n 3";
       held.result = ParamTopCheckParamList(held.owned, params);
     },
     [] { return held.result == 1; }, {kListMemory, kParamCreate}},
    {"ParamChangeParamValue", SetParams,
     [] { ParamChangeParamValue(held.owned, "n", "4"); },
     [] { return ParamFindParamValue(held.owned, "n", "4") == 1; }, {kParamCreate}},
    {"ParamFindNamedParam", SetParams,
     [] { held.text = ParamFindNamedParam(held.owned, "n"); }, [] { return Text("3"); }, {""}},
    {"ParamExtractWordFromStr", SetNothing,
     [] {
       char words[] = " \"a b\" c";
       char* cursor = words;
       held.text = ParamExtractWordFromStr(&cursor);
     },
     [] { return Text("a b"); }, {""}},
    {"ParamExtractWordFromStrWithQuote", SetNothing,
     [] {
       char words[] = " \"a b\" c";
       char* cursor = words;
       held.text = ParamExtractWordFromStrWithQuote(&cursor);
     },
     [] { return Text("\"a b\""); }, {""}},
    {"ParamDefSetInt", SetNothing,
     [] { ParamDefSetInt("level", 5); }, [] { return ParamDefGetInt("level") == 5; },
     {kListMemory, kParamCreate}},
    // Temporary names.
    {"FileRandomNameNoExtension", SetNothing,
     [] { held.text = FileRandomNameNoExtension(); },
     [] { return held.text && held.text[0] == 'p' && strlen(held.text) == 8; }, {""}},
    {"FileCreateNameInTmpWithExtension", SetNothing,
     [] { held.text = FileCreateNameInTmpWithExtension("v"); },
     [] { return held.text && strlen(held.text) == 10 && strcmp(held.text + 8, ".v") == 0; },
     {"", kListMemory}},
    {"FileCreateRandomName", SetNothing,
     [] { held.text = FileCreateRandomName(); }, [] { return held.text && strlen(held.text) == 12; },
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
    op.setup();
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

// Session variables, the exit to the session loop, the reporting convention and
// the main-output rule.
#include <gtest/gtest.h>

#include <cstdint>
#include <cstdio>
#include <string>
#include <tuple>

#include "duduzu/duduzu.h"
#include "port/port_testing.h"
#include "support/session_test.h"

TEST(Session, VariablesStartWithTheirStaticValues) {
  EXPECT_EQ(MainEVarMaxTime, 3600);
  EXPECT_EQ(MainEvarVzlMaxLoop, 7);
  for (int v : {MainEVarMorvelFF, MainEVarSameTechno, MainEVarVerbose, MainEVarReturnStatus,
                MainEVarMorvelDepth, MainEVarMorvelHMaps, MainEVarMorvelFMaps,
                MainEVarMorvelCLBNumber, MainEvarGraphicMode, MainEVarGkerb,
                NumberOfCallToListCreate, NumberOfCallToListDel, NumberOfCallToRealloc, EVarMaxMem})
    EXPECT_EQ(v, 0);
  EXPECT_EQ(MainEVarInFile, nullptr);
  EXPECT_EQ(MainEVarOutFile, nullptr);
  for (const char* p : {QelHdpIni, MainEVarEdifGeneratedBy, QelHdpDir, KERBTmpDir})
    EXPECT_EQ(p, nullptr);
}

TEST(Session, ExitToSessionStoresTheCodeAndUnwinds) {
  PortTest::Capture cap;
  EXPECT_TRUE(ExitsToSession([] { ExitToSession(3); }));
  EXPECT_EQ(MainEVarReturnStatus, 3);
  EXPECT_TRUE(ExitsToSession([] { ExitToSession(0); }));
  EXPECT_EQ(MainEVarReturnStatus, 6);
  EXPECT_EQ(cap.size(), 0u);  // nothing is printed on the way
}

static void printInt(FILE* stream, int* e) {
  fprintf(stream, "<%d>", static_cast<int>(reinterpret_cast<intptr_t>(e)));
}

static std::string contents(FILE* f) {
  char text[64] = {};
  rewind(f);
  return fgets(text, sizeof text, f) ? text : "";
}

TEST(MainOutput, WritesToMainOutFileBecomeStatusReportsOthersGoToTheirStream) {
  DomList* list = ListCreate();
  for (intptr_t i = 1; i <= 3; ++i) ListAddElt(list, reinterpret_cast<int*>(i));
  FILE* s = tmpfile();
  FILE* t = tmpfile();
  MainEVarOutFile = s;
  PortTest::Capture cap;
  ListPrint(s, list, printInt, ", ");
  ListPrint(t, list, printInt, ", ");  // another stream: plain writes
  ASSERT_EQ(cap.size(), 2u);
  for (const Port_Report& r : cap.reports()) {
    EXPECT_EQ(std::make_tuple(r.level, r.text, r.module, r.unit, r.revision),
              std::make_tuple(Port_Status, std::string(", "), std::string("DuduzuRorez"),
                              std::string("../s/listutil"), std::string("$Revision: 1.1 $")));
    EXPECT_GT(r.line, 0);
  }
  EXPECT_EQ(contents(t), "<1>, <2>, <3>");
  EXPECT_EQ(contents(s), "<1><2><3>");  // the callback writes; separators went to the reports
  // A null stream while MainEVarOutFile is null is the main output too.
  MainEVarOutFile = nullptr;
  cap.clear();
  IntPrint(nullptr, 42);
  ASSERT_EQ(cap.size(), 1u);
  EXPECT_EQ(std::make_pair(cap[0].level, cap[0].text), std::make_pair(Port_Status, std::string("42")));
  fclose(s);
  fclose(t);
  ListQuickDelete(&list);
}

TEST(Session, EndOfSessionReleasesAreSafeInAnyOrder) {
  ParamDefSetStr("depth", "3");
  FILE* f = FOPEN("/dev/null", "r");
  FileAddFileNameForCleanOnExit(const_cast<char*>("never-made.tmp"));
  ListKill();  // releases the library's own lists first; ASan and LSan watch the rest
  ParamDefFree();
  FileRemoveAllFilesInTmp();
  EXPECT_EQ(ParamDefGetStr("depth"), nullptr);
  ParamDefSetStr("depth", "4");  // the next session starts afresh
  char* v = ParamDefGetStr("depth");
  EXPECT_STREQ(v, "4");
  StrFree(&v);
  ParamDefFree();
  fclose(f);
}

// Session variables, the exit to the session loop, the reporting convention and
// the main-output rule.
#include <gtest/gtest.h>

#include <cstdint>
#include <cstdio>

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

TEST(MainOutput, WritesToMainOutFileBecomeStatusReports) {
  DomList* list = ListCreate();
  for (intptr_t i = 1; i <= 3; ++i) ListAddElt(list, reinterpret_cast<int*>(i));
  FILE* s = tmpfile();
  FILE* t = tmpfile();
  MainEVarOutFile = s;
  {
    PortTest::Capture cap;
    ListPrint(s, list, printInt, ", ");
    ASSERT_EQ(cap.size(), 2u);
    for (const Port_Report& r : cap.reports()) {
      EXPECT_EQ(r.level, Port_Status);
      EXPECT_EQ(r.text, ", ");
      EXPECT_EQ(r.module, "DuduzuRorez");
      EXPECT_EQ(r.unit, "../s/listutil");
      EXPECT_EQ(r.revision, "$Revision: 1.1 $");
      EXPECT_GT(r.line, 0);
    }
    ListPrint(t, list, printInt, ", ");  // another stream: plain writes
    EXPECT_EQ(cap.size(), 2u);
  }
  char text[64] = {};
  rewind(t);
  ASSERT_NE(fgets(text, sizeof text, t), nullptr);
  EXPECT_STREQ(text, "<1>, <2>, <3>");
  rewind(s);
  ASSERT_NE(fgets(text, sizeof text, s), nullptr);
  EXPECT_STREQ(text, "<1><2><3>");  // the callback writes; separators went to the reports
  MainEVarOutFile = nullptr;
  fclose(s);
  fclose(t);
  ListQuickDelete(&list);
}

static void printNothing(FILE*, int*) {}

TEST(MainOutput, NullStreamWithNullMainOutFileIsAStatusReport) {
  DomList* list = ListCreate();
  ListAddElt(list, nullptr);
  ListAddElt(list, nullptr);
  PortTest::Capture cap;
  ListPrint(nullptr, list, printNothing, "|");
  ASSERT_EQ(cap.size(), 1u);
  EXPECT_EQ(cap[0].level, Port_Status);
  EXPECT_EQ(cap[0].text, "|");
  ListQuickDelete(&list);
}

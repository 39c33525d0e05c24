#include <gtest/gtest.h>

#include "duduzu/param.h"
#include "duduzu/qelmsg.h"
#include "duduzu/redirect.h"
#include "file/file_test_util.h"
#include "support/msg_outputs.h"
#include "support/session_test.h"

// A status report through the dispatcher, as any unit of a tool makes it.
static void Say(const char* text) { Port_MsgManData::createObject("T", "t", 1, "")->issueStatus("%s", text); }

static void Out(const char* text) { fputs(text, MainEVarOutFile), fflush(MainEVarOutFile); }

TEST(SetQelMsgMan, AttachesTheConsoleAndTheLogWithIntegrationStyleOnlyWithALog) {
  TempDir dir;
  std::string log = dir / "run.log", bad = dir / "no/run.log";
  Port_MsgMan* const original = Port_MsgDispatcher::getDefaultMsgMan();
  const std::string ignored = "1:No log file : `-intstyle\" ignored.\n";
  struct Case {
    const std::string* name;
    bool intStyle, noLatch;
    std::string types, reports, logText;  // the quiet status reaches the log in quiet mode only
  } const cases[] = {
      {nullptr, false, false, "c012345678", "", "old\n"},
      {&log, true, false, "c04568 f012345678", "", "quiet\nlogged\n"},
      {&log, true, true, "c04568 f012345678", "", "logged\n"},
      {nullptr, true, false, "c012345678", ignored, "old\n"},
      {&bad, true, false, "c012345678", "4:unable to open log file '" + bad + "'\n" + ignored, "old\n"},
  };
  for (const auto& c : cases) {
    SCOPED_TRACE(&c - cases);
    WriteFile(log, "old\n");
    PortTest::Capture cap;
    SetQelMsgMan(c.name ? std::string(*c.name).data() : nullptr, c.intStyle, c.noLatch);
    EXPECT_EQ(Reports(cap) + TypesOn(), c.reports + c.types);
    EXPECT_EQ(Port_MsgDispatcher::getMaxLineWidth(), 1024);
    Qel_Msg::QuietStatus("quiet\n");
    Say("logged\n");
    UnsetQelMsgMan();
    EXPECT_EQ(Port_MsgDispatcher::getDefaultMsgMan(), original);
    EXPECT_EQ(ReadFile(log), c.logText);
  }
}

TEST(FileRedirectMainOutFile, NestedFilesTakeEverythingInTurnAFailedOneChangesNothingAndRestoreFilters) {
  TempDir dir;
  std::string setup = dir / "setup.log", a = dir / "a.log", b = dir / "b.log", bad = dir / "no/x.log";
  WriteFile(a, "old\n");
  FILE* tool = MainEVarOutFile = tmpfile();
  int fds = OpenFdCount();
  SetQelMsgMan(setup.data(), true, false);  // integration style: the console filtered
  PortTest::Capture cap;
  EXPECT_TRUE(ExitsToSession([&] { FileRedirectMainOutFile(bad.data()); }) && MainEVarOutFile == tool);
  EXPECT_EQ(std::to_string(MainEVarReturnStatus) + Reports(cap), "14:Something wrong when opening logfile : " + bad + "\n");
  Say("s0\n");
  FileRedirectMainOutFile(a.data());
  Out("a-out\n");
  Say("a1\n");
  FileRedirectMainOutFile(b.data());
  EXPECT_EQ(TypesOn(), "f012345678");
  Say("b1\n");
  Out("b-out\n");
  FileRestoreOldMainOutFile();
  EXPECT_EQ(TypesOn(), "f012345678");  // the console waits for the outer restore
  Say("a2\n");
  FileRestoreOldMainOutFile();
  EXPECT_EQ(TypesOn(), "c04568 f012345678");  // filtered again
  Say("s1\n");
  FileRestoreOldMainOutFile();  // nothing left to restore: the tool's stream stays open
  Out("t\n");
  Qel_Msg::QuietEnableScreen();  // then a restore leaves the console unfiltered
  FileRedirectMainOutFile(b.data());
  FileRestoreOldMainOutFile();
  EXPECT_EQ(TypesOn(), "c012345678 f012345678");
  UnsetQelMsgMan();
  EXPECT_EQ(OpenFdCount(), fds);
  EXPECT_EQ(ReadFile(setup), "ERROR:DuduzuRorez - Something wrong when opening logfile : " + bad + "\ns0\ns1\n");
  EXPECT_EQ(ReadFile(a), "old\na-out\na1\na2\n");
  EXPECT_EQ(ReadFile(b), "b1\nb-out\n");
  EXPECT_EQ(StreamText(tool), "t\n");
}

TEST(FileCopyInterf, CopiesIfnToOfnOrSaysWhyNot) {
  TempDir dir;
  std::string src = dir / "src.txt", dst = dir / "dst.txt", missing = dir / "missing.txt";
  WriteFile(src, "data\n");
  std::vector<std::pair<std::vector<std::pair<const char*, std::string>>, std::string>> cases = {
      {{{"ofn", dst}}, "0 2:Missing -ifn parameter\n"},
      {{{"IFN", src}}, "0 2:Missing -ofn parameter\n"},
      {{{"ifn", missing}, {"ofn", dst}}, "0 2:Copy (" + missing + " -> " + dst + ") operation failed\n"},
      {{{"Ifn", src}, {"OFN", dst}}, "1 "}};
  PortTest::Capture cap;
  for (const auto& [params, want] : cases) {
    DomList* list = ListCreate();
    for (auto& p : params) ListAddElt(list, reinterpret_cast<int*>(ParamCreateParam(p.first, p.second.c_str())));
    int result = FileCopyInterf(list);
    EXPECT_EQ(std::to_string(result) + " " + Reports(cap), want);
    ListDelete(&list, [](int** slot) { ParamFree(reinterpret_cast<DomParam**>(slot)); });
  }
  EXPECT_EQ(ReadFile(dst), "data\n");
}

#include <gtest/gtest.h>

#include <string>
#include <utility>
#include <vector>

#include "duduzu/param.h"
#include "duduzu/qelmsg.h"
#include "duduzu/redirect.h"
#include "file/file_test_util.h"
#include "port/port_testing.h"
#include "support/msg_outputs.h"
#include "support/session_test.h"
#include "support/temp_dir.h"

namespace {

// A status report through the dispatcher, as any unit of a tool makes it.
void Say(const char* text) {
  Port_MsgManData::createObject("T", "t", 1, "")->issueStatus("%s", text);
}

void Out(const char* text) {
  fputs(text, MainEVarOutFile);
  fflush(MainEVarOutFile);
}

// The reports so far as "level:text", all from the file unit; clears them.
std::string TaggedReports(PortTest::Capture& cap) {
  std::string s;
  for (const Port_Report& r : cap.reports())
    s += (r.unit == "../s/fileutil" ? "" : r.unit) + std::to_string(int(r.level)) + ":" + r.text;
  cap.clear();
  return s;
}

}  // namespace

TEST(SetQelMsgMan, AttachesTheConsoleAndTheLogWithIntegrationStyleOnlyWithALog) {
  TempDir dir;
  std::string log = dir / "run.log", bad = dir / "no/run.log";
  Port_MsgMan* const original = Port_MsgDispatcher::getDefaultMsgMan();
  const std::string ignored = "1:No log file : `-intstyle\" ignored.\n";
  struct {
    const std::string* name;
    bool intStyle, noLatch;
    std::string types, reports, logText;  // the quiet status reaches the log in quiet mode only
  } cases[] = {
      {nullptr, false, false, "c012345678", "", "old\n"},
      {&log, true, false, "c04568 f012345678", "", "quiet\nlogged\n"},
      {&log, true, true, "c04568 f012345678", "", "logged\n"},
      {nullptr, true, false, "c012345678", ignored, "old\n"},
      {&bad, true, false, "c012345678", "4:unable to open log file '" + bad + "'\n" + ignored,
       "old\n"},
  };
  for (const auto& c : cases) {
    SCOPED_TRACE(&c - cases);
    WriteFile(log, "old\n");
    PortTest::Capture cap;
    SetQelMsgMan(c.name ? std::string(*c.name).data() : nullptr, c.intStyle, c.noLatch);
    EXPECT_EQ(TaggedReports(cap), c.reports);
    EXPECT_EQ(TypesOn(), c.types);
    EXPECT_EQ(Port_MsgDispatcher::getMaxLineWidth(), 1024);
    Qel_Msg::QuietStatus("quiet\n");
    Say("logged\n");
    UnsetQelMsgMan();
    EXPECT_EQ(Port_MsgDispatcher::getDefaultMsgMan(), original);
    EXPECT_EQ(ReadFile(log), c.logText);
  }
  PortTest::Capture after;
  Qel_Msg::QuietAndLogStatus("after\n");  // message control no longer has a stream
  EXPECT_EQ(after.size(), 0u);
}

TEST(FileRedirectMainOutFile, NestedFilesTakeEverythingInTurnAndAFailedOneChangesNothing) {
  TempDir dir;
  std::string setup = dir / "setup.log", a = dir / "a.log", b = dir / "b.log";
  std::string bad = dir / "no/x.log";
  WriteFile(a, "old\n");
  FILE* tool = MainEVarOutFile = tmpfile();
  int fds = OpenFdCount();
  SetQelMsgMan(setup.data(), false, false);
  PortTest::Capture cap;
  EXPECT_TRUE(ExitsToSession([&] { FileRedirectMainOutFile(bad.data()); }));
  EXPECT_EQ(MainEVarReturnStatus, 1);
  EXPECT_EQ(TaggedReports(cap), "4:Something wrong when opening logfile : " + bad + "\n");
  EXPECT_EQ(MainEVarOutFile, tool);
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
  EXPECT_EQ(MainEVarOutFile, tool);
  EXPECT_EQ(TypesOn(), "c012345678 f012345678");
  Say("s1\n");
  FileRestoreOldMainOutFile();  // nothing left to restore: the tool's stream stays open
  Out("t\n");
  UnsetQelMsgMan();
  EXPECT_EQ(OpenFdCount(), fds);
  EXPECT_EQ(ReadFile(setup), "ERROR:DuduzuRorez - Something wrong when opening logfile : " + bad +
                                 "\ns0\ns1\n");
  EXPECT_EQ(ReadFile(a), "old\na-out\na1\na2\n");
  EXPECT_EQ(ReadFile(b), "b1\nb-out\n");
  EXPECT_EQ(StreamText(tool), "t\n");
  fclose(tool);
}

TEST(FileRestoreOldMainOutFile, IntegrationStyleFiltersTheConsoleAgainUnlessQuietScreenIsOpen) {
  TempDir dir;
  std::string setup = dir / "setup.log", a = dir / "a.log";
  auto cycle = [&] {
    FileRedirectMainOutFile(a.data());
    FileRestoreOldMainOutFile();
    return TypesOn();
  };
  SetQelMsgMan(setup.data(), true, false);
  EXPECT_EQ(cycle(), "c04568 f012345678");
  Qel_Msg::QuietEnableScreen();
  EXPECT_EQ(cycle(), "c012345678 f012345678");
  UnsetQelMsgMan();
  SetQelMsgMan(setup.data(), false, true);  // no latch alone: filtered from the first restore
  EXPECT_EQ(TypesOn(), "c012345678 f012345678");
  EXPECT_EQ(cycle(), "c04568 f012345678");
  UnsetQelMsgMan();
  SetQelMsgMan(setup.data(), false, false);
  EXPECT_EQ(cycle(), "c012345678 f012345678");
  UnsetQelMsgMan();
}

TEST(FileCopyInterf, CopiesIfnToOfnOrSaysWhyNot) {
  TempDir dir;
  std::string src = dir / "src.txt", dst = dir / "dst.txt", missing = dir / "missing.txt";
  WriteFile(src, "data\n");
  struct {
    std::vector<std::pair<const char*, std::string>> params;
    int result;
    std::string reports;
  } cases[] = {
      {{{"ofn", dst}}, 0, "2:Missing -ifn parameter\n"},
      {{{"IFN", src}}, 0, "2:Missing -ofn parameter\n"},
      {{{"ifn", missing}, {"ofn", dst}}, 0,
       "2:Copy (" + missing + " -> " + dst + ") operation failed\n"},
      {{{"Ifn", src}, {"OFN", dst}}, 1, ""},
  };
  PortTest::Capture cap;
  for (const auto& c : cases) {
    SCOPED_TRACE(&c - cases);
    DomList* list = ListCreate();
    for (auto& p : c.params)
      ListAddElt(list, reinterpret_cast<int*>(ParamCreateParam(p.first, p.second.c_str())));
    EXPECT_EQ(FileCopyInterf(list), c.result);
    EXPECT_EQ(TaggedReports(cap), c.reports);
    ListDelete(&list, [](int** slot) { ParamFree(reinterpret_cast<DomParam**>(slot)); });
  }
  EXPECT_EQ(ReadFile(dst), "data\n");
}

#include <gtest/gtest.h>

#include <string>
#include <utility>
#include <vector>

#include "duduzu/file.h"
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
  Port_MsgManData::createObject("Tool", "tool", 1, "")->issueStatus("%s", text);
}

// Main output written straight to MainEVarOutFile.
void Out(const char* text) {
  fputs(text, MainEVarOutFile);
  fflush(MainEVarOutFile);
}

// The reports since the last call as "level:text", all from the file unit.
std::string Reports(PortTest::Capture& cap) {
  std::string s;
  for (const Port_Report& r : cap.reports()) {
    EXPECT_EQ(r.unit, "../s/fileutil");
    s += std::to_string(static_cast<int>(r.level)) + ":" + r.text;
  }
  cap.clear();
  return s;
}

}  // namespace

TEST(SetQelMsgMan, AttachesTheConsoleAndTheLogWithIntegrationStyleOnlyWithALog) {
  TempDir dir;
  std::string log = dir / "run.log", bad = dir / "no/run.log";
  Port_MsgMan* const original = Port_MsgDispatcher::getDefaultMsgMan();
  const char* const ignored = "1:No log file : `-intstyle\" ignored.\n";
  struct Case {
    const std::string* name;
    bool intStyle, noLatch;
    std::string types, reports, logText;  // logText: quiet mode shows in the quiet status
  } cases[] = {
      {nullptr, false, false, "c012345678", "", "old\n"},
      {&log, true, false, "c04568 f012345678", "", "quiet\nlogged\n"},
      {&log, true, true, "c04568 f012345678", "", "logged\n"},
      {nullptr, true, false, "c012345678", ignored, "old\n"},
      {&bad, true, false, "c012345678", "4:unable to open log file '" + bad + "'\n" + ignored,
       "old\n"},
  };
  for (const Case& c : cases) {
    SCOPED_TRACE(c.types + (c.name ? *c.name : "") + (c.intStyle ? " intStyle" : "") +
                 (c.noLatch ? " noLatch" : ""));
    WriteFile(log, "old\n");
    PortTest::Capture cap;
    SetQelMsgMan(c.name ? std::string(*c.name).data() : nullptr, c.intStyle, c.noLatch);
    EXPECT_EQ(Reports(cap), c.reports);
    EXPECT_EQ(TypesOn(), c.types);
    EXPECT_EQ(Port_MsgDispatcher::getMaxLineWidth(), 1024);
    Qel_Msg::QuietStatus("quiet\n");
    Say("logged\n");
    UnsetQelMsgMan();
    EXPECT_EQ(Port_MsgDispatcher::getDefaultMsgMan(), original);
    EXPECT_EQ(ReadFile(log), c.logText);
    cap.clear();
    Qel_Msg::QuietAndLogStatus("after\n");  // no stream any more: nothing
    EXPECT_EQ(cap.size(), 0u);
  }
}

TEST(FileRedirectMainOutFile, NestedRedirectionsWriteOnlyToTheInnermostFile) {
  TempDir dir;
  std::string setup = dir / "setup.log", a = dir / "a.log", b = dir / "b.log";
  WriteFile(a, "old\n");
  FILE* tool = tmpfile();
  MainEVarOutFile = tool;
  int fds = OpenFdCount();
  SetQelMsgMan(setup.data(), false, false);
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
  Out("a-out2\n");
  FileRestoreOldMainOutFile();
  EXPECT_EQ(MainEVarOutFile, tool);
  EXPECT_EQ(TypesOn(), "c012345678 f012345678");
  Say("s1\n");
  FileRestoreOldMainOutFile();  // nothing left to restore: the tool's stream stays open
  EXPECT_EQ(MainEVarOutFile, tool);
  Out("t\n");
  UnsetQelMsgMan();
  EXPECT_EQ(OpenFdCount(), fds);
  EXPECT_EQ(ReadFile(setup), "s0\ns1\n");
  EXPECT_EQ(ReadFile(a), "old\na-out\na1\na2\na-out2\n");
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
  SetQelMsgMan(setup.data(), false, true);  // no latch alone: not filtered until a restore
  EXPECT_EQ(TypesOn(), "c012345678 f012345678");
  EXPECT_EQ(cycle(), "c04568 f012345678");
  UnsetQelMsgMan();
  SetQelMsgMan(setup.data(), false, false);
  EXPECT_EQ(cycle(), "c012345678 f012345678");
  UnsetQelMsgMan();
}

TEST(FileRedirectMainOutFile, UnopenableTargetEndsTheSessionWithStatus1AndOutputsKept) {
  TempDir dir;
  std::string setup = dir / "setup.log", bad = dir / "no/x.log";
  SetQelMsgMan(setup.data(), false, false);
  PortTest::Capture cap;
  MainEVarOutFile = stdout;
  MainEVarReturnStatus = 0;
  EXPECT_TRUE(ExitsToSession([&] { FileRedirectMainOutFile(bad.data()); }));
  EXPECT_EQ(MainEVarReturnStatus, 1);
  EXPECT_EQ(Reports(cap), "4:Something wrong when opening logfile : " + bad + "\n");
  EXPECT_EQ(TypesOn(), "c012345678 f012345678");
  EXPECT_EQ(MainEVarOutFile, stdout);
  Say("kept\n");
  UnsetQelMsgMan();
  EXPECT_EQ(ReadFile(setup),
            "ERROR:DuduzuRorez - Something wrong when opening logfile : " + bad + "\nkept\n");
}

TEST(FileCopyInterf, CopiesIfnToOfnOrSaysWhyNot) {
  TempDir dir;
  std::string src = dir / "src.txt", dst = dir / "dst.txt", missing = dir / "missing.txt";
  WriteFile(src, "data\n");
  struct Case {
    std::vector<std::pair<const char*, std::string>> params;  // none: no list at all
    int result;
    std::string reports;
  } cases[] = {
      {{}, 0, "2:Missing -ifn parameter\n"},
      {{{"ofn", dst}}, 0, "2:Missing -ifn parameter\n"},
      {{{"IFN", src}}, 0, "2:Missing -ofn parameter\n"},
      {{{"ifn", missing}, {"ofn", dst}}, 0,
       "2:Copy (" + missing + " -> " + dst + ") operation failed\n"},
      {{{"Ifn", src}, {"OFN", dst}}, 1, ""},
  };
  PortTest::Capture cap;
  for (const Case& c : cases) {
    SCOPED_TRACE(c.reports);
    DomList* list = c.params.empty() ? nullptr : ListCreate();
    for (auto& p : c.params)
      ListAddElt(list, reinterpret_cast<int*>(ParamCreateParam(p.first, p.second.c_str())));
    EXPECT_EQ(FileCopyInterf(list), c.result);
    EXPECT_EQ(Reports(cap), c.reports);
    ListDelete(&list, [](int** slot) { ParamFree(reinterpret_cast<DomParam**>(slot)); });
  }
  EXPECT_EQ(ReadFile(dst), "data\n");
}

// Message control: type switches without nesting, quiet mode, direct status
// lines, warnings once per format text.
#include <gtest/gtest.h>

#include <string>

#include "duduzu/qelmsg.h"
#include "duduzu/redirect.h"
#include "port/port_testing.h"
#include "support/msg_outputs.h"
#include "support/temp_dir.h"

namespace {

class QelMsg : public ::testing::Test {
 protected:
  void TearDown() override { UnsetQelMsgMan(); }
  TempDir dir;
  std::string path = dir / "qelmsg.log";
  PortTest::Capture cap;
};

// The types on for each output, and whether quiet mode's screen is open.
std::string State() { return TypesOn() + (Qel_Msg::IsQuietEnableScreen() ? " open" : ""); }

TEST_F(QelMsg, SwitchesHaveNoNestingAndQuietModeOwnsTheScreenTypes) {
  SetQelMsgMan(path.data(), false, false);
  Qel_Msg::QuietStatus("quiet\n");  // not in quiet mode: nothing
  Qel_Msg::QuietAndLogStatus("log %s\n", "x");
  Qel_Msg::Disable();
  Qel_Msg::Disable();
  EXPECT_EQ(State(), "c f");
  Qel_Msg::QuietAndLogStatus("off\n");
  Qel_Msg::Enable();  // no nesting: on again, as the log shows below
  Qel_Msg::DisableScreen();
  Qel_Msg::Enable();             // messages are on already: nothing to do
  Qel_Msg::QuietEnableScreen();  // outside quiet mode: nothing
  EXPECT_EQ(State(), "c f012345678");
  Qel_Msg::EnableScreen();
  Qel_Msg::QuietDisableScreen();
  EXPECT_EQ(State(), "c012345678 f012345678");
  UnsetQelMsgMan();
  SetQelMsgMan(path.data(), true, false);  // integration style with a log: quiet mode
  Qel_Msg::QuietStatus("quiet %d\n", 2);
  Qel_Msg::Disable();
  Qel_Msg::Enable();
  EXPECT_EQ(State(), "c04568 f012345678");
  EXPECT_EQ(cap.text(Port_Status), "log x\nquiet 2\n");
  EXPECT_EQ(cap[0].module + cap[0].unit + cap[0].revision, "DuduzuRorez../s/qelmsg$Revision: 1.1 $");
  Qel_Msg::QuietEnableScreen();
  EXPECT_EQ(State(), "c012345678 f012345678 open");
  Qel_Msg::QuietDisableScreen();
  EXPECT_EQ(State(), "c0145678 f012345678");
}

TEST_F(QelMsg, WarnOnceIssuesOncePerFormatTextOnlyWithAStream) {
  Qel_Msg::WarnOnce("w %d\n", 0);
  SetQelMsgMan(path.data(), false, false);
  Qel_Msg::WarnOnce("w %d\n", 1);
  std::string buffer = "v%d\n";
  Qel_Msg::WarnOnce(buffer.c_str(), 1);
  buffer[0] = 'u';  // the same buffer with another text is another warning
  Qel_Msg::WarnOnce(buffer.c_str(), 2);
  Qel_Msg::Disable();
  Qel_Msg::WarnOnce("v%d\n", 3);
  Qel_Msg::WarnOnce("d\n");  // recorded, but shown nowhere
  Qel_Msg::Enable();
  Qel_Msg::WarnOnce("d\n");
  EXPECT_EQ(cap.text(Port_Warning), "w 1\nv1\nu2\nd\n");
  ASSERT_EQ(cap.size(), 8u);
  EXPECT_EQ(cap[1].unit + cap[1].text, "../s/qelmsgLast warning will be issued only once.\n");
  EXPECT_EQ(ReadFile(path), Port_FormatReport(cap[0]) + cap[1].text + Port_FormatReport(cap[2]) +
                              cap[3].text + Port_FormatReport(cap[4]) + cap[5].text);
}

}  // namespace

// Message control: type switches without nesting, quiet mode, direct status
// lines, warnings once per format text.
#include <gtest/gtest.h>

#include <cstring>

#include "duduzu/qelmsg.h"
#include "duduzu/redirect.h"
#include "port/port_testing.h"
#include "support/msg_outputs.h"
#include "support/temp_dir.h"

namespace {

class QelMsg : public ::testing::Test {
 protected:
  // A fresh set-up with the log: integration style gives quiet mode, or with
  // noLatch only its console filter.
  void install(bool intStyle, bool noLatch = false) {
    if (InstalledStream()) UnsetQelMsgMan();
    SetQelMsgMan(path.data(), intStyle, noLatch);
  }
  void TearDown() override { UnsetQelMsgMan(); }
  TempDir dir;
  std::string path = dir / "qelmsg.log";
  PortTest::Capture cap;
};

TEST_F(QelMsg, SwitchesHaveNoNestingAndSpareQuietModesScreenTypes) {
  install(false);
  Qel_Msg::Disable();
  Qel_Msg::Disable();
  EXPECT_EQ(TypesOn(), "c f");
  Qel_Msg::QuietAndLogStatus("hidden\n");
  Qel_Msg::Enable();
  Qel_Msg::QuietAndLogStatus("shown %d\n", 1);
  EXPECT_EQ(cap.text() + ReadFile(path), "shown 1\nshown 1\n");
  Qel_Msg::DisableScreen();
  Qel_Msg::Enable();  // messages are on already: nothing to do
  EXPECT_EQ(TypesOn(), "c f012345678");
  install(true);
  Qel_Msg::EnableScreen();
  Qel_Msg::Disable();
  Qel_Msg::Enable();
  EXPECT_EQ(TypesOn(), "c04568 f012345678");
}

TEST_F(QelMsg, QuietScreenOpensFourTypesShutsTwoAndOnlyInQuietMode) {
  install(true);
  Qel_Msg::QuietEnableScreen();
  EXPECT_TRUE(Qel_Msg::IsQuietEnableScreen());
  EXPECT_EQ(TypesOn(), "c012345678 f012345678");
  Qel_Msg::QuietDisableScreen();
  EXPECT_FALSE(Qel_Msg::IsQuietEnableScreen());
  EXPECT_EQ(TypesOn(), "c0145678 f012345678");
  install(true, true);  // the console filtered, quiet mode off
  Qel_Msg::QuietEnableScreen();
  EXPECT_FALSE(Qel_Msg::IsQuietEnableScreen());
  EXPECT_EQ(TypesOn(), "c04568 f012345678");
  Qel_Msg::EnableScreen();
  Qel_Msg::QuietDisableScreen();
  EXPECT_EQ(TypesOn(), "c012345678 f012345678");
}

TEST_F(QelMsg, QuietStatusNeedsQuietModeAndBothNeedMessagesOn) {
  install(false);
  Qel_Msg::QuietStatus("quiet\n");
  Qel_Msg::QuietAndLogStatus("log %s\n", "x");
  install(true);
  Qel_Msg::QuietStatus("quiet %d\n", 2);
  Qel_Msg::Disable();
  Qel_Msg::QuietStatus("off\n");
  Qel_Msg::QuietAndLogStatus("off\n");
  EXPECT_EQ(cap.text(Port_Status), "log x\nquiet 2\n");
  EXPECT_EQ(cap[0].module + cap[0].unit + cap[0].revision, "DuduzuRorez../s/qelmsg$Revision: 1.1 $");
}

TEST_F(QelMsg, WarnOnceIssuesOncePerFormatTextOnlyWithAStream) {
  Qel_Msg::WarnOnce("w %d\n", 0);
  Qel_Msg::Disable();  // before set-up: no effect
  install(false);
  Qel_Msg::WarnOnce("w %d\n", 1);
  Qel_Msg::WarnOnce(std::string("w %d\n").c_str(), 2);
  char* buffer = strdup("v%d\n");
  Qel_Msg::WarnOnce(buffer, 1);
  buffer[0] = 'u';  // the same buffer with another text is another warning
  Qel_Msg::WarnOnce(buffer, 2);
  free(buffer);
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

// Message control: type switches without nesting, quiet mode, direct status
// lines, warnings once per format text.
#include <gtest/gtest.h>
#include <unistd.h>

#include <cstring>
#include <fstream>
#include <sstream>

#include "../src/frame/msgstate.h"  // the internal hand-over setters
#include "duduzu/qelmsg.h"
#include "port/port_testing.h"

namespace {

Port::Stream* const console = Port::File::getCout();

class QelMsg : public ::testing::Test {
 protected:
  // As the set-up does: console (screen types off in quiet mode) and log
  // attached, state handed over, stream receiving every report.
  void install(bool quiet) {
    stream.addStream(console);
    stream.addStream(log);
    for (int type : {3, 2, 7, 1})
      if (quiet) stream.disableMsgType(console, type);
    SetQelMsgQuiet(quiet);
    SetQelMsgStream(&stream);
    SetQelMsgLogStream(log);
    Port_MsgDispatcher::addMsgMan(&stream);
  }
  void TearDown() override { Port::File::close(log), std::remove(path.c_str()); }
  // The types on for the console and the log, e.g. "0145678/012345678".
  std::string on() const {
    std::string types;
    for (Port::Stream* output : {console, log}) {
      for (int t = 0; t <= 8; ++t)
        if (stream.isMsgTypeEnabled(output, t)) types += char('0' + t);
      types += output == console ? "/" : "";
    }
    return types;
  }
  std::string logText() const { return (std::stringstream() << std::ifstream(path).rdbuf()).str(); }
  Port_MsgStream stream{nullptr};
  std::string path = ::testing::TempDir() + "qelmsg" + std::to_string(getpid()) + ".log";
  Port::Stream* log = Port::File::open(path.c_str(), 2, false);
  PortTest::Capture cap;
};

TEST_F(QelMsg, SwitchesHaveNoNestingAndSpareQuietModesScreenTypes) {
  install(false);
  Qel_Msg::Disable();
  Qel_Msg::Disable();
  EXPECT_EQ(on(), "/");
  Qel_Msg::QuietAndLogStatus("hidden\n");
  Qel_Msg::Enable();
  Qel_Msg::QuietAndLogStatus("shown %d\n", 1);
  EXPECT_EQ(cap.text() + logText(), "shown 1\nshown 1\n");
  Qel_Msg::DisableScreen();
  Qel_Msg::Enable();  // messages are on already: nothing to do
  EXPECT_EQ(on(), "/012345678");
  SetQelMsgQuiet(true);
  Qel_Msg::EnableScreen();
  Qel_Msg::Disable();
  Qel_Msg::Enable();
  EXPECT_EQ(on(), "04568/012345678");
}

TEST_F(QelMsg, QuietScreenOpensFourTypesShutsTwoAndOnlyInQuietMode) {
  install(true);
  Qel_Msg::QuietEnableScreen();
  EXPECT_TRUE(Qel_Msg::IsQuietEnableScreen());
  SetQelMsgQuiet(false);
  Qel_Msg::QuietDisableScreen();
  EXPECT_FALSE(Qel_Msg::IsQuietEnableScreen());
  SetQelMsgQuiet(true);
  EXPECT_EQ(on(), "012345678/012345678");
  Qel_Msg::QuietDisableScreen();
  EXPECT_FALSE(Qel_Msg::IsQuietEnableScreen());
  EXPECT_EQ(on(), "0145678/012345678");
}

TEST_F(QelMsg, QuietStatusNeedsQuietModeAndBothNeedMessagesOn) {
  install(false);
  Qel_Msg::QuietStatus("quiet\n");
  Qel_Msg::QuietAndLogStatus("log %s\n", "x");
  SetQelMsgQuiet(true);
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
  EXPECT_EQ(logText(), Port_FormatReport(cap[0]) + cap[1].text + Port_FormatReport(cap[2]) +
                           cap[3].text + Port_FormatReport(cap[4]) + cap[5].text);
}

}  // namespace

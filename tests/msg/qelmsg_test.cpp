// Message control: switch orders and guards, quiet mode, direct status lines,
// warnings once per format text.
#include <gtest/gtest.h>
#include <unistd.h>

#include <cstring>
#include <fstream>
#include <sstream>
#include <string>

#include "../src/frame/msgstate.h"  // the internal hand-over setters
#include "duduzu/qelmsg.h"
#include "port/port_testing.h"

namespace {

Port::Stream* const console = Port::File::getCout();
const char* const kOnce = "Last warning will be issued only once.\n";

// The message stream, recording each switch call as "+c3 " (on, console, type 3)
// or "-l8 " (off, log, type 8).
class Recorder : public Port_MsgStream {
 public:
  Recorder() : Port_MsgStream(nullptr) {}
  void enableMsgType(Port::Stream* s, int type) override {
    record('+', s, type);
    Port_MsgStream::enableMsgType(s, type);
  }
  void disableMsgType(Port::Stream* s, int type) override {
    record('-', s, type);
    Port_MsgStream::disableMsgType(s, type);
  }
  std::string calls;

 private:
  void record(char sign, Port::Stream* s, int type) {
    calls += std::string{sign, s == console ? 'c' : 'l', char('0' + type), ' '};
  }
};

class QelMsg : public ::testing::Test {
 protected:
  // Installs the stream as the set-up does: console (screen types off in quiet
  // mode), optional log, hand-over, stream in place of the default manager.
  void install(bool quiet, bool withLog = false) {
    stream.addStream(console);
    if (quiet)
      for (int type : {3, 2, 7, 1}) stream.disableMsgType(console, type);
    if (withLog) stream.addStream(log = Port::File::open(logPath.c_str(), 2, false));
    SetQelMsgQuiet(quiet);
    SetQelMsgStream(&stream);
    SetQelMsgLogStream(log);
    Port_MsgDispatcher::addMsgMan(&stream);
    Port_MsgDispatcher::removeMsgMan(defaultMan);
    stream.calls.clear();
  }
  void TearDown() override {
    Port_MsgDispatcher::addMsgMan(defaultMan);
    SetQelMsgStream(nullptr);
    Port::File::close(log);
    std::remove(logPath.c_str());
  }
  std::string logText() const {
    std::stringstream text;
    text << std::ifstream(logPath).rdbuf();
    return text.str();
  }
  bool consoleOn(int type) const { return stream.isMsgTypeEnabled(console, type); }

  Recorder stream;
  Port::Stream* log = nullptr;
  Port_MsgMan* defaultMan = Port_MsgDispatcher::getDefaultMsgMan();
  std::string logPath = ::testing::TempDir() + "qelmsg" + std::to_string(getpid()) + ".log";
  PortTest::Capture cap;
};

// Expected calls: sw('-', 'c', "32") is "-c3 -c2 ".
std::string sw(char sign, char output, const char* types) {
  std::string calls;
  for (const char* t = types; *t; ++t) calls += std::string{sign, output, *t, ' '};
  return calls;
}
const char* const kAll = "327165048";  // screen-filtered types, then the others

TEST_F(QelMsg, BeforeSetUpNothingHappensAndNothingIsRecorded) {
  Qel_Msg::Disable();
  Qel_Msg::WarnOnce("w\n");
  EXPECT_EQ(cap.size(), 0u);
  install(false);
  Qel_Msg::QuietAndLogStatus("on\n");
  Qel_Msg::WarnOnce("w\n");
  EXPECT_EQ(cap.text(), std::string("on\nw\n") + kOnce);
}

TEST_F(QelMsg, DisableAndEnableSwitchEveryTypeInOrderWithoutNesting) {
  install(false, true);
  Qel_Msg::Enable();
  EXPECT_EQ(stream.calls, "");
  Qel_Msg::Disable();
  Qel_Msg::Disable();
  EXPECT_EQ(stream.calls, sw('-', 'c', kAll) + sw('-', 'l', kAll));
  Qel_Msg::QuietAndLogStatus("hidden\n");
  stream.calls.clear();
  Qel_Msg::Enable();
  EXPECT_EQ(stream.calls, sw('+', 'c', kAll) + sw('+', 'l', kAll));
  Qel_Msg::QuietAndLogStatus("shown %d\n", 1);
  EXPECT_EQ(cap.text(), "shown 1\n");
  EXPECT_EQ(logText(), "shown 1\n");
}

TEST_F(QelMsg, QuietModeLeavesTheConsoleScreenTypesAlone) {
  install(true, true);
  Qel_Msg::Disable();
  Qel_Msg::Enable();
  Qel_Msg::DisableScreen();
  EXPECT_EQ(stream.calls, sw('-', 'c', "65048") + sw('-', 'l', kAll) + sw('+', 'c', "65048") +
                              sw('+', 'l', kAll) + sw('-', 'c', "65048"));
  for (int type : {3, 2, 7, 1}) EXPECT_FALSE(consoleOn(type));
}

TEST_F(QelMsg, DisableScreenIsNotUndoneByEnable) {
  install(false, true);
  Qel_Msg::DisableScreen();
  Qel_Msg::Enable();
  EXPECT_EQ(stream.calls, sw('-', 'c', kAll));
  EXPECT_FALSE(consoleOn(2));
  EXPECT_TRUE(stream.isMsgTypeEnabled(log, 2));
  Qel_Msg::EnableScreen();
  EXPECT_TRUE(consoleOn(2));
}

TEST_F(QelMsg, QuietScreenOpensFourTypesAndShutsOnlyThreeAndTwo) {
  install(true);
  Qel_Msg::QuietEnableScreen();
  EXPECT_TRUE(Qel_Msg::IsQuietEnableScreen());
  Qel_Msg::QuietDisableScreen();
  EXPECT_FALSE(Qel_Msg::IsQuietEnableScreen());
  EXPECT_EQ(stream.calls, sw('+', 'c', "3271") + sw('-', 'c', "32"));
  EXPECT_TRUE(consoleOn(7) && consoleOn(1));
  EXPECT_FALSE(consoleOn(3) || consoleOn(2));
}

TEST_F(QelMsg, OutsideQuietModeQuietScreenAndQuietStatusDoNothing) {
  install(false);
  Qel_Msg::QuietEnableScreen();
  EXPECT_FALSE(Qel_Msg::IsQuietEnableScreen());
  Qel_Msg::QuietDisableScreen();
  EXPECT_EQ(stream.calls, "");
  Qel_Msg::QuietStatus("quiet\n");
  Qel_Msg::QuietAndLogStatus("log %s\n", "x");
  ASSERT_EQ(cap.size(), 1u);
  EXPECT_EQ(cap[0].level, Port_Status);
  EXPECT_EQ(cap[0].module, "DuduzuRorez");
  EXPECT_EQ(cap[0].unit, "../s/qelmsg");
  EXPECT_EQ(cap[0].revision, "$Revision: 1.1 $");
  EXPECT_EQ(cap[0].text, "log x\n");
}

TEST_F(QelMsg, InQuietModeQuietStatusIssuesUnlessDisabled) {
  install(true);
  Qel_Msg::QuietStatus("quiet %d\n", 2);
  Qel_Msg::Disable();
  Qel_Msg::QuietStatus("off\n");
  Qel_Msg::QuietAndLogStatus("off\n");
  EXPECT_EQ(cap.text(), "quiet 2\n");
}

TEST_F(QelMsg, WarnOnceIssuesOncePerFormatText) {
  install(false, true);
  Qel_Msg::WarnOnce("w %d\n", 1);
  Qel_Msg::WarnOnce("w %d\n", 2);
  Qel_Msg::WarnOnce(std::string("w %d\n").c_str(), 3);
  ASSERT_EQ(cap.size(), 2u);
  EXPECT_EQ(cap[0].level, Port_Warning);
  EXPECT_EQ(cap[0].unit, "../s/qelmsg");
  EXPECT_EQ(cap[0].text, "w 1\n");
  EXPECT_EQ(cap[1].level, Port_Status);
  EXPECT_EQ(cap[1].unit, "../s/qelmsg");
  EXPECT_EQ(logText(), Port_FormatReport(cap[0]) + kOnce);
  // The key is the text, not the caller's buffer, which may be reused or freed.
  char* buffer = strdup("v %d\n");
  Qel_Msg::WarnOnce(buffer, 1);
  memcpy(buffer, "u", 1);
  Qel_Msg::WarnOnce(buffer, 2);
  free(buffer);
  Qel_Msg::WarnOnce("v %d\n", 3);
  EXPECT_EQ(cap.text(Port_Warning), "w 1\nv 1\nu 2\n");
}

TEST_F(QelMsg, WarnOnceWhileDisabledIsRecordedButNotShown) {
  install(false, true);
  Qel_Msg::Disable();
  Qel_Msg::WarnOnce("d\n");
  Qel_Msg::Enable();
  Qel_Msg::WarnOnce("d\n");
  EXPECT_EQ(cap.text(), std::string("d\n") + kOnce);
  EXPECT_EQ(logText(), "");
}

}  // namespace

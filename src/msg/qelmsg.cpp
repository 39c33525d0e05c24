// Message control: switches of the message stream's outputs, quiet-mode
// status lines and warnings issued once.
#include <cstdarg>
#include <string>
#include <unordered_set>

#include "duduzu/qelmsg.h"
#include "frame/msgstate.h"
#include "frame/unit.h"

namespace {

constexpr const char* kUnit = "../s/qelmsg";

// The types quiet mode keeps off the console, then all the others, each in
// the order they are switched.
constexpr int kOtherTypes[] = {6, 5, 0, 4, 8};
constexpr int kQuietShutTypes[] = {3, 2};

bool messagesEnabled = true;
bool quietScreen = false;  // quiet mode's screen opened by QuietEnableScreen

// One switch call per type, in order; an absent output (no log) is skipped.
template <size_t N>
void switchTypes(bool on, Port::Stream* output, const int (&types)[N]) {
  if (!output) return;
  Port_MsgStream* stream = qelMsgHandOver.stream;
  for (int type : types) {
    if (on)
      stream->enableMsgType(output, type);
    else
      stream->disableMsgType(output, type);
  }
}

// The console's types, leaving the screen-filtered ones to quiet mode.
void switchConsole(bool on) {
  if (!qelMsgHandOver.quiet) switchTypes(on, Port::File::getCout(), kScreenFilteredTypes);
  switchTypes(on, Port::File::getCout(), kOtherTypes);
}

void setMessages(bool on) {
  if (!qelMsgHandOver.stream || messagesEnabled == on) return;
  messagesEnabled = on;
  switchConsole(on);
  switchTypes(on, qelMsgHandOver.logStream, kScreenFilteredTypes);
  switchTypes(on, qelMsgHandOver.logStream, kOtherTypes);
}

void setScreen(bool on) {
  if (qelMsgHandOver.stream) switchConsole(on);
}

// Quiet mode only: the console's screen types opened (or shut) again.
template <size_t N>
void setQuietScreen(bool open, const int (&types)[N]) {
  if (!qelMsgHandOver.stream || !qelMsgHandOver.quiet) return;
  switchTypes(open, Port::File::getCout(), types);
  quietScreen = open;
}

// A status straight to the message stream, bypassing the dispatcher, while
// messages are on and `when` holds.
void streamStatus(bool when, int line, const char* fmt, va_list ap) {
  Port_MsgStream* stream = qelMsgHandOver.stream;
  if (stream && messagesEnabled && when)
    stream->issueStatusV(dz::kModule, kUnit, line, dz::kRevision, fmt, ap);
}

}  // namespace

void Qel_Msg::QuietStatus(const char* fmt, ...) {
  va_list ap;
  va_start(ap, fmt);
  streamStatus(qelMsgHandOver.quiet, __LINE__, fmt, ap);
  va_end(ap);
}

void Qel_Msg::QuietAndLogStatus(const char* fmt, ...) {
  va_list ap;
  va_start(ap, fmt);
  streamStatus(true, __LINE__, fmt, ap);
  va_end(ap);
}

void Qel_Msg::Disable() { setMessages(false); }
void Qel_Msg::Enable() { setMessages(true); }
void Qel_Msg::DisableScreen() { setScreen(false); }
void Qel_Msg::EnableScreen() { setScreen(true); }

void Qel_Msg::QuietDisableScreen() { setQuietScreen(false, kQuietShutTypes); }
void Qel_Msg::QuietEnableScreen() { setQuietScreen(true, kScreenFilteredTypes); }

bool Qel_Msg::IsQuietEnableScreen() { return qelMsgHandOver.quiet && quietScreen; }

void Qel_Msg::WarnOnce(const char* fmt, ...) {
  Port_MsgStream* stream = qelMsgHandOver.stream;
  if (!stream) return;
  // Keyed on the text, kept as a copy so that the caller's buffer may go.
  static std::unordered_set<std::string> warned(100);
  if (!warned.insert(fmt).second) return;
  va_list ap;
  va_start(ap, fmt);
  stream->issueWarningV(dz::kModule, kUnit, __LINE__, dz::kRevision, fmt, ap);
  va_end(ap);
  DZ_REPORT(Status, "Last warning will be issued only once.\n");
}

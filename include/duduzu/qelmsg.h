// Message control: silencing all messages or the screen alone, the reduced
// screen of quiet mode, status lines for particular output set-ups, and
// warnings issued once per format.
#pragma once

#include "duduzu/export.h"

// Static operations only. All but IsQuietEnableScreen act on the message
// stream installed by SetQelMsgMan; before that they do nothing.
class DUDUZU_API Qel_Msg {
 public:
  Qel_Msg() = delete;

  // Status straight to the message stream while messages are on and quiet mode
  // is in force.
  static void QuietStatus(const char* fmt, ...) __attribute__((format(printf, 1, 2)));
  // Status straight to the message stream while messages are on.
  static void QuietAndLogStatus(const char* fmt, ...) __attribute__((format(printf, 1, 2)));

  // Every message type off (on) for the console and the log. A second Disable
  // or Enable in a row does nothing: there is no nesting count. In quiet mode
  // the console's screen-filtered types are left as they are.
  static void Disable();
  static void Enable();
  // The same for the console alone, without touching the messages-enabled flag.
  static void DisableScreen();
  static void EnableScreen();

  // In quiet mode only: shut (types 3 and 2) or open (3, 2, 7, 1) the
  // console's screen-filtered types again.
  static void QuietDisableScreen();
  static void QuietEnableScreen();
  // True while quiet mode is in force and its screen has been opened.
  static bool IsQuietEnableScreen();

  // A warning the first time its format text is seen, followed by the status
  // "Last warning will be issued only once."; later calls with the same text
  // (whatever the arguments) issue nothing.
  static void WarnOnce(const char* fmt, ...) __attribute__((format(printf, 1, 2)));
};

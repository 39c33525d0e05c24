// State handed from the message-manager set-up to message control.
#pragma once

#include "port/port.h"

struct QelMsgHandOver {
  bool quiet = false;                  // quiet mode (integration style with a log)
  Port_MsgStream* stream = nullptr;    // the library's message stream
  Port::Stream* logStream = nullptr;   // the log file attached to it
};

extern QelMsgHandOver qelMsgHandOver;

// The setters are internal. Builds with tests make them visible so that the
// message-control tests can hand state over the way the set-up does.
#ifdef DUDUZU_TESTING
#define DZ_TESTING_API __attribute__((visibility("default")))
#else
#define DZ_TESTING_API
#endif

DZ_TESTING_API void SetQelMsgQuiet(bool quiet);
DZ_TESTING_API void SetQelMsgStream(Port_MsgStream* stream);
DZ_TESTING_API void SetQelMsgLogStream(Port::Stream* stream);

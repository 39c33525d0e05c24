// State handed from the message-manager set-up to message control.
#pragma once

#include "port/port.h"

struct QelMsgHandOver {
  bool quiet = false;                  // quiet mode (integration style with a log)
  Port_MsgStream* stream = nullptr;    // the library's message stream
  Port::Stream* logStream = nullptr;   // the log file attached to it
};

extern QelMsgHandOver qelMsgHandOver;

// Internal setters, called by the message-manager set-up alone.
void SetQelMsgQuiet(bool quiet);
void SetQelMsgStream(Port_MsgStream* stream);
void SetQelMsgLogStream(Port::Stream* stream);

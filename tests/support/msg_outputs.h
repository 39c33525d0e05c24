// Shared test support: the outputs of the installed message stream.
#pragma once

#include <string>

#include "port/port.h"

// The message stream that SetQelMsgMan put in place of the default manager.
inline Port_MsgStream* InstalledStream() {
  return dynamic_cast<Port_MsgStream*>(Port_MsgDispatcher::getDefaultMsgMan());
}

// Each attached output in attach order, "c" for the console and "f" for a
// file, followed by the types on for it: "c04568 f012345678".
inline std::string TypesOn() {
  Port_MsgStream* stream = InstalledStream();
  std::string text;
  for (Port::Stream* output : stream->attachedStreams()) {
    text += text.empty() ? "" : " ";
    text += output == Port::File::getCout() ? 'c' : 'f';
    for (int type = 0; type <= 8; ++type)
      if (stream->isMsgTypeEnabled(output, type)) text += char('0' + type);
  }
  return text;
}

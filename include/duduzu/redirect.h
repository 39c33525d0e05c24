// The tool's message manager and the redirection of its output: SetQelMsgMan
// installs a message stream writing to the console and an optional log file;
// the main output (MainEVarOutFile) and the messages can then be sent to
// another file for a while, in nested redirect/restore pairs.
#pragma once

#include "duduzu/export.h"
#include "duduzu/list.h"

// Puts the library's message stream in place of the dispatcher's default
// manager, with the console attached and, when logFileName is given, that
// file (created or truncated) as the log. Integration style (intStyle) needs
// the log: it keeps types 3, 2, 7 and 1 off the console and, unless noLatch,
// turns quiet mode on; without a log it is ignored with a warning. A log that
// cannot be opened is reported and the set-up goes on without it.
DUDUZU_API void SetQelMsgMan(char* logFileName, bool intStyle, bool noLatch);
// Puts the default manager back, closes the log and destroys the stream.
DUDUZU_API void UnsetQelMsgMan();

// Sends the messages (to this file alone: no console, no outer log) and the
// main output to logFileName, appending. A file that cannot be opened ends the
// session with ExitToSession(1), the outputs left as they were.
DUDUZU_API void FileRedirectMainOutFile(char* logFileName);
// Undoes the latest unrestored redirection; does nothing when there is none.
DUDUZU_API void FileRestoreOldMainOutFile();

// The file-copy command: copies the file named by the parameter "ifn" to the
// one named by "ofn" (names matched ignoring case). 1 copied, 0 otherwise,
// with a status message saying why.
DUDUZU_API int FileCopyInterf(DomList* params);

// System services: command processor, working directory, environment,
// temporary directory, process number, memory use, rounding and byte-reversed
// binary items.
#pragma once

#include <cstdio>

#include "duduzu/export.h"

// Runs cmd through the command processor; its result is ignored.
DUDUZU_API void SystemCmd(const char* cmd);
// Changes the working directory, then prints the current one to f by the
// main-output rule. Always 1; a failed change shows only in its message.
DUDUZU_API int SystemCd(FILE* f, const char* dir);
// Prints the current working directory and a newline to f; returns 1.
DUDUZU_API int SystemPwd(FILE* f);
// The process environment's value of name, or null; not to be freed.
DUDUZU_API char* SystemGetEnv(const char* name);
// New 1024-byte heap string: $TMPDIR (or /tmp) ending in '/', empty when it
// does not fit. Released with StrFree.
DUDUZU_API char* SystemGetTempPath(void);
// Small per-run number from 1 to 1000, taken from the clock on the first call
// and kept for the rest of the process.
DUDUZU_API int SystemGetPID(void);
DUDUZU_API long SystemGetHostId(void);
DUDUZU_API void SystemSetDebugMode(FILE* f, int on);
// Memory usage figure of the Portability library, and its printing.
DUDUZU_API unsigned int SystemMemoryGet(void);
DUDUZU_API void SystemMemoryPrint(FILE* f, char* label);
// x rounded to the nearest int, halves away from zero.
DUDUZU_API int SystemIRint(float x);
// n items of size bytes, stored in the file with each item's bytes reversed.
// SystemFRead returns n when every item was read, 0 after a short read (for
// size 1: the byte count of fread).
DUDUZU_API void SystemFWrite(char* data, unsigned size, unsigned n, FILE* f);
DUDUZU_API int SystemFRead(char* data, unsigned size, unsigned n, FILE* f);

// Replaces the clock (seconds) that SystemGetPID reads on its first call, so
// that tests get a known number; null restores time().
typedef long long (*SystemClockFn)(void);
DUDUZU_API void SystemSetClock(SystemClockFn clock);

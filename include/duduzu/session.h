// Session variables shared with the tools, and the exit to the session loop.
#pragma once

#include <csetjmp>
#include <cstdio>

#include "duduzu/export.h"

DUDUZU_API extern int MainEVarMaxTime;
DUDUZU_API extern int MainEvarVzlMaxLoop;
DUDUZU_API extern int MainEVarMorvelFF;
DUDUZU_API extern int MainEVarSameTechno;
DUDUZU_API extern FILE* MainEVarInFile;
DUDUZU_API extern char* QelHdpIni;
DUDUZU_API extern int MainEVarVerbose;
DUDUZU_API extern int MainEVarReturnStatus;
DUDUZU_API extern int MainEVarMorvelDepth;
DUDUZU_API extern int MainEVarMorvelHMaps;
DUDUZU_API extern int MainEVarMorvelFMaps;
DUDUZU_API extern FILE* MainEVarOutFile;
DUDUZU_API extern char* MainEVarEdifGeneratedBy;
DUDUZU_API extern char* QelHdpDir;
DUDUZU_API extern char* KERBTmpDir;
DUDUZU_API extern int MainEVarMorvelCLBNumber;
DUDUZU_API extern int MainEvarGraphicMode;
DUDUZU_API extern int MainEVarGkerb;
DUDUZU_API extern int NumberOfCallToListCreate;
DUDUZU_API extern int NumberOfCallToListDel;
DUDUZU_API extern int NumberOfCallToRealloc;
DUDUZU_API extern int EVarMaxMem;

// Armed by the tool with setjmp; ExitToSession long-jumps here.
DUDUZU_API extern jmp_buf RestartSession;

// Stores code (6 when code is 0) in MainEVarReturnStatus and long-jumps to
// RestartSession. Releases nothing on the way.
[[noreturn]] DUDUZU_API void ExitToSession(int code);

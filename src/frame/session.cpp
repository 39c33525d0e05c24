// Session variables, the exit to the session loop and the message-control hand-over.
#include <csetjmp>

#include "frame/msgstate.h"
#include "frame/unit.h"

int MainEVarMaxTime = 3600;
int MainEvarVzlMaxLoop = 7;
int MainEVarMorvelFF = 0;
int MainEVarSameTechno = 0;
FILE* MainEVarInFile = nullptr;
char* QelHdpIni = nullptr;
int MainEVarVerbose = 0;
int MainEVarReturnStatus = 0;
int MainEVarMorvelDepth = 0;
int MainEVarMorvelHMaps = 0;
int MainEVarMorvelFMaps = 0;
FILE* MainEVarOutFile = nullptr;
char* MainEVarEdifGeneratedBy = nullptr;
char* QelHdpDir = nullptr;
char* KERBTmpDir = nullptr;
int MainEVarMorvelCLBNumber = 0;
int MainEvarGraphicMode = 0;
int MainEVarGkerb = 0;
int NumberOfCallToListCreate = 0;
int NumberOfCallToListDel = 0;
int NumberOfCallToRealloc = 0;
int EVarMaxMem = 0;
jmp_buf RestartSession;

void ExitToSession(int code) {
  MainEVarReturnStatus = code == 0 ? 6 : code;
  longjmp(RestartSession, 0);
}

QelMsgHandOver qelMsgHandOver;

void SetQelMsgQuiet(bool quiet) { qelMsgHandOver.quiet = quiet; }
void SetQelMsgStream(Port_MsgStream* stream) { qelMsgHandOver.stream = stream; }
void SetQelMsgLogStream(Port::Stream* stream) { qelMsgHandOver.logStream = stream; }

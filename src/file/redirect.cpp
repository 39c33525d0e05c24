// The tool's message manager, nested redirection of the messages and the main
// output, and the file-copy command.
#include "duduzu/redirect.h"

#include "duduzu/file.h"
#include "duduzu/param.h"
#include "duduzu/qelmsg.h"
#include "duduzu/str.h"
#include "frame/msgstate.h"
#include "frame/unit.h"
#include "list/keptlist.h"

namespace {

constexpr const char* kUnit = "../s/fileutil";

Port_MsgMan* defaultMan = nullptr;     // the dispatcher's manager before set-up
Port_MsgStream* msgStream = nullptr;   // ours, while installed
Port::Stream* currentLog = nullptr;    // the one log attached now
KeptList logStack;                     // logs to return to, innermost last
KeptList outStack;                     // MainEVarOutFile values to return to
int depth = 0;                         // redirections not yet restored
bool restoreFilter = false;            // integration style or no-latch was asked for

// Stacks of pointers: created by the first push, deleted when emptied. A stack
// that could not be created (reported by the list core) reads as empty.
template <class T>
void push(DomList*& stack, T* e) {
  if (!stack) stack = ListCreate();
  if (stack) ListAddElt(stack, reinterpret_cast<int*>(e));
}

template <class T>
T* top(DomList* stack) {
  return stack ? reinterpret_cast<T*>(stack->elements[stack->count - 1]) : nullptr;
}

void pop(DomList*& stack) {
  if (!stack) return;
  ListDelInsert(stack, stack->count);
  if (stack->count == 0) ListQuickDelete(&stack);
}

// Keeps the types that quiet mode hides off the console.
void filterConsole() {
  for (int type : kScreenFilteredTypes) msgStream->disableMsgType(Port::File::getCout(), type);
}

}  // namespace

void SetQelMsgMan(char* logFileName, bool intStyle, bool noLatch) {
  defaultMan = Port_MsgDispatcher::getDefaultMsgMan();
  msgStream = new Port_MsgStream(nullptr);
  msgStream->addStream(Port::File::getCout());
  SetQelMsgQuiet(false);
  SetQelMsgStream(msgStream);
  restoreFilter = intStyle || noLatch;
  // The log is opened first: integration style applies only when there is one.
  currentLog = logFileName ? Port::File::open(logFileName, 2, false) : nullptr;
  if (logFileName && !currentLog) DZ_REPORT(Error, "unable to open log file '%s'\n", logFileName);
  if (intStyle && !currentLog) {
    DZ_REPORT(Warning, "No log file : `-intstyle\" ignored.\n");
  } else if (intStyle) {
    filterConsole();
    if (!noLatch) SetQelMsgQuiet(true);
  }
  if (currentLog) msgStream->addStream(currentLog);
  SetQelMsgLogStream(currentLog);
  Port_MsgDispatcher::addMsgMan(msgStream);
  Port_MsgDispatcher::removeMsgMan(defaultMan);
  Port_MsgDispatcher::setMaxLineWidth(1024);
}

void UnsetQelMsgMan() {
  Port_MsgDispatcher::addMsgMan(defaultMan);
  Port_MsgDispatcher::removeMsgMan(msgStream);
  if (currentLog) Port::File::close(currentLog);
  delete msgStream;
  // Message control must not keep the stream or the log it no longer has.
  SetQelMsgStream(nullptr);
  SetQelMsgLogStream(nullptr);
}

void FileRedirectMainOutFile(char* logFileName) {
  // Opened before anything changes, so that a failure leaves the outputs and
  // the stacks as they were.
  Port::Stream* log = Port::File::open(logFileName, 6, false);
  if (!log) {
    DZ_REPORT(Error, "Something wrong when opening logfile : %s\n", logFileName);
    ExitToSession(1);
  }
  Port::Stream* previous = currentLog;
  if (previous) push(logStack.get(), previous);
  currentLog = log;
  msgStream->addStream(log);
  if (previous) msgStream->removeStream(previous);
  if (depth++ == 0) msgStream->removeStream(Port::File::getCout());
  push(outStack.get(), MainEVarOutFile);
  MainEVarOutFile = FOPEN(logFileName, "a");
}

void FileRestoreOldMainOutFile() {
  if (depth == 0) return;  // nothing to restore: the tool's own output stays open
  if (--depth == 0) msgStream->addStream(Port::File::getCout());
  Port::Stream* previous = top<Port::Stream>(logStack.get());
  if (previous) {
    msgStream->addStream(previous);
    if (restoreFilter && !Qel_Msg::IsQuietEnableScreen()) filterConsole();
  }
  msgStream->removeStream(currentLog);
  Port::File::close(currentLog);
  currentLog = previous;
  pop(logStack.get());
  FCLOSE(MainEVarOutFile);
  MainEVarOutFile = top<FILE>(outStack.get());
  pop(outStack.get());
}

int FileCopyInterf(DomList* params) {
  char* ifn = ParamFindNamedParam(params, "ifn");
  if (!ifn) {
    DZ_REPORT(Status, "Missing -ifn parameter\n");
    return 0;
  }
  char* ofn = ParamFindNamedParam(params, "ofn");
  if (!ofn) {
    DZ_REPORT(Status, "Missing -ofn parameter\n");
    StrFree(&ifn);
    return 0;
  }
  int copied = FileCopyFileNameToFileName(ifn, ofn);
  if (!copied) DZ_REPORT(Status, "Copy (%s -> %s) operation failed\n", ifn, ofn);
  StrFree(&ifn);
  StrFree(&ofn);
  return copied;
}

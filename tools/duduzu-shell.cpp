// duduzu-shell: a small session tool on libduduzu. It reads command lines from
// a script file (or standard input), one command per line, and runs each one
// the way the tool chain's tools run theirs: parameters parsed and checked
// against the command's descriptor strings, output through the main output
// and the message stream, fatal conditions unwinding to the session loop.
//
//   duduzu-shell [-log FILE] [-intstyle] [-clock N] [script]
//
// -log FILE   also write every message to FILE
// -intstyle   integration style: status messages go to the log only
// -clock N    (for tests) take the process number, and so the temporary
//             names, from the clock value N instead of the time of day
//
// A line is a command name and its parameters; blank lines and lines whose
// first non-blank character is '#' are skipped. `help` lists the commands.
#include <sys/stat.h>
#include <unistd.h>

#include <algorithm>
#include <cerrno>
#include <climits>
#include <csetjmp>
#include <cstdarg>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <string>
#include <vector>

#include "duduzu/duduzu.h"

namespace {

// ---- session state ----

// Everything the loop needs after a long jump lives here, not in a stack frame.
struct Session {
  FILE* script = nullptr;
  bool echo = false;     // echo each command line (not when typing at a terminal)
  char* line = nullptr;  // the line being run (getline's buffer)
  size_t lineSize = 0;
  int lineNumber = 0;
  const char* command = "";   // name of the command being run
  DomList* params = nullptr;  // its parameter list, released after it ran or unwound
  int depth = 0;              // redirections not yet restored
  bool quit = false;
};
Session session;

// ---- output and reports ----

std::string formatV(const char* fmt, va_list ap) {
  va_list copy;
  va_copy(copy, ap);
  int n = vsnprintf(nullptr, 0, fmt, copy);
  va_end(copy);
  std::string text(n > 0 ? n : 0, '\0');
  if (n > 0) vsnprintf(&text[0], text.size() + 1, fmt, ap);
  return text;
}

// Main output: written to MainEVarOutFile, which the main-output rule turns
// into a status message, so that a redirection or the log captures it.
__attribute__((format(printf, 1, 2))) void say(const char* fmt, ...) {
  va_list ap;
  va_start(ap, fmt);
  StrPrint(MainEVarOutFile, formatV(fmt, ap).c_str());
  va_end(ap);
}

// The tool's own error messages, reported like the library's and prefixed
// with the script line.
__attribute__((format(printf, 2, 3))) void complainAt(int line, const char* fmt, ...) {
  va_list ap;
  va_start(ap, fmt);
  Port_MsgManData::createObject("DuduzuShell", "tools/duduzu-shell", line, "$Revision: 1.1 $")
      ->issueError("line %d: %s", session.lineNumber, formatV(fmt, ap).c_str());
  va_end(ap);
}
#define COMPLAIN(...) complainAt(__LINE__, __VA_ARGS__)

// ---- parameters ----

DomParam* record(DomList* p, int i) { return reinterpret_cast<DomParam*>(p->elements[i]); }
int recordCount(DomList* p) { return p ? p->count : 0; }

void freeParam(int** slot) { ParamFree(reinterpret_cast<DomParam**>(slot)); }

// Parsed values keep the double quotes of a quoted word; the commands want the text.
void unquoteValues(DomList* p) {
  for (int i = 0; i < recordCount(p); ++i) {
    char* v = record(p, i)->CharParam;
    size_t n = strlen(v);
    if (n == 0 || v[0] != '"') continue;
    n -= (n > 1 && v[n - 1] == '"') ? 2 : 1;
    memmove(v, v + 1, n);
    v[n] = '\0';
  }
}

// The i-th positional argument (from 0); the descriptors guarantee it exists.
char* arg(DomList* p, int i) {
  for (int k = 0; k < recordCount(p); ++k)
    if (record(p, k)->CharParamQual[0] == '\0' && i-- == 0) return record(p, k)->CharParam;
  return nullptr;
}

DomParam* option(DomList* p, const char* name) {
  for (int k = 0; k < recordCount(p); ++k)
    if (strcasecmp(record(p, k)->CharParamQual, name) == 0) return record(p, k);
  return nullptr;
}

// An option's value, null when the option is absent or has no value.
char* text(DomList* p, const char* name) {
  DomParam* r = option(p, name);
  return r && r->CharParam[0] ? r->CharParam : nullptr;
}

// An option of type I (digits only), or `fallback` when absent or empty.
int number(DomList* p, const char* name, int fallback) {
  char* v = text(p, name);
  return v ? static_cast<int>(std::min(strtol(v, nullptr, 10), static_cast<long>(INT_MAX)))
           : fallback;
}

// ---- commands ----

bool isBase(int base) { return base == 2 || base == 8 || base == 10 || base == 16; }

// Reads `value` as a Mint in base `base` (0: by its form); 0 after a message.
int readMint(const char* value, int base, unsigned int** m, int* cells) {
  if (base != 0 && !isBase(base)) {
    COMPLAIN("%s: base %d is not 2, 8, 10 or 16\n", session.command, base);
    return 0;
  }
  if (MintFromStr(value, m, cells, base)) return 1;
  COMPLAIN("%s: '%s' is not a number in base %d\n", session.command, value, base);
  return 0;
}

void cmdCopy(DomList* p) {
  if (FileCopyInterf(p)) say("copied %s to %s\n", text(p, "ifn"), text(p, "ofn"));
}

void cmdCat(DomList* p) {
  FILE* f = FOPEN(arg(p, 0), "r");  // a missing file ends the command through ExitToSession
  FileCopyFileToFile(f, MainEVarOutFile);
  fflush(MainEVarOutFile);
  FCLOSE(f);
}

void cmdMint(DomList* p) {
  int to = number(p, "to", 10), width = number(p, "width", 0);
  if (!isBase(to)) {
    COMPLAIN("mint: base %d is not 2, 8, 10 or 16\n", to);
    return;
  }
  if (width > 4096) {
    COMPLAIN("mint: width %d is more than 4096\n", width);
    return;
  }
  unsigned int* m;
  int cells;
  if (!readMint(arg(p, 0), number(p, "from", 0), &m, &cells)) return;
  char* digits = static_cast<char*>(vzl_calloc(cells * 32 + width + 3, 1));
  if (digits) {
    MintToStr(m, cells, width, to, option(p, "prefix") != nullptr, digits);
    say("%s\n", digits);
  } else {
    COMPLAIN("mint: out of memory\n");
  }
  vzl_free(digits);
  vzl_free(m);
}

void cmdBits(DomList* p) {
  unsigned int* m;
  int cells;
  if (!readMint(arg(p, 0), number(p, "from", 0), &m, &cells)) return;
  say("bits set in %s:", arg(p, 0));
  if (MintNotNull(m, cells))
    MintPrintBitsEqualTo1(MainEVarOutFile, m, cells);
  else
    say(" none");
  say("\n");
  vzl_free(m);
}

// "N label: [a] [b] ..." and releases the string list.
void sayList(DomList* list, const char* label) {
  say("%d %s:", recordCount(list), label);
  for (int i = 0; i < recordCount(list); ++i)
    say(" [%s]", reinterpret_cast<char*>(list->elements[i]));
  say("\n");
  ListDelete(&list, ListElemFree);
}

void cmdSplit(DomList* p) {
  char* sep = text(p, "sep");
  sayList(StrStringToList(arg(p, 0), sep ? sep[0] : ',', nullptr), "fields");
}

void cmdWords(DomList* p) { sayList(StrToWordList(arg(p, 0), " \t,;"), "words"); }

void cmdCompose(DomList* p) {
  int mode = number(p, "mode", 0);
  char* name = StrComposeName(arg(p, 0), text(p, "dir"), text(p, "suffix"), text(p, "ext"), mode);
  if (name)
    say("%s\n", name);
  else
    COMPLAIN("compose: no name for mode %d\n", mode);
  StrFree(&name);
}

void cmdExpand(DomList* p) {
  char* expanded = StrReplaceEnvVariable(arg(p, 0));
  say("%s\n", expanded ? expanded : arg(p, 0));
  StrFree(&expanded);
}

void cmdRange(DomList* p) {
  int from = number(p, "from", 0), to = number(p, "to", from);
  DomList* names = option(p, "hdl") ? StrCreateListHDLIndexStr(arg(p, 0), from, to)
                                    : StrCreateListIndexedStr(arg(p, 0), from, to);
  if (names) sayList(names, "names");  // a refused range was reported by the library
}

void cmdSetdef(DomList* p) { ParamDefSetStr(arg(p, 0), arg(p, 1)); }

void cmdGetdef(DomList* p) {
  char* value = ParamDefGetStr(arg(p, 0));
  if (value)
    say("%s = %s\n", arg(p, 0), value);
  else
    say("%s has no default\n", arg(p, 0));
  vzl_free(value);
}

void cmdDefs(DomList*) { ParamDefPrint(); }

void cmdRedirect(DomList* p) {
  FileRedirectMainOutFile(arg(p, 0));  // a file that cannot be opened ends the command
  ++session.depth;
}

void cmdRestore(DomList*) {
  if (session.depth == 0) {
    COMPLAIN("restore: no redirection to restore\n");
    return;
  }
  FileRestoreOldMainOutFile();
  --session.depth;
}

void cmdTmpname(DomList* p) {
  char* name = FileCreateNameInTmpWithExtension(text(p, "ext"));
  say("%s\n", name);
  StrFree(&name);
}

void cmdTmpdir(DomList*) { SystemCd(MainEVarOutFile, KERBTmpDir); }
void cmdPwd(DomList*) { SystemPwd(MainEVarOutFile); }
void cmdCd(DomList* p) { SystemCd(MainEVarOutFile, arg(p, 0)); }

void cmdMkdir(DomList* p) {
  if (mkdir(arg(p, 0), 0777) != 0) COMPLAIN("mkdir: %s: %s\n", arg(p, 0), strerror(errno));
}

void cmdRmdir(DomList* p) {
  if (rmdir(arg(p, 0)) != 0) COMPLAIN("rmdir: %s: %s\n", arg(p, 0), strerror(errno));
}

void cmdRm(DomList* p) {
  if (FileExist(arg(p, 0), "r"))
    FileRemoveFile(arg(p, 0));
  else
    COMPLAIN("rm: no file %s\n", arg(p, 0));
}

void cmdHelp(DomList*);
void cmdQuit(DomList*) { session.quit = true; }

struct Command {
  const char* name;
  const char* positional;  // first descriptor string: the positional arguments' types
  const char* options;     // second descriptor string: the options and their types
  void (*run)(DomList* params);
  const char* help;
};

const Command kCommands[] = {
    {"copy", "", "-ifn S -ofn S", cmdCopy, "copy file -ifn to file -ofn"},
    {"cat", "S", "", cmdCat, "write a file to the main output"},
    {"mint", "S", "-from I -to I -width I -prefix", cmdMint,
     "convert a number between bases 2, 8, 10, 16 (-from 0: by its form)"},
    {"bits", "S", "-from I", cmdBits, "numbers of the bits set in a number"},
    {"split", "S", "-sep S", cmdSplit, "fields of a text between separators (default ,)"},
    {"words", "S", "", cmdWords, "words of a text (blanks, commas, semicolons; \"...\" groups)"},
    {"compose", "S", "-dir S -suffix S -ext S -mode I", cmdCompose,
     "compose a file name from a name and pieces"},
    {"expand", "S", "", cmdExpand, "substitute $NAME environment references"},
    {"range", "S", "-from I -to I -hdl", cmdRange, "indexed names base<from> .. base<to>"},
    {"setdef", "S S", "", cmdSetdef, "set a global default (an empty value removes it)"},
    {"getdef", "S", "", cmdGetdef, "show a global default"},
    {"defs", "", "", cmdDefs, "list the global defaults"},
    {"redirect", "S", "", cmdRedirect, "send output and messages to a file (nests)"},
    {"restore", "", "", cmdRestore, "end the latest redirection"},
    {"tmpname", "", "-ext S", cmdTmpname, "a temporary file name, removed at the end"},
    {"tmpdir", "", "", cmdTmpdir, "change to the temporary directory"},
    {"pwd", "", "", cmdPwd, "show the working directory"},
    {"cd", "S", "", cmdCd, "change the working directory"},
    {"mkdir", "S", "", cmdMkdir, "make a directory"},
    {"rmdir", "S", "", cmdRmdir, "remove an empty directory"},
    {"rm", "S", "", cmdRm, "remove a file"},
    {"help", "", "", cmdHelp, "this list"},
    {"quit", "", "", cmdQuit, "stop reading commands"},
};

void cmdHelp(DomList*) {
  say("commands (positional types, then options; S text, I digits, no type: a flag):\n");
  for (const Command& c : kCommands)
    say("  %-8s %-3s %-32s %s\n", c.name, c.positional, c.options, c.help);
}

// Edit distance, for suggesting the command that was probably meant.
size_t distance(const std::string& a, const std::string& b) {
  std::vector<size_t> row(b.size() + 1);
  for (size_t j = 0; j <= b.size(); ++j) row[j] = j;
  for (size_t i = 1; i <= a.size(); ++i) {
    size_t diagonal = row[0];
    row[0] = i;
    for (size_t j = 1; j <= b.size(); ++j) {
      size_t above = row[j];
      row[j] = std::min({row[j] + 1, row[j - 1] + 1, diagonal + (a[i - 1] != b[j - 1])});
      diagonal = above;
    }
  }
  return row[b.size()];
}

const Command* nearest(const char* name) {
  const Command* best = &kCommands[0];
  for (const Command& c : kCommands)
    if (distance(name, c.name) < distance(name, best->name)) best = &c;
  return best;
}

const Command* find(const char* name) {
  for (const Command& c : kCommands)
    if (strcasecmp(c.name, name) == 0) return &c;
  return nullptr;
}

// ---- the session loop ----

// Runs one line: the command name, then the parameter string checked against
// the command's two descriptor strings.
void runLine(char* line) {
  line[strcspn(line, "\r\n")] = '\0';
  char* name = line + strspn(line, " \t");
  if (*name == '\0' || *name == '#') return;
  if (session.echo) say("> %s\n", name);
  char* params = name + strcspn(name, " \t");
  if (*params) *params++ = '\0';
  const Command* c = find(name);
  if (!c) {
    COMPLAIN("unknown command '%s' (did you mean '%s'? 'help' lists the commands)\n", name,
             nearest(name)->name);
    return;
  }
  session.command = c->name;
  // The checker only reads the descriptor strings.
  if (!ParamCheckParamList(name, params, const_cast<char*>(c->positional),
                           const_cast<char*>(c->options), &session.params)) {
    COMPLAIN("%s: parameters '%s' rejected; %s takes \"%s\" \"%s\"\n", c->name, params, c->name,
             c->positional, c->options);
  } else {
    unquoteValues(session.params);
    c->run(session.params);
  }
  ListDelete(&session.params, freeParam);
}

long long fixedClock = 0;
long long readFixedClock() { return fixedClock; }

void endSession() {
  for (; session.depth > 0; --session.depth) FileRestoreOldMainOutFile();
  FileRemoveAllFilesInTmp();
  ParamDefFree();  // before ListKill: the defaults are a list, invalid once the pool is gone
  ListKill();
  UnsetQelMsgMan();
  StrFree(&KERBTmpDir);
  free(session.line);
  if (session.script != stdin) fclose(session.script);
}

int usage() {
  fprintf(stderr, "usage: duduzu-shell [-log FILE] [-intstyle] [script]\n");
  return 1;
}

}  // namespace

int main(int argc, char** argv) {
  char* log = nullptr;
  char* scriptName = nullptr;
  bool intStyle = false;
  for (int i = 1; i < argc; ++i) {
    if (strcmp(argv[i], "-log") == 0 && i + 1 < argc) {
      log = argv[++i];
    } else if (strcmp(argv[i], "-intstyle") == 0) {
      intStyle = true;
    } else if (strcmp(argv[i], "-clock") == 0 && i + 1 < argc) {
      fixedClock = atoll(argv[++i]);
      SystemSetClock(readFixedClock);
    } else if (argv[i][0] != '-' && !scriptName) {
      scriptName = argv[i];
    } else {
      return usage();
    }
  }
  session.script = scriptName ? FileExistThenOpenRead(scriptName) : stdin;
  if (!session.script) {
    fprintf(stderr, "duduzu-shell: cannot read %s\n", scriptName);
    return 1;
  }
  bool interactive = !scriptName && isatty(STDIN_FILENO);
  session.echo = !interactive;

  SetQelMsgMan(log, intStyle, false);
  MainEVarOutFile = stdout;
  KERBTmpDir = SystemGetTempPath();
  if (setjmp(RestartSession) != 0) {
    // A fatal condition ended the command: report its status, drop its parameters.
    say("line %d: %s: return status %d\n", session.lineNumber, session.command,
        MainEVarReturnStatus);
    ListDelete(&session.params, freeParam);
  }
  while (!session.quit) {
    if (interactive) {
      fputs("duduzu> ", stdout);
      fflush(stdout);
    }
    if (getline(&session.line, &session.lineSize, session.script) < 0) {
      if (interactive) fputs("\n", stdout);
      break;
    }
    ++session.lineNumber;
    runLine(session.line);
  }
  endSession();
  return 0;
}

// Tracked file handles and file helpers: the open-file list, existence tests,
// fall-back opening, copying and file-name splitting.
#include <strings.h>
#include <unistd.h>

#include <cstdint>
#include <cstring>

#include "duduzu/file.h"
#include "duduzu/intutil.h"
#include "duduzu/list.h"
#include "duduzu/str.h"
#include "file/openfiles.h"
#include "frame/unit.h"
#include "list/keptlist.h"

namespace {

constexpr const char* kUnit = "../s/fileutil";

KeptList openFiles;  // handles of the tracked opens; made by the first one

// The stream's status-flag word: glibc's FILE::_flags, low 16 bits as signed.
int flagWord(FILE* stream) { return static_cast<int16_t>(stream->_flags); }

FILE* openAlternate(const char* name, const char* altDir, int report, const char* mode) {
  if (!name) return nullptr;
  FILE* f = fopen(name, mode);
  if (f || !altDir) return f;
  char* candidate = StrCopy(altDir);  // altDir brings its own separator
  StrSafeCatPX(&candidate, name);
  f = candidate ? fopen(candidate, mode) : nullptr;
  if (!f && report) DZ_REPORT(Error, "File not found : %s\n", name);
  StrFree(&candidate);
  return f;
}

// Lets the kernel copy between the descriptors of two streams that have
// nothing buffered yet. It stops at the end or at the first refusal (a pipe,
// another file system); the stdio copy then goes on from the same offsets.
void kernelCopy(FILE* from, FILE* to) {
  while (copy_file_range(fileno(from), nullptr, fileno(to), nullptr, size_t{1} << 30, 0) > 0) {
  }
}

// New copy of the first len characters of name.
char* prefixCopy(const char* name, size_t len) {
  char* r = StrCopy(name);
  if (r) r[len] = '\0';
  return r;
}

}  // namespace

FILE* KERB_FOPEN(const char* name, const char* mode) {
  FILE* f = fopen(name, mode);
  DomList*& open = openFiles.get();
  if (f && !open) open = ListCreate();
  if (f && open) ListAddElt(open, reinterpret_cast<int*>(f));
  return f;
}

FILE* FOPEN(const char* name, const char* mode) {
  FILE* f = KERB_FOPEN(name, mode);
  if (!f) {
    DZ_REPORT(Status, "\nCan not Open File : %s !\n", name);
    MainEVarReturnStatus = 5;
    ExitToSession(5);
  }
  return f;
}

int FCLOSE(FILE* stream) {
  int before = flagWord(stream);
  // glibc releases every stream but the standard three when closing it; the
  // word of a released stream reads 0.
  FILE* kept = stream == stdin ? stdin : stream == stdout ? stdout : stream == stderr ? stderr : nullptr;
  // Handles are compared whole: an int would hold only part of a 64-bit one.
  int pos = ListMemberOfList(openFiles.get(), reinterpret_cast<int*>(stream), PtrIdentical);
  if (pos) ListDelInsert(openFiles.get(), pos);
  int result = fclose(stream);
  if (result != 0)
    DZ_REPORT(Status, "\nCan not Close File [%d/%d]!\n", before, kept ? flagWord(kept) : 0);
  return result;
}

void FileCloseAllTracked() {
  DomList* list = openFiles.get();
  openFiles.get() = nullptr;  // detached first, so FCLOSE leaves the walk alone
  for (int i = 0; list && i < list->count; ++i) FCLOSE(reinterpret_cast<FILE*>(list->elements[i]));
  ListQuickDelete(&list);
}

FILE* FileExistThenOpenRead(const char* name) { return name ? fopen(name, "r") : nullptr; }

FILE* FileOpenWrite(const char* name) { return name ? fopen(name, "w") : nullptr; }

FILE* FileOpenReadAlternate(const char* name, const char* altDir, int report) {
  return openAlternate(name, altDir, report, "r");
}

FILE* FileOpenWriteAlternate(const char* name, const char* altDir, int report) {
  return openAlternate(name, altDir, report, "w");
}

int FileExist(const char* name, const char* mode) {
  if (!name || !mode) return 0;
  FILE* f = !strcasecmp(mode, "r")   ? FileExistThenOpenRead(name)
            : !strcasecmp(mode, "w") ? FileOpenWrite(name)
                                     : nullptr;
  if (!f) return 0;
  FCLOSE(f);
  return 1;
}

void FileCopyFileToFile(FILE* from, FILE* to) {
  // Buffered: the same bytes as a character-by-character copy, in large blocks.
  char buf[65536];
  for (size_t n; (n = fread(buf, 1, sizeof buf, from)) > 0;) fwrite(buf, 1, n, to);
}

int FileCopyFileNameToFile(char* fromName, FILE* to) {
  FILE* from = FileExistThenOpenRead(fromName);
  if (!from) return 0;
  FileCopyFileToFile(from, to);
  FCLOSE(from);
  return 1;
}

int FileCopyFileNameToFileName(char* fromName, char* toName) {
  FILE* from = FileExistThenOpenRead(fromName);
  if (!from) return 0;
  FILE* to = FileOpenWrite(toName);
  if (!to) {
    FCLOSE(from);
    return 0;
  }
  kernelCopy(from, to);
  FileCopyFileToFile(from, to);
  FCLOSE(from);
  FCLOSE(to);
  return 1;
}

void FileRemoveFile(const char* name) {
  if (FileExist(name, "r")) remove(name);
}

char* FileRemoveExtension(const char* name) {
  if (!name) return nullptr;
  const char* sep = StrChrSlash(name);
  const char* dot = strchr(sep ? sep + 1 : name, '.');
  return prefixCopy(name, dot ? static_cast<size_t>(dot - name) : strlen(name));
}

char* FileGetDirName(char* name) {
  if (!name) return nullptr;
  const char* sep = StrChrSlash(name);
  return prefixCopy(name, sep ? static_cast<size_t>(sep - name) + 1 : 0);
}

char* FileGetFileExtension(char* name) {
  if (!name) return nullptr;
  // From the last character down to the second; the first is never examined.
  for (size_t i = strlen(name); i-- > 1;) {
    if (name[i] == '.') return StrCopy(name + i + 1);
    if (name[i] == '/' || name[i] == '\\' || name[i] == ':') return nullptr;
  }
  return nullptr;
}

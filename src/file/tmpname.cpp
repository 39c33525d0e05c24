// Temporary names and the end-of-session clean-up.
#include <cstdio>
#include <cstring>

#include "duduzu/file.h"
#include "duduzu/list.h"
#include "duduzu/str.h"
#include "duduzu/system.h"
#include "file/openfiles.h"
#include "frame/unit.h"
#include "list/keptlist.h"
#include "str/strbuild.h"

namespace {

unsigned nameCounter = 0;        // names made so far; never reset
KeptList cleanNames(ListElemFree);  // owned copies of the names to remove at the end

// The w least significant base-36 digits of v ("0"-"9", "a"-"z"), most
// significant first, zero-padded, in out (w + 1 bytes).
void base36Field(unsigned v, int w, char* out) {
  out[w] = '\0';
  for (int i = w - 1; i >= 0; --i, v /= 36) out[i] = "0123456789abcdefghijklmnopqrstuvwxyz"[v % 36];
}

// KERBTmpDir, or the current directory (an empty prefix) when it is not set.
const char* tmpDir() { return KERBTmpDir ? KERBTmpDir : ""; }

// Adds a copy of name to the clean-up list; false when memory ran out.
bool registerForClean(const char* name) {
  DomList*& cleanList = cleanNames.get();
  if (!cleanList) cleanList = ListCreate();
  char* copy = cleanList ? StrCopy(name) : nullptr;
  if (copy) ListAddElt(cleanList, reinterpret_cast<int*>(copy));
  return copy != nullptr;
}

}  // namespace

char* FileRandomNameNoExtension() {
  char* name = static_cast<char*>(vzl_calloc(255, 1));
  if (!name) return nullptr;
  char process[5], counter[4];
  base36Field(static_cast<unsigned>(SystemGetPID()), 4, process);
  base36Field(nameCounter++, 3, counter);
  snprintf(name, 255, "p%s%s", process, counter);
  return name;
}

char* FileCreateNameInTmpWithExtension(const char* extension) {
  char* name = FileRandomNameNoExtension();
  if (!name) return nullptr;
  char* path = dz::HeapPrintf("%s%s%s%s", tmpDir(), name, extension ? "." : "",
                              extension ? extension : "");
  StrFree(&name);
  if (path && !registerForClean(path)) StrFree(&path);
  return path;
}

char* FileCreateRandomName() { return FileCreateNameInTmpWithExtension("tmp"); }

void FileAddFileNameForCleanOnExit(char* name) {
  if (name) registerForClean(name);
}

void FileRemoveAllFilesInTmp() {
  FileCloseAllTracked();  // open files can be removed only once closed
  DomList*& cleanList = cleanNames.get();
  for (int i = 0; cleanList && i < cleanList->count; ++i)
    FileRemoveFile(reinterpret_cast<char*>(cleanList->elements[i]));
  ListDelete(&cleanList, ListElemFree);
  // Sized to fit whatever the directory's length.
  char* ren = dz::HeapPrintf("%skerb%d.ren", tmpDir(), SystemGetPID());
  FileRemoveFile(ren);  // a null name is passed over
  vzl_free(ren);
}

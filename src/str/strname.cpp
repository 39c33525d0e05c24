// File-name composition and substitution of $NAME environment references.
#include <cstring>

#include "duduzu/str.h"
#include "duduzu/strname.h"
#include "frame/unit.h"
#include "str/strbuild.h"

namespace {

// Start of the file part: just behind the last backslash, or else the last slash.
const char* filePart(const char* name) {
  const char* slash = StrChrSlash(name);
  return slash ? slash + 1 : name;
}

}  // namespace

char* StrComposeName(char* name, const char* dir, const char* suffix, const char* ext, int mode) {
  if (mode < 0 || mode > 4) return nullptr;
  const char* file = name ? filePart(name) : nullptr;
  const char* oldExt = file ? strrchr(file, '.') : nullptr;
  return dz::BuildString([&](auto emit) {
    auto put = [&](const char* s) {
      if (s) emit(s, strlen(s));
    };
    auto putExt = [&](bool keepOld) {
      if (ext && *ext != '.') emit(".", 1);
      put(ext ? ext : keepOld ? oldExt : nullptr);
    };
    if (!name) {
      put(dir);
      put(suffix);
      putExt(false);
      return;
    }
    size_t dirLength = static_cast<size_t>(file - name);
    if (mode == 4) {
      put(dir);
      if (dirLength) emit(name, dirLength);
      put(suffix);
      putExt(false);
      return;
    }
    if (mode == 2) emit(name, dirLength);
    put(dir);
    emit(file, oldExt ? static_cast<size_t>(oldExt - file) : strlen(file));
    put(suffix);
    putExt(mode == 1 || mode == 2);
  });
}

char* StrComposeBaseName(const char* path) {
  if (!path) return nullptr;
  const char* file = filePart(path);
  return dz::CopyChars(file, strcspn(file, "."));
}

// The reference names are cut out of a work copy, so s itself is only read.
char* StrReplaceEnvVariable(char* s) {
  if (!s || !strchr(s, '$')) return nullptr;
  char* work = dz::CopyChars(s, strlen(s));
  if (!work) return nullptr;
  bool substituted = false;
  char* result = dz::BuildString([&](auto emit) {
    for (char* p = work; *p;) {
      if (*p == '$') {
        size_t n = 1 + strcspn(p + 1, "/\\");  // the reference, '$' included
        char end = p[n];
        p[n] = '\0';
        const char* value = Port_Env::GetEnv(p + 1);
        p[n] = end;
        if (value) {
          emit(value, strlen(value));
          substituted = true;
        } else {
          emit(p, n);
        }
        p += n;
      }
      size_t literal = strcspn(p, "$");
      emit(p, literal);
      p += literal;
    }
  });
  vzl_free(work);
  if (!substituted) StrFree(&result);
  return result;
}

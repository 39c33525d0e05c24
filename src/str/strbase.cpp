// String primitives: heap copies, comparisons, case folding, reading and
// printing, character removal and the safe concatenation and copy routines.
#include <strings.h>

#include <algorithm>
#include <cctype>
#include <cstdarg>
#include <cstring>

#include "duduzu/str.h"
#include "frame/unit.h"
#include "str/strbuild.h"

namespace {

constexpr const char* kUnit = "../s/strutil";

// Zero-filled block for a string of len characters (null when memory is out).
char* newBlock(size_t len) { return static_cast<char*>(vzl_calloc(len + 1, 1)); }

int sign(int v) { return (v > 0) - (v < 0); }

}  // namespace

char* StrCopy(const char* s) {
  size_t len = strlen(s);
  char* r = newBlock(len);
  if (r) memcpy(r, s, len);
  return r;
}

void StrFree(char** p) {
  vzl_free(*p);
  *p = nullptr;
}

int StrCmpRobust(const char* a, const char* b) {
  if (!a || !b) return 1;
  return sign(strcmp(a, b));
}

int StrCmpNoCase(const char* a, const char* b) {
  if (!a || !b) return a != b;
  return strcasecmp(a, b);
}

int StrCmpNoCaseN(const char* a, const char* b, int n) {
  return strncasecmp(a, b, static_cast<size_t>(n));
}

int StrIdentical(const char* a, const char* b) {
  if (!a || !b) return a == b;
  return strcasecmp(a, b) == 0;
}

int StrCaseIdentical(const char* a, const char* b) {
  if (!a || !b) return a == b;
  return strcmp(a, b) == 0;
}

int StrInEnumOfStrNC(const char* s, int count, ...) {
  if (!s) return 0;
  va_list ap;
  va_start(ap, count);
  int found = 0;
  for (int i = 1; i <= count && !found; ++i) {
    const char* e = va_arg(ap, const char*);
    if (e && strcasecmp(s, e) == 0) found = i;
  }
  va_end(ap);
  return found;
}

int StrFirstCharIsAlpha(char* s) { return isalpha(static_cast<unsigned char>(*s)); }

void StrUpper(char* s) {
  for (; s && *s; ++s) {
    unsigned char c = static_cast<unsigned char>(*s);
    if (isalpha(c) && islower(c)) *s = static_cast<char>(toupper(c));
  }
}

void StrLower(char* s) {
  for (; s && *s; ++s) {
    unsigned char c = static_cast<unsigned char>(*s);
    if (isalpha(c) && isupper(c)) *s = static_cast<char>(tolower(c));
  }
}

char* ToLowerStr(char* s) {
  for (char* c = s; c && *c; ++c) *c = static_cast<char>(tolower(static_cast<unsigned char>(*c)));
  return s;
}

void StrReverse(char* s) { std::reverse(s, s + strlen(s)); }

void StrInitChar(int n, char c, char* buf) {
  int k = std::max(n, 0);
  memset(buf, c, static_cast<size_t>(k));
  buf[k] = '\0';
}

// Characters beyond n - 1 are read and dropped up to the white space; the
// terminator then replaces the last stored character (normally that white
// space). At the end of the stream the stored characters are all kept.
char StrReadName(char* buf, int n, FILE* f) {
  int stored = 0;
  for (;;) {
    int c = getc(f);
    if (c == EOF) {
      buf[stored] = '\0';
      return '\0';
    }
    if (stored < n - 1) buf[stored++] = static_cast<char>(c);
    if (isspace(c)) {
      buf[stored > 0 ? stored - 1 : 0] = '\0';
      return static_cast<char>(c);
    }
  }
}

void StrRead(char* buf, FILE* f) {
  if (fscanf(f, "%s", buf) != 1) *buf = '\0';
}

void StrPrint(FILE* f, const char* s) { DZ_OUT(f, "%s", s); }

void StrLeftCat(char* prefix, char* dst) {
  size_t len = strlen(prefix);
  memmove(dst + len, dst, strlen(dst) + 1);
  memcpy(dst, prefix, len);
}

char* StrChr(char* s, char c) { return s && c ? strrchr(s, c) : nullptr; }

char* StrChrSlash(const char* s) {
  if (!s) return nullptr;
  const char* r = strrchr(s, '\\');
  return const_cast<char*>(r ? r : strrchr(s, '/'));
}

// The block is sized for s and zero-filled, so the result is terminated
// however many characters are dropped.
char* StrRemoveChar(char* s, char c) {
  char* r = newBlock(strlen(s));
  if (!r) return nullptr;
  for (char* w = r; *s; ++s)
    if (*s != c) *w++ = *s;
  return r;
}

char* StrRemoveCharInFront(char* s, char c) {
  while (c && *s == c) ++s;
  return StrCopy(s);
}

void StrRemoveDoubleSlash(char** pp) {
  for (char* slash = strchr(*pp, '/'); slash; slash = strchr(*pp, '/')) {
    if (slash[1] != '/') {
      *pp = slash + 1;
      continue;
    }
    *pp = slash + strspn(slash, "/");
    return;
  }
}

// The new block is filled before the old one is freed, so src may point into *p.
void StrSafeCatPX(char** p, const char* src) {
  if (!src) {
    DZ_REPORT(Fatal, "Data corruption (StrSafeCatPX) - Null string\n");
    return;
  }
  if (!*p) {
    *p = StrCopy(src);
    return;
  }
  size_t head = strlen(*p), tail = strlen(src);
  char* r = newBlock(head + tail);
  if (!r) return;
  memcpy(r, *p, head);
  memcpy(r + head, src, tail);
  vzl_free(*p);
  *p = r;
}

// Appends what fits; a buffer already full (or size < 1) gets nothing.
void StrSafeCatTX(char* dst, const char* src, int size) {
  if (!src) return;
  if (!dst) {
    DZ_REPORT(Fatal, "Data corruption (StrSafeCatTX) - Null string\n");
    return;
  }
  long long head = static_cast<long long>(strlen(dst));
  long long tail = static_cast<long long>(strlen(src));
  long long room = static_cast<long long>(size) - 1 - head;
  if (tail >= room) DZ_REPORT(Warning, "Name truncation in StrSafeCatTX : %s\n", dst);
  if (room <= 0) return;
  size_t n = static_cast<size_t>(std::min(tail, room));
  memcpy(dst + head, src, n);
  dst[head + static_cast<long long>(n)] = '\0';
}

int StrSafeCopyTX(char* dst, const char* src, int size, int /*flag*/) {
  if (!src) {
    if (dst) *dst = '\0';
    return 1;
  }
  if (!dst) {
    DZ_REPORT(Fatal, "Data corruption (StrSafeCopyTX) - Null string\n");
    return 0;
  }
  size_t len = strlen(src);
  if (size < 1 || len > static_cast<size_t>(size) - 1) {
    DZ_REPORT(Fatal, "Data corruption (StrSafeCopyTX) - String overflow\n");
    return 0;
  }
  memcpy(dst, src, len + 1);
  return 1;
}

int StrIntNbOfChar(int n) {
  if (n < 0) return -1;
  int count = 1;
  for (; n >= 10; n /= 10) ++count;
  return count;
}

char* dz::HeapPrintf(const char* fmt, ...) {
  va_list ap, again;
  va_start(ap, fmt);
  va_copy(again, ap);
  int len = vsnprintf(nullptr, 0, fmt, ap);
  va_end(ap);
  char* s = len < 0 ? nullptr : static_cast<char*>(vzl_calloc(static_cast<size_t>(len) + 1, 1));
  if (s) vsnprintf(s, static_cast<size_t>(len) + 1, fmt, again);
  va_end(again);
  return s;
}

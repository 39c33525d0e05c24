// String lists: splitting at a separator, into tokens and into quoted words;
// finding, appending and printing; indexed names and lists of them.
#include <strings.h>

#include <algorithm>
#include <climits>
#include <cstring>

#include "duduzu/str.h"
#include "duduzu/strlist.h"
#include "frame/unit.h"
#include "str/strbuild.h"

namespace {

constexpr const char* kUnit = "../s/strutil";

char* eltAt(DomList* list, int i) { return reinterpret_cast<char*>(list->elements[i]); }

// Appends s, which the list then owns; false (nothing added) for a null s,
// which is what an allocation that ran out gives.
bool addOwned(DomList* list, char* s) {
  if (s) ListAddElt(list, reinterpret_cast<int*>(s));
  return s != nullptr;
}

bool addCopy(DomList* list, const char* p, size_t n) { return addOwned(list, dz::CopyChars(p, n)); }

// Releases a list being built and its strings; null for the caller to return.
DomList* discard(DomList* list) {
  ListDelete(&list, ListElemFree);
  return nullptr;
}

// Cuts a copy of s into the tokens strtok would give and hands each to
// take(list, token, length), which answers false when memory runs out. The
// reentrant tokenizer keeps its position locally, so a caller's own strtok
// scan goes on undisturbed. The copy is freed on every path.
template <class Take>
DomList* splitTokens(const char* s, const char* delims, Take take) {
  if (!s || !delims) return nullptr;
  char* work = dz::CopyChars(s, strlen(s));
  DomList* list = work ? ListCreateWithSize(4) : nullptr;
  bool ok = list != nullptr;
  char* position = nullptr;
  for (char* t = ok ? strtok_r(work, delims, &position) : nullptr; ok && t;
       t = strtok_r(nullptr, delims, &position))
    ok = take(list, t, strlen(t));
  vzl_free(work);
  return ok ? list : discard(list);
}

// Decimal text of a non-negative i in buf; returns its length.
size_t decimal(long i, char (&buf)[24]) {
  return static_cast<size_t>(snprintf(buf, sizeof buf, "%ld", i));
}

// New heap string: base (when not null) followed by i, in angle brackets for
// the bus form.
char* indexedName(const char* base, long i, bool bus) {
  char number[24];
  size_t n = decimal(i, number);
  return dz::BuildString([&](auto emit) {
    if (base) emit(base, strlen(base));
    if (bus) emit("<", 1);
    emit(number, n);
    if (bus) emit(">", 1);
  });
}

char* appendIndex(const char* base, long i) {
  if (i < 0) {
    DZ_REPORT(Fatal, "Data corruption (StrAppendIndexToStr) - Negative index\n");
    return nullptr;
  }
  return indexedName(base, i, false);
}

// List of name(i) for i = from .. to, after the range check shared by both forms.
template <class Name>
DomList* indexedList(int from, int to, const char* refusal, Name name) {
  if (from > to || from < 0) {
    DZ_REPORT(Fatal, refusal);
    return nullptr;
  }
  long count = static_cast<long>(to) - from + 1;
  DomList* list = ListCreateWithSize(static_cast<int>(std::min<long>(count, INT_MAX)));
  if (!list) return nullptr;
  for (long i = from; i <= to; ++i)
    if (!addOwned(list, name(static_cast<int>(i)))) return discard(list);
  return list;
}

void printElt(FILE* f, int* e) { StrPrint(f, reinterpret_cast<const char*>(e)); }

}  // namespace

DomList* StrStringToList(const char* s, char sep, const char* skip) {
  DomList* list = ListCreate();
  if (!list) return nullptr;
  for (const char* p = s;;) {
    const char* end = sep ? strchr(p, sep) : nullptr;
    size_t n = end ? static_cast<size_t>(end - p) : strlen(p);
    bool skipped = skip && strncasecmp(p, skip, n) == 0 && skip[n] == '\0';
    if ((end || n > 0) && !skipped && !addCopy(list, p, n)) return discard(list);
    if (!end) return list;
    p = end + 1;
  }
}

DomList* StrToTokenList(const char* s, const char* delims) {
  return splitTokens(s, delims, addCopy);
}

// The group text is gathered in place in the scanned copy: each token lies
// beyond the text gathered so far, so the joined text never overtakes the scan.
DomList* StrToWordList(const char* s, const char* delims) {
  bool open = false;
  char* group = nullptr;  // group text, null when there is none
  char* groupEnd = nullptr;
  auto start = [&](char* t, size_t n) {
    group = t;
    groupEnd = t + n;
    open = true;
  };
  auto gather = [&](char* t, size_t n) {
    if (!group) return start(t, n);
    *groupEnd++ = ' ';
    memmove(groupEnd, t, n);
    groupEnd += n;
  };
  return splitTokens(s, delims, [&](DomList* list, char* t, size_t n) {
    bool starts = t[0] == '"', ends = t[n - 1] == '"', lone = n == 1 && starts;
    // A token with no quote at either end outside a group is a word by itself.
    if (!open && !starts && !ends) return addCopy(list, t, n);
    // A lone quote opens a group; so does a token starting, not ending, with one.
    if (lone ? !open : starts && !ends) {
      start(t, n);
      return true;
    }
    // A token quoted at both ends is a word by itself and ends the group (the
    // text gathered so far stays for a later closing token).
    if (starts && !lone) {
      open = false;
      return addCopy(list, t, n);
    }
    gather(t, n);
    if (!ends) return true;
    // A lone quote inside a group, or a token ending with one, closes the group.
    open = false;
    char* word = group;
    group = nullptr;
    return addCopy(list, word, static_cast<size_t>(groupEnd - word));
  });
}

int StrStringInList(DomList* list, char* s) {
  for (int i = list ? list->count : 0; i > 0; --i)
    if (StrCaseIdentical(eltAt(list, i - 1), s)) return i;
  return 0;
}

int StrInsertInList(DomList* list, char* s) {
  return addCopy(list, s, strlen(s)) ? list->count : 0;
}

void StrListPrint(FILE* f, DomList* list, const char* sep) { ListPrint(f, list, printElt, sep); }

// Lengths are compared as unsigned quantities, so a negative width never wraps.
char* StrListNicePrint(DomList* list, const char* sep, const char* indent, int width) {
  size_t sepLength = strlen(sep), indentLength = strlen(indent);
  size_t limit = static_cast<size_t>(static_cast<unsigned>(width));
  int count = list ? list->count : 0;
  return dz::BuildString([&](auto emit) {
    size_t total = 0, line = indentLength;
    auto put = [&](const char* p, size_t n) {
      emit(p, n);
      total += n;
    };
    put(indent, indentLength);
    for (int i = 0; i < count; ++i) {
      const char* e = eltAt(list, i);
      size_t n = strlen(e);
      if (total + sepLength + n > 1020) return put("...", 3);
      // An element too long for any line goes on a fresh line without a break.
      if (line + sepLength + n > limit && !(n > limit && line == indentLength)) {
        put("\n", 1);
        put(indent, indentLength);
        line = indentLength;
      }
      put(e, n);
      if (i + 1 < count) put(sep, sepLength);
      line += n + sepLength;
    }
  });
}

char* StrAppendIndexToStr(const char* base, int i) { return appendIndex(base, i); }

char* StrAppendIndexToStr(const char* base, long i) { return appendIndex(base, i); }

void StrCatIndexToStrPX(char** p, long i) {
  if (i < 0) {
    DZ_REPORT(Fatal, "Data corruption (StrCatIndexToStrPX) - Negative index\n");
    return;
  }
  char number[24];
  decimal(i, number);
  StrSafeCatPX(p, number);
}

DomList* StrCreateListIndexedStr(const char* base, int from, int to) {
  return indexedList(from, to, "Data corruption (StrCreateListIndexedStr) - Incorrect indices\n",
                     [&](int i) { return indexedName(base, i, false); });
}

DomList* StrCreateListHDLIndexStr(const char* base, int from, int to) {
  return indexedList(from, to, "Data corruption (StrCreateListHDLIndexStr) - Incorrect indices\n",
                     [&](int i) { return to == 0 ? StrCopy(base) : indexedName(base, i, true); });
}

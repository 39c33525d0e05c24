// Command strings: word extraction, parsing of parameter and descriptor
// strings into parameter lists, and the check of parameters against the
// declarations of a command.
#include <strings.h>

#include <cctype>
#include <cstring>
#include <string>
#include <vector>

#include "duduzu/str.h"
#include "frame/unit.h"
#include "param/paramlist.h"

namespace {

constexpr const char* kUnit = "../s/paramutl";
constexpr size_t kWordMax = 999;               // characters kept of one word
constexpr size_t kFramedRoom = kWordMax + 3;   // with both quotes and the terminator

// One word of a command string: its text (without quotes) and its quotes.
struct Word {
  const char* text;
  size_t len;
  bool quoted;  // began with a double quote
  bool closed;  // and a closing one was found
};

// Skips white space and delimits the next word, leaving *cursor behind it
// (behind the closing quote if any); false at the end of the string.
bool scanWord(char** cursor, Word* w) {
  if (!cursor || !*cursor) return false;
  char* p = *cursor;
  while (isspace(static_cast<unsigned char>(*p))) ++p;
  *cursor = p;
  if (!*p) return false;
  w->quoted = *p == '"';
  if (w->quoted) {
    ++p;
    const char* end = strchr(p, '"');
    w->closed = end != nullptr;
    w->len = end ? static_cast<size_t>(end - p) : strlen(p);
  } else {
    w->closed = false;
    w->len = strcspn(p, " \t\n\v\f\r");
  }
  w->text = p;
  *cursor = p + w->len + w->closed;
  return true;
}

// Writes at most 999 characters of the word's text to dst, terminated, and
// returns how many. A longer text is cut by StrSafeCatTX, which warns; it
// reads on past the word but takes only characters of the word.
size_t keepText(char* dst, const Word& w) {
  *dst = '\0';
  if (w.len >= kWordMax) {
    StrSafeCatTX(dst, w.text, static_cast<int>(kWordMax + 1));
    return kWordMax;
  }
  memcpy(dst, w.text, w.len);
  dst[w.len] = '\0';
  return w.len;
}

// The word framed by the quotes that were present; dst holds kFramedRoom.
void frameWord(char* dst, const Word& w) {
  if (w.quoted) *dst++ = '"';
  dst += keepText(dst, w);
  if (w.closed) *dst++ = '"';
  *dst = '\0';
}

bool isPositional(DomParam* p) { return p->CharParamQual[0] == '\0'; }

// Splits a parameter or descriptor string into (name, value) pairs handed to
// emit in order: positional words (empty name), then options each followed by
// at most one value. False on a syntax error or when emit refuses a pair.
template <class Emit>
bool parseWords(char* text, Emit emit) {
  enum { kPositional, kOption, kValued } state = kPositional;
  char word[kFramedRoom], name[kFramedRoom];
  Word w;
  for (;;) {
    bool more = scanWord(&text, &w);
    if (more) frameWord(word, w);
    if (state == kOption && (!more || word[0] == '-') && !emit(name, "")) return false;
    if (!more) return true;
    if (word[0] == '-') {
      strcpy(name, word + 1);
      state = kOption;
    } else if (state == kValued) {
      return false;
    } else {
      if (!emit(state == kOption ? name : "", word)) return false;
      state = state == kOption ? kValued : kPositional;
    }
  }
}

// Parses into a new parameter list in *out; null when the string holds no
// word, and null with false on a syntax error or a record that cannot be made.
bool parseParams(char* text, DomList** out) {
  *out = nullptr;
  bool ok = parseWords(text, [out](const char* name, const char* value) {
    if (!*out) *out = ListCreate();
    DomParam* p = *out ? ParamCreateParam(name, value) : nullptr;
    if (p) ListAddElt(*out, reinterpret_cast<int*>(p));
    return p != nullptr;
  });
  if (!ok) ListDelete(out, ParamFreeSlot);
  return ok;
}

// One declaration of a descriptor: an argument (empty name) or an option,
// with its type code.
struct Decl {
  std::string name, code;
};

// Appends the declarations of a descriptor string, under the limits of records.
bool parseDecls(char* text, std::vector<Decl>* decls) {
  return parseWords(text, [decls](const char* name, const char* code) {
    if (!ParamFits(name, code)) return false;
    decls->push_back({name, code});
    return true;
  });
}

// "S" takes anything, "I" digits only, the empty code (a flag) only the empty
// value; other codes take nothing.
bool typeAccepts(const std::string& code, const char* value) {
  if (code == "S") return true;
  if (code == "I") return StrIsDecimal(value);
  return code.empty() && !*value;
}

// No two named records share a name, compared with case.
bool namesUnique(DomList* u) {
  for (int i = 1; i <= u->count; ++i) {
    const char* a = ParamAt(u, i)->CharParamQual;
    for (int j = i + 1; *a && j <= u->count; ++j) {
      const char* b = ParamAt(u, j)->CharParamQual;
      if (a[0] == b[0] && strcmp(a, b) == 0) return false;
    }
  }
  return true;
}

// First declaration named `name` ignoring case; null when none. Names of
// another length are passed over without comparing.
const Decl* findDecl(const std::vector<Decl>& d, const char* name) {
  size_t len = strlen(name);
  for (const Decl& decl : d)
    if (decl.name.size() == len && strcasecmp(decl.name.c_str(), name) == 0) return &decl;
  return nullptr;
}

// The user's parameters U against the declarations D: the positional
// arguments in order and all of them, then each option with its declared
// type (undeclared options are skipped with a warning), no option twice.
bool accepts(DomList* u, const std::vector<Decl>& d) {
  int dn = static_cast<int>(d.size()), un = u ? u->count : 0;
  if (dn == 0) return un == 0;
  if (un == 0) return !d[0].name.empty();
  int i = 0, j = 1;
  for (; i < dn && d[i].name.empty() && j <= un; ++i, ++j)
    if (!isPositional(ParamAt(u, j)) || !typeAccepts(d[i].code, ParamAt(u, j)->CharParam))
      return false;
  if (i == dn) return j > un;
  if (j > un) return !d[i].name.empty();
  if (isPositional(ParamAt(u, j))) return false;
  for (; j <= un; ++j) {
    DomParam* p = ParamAt(u, j);
    const Decl* decl = findDecl(d, p->CharParamQual);
    if (!decl)
      DZ_REPORT(Warning, "skipping parameter : %s\n", p->CharParamQual);
    else if (!typeAccepts(decl->code, p->CharParam))
      return false;
  }
  return namesUnique(u);
}

}  // namespace

char* ParamExtractWordFromStr(char** cursor) {
  Word w;
  char text[kWordMax + 1];
  if (!scanWord(cursor, &w) || keepText(text, w) == 0) return nullptr;
  return StrCopy(text);
}

char* ParamExtractWordFromStrWithQuote(char** cursor) {
  Word w;
  char text[kFramedRoom];
  if (!scanWord(cursor, &w)) return nullptr;
  frameWord(text, w);
  return StrCopy(text);
}

int ParamExtractWordFromStrQuote(char** cursor, char** word) {
  Word w;
  char* dst = *word;
  if (!scanWord(cursor, &w)) {
    *dst = '\0';
    return 0;
  }
  if (w.quoted) *dst++ = '"';
  memcpy(dst, w.text, w.len);
  dst += w.len;
  if (w.closed) *dst++ = '"';
  *dst = '\0';
  return !w.quoted || w.closed;
}

int ParamCheckParamList(char* command, char* const parameters, char* const descriptor1,
                        char* const descriptor2, DomList** list) {
  if (!parseParams(parameters, list)) return 0;
  if (StrInEnumOfStrNC(command, 4, "run", "kerb", "macro", "env")) return 1;
  std::vector<Decl> d;
  d.reserve(32);
  return parseDecls(descriptor1, &d) && parseDecls(descriptor2, &d) && accepts(*list, d);
}

int ParamTopCheckParamList(DomList* list, char* parameters) {
  DomList* t = nullptr;
  if (!parseParams(parameters, &t) || !t) return 0;
  const char* bad = nullptr;
  for (int i = 1; list && i <= list->count && !bad; ++i) {
    DomParam* p = ParamAt(list, i);
    if (ParamFindParamValue(t, p->CharParamQual, p->CharParam) == 0) bad = p->CharParamQual;
  }
  for (int i = 1; i <= t->count && !bad; ++i) {
    DomParam* p = ParamAt(t, i);
    if (ParamFindParamValue(list, p->CharParamQual, p->CharParam) != 1) bad = p->CharParamQual;
  }
  if (bad) DZ_REPORT(Status, "Illegal parameter value for %s\n", bad);
  ListDelete(&t, ParamFreeSlot);
  return !bad;
}

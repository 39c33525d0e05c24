// Parameter records and parameter lists: creation, lookup, checks against
// allowed names and values, in-place and move-to-end changes, printing.
#include <cstdarg>
#include <cstring>
#include <string>
#include <vector>

#include "duduzu/str.h"
#include "duduzu/strname.h"
#include "frame/unit.h"
#include "param/paramlist.h"

namespace {

constexpr const char* kUnit = "../s/paramutl";
constexpr size_t kNameMax = sizeof(DomParam::CharParamQual) - 1;
constexpr size_t kValueMax = sizeof(DomParam::CharParam) - 1;

DomParam* newRecord(const char* function) {
  auto* p = static_cast<DomParam*>(vzl_calloc(1, sizeof(DomParam)));
  if (!p) DZ_REPORT(Error, "Memory Full (%s)\n", function);
  return p;
}

const char* orEmpty(const char* s) { return s ? s : ""; }

std::vector<const char*> collect(int count, va_list ap) {
  std::vector<const char*> names;
  for (int i = 0; i < count; ++i) names.push_back(va_arg(ap, const char*));
  return names;
}

// Position (from 0) of the first entry equal to s ignoring case; -1 if none.
int indexOf(const std::vector<const char*>& entries, const char* s) {
  for (size_t i = 0; i < entries.size(); ++i)
    if (StrIdentical(entries[i], s)) return static_cast<int>(i);
  return -1;
}

void append(DomList* list, DomParam* p) { ListAddElt(list, reinterpret_cast<int*>(p)); }

// Puts a new record (name, value) in place of the record at pos; the list is
// unchanged when the record cannot be made.
bool replaceAt(DomList* list, int pos, const char* name, const char* value) {
  DomParam* p = ParamCreateParam(name, value);
  if (!p) return false;
  ParamFreeSlot(&list->elements[pos - 1]);
  list->elements[pos - 1] = reinterpret_cast<int*>(p);
  return true;
}

// Removes the record at pos and appends (name, value): the parameter moves to
// the end. Nothing changes when the new record cannot be made.
void moveToEnd(DomList* list, int pos, const char* name, const char* value) {
  DomParam* p = ParamCreateParam(name, value);
  if (!p) return;
  ListDelShiftFree(list, pos, ParamFreeSlot);
  append(list, p);
}

// Copies `name` into `to` with `value` (from `from`, else the default),
// replacing any record of that name there and warning when its value differs.
void moveFrom(DomList* from, DomList* to, const char* name, const char* defaultValue) {
  if (!from || !to) return;
  int src = ParamPosition(from, name);
  const char* value = src ? ParamAt(from, src)->CharParam : defaultValue;
  if (!value) return;
  DomParam* p = ParamCreateParam(name, value);
  if (!p) return;
  int old = ParamPosition(to, name);
  if (old) {
    if (!StrIdentical(ParamAt(to, old)->CharParam, value))
      DZ_REPORT(Warning, "Overwritting parameter %s\n", name);
    ListDelShiftFree(to, old, ParamFreeSlot);
  }
  append(to, p);
}

template <class Line>
void printEach(DomList* list, Line line) {
  for (int i = 1; list && i <= list->count; ++i) line(ParamAt(list, i));
}

}  // namespace

void ParamFreeSlot(int** slot) { ParamFree(reinterpret_cast<DomParam**>(slot)); }

int ParamPosition(DomList* list, const char* name) {
  return ListMemberOfList(list, reinterpret_cast<int*>(const_cast<char*>(name)),
                          [](int* e, int* v) {
                            return ParamIdenticalName(reinterpret_cast<DomParam*>(e),
                                                      reinterpret_cast<const char*>(v));
                          });
}

bool ParamFits(const char* name, const char* value) {
  size_t nameLen = name ? strlen(name) : 0, valueLen = value ? strlen(value) : 0;
  if (nameLen > kNameMax) {
    DZ_REPORT(Error, "Parameter name too long (%d characters, at most 254) : %s\n",
              static_cast<int>(nameLen), name);
    return false;
  }
  if (valueLen > kValueMax) {
    DZ_REPORT(Error, "Parameter value too long (%d characters, at most 1019) for %s\n",
              static_cast<int>(valueLen), orEmpty(name));
    return false;
  }
  return true;
}

// Text that does not fit a field is refused rather than cut, so that a record
// never holds a silently altered name or value.
DomParam* ParamCreateParam(const char* name, const char* value) {
  if (!ParamFits(name, value)) return nullptr;
  DomParam* p = newRecord("ParamCreateParam");
  if (!p) return nullptr;
  if (name) strcpy(p->CharParamQual, name);
  if (value) strcpy(p->CharParam, value);
  return p;
}

DomParam* ParamCopy(DomParam* param) {
  if (!param) return nullptr;
  DomParam* p = newRecord("ParamCopy");
  if (p) *p = *param;
  return p;
}

void ParamFree(DomParam** param) {
  vzl_free(*param);
  *param = nullptr;
}

int ParamIdenticalName(DomParam* param, const char* name) {
  return StrIdentical(param->CharParamQual, name);
}

char* ParamFindNamedParam(DomList* list, const char* name) {
  int pos = ParamPosition(list, name);
  return pos ? StrCopy(ParamAt(list, pos)->CharParam) : nullptr;
}

int ParamFindParamValue(DomList* list, const char* name, const char* value) {
  if (!list) return 0;
  int pos = ParamPosition(list, name);
  if (!pos) return 2;
  return StrIdentical(ParamAt(list, pos)->CharParam, value);
}

int ParamCheckInList(DomList* list, int count, ...) {
  va_list ap;
  va_start(ap, count);
  std::vector<const char*> allowed = collect(count, ap);
  va_end(ap);
  for (int i = 1; list && i <= list->count; ++i)
    if (indexOf(allowed, ParamAt(list, i)->CharParamQual) < 0) return 0;
  return 1;
}

int ParamCheckAtLeastInList(DomList* list, int count, ...) {
  va_list ap;
  va_start(ap, count);
  std::vector<const char*> required = collect(count, ap);
  va_end(ap);
  for (int i = 1; list && i <= list->count && !required.empty(); ++i) {
    int k = indexOf(required, ParamAt(list, i)->CharParamQual);
    if (k >= 0) required.erase(required.begin() + k);
  }
  return required.empty();
}

int ParamCheckParamValue(DomList* list, const char* name, const char* defaultValue, int count,
                         ...) {
  if (!list) return 0;
  va_list ap;
  va_start(ap, count);
  std::vector<const char*> allowed = collect(count, ap);
  va_end(ap);
  int pos = ParamPosition(list, name);
  if (pos) {
    int k = indexOf(allowed, ParamAt(list, pos)->CharParam);
    if (k >= 0) return k + 1;
    std::string text = std::string("allowed values for -") + orEmpty(name) + " are ";
    for (size_t i = 0; i < allowed.size(); ++i) (text += i ? "/" : "") += orEmpty(allowed[i]);
    DZ_REPORT(Error, "Unknown parameter value : %s\n", text.c_str());
    return 0;
  }
  if (!defaultValue) return 1;
  if (indexOf(allowed, defaultValue) < 0) {
    std::string text =
        std::string("bad default value ") + defaultValue + " for parameter " + orEmpty(name);
    DZ_REPORT(Error, "Unknown parameter value : %s\n", text.c_str());
    return 0;
  }
  DomParam* p = ParamCreateParam(name, defaultValue);
  if (!p) return 0;
  append(list, p);
  return 1;
}

int ParamCheckParamYesNo(DomList* list, const char* name, int defaultValue) {
  int pos = ParamPosition(list, name);
  if (!pos) return defaultValue;
  switch (StrInEnumOfStrNC(ParamAt(list, pos)->CharParam, 2, "NO", "YES")) {
    case 1: return 0;
    case 2: return 1;
  }
  DZ_REPORT(Warning, "allowed values for -%s for are yes/no ; Default value is used!", name);
  return defaultValue;
}

void ParamRemoveExistingParam(DomList* list, const char* name) {
  int pos = ParamPosition(list, name);
  if (pos) ListDelShiftFree(list, pos, ParamFreeSlot);
}

void ParamRemoveExistingParamIfValue(DomList* list, char* name, char* value) {
  int pos = ParamPosition(list, name);
  if (pos && StrIdentical(ParamAt(list, pos)->CharParam, value))
    ListDelShiftFree(list, pos, ParamFreeSlot);
}

void ParamChangeParamValue(DomList* list, const char* name, const char* value) {
  if (!list) return;
  int pos = ParamPosition(list, name);
  if (pos) {
    replaceAt(list, pos, name, value);
    return;
  }
  if (DomParam* p = ParamCreateParam(name, value)) append(list, p);
}

// Each substituted value replaces the value of the record it came from, even
// when an earlier record has the same name.
int ParamExpandEnvVar(DomList* list) {
  int changed = 0;
  for (int i = 1; list && i <= list->count; ++i) {
    DomParam* p = ParamAt(list, i);
    char* text = StrReplaceEnvVariable(p->CharParam);
    if (text && replaceAt(list, i, p->CharParamQual, text)) ++changed;
    StrFree(&text);
  }
  return changed;
}

void ParamMoveParamName(DomList* list, const char* oldName, const char* newName) {
  int pos = ParamPosition(list, oldName);
  if (pos) moveToEnd(list, pos, newName, ParamAt(list, pos)->CharParam);
}

void ParamMoveParamValue(DomList* list, const char* name, const char* oldValue,
                         const char* newValue) {
  int pos = ParamPosition(list, name);
  if (pos && StrIdentical(ParamAt(list, pos)->CharParam, oldValue))
    moveToEnd(list, pos, name, newValue);
}

void ParamMoveFromList(DomList* from, DomList* to, const char* name) {
  moveFrom(from, to, name, nullptr);
}

void ParamMoveFromListWithDefault(DomList* from, DomList* to, const char* name,
                                  const char* defaultValue) {
  moveFrom(from, to, name, defaultValue);
}

void ParamExpandParam(char** text, DomList* list) {
  static char empty[] = "";
  if (list && list->count > 0) *text = empty;
}

void DomParamLPrint(DomList* list) {
  printEach(list, [](DomParam* p) {
    DZ_REPORT(Status, "CharParamQual = %s\n", p->CharParamQual);
    DZ_REPORT(Status, "CharParam     = %s\n", p->CharParam);
  });
}

void ParamNicePrint(DomList* list) {
  printEach(list, [](DomParam* p) { DZ_REPORT(Status, "%s\t%s\n", p->CharParamQual, p->CharParam); });
}

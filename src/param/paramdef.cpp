// The process-wide table of parameter defaults: one parameter list, created
// by the first setting and destroyed by ParamDefFree.
#include <cstdio>
#include <cstdlib>

#include "frame/unit.h"
#include "list/keptlist.h"
#include "param/paramlist.h"

namespace {

constexpr const char* kUnit = "../s/paramutl";

KeptList defaultList(ParamFreeSlot);
DomList*& defaults() { return defaultList.get(); }

// Reads the default through `convert`, or gives `none` when there is none.
template <class T, class Convert>
T getAs(const char* name, T none, Convert convert) {
  char* text = ParamFindNamedParam(defaults(), name);
  if (!text) return none;
  T value = convert(text);
  vzl_free(text);
  return value;
}

}  // namespace

// A new setting replaces the old one at the end of the list; an empty value
// only removes. A refused record leaves the old default in place.
void ParamDefSetStr(const char* name, const char* value) {
  DomParam* p = ParamCreateParam(name, value);
  if (!p) return;
  if (!defaults()) defaults() = ListCreateWithSize(1);
  if (!defaults()) {
    ParamFree(&p);
    return;
  }
  ParamRemoveExistingParam(defaults(), name);
  if (p->CharParam[0])
    ListAddElt(defaults(), reinterpret_cast<int*>(p));
  else
    ParamFree(&p);
}

char* ParamDefGetStr(const char* name) { return ParamFindNamedParam(defaults(), name); }

void ParamDefSetInt(const char* name, int value) {
  char text[16] = "";
  if (value >= 0) snprintf(text, sizeof text, "%d", value);
  ParamDefSetStr(name, text);
}

int ParamDefGetInt(const char* name) {
  return getAs(name, -1, [](const char* text) { return atoi(text); });
}

float ParamDefGetFloat(const char* name) {
  return getAs(name, -1.0f, [](const char* text) { return static_cast<float>(atof(text)); });
}

void ParamDefFree(void) { ListDelete(&defaults(), ParamFreeSlot); }

void ParamDefPrint(void) {
  DZ_REPORT(Status, "--- Global Param List:\n");
  ParamDefPrintFormatted();
}

void ParamDefPrintFormatted(void) { ParamNicePrint(defaults()); }

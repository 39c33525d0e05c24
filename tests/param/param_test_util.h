// Helpers shared by the parameter tests.
#pragma once

#include "duduzu/param.h"
#include "support/owned.h"
#include "support/reports.h"

inline std::string Reports(PortTest::Capture& cap) { return Reports(cap, "../s/paramutl"); }

inline void DeleteList(DomList** l) { ListDelete(l, [](int** e) { ParamFree(reinterpret_cast<DomParam**>(e)); }); }

inline DomList* MakeList(std::initializer_list<std::pair<const char*, const char*>> records) {
  DomList* list = ListCreate();
  for (auto& r : records) ListAddElt(list, reinterpret_cast<int*>(ParamCreateParam(r.first, r.second)));
  return list;
}

// "name=value" items joined by ";"; "<null>" for no list.
inline std::string Show(DomList* list) {
  std::string s = list ? "" : "<null>";
  for (int i = 0; list && i < list->count; ++i) {
    auto* p = reinterpret_cast<DomParam*>(list->elements[i]);
    s += (i ? ";" : "") + std::string(p->CharParamQual) + "=" + p->CharParam;
  }
  return s;
}

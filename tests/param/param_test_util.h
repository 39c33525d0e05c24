// Helpers shared by the parameter tests.
#pragma once

#include <gtest/gtest.h>

#include <initializer_list>
#include <string>
#include <utility>

#include "duduzu/list.h"
#include "duduzu/param.h"
#include "port/port_testing.h"

inline void DeleteList(DomList** list) {
  ListDelete(list, [](int** slot) { ParamFree(reinterpret_cast<DomParam**>(slot)); });
}

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

// Takes ownership of a returned heap string.
inline std::string Owned(char* s) {
  std::string r = s ? s : "<null>";
  vzl_free(s);
  return r;
}

// The reports since the last call as "level:text" (0 fatal, 1 warning, 2 status, 4 error), all
// from the parameter unit.
inline std::string Reports(PortTest::Capture& cap) {
  std::string s;
  for (size_t i = 0; i < cap.size(); ++i) {
    EXPECT_EQ(cap[i].unit, "../s/paramutl");
    s += std::to_string(static_cast<int>(cap[i].level)) + ":" + cap[i].text;
  }
  cap.clear();
  return s;
}

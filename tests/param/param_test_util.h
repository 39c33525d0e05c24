// Helpers shared by the parameter tests.
#pragma once

#include <gtest/gtest.h>

#include <initializer_list>
#include <string>
#include <utility>

#include "duduzu/list.h"
#include "duduzu/param.h"
#include "port/port_testing.h"

inline void FreeParamSlot(int** slot) { ParamFree(reinterpret_cast<DomParam**>(slot)); }

// A parameter list owning records made from (name, value) pairs.
inline DomList* MakeList(std::initializer_list<std::pair<const char*, const char*>> records) {
  DomList* list = ListCreate();
  for (auto& r : records) ListAddElt(list, reinterpret_cast<int*>(ParamCreateParam(r.first, r.second)));
  return list;
}

inline void DeleteList(DomList** list) { ListDelete(list, FreeParamSlot); }

// The list as "name=value" items joined by ";"; "<null>" for no list.
inline std::string Show(DomList* list) {
  if (!list) return "<null>";
  std::string s;
  for (int i = 0; i < list->count; ++i) {
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

// The capture holds exactly one report of this level and text from the parameter unit.
inline void ExpectOneReport(const PortTest::Capture& cap, Port_MsgLevel level,
                            const std::string& text) {
  ASSERT_EQ(cap.size(), 1u);
  EXPECT_EQ(cap[0].level, level);
  EXPECT_EQ(cap[0].text, text);
  EXPECT_EQ(cap[0].unit, "../s/paramutl");
  EXPECT_EQ(cap[0].module, "DuduzuRorez");
}

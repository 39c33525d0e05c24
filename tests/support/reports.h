// Shared test support: the reports a capture holds, as one comparable text.
#pragma once

#include <gtest/gtest.h>

#include <string>

#include "port/port_testing.h"

// The reports since the last call as "level:text" (0 fatal, 1 warning, 2 status,
// 4 error), each checked to come from `unit` of the library's module; the
// capture is emptied for the next check.
inline std::string Reports(PortTest::Capture& cap, const std::string& unit) {
  std::string s;
  for (size_t i = 0; i < cap.size(); ++i) {
    EXPECT_EQ(cap[i].unit, unit) << cap[i].text;
    EXPECT_EQ(cap[i].module, "DuduzuRorez") << cap[i].text;
    s += std::to_string(static_cast<int>(cap[i].level)) + ":" + cap[i].text;
  }
  cap.clear();
  return s;
}

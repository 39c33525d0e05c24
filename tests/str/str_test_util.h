// Helpers shared by the string tests.
#pragma once

#include <gtest/gtest.h>

#include <string>

#include "port/port_testing.h"

// The capture holds exactly one report, of this level and text, from unit.
inline void ExpectOneReport(const PortTest::Capture& cap, Port_MsgLevel level,
                            const std::string& text, const char* unit = "../s/strutil") {
  ASSERT_EQ(cap.size(), 1u);
  EXPECT_EQ(cap[0].level, level);
  EXPECT_EQ(cap[0].text, text);
  EXPECT_EQ(cap[0].unit, unit);
  EXPECT_EQ(cap[0].module, "DuduzuRorez");
}

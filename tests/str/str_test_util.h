// Helpers shared by the string tests.
#pragma once

#include <gtest/gtest.h>

#include <string>

#include "duduzu/str.h"
#include "port/port_testing.h"

// The capture holds exactly one report, of this level and text, from the string
// unit; it is emptied for the next check.
inline void ExpectOneReport(PortTest::Capture& cap, Port_MsgLevel level, const std::string& text) {
  ASSERT_EQ(cap.size(), 1u);
  EXPECT_EQ(cap[0].level, level);
  EXPECT_EQ(cap[0].text, text);
  EXPECT_EQ(cap[0].unit, "../s/strutil");
  EXPECT_EQ(cap[0].module, "DuduzuRorez");
  cap.clear();
}

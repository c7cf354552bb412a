// SPDX-License-Identifier: MIT
#include <gtest/gtest.h>

#include "MonitorLine.h"

namespace Ostinet::Tool {
namespace {

TEST(MonitorJSON, IsOneObjectInOneLine) {
  EXPECT_EQ(MonitorJSON({"In \"1\"", 123456789012ull, {0x90, 0x3C, 0x40}}),
            R"({"source":"In \"1\"","clocks":123456789012,"bytes":"90 3C 40"})");
}

TEST(MonitorText, TellsTheMessageOrItsBytes) {
  MonitoredMessage const message = {"In 1", 0, {0xC0, 0x05}};
  EXPECT_EQ(MonitorText(message, false), "In 1                program change    ch 1   program 5");
  EXPECT_EQ(MonitorText(message, true), "In 1                C0 05");
}

TEST(MonitorText, KeepsALongNameApart) {
  EXPECT_EQ(MonitorText({"A source with a long name", 0, {0xF8}}, false),
            "A source with a long name  clock");
}

TEST(SecondsText, CountsFromTheStart) {
  EXPECT_EQ(SecondsText(25000000, 10000000), "   1.500000");
  EXPECT_EQ(SecondsText(10000000, 15000000), "  -0.500000");
}

}  // namespace
}  // namespace Ostinet::Tool

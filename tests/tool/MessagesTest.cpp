// SPDX-License-Identifier: MIT
#include <gtest/gtest.h>

#include "Errors.h"
#include "Messages.h"

namespace Ostinet::Tool {
namespace {

using MessageList = std::vector<Bytes>;

TEST(MessageLength, KnowsEveryStatus) {
  EXPECT_EQ(MessageLength(0x7F), 0u);
  EXPECT_EQ(MessageLength(0x80), 3u);
  EXPECT_EQ(MessageLength(0xBF), 3u);
  EXPECT_EQ(MessageLength(0xC0), 2u);
  EXPECT_EQ(MessageLength(0xDF), 2u);
  EXPECT_EQ(MessageLength(0xE0), 3u);
  EXPECT_EQ(MessageLength(0xF0), 0u);
  EXPECT_EQ(MessageLength(0xF1), 2u);
  EXPECT_EQ(MessageLength(0xF2), 3u);
  EXPECT_EQ(MessageLength(0xF3), 2u);
  EXPECT_EQ(MessageLength(0xF6), 1u);
  EXPECT_EQ(MessageLength(0xFF), 1u);
}

TEST(SplitMessages, CutsAtEachMessage) {
  EXPECT_EQ(SplitMessages({0x90, 0x3C, 0x40, 0xC1, 0x05, 0xFA}),
            (MessageList{{0x90, 0x3C, 0x40}, {0xC1, 0x05}, {0xFA}}));
}

// A packet holds one message: a running status would go out as data without a meaning.
TEST(SplitMessages, WritesARunningStatusOut) {
  EXPECT_EQ(SplitMessages({0x90, 0x3C, 0x40, 0x3E, 0x41}),
            (MessageList{{0x90, 0x3C, 0x40}, {0x90, 0x3E, 0x41}}));
}

TEST(SplitMessages, KeepsASysexWhole) {
  EXPECT_EQ(SplitMessages({0xF0, 0x41, 0x10, 0xF7, 0x80, 0x00, 0x00}),
            (MessageList{{0xF0, 0x41, 0x10, 0xF7}, {0x80, 0x00, 0x00}}));
}

TEST(SplitMessages, LetsRealTimeOutOfWhatItStandsIn) {
  EXPECT_EQ(SplitMessages({0xF0, 0x41, 0xF8, 0xF7}), (MessageList{{0xF8}, {0xF0, 0x41, 0xF7}}));
  EXPECT_EQ(SplitMessages({0x90, 0xFE, 0x3C, 0x40, 0x3E, 0x40}),
            (MessageList{{0xFE}, {0x90, 0x3C, 0x40}, {0x90, 0x3E, 0x40}}));
}

TEST(SplitMessages, RefusesDataWithoutAStatus) {
  EXPECT_THROW(SplitMessages({0x3C, 0x40}), UsageError);
  EXPECT_THROW(SplitMessages({0xF6, 0x01}), UsageError);  // Only channel messages run on.
}

TEST(SplitMessages, RefusesWhatEndsWithinAMessage) {
  EXPECT_THROW(SplitMessages({0x90, 0x3C}), UsageError);
  EXPECT_THROW(SplitMessages({0x90, 0x3C, 0x80, 0x3C, 0x40}), UsageError);
  EXPECT_THROW(SplitMessages({0xF0, 0x41}), UsageError);
  EXPECT_THROW(SplitMessages({0xF0, 0x41, 0x90, 0x3C, 0x40}), UsageError);
}

TEST(SplitMessages, MakesNothingOfNothing) { EXPECT_TRUE(SplitMessages({}).empty()); }

}  // namespace
}  // namespace Ostinet::Tool

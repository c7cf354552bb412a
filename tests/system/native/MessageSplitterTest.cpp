// SPDX-License-Identifier: MIT
#include <gtest/gtest.h>

#include <vector>

#include "platform/system/native/MessageSplitter.h"

namespace Ostinet::Impl {
namespace {

using Bytes = std::vector<unsigned char>;

std::vector<Bytes> Split(Bytes const& bytes) {
  std::vector<Bytes> messages;
  SplitMessages(bytes.data(), bytes.size(), [&](unsigned char const* message, std::size_t count) {
    messages.emplace_back(message, message + count);
  });
  return messages;
}

TEST(MessageSplitter, KnowsTheLengthOfEachStatus) {
  EXPECT_EQ(MessageLength(0x7F), 0U);
  EXPECT_EQ(MessageLength(0x80), 3U);
  EXPECT_EQ(MessageLength(0xBF), 3U);
  EXPECT_EQ(MessageLength(0xC0), 2U);
  EXPECT_EQ(MessageLength(0xDF), 2U);
  EXPECT_EQ(MessageLength(0xE0), 3U);
  EXPECT_EQ(MessageLength(0xF0), 0U);
  EXPECT_EQ(MessageLength(0xF1), 2U);
  EXPECT_EQ(MessageLength(0xF2), 3U);
  EXPECT_EQ(MessageLength(0xF3), 2U);
  EXPECT_EQ(MessageLength(0xF6), 1U);
  EXPECT_EQ(MessageLength(0xFF), 1U);
}

TEST(MessageSplitter, PartsMessagesThatFollowEachOther) {
  EXPECT_EQ(Split({0x90, 0x3C, 0x40, 0xC0, 0x05, 0xF8, 0x80, 0x3C, 0x00}),
            (std::vector<Bytes>{{0x90, 0x3C, 0x40}, {0xC0, 0x05}, {0xF8}, {0x80, 0x3C, 0x00}}));
}

TEST(MessageSplitter, SpellsRunningStatusOut) {
  EXPECT_EQ(Split({0x90, 0x3C, 0x40, 0x3E, 0x41}),
            (std::vector<Bytes>{{0x90, 0x3C, 0x40}, {0x90, 0x3E, 0x41}}));
}

TEST(MessageSplitter, KeepsASysexWholeWithRealtimeInside) {
  EXPECT_EQ(Split({0xF0, 0x01, 0xF8, 0x02, 0xF7, 0xFE}),
            (std::vector<Bytes>{{0xF0, 0x01, 0xF8, 0x02, 0xF7}, {0xFE}}));
}

TEST(MessageSplitter, AStatusEndsASysexThatHasNoEnd) {
  EXPECT_EQ(Split({0xF0, 0x01, 0x90, 0x3C, 0x40}),
            (std::vector<Bytes>{{0xF0, 0x01}, {0x90, 0x3C, 0x40}}));
}

TEST(MessageSplitter, PassesThePiecesOfASysexThatTheHostCuts) {
  EXPECT_EQ(Split({0xF0, 0x01, 0x02}), (std::vector<Bytes>{{0xF0, 0x01, 0x02}}));
  EXPECT_EQ(Split({0x03, 0x04, 0xF7}), (std::vector<Bytes>{{0x03, 0x04, 0xF7}}));
}

TEST(MessageSplitter, DropsAMessageThatLacksBytes) {
  EXPECT_EQ(Split({0x90, 0x3C}), std::vector<Bytes>{});
  EXPECT_EQ(Split({0x90, 0x3C, 0xF8}), (std::vector<Bytes>{{0xF8}}));
  EXPECT_EQ(Split({}), std::vector<Bytes>{});
}

}  // namespace
}  // namespace Ostinet::Impl

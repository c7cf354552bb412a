// SPDX-License-Identifier: MIT
#include <gtest/gtest.h>

#include <vector>

#include "ostinet/TimeStamp.h"

namespace Ostinet {
namespace {

using Bytes = std::vector<unsigned char>;

Bytes BytesOf(DataPacket const& packet) { return Bytes(packet.data, packet.data + packet.length); }

TEST(DataBuffer, IsEmptyAtFirst) {
  DataBuffer const buffer;
  EXPECT_TRUE(buffer.empty());
  EXPECT_EQ(buffer.size(), 0u);
}

TEST(DataBuffer, GivesEmptyPacketsBeyondItsEnd) {
  DataBuffer buffer;
  EXPECT_EQ(buffer.back().length, 0u);
  EXPECT_EQ(buffer[0].length, 0u);
  unsigned char const byte = 0xF8;
  buffer.Add(TimeStamp(1), &byte, 1);
  EXPECT_EQ(buffer[1].length, 0u);
  EXPECT_EQ(buffer[1].stamp, kNoTimeStamp);
}

TEST(DataBuffer, KeepsPacketsInOrderWithStampsAndBytes) {
  DataBuffer buffer;
  Bytes const note{0x90, 60, 100};
  Bytes const sysex{0xF0, 0x7E, 1, 2, 3, 4, 5, 6, 7, 8, 9, 10, 11, 12, 13, 14, 15, 0xF7};
  buffer.Add(TimeStamp(10), note.data(), note.size());
  buffer.Add(TimeStamp(20, 5.0), sysex.data(), sysex.size());
  ASSERT_EQ(buffer.size(), 2u);
  EXPECT_FALSE(buffer.empty());
  EXPECT_EQ(BytesOf(buffer[0]), note);
  EXPECT_EQ(buffer[0].stamp, TimeStamp(10));
  EXPECT_EQ(BytesOf(buffer[1]), sysex);
  EXPECT_EQ(BytesOf(buffer.back()), sysex);
  EXPECT_EQ(buffer.back().stamp, TimeStamp(20));
  EXPECT_EQ(buffer.back().stamp.AsSampleCount(), 5.0);
}

TEST(DataBuffer, OwnsItsBytes) {
  DataBuffer buffer;
  Bytes bytes{0xC0, 1};
  buffer.Add(kNoTimeStamp, bytes.data(), bytes.size());
  bytes[1] = 9;
  EXPECT_EQ(BytesOf(buffer[0]), (Bytes{0xC0, 1}));
}

TEST(DataBuffer, HasBytesOfItsOwnInACopy) {
  DataBuffer buffer;
  Bytes const bytes{0xC0, 1};
  buffer.Add(kNoTimeStamp, bytes.data(), bytes.size());
  DataBuffer const copy = buffer;
  EXPECT_NE(copy[0].data, buffer[0].data);
  EXPECT_EQ(BytesOf(copy[0]), bytes);
  buffer = DataBuffer();
  EXPECT_EQ(BytesOf(copy[0]), bytes);
}

TEST(DataBuffer, AcceptsEmptyPackets) {
  DataBuffer buffer;
  buffer.Add(TimeStamp(3), nullptr, 5);
  unsigned char const byte = 0;
  buffer.Add(TimeStamp(4), &byte, 0);
  ASSERT_EQ(buffer.size(), 2u);
  EXPECT_EQ(buffer[0].length, 0u);
  EXPECT_EQ(buffer[0].stamp, TimeStamp(3));
  EXPECT_EQ(buffer[1].length, 0u);
}

TEST(DataBuffer, CopiesItsOwnPackets) {
  DataBuffer buffer;
  Bytes const bytes{0xB0, 0, 5};
  buffer.Add(TimeStamp(1), bytes.data(), bytes.size());
  for (int i = 0; i < 100; ++i) {
    DataPacket const last = buffer.back();
    buffer.Add(TimeStamp(2), last.data, static_cast<size_t>(last.length));
    ASSERT_EQ(BytesOf(buffer.back()), bytes);
  }
}

}  // namespace
}  // namespace Ostinet

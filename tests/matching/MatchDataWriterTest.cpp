// SPDX-License-Identifier: MIT
#include <gtest/gtest.h>

#include "matching/HexBytes.h"
#include "matching/MatchDataWriter.h"
#include "ostinet/Endpoint.h"

namespace Ostinet::Impl {
namespace {

using Testing::Hex;
using Testing::ToHex;

TEST(MatchDataWriter, LaysOutHeaderAndEmptySections) {
  MatchDataWriter const writer(Properties::kPlatformImplementation, Destination::kObjectID,
                               "MIDI 1");
  EXPECT_EQ(ToHex(writer.Finish()), Hex("00 00 00 00  00 00 00 03  00 00 00 04  00 00 00 06 "
                                        "00 4D 00 49 00 44 00 49 00 20 00 31 "
                                        "00 00 00 04  00 00 00 00  00 00 00 04  00 00 00 00"));
}

TEST(MatchDataWriter, WritesEachFieldWithItsHighestByteFirst) {
  MatchDataWriter writer(Properties::kNoImplementation, MatchObjectID(1), UString(), 2, 3);
  auto& section1 = writer.GetSection1Stream();
  section1.WriteBool(true);
  section1.WriteBool(false);
  section1.WriteInt16(-2);
  section1.WriteUInt16(0x1234);
  section1.WriteInt32(-2);
  section1.WriteUInt32(0x89ABCDEF);
  auto& section2 = writer.GetSection2Stream();
  section2.WriteString(UString(u"A\u2126"));
  SlotID slot;
  slot.words[0] = 1;
  slot.words[5] = 0xFF000000;
  section2.WriteSlotID(slot);
  EXPECT_EQ(ToHex(writer.Finish()),
            Hex("00 00 00 00  00 00 00 00  00 00 00 01  00 00 00 00 "
                "00 00 00 12  00 00 00 02  01 00  FF FE  12 34  FF FF FF FE  89 AB CD EF "
                "00 00 00 24  00 00 00 03  00 00 00 02 00 41 21 26 "
                "00 00 00 01 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 FF 00 00 00"));
}

}  // namespace
}  // namespace Ostinet::Impl

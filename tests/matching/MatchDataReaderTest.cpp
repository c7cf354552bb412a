// SPDX-License-Identifier: MIT
#include <gtest/gtest.h>

#include "matching/HexBytes.h"
#include "matching/MatchDataReader.h"
#include "matching/MatchDataUpdater.h"
#include "ostinet/Endpoint.h"

namespace Ostinet::Impl {
namespace {

using Testing::FirstBytes;
using Testing::FromHex;
using Testing::Hex;
using Testing::ToHex;
using Stream = MatchDataReader::Stream;

TEST(MatchDataReader, FindsHeaderAndSections) {
  MatchData const data = FromHex(Testing::kExternalDestination);
  MatchDataReader const reader(data);
  EXPECT_TRUE(reader.IsValid());
  EXPECT_EQ(reader.GetImplementation(), 3u);
  EXPECT_EQ(reader.GetObjectType(), Destination::kObjectID);
  EXPECT_EQ(reader.GetName().Decode(), UString("Pad"));
  EXPECT_EQ(reader.GetSection1Stream().Remaining(), 9u);
  EXPECT_EQ(reader.GetSection2Stream().Remaining(), 0x2Eu - 4);
}

TEST(MatchDataReader, IgnoresWhatFollowsTheSecondSection) {
  MatchData const data = FromHex(std::string(Testing::kNameOnly) + " FF FF FF");
  MatchDataReader const reader(data);
  EXPECT_TRUE(reader.IsValid());
  EXPECT_EQ(reader.GetSection2Stream().Remaining(), 11u);
}

TEST(MatchDataReader, ReadsNothingOfAnotherVersion) {
  MatchData data = FromHex(Testing::kExternalDestination);
  data[3] = 1;
  MatchDataReader const reader(data);
  EXPECT_FALSE(reader.IsValid());
  EXPECT_EQ(reader.GetObjectType(), MatchObjectID(0));
  EXPECT_TRUE(reader.GetName().empty());
}

TEST(MatchDataReader, KeepsWhatStoodBeforeTheFault) {
  MatchData const data = FromHex(Testing::kExternalDestination);
  constexpr std::size_t kBehindType = 12;
  constexpr std::size_t kBehindName = 22;
  MatchData const type = FirstBytes(data, kBehindType);
  EXPECT_EQ(MatchDataReader(type).GetObjectType(), Destination::kObjectID);
  MatchData const nameLess = FirstBytes(data, kBehindName - 1);
  EXPECT_TRUE(MatchDataReader(nameLess).GetName().empty());
  MatchData const name = FirstBytes(data, kBehindName);
  MatchDataReader const reader(name);
  EXPECT_EQ(reader.GetName().Decode(), UString("Pad"));
  EXPECT_FALSE(reader.IsValid());
}

TEST(MatchDataReader, RejectsASectionTooShortForItsVersion) {
  for (char const length : {'\0', '\1', '\2', '\3'}) {
    MatchData data = FromHex(
        "00 00 00 00  00 00 00 03  00 00 00 04  00 00 00 00 "
        "00 00 00 04  00 00 00 00  00 00 00 04  00 00 00 00");
    data[27] = length;
    MatchDataReader const reader(data);
    EXPECT_FALSE(reader.IsValid());
    EXPECT_EQ(reader.GetSection2Stream().Remaining(), 0u);
    data[19] = length;
    EXPECT_FALSE(MatchDataReader(data).IsValid());
  }
}

TEST(MatchDataReader, RejectsLengthsBeyondTheData) {
  for (char const* const lengths : {"00 00 00 15", "7F FF FF FF", "FF FF FF FF"}) {
    MatchData const data = FromHex(std::string("00 00 00 00  00 00 00 03  00 00 00 04 "
                                               "00 00 00 00 ") +
                                   lengths + " 00 00 00 00  00 00 00 04  00 00 00 00  00 00 00 00");
    EXPECT_FALSE(MatchDataReader(data).IsValid()) << lengths;
  }
}

TEST(MatchDataReader, RejectsANameThatClaimsMoreThanThereIs) {
  for (char const* const count : {"00 00 00 03", "7F FF FF FF", "80 00 00 00", "FF FF FF FF"}) {
    MatchData const data =
        FromHex(std::string("00 00 00 00  00 00 00 03  00 00 00 04 ") + count + " 00 41 00 42");
    MatchDataReader const reader(data);
    EXPECT_FALSE(reader.IsValid()) << count;
    EXPECT_TRUE(reader.GetName().empty()) << count;
    EXPECT_EQ(reader.GetObjectType(), Destination::kObjectID) << count;
  }
}

TEST(MatchDataStream, ReadsEachKindOfField) {
  MatchData const data =
      FromHex("02 00  FF FE  FF FE  FF FF FF FE  FF FF FF FE  00 00 00 01 21 26");
  Stream stream(data.begin(), data.end());
  bool flag = false;
  EXPECT_TRUE(stream.ReadBool(flag));
  EXPECT_TRUE(flag);
  EXPECT_TRUE(stream.ReadBool(flag));
  EXPECT_FALSE(flag);
  std::int16_t int16 = 0;
  EXPECT_TRUE(stream.ReadInt16(int16));
  EXPECT_EQ(int16, -2);
  std::uint16_t uint16 = 0;
  EXPECT_TRUE(stream.ReadUInt16(uint16));
  EXPECT_EQ(uint16, 0xFFFE);
  std::int32_t int32 = 0;
  EXPECT_TRUE(stream.ReadInt32(int32));
  EXPECT_EQ(int32, -2);
  std::uint32_t uint32 = 0;
  EXPECT_TRUE(stream.ReadUInt32(uint32));
  EXPECT_EQ(uint32, 0xFFFFFFFE);
  EncodedText text;
  EXPECT_TRUE(stream.ReadString(text));
  EXPECT_TRUE(text.Equals(UString(u"\u2126")));
  EXPECT_FALSE(text.Equals(UString(u"\u2126\u2126")));
  EXPECT_FALSE(text.Equals(UString("O")));
  EXPECT_EQ(stream.Remaining(), 0u);
  EXPECT_FALSE(stream.ReadBool(flag));
}

TEST(MatchDataStream, LeavesItsOutputWhenTheBytesRunOut) {
  MatchData const data = FromHex("01 02 03");
  Stream stream(data.begin(), data.end());
  std::uint32_t value = 5;
  EXPECT_FALSE(stream.ReadUInt32(value));
  EXPECT_EQ(value, 5u);
  EXPECT_EQ(stream.Remaining(), 0u);
}

TEST(MatchDataStream, ASkipThatDoesNotFitGoesToTheEnd) {
  MatchData const data = FromHex("01 02 03");
  Stream stream(data.begin(), data.end());
  EXPECT_TRUE(stream.Skip(2));
  EXPECT_FALSE(stream.Skip(2));
  EXPECT_EQ(stream.Remaining(), 0u);
}

TEST(MatchDataUpdater, OverwritesInPlace) {
  MatchData data = FromHex(Testing::kInternalSource);
  MatchDataUpdater updater(data);
  auto stream = updater.GetSection2Stream();
  stream.SkipString();
  stream.SkipString();
  stream.WriteBool(false);
  stream.WriteBool(true);
  stream.Skip(2);
  SlotID slot;
  slot.words[5] = 0x01020304;
  stream.WriteSlotID(slot);
  EXPECT_EQ(ToHex(data),
            Hex("00 00 00 00  00 00 00 04  00 00 00 03  00 00 00 02  00 46 00 58 "
                "00 00 00 0D  00 00 00 00  00 00 00 07  00 00 00 00  01 "
                "00 00 00 28  00 00 00 00  00 00 00 00  00 00 00 00  00 01 00 01 "
                "00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 01 02 03 04"));
}

TEST(MatchDataUpdater, WritesNothingThatDoesNotFit) {
  MatchData data = FromHex(Testing::kInternalSource);
  MatchData const before = data;
  MatchDataUpdater updater(data);
  auto stream = updater.GetSection2Stream();
  stream.Skip(stream.Remaining() - 23);
  SlotID slot;
  slot.words[0] = 0xFFFFFFFF;
  stream.WriteSlotID(slot);
  stream.Skip(23);
  stream.WriteBool(true);
  EXPECT_EQ(data, before);
}

}  // namespace
}  // namespace Ostinet::Impl

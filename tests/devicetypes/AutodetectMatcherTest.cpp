// SPDX-License-Identifier: MIT
#include "AutodetectTables.h"

namespace Ostinet {
namespace {

using namespace Testing;
using Autodetect::Matcher;

// What one try at an answer yields.
struct Attempt {
  std::size_t position = 0;
  unsigned char deviceID = 0xFF;
  Captured captured = Untouched();

  Attempt& Take(Matcher const& matcher, Bytes const& bytes) {
    position = matcher.Match(Data(bytes.data(), bytes.size()), position, deviceID, captured);
    return *this;
  }
};

Attempt Try(std::string const& table, std::string const& reply, bool strict = false) {
  Attempt attempt;
  return attempt.Take(Matcher(TableOf(table), strict), BytesOf(reply));
}

constexpr char kShortInquiry[] = "F0 7E ID 06 02 F9 FC FD FE FF";
constexpr char kLongInquiry[] = "F0 7E ID 06 02 F9 FA FB FC FD FE FF";
constexpr char kRolandReply[] = "F0 7E 10 06 02 41 00 19 00 10 01 02 03 04 F7";

TEST(AutodetectMatcher, RecognisesAnInquiryReplyWithWhateverFollows) {
  Matcher const matcher(TableOf(kShortInquiry), false);
  EXPECT_EQ(matcher.Start(), 0u);
  EXPECT_EQ(matcher.Success(), 10u);
  Attempt const attempt = Try(kShortInquiry, kRolandReply);
  EXPECT_EQ(attempt.position, 10u);
  EXPECT_EQ(attempt.deviceID, 0x10);
  EXPECT_EQ(BytesOf(attempt.captured), BytesOf("41 FF FF 00 19 00 10"));
}

TEST(AutodetectMatcher, CapturesAManufacturerOfThreeBytes) {
  Attempt const attempt = Try(kLongInquiry, "F0 7E 00 06 02 00 20 29 01 02 03 04");
  EXPECT_EQ(attempt.position, 12u);
  EXPECT_EQ(BytesOf(attempt.captured), BytesOf("00 20 29 01 02 03 04"));
}

TEST(AutodetectMatcher, GoesOnWhereTheLastPieceEnded) {
  Matcher const matcher(TableOf(kShortInquiry), false);
  Attempt attempt;
  EXPECT_EQ(attempt.Take(matcher, BytesOf("F0 7E 10 06")).position, 4u);
  EXPECT_EQ(attempt.Take(matcher, BytesOf("02 41 00 19 00 10 01")).position, 10u);
  EXPECT_EQ(attempt.deviceID, 0x10);
  EXPECT_EQ(BytesOf(attempt.captured), BytesOf("41 FF FF 00 19 00 10"));
}

TEST(AutodetectMatcher, TakesAReplyInTwoPiecesCutAnywhere) {
  Matcher const matcher(TableOf(kShortInquiry), false);
  Bytes const reply = BytesOf(kRolandReply);
  for (std::size_t cut = 1; cut < reply.size(); ++cut) {
    auto const middle = reply.begin() + static_cast<std::ptrdiff_t>(cut);
    Attempt attempt;
    attempt.Take(matcher, Bytes(reply.begin(), middle));
    ASSERT_NE(attempt.position, 0u);
    attempt.Take(matcher, Bytes(middle, reply.end()));
    EXPECT_EQ(attempt.position, matcher.Success()) << "cut at " << cut;
    EXPECT_EQ(BytesOf(attempt.captured), BytesOf("41 FF FF 00 19 00 10"));
  }
}

TEST(AutodetectMatcher, EndsExactlyWithTheTable) {
  EXPECT_EQ(Try("F0 41 10", "F0 41 10").position, 3u);
  EXPECT_EQ(Try("F0 41 10", "F0 41").position, 2u);
}

TEST(AutodetectMatcher, TakesTheOffsetFromTheDeviceIDInEightBits) {
  EXPECT_EQ(Try("ID+2", "12").deviceID, 0x10);
  EXPECT_EQ(Try("ID+2", "01").deviceID, 0xFF);
  EXPECT_EQ(Try("ID", "F7").deviceID, 0xF7) << "no range is checked";
}

TEST(AutodetectMatcher, EndsAtTheFirstByteThatDiffers) {
  EXPECT_EQ(Try("F0 41 10 20 30", "F0 41 10 21 30").position, 0u);
  EXPECT_EQ(Try("F0 41 10 20 30", "F0 41 10 21").position, 0u);
}

// Hosts begin each attempt with fresh values because of this.
TEST(AutodetectMatcher, LeavesWhatItCapturedBeforeAMismatch) {
  Attempt const attempt = Try("F0 ID F9 42", "F0 05 41 43");
  EXPECT_EQ(attempt.position, 0u);
  EXPECT_EQ(attempt.deviceID, 5);
  EXPECT_EQ(attempt.captured[0], 0x41);
}

TEST(AutodetectMatcher, CapturesNothingForF8AndAByteForEachCodeAboveIt) {
  Attempt const attempt = Try("F8 F9 FA FB FC FD FE FF", "00 01 02 03 04 05 06 07");
  EXPECT_EQ(attempt.position, 8u);
  EXPECT_EQ(BytesOf(attempt.captured), BytesOf("01 02 03 04 05 06 07"));
}

TEST(AutodetectMatcher, ComparesUpToF7) {
  EXPECT_EQ(Try("F7", "F7").position, 1u);
  EXPECT_EQ(Try("F7", "F6").position, 0u);
  EXPECT_EQ(Try("F8", "F6").position, 1u);
}

TEST(AutodetectMatcher, RefusesALongerAnswerOnlyWhenStrict) {
  EXPECT_EQ(Try("F0 41", "F0 41", true).position, 2u);
  EXPECT_EQ(Try("F0 41", "F0 41 10", true).position, 0u);
  EXPECT_EQ(Try("F0 41", "F0 41 10", false).position, 2u);
}

TEST(AutodetectMatcher, StaysWhereItIsWithoutBytes) {
  EXPECT_EQ(Try("F0 41", "").position, 0u);
  Attempt attempt;
  attempt.position = 1;
  EXPECT_EQ(attempt.Take(Matcher(TableOf("F0 41"), false), {}).position, 1u);
}

TEST(AutodetectMatcher, CannotTellFailureFromSuccessWithAnEmptyTable) {
  Matcher const matcher({}, false);
  EXPECT_EQ(matcher.Success(), 0u);
  EXPECT_EQ(Try("", "F0 41").position, 0u);
}

TEST(AutodetectMatcher, TakesAPositionBehindTheTableForItsEnd) {
  Attempt attempt;
  attempt.position = 99;
  EXPECT_EQ(attempt.Take(Matcher(TableOf("F0 41"), false), BytesOf("F0")).position, 2u);
  attempt.position = 99;
  EXPECT_EQ(attempt.Take(Matcher(TableOf("F0 41"), true), BytesOf("F0")).position, 0u);
}

TEST(AutodetectMatcher, CopiesItsTable) {
  Matcher copy(TableOf("F0"), true);
  {
    Matcher const matcher(TableOf("F0 41"), false);
    copy = matcher;
  }
  EXPECT_EQ(copy.Success(), 2u);
  Attempt attempt;
  EXPECT_EQ(attempt.Take(copy, BytesOf("F0 41 10")).position, 2u);
}

TEST(AutodetectMatcher, ReadsAPacketAsBytes) {
  unsigned char const bytes[] = {0xF0, 0x41};
  DataPacket packet;
  packet.data = bytes;
  packet.length = 2;
  EXPECT_EQ(Data(packet).bytes, bytes);
  EXPECT_EQ(Data(packet).count, 2u);
}

}  // namespace
}  // namespace Ostinet

// SPDX-License-Identifier: MIT
#include <gtest/gtest.h>

#include "api/Link.h"
#include "ostinet/TimeStamp.h"

namespace Ostinet::Testing {
namespace {

TEST(Declarations, OfTimeAreComplete) {
  Link<Const<Clocks, unsigned long long>>(&Clocks::Value);

  Link<Const<Nanos, unsigned long long>>(&Nanos::Value);

  Link<Const<Seconds, double>>(&Seconds::Value);

  Link<Static<TimeStamp, Clocks>>(&TimeStamp::TimeStampWithMIDITime);
  Link<Static<TimeStamp, Seconds>>(&TimeStamp::TimeStampWithSeconds);
  Link<Static<TimeStamp, Seconds, double>>(&TimeStamp::TimeStampWithSecondsAndSamples);
  Link<Const<TimeStamp, Clocks>>(&TimeStamp::AsMIDITime);
  Link<Const<TimeStamp, Seconds>>(&TimeStamp::AsSeconds);
  Link<Const<TimeStamp, bool>>(&TimeStamp::HaveSamps);
  Link<Const<TimeStamp, double>>(&TimeStamp::AsSampleCount);
  Link<Const<TimeStamp, void>>(&TimeStamp::DemandSampleTime);
  Link<Const<TimeStamp, bool, TimeStamp const&>>(&TimeStamp::operator==);
  Link<Const<TimeStamp, bool, TimeStamp const&>>(&TimeStamp::operator!=);
  Link<Const<TimeStamp, bool, TimeStamp const&>>(&TimeStamp::operator<);

  Link<Mutable<DataBuffer, void, TimeStamp const&, unsigned char const*, size_t>>(&DataBuffer::Add);
  Link<Const<DataBuffer, bool>>(&DataBuffer::empty);
  Link<Const<DataBuffer, size_t>>(&DataBuffer::size);
  Link<Const<DataBuffer, DataPacket, size_t>>(&DataBuffer::operator[]);
  Link<Const<DataBuffer, DataPacket>>(&DataBuffer::back);

  Link<Clocks (*)()>(&CurrentMIDITime);
  Link<Nanos (*)(Clocks)>(&MIDITimeToNanoseconds);
  Link<Clocks (*)(Nanos)>(&NanosecondsToMIDITime);
  Link<Clocks (*)(double)>(&EventTimeToMIDITime);
  Link<double (*)(Clocks)>(&MIDITimeToEventTime);
  Link<Clocks (*)(unsigned long long)>(&HostClocksToMIDITime);
  Link<unsigned long long (*)(Clocks)>(&MIDITimeToHostClocks);
  Link<Seconds (*)(double)>(&HostTimeToMIDITime);
  Link<double (*)(Seconds)>(&MIDITimeToHostTime);
  Link<TimeStamp (*)(Clocks)>(&TimeStampWithMIDITime);
  Link<TimeStamp (*)(Seconds)>(&TimeStampWithSeconds);
  Link<TimeStamp (*)(Seconds, double)>(&TimeStampWithSecondsAndSamples);
}

static_assert(kIsImplicit<unsigned long long, Clocks>, "");
static_assert(kIsImplicit<unsigned long long, Nanos>, "");
static_assert(kIsImplicit<double, Seconds>, "");
static_assert(kIsImplicit<Clocks, TimeStamp>, "");
static_assert(std::is_constructible<TimeStamp, Clocks, double>::value, "");
static_assert(std::is_same<decltype(kNoTimeStamp), TimeStamp const>::value, "");

TEST(Declarations, PacketsAreMadeOfTheirParts) {
  unsigned char const bytes[] = {0xF8};
  DataPacket packet = {bytes, 1, TimeStamp(Clocks(7))};
  packet.data = bytes;
  packet.length = 1ull;
  DataBuffer buffer;
  buffer.Add(packet.stamp, packet.data, 1);
  EXPECT_EQ(buffer[0].stamp, Clocks(7));
  EXPECT_EQ(buffer.back().data[0], 0xF8);
}

TEST(Declarations, TheNullStampAnswersLikeAny) {
  EXPECT_EQ(kNoTimeStamp.AsSampleCount(), -100000.0);
  EXPECT_EQ(TimeStamp::TimeStampWithSecondsAndSamples(1.0, 2.0).AsSampleCount(), 2.0);
  EXPECT_EQ(TimeStampWithSeconds(1.0).AsMIDITime().Value(), 10000000u);
}

}  // namespace
}  // namespace Ostinet::Testing

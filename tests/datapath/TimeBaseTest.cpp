// SPDX-License-Identifier: MIT
#include <gtest/gtest.h>

#include "datapath/TimeBase.h"

namespace Ostinet::Impl {
namespace {

class TimeBase : public testing::Test {
 protected:
  TimeBase() { SetTimeBaseOffsets({}); }
  ~TimeBase() override { SetTimeBaseOffsets({}); }
};

TEST_F(TimeBase, CountsAHundredNanosecondsToTheClock) {
  EXPECT_EQ(MIDITimeToNanoseconds(1).Value(), 100u);
  EXPECT_EQ(NanosecondsToMIDITime(99).Value(), 0u);
  EXPECT_EQ(NanosecondsToMIDITime(100).Value(), 1u);
}

TEST_F(TimeBase, FindsTenThousandClocksInAMillisecond) {
  EXPECT_EQ(NanosecondsToMIDITime(1000000).Value(), 10000u);
}

TEST_F(TimeBase, ConvertsCountsAboveTheSignedRange) {
  EXPECT_EQ(NanosecondsToMIDITime(1ull << 63).Value(), 92233720368547760u);
  EXPECT_EQ(MIDITimeToNanoseconds(100000000000000000u).Value(), 10000000000000000000u);
}

TEST_F(TimeBase, ConvertsEventTimesWithoutAnOffset) {
  EXPECT_EQ(EventTimeToMIDITime(2.5).Value(), 25000000u);
  EXPECT_EQ(MIDITimeToEventTime(25000000), 2.5);
}

TEST_F(TimeBase, ConvertsEventTimesWithTheOffset) {
  SetTimeBaseOffsets({100.0, 0.0});
  EXPECT_EQ(EventTimeToMIDITime(102.5).Value(), 25000000u);
  EXPECT_EQ(MIDITimeToEventTime(25000000), 102.5);
}

// An event before the beginning of MIDI time wraps around, as counts do.
TEST_F(TimeBase, WrapsEventTimesBelowZero) {
  EXPECT_EQ(EventTimeToMIDITime(-1.0).Value(), 184467440727095520u);
}

// While the two clocks are measured to be next to each other, host clocks must pass to the bit.
TEST_F(TimeBase, PassesHostClocksUnchangedBelowAHundred) {
  constexpr unsigned long long kOdd = (1ull << 60) + 1;  // more bits than a double holds
  for (double offset : {0.0, 99.9, -99.9}) {
    SetTimeBaseOffsets({0.0, offset});
    EXPECT_EQ(HostClocksToMIDITime(kOdd).Value(), kOdd) << offset;
    EXPECT_EQ(MIDITimeToHostClocks(kOdd), kOdd) << offset;
  }
}

TEST_F(TimeBase, ConvertsHostClocksFromAHundredOn) {
  SetTimeBaseOffsets({0.0, 100.0});
  EXPECT_EQ(HostClocksToMIDITime(1000).Value(), 900u);
  EXPECT_EQ(MIDITimeToHostClocks(900), 1000u);
  SetTimeBaseOffsets({0.0, -100.0});
  EXPECT_EQ(HostClocksToMIDITime(1000).Value(), 1100u);
  EXPECT_EQ(MIDITimeToHostClocks(1100), 1000u);
}

TEST_F(TimeBase, ConvertsHostTimesInSeconds) {
  EXPECT_DOUBLE_EQ(HostTimeToMIDITime(2.5).Value(), 2.5);
  EXPECT_DOUBLE_EQ(MIDITimeToHostTime(2.5), 2.5);
  SetTimeBaseOffsets({0.0, 10000000.0});
  EXPECT_DOUBLE_EQ(HostTimeToMIDITime(3.5).Value(), 2.5);
  EXPECT_DOUBLE_EQ(MIDITimeToHostTime(2.5), 3.5);
}

// Hosts rely on the slow start: no measurement is ever taken over at once, not even the first.
TEST_F(TimeBase, MovesFivePercentOfTheWayAtEachCalibration) {
  Clocks const now(20000000);  // two seconds
  CalibrateTimeBase(now, 20000000 + 4000, 12000);
  EXPECT_NEAR(GetTimeBaseOffsets().eventTime, 0.5, 1e-9);
  EXPECT_NEAR(GetTimeBaseOffsets().hostClocks, 200.0, 1e-9);
  CalibrateTimeBase(now, 20000000 + 4000, 12000);
  EXPECT_NEAR(GetTimeBaseOffsets().eventTime, 0.975, 1e-9);
  EXPECT_NEAR(GetTimeBaseOffsets().hostClocks, 390.0, 1e-9);
}

TEST_F(TimeBase, ComesWithinOnePercentAfterNinetyCalibrations) {
  for (int i = 0; i < 90; ++i) {
    CalibrateTimeBase(Clocks(20000000), 20000000 + 4000, 12000);
  }
  EXPECT_NEAR(GetTimeBaseOffsets().eventTime, 10.0, 0.1);
  EXPECT_LT(GetTimeBaseOffsets().eventTime, 10.0);
  EXPECT_NEAR(GetTimeBaseOffsets().hostClocks, 4000.0, 40.0);
}

TEST_F(TimeBase, SmoothsTheTwoOffsetsIndependently) {
  SetTimeBaseOffsets({10.0, 500.0});
  CalibrateTimeBase(Clocks(0), 500, 0);
  EXPECT_NEAR(GetTimeBaseOffsets().eventTime, 9.5, 1e-9);
  EXPECT_NEAR(GetTimeBaseOffsets().hostClocks, 500.0, 1e-9);
}

// The distance of the host's counter is an unsigned difference: a counter behind the master clock
// counts as far ahead of it.
TEST_F(TimeBase, MeasuresTheHostClockUnsigned) {
  CalibrateTimeBase(Clocks(1), 0, 0);
  EXPECT_NEAR(GetTimeBaseOffsets().hostClocks, 18446744073709551615.0 * 0.05, 1e6);
}

}  // namespace
}  // namespace Ostinet::Impl

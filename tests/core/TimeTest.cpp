// SPDX-License-Identifier: MIT
#include <gtest/gtest.h>

#include <atomic>
#include <chrono>

#include "core/Time.h"

namespace Ostinet {
namespace {

unsigned long long sReading = 0;

class MovedTimer : public testing::Test {
 protected:
  MovedTimer() {
    sReading = 0;
    TimerCalibrator::fgInstance.SetCounter([] { return sReading; });
  }
  ~MovedTimer() override { TimerCalibrator::fgInstance.SetCounter(nullptr); }
};

TEST(TimerCalibrator, CountsIn100Nanoseconds) {
  EXPECT_EQ(TimerCalibrator::fgInstance.TicksPerSecond(), 1e7);
  EXPECT_EQ(TimerCalibrator::fgInstance.SecondsPerTick(), 1e-7);
}

TEST(TimerCalibrator, ReadsTheSystemsSteadyClock) {
  auto const clocks = [] {
    auto const now = std::chrono::steady_clock::now().time_since_epoch();
    return static_cast<unsigned long long>(
        std::chrono::duration_cast<std::chrono::nanoseconds>(now).count() / 100);
  };
  auto const before = clocks();
  auto const reading = TimerCalibrator::fgInstance.Clocks();
  EXPECT_LE(before, reading);
  EXPECT_LE(reading, clocks());
}

TEST_F(MovedTimer, GivesTheReadingOfTheCounterThatWasSet) {
  sReading = 12345;
  EXPECT_EQ(TimerCalibrator::fgInstance.Clocks(), 12345U);
}

TEST_F(MovedTimer, GivesTheEventTimeInSeconds) {
  sReading = 25'000'000;
  EXPECT_DOUBLE_EQ(VantorSystemTime::GetCurrentEventTime(), 2.5);
}

}  // namespace
}  // namespace Ostinet

// SPDX-License-Identifier: MIT
#include "datapath/TimeBase.h"

#include <atomic>
#include <cmath>

#include "core/Conversions.h"
#include "core/Time.h"
#include "ostinet/Clocks.h"

namespace Ostinet {
namespace Impl {
namespace {

// The polling thread stores, any thread loads. Each stands for itself, so relaxed order is enough.
std::atomic<double> gEventTimeOffset{0.0};
std::atomic<double> gHostClockOffset{0.0};

// Hosts count on the slow start: the first measurement too moves an offset 5 % of the way only, so
// that host clocks pass unchanged while the measured distance is small.
void MoveTowards(double measured, std::atomic<double>& offset) {
  constexpr double kCoefficient = 0.95;
  double const old = offset.load(std::memory_order_relaxed);
  offset.store(old * kCoefficient + (1.0 - kCoefficient) * measured, std::memory_order_relaxed);
}

// Below this many ticks the two clocks count as one.
constexpr double kNegligibleHostOffset = 100.0;

}  // namespace

void CalibrateTimeBase(Clocks now, unsigned long long hostClocks, unsigned int milliseconds) {
  double const nanoseconds = Unsigned64ToDouble(MIDITimeToNanoseconds(now).Value());
  MoveTowards(milliseconds / 1000.0 - nanoseconds / 1e9, gEventTimeOffset);
  MoveTowards(Unsigned64ToDouble(hostClocks - now.Value()), gHostClockOffset);
}

TimeBaseOffsets GetTimeBaseOffsets() {
  return {gEventTimeOffset.load(std::memory_order_relaxed),
          gHostClockOffset.load(std::memory_order_relaxed)};
}

void SetTimeBaseOffsets(TimeBaseOffsets const& offsets) {
  gEventTimeOffset.store(offsets.eventTime, std::memory_order_relaxed);
  gHostClockOffset.store(offsets.hostClocks, std::memory_order_relaxed);
}

}  // namespace Impl

Nanos MIDITimeToNanoseconds(Clocks clocks) {
  return DoubleToUnsigned64(Unsigned64ToDouble(clocks.Value()) * 100.0);
}

Clocks NanosecondsToMIDITime(Nanos nanos) {
  return DoubleToUnsigned64(Unsigned64ToDouble(nanos.Value()) * (1.0 / 100.0));
}

Clocks EventTimeToMIDITime(double eventTime) {
  double const seconds = eventTime - Impl::gEventTimeOffset.load(std::memory_order_relaxed);
  return NanosecondsToMIDITime(DoubleToUnsigned64(seconds * 1e9));
}

double MIDITimeToEventTime(Clocks clocks) {
  return 100.0 * Unsigned64ToDouble(clocks.Value()) / 1e9 +
         Impl::gEventTimeOffset.load(std::memory_order_relaxed);
}

Clocks HostClocksToMIDITime(unsigned long long hostClocks) {
  double const offset = Impl::gHostClockOffset.load(std::memory_order_relaxed);
  if (std::abs(offset) < Impl::kNegligibleHostOffset) {
    return hostClocks;
  }
  return DoubleToUnsigned64(Unsigned64ToDouble(hostClocks) - offset);
}

unsigned long long MIDITimeToHostClocks(Clocks clocks) {
  double const offset = Impl::gHostClockOffset.load(std::memory_order_relaxed);
  if (std::abs(offset) < Impl::kNegligibleHostOffset) {
    return clocks.Value();
  }
  return DoubleToUnsigned64(Unsigned64ToDouble(clocks.Value()) + offset);
}

Seconds HostTimeToMIDITime(double hostTime) {
  double const hostClocks = hostTime * TimerCalibrator::fgInstance.TicksPerSecond();
  Clocks const clocks = HostClocksToMIDITime(DoubleToUnsigned64(hostClocks));
  return Unsigned64ToDouble(MIDITimeToNanoseconds(clocks).Value()) / 1e9;
}

double MIDITimeToHostTime(Seconds time) {
  Clocks const clocks = NanosecondsToMIDITime(DoubleToUnsigned64(time.Value() * 1e9));
  return Unsigned64ToDouble(MIDITimeToHostClocks(clocks)) *
         TimerCalibrator::fgInstance.SecondsPerTick();
}

}  // namespace Ostinet

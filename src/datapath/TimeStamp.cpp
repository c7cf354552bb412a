// SPDX-License-Identifier: MIT
#include "ostinet/TimeStamp.h"

#include <limits>

#include "core/Conversions.h"
#include "ostinet/Setup.h"

namespace Ostinet {
namespace {

// What hosts recognise a stamp without a time by.
constexpr double kNoSampleTime = -100000.0;

Clocks WholeClocks(Seconds seconds) {
  return NanosecondsToMIDITime(DoubleToUnsigned64(seconds.Value() * 1e9));
}

}  // namespace

TimeStamp const kNoTimeStamp;

TimeStamp TimeStamp::TimeStampWithMIDITime(Clocks clocks) { return TimeStamp(clocks); }

TimeStamp TimeStamp::TimeStampWithSeconds(Seconds seconds) {
  return TimeStamp(WholeClocks(seconds));
}

TimeStamp TimeStamp::TimeStampWithSecondsAndSamples(Seconds seconds, double samples) {
  return TimeStamp(WholeClocks(seconds), samples);
}

TimeStamp TimeStampWithMIDITime(Clocks clocks) { return TimeStamp::TimeStampWithMIDITime(clocks); }

TimeStamp TimeStampWithSeconds(Seconds seconds) { return TimeStamp::TimeStampWithSeconds(seconds); }

TimeStamp TimeStampWithSecondsAndSamples(Seconds seconds, double samples) {
  return TimeStamp::TimeStampWithSecondsAndSamples(seconds, samples);
}

Seconds TimeStamp::AsSeconds() const {
  return Unsigned64ToDouble(MIDITimeToNanoseconds(clocks_).Value()) / 1e9;
}

double TimeStamp::AsSampleCount() const {
  if (!haveSamples_) {
    DemandSampleTime();
  }
  return samples_;
}

void TimeStamp::DemandSampleTime() const {
  unsigned long long const clocks = clocks_.Value();
  OstinetCallbackAPI* const host = OstinetCallbackAPI::gInstance;
  if (clocks == 0 || clocks == std::numeric_limits<unsigned long long>::max() || host == nullptr) {
    samples_ = kNoSampleTime;
  } else {
    samples_ = host->GetSampleTime(MIDITimeToHostClocks(clocks_));
  }
  haveSamples_ = true;
}

}  // namespace Ostinet

// SPDX-License-Identifier: MIT
#pragma once

#include "ostinet/Export.h"

namespace Ostinet {

/// A moment of MIDI time: a count of 100 ns on the master clock. On the way out, 0 means now.
class Clocks {
 public:
  constexpr Clocks() : value_(0) {}
  constexpr Clocks(unsigned long long value) : value_(value) {}
  constexpr unsigned long long Value() const { return value_; }

 private:
  unsigned long long value_;
};

/// A count of nanoseconds.
class Nanos {
 public:
  constexpr Nanos() : value_(0) {}
  constexpr Nanos(unsigned long long value) : value_(value) {}
  constexpr unsigned long long Value() const { return value_; }

 private:
  unsigned long long value_;
};

/// A time in seconds.
class Seconds {
 public:
  constexpr Seconds() : value_(0.0) {}
  constexpr Seconds(double value) : value_(value) {}
  constexpr double Value() const { return value_; }

 private:
  double value_;
};

// The one time line of all MIDI data, and the roads to the host's other clocks.
//
// All of these are [realtime] and safe on any thread: they take no lock and allocate nothing. Only
// CurrentMIDITime throws. Counts pass through doubles, so that beyond 2^53 they lose their last
// bits; a count of 2^63 and above converts as the unsigned number that it is, and a negative double
// gives the two's complement of its whole part.

/// The master clock's reading; 0 before sign-in and after sign-out. Throws a VantorError where the
/// system cannot tell the time.
OSTINET_EXPORT Clocks CurrentMIDITime();

/// The clocks in nanoseconds, 100 to the clock.
OSTINET_EXPORT Nanos MIDITimeToNanoseconds(Clocks clocks);
/// The whole clocks in `nanos`: 99 ns are none.
OSTINET_EXPORT Clocks NanosecondsToMIDITime(Nanos nanos);

/// From the host's event time in seconds, the scale of VantorSystemTime. Polling calibrates it:
/// each poll goes 5 % of the way, so that it is within 1 % of the distance after some 90 polls.
OSTINET_EXPORT Clocks EventTimeToMIDITime(double eventTime);
/// The reverse of EventTimeToMIDITime, in seconds.
OSTINET_EXPORT double MIDITimeToEventTime(Clocks clocks);

/// From a reading of the host's counter, in ticks of 100 ns. While the measured distance of the two
/// clocks is below 100 ticks, the value comes back as it stands.
OSTINET_EXPORT Clocks HostClocksToMIDITime(unsigned long long hostClocks);
/// The reverse of HostClocksToMIDITime, with the same exception.
OSTINET_EXPORT unsigned long long MIDITimeToHostClocks(Clocks clocks);

/// From the host's counter in seconds to MIDI time in seconds.
OSTINET_EXPORT Seconds HostTimeToMIDITime(double hostTime);
/// From MIDI time in seconds to the host's counter in seconds.
OSTINET_EXPORT double MIDITimeToHostTime(Seconds time);

}  // namespace Ostinet

// SPDX-License-Identifier: MIT
#pragma once

#include <cstddef>
#include <vector>

#include "ostinet/Common.h"

namespace Ostinet {
class Clocks {
 public:
  Clocks();
  Clocks(unsigned long long);
  unsigned long long Value() const;
};
class Nanos {
 public:
  Nanos();
  Nanos(unsigned long long);
  unsigned long long Value() const;
};
class Seconds {
 public:
  Seconds();
  Seconds(double);
  double Value() const;
};
class TimeStamp {
 public:
  TimeStamp();
  TimeStamp(Clocks);
  TimeStamp(Clocks, double samples);
  static TimeStamp TimeStampWithMIDITime(Clocks);
  static TimeStamp TimeStampWithSeconds(Seconds);
  static TimeStamp TimeStampWithSecondsAndSamples(Seconds, double);
  Clocks AsMIDITime() const;
  Seconds AsSeconds() const;
  bool HaveSamps() const;
  double AsSampleCount() const;
  void DemandSampleTime() const;
  bool operator==(TimeStamp const&) const;
  bool operator!=(TimeStamp const&) const;
  bool operator<(TimeStamp const&) const;
};
extern TimeStamp const kNoTimeStamp;
Clocks CurrentMIDITime();
Nanos MIDITimeToNanoseconds(Clocks);
Clocks NanosecondsToMIDITime(Nanos);
Clocks EventTimeToMIDITime(double);
double MIDITimeToEventTime(Clocks);
Clocks HostClocksToMIDITime(unsigned long long);
unsigned long long MIDITimeToHostClocks(Clocks);
Seconds HostTimeToMIDITime(double);
double MIDITimeToHostTime(Seconds);
struct DataPacket {
  unsigned char const* data;
  unsigned long long length;
  TimeStamp stamp;
};
class DataBuffer {
 public:
  DataBuffer();
  void Add(TimeStamp const&, unsigned char const*, size_t);
  bool empty() const;
  size_t size() const;
  DataPacket operator[](size_t) const;
  DataPacket back() const;
};
}  // namespace Ostinet

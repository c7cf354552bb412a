// SPDX-License-Identifier: MIT
#pragma once

#include <cstddef>
#include <vector>

#include "ostinet/Clocks.h"
#include "ostinet/Common.h"
#include "ostinet/Export.h"

namespace Ostinet {

/// When a message happens: a moment of MIDI time, and the audio sample count that belongs to it as
/// soon as somebody asks for it.
///
/// Ownership    A value.
/// Threads      [realtime] One stamp belongs to one thread at a time. Asking a const stamp for its
///              samples writes them into it, and kNoTimeStamp is no exception: on other threads
///              than the polling thread, ask a copy.
/// Errors       None are thrown, except by the host's GetSampleTime.
class OSTINET_EXPORT TimeStamp {
 public:
  /// Clock 0, which on the way out means now.
  constexpr TimeStamp() : samples_(0.0), haveSamples_(false) {}
  constexpr TimeStamp(Clocks clocks) : clocks_(clocks), samples_(0.0), haveSamples_(false) {}
  constexpr TimeStamp(Clocks clocks, double samples)
      : clocks_(clocks), samples_(samples), haveSamples_(true) {}

  /// A stamp of that clock without samples.
  static TimeStamp TimeStampWithMIDITime(Clocks clocks);
  /// A stamp of so many seconds of MIDI time, cut to whole nanoseconds and then to whole clocks.
  static TimeStamp TimeStampWithSeconds(Seconds seconds);
  /// The same with a sample count.
  static TimeStamp TimeStampWithSecondsAndSamples(Seconds seconds, double samples);

  Clocks AsMIDITime() const { return clocks_; }
  Seconds AsSeconds() const;
  /// Whether a sample count is here, given or asked for earlier.
  bool HaveSamps() const { return haveSamples_; }
  /// The sample count; asks the host for it the first time.
  double AsSampleCount() const;
  /// Asks the host, through OstinetCallbackAPI::gInstance, which sample sounds at this moment, also
  /// where a count is here already. A stamp without a time, clock 0 or all ones, gets -100000.0,
  /// and so does every stamp while there is no OstinetCallbackAPI.
  void DemandSampleTime() const;

  /// Stamps compare by their clocks, unsigned; the samples take no part.
  bool operator==(TimeStamp const& other) const { return clocks_.Value() == other.clocks_.Value(); }
  bool operator!=(TimeStamp const& other) const { return !(*this == other); }
  bool operator<(TimeStamp const& other) const { return clocks_.Value() < other.clocks_.Value(); }

 private:
  Clocks clocks_;
  mutable double samples_;
  mutable bool haveSamples_;
};

/// The stamp of all zeroes.
OSTINET_EXPORT extern TimeStamp const kNoTimeStamp;

/// The same as the static members of TimeStamp.
OSTINET_EXPORT TimeStamp TimeStampWithMIDITime(Clocks clocks);
OSTINET_EXPORT TimeStamp TimeStampWithSeconds(Seconds seconds);
OSTINET_EXPORT TimeStamp TimeStampWithSecondsAndSamples(Seconds seconds, double samples);

/// A view of one stamped MIDI message, or of a piece of a long one. It owns nothing: whoever makes
/// it keeps the bytes for as long as the packet is used. A stamp of clock 0 means now.
struct DataPacket {
  unsigned char const* data = nullptr;
  unsigned long long length = 0;  ///< in bytes
  TimeStamp stamp;
};

/// Stamped messages with their bytes, in the order in which they are to be sent.
///
/// Ownership    A value: a copy has bytes of its own.
/// Threads      One buffer belongs to one thread at a time.
/// Errors       Add throws std::bad_alloc, and then the buffer is as before.
class OSTINET_EXPORT DataBuffer {
 public:
  DataBuffer();

  /// Appends a packet with a copy of `length` bytes; null `bytes` make an empty packet. The bytes
  /// may be those of a packet of this buffer.
  void Add(TimeStamp const& stamp, unsigned char const* bytes, size_t length);
  /// Makes the last packet longer by one byte; does nothing where there is no packet.
  void AppendByte(unsigned char byte);

  bool empty() const { return entries_.empty(); }
  /// The count of packets.
  size_t size() const { return entries_.size(); }

  /// A packet, whose bytes stay where they are until the next Add or the buffer's end. Beyond the
  /// last one, an empty packet.
  DataPacket operator[](size_t index) const;
  /// The last packet, or an empty one.
  DataPacket back() const;

 private:
  struct Entry {
    TimeStamp stamp;
    size_t offset = 0;
    size_t length = 0;
  };

  std::vector<Entry> entries_;
  std::vector<unsigned char> bytes_;  // of all packets, one behind the other
};

}  // namespace Ostinet

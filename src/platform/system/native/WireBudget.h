// SPDX-License-Identifier: MIT
#pragma once

#include <chrono>
#include <cstddef>

namespace Ostinet::Impl {

/// How fast bytes may go to a port behind the ALSA sequencer, which drops without a word what its
/// driver's buffer (4 KB as a rule) has no room for.
///
/// Sysex flows at the rate of a MIDI cable once a burst is spent, since a dump for an instrument
/// has to arrive whole. Short messages, where being late is worse, may come twenty times as fast,
/// which is more than an instrument can use.
///
/// Threads  One.
class WireBudget {
 public:
  using Time = std::chrono::steady_clock::time_point;
  using Duration = std::chrono::steady_clock::duration;

  /// What may go out at once after a rest, in bytes.
  static constexpr double kBurst = 2048;
  /// A MIDI cable's bytes a second.
  static constexpr double kCableRate = 3125;
  /// Short messages cost this much less.
  static constexpr double kShortDiscount = 20;

  /// Spends `count` bytes at `now`; the result is how long to wait before they go out, 0 or more.
  Duration Spend(std::size_t count, Time now);

 private:
  double debt_ = 0;  // bytes that a cable would still be busy with
  Time last_{};
};

}  // namespace Ostinet::Impl

// SPDX-License-Identifier: MIT
#pragma once

#include <atomic>

namespace Ostinet {

/// The process-wide high-resolution timer. One clock of it is 100 ns, the unit of MIDI time, so
/// that the difference between the two stays a count in one unit.
///
/// Threads      [any thread]
class TimerCalibrator {
 public:
  /// Reads a counter that never goes back, in clocks.
  using Counter = unsigned long long (*)();

  static TimerCalibrator fgInstance;

  /// The present reading.
  unsigned long long Clocks() const { return counter_.load(std::memory_order_acquire)(); }
  double TicksPerSecond() const { return kTicksPerSecond; }
  double SecondsPerTick() const { return 1.0 / kTicksPerSecond; }

  /// Reads another counter from now on, such as one that a test moves; null brings the system's
  /// back.
  void SetCounter(Counter counter);

 private:
  static constexpr double kTicksPerSecond = 1e7;
  static unsigned long long SystemCounter();

  // Stored by SetCounter, loaded by any thread; the counter sees what was written before it was
  // set.
  std::atomic<Counter> counter_{&SystemCounter};
};

/// The time line of the host's own events.
class VantorSystemTime {
 public:
  /// The present moment in seconds, on a time line that never goes back.
  static double GetCurrentEventTime();
};

}  // namespace Ostinet

// SPDX-License-Identifier: MIT
#pragma once

#include <atomic>
#include <cstdint>

namespace Ostinet::Impl::Simulated {

/// The time of the simulated system, in units of 100 ns: the machine's, or moved by hand.
///
/// Threads  Any; each value is an atomic that stands for itself.
class SimClock {
 public:
  std::int64_t Now() const;
  bool IsByHand() const { return byHand_.load(std::memory_order_acquire); }

  void UseRealTime();
  void UseHand(std::int64_t start);
  /// The present moment of a clock that is moved by hand. Never goes back.
  void MoveTo(std::int64_t time);

  /// What the master clock gives, with all that is asked of it below.
  std::int64_t ReadMaster();
  void SetStep(std::int64_t step) { step_.store(step, std::memory_order_relaxed); }
  void SetTick(std::int64_t tick) { tick_.store(tick, std::memory_order_relaxed); }
  void SetAbsent(bool absent) { absent_.store(absent, std::memory_order_relaxed); }
  void SetStill(bool still);

 private:
  static std::int64_t Machine();

  std::atomic<bool> byHand_{false};
  // Real time: added to the machine's reading. By hand: the reading itself.
  std::atomic<std::int64_t> offset_{0};
  std::atomic<std::int64_t> hand_{0};
  std::atomic<std::int64_t> step_{0};
  std::atomic<std::int64_t> tick_{1};
  std::atomic<bool> absent_{false};
  std::atomic<bool> still_{false};
  std::atomic<std::int64_t> stillAt_{0};
};

}  // namespace Ostinet::Impl::Simulated

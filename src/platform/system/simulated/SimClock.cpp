// SPDX-License-Identifier: MIT
#include "platform/system/simulated/SimClock.h"

#include <chrono>

namespace Ostinet::Impl::Simulated {

std::int64_t SimClock::Machine() {
  auto const now = std::chrono::steady_clock::now().time_since_epoch();
  return std::chrono::duration_cast<std::chrono::nanoseconds>(now).count() / 100 + 1;
}

std::int64_t SimClock::Now() const {
  if (IsByHand()) return hand_.load(std::memory_order_acquire);
  return Machine() + offset_.load(std::memory_order_relaxed);
}

void SimClock::UseRealTime() {
  std::int64_t const now = Now();
  offset_.store(now - Machine(), std::memory_order_relaxed);
  byHand_.store(false, std::memory_order_release);
}

void SimClock::UseHand(std::int64_t start) {
  hand_.store(start, std::memory_order_release);
  byHand_.store(true, std::memory_order_release);
}

void SimClock::MoveTo(std::int64_t time) {
  std::int64_t now = hand_.load(std::memory_order_relaxed);
  while (now < time && !hand_.compare_exchange_weak(now, time, std::memory_order_acq_rel)) {
  }
}

void SimClock::SetStill(bool still) {
  stillAt_.store(Now(), std::memory_order_relaxed);
  still_.store(still, std::memory_order_release);
}

std::int64_t SimClock::ReadMaster() {
  if (absent_.load(std::memory_order_relaxed)) return 0;
  if (still_.load(std::memory_order_acquire)) return stillAt_.load(std::memory_order_relaxed);
  std::int64_t now = 0;
  std::int64_t const step = step_.load(std::memory_order_relaxed);
  if (IsByHand() && step != 0) {
    now = hand_.fetch_add(step, std::memory_order_acq_rel) + step;
  } else {
    now = Now();
  }
  std::int64_t const tick = tick_.load(std::memory_order_relaxed);
  return tick > 1 ? now - now % tick : now;
}

}  // namespace Ostinet::Impl::Simulated

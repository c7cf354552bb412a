// SPDX-License-Identifier: MIT
#include "core/Time.h"

#include <chrono>
#include <ratio>

namespace Ostinet {

constinit TimerCalibrator TimerCalibrator::fgInstance;

unsigned long long TimerCalibrator::SystemCounter() {
  using Clocks100ns = std::chrono::duration<unsigned long long, std::ratio<1, 10'000'000>>;
  auto const now = std::chrono::steady_clock::now().time_since_epoch();
  return std::chrono::duration_cast<Clocks100ns>(now).count();
}

void TimerCalibrator::SetCounter(Counter counter) {
  counter_.store(counter != nullptr ? counter : &SystemCounter, std::memory_order_release);
}

double VantorSystemTime::GetCurrentEventTime() {
  TimerCalibrator const& timer = TimerCalibrator::fgInstance;
  return static_cast<double>(timer.Clocks()) * timer.SecondsPerTick();
}

}  // namespace Ostinet

// SPDX-License-Identifier: MIT
#include "core/Semaphore.h"

#include <algorithm>
#include <chrono>

namespace Ostinet {

namespace {
// A day: longer waits would overflow the clock's count, and nobody can tell the difference.
constexpr unsigned long long kLongestWait = 24ULL * 60 * 60 * 1000 * 1000;
}  // namespace

void VantorBinarySemaphore::Wait() {
  MutexHolder lock(mutex_);
  while (!signalled_) {
    changed_.wait(mutex_);
  }
  signalled_ = false;
}

WakeReason VantorBinarySemaphore::TimedWait(unsigned long long microseconds) {
  auto const end = std::chrono::steady_clock::now() +
                   std::chrono::microseconds(std::min(microseconds, kLongestWait));
  MutexHolder lock(mutex_);
  while (!signalled_) {
    if (changed_.wait_until(mutex_, end) == std::cv_status::timeout && !signalled_) {
      return WakeReason::kTimedOut;
    }
  }
  signalled_ = false;
  return WakeReason::kSignalled;
}

void VantorBinarySemaphore::Signal() {
  MutexHolder lock(mutex_);
  signalled_ = true;
  changed_.notify_one();
}

}  // namespace Ostinet

// SPDX-License-Identifier: MIT
#pragma once

#include "core/Mutex.h"

namespace Ostinet {

/// What ended a wait.
enum class WakeReason : int { kSignalled, kTimedOut };

/// One signal that is there or not: signals that nobody waited for count as one.
///
/// Threads      [any thread]
class VantorBinarySemaphore : private Noncopyable<VantorBinarySemaphore> {
 public:
  /// `signalled`: whether the first wait goes straight through.
  explicit VantorBinarySemaphore(bool signalled) : signalled_(signalled) {}

  /// Waits for the signal and takes it.
  void Wait();
  /// The same for at most so many microseconds; 0 only looks.
  WakeReason TimedWait(unsigned long long microseconds);
  /// Gives the signal, which wakes one waiting thread.
  void Signal();

 private:
  VantorCoreMutex mutex_;
  ConditionVariable changed_;
  bool signalled_ OSTINET_GUARDED_BY(mutex_);
};

}  // namespace Ostinet

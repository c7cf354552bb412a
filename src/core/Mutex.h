// SPDX-License-Identifier: MIT
#pragma once

#include <condition_variable>
#include <mutex>

#include "core/ThreadAnnotations.h"
#include "ostinet/core/Noncopyable.h"

namespace Ostinet {

/// A mutex, not recursive: the thread that holds it neither locks nor tries it again.
class OSTINET_CAPABILITY("mutex") VantorCoreMutex : private Noncopyable<VantorCoreMutex> {
 public:
  void lock() OSTINET_ACQUIRE() { mutex_.lock(); }
  /// Takes the mutex if no other thread holds it; true if taken.
  bool tryLock() OSTINET_TRY_ACQUIRE(true) { return mutex_.try_lock(); }
  void unlock() OSTINET_RELEASE() { mutex_.unlock(); }

 private:
  std::mutex mutex_;
};

/// A mutex for a handful of instructions. Not recursive, and there is no trying it.
class OSTINET_CAPABILITY("mutex") VantorMutexLite : private Noncopyable<VantorMutexLite> {
 public:
  void lock() OSTINET_ACQUIRE() { mutex_.lock(); }
  void unlock() OSTINET_RELEASE() { mutex_.unlock(); }

 private:
  std::mutex mutex_;
};

/// Holds a mutex from here to the end of the block.
template <class Mutex>
class OSTINET_SCOPED_CAPABILITY MutexHolder : private Noncopyable<void> {
 public:
  explicit MutexHolder(Mutex& mutex) OSTINET_ACQUIRE(mutex) : mutex_(mutex) { mutex_.lock(); }
  ~MutexHolder() OSTINET_RELEASE() { mutex_.unlock(); }

 private:
  Mutex& mutex_;
};

/// Lets threads that hold a mutex wait for one another's news.
using ConditionVariable = std::condition_variable_any;

}  // namespace Ostinet

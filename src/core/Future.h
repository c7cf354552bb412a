// SPDX-License-Identifier: MIT
#pragma once

#include <chrono>
#include <memory>
#include <optional>
#include <utility>

#include "core/Mutex.h"
#include "ostinet/core/Error.h"

// A value or an error that one thread makes and another takes. The promise is the maker's end,
// the future the taker's; either may go first. Every promise ends in a completed future: one that
// is dropped, with its job or without having run, completes it with the error of a cancelled job.

namespace Ostinet {

template <class T>
class VantorPromise;

/// The taker's end, shared between the taker and the promise.
///
/// Threads      [any thread]
template <class T>
class VantorFuture : private Noncopyable<VantorFuture<T>> {
 public:
  VantorFuture() = default;

  /// A copy of the value, once there is one, waiting for it at most so many milliseconds; 0 only
  /// looks. Nothing if none came by then. Throws the VantorError that was put in its place. The
  /// value stays: a second call gives it again.
  std::optional<T> Try(unsigned int milliseconds) const {
    auto const end = std::chrono::steady_clock::now() + std::chrono::milliseconds(milliseconds);
    MutexHolder lock(mutex_);
    while (!value_ && !error_) {
      if (milliseconds == 0 || changed_.wait_until(mutex_, end) == std::cv_status::timeout) {
        break;
      }
    }
    if (error_) {
      throw VantorError(*error_);
    }
    return value_;
  }

  bool IsComplete() const {
    MutexHolder lock(mutex_);
    return value_.has_value() || error_.has_value();
  }

 private:
  friend class VantorPromise<T>;

  // The first completion counts; a later one changes nothing.
  void Complete(std::optional<T> value, std::optional<VantorError> error) {
    MutexHolder lock(mutex_);
    if (!value_ && !error_) {
      value_ = std::move(value);
      error_ = std::move(error);
      changed_.notify_all();
    }
  }

  mutable VantorCoreMutex mutex_;
  mutable ConditionVariable changed_;
  std::optional<T> value_ OSTINET_GUARDED_BY(mutex_);
  std::optional<VantorError> error_ OSTINET_GUARDED_BY(mutex_);
};

/// The maker's end.
///
/// Threads      [any thread]
template <class T>
class VantorPromise : private Noncopyable<VantorPromise<T>> {
 public:
  VantorPromise() : future_(std::make_shared<VantorFuture<T>>()) {}
  ~VantorPromise() { Cancel(); }

  std::shared_ptr<VantorFuture<T>> GetFuture() const { return future_; }

  void Complete(T value) { future_->Complete(std::move(value), std::nullopt); }
  void Fail(VantorError error) { future_->Complete(std::nullopt, std::move(error)); }
  /// Completes with the error of a job that never ran.
  void Cancel() { Fail(VantorError("VantorThreads", "VantorJobQueue", 0, "Job cancelled")); }

 private:
  std::shared_ptr<VantorFuture<T>> const future_;
};

}  // namespace Ostinet

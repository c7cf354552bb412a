// SPDX-License-Identifier: MIT
#pragma once

#include <chrono>
#include <condition_variable>
#include <cstddef>
#include <mutex>

namespace Ostinet::Testing {

/// A std::latch. That of MinGW's library now and then never wakes who waits.
class Latch {
 public:
  explicit Latch(std::ptrdiff_t count) : left_(count) {}

  void count_down() {
    std::lock_guard const lock(mutex_);
    if (--left_ == 0) {
      opened_.notify_all();
    }
  }
  void wait() {
    std::unique_lock lock(mutex_);
    opened_.wait(lock, [this] { return left_ <= 0; });
  }
  bool wait_for(std::chrono::milliseconds time) {
    std::unique_lock lock(mutex_);
    return opened_.wait_for(lock, time, [this] { return left_ <= 0; });
  }
  bool try_wait() {
    std::lock_guard const lock(mutex_);
    return left_ <= 0;
  }
  void arrive_and_wait() {
    count_down();
    wait();
  }

 private:
  std::mutex mutex_;
  std::condition_variable opened_;
  std::ptrdiff_t left_;
};

}  // namespace Ostinet::Testing

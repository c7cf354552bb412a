// SPDX-License-Identifier: MIT
#pragma once

#include <deque>
#include <optional>
#include <utility>

#include "core/Mutex.h"

namespace Ostinet {

/// A queue whose reader waits for the next element. Once closed it takes nothing more.
///
/// Threads      [any thread]
template <class T>
class blocking_queue : private Noncopyable<blocking_queue<T>> {
 public:
  blocking_queue() = default;

  /// Appends an element; false, with nothing done, if the queue is closed.
  bool push(T element) {
    MutexHolder lock(mutex_);
    if (closed_) {
      return false;
    }
    elements_.push_back(std::move(element));
    changed_.notify_one();
    return true;
  }

  /// Waits for the first element and takes it; nothing once the queue is closed.
  std::optional<T> pop() {
    MutexHolder lock(mutex_);
    while (elements_.empty() && !closed_) {
      changed_.wait(mutex_);
    }
    if (closed_) {
      return std::nullopt;
    }
    std::optional<T> element(std::move(elements_.front()));
    elements_.pop_front();
    return element;
  }

  /// Wakes all readers, and gives what was not read.
  std::deque<T> close() {
    MutexHolder lock(mutex_);
    closed_ = true;
    changed_.notify_all();
    return std::exchange(elements_, {});
  }

  bool empty() const {
    MutexHolder lock(mutex_);
    return elements_.empty();
  }

 private:
  mutable VantorCoreMutex mutex_;
  ConditionVariable changed_;
  std::deque<T> elements_ OSTINET_GUARDED_BY(mutex_);
  bool closed_ OSTINET_GUARDED_BY(mutex_) = false;
};

}  // namespace Ostinet

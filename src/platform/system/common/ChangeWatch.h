// SPDX-License-Identifier: MIT
#pragma once

#include <condition_variable>
#include <functional>
#include <memory>
#include <mutex>
#include <thread>

#include "platform/system/common/ChangeNotifier.h"

namespace Ostinet::Impl {

/// Looks at the machine's ports every two seconds, and at once when it is given a hint, and tells
/// its listeners when a look found a change. Without listeners there is no thread.
///
/// Threads  Any; `look` and the listeners run on the watch's own thread.
class ChangeWatch {
 public:
  /// `look` gives true when what it sees differs from what it saw the last time.
  explicit ChangeWatch(std::function<bool()> look);
  /// Waits for a look or call in progress. Not from within a listener.
  ~ChangeWatch();
  ChangeWatch(ChangeWatch const&) = delete;
  ChangeWatch& operator=(ChangeWatch const&) = delete;

  std::shared_ptr<void> Add(std::function<void()> changed);
  /// Something may have changed. Never waits for a look.
  void Hint();

 private:
  void Run();

  std::function<bool()> const look_;
  ChangeNotifier notifier_;
  std::mutex mutex_;
  std::condition_variable woken_;
  bool hinted_ = false;  // guarded by mutex_, as is all below
  bool ending_ = false;
  std::thread thread_;
};

}  // namespace Ostinet::Impl

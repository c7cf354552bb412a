// SPDX-License-Identifier: MIT
#include "platform/system/common/ChangeWatch.h"

#include <chrono>
#include <utility>

namespace Ostinet::Impl {

// As often as hosts are expected to ask for changes of the setup.
constexpr auto kLookInterval = std::chrono::seconds(2);
// Ports come in swarms: an interface with eight of them is one change.
constexpr auto kGatherTime = std::chrono::milliseconds(50);

ChangeWatch::ChangeWatch(std::function<bool()> look) : look_(std::move(look)) {}

ChangeWatch::~ChangeWatch() {
  std::thread thread;
  {
    std::scoped_lock lock(mutex_);
    ending_ = true;
    thread = std::move(thread_);
  }
  woken_.notify_all();
  if (thread.joinable()) thread.join();
}

std::shared_ptr<void> ChangeWatch::Add(std::function<void()> changed) {
  auto place = notifier_.Add(std::move(changed));
  std::scoped_lock lock(mutex_);
  if (!thread_.joinable() && !ending_) thread_ = std::thread([this] { Run(); });
  return place;
}

void ChangeWatch::Hint() {
  {
    std::scoped_lock lock(mutex_);
    hinted_ = true;
  }
  woken_.notify_all();
}

void ChangeWatch::Run() {
  std::unique_lock lock(mutex_);
  while (!ending_) {
    woken_.wait_for(lock, kLookInterval, [this] { return ending_ || hinted_; });
    if (hinted_) woken_.wait_for(lock, kGatherTime, [this] { return ending_; });
    if (ending_) return;
    hinted_ = false;
    lock.unlock();
    if (notifier_.HasListeners() && look_()) notifier_.Notify();
    lock.lock();
  }
}

}  // namespace Ostinet::Impl

// SPDX-License-Identifier: MIT
//
// What is due, and who lets it happen. In real time a thread of the studio sleeps until the next
// time; a clock that is moved by hand does it on the thread that moves it. Either way one thing
// happens after the other, by time and then by the order in which it was asked for.

#include <algorithm>
#include <chrono>

#include "platform/system/simulated/OpenInput.h"
#include "platform/system/simulated/Studio.h"

namespace Ostinet::Impl::Simulated {

namespace {

using SteadyClock = std::chrono::steady_clock;

}  // namespace

Studio::~Studio() {
  {
    std::lock_guard lock(mutex_);
    quit_ = true;
    dueChanged_.notify_all();
  }
  if (clockThread_.joinable()) clockThread_.join();
  // Devices that the host left open: their threads need the mutex to end.
  openInputs.clear();
}

void Studio::Push(Due&& due) {
  due.order = ++order_;
  due_.push_back(std::move(due));
  std::push_heap(due_.begin(), due_.end(), Due::Later);
  if (clock_.IsByHand()) return;
  if (!clockThread_.joinable()) clockThread_ = std::thread([this] { RunClockThread(); });
  dueChanged_.notify_all();
}

void Studio::Schedule(PortPtr const& port, void const* owner, std::int64_t time,
                      std::uint8_t const* bytes, std::size_t size) {
  std::int64_t const now = clock_.Now();
  if (time <= now) {
    Emit(*port, bytes, size, {now, time, now});
    return;
  }
  Due due;
  due.time = time;
  due.port = port;
  due.owner = owner;
  due.handedOver = now;
  due.size = size;
  if (size <= due.inlineBytes.size()) {
    std::copy_n(bytes, size, due.inlineBytes.begin());
  } else {
    due.moreBytes.assign(bytes, bytes + size);
  }
  Push(std::move(due));
}

void Studio::Unschedule(void const* owner) {
  auto const first = std::remove_if(due_.begin(), due_.end(), [&](Due const& due) {
    return due.timeline < 0 && due.owner == owner;
  });
  due_.erase(first, due_.end());
  std::make_heap(due_.begin(), due_.end(), Due::Later);
}

int Studio::CountScheduled() {
  std::lock_guard lock(mutex_);
  return static_cast<int>(
      std::count_if(due_.begin(), due_.end(), [](Due const& due) { return due.timeline < 0; }));
}

void Studio::AddTimelineEvent(std::int64_t at, std::int64_t every, int times,
                              std::function<void()> action) {
  std::lock_guard lock(mutex_);
  timeline_.push_back({at, every, times, std::move(action)});
}

void Studio::StartTimeline() {
  std::lock_guard lock(mutex_);
  if (timelineStarted_) return;
  timelineStarted_ = true;
  std::int64_t const now = clock_.Now();
  for (std::size_t i = 0; i < timeline_.size(); ++i) {
    PushTimeline(static_cast<int>(i), now + timeline_[i].at);
  }
}

void Studio::PushTimeline(int index, std::int64_t time) {
  Due due;
  due.time = time;
  due.timeline = index;
  Push(std::move(due));
}

std::optional<std::int64_t> Studio::EarliestDue() {
  std::lock_guard lock(mutex_);
  if (due_.empty()) return {};
  return due_.front().time;
}

void Studio::RunDue(std::int64_t time) {
  std::lock_guard running(runMutex_);
  std::unique_lock lock(mutex_);
  while (!due_.empty() && due_.front().time <= time && !quit_) {
    std::pop_heap(due_.begin(), due_.end(), Due::Later);
    Due due = std::move(due_.back());
    due_.pop_back();
    if (due.timeline < 0) {
      auto const* const bytes =
          due.moreBytes.empty() ? due.inlineBytes.data() : due.moreBytes.data();
      Emit(*due.port, bytes, due.size, {due.handedOver, due.time, clock_.Now()});
      continue;
    }
    TimelineEvent& event = timeline_[static_cast<std::size_t>(due.timeline)];
    if (event.every > 0 && --event.times > 0) PushTimeline(due.timeline, due.time + event.every);
    auto const action = event.action;
    lock.unlock();
    action();
    lock.lock();
  }
}

void Studio::RunClockThread() {
  std::unique_lock lock(mutex_);
  while (!quit_) {
    if (clock_.IsByHand() || due_.empty()) {
      dueChanged_.wait(lock);
      continue;
    }
    std::int64_t const left = due_.front().time - clock_.Now();
    if (left > 0) {
      // Woken at the latest in a second: a wait of years would overflow the system's clock.
      auto const most = std::min<std::int64_t>(left, 10000000);
      dueChanged_.wait_for(lock, std::chrono::nanoseconds(most * 100));
      continue;
    }
    std::int64_t const now = clock_.Now();
    lock.unlock();
    RunDue(now);
    lock.lock();
  }
}

void Studio::UseRealTime() {
  {
    std::lock_guard lock(mutex_);
    clock_.UseRealTime();
    if (!due_.empty() && !clockThread_.joinable()) {
      clockThread_ = std::thread([this] { RunClockThread(); });
    }
    dueChanged_.notify_all();
  }
  waits_.ClockChanged();
}

void Studio::MoveClockByHand(std::int64_t const* start) {
  {
    std::lock_guard running(runMutex_);
    std::lock_guard lock(mutex_);
    clock_.UseHand(start != nullptr ? *start : clock_.Now());
    dueChanged_.notify_all();
  }
  waits_.ClockChanged();
}

bool Studio::Advance(std::int64_t clocks) {
  constexpr int kPatience = 20000;
  std::lock_guard running(runMutex_);
  std::int64_t const target = clock_.Now() + clocks;
  for (;;) {
    if (!Settle(kPatience)) return false;
    auto next = EarliestDue();
    auto const timer = waits_.EarliestTimer();
    if (timer && (!next || *timer < *next)) next = timer;
    if (!next || *next > target) break;
    clock_.MoveTo(*next);
    waits_.FireTimers(*next);
    RunDue(*next);
  }
  clock_.MoveTo(target);
  return Settle(kPatience);
}

bool Studio::CallbacksAreIdle() const {
  return std::all_of(openInputs.begin(), openInputs.end(), [](auto const& each) {
    return each.second->IsIdle() || each.second->IsOwnThread();
  });
}

bool Studio::Settle(int milliseconds) {
  auto const deadline = SteadyClock::now() + std::chrono::milliseconds(milliseconds);
  for (;;) {
    std::uint64_t const before = waits_.Changes();
    {
      std::unique_lock lock(mutex_);
      bool const idle =
          callbacksIdle.wait_until(lock, deadline, [this] { return CallbacksAreIdle(); });
      if (!idle) return false;
    }
    if (!waits_.WaitUntilIdle(deadline)) return false;
    // What a callback did may have woken a thread, and the other way round: look once more.
    std::lock_guard lock(mutex_);
    if (CallbacksAreIdle() && waits_.Changes() == before) return true;
  }
}

}  // namespace Ostinet::Impl::Simulated

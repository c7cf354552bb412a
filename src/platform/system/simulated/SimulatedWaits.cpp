// SPDX-License-Identifier: MIT
#include "platform/system/simulated/SimulatedWaits.h"

#include <chrono>

#include "platform/system/SystemWaits.h"
#include "platform/system/simulated/ThreadRegistry.h"

namespace Ostinet::Impl::Simulated {

namespace {

// A due time for a timer that only the hand fires: a year from now.
constexpr LONGLONG kFarFuture = -315360000000000;

thread_local DWORD sLastError = ERROR_SUCCESS;

}  // namespace

SimulatedWaits::SimulatedWaits(CallBook& book, SimClock& clock)
    : book_(book),
      clock_(clock),
      machine_(MakeSystemWaits()),
      threads_(std::make_shared<Registry>()) {}

SimulatedWaits::~SimulatedWaits() {
  for (auto const& [handle, shadow] : shadows_) machine_->CloseHandle(handle);
}

HANDLE SimulatedWaits::Add(HANDLE handle, Shadow const& shadow) {
  if (handle == nullptr) {
    sLastError = machine_->GetLastError();
    return nullptr;
  }
  std::lock_guard lock(mutex_);
  shadows_[handle] = shadow;
  return handle;
}

BOOL SimulatedWaits::Done(Op op, BOOL result, std::initializer_list<long long> arguments) {
  if (result == FALSE) sLastError = machine_->GetLastError();
  book_.Log(op, result, arguments);
  return result;
}

HANDLE SimulatedWaits::CreateSemaphoreW(LONG initial, LONG maximum) {
  long long failure = 0;
  if (book_.Fails(Op::kCreateSemaphore, failure)) {
    sLastError = ERROR_NOT_ENOUGH_MEMORY;
    return nullptr;
  }
  Shadow shadow;
  shadow.kind = Kind::kSemaphore;
  shadow.count = initial;
  shadow.maximum = maximum;
  HANDLE const handle = Add(machine_->CreateSemaphoreW(initial, maximum), shadow);
  book_.Log(Op::kCreateSemaphore, handle != nullptr ? 1 : 0, {initial, maximum});
  return handle;
}

BOOL SimulatedWaits::ReleaseSemaphore(HANDLE semaphore, LONG count) {
  long long failure = 0;
  if (book_.Fails(Op::kReleaseSemaphore, failure)) {
    sLastError = ERROR_TOO_MANY_POSTS;
    return static_cast<BOOL>(failure);
  }
  std::lock_guard lock(mutex_);
  BOOL const result = machine_->ReleaseSemaphore(semaphore, count);
  auto const found = shadows_.find(semaphore);
  if (result != FALSE && found != shadows_.end()) found->second.count += count;
  ++changes_;
  return Done(Op::kReleaseSemaphore, result, {count});
}

HANDLE SimulatedWaits::CreateEventW() {
  long long failure = 0;
  if (book_.Fails(Op::kCreateEvent, failure)) {
    sLastError = ERROR_NOT_ENOUGH_MEMORY;
    return nullptr;
  }
  HANDLE const handle = Add(machine_->CreateEventW(), Shadow());
  book_.Log(Op::kCreateEvent, handle != nullptr ? 1 : 0);
  return handle;
}

BOOL SimulatedWaits::SetEvent(HANDLE event) {
  long long failure = 0;
  if (book_.Fails(Op::kSetEvent, failure)) return static_cast<BOOL>(failure);
  return Done(Op::kSetEvent, SignalQuietly(event));
}

BOOL SimulatedWaits::SignalQuietly(HANDLE event) {
  std::lock_guard lock(mutex_);
  BOOL const result = machine_->SetEvent(event);
  auto const found = shadows_.find(event);
  if (result != FALSE && found != shadows_.end()) found->second.count = 1;
  ++changes_;
  return result;
}

HANDLE SimulatedWaits::CreateWaitableTimerW() {
  long long failure = 0;
  if (book_.Fails(Op::kCreateWaitableTimer, failure)) {
    sLastError = ERROR_NOT_ENOUGH_MEMORY;
    return nullptr;
  }
  Shadow shadow;
  shadow.kind = Kind::kTimer;
  HANDLE const handle = Add(machine_->CreateWaitableTimerW(), shadow);
  // Whoever makes a timer is about to wait: it counts from now on.
  threads_->Enter();
  book_.Log(Op::kCreateWaitableTimer, handle != nullptr ? 1 : 0);
  return handle;
}

BOOL SimulatedWaits::SetWaitableTimer(HANDLE timer, LONGLONG due) {
  long long failure = 0;
  if (book_.Fails(Op::kSetWaitableTimer, failure)) return static_cast<BOOL>(failure);
  std::lock_guard lock(mutex_);
  auto const found = shadows_.find(timer);
  bool const byHand = clock_.IsByHand() && due < 0;
  BOOL const result = machine_->SetWaitableTimer(timer, byHand ? kFarFuture : due);
  if (result != FALSE && found != shadows_.end()) {
    found->second.fired = due == 0;
    found->second.due.reset();
    if (due < 0) found->second.due = clock_.Now() - due;
  }
  ++changes_;
  return Done(Op::kSetWaitableTimer, result, {due});
}

DWORD SimulatedWaits::WaitForSingleObject(HANDLE object, DWORD milliseconds) {
  return Wait(Op::kWaitForSingleObject, 1, &object, milliseconds);
}

DWORD SimulatedWaits::WaitForMultipleObjects(DWORD count, HANDLE const* objects,
                                             DWORD milliseconds) {
  return Wait(Op::kWaitForMultipleObjects, count, objects, milliseconds);
}

DWORD SimulatedWaits::Wait(Op op, DWORD count, HANDLE const* objects, DWORD milliseconds) {
  long long failure = 0;
  if (book_.Fails(op, failure)) return static_cast<DWORD>(failure);
  if (milliseconds != 0) {
    std::lock_guard lock(mutex_);
    threads_->SetWaiting(count, objects);
    for (DWORD i = 0; i < count; ++i) {
      auto const found = shadows_.find(objects[i]);
      if (found != shadows_.end()) found->second.waitedFor = true;
    }
    changed_.notify_all();
  }
  DWORD const result = count == 1 ? machine_->WaitForSingleObject(objects[0], milliseconds)
                                  : machine_->WaitForMultipleObjects(count, objects, milliseconds);
  if (result == WAIT_FAILED) sLastError = machine_->GetLastError();
  {
    std::lock_guard lock(mutex_);
    if (milliseconds != 0) threads_->SetRunning();
    ++changes_;
    if (result < WAIT_OBJECT_0 + count) {
      auto const found = shadows_.find(objects[result - WAIT_OBJECT_0]);
      if (found != shadows_.end() && found->second.count > 0) {
        --found->second.count;
      }
    }
    changed_.notify_all();
  }
  book_.Log(op, result, {count, milliseconds});
  return result;
}

BOOL SimulatedWaits::CloseHandle(HANDLE object) {
  long long failure = 0;
  if (book_.Fails(Op::kCloseHandle, failure)) return static_cast<BOOL>(failure);
  std::lock_guard lock(mutex_);
  shadows_.erase(object);
  return Done(Op::kCloseHandle, machine_->CloseHandle(object));
}

DWORD SimulatedWaits::GetLastError() { return sLastError; }

int SimulatedWaits::CountHandles() const {
  std::lock_guard lock(mutex_);
  return static_cast<int>(shadows_.size());
}

std::uint64_t SimulatedWaits::Changes() const {
  std::lock_guard lock(mutex_);
  return changes_;
}

std::optional<std::int64_t> SimulatedWaits::EarliestTimer() const {
  std::lock_guard lock(mutex_);
  std::optional<std::int64_t> earliest;
  for (auto const& [handle, shadow] : shadows_) {
    if (shadow.due && (!earliest || *shadow.due < *earliest)) earliest = shadow.due;
  }
  return earliest;
}

void SimulatedWaits::FireTimers(std::int64_t time) {
  std::lock_guard lock(mutex_);
  for (auto& [handle, shadow] : shadows_) {
    if (!shadow.due || *shadow.due > time) continue;
    shadow.due.reset();
    shadow.fired = true;
    machine_->SetWaitableTimer(handle, 0);
    ++changes_;
  }
}

void SimulatedWaits::ClockChanged() {
  std::lock_guard lock(mutex_);
  std::int64_t const now = clock_.Now();
  for (auto& [handle, shadow] : shadows_) {
    if (!shadow.due) continue;
    LONGLONG const left = *shadow.due > now ? now - *shadow.due : 0;
    machine_->SetWaitableTimer(handle, clock_.IsByHand() && left != 0 ? kFarFuture : left);
  }
}

bool SimulatedWaits::IsSignalled(Shadow const& shadow) const {
  if (shadow.kind != Kind::kTimer) return shadow.count > 0;
  // In real time a timer fires by itself.
  return shadow.fired || (!clock_.IsByHand() && shadow.due && *shadow.due <= clock_.Now());
}

bool SimulatedWaits::IsIdle() const {
  for (auto const& [handle, shadow] : shadows_) {
    // Items that no thread has looked at yet: its thread is still on its way.
    bool const forWorker = shadow.kind == Kind::kSemaphore && shadow.maximum > 1;
    if (forWorker && shadow.count > 0 && !shadow.waitedFor) return false;
  }
  return threads_->AllOthers([this](Registry::Entry const& entry) {
    if (!entry.waiting) return false;
    for (DWORD i = 0; i < entry.count; ++i) {
      auto const found = shadows_.find(entry.objects[i]);
      if (found != shadows_.end() && IsSignalled(found->second)) return false;
    }
    return true;
  });
}

bool SimulatedWaits::WaitUntilIdle(std::chrono::steady_clock::time_point deadline) {
  std::unique_lock lock(mutex_);
  while (!IsIdle()) {
    if (std::chrono::steady_clock::now() >= deadline) return false;
    // A thread that ends tells the registry only, so look again now and then.
    changed_.wait_for(lock, std::chrono::milliseconds(1));
  }
  return true;
}

}  // namespace Ostinet::Impl::Simulated

// SPDX-License-Identifier: MIT
//
// Semaphores, events and timers on threads and condition variables.
//
// One mutex guards all objects. A thread that waits leaves a Waiter, which has a condition
// variable of its own, with each object that it waits for; whoever signals an object wakes only
// those, and the woken look again whether something is left for them. A closed object stays in
// memory as long as somebody waits for it, and its waiters fail at once.

#include <algorithm>
#include <chrono>
#include <condition_variable>
#include <mutex>
#include <optional>
#include <unordered_map>
#include <vector>

#include "platform/system/SystemWaits.h"

namespace Ostinet::Impl {

namespace {

using Clock = std::chrono::steady_clock;

// 1601 to 1970 in units of 100 ns: absolute due times count from the former.
constexpr LONGLONG kUnixEpoch = 116444736000000000;

thread_local DWORD sLastError = ERROR_SUCCESS;

struct Waiter {
  std::condition_variable condition;
};

enum class Kind { kSemaphore, kEvent, kTimer };

struct Object {
  Kind kind = Kind::kEvent;
  LONG count = 0;  // of an event 0 or 1
  LONG maximum = 1;
  std::optional<Clock::time_point> due;  // of a timer that was set
  bool closed = false;
  std::vector<Waiter*> waiters;

  bool IsSignalled(Clock::time_point now) const {
    return kind == Kind::kTimer ? due && *due <= now : count > 0;
  }
  void Consume() {
    if (kind != Kind::kTimer) --count;
  }
  void WakeAll() const {
    for (Waiter* waiter : waiters) waiter->condition.notify_one();
  }
};

using ObjectPtr = std::shared_ptr<Object>;

Clock::time_point DueTime(LONGLONG due) {
  // A century is for ever, and keeps the sum within the clock's range.
  constexpr LONGLONG kCentury = 31557600000000000;
  LONGLONG relative = due < -kCentury ? kCentury : -due;
  if (due > 0) {
    auto const sinceEpoch = std::chrono::system_clock::now().time_since_epoch();
    auto const now =
        std::chrono::duration_cast<std::chrono::nanoseconds>(sinceEpoch).count() / 100 + kUnixEpoch;
    relative = std::max<LONGLONG>(due - now, 0);
  }
  relative = std::min(relative, kCentury);
  return Clock::now() + std::chrono::nanoseconds(relative * 100);
}

class PosixWaits final : public Waits {
 public:
  HANDLE CreateSemaphoreW(LONG initial, LONG maximum) override {
    if (maximum < 1 || initial < 0 || initial > maximum) {
      sLastError = ERROR_INVALID_PARAMETER;
      return nullptr;
    }
    Object object;
    object.kind = Kind::kSemaphore;
    object.count = initial;
    object.maximum = maximum;
    return Add(std::move(object));
  }

  BOOL ReleaseSemaphore(HANDLE semaphore, LONG count) override {
    std::lock_guard lock(mutex_);
    Object* const object = Find(semaphore, Kind::kSemaphore);
    if (object == nullptr) return FALSE;
    if (count < 1) return Failed(ERROR_INVALID_PARAMETER);
    if (count > object->maximum - object->count) return Failed(ERROR_TOO_MANY_POSTS);
    object->count += count;
    object->WakeAll();
    return TRUE;
  }

  HANDLE CreateEventW() override { return Add(Object()); }

  BOOL SetEvent(HANDLE event) override {
    std::lock_guard lock(mutex_);
    Object* const object = Find(event, Kind::kEvent);
    if (object == nullptr) return FALSE;
    object->count = 1;
    object->WakeAll();
    return TRUE;
  }

  HANDLE CreateWaitableTimerW() override {
    Object object;
    object.kind = Kind::kTimer;
    return Add(std::move(object));
  }

  BOOL SetWaitableTimer(HANDLE timer, LONGLONG due) override {
    Clock::time_point const time = DueTime(due);
    std::lock_guard lock(mutex_);
    Object* const object = Find(timer, Kind::kTimer);
    if (object == nullptr) return FALSE;
    object->due = time;
    object->WakeAll();
    return TRUE;
  }

  DWORD WaitForSingleObject(HANDLE object, DWORD milliseconds) override {
    return WaitForMultipleObjects(1, &object, milliseconds);
  }

  DWORD WaitForMultipleObjects(DWORD count, HANDLE const* objects, DWORD milliseconds) override;

  BOOL CloseHandle(HANDLE object) override {
    std::lock_guard lock(mutex_);
    auto const found = objects_.find(object);
    if (found == objects_.end()) return Failed(ERROR_INVALID_HANDLE);
    found->second->closed = true;
    found->second->WakeAll();
    objects_.erase(found);
    return TRUE;
  }

  DWORD GetLastError() override { return sLastError; }

 private:
  static BOOL Failed(DWORD error) {
    sLastError = error;
    return FALSE;
  }

  HANDLE Add(Object&& object) {
    auto held = std::make_shared<Object>(std::move(object));
    std::lock_guard lock(mutex_);
    // Numbers and not addresses, so that a stale handle never names a younger object.
    HANDLE const handle = reinterpret_cast<HANDLE>(next_ += 4);
    objects_.emplace(handle, std::move(held));
    return handle;
  }

  Object* Find(HANDLE handle, Kind kind) {
    auto const found = objects_.find(handle);
    if (found != objects_.end() && found->second->kind == kind) return found->second.get();
    sLastError = ERROR_INVALID_HANDLE;
    return nullptr;
  }

  bool Collect(DWORD count, HANDLE const* handles, ObjectPtr* objects) {
    for (DWORD i = 0; i < count; ++i) {
      auto const found = objects_.find(handles[i]);
      if (found == objects_.end()) return false;
      objects[i] = found->second;
    }
    return true;
  }

  std::mutex mutex_;
  std::uintptr_t next_ = 0;
  std::unordered_map<HANDLE, ObjectPtr> objects_;
};

// The first that is signalled, taken; WAIT_FAILED when one was closed; else WAIT_TIMEOUT.
DWORD TakeFirst(DWORD count, ObjectPtr const* objects) {
  Clock::time_point const now = Clock::now();
  for (DWORD i = 0; i < count; ++i) {
    if (objects[i]->closed) {
      sLastError = ERROR_INVALID_HANDLE;
      return WAIT_FAILED;
    }
  }
  for (DWORD i = 0; i < count; ++i) {
    if (!objects[i]->IsSignalled(now)) continue;
    objects[i]->Consume();
    return WAIT_OBJECT_0 + i;
  }
  return WAIT_TIMEOUT;
}

std::optional<Clock::time_point> EarliestDue(DWORD count, ObjectPtr const* objects) {
  std::optional<Clock::time_point> earliest;
  for (DWORD i = 0; i < count; ++i) {
    auto const& due = objects[i]->due;
    if (due && (!earliest || *due < *earliest)) earliest = due;
  }
  return earliest;
}

DWORD PosixWaits::WaitForMultipleObjects(DWORD count, HANDLE const* handles, DWORD milliseconds) {
  if (count < 1 || count > MAXIMUM_WAIT_OBJECTS) {
    sLastError = ERROR_INVALID_PARAMETER;
    return WAIT_FAILED;
  }
  std::optional<Clock::time_point> deadline;
  if (milliseconds != INFINITE) deadline = Clock::now() + std::chrono::milliseconds(milliseconds);

  ObjectPtr objects[MAXIMUM_WAIT_OBJECTS];
  Waiter waiter;
  std::unique_lock lock(mutex_);
  if (!Collect(count, handles, objects)) {
    sLastError = ERROR_INVALID_HANDLE;
    return WAIT_FAILED;
  }
  DWORD result = TakeFirst(count, objects);
  if (result != WAIT_TIMEOUT || milliseconds == 0) return result;

  for (DWORD i = 0; i < count; ++i) objects[i]->waiters.push_back(&waiter);
  while (result == WAIT_TIMEOUT && (!deadline || Clock::now() < *deadline)) {
    auto until = EarliestDue(count, objects);
    if (deadline && (!until || *deadline < *until)) until = deadline;
    if (until) {
      waiter.condition.wait_until(lock, *until);
    } else {
      waiter.condition.wait(lock);
    }
    result = TakeFirst(count, objects);
  }
  for (DWORD i = 0; i < count; ++i) {
    auto& waiters = objects[i]->waiters;
    waiters.erase(std::find(waiters.begin(), waiters.end(), &waiter));
  }
  return result;
}

}  // namespace

std::unique_ptr<Waits> MakeSystemWaits() { return std::make_unique<PosixWaits>(); }

}  // namespace Ostinet::Impl

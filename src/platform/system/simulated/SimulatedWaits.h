// SPDX-License-Identifier: MIT
#pragma once

// The machine's waits with a shadow of each object's state, for two ends. Timers follow a clock
// that is moved by hand: while it stands, a set timer of the machine is due in a far future, and
// when the hand reaches its time it is set to be due at once. And one can tell whether the threads
// of the library are idle: each of them waits, and nothing that it waits for is signalled.

#include <chrono>
#include <condition_variable>
#include <cstdint>
#include <memory>
#include <mutex>
#include <optional>
#include <unordered_map>
#include <vector>

#include "platform/system/System.h"
#include "platform/system/simulated/Operations.h"
#include "platform/system/simulated/SimClock.h"

namespace Ostinet::Impl::Simulated {

class SimulatedWaits final : public Waits {
 public:
  SimulatedWaits(CallBook& book, SimClock& clock);
  ~SimulatedWaits() override;

  HANDLE CreateSemaphoreW(LONG initial, LONG maximum) override;
  BOOL ReleaseSemaphore(HANDLE semaphore, LONG count) override;
  HANDLE CreateEventW() override;
  BOOL SetEvent(HANDLE event) override;
  HANDLE CreateWaitableTimerW() override;
  BOOL SetWaitableTimer(HANDLE timer, LONGLONG due) override;
  DWORD WaitForSingleObject(HANDLE object, DWORD milliseconds) override;
  DWORD WaitForMultipleObjects(DWORD count, HANDLE const* objects, DWORD milliseconds) override;
  BOOL CloseHandle(HANDLE object) override;
  DWORD GetLastError() override;

  /// Signals an event without a trace in the book: what the system itself does.
  BOOL SignalQuietly(HANDLE event);

  /// The earliest time of a timer that waits for the hand.
  std::optional<std::int64_t> EarliestTimer() const;
  /// Fires the timers that are due at `time`.
  void FireTimers(std::int64_t time);
  /// Sets the waiting timers anew after the clock went over to the hand or back.
  void ClockChanged();

  /// Waits until the library's threads are idle. False at the deadline.
  bool WaitUntilIdle(std::chrono::steady_clock::time_point deadline);
  /// How often anything changed that idleness depends on.
  std::uint64_t Changes() const;
  int CountHandles() const;

  class Registry;

 private:
  enum class Kind { kSemaphore, kEvent, kTimer };
  struct Shadow {
    Kind kind = Kind::kEvent;
    LONG count = 0;
    LONG maximum = 1;
    bool fired = false;               // a timer that is due by the hand
    std::optional<std::int64_t> due;  // a timer that was set and has not fired
    bool waitedFor = false;           // a thread has found its way here
  };

  HANDLE Add(HANDLE handle, Shadow const& shadow);
  BOOL Done(Op op, BOOL result, std::initializer_list<long long> arguments = {});
  DWORD Wait(Op op, DWORD count, HANDLE const* objects, DWORD milliseconds);
  bool IsIdle() const;
  bool IsSignalled(Shadow const& shadow) const;

  CallBook& book_;
  SimClock& clock_;
  std::unique_ptr<Waits> const machine_;

  mutable std::mutex mutex_;
  std::condition_variable changed_;
  std::uint64_t changes_ = 0;
  std::unordered_map<HANDLE, Shadow> shadows_;
  std::shared_ptr<Registry> const threads_;
};

}  // namespace Ostinet::Impl::Simulated

// SPDX-License-Identifier: MIT
#pragma once

#include <array>
#include <condition_variable>
#include <memory>
#include <mutex>
#include <thread>
#include <unordered_map>

#include "platform/system/WindowsTypes.h"
#include "platform/system/simulated/SimulatedWaits.h"

namespace Ostinet::Impl::Simulated {

/// The threads that have ever waited through a SimulatedWaits, or made a timer there. A thread
/// leaves by itself when it ends.
///
/// Threads  Any; it has a mutex of its own because a thread may end after the waits did.
class SimulatedWaits::Registry : public std::enable_shared_from_this<Registry> {
 public:
  struct Entry {
    bool waiting = false;
    DWORD count = 0;
    std::array<HANDLE, MAXIMUM_WAIT_OBJECTS> objects{};
  };

  /// Enters the calling thread.
  void Enter();
  void SetWaiting(DWORD count, HANDLE const* objects);
  void SetRunning();
  void Leave(std::thread::id thread);

  /// Calls `visit(entry)` for every thread but the calling one until it gives false.
  template <class Visit>
  bool AllOthers(Visit const& visit) const {
    std::lock_guard lock(mutex_);
    for (auto const& [id, entry] : entries_) {
      if (id != std::this_thread::get_id() && !visit(entry)) return false;
    }
    return true;
  }

 private:
  mutable std::mutex mutex_;
  std::unordered_map<std::thread::id, Entry> entries_;
};

}  // namespace Ostinet::Impl::Simulated

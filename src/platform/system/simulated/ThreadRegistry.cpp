// SPDX-License-Identifier: MIT
#include "platform/system/simulated/ThreadRegistry.h"

#include <algorithm>
#include <vector>

#include "core/PerThread.h"

namespace Ostinet::Impl::Simulated {

namespace {

// One for each thread; its end tells the registries that the thread is in.
struct Membership {
  std::vector<std::weak_ptr<SimulatedWaits::Registry>> registries;

  ~Membership() {
    for (auto const& each : registries) {
      if (auto const registry = each.lock()) registry->Leave(std::this_thread::get_id());
    }
  }
};

Membership& TheMembership() {
  static PerThread<Membership> sMembership;
  return *sMembership;
}

}  // namespace

void SimulatedWaits::Registry::Enter() {
  {
    std::lock_guard lock(mutex_);
    if (!entries_.try_emplace(std::this_thread::get_id()).second) return;
  }
  auto& registries = TheMembership().registries;
  registries.erase(std::remove_if(registries.begin(), registries.end(),
                                  [](auto const& each) { return each.expired(); }),
                   registries.end());
  registries.push_back(weak_from_this());
}

void SimulatedWaits::Registry::SetWaiting(DWORD count, HANDLE const* objects) {
  Enter();
  std::lock_guard lock(mutex_);
  Entry& entry = entries_[std::this_thread::get_id()];
  entry.waiting = true;
  entry.count = std::min<DWORD>(count, MAXIMUM_WAIT_OBJECTS);
  std::copy_n(objects, entry.count, entry.objects.begin());
}

void SimulatedWaits::Registry::SetRunning() {
  std::lock_guard lock(mutex_);
  entries_[std::this_thread::get_id()].waiting = false;
}

void SimulatedWaits::Registry::Leave(std::thread::id thread) {
  std::lock_guard lock(mutex_);
  entries_.erase(thread);
}

}  // namespace Ostinet::Impl::Simulated

// SPDX-License-Identifier: MIT
#pragma once

#include <cstdint>
#include <map>
#include <memory>
#include <mutex>
#include <utility>
#include <vector>

namespace Ostinet::Impl {

/// Open devices by their handles. Handles are numbers that never come twice, so that a stale one is
/// refused instead of followed.
///
/// Threads  Any; a device stays alive while someone who found it still uses it.
template <class Handle, class Device>
class HandleTable {
 public:
  Handle Add(std::shared_ptr<Device> device) {
    std::scoped_lock lock(mutex_);
    Handle const handle = reinterpret_cast<Handle>(next_);
    next_ += kStep;
    devices_.emplace(handle, std::move(device));
    return handle;
  }

  /// Null for an unknown handle.
  std::shared_ptr<Device> Find(Handle handle) const {
    std::scoped_lock lock(mutex_);
    auto const found = devices_.find(handle);
    return found == devices_.end() ? nullptr : found->second;
  }

  std::shared_ptr<Device> Remove(Handle handle) {
    std::scoped_lock lock(mutex_);
    auto const found = devices_.find(handle);
    if (found == devices_.end()) return nullptr;
    std::shared_ptr<Device> device = std::move(found->second);
    devices_.erase(found);
    return device;
  }

 private:
  static constexpr std::uintptr_t kStep = 16;  // looks like an address, aligned

  mutable std::mutex mutex_;
  std::uintptr_t next_ = kStep;                        // guarded by mutex_
  std::map<Handle, std::shared_ptr<Device>> devices_;  // guarded by mutex_
};

}  // namespace Ostinet::Impl

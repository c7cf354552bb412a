// SPDX-License-Identifier: MIT
#pragma once

#include <array>
#include <atomic>
#include <cstddef>
#include <stdexcept>
#include <string>

namespace Ostinet::Impl::Simulated {

/// The COM objects that are alive, by interface.
///
/// Threads  Any.
class ObjectCounts {
 public:
  enum Interface {
    kMusic,
    kPort,
    kBuffer,
    kClock,
    kLoader,
    kCollection,
    kInstrument,
    kDownloadedInstrument,
    kInterfaceCount
  };

  static std::string const& NameOf(Interface which) {
    static std::array<std::string, kInterfaceCount> const names = {
        "IDirectMusic",           "IDirectMusicPort",
        "IDirectMusicBuffer",     "IReferenceClock",
        "IDirectMusicLoader",     "IDirectMusicCollection",
        "IDirectMusicInstrument", "IDirectMusicDownloadedInstrument"};
    return names[static_cast<std::size_t>(which)];
  }

  void Add(Interface which, int count) {
    counts_[static_cast<std::size_t>(which)].fetch_add(count, std::memory_order_acq_rel);
  }

  /// "*" counts all. Throws std::invalid_argument for an unknown name.
  int Count(std::string const& name) const {
    int sum = 0;
    bool known = name == "*";
    for (int i = 0; i < kInterfaceCount; ++i) {
      if (name != "*" && name != NameOf(static_cast<Interface>(i))) continue;
      known = true;
      sum += counts_[static_cast<std::size_t>(i)].load(std::memory_order_acquire);
    }
    if (!known) throw std::invalid_argument("No interface is named \"" + name + "\"");
    return sum;
  }

 private:
  std::array<std::atomic<int>, kInterfaceCount> counts_{};
};

}  // namespace Ostinet::Impl::Simulated

// SPDX-License-Identifier: MIT
#pragma once

#include <cstdint>
#include <memory>
#include <mutex>
#include <optional>
#include <string>
#include <vector>

#include "platform/system/native/MidiService.h"

namespace Ostinet::Impl {

/// A port as the machine's WinMM devices show it.
struct TablePort {
  std::shared_ptr<MidiService> service;
  std::string id;
  std::u16string name;
  bool present = false;
};

/// The machine's ports of both directions, numbered like WinMM devices.
///
/// A port keeps its number and its name as long as the program runs, also while it is away, so a
/// number that was read before a change still opens the same port after it. Numbers of ports that
/// are away answer like a device that cannot be asked.
///
/// Threads  Any.
class PortTable {
 public:
  explicit PortTable(std::vector<std::shared_ptr<MidiService>> services);

  /// Asks the services anew. The result is the number of changes so far: a reading that differs
  /// from an earlier one means that what is present, or its names, changed in between.
  unsigned Refresh();

  /// One more than the highest number, the larger of both directions: every input and every output
  /// is then reached by a scan that takes the number of one direction for both.
  unsigned Count() const;
  /// No value for a number out of range or of a port that is away.
  std::optional<TablePort> Find(PortDirection direction, std::uintptr_t number) const;
  /// In the order of their numbers.
  std::vector<TablePort> Present(PortDirection direction) const;

 private:
  using Ports = std::vector<TablePort>;

  Ports& PortsOf(PortDirection direction) { return ports_[static_cast<int>(direction)]; }
  Ports const& PortsOf(PortDirection direction) const {
    return ports_[static_cast<int>(direction)];
  }
  bool RefreshDirection(PortDirection direction);

  std::vector<std::shared_ptr<MidiService>> const services_;
  std::mutex refreshing_;  // so that an older listing never overwrites a newer; before mutex_
  mutable std::mutex mutex_;
  Ports ports_[2];        // guarded by mutex_
  unsigned changes_ = 0;  // guarded by refreshing_
};

}  // namespace Ostinet::Impl

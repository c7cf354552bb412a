// SPDX-License-Identifier: MIT
#pragma once

#include <vector>

#include "model/DeviceObjectImpl.h"

namespace Ostinet::Impl {

/// Which properties of which objects changed since the last poll, in the order in which the objects
/// changed first. A studio may change ten thousand objects at once, so the notes stand side by side
/// and each object knows its own.
///
/// Threads      The host's polling thread.
class PendingChanges {
 public:
  struct Change {
    RCPtrMT<DeviceObjectImpl> object;
    PropertyKeys keys;
  };

  void Add(DeviceObjectImpl* object, UString const& key);
  /// Gives all notes away. Their room may be given back when they are worked off.
  std::vector<Change> Take();
  void GiveBack(std::vector<Change> room);
  void Clear() {
    changes_.clear();
    room_ = {};
  }

 private:
  std::vector<Change> changes_;
  std::vector<Change> room_;  // empty, for the next notes
};

}  // namespace Ostinet::Impl

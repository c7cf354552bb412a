// SPDX-License-Identifier: MIT
#include "platform/PendingChanges.h"

#include <utility>

namespace Ostinet::Impl {

void PendingChanges::Add(DeviceObjectImpl* object, UString const& key) {
  std::size_t const place = object->placeInChanges;
  bool const isKnown = place < changes_.size() && changes_[place].object.get() == object;
  if (!isKnown) {
    object->placeInChanges = changes_.size();
    changes_.push_back({object, {}});
  }
  changes_[object->placeInChanges].keys.insert(key);
}

std::vector<PendingChanges::Change> PendingChanges::Take() {
  return std::exchange(changes_, std::exchange(room_, {}));
}

void PendingChanges::GiveBack(std::vector<Change> room) {
  room.clear();
  room_ = std::move(room);
}

}  // namespace Ostinet::Impl

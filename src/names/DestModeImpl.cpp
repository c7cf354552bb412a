// SPDX-License-Identifier: MIT
#include "names/DestModeImpl.h"

#include <algorithm>

namespace Ostinet::Impl {

namespace {

bool IsChannel(int channel) { return channel >= 0 && channel < 16; }

}  // namespace

DestModeImpl::~DestModeImpl() {
  for (RCPtrMT<DestNameSetImpl> const& nameSet : nameSets_) {
    if (nameSet.get() != nullptr) {
      nameSet->RemoveMode(this);
    }
  }
}

DestNameSetImpl* DestModeImpl::GetNameSet(int channel) const {
  return IsChannel(channel) ? nameSets_[static_cast<std::size_t>(channel)].get() : nullptr;
}

void DestModeImpl::SetNameSet(int channel, RCPtrMT<DestNameSetImpl> const& nameSet) {
  DestNameSetImpl* const old = GetNameSet(channel);
  if (!IsChannel(channel) || old == nameSet.get()) {
    return;
  }
  if (old != nullptr) {
    old->RemoveUse(this, channel);
  }
  if (nameSet.get() != nullptr) {
    nameSet->AddUse(this, channel);
  }
  nameSets_[static_cast<std::size_t>(channel)] = nameSet;
}

bool DestModeImpl::HasNameSets() const {
  return std::any_of(
      nameSets_.begin(), nameSets_.end(),
      [](RCPtrMT<DestNameSetImpl> const& nameSet) { return nameSet.get() != nullptr; });
}

}  // namespace Ostinet::Impl

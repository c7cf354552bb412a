// SPDX-License-Identifier: MIT
#include "model/Handles.h"

namespace Ostinet {

using Impl::HandleAt;
using Impl::ImplOf;

MatchObjectID const Device::kObjectID;
Device const Device::kNoDevice;

Device::Device() = default;
Device::Device(RCPtrMT<Impl::DeviceImpl> const& impl) : DeviceObject(impl) {}

int Device::CountEntities() const {
  Impl::DeviceImpl const* const impl = ImplOf(*this);
  return impl != nullptr ? static_cast<int>(impl->GetEntities().size()) : 0;
}

Entity Device::GetEntity(int index) const {
  Impl::DeviceImpl const* const impl = ImplOf(*this);
  return impl != nullptr ? HandleAt<Entity>(impl->GetEntities(), index) : Entity();
}

Entity Device::GetSpecialEntity(SpecialEntityType type) const {
  Impl::DeviceImpl const* const impl = ImplOf(*this);
  return impl != nullptr ? Entity(impl->GetSpecialEntity(type)) : Entity();
}

}  // namespace Ostinet

// SPDX-License-Identifier: MIT
#include "model/Handles.h"

namespace Ostinet {

using Impl::HandleAt;
using Impl::ImplOf;

MatchObjectID const Entity::kObjectID;
Entity const Entity::kNoEntity;

Entity::Entity() = default;
Entity::Entity(RCPtrMT<Impl::EntityImpl> const& impl) : DeviceObject(impl) {}

int Entity::CountSources() const {
  Impl::EntityImpl const* const impl = ImplOf(*this);
  return impl != nullptr ? static_cast<int>(impl->GetSources().size()) : 0;
}

Source Entity::GetSource(int index) const {
  Impl::EntityImpl const* const impl = ImplOf(*this);
  return impl != nullptr ? HandleAt<Source>(impl->GetSources(), index) : Source();
}

int Entity::CountDestinations() const {
  Impl::EntityImpl const* const impl = ImplOf(*this);
  return impl != nullptr ? static_cast<int>(impl->GetDestinations().size()) : 0;
}

Destination Entity::GetDestination(int index) const {
  Impl::EntityImpl const* const impl = ImplOf(*this);
  return impl != nullptr ? HandleAt<Destination>(impl->GetDestinations(), index) : Destination();
}

Device Entity::GetDevice() const {
  Impl::EntityImpl const* const impl = ImplOf(*this);
  return impl != nullptr ? Device(impl->GetDevice()) : Device();
}

}  // namespace Ostinet

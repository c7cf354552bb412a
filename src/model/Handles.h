// SPDX-License-Identifier: MIT
#pragma once

#include <cstddef>
#include <vector>

#include "model/DestinationImpl.h"
#include "model/DeviceImpl.h"
#include "model/EntityImpl.h"

namespace Ostinet::Impl {

// From handles to the objects behind them; null for a null handle. A handle's class vouches for
// the class of its object.

inline ObjectImpl* ImplOf(Object const& handle) {
  return static_cast<ObjectImpl*>(handle.GetImplPtr());
}
inline DeviceObjectImpl* ImplOf(DeviceObject const& handle) {
  return static_cast<DeviceObjectImpl*>(ImplOf(static_cast<Object const&>(handle)));
}
inline DeviceImpl* ImplOf(Device const& handle) {
  return static_cast<DeviceImpl*>(ImplOf(static_cast<Object const&>(handle)));
}
inline EntityImpl* ImplOf(Entity const& handle) {
  return static_cast<EntityImpl*>(ImplOf(static_cast<Object const&>(handle)));
}
inline EndpointImpl* ImplOf(Endpoint const& handle) {
  return static_cast<EndpointImpl*>(ImplOf(static_cast<Object const&>(handle)));
}
inline DestinationImpl* ImplOf(Destination const& handle) {
  return static_cast<DestinationImpl*>(ImplOf(static_cast<Object const&>(handle)));
}

/// The member at `index` as a handle, or a null handle out of range.
template <class Handle, class T>
Handle HandleAt(std::vector<RCPtrMT<T>> const& list, int index) {
  bool const isThere = index >= 0 && static_cast<std::size_t>(index) < list.size();
  return isThere ? Handle(list[static_cast<std::size_t>(index)]) : Handle();
}

}  // namespace Ostinet::Impl

// SPDX-License-Identifier: MIT
#pragma once

#include <cstddef>
#include <vector>

#include "devicetypes/DeviceTypeInfoImpl.h"
#include "model/EntityImpl.h"
#include "model/ImplImpl.h"

// How a type reaches a device. The backend shapes new devices with these, Setup changes old ones.

namespace Ostinet::Impl {

/// Copies the facts of a type into a device's properties, except maker and model. What the type
/// leaves unset keeps its old value; the picture goes if the type has none.
void ApplyToDevice(DeviceTypeInfoImpl const& type, ImplImpl& peer);

/// The entities of a device of this type, which may be null. Without a type, or where the type
/// tells of none: one without a name, with one nameless port each way.
std::vector<DeviceTypePortGroup> PortGroupsOf(DeviceTypeInfoImpl const* type);

/// What the entity of the group at `index` is called: "Port 1" for the first if it has no name.
UString EntityNameOf(DeviceTypePortGroup const& group, std::size_t index);

/// Gives the entity's ports the names that the group has for them; nameless ones keep theirs.
void NamePorts(DeviceTypePortGroup const& group, EntityImpl const& entity);

/// The same for the entity at `index` of a new device, which has the group's number of ports. Its
/// destinations are named all or none: by whether the group's input at `index` has a name.
void NameNewPorts(DeviceTypePortGroup const& group, std::size_t index, EntityImpl const& entity);

}  // namespace Ostinet::Impl

// SPDX-License-Identifier: MIT
//
// Setup: devices that are made after a type, or made over to another one.
#include "devicetypes/DeviceTypeApplication.h"
#include "model/Handles.h"
#include "ostinet/Setup.h"

namespace Ostinet {

using Impl::ImplOf;

namespace {

int CountOf(std::vector<UString> const& ports) { return static_cast<int>(ports.size()); }

// The first entities stay, with all that hangs on them.
void DeleteEntitiesBehind(Setup& setup, Device const& device, int count) {
  for (int i = device.CountEntities() - 1; i >= count; --i) {
    setup.DeleteEntity(device.GetEntity(i));
  }
}

void ShapeEntity(Setup& setup, Device const& device, int index,
                 Impl::DeviceTypePortGroup const& group) {
  UString const name = Impl::EntityNameOf(group, static_cast<std::size_t>(index));
  Entity entity = device.GetEntity(index);
  if (entity.Exists()) {
    entity.SetRawName(name);
    setup.SetEntitySources(entity, CountOf(group.outs));
    setup.SetEntityDestinations(entity, CountOf(group.ins));
  } else {
    entity = setup.CreateEntity(device, name, CountOf(group.outs), CountOf(group.ins));
  }
  if (Impl::EntityImpl const* const impl = ImplOf(entity)) {
    Impl::NamePorts(group, *impl);
  }
}

}  // namespace

// Maker and model stay unset: a host that makes a device of some type may know it under another
// name. ChangeDeviceType sets them.
Device Setup::CreateDevice(DeviceTypeInfo const& type, UString const& name) {
  return PlatformCreateDevice(type.GetImplPtr(), MakeUniqueDevName(name));
}

void Setup::ChangeDeviceType(Device const& device, DeviceTypeInfo const& type) {
  if (!device.Exists() || device.IsDirect() || !type.Exists()) {
    return;
  }
  device.SetManufacturer(type.GetMfrName());
  device.SetModel(type.GetModelName());
  Impl::ApplyToDevice(*type.GetImplPtr(), *ImplOf(device)->Peer());
  auto const groups = Impl::PortGroupsOf(type.GetImplPtr());
  int const count = static_cast<int>(groups.size());
  DeleteEntitiesBehind(*this, device, count);
  for (int i = 0; i < count; ++i) {
    ShapeEntity(*this, device, i, groups[static_cast<std::size_t>(i)]);
  }
}

}  // namespace Ostinet

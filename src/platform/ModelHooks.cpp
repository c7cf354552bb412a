// SPDX-License-Identifier: MIT

// The hooks by which Setup makes and shapes the user's devices on this platform.

#include <algorithm>

#include "devicetypes/DeviceTypeApplication.h"
#include "model/DestinationImpl.h"
#include "model/DeviceImpl.h"
#include "model/EntityImpl.h"
#include "model/PropertyKeys.h"
#include "platform/SetupFileReader.h"
#include "platform/WinMIDIImplImpl.h"
#include "platform/WinMIDISetup.h"

namespace Ostinet::Impl {

namespace {

/// The peer of an object that this backend made, as the parent of the peers below it.
WinMIDIImplImpl* PeerOf(DeviceObjectImpl const& object) {
  return dynamic_cast<WinMIDIImplImpl*>(object.Peer());
}

}  // namespace

RCPtrMT<DeviceImpl> WinMIDISetup::PlatformCreateDevice(XMLLib::Parser& parser) {
  return SetupFileReader(*this, parser, SetupFileReader::kImport).ReadDevice();
}

RCPtrMT<DeviceImpl> WinMIDISetup::PlatformCreateDevice(DeviceTypeInfoImpl* type,
                                                       UString const& name) {
  RCPtrMT<DeviceImpl> device(
      new DeviceImpl(std::make_unique<WinMIDIImplImpl>(*this, nullptr), false));
  Lists().devices.push_back(device);
  MarkChanged();
  device->SetName(name);
  MaybeAssignUniqueID(*device);
  if (type != nullptr) {
    ApplyToDevice(*type, *device->Peer());
  }
  auto const groups = PortGroupsOf(type);
  for (std::size_t i = 0; i < groups.size(); ++i) {
    DeviceTypePortGroup const& group = groups[i];
    auto const entity =
        PlatformCreateEntity(device, EntityNameOf(group, i), static_cast<int>(group.outs.size()),
                             static_cast<int>(group.ins.size()));
    NameNewPorts(group, i, *entity);
  }
  return device;
}

RCPtrMT<EntityImpl> WinMIDISetup::PlatformCreateEntity(RCPtrMT<DeviceImpl>& device,
                                                       UString const& name, int sources,
                                                       int destinations) {
  RCPtrMT<EntityImpl> entity(
      new EntityImpl(std::make_unique<WinMIDIImplImpl>(*this, PeerOf(*device)), device.get()));
  Lists().entities.push_back(entity);
  device->AddEntity(entity);
  MarkChanged();
  entity->SetName(name);
  MaybeAssignUniqueID(*entity);
  PlatformSetEntitySources(entity, sources);
  PlatformSetEntityDestinations(entity, destinations);
  return entity;
}

void WinMIDISetup::PlatformSetEntitySources(RCPtrMT<EntityImpl>& entity, int count) {
  auto const wanted = static_cast<std::size_t>(std::max(count, 0));
  while (entity->GetSources().size() < wanted) {
    RCPtrMT<EndpointImpl> const source(
        new EndpointImpl(std::make_unique<WinMIDIImplImpl>(*this, PeerOf(*entity)), *this,
                         EndpointKind::InEntity(*entity)));
    entity->AddSource(source);
    Lists().sources.push_back(source);
    MaybeAssignUniqueID(*source);
  }
  while (entity->GetSources().size() > wanted) {
    RemoveSource(entity->GetSources().back());
  }
}

void WinMIDISetup::PlatformSetEntityDestinations(RCPtrMT<EntityImpl>& entity, int count) {
  auto const wanted = static_cast<std::size_t>(std::max(count, 0));
  while (entity->GetDestinations().size() < wanted) {
    RCPtrMT<DestinationImpl> const destination(
        new DestinationImpl(std::make_unique<WinMIDIImplImpl>(*this, PeerOf(*entity)), *this,
                            EndpointKind::InEntity(*entity)));
    entity->AddDestination(destination);
    Lists().destinations.push_back(destination);
    MaybeAssignUniqueID(*destination);
    destination->RenewNewNames();
  }
  while (entity->GetDestinations().size() > wanted) {
    RemoveDestination(entity->GetDestinations().back());
  }
}

}  // namespace Ostinet::Impl

// SPDX-License-Identifier: MIT
#include "devicetypes/DeviceTypeApplication.h"

#include <algorithm>

#include "devicetypes/DeviceTypeFlags.h"
#include "ostinet/core/Files.h"

namespace Ostinet::Impl {

namespace {

// Pictures are looked for in the machine's folder alone, with all below it, so that the devices of
// all users show the same.
void ApplyImage(UString const& name, ImplImpl& peer) {
  FileSpecification found;
  if (!name.empty() &&
      Folder::Find(Folder::kSystemDeviceFiles, Folder::kDoNotCreate).SearchFolder(name, found)) {
    peer.SetString(Keys::kImage, found.GetFullPath());
  } else {
    peer.RemoveProperty(Keys::kImage);
  }
}

template <std::size_t N>
void ApplyFlags(DeviceTypeFlag const (&forms)[N], std::array<TriBool, N> const& flags,
                ImplImpl& peer) {
  for (std::size_t i = 0; i < N; ++i) {
    if (flags[i] != TriBool::kUnset) {
      peer.SetInt(forms[i].key, static_cast<int>(flags[i]));
    }
  }
}

template <std::size_t N>
void ApplyTraffic(DeviceTypeTraffic<N> const& traffic, DeviceTypeFlag const (&forms)[N],
                  bool isReceived, ImplImpl& peer) {
  peer.SetInt(KeyPairs::kMaxChannels.For(isReceived), traffic.maxChannels);
  peer.SetInt(KeyPairs::kChannels.For(isReceived), (1 << traffic.maxChannels) - 1);
  ApplyFlags(forms, traffic.flags, peer);
}

template <class Ports>
void NameEach(Ports const& ports, std::vector<UString> const& names) {
  for (std::size_t i = 0; i < std::min(ports.size(), names.size()); ++i) {
    if (!names[i].empty()) {
      ports[i]->SetName(names[i]);
    }
  }
}

}  // namespace

void ApplyToDevice(DeviceTypeInfoImpl const& type, ImplImpl& peer) {
  ApplyImage(type.image, peer);
  ApplyFlags(kCapabilityFlags, type.capabilities, peer);
  if (type.hasDeviceID) {
    peer.SetInt(Keys::kDeviceID, type.defaultDeviceID);
  }
  ApplyTraffic(type.receives, kReceiveFlags, true, peer);
  ApplyTraffic(type.transmits, kTransmitFlags, false, peer);
}

std::vector<DeviceTypePortGroup> PortGroupsOf(DeviceTypeInfoImpl const* type) {
  if (type != nullptr && !type->portGroups.empty()) {
    return type->portGroups;
  }
  return {{UString(), {UString()}, {UString()}}};
}

UString EntityNameOf(DeviceTypePortGroup const& group, std::size_t index) {
  if (!group.name.empty()) {
    return group.name;
  }
  UString name;
  name.Stream() << "Port " << static_cast<unsigned long>(index + 1);
  return name;
}

// The instrument's outputs are the studio's sources.
void NamePorts(DeviceTypePortGroup const& group, EntityImpl const& entity) {
  NameEach(entity.GetSources(), group.outs);
  NameEach(entity.GetDestinations(), group.ins);
}

// The input that stands where the entity stands among the groups says for all inputs of the entity
// whether they are named. Device type files are written around this, and hosts find what they
// stored by the names that came of it. An entity that stands behind its inputs' end has no such
// input, so there each says it for itself.
void NameNewPorts(DeviceTypePortGroup const& group, std::size_t index, EntityImpl const& entity) {
  NameEach(entity.GetSources(), group.outs);
  if (index >= group.ins.size()) {
    NameEach(entity.GetDestinations(), group.ins);
  } else if (!group.ins[index].empty()) {
    for (std::size_t i = 0; i < entity.GetDestinations().size(); ++i) {
      entity.GetDestinations()[i]->SetName(group.ins[i]);
    }
  }
}

}  // namespace Ostinet::Impl

// SPDX-License-Identifier: MIT
#pragma once

#include "StudioView.h"

namespace Ostinet::Tool {

inline EndpointView SomeEndpoint(unsigned long long key, bool isSource, std::string name) {
  EndpointView view;
  view.key = key;
  view.isSource = isSource;
  view.name = std::move(name);
  view.uniqueID = static_cast<int>(key) + 100;
  view.online = true;
  view.channels = 0xFFFF;
  return view;
}

/// A device "Synth" with an input and an output, the latter on the port "Out 1"; the ports "In 1"
/// and "Out 1".
inline StudioView SomeStudio() {
  StudioView studio;
  EntityView entity;
  entity.key = 2;
  entity.name = "Port 1";
  entity.uniqueID = 102;
  entity.sources = {SomeEndpoint(3, true, "Synth")};
  entity.destinations = {SomeEndpoint(4, false, "Synth")};
  entity.destinations[0].port = "Out 1";
  entity.destinations[0].channels = 0x020F;
  DeviceView device;
  device.key = 1;
  device.name = "Synth";
  device.uniqueID = 101;
  device.manufacturer = "Maker";
  device.model = "Model";
  device.online = true;
  device.entities = {entity};
  studio.devices = {device};
  studio.sources = {SomeEndpoint(5, true, "In 1")};
  studio.destinations = {SomeEndpoint(6, false, "Out 1")};
  studio.sources[0].direct = true;
  studio.destinations[0].direct = true;
  studio.destinations[0].isInterface = true;
  studio.destinations[0].connected = {"Synth"};
  return studio;
}

}  // namespace Ostinet::Tool

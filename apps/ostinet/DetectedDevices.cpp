// SPDX-License-Identifier: MIT
#include "DetectedDevices.h"

#include "DeviceProperties.h"

namespace Ostinet::Tool {
namespace {

bool IsRealID(int id) {
  return id != DetectionRun::kNoDeviceID && id != DetectionRun::kAllDeviceIDs;
}

// A device whose ID nobody stored may be any.
bool IsDeviceOf(Device const& device, DetectionRun::Finding const& finding) {
  std::optional<int> const id = SysexDeviceIDOf(device);
  bool const canBeID = !id || !IsRealID(finding.deviceID) || *id == finding.deviceID;
  return canBeID && finding.types.front().MatchesDevice(device);
}

bool IsThere(Destination const& port, DetectionRun::Finding const& finding) {
  for (int i = 0; i < port.CountConnectedDestinations(); ++i) {
    if (IsDeviceOf(port.GetConnectedDestination(i).GetEntity().GetDevice(), finding)) {
      return true;
    }
  }
  return false;
}

void Connect(Device const& device, Destination const& port, Source const& source) {
  Entity const entity = device.GetEntity(0);
  if (entity.CountDestinations() > 0) {
    port.AddConnectedDestination(entity.GetDestination(0));
  }
  if (entity.CountSources() > 0) {
    source.AddConnectedSource(entity.GetSource(0));
  }
}

}  // namespace

std::optional<Device> CreateDetectedDevice(Setup& setup, Destination const& port,
                                           DetectionRun::Finding const& finding) {
  if (finding.types.empty() || IsThere(port, finding)) {
    return std::nullopt;
  }
  DeviceTypeInfo const& type = finding.types.front();
  Device const device = setup.CreateDevice(type, type.GetModelName());
  device.SetManufacturer(type.GetMfrName());
  device.SetModel(type.GetModelName());
  if (IsRealID(finding.deviceID)) {
    device.SetSysexDeviceID(static_cast<char>(finding.deviceID));
  }
  Connect(device, port, finding.source);
  return device;
}

}  // namespace Ostinet::Tool

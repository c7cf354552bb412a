// SPDX-License-Identifier: MIT
#include "Lookup.h"

#include <algorithm>

#include "Errors.h"
#include "ostinet/Setup.h"

namespace Ostinet::Tool {
namespace {

// `get(i)` for each i below `count`.
template <class Get>
auto Each(int count, Get get) {
  std::vector<decltype(get(0))> handles;
  for (int i = 0; i < count; ++i) {
    handles.push_back(get(i));
  }
  return handles;
}

}  // namespace

std::vector<Device> DevicesOf(Setup const& setup) {
  return Each(setup.CountDevices(), [&](int i) { return setup.GetDevice(i); });
}

std::vector<Entity> EntitiesOf(Device const& device) {
  return Each(device.CountEntities(), [&](int i) { return device.GetEntity(i); });
}

std::vector<Source> SourcesOf(Setup const& setup) {
  return Each(setup.CountSources(), [&](int i) { return setup.GetSource(i); });
}

std::vector<Destination> DestinationsOf(Setup const& setup) {
  return Each(setup.CountDestinations(), [&](int i) { return setup.GetDestination(i); });
}

Device FindDevice(Setup const& setup, std::string const& name) {
  return Find(DevicesOf(setup), name, "device");
}

UString NewName(std::string const& name, std::string const& kind) {
  bool const isBlank = std::all_of(name.begin(), name.end(), [](char c) { return c == ' '; });
  bool const hasControls = std::any_of(name.begin(), name.end(), [](char c) {
    return static_cast<unsigned char>(c) < 0x20 || c == 0x7F;
  });
  if (isBlank || hasControls) {
    throw UsageError("the new name of a " + kind +
                     (isBlank ? " is empty"
                              : " holds a line break"
                                " or the like"));
  }
  return UString(name);
}

}  // namespace Ostinet::Tool

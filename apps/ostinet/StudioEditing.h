// SPDX-License-Identifier: MIT
#pragma once

#include <optional>
#include <string>
#include <vector>

#include "Session.h"

namespace CLI {
class App;
}

namespace Ostinet::Tool {

// What the commands that edit the studio share.

/// What a command has made or deleted, to be told when it is saved.
struct NamedObject {
  std::string name;
  int uniqueID;
};
NamedObject Named(DeviceObject const& object);
/// "Synth  #101", or the same as JSON.
void PrintNamed(GlobalOptions const& globals, NamedObject const& object);

/// Adds --inputs and --outputs: how many endpoints a new entity has.
void AddEndpointCounts(CLI::App& command, std::optional<int>& inputs, std::optional<int>& outputs);

/// Takes each end of an entity off the port that it hangs on. One that goes while it hangs there
/// would leave its number with the port for ever.
void TakeOffPorts(Entity const& entity);

/// The ports that the ends of a device hang on.
struct PortsInUse {
  std::vector<Source> sources;
  std::vector<Destination> destinations;
};
PortsInUse PortsOf(Device const& device);
/// Has each port list what hangs on it now, without the numbers of ends that are gone.
void ListAnew(PortsInUse const& ports);

}  // namespace Ostinet::Tool

// SPDX-License-Identifier: MIT
#include "StudioEditing.h"

#include <CLI/CLI.hpp>

#include "JsonText.h"
#include "Lookup.h"
#include "Output.h"

namespace Ostinet::Tool {

NamedObject Named(DeviceObject const& object) {
  return {object.GetName().string(), object._get_impl_id()};
}

void PrintNamed(GlobalOptions const& globals, NamedObject const& object) {
  if (globals.json) {
    Json const json = {{"name", object.name}, {"uniqueID", object.uniqueID}};
    PrintLine(JsonLine(json));
  } else {
    PrintLine(object.name + "  #" + std::to_string(object.uniqueID));
  }
}

void AddEndpointCounts(CLI::App& command, std::optional<int>& inputs, std::optional<int>& outputs) {
  constexpr int kMost = 64;
  command.add_option("--inputs", inputs, "How many inputs it has, what MIDI comes from (1)")
      ->check(CLI::Range(0, kMost))
      ->type_name("N");
  command.add_option("--outputs", outputs, "How many outputs it has, what MIDI goes to (1)")
      ->check(CLI::Range(0, kMost))
      ->type_name("N");
}

void TakeOffPorts(Entity const& entity) {
  for (int i = 0; i < entity.CountSources(); ++i) {
    Source const source = entity.GetSource(i);
    source.GetDirectSource().RemoveConnectedSource(source);
  }
  for (int i = 0; i < entity.CountDestinations(); ++i) {
    Destination const destination = entity.GetDestination(i);
    destination.GetDirectDestination().RemoveConnectedDestination(destination);
  }
}

PortsInUse PortsOf(Device const& device) {
  PortsInUse ports;
  for (Entity const& entity : EntitiesOf(device)) {
    for (int i = 0; i < entity.CountSources(); ++i) {
      ports.sources.push_back(entity.GetSource(i).GetDirectSource());
    }
    for (int i = 0; i < entity.CountDestinations(); ++i) {
      ports.destinations.push_back(entity.GetDestination(i).GetDirectDestination());
    }
  }
  return ports;
}

// Taking nothing off a port writes its list.
void ListAnew(PortsInUse const& ports) {
  for (Source const& port : ports.sources) {
    port.RemoveConnectedSource(Source::kNoSource);
  }
  for (Destination const& port : ports.destinations) {
    port.RemoveConnectedDestination(Destination::kNoDestination);
  }
}

}  // namespace Ostinet::Tool

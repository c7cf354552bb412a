// SPDX-License-Identifier: MIT
#include <CLI/CLI.hpp>

#include "Commands.h"
#include "Errors.h"
#include "Lookup.h"
#include "StudioEditing.h"

namespace Ostinet::Tool {
namespace {

struct EntityOptions {
  std::string device;
  std::string entity;
  std::optional<int> inputs;
  std::optional<int> outputs;
};

void NewEntity(GlobalOptions const& globals, EntityOptions const& options) {
  UString const name = NewName(options.entity, "entity");
  Session session(globals, nullptr, nullptr);
  Device const device = FindDevice(session.GetSetup(), options.device);
  Entity const entity = session.GetSetup().CreateEntity(device, name, options.inputs.value_or(1),
                                                        options.outputs.value_or(1));
  if (!entity.Exists()) {
    throw Failure("the device \"" + device.GetName().string() + "\" is the system's own");
  }
  NamedObject const made = Named(entity);
  session.Save();
  PrintNamed(globals, made);
}

void DeleteEntity(GlobalOptions const& globals, EntityOptions const& options) {
  Session session(globals, nullptr, nullptr);
  Device const device = FindDevice(session.GetSetup(), options.device);
  Entity const entity = Find(EntitiesOf(device), options.entity, "entity");
  NamedObject const gone = Named(entity);
  TakeOffPorts(entity);
  session.GetSetup().DeleteEntity(entity);
  session.Save();
  PrintNamed(globals, gone);
}

}  // namespace

void AddEntityCommand(CLI::App& app, CommandLine& line) {
  auto const options = std::make_shared<EntityOptions>();
  CLI::App* const entity =
      app.add_subcommand("entity", "Edit the entities of a device, its groups of endpoints");
  entity->require_subcommand(1);
  auto const add = [&](char const* name, char const* help, auto work) {
    CLI::App* const command = entity->add_subcommand(name, help);
    command->add_option("DEVICE", options->device, "The name of the device")->required();
    command->add_option("ENTITY", options->entity, "The name of the entity")->required();
    command->callback([&line, options, work] {
      line.run = [&line, options, work] { work(line.options, *options); };
    });
    return command;
  };
  AddEndpointCounts(*add("new", "Make an entity in a device", NewEntity), options->inputs,
                    options->outputs);
  add("delete", "Delete an entity with its endpoints", DeleteEntity);
}

}  // namespace Ostinet::Tool

// SPDX-License-Identifier: MIT
#include <CLI/CLI.hpp>

#include "Commands.h"
#include "DeviceProperties.h"
#include "Errors.h"
#include "Lookup.h"
#include "Output.h"
#include "StudioEditing.h"
#include "TypeLookup.h"

namespace Ostinet::Tool {
namespace {

struct DeviceOptions {
  std::string device;
  std::string name;
  std::string key;
  std::string value;
  std::string maker;
  std::string model;
  std::optional<int> inputs;
  std::optional<int> outputs;
};

void New(GlobalOptions const& globals, DeviceOptions const& options) {
  UString const name = NewName(options.name, "device");
  bool const isTyped = !options.maker.empty();
  DeviceTypeInfo const type =
      isTyped ? FindDeviceType(options.maker, options.model) : DeviceTypeInfo();
  Session session(globals, nullptr, nullptr);
  Setup& setup = session.GetSetup();
  Device const device = setup.CreateDevice(name);
  if (isTyped) {
    setup.ChangeDeviceType(device, type);
  }
  if (options.inputs) {
    setup.SetEntitySources(device.GetEntity(0), *options.inputs);
  }
  if (options.outputs) {
    setup.SetEntityDestinations(device.GetEntity(0), *options.outputs);
  }
  NamedObject const made = Named(device);
  session.Save();
  PrintNamed(globals, made);
}

// A device that goes leaves no number of its own with the ports that it hung on.
void TakeAllOffPorts(Device const& device) {
  for (Entity const& entity : EntitiesOf(device)) {
    TakeOffPorts(entity);
  }
}

void Delete(GlobalOptions const& globals, DeviceOptions const& options) {
  Session session(globals, nullptr, nullptr);
  Device const device = FindDevice(session.GetSetup(), options.device);
  NamedObject const gone = Named(device);
  TakeAllOffPorts(device);
  session.GetSetup().DeleteDevice(device);
  if (device.Exists()) {
    throw Failure("the device \"" + device.GetName().string() + "\" is the system's own");
  }
  session.Save();
  PrintNamed(globals, gone);
}

void Rename(GlobalOptions const& globals, DeviceOptions const& options) {
  UString const name = NewName(options.name, "device");
  Session session(globals, nullptr, nullptr);
  Device const device = FindDevice(session.GetSetup(), options.device);
  for (Device const& other : DevicesOf(session.GetSetup())) {
    if (other != device && other.GetName().equal(name, UString::kLooselyEqual)) {
      throw Failure("there is a device \"" + other.GetName().string() + "\" already");
    }
  }
  device.SetRawName(name);
  session.Save();
}

void ChangeType(GlobalOptions const& globals, DeviceOptions const& options) {
  DeviceTypeInfo const type = FindDeviceType(options.maker, options.model);
  Session session(globals, nullptr, nullptr);
  Device const device = FindDevice(session.GetSetup(), options.device);
  PortsInUse const ports = PortsOf(device);
  session.GetSetup().ChangeDeviceType(device, type);
  ListAnew(ports);  // The type may have fewer ends.
  session.Save();
}

// A device, else a port: ports have properties of their own.
DeviceObject FindObject(Setup const& setup, std::string const& name) {
  Device const device = TryFind(DevicesOf(setup), name, "device");
  if (device.Exists()) {
    return device;
  }
  std::vector<Endpoint> endpoints;
  for (Destination const& destination : DestinationsOf(setup)) {
    endpoints.push_back(destination);
  }
  for (Source const& source : SourcesOf(setup)) {
    endpoints.push_back(source);
  }
  return Find(endpoints, name, "device or port");
}

void Set(GlobalOptions const& globals, DeviceOptions const& options) {
  Session session(globals, nullptr, nullptr);
  WriteProperty(FindObject(session.GetSetup(), options.device), options.key, options.value);
  session.Save();
}

void Get(GlobalOptions const& globals, DeviceOptions const& options) {
  Session const session(globals, nullptr, nullptr);
  DeviceObject const object = FindObject(session.GetSetup(), options.device);
  if (!options.key.empty()) {
    PrintLine(ReadProperty(object, options.key));
  } else if (globals.json) {
    PrintLine(PropertiesJSON(object));
  } else {
    for (NamedValue const& property : ReadProperties(object)) {
      PrintLine(property.key + ": " + property.value);
    }
  }
}

using Work = void (*)(GlobalOptions const&, DeviceOptions const&);

/// Adds one of the commands behind "device".
CLI::App* Add(CLI::App& device, CommandLine& line, std::shared_ptr<DeviceOptions> const& options,
              std::string const& name, std::string const& help, Work work) {
  CLI::App* const command = device.add_subcommand(name, help);
  command->callback([&line, options, work] {
    line.run = [&line, options, work] { work(line.options, *options); };
  });
  return command;
}

void AddDevice(CLI::App& command, DeviceOptions& options, char const* help = "Its name") {
  command.add_option("DEVICE", options.device, help)->required();
}

void AddType(CLI::App& command, DeviceOptions& options) {
  command.add_option("MAKER", options.maker, "As ostinet types lists it")->required();
  command.add_option("MODEL", options.model, "Likewise")->required();
}

}  // namespace

void AddDeviceCommand(CLI::App& app, CommandLine& line) {
  auto const options = std::make_shared<DeviceOptions>();
  CLI::App* const device = app.add_subcommand("device", "Edit the devices of the studio");
  device->require_subcommand(1);

  CLI::App* command = Add(*device, line, options, "new", "Make a device", New);
  command->add_option("NAME", options->name, "A number is added where it is taken")->required();
  command->add_option("MAKER", options->maker, "Of a device type, as ostinet types lists it");
  command->add_option("MODEL", options->model, "Likewise")->needs("MAKER");
  command->get_option("MAKER")->needs("MODEL");
  AddEndpointCounts(*command, options->inputs, options->outputs);

  AddDevice(*Add(*device, line, options, "delete", "Delete a device with all its parts", Delete),
            *options);

  command = Add(*device, line, options, "rename", "Give a device another name", Rename);
  AddDevice(*command, *options);
  command->add_option("NAME", options->name, "The new name")->required();

  command =
      Add(*device, line, options, "type", "Make a device one of a catalogued type", ChangeType);
  AddDevice(*command, *options);
  AddType(*command, *options);

  command = Add(*device, line, options, "set", "Say something about a device or a port", Set);
  AddDevice(*command, *options, "A device, else a port");
  command->add_option("KEY", options->key, "What is said")->required();
  command->add_option("VALUE", options->value, "What it is")->required();
  command->footer("Keys:\n" + PropertiesHelp());

  command = Add(*device, line, options, "get", "Show what is known of a device or a port", Get);
  AddDevice(*command, *options, "A device, else a port");
  command->add_option("KEY", options->key, "Only this one");
}

}  // namespace Ostinet::Tool

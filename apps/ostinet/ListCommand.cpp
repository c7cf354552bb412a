// SPDX-License-Identifier: MIT
#include <CLI/CLI.hpp>

#include "Commands.h"
#include "Output.h"
#include "StudioText.h"

namespace Ostinet::Tool {
namespace {

struct ListOptions {
  bool inputs = false;
  bool outputs = false;
  bool connections = false;
  bool devices = false;
};

ViewFilter FilterOf(ListOptions const& options) {
  ViewFilter filter;
  filter.sources = options.inputs || !options.outputs;
  filter.destinations = options.outputs || !options.inputs;
  filter.withoutEntity = !options.devices;
  filter.onlyConnected = options.connections;
  return filter;
}

void List(GlobalOptions const& globals, ListOptions const& options) {
  Session const session(globals, nullptr, nullptr);
  StudioView whole = ViewStudio(session.GetSetup());
  AddPlaying(whole, session.GetSetup());
  StudioView const view = Filtered(whole, FilterOf(options));
  if (globals.json) {
    PrintLine(StudioJSON(view));
    return;
  }
  for (std::string const& line : StudioLines(view)) {
    PrintLine(line);
  }
}

}  // namespace

void AddListCommand(CLI::App& app, CommandLine& line) {
  auto const options = std::make_shared<ListOptions>();
  CLI::App* const command = app.add_subcommand("list", "Show the studio as a tree");
  command->add_flag("-i,--inputs", options->inputs, "Only inputs (what MIDI comes from)");
  command->add_flag("-o,--outputs", options->outputs, "Only outputs (what MIDI goes to)");
  command->add_flag("-l,--connections", options->connections, "Only what is connected");
  command->add_flag("-d,--devices", options->devices, "Only devices, without loose ports");
  command->footer("The options combine: \"list -l -o\" shows the connected outputs.");
  command->callback(
      [&line, options] { line.run = [&line, options] { List(line.options, *options); }; });
}

}  // namespace Ostinet::Tool

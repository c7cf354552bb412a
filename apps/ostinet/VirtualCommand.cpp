// SPDX-License-Identifier: MIT
#include <CLI/CLI.hpp>

#include "Commands.h"
#include "Lookup.h"
#include "StudioEditing.h"

namespace Ostinet::Tool {
namespace {

struct VirtualOptions {
  std::string name;
  bool input = false;  // the default, which may be said
  bool output = false;
};

void New(GlobalOptions const& globals, VirtualOptions const& options) {
  UString const name = NewName(options.name, "virtual endpoint");
  Session session(globals, nullptr, nullptr);
  Endpoint const shown = session.GetVirtualEndpoints().Add(
      session.GetSetup(), name, options.output ? Setup::kDestinationEnd : Setup::kSourceEnd);
  NamedObject const made = Named(shown);
  session.Save();
  PrintNamed(globals, made);
}

void Delete(GlobalOptions const& globals, VirtualOptions const& options) {
  Session session(globals, nullptr, nullptr);
  Endpoint const gone = session.GetVirtualEndpoints().Find(options.name);
  NamedObject const told = Named(gone);
  session.GetVirtualEndpoints().Remove(session.GetSetup(), gone);
  session.Save();
  PrintNamed(globals, told);
}

}  // namespace

void AddVirtualCommand(CLI::App& app, CommandLine& line) {
  auto const options = std::make_shared<VirtualOptions>();
  CLI::App* const command = app.add_subcommand(
      "virtual", "Edit virtual endpoints: what is sent to one end comes out of the other");
  command->require_subcommand(1);
  auto const add = [&](char const* name, char const* help, auto work) {
    CLI::App* const sub = command->add_subcommand(name, help);
    sub->add_option("NAME", options->name, "Its name")->required();
    sub->callback([&line, options, work] {
      line.run = [&line, options, work] { work(line.options, *options); };
    });
    return sub;
  };
  CLI::App* const make = add("new", "Make a pair of ends", New);
  make->add_flag("-o,--output", options->output, "Its output shows, what MIDI goes to");
  make->add_flag("-i,--input", options->input,
                 "Its input shows, what MIDI comes from (the default)")
      ->excludes("--output");
  add("delete", "Delete both ends", Delete);
}

}  // namespace Ostinet::Tool

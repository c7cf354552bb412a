// SPDX-License-Identifier: MIT
#include "NamesCommand.h"

#include <CLI/CLI.hpp>

namespace Ostinet::Tool {

void AddNamesCommand(CLI::App& app, CommandLine& line) {
  CLI::App* const names =
      app.add_subcommand("names", "What modes, banks, patches, notes and controls are called");
  names->require_subcommand(0, 1);
  names->fallthrough();
  for (auto const add : {AddNamesOfDestination, AddNamesList, AddNamesShow, AddNamesCheck}) {
    add(*names, line);
  }
}

}  // namespace Ostinet::Tool

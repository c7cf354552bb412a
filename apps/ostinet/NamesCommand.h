// SPDX-License-Identifier: MIT
#pragma once

#include "Commands.h"

namespace Ostinet::Tool {

// What `names` does by itself, with a destination, and its subcommands, each with its options and
// its help; they set `run` where given.
void AddNamesOfDestination(CLI::App& names, CommandLine& line);
void AddNamesList(CLI::App& names, CommandLine& line);
void AddNamesShow(CLI::App& names, CommandLine& line);
void AddNamesCheck(CLI::App& names, CommandLine& line);

}  // namespace Ostinet::Tool

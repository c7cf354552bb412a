// SPDX-License-Identifier: MIT
#pragma once

#include "Commands.h"

namespace Ostinet::Tool {

// The subcommands of `names`, each with its options and its help; they set `run` where given.
void AddNamesShow(CLI::App& names, CommandLine& line);
void AddNamesCheck(CLI::App& names, CommandLine& line);

}  // namespace Ostinet::Tool

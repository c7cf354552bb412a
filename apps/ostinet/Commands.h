// SPDX-License-Identifier: MIT
#pragma once

#include <functional>

#include "Session.h"

namespace CLI {
class App;
}

namespace Ostinet::Tool {

/// What reading the command line leaves behind.
struct CommandLine {
  GlobalOptions options;
  std::function<void()> run;  ///< the command that was given; throws UsageError or Failure
};

// Each adds its command with its options and its help, and sets `run` where it is given. Both
// arguments outlive the run.
void AddListCommand(CLI::App& app, CommandLine& line);
void AddWatchCommand(CLI::App& app, CommandLine& line);
void AddMonitorCommand(CLI::App& app, CommandLine& line);
void AddSendCommand(CLI::App& app, CommandLine& line);
void AddPanicCommand(CLI::App& app, CommandLine& line);
void AddRefCommand(CLI::App& app, CommandLine& line);
void AddResolveCommand(CLI::App& app, CommandLine& line);
void AddPairCommand(CLI::App& app, CommandLine& line);
void AddDeviceCommand(CLI::App& app, CommandLine& line);
void AddEntityCommand(CLI::App& app, CommandLine& line);
void AddConnectCommand(CLI::App& app, CommandLine& line);
void AddDisconnectCommand(CLI::App& app, CommandLine& line);
void AddVirtualCommand(CLI::App& app, CommandLine& line);
void AddDrawCommand(CLI::App& app, CommandLine& line);
void AddTypesCommand(CLI::App& app, CommandLine& line);
void AddDetectCommand(CLI::App& app, CommandLine& line);
void AddDiagCommand(CLI::App& app, CommandLine& line);
void AddNamesCommand(CLI::App& app, CommandLine& line);
void AddModesCommand(CLI::App& app, CommandLine& line);
void AddBanksCommand(CLI::App& app, CommandLine& line);
void AddPatchesCommand(CLI::App& app, CommandLine& line);
void AddNotesCommand(CLI::App& app, CommandLine& line);
void AddControlsCommand(CLI::App& app, CommandLine& line);
void AddSelectCommand(CLI::App& app, CommandLine& line);
void AddModeCommand(CLI::App& app, CommandLine& line);
void AddNoteNameCommand(CLI::App& app, CommandLine& line);

/// Adds --for and --count.
void AddLimits(CLI::App& command, Limits& limits);

}  // namespace Ostinet::Tool

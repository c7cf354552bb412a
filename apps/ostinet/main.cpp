// SPDX-License-Identifier: MIT
#include <CLI/CLI.hpp>
#include <iostream>

#include "Commands.h"
#include "Errors.h"
#include "Interrupt.h"
#include "Output.h"

namespace Ostinet::Tool {
namespace {

void AddGlobals(CLI::App& app, GlobalOptions& options) {
  app.add_flag("--json", options.json, "Print JSON, with keys that stay as they are");
  app.add_option("--studio", options.studio,
                 "Run on the simulated studio of this JSON file, as OSTINET_STUDIO does")
      ->type_name("FILE");
  app.add_option("--settings", options.settings, "Where settings are kept, instead of the user's")
      ->type_name("FOLDER");
  app.set_version_flag("--version", OSTINET_TOOL_VERSION);
}

void Describe(CLI::App& app) {
  app.name("ostinet");
  app.description("The MIDI studio on the command line");
  app.footer(
      "Names are taken exactly, else by an unambiguous beginning, else by an unambiguous part;"
      "\n#123 is the unique ID 123. Channels count from 1 to 16."
      "\nExit codes: 0 done, 1 failed or not found, 2 wrong usage.");
  app.require_subcommand(1);
  app.fallthrough();
  app.allow_windows_style_options(false);
}

int Report(std::string const& sentence, int exitCode) {
  Notify(sentence);
  return exitCode;
}

// A command that does not exist would else be told as one that is missing.
std::string UsageSentence(CLI::App const& app, CLI::ParseError const& error) {
  std::vector<std::string> const unknown = app.remaining();
  bool const isUnknownCommand = app.get_subcommands().empty() && !unknown.empty();
  std::string const sentence =
      isUnknownCommand ? "there is no command or option \"" + unknown.front() + "\"" : error.what();
  return sentence + "; see ostinet --help";
}

int RunCommand(CommandLine const& line) {
  try {
    line.run();
    return kExitDone;
  } catch (OutputClosed const&) {
    return kExitDone;
  } catch (UsageError const& error) {
    return Report(error.what(), kExitUsage);
  } catch (std::exception const& error) {
    return Report(error.what(), kExitFailed);
  }
}

int Main(int argc, char** argv) {
  KeepRunningOnClosedPipes();
  CatchInterrupts();
  CLI::App app;
  CommandLine line;
  Describe(app);
  AddGlobals(app, line.options);
  for (auto const add :
       {AddListCommand,     AddWatchCommand,      AddMonitorCommand, AddSendCommand,
        AddPanicCommand,    AddRefCommand,        AddResolveCommand, AddPairCommand,
        AddTypesCommand,    AddDetectCommand,     AddDeviceCommand,  AddEntityCommand,
        AddConnectCommand,  AddDisconnectCommand, AddVirtualCommand, AddDrawCommand,
        AddNamesCommand,    AddModesCommand,      AddBanksCommand,   AddPatchesCommand,
        AddNotesCommand,    AddControlsCommand,   AddSelectCommand,  AddModeCommand,
        AddNoteNameCommand, AddDiagCommand}) {
    add(app, line);
  }
  try {
    app.parse(argc, argv);
  } catch (CLI::Success const& help) {
    return app.exit(help, std::cout, std::cerr);
  } catch (CLI::ParseError const& error) {
    return Report(UsageSentence(app, error), kExitUsage);
  }
  return RunCommand(line);
}

}  // namespace
}  // namespace Ostinet::Tool

int main(int argc, char** argv) { return Ostinet::Tool::Main(argc, argv); }

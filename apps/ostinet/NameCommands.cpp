// SPDX-License-Identifier: MIT
//
// modes, banks, patches, notes, controls: what a destination offers.
#include <CLI/CLI.hpp>

#include "Commands.h"
#include "NameLookup.h"
#include "NameText.h"
#include "Output.h"

namespace Ostinet::Tool {
namespace {

struct Options {
  std::string destination;
  std::string bank;
  std::string patch;
  int channel = 1;
};

using Show = void (*)(GlobalOptions const&, Options const&, Destination const&);

CLI::App* AddCommand(CLI::App& app, CommandLine& line, char const* name, char const* help,
                     std::shared_ptr<Options> const& options, Show show) {
  CLI::App* const command = app.add_subcommand(name, help);
  command->add_option("DESTINATION", options->destination, "Its name, or an unambiguous part")
      ->required();
  command->callback([&line, options, show] {
    line.run = [&line, options, show] {
      Session const session(line.options, nullptr, nullptr);
      show(line.options, *options, FindAnyDestination(session.GetSetup(), options->destination));
    };
  });
  return command;
}

void AddChannel(CLI::App& command, Options& options) {
  command.add_option("-c,--channel", options.channel, "1 to 16 (1)")->type_name("N");
}

void AddBank(CLI::App& command, Options& options) {
  command.add_option("--bank", options.bank, "Only in the bank of this name")->type_name("BANK");
}

void ShowModes(GlobalOptions const& globals, Options const&, Destination const& destination) {
  PrintOne(globals.json, ModesJSON(destination), ModesLines(destination));
}

void ShowBanks(GlobalOptions const& globals, Options const& options,
               Destination const& destination) {
  auto const banks = BanksOf(NameSetOf(destination, ChannelOf(options.channel)));
  PrintOne(globals.json, BanksJSON(banks), BanksLines(banks));
}

void ShowPatches(GlobalOptions const& globals, Options const& options,
                 Destination const& destination) {
  DestinationNameSet const nameSet = NameSetOf(destination, ChannelOf(options.channel));
  std::vector<PatchBank> const banks =
      options.bank.empty() ? BanksOf(nameSet)
                           : std::vector<PatchBank>{FindBank(nameSet, options.bank)};
  PrintOne(globals.json, PatchesJSON(banks), PatchesLines(banks));
}

Patch PatchOf(Options const& options, Destination const& destination) {
  return FindPatchToShow(destination, ChannelOf(options.channel), options.patch, options.bank);
}

void ShowNotes(GlobalOptions const& globals, Options const& options,
               Destination const& destination) {
  Patch const patch = PatchOf(options, destination);
  PrintOne(globals.json, NotesJSON(patch), NotesLines(patch));
}

void ShowControls(GlobalOptions const& globals, Options const& options,
                  Destination const& destination) {
  Patch const patch = PatchOf(options, destination);
  PrintOne(globals.json, ControlsJSON(patch), ControlsLines(patch));
}

void AddPatchOptions(CLI::App& command, Options& options) {
  command.add_option("PATCH", options.patch,
                     "Its number or name; without one the patch that plays, else the first");
  AddBank(command, options);
  AddChannel(command, options);
}

}  // namespace

void AddModesCommand(CLI::App& app, CommandLine& line) {
  auto const options = std::make_shared<Options>();
  AddCommand(app, line, "modes", "List the modes of a destination", options, ShowModes);
}

void AddBanksCommand(CLI::App& app, CommandLine& line) {
  auto const options = std::make_shared<Options>();
  AddChannel(*AddCommand(app, line, "banks", "List the banks of a channel", options, ShowBanks),
             *options);
}

void AddPatchesCommand(CLI::App& app, CommandLine& line) {
  auto const options = std::make_shared<Options>();
  CLI::App& command =
      *AddCommand(app, line, "patches", "List the patches of a channel", options, ShowPatches);
  AddBank(command, *options);
  AddChannel(command, *options);
}

void AddNotesCommand(CLI::App& app, CommandLine& line) {
  auto const options = std::make_shared<Options>();
  AddPatchOptions(*AddCommand(app, line, "notes", "List what the notes of a patch are called",
                              options, ShowNotes),
                  *options);
}

void AddControlsCommand(CLI::App& app, CommandLine& line) {
  auto const options = std::make_shared<Options>();
  AddPatchOptions(*AddCommand(app, line, "controls", "List what the controls of a patch are called",
                              options, ShowControls),
                  *options);
}

}  // namespace Ostinet::Tool

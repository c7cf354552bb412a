// SPDX-License-Identifier: MIT
//
// select, mode, note-name: choose patches and modes, and name notes.
#include <CLI/CLI.hpp>

#include "Commands.h"
#include "Errors.h"
#include "MessageText.h"
#include "NameLookup.h"
#include "NameText.h"
#include "Outgoing.h"
#include "Output.h"

namespace Ostinet::Tool {
namespace {

// What was sent leaves by a thread of the port; a mode's script may spread over time.
constexpr auto kUntilSent = std::chrono::milliseconds(200);

struct SelectOptions {
  std::string destination;
  int channel = 1;
  std::string patch;
  std::string bank;
};

void Select(GlobalOptions const& globals, SelectOptions const& options) {
  Session session(globals, nullptr, nullptr);
  Destination const destination = FindDestination(session.GetSetup(), options.destination);
  short const channel = ChannelOf(options.channel);
  Patch const patch = FindPatch(NameSetOf(destination, channel), options.patch, options.bank);
  destination.SendPatchChange(channel, patch);
  session.RunFor(kUntilSent);
  PrintOne(globals.json, PatchJSON(patch), {PatchText(patch)});
}

struct ModeOptions {
  std::string destination;
  std::string mode;
};

void ChangeMode(GlobalOptions const& globals, ModeOptions const& options) {
  Session session(globals, nullptr, nullptr);
  Destination const destination = FindDestination(session.GetSetup(), options.destination);
  DestinationMode const mode = FindMode(destination, options.mode);
  bool const isCurrent = mode == destination.GetCurrentMode();
  destination.SendModeChange(mode);
  session.RunFor(kUntilSent);
  PrintOne(globals.json, ModesJSON(destination), ModesLines(destination));
  if (!isCurrent) {
    FailIfNothingIsKept(destination);
    session.Save();
  }
}

struct NoteOptions {
  std::string destination;
  std::string patch;
  std::string note;
  std::string name;
  std::string bank;
  int channel = 1;
  bool clear = false;
  CLI::Option* nameOption = nullptr;
};

void NameNote(GlobalOptions const& globals, NoteOptions const& options) {
  auto const pitch = static_cast<unsigned char>(ParseNote(options.note));
  Session session(globals, nullptr, nullptr);
  Destination const destination = FindAnyDestination(session.GetSetup(), options.destination);
  Patch const patch =
      FindPatchToShow(destination, ChannelOf(options.channel), options.patch, options.bank);
  NoteNameList const notes = patch.GetNoteNames();
  bool const isEdit = options.clear || options.nameOption->count() > 0;
  if (isEdit) {
    FailIfNothingIsKept(destination);
  }
  if (options.clear) {
    notes.ClearNoteName(pitch);
  } else if (isEdit) {
    notes.SetNoteName(pitch, UString(options.name));
  }
  std::string const name = notes.GetNoteNameForPitch(pitch).string();
  PrintOne(globals.json, NoteJSON(pitch, name), {name});
  if (isEdit) {
    session.GetSetup().SaveEditedDestBanks();
    session.Save();
  }
}

CLI::Option* AddDestination(CLI::App& command, std::string& destination) {
  return command.add_option("DESTINATION", destination, "Its name, or an unambiguous part")
      ->required();
}

}  // namespace

void AddSelectCommand(CLI::App& app, CommandLine& line) {
  auto const options = std::make_shared<SelectOptions>();
  CLI::App* const command = app.add_subcommand("select", "Have a channel play a patch");
  AddDestination(*command, options->destination);
  command->add_option("CHANNEL", options->channel, "1 to 16")->required();
  command->add_option("PATCH", options->patch, "Its number or name")->required();
  command->add_option("--bank", options->bank, "Only in the bank of this name")->type_name("BANK");
  command->callback(
      [&line, options] { line.run = [&line, options] { Select(line.options, *options); }; });
}

void AddModeCommand(CLI::App& app, CommandLine& line) {
  auto const options = std::make_shared<ModeOptions>();
  CLI::App* const command = app.add_subcommand("mode", "Put a destination into a mode");
  AddDestination(*command, options->destination);
  command->add_option("MODE", options->mode, "Its name, or an unambiguous part")->required();
  command->callback(
      [&line, options] { line.run = [&line, options] { ChangeMode(line.options, *options); }; });
}

void AddNoteNameCommand(CLI::App& app, CommandLine& line) {
  auto const options = std::make_shared<NoteOptions>();
  CLI::App* const command =
      app.add_subcommand("note-name", "Tell or change what a note of a patch is called");
  AddDestination(*command, options->destination);
  command->add_option("PATCH", options->patch, "Its number or name")->required();
  command->add_option("NOTE", options->note, "A number from 0 to 127, or a name like C4")
      ->required();
  options->nameOption = command->add_option("NAME", options->name, "The new name");
  command->add_flag("--clear", options->clear, "Take the name away");
  command->add_option("--bank", options->bank, "Only in the bank of this name")->type_name("BANK");
  command->add_option("-c,--channel", options->channel, "1 to 16 (1)")->type_name("N");
  command->callback(
      [&line, options] { line.run = [&line, options] { NameNote(line.options, *options); }; });
}

}  // namespace Ostinet::Tool

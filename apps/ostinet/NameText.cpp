// SPDX-License-Identifier: MIT
#include "NameText.h"

#include "MessageText.h"
#include "NameLookup.h"

namespace Ostinet::Tool {
namespace {

using Lines = std::vector<std::string>;

constexpr unsigned char kNoNumber = 255;

char const* TypeText(Names const& names) {
  switch (names.GetType()) {
    case Names::kMasterNames:
      return "document";
    case Names::kStandardModeNames:
      return "standard mode";
    case Names::kOverrideNames:
      return "patch list";
    case Names::kEditedOverrideNames:
      return "edited patch list";
    case Names::kNoNames:
      break;
  }
  return "none";
}

std::string BankText(PatchBank const& bank) {
  std::string const numbers = BankNumbersText(bank);
  return bank.GetName().string() + (numbers.empty() ? "" : "  (bank " + numbers + ")");
}

std::string NumberText(double number) {
  std::string text = std::to_string(number);
  text.erase(text.find_last_not_of('0') + 1);
  return text.back() == '.' ? text.substr(0, text.size() - 1) : text;
}

}  // namespace

std::string PatchText(Patch const& patch) {
  return patch.GetNumberAndName().string() + "  (" + patch.GetBank().GetName().string() + ")";
}

Lines NamesLines(Destination const& destination) {
  Names const names = destination.GetNames();
  Lines lines = {destination.GetName().string() + ": " +
                 (names.Exists() ? names.GetName().string() : "no names")};
  if (names.Exists()) {
    lines.push_back(std::string("  ") + TypeText(names) + " in " +
                    names.GetFile().GetFullPath().string());
  }
  if (destination.GetCurrentMode().GetImplPtr() != nullptr) {
    lines.push_back("  mode " + destination.GetCurrentMode().GetName().string());
  }
  return lines;
}

Lines OffersLines(std::vector<NameDocumentOffer> const& offers) {
  Lines lines;
  for (NameDocumentOffer const& offer : offers) {
    bool const isForDevice = offer.names.GetType() != Names::kStandardModeNames;
    lines.push_back(
        (isForDevice ? offer.manufacturer.string() + " " + offer.model.string() + ": " : "") +
        offer.names.GetName().string() + "  (" + TypeText(offer.names) + ")  " +
        offer.names.GetFile().GetFullPath().string());
  }
  return lines;
}

Lines ModesLines(Destination const& destination) {
  Lines lines;
  for (DestinationMode const& mode : ModesOf(destination)) {
    bool const isCurrent = mode == destination.GetCurrentMode();
    lines.push_back((isCurrent ? "* " : "  ") + mode.GetName().string() +
                    (mode.IsStandardMode() ? "  (standard)" : "") +
                    (mode.SelectableWithMIDI() ? "  (selected by MIDI)" : ""));
  }
  return lines;
}

Lines BanksLines(std::vector<PatchBank> const& banks) {
  Lines lines;
  for (PatchBank const& bank : banks) {
    lines.push_back(BankText(bank) + "  " + std::to_string(bank.CountPatches()) + " patches");
  }
  return lines;
}

Lines PatchesLines(std::vector<PatchBank> const& banks) {
  Lines lines;
  for (PatchBank const& bank : banks) {
    lines.push_back(BankText(bank));
    for (Patch const& patch : PatchesOf(bank)) {
      unsigned char const program = patch.GetPatchNumbers().program;
      lines.push_back("  " + patch.GetNumberAndName().string() +
                      (program != kNoNumber ? "  (program " + std::to_string(program) + ")" : ""));
    }
  }
  return lines;
}

Lines NotesLines(Patch const& patch) {
  Lines lines;
  NoteNameList const notes = patch.GetNoteNames();
  for (int i = 0; i < notes.CountNoteNames(); ++i) {
    auto const [pitch, name] = notes.GetNoteName(i);
    NoteGroup const group = notes.GetNoteGroupForID(notes.GetNoteGroupForPitch(pitch));
    lines.push_back(std::to_string(pitch) + " " + NoteName(pitch) + "  " + name.string() +
                    (group.name.empty() ? "" : "  (" + group.name.string() + ")"));
  }
  return lines;
}

Lines ControlsLines(Patch const& patch) {
  static constexpr char const* kTypes[] = {"", "14 bit ", "RPN ", "NRPN "};
  Lines lines;
  ControlList const controls = patch.GetControlNames();
  for (int i = 0; i < controls.CountControls(); ++i) {
    Control const control = controls.GetControl(i);
    std::string line = kTypes[control.GetType() & 3] + std::to_string(control.GetNumber()) + "  " +
                       control.GetName().string();
    if (control.HasValueRange()) {
      line += "  (" + NumberText(control.GetMinValue()) + " to " +
              NumberText(control.GetMaxValue()) +
              (control.HasUnits() ? " " + control.GetUnits().string() : "") + ")";
    }
    lines.push_back(line);
  }
  return lines;
}

}  // namespace Ostinet::Tool

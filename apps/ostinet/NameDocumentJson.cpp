// SPDX-License-Identifier: MIT

#include "HexBytes.h"
#include "JsonText.h"
#include "NameDocumentText.h"

// The keys are a promise to scripts: docs/tool.md lists them, and more may come, but none goes.

namespace Ostinet::Tool {
namespace {

// What goes over the wire to a device whose ID nobody knows: the call to all devices.
constexpr unsigned char kAllDevices = 126;
constexpr char const* kControlTypes[] = {"7bit", "14bit", "RPN", "NRPN"};
constexpr char const* kFindingKinds[] = {"malformed", "notStandard", "passedOver"};

template <class MakeElement>
Json Array(int count, MakeElement makeElement) {
  Json array = Json::array();
  for (int i = 0; i < count; ++i) {
    array.push_back(makeElement(i));
  }
  return array;
}

Json NotesJSON(NoteNameListBase const& list) {
  if (!list.HasNames()) {
    return {};
  }
  Json const notes = Array(list.CountNoteNames(), [&](int index) -> Json {
    auto const [pitch, name] = list.GetNoteName(index);
    return {{"pitch", pitch}, {"name", name.string()}, {"group", list.GetNoteGroupForPitch(pitch)}};
  });
  Json const groups = Array(list.CountNoteGroups(), [&](int index) -> Json {
    NoteGroup const group = list.GetNoteGroup(index);
    return {{"id", group.id}, {"name", group.name.string()}, {"pitches", group.pitches}};
  });
  return {{"name", list.GetName().string()}, {"notes", notes}, {"groups", groups}};
}

Json ControlJSON(Control const& control) {
  bool const hasRange = control.HasValueRange();
  Json const values = Array(control.CountValueNames(), [&](int index) -> Json {
    auto const [number, name] = control.GetValueName(index);
    return {{"number", number}, {"name", name.string()}};
  });
  return {{"type", kControlTypes[control.GetType()]},
          {"number", control.GetNumber()},
          {"name", control.GetName().string()},
          {"min", hasRange ? Json(control.GetMinValue()) : Json()},
          {"max", hasRange ? Json(control.GetMaxValue()) : Json()},
          {"default", control.HasDefaultValue() ? Json(control.GetDefaultValue()) : Json()},
          {"units", control.GetUnits().string()},
          {"values", values}};
}

Json ControlsJSON(ControlListBase const& list) {
  if (!NameDocument::HasControls(list)) {
    return {};
  }
  return {{"name", list.GetName().string()},
          {"controls", Array(list.CountControls(),
                             [&](int index) { return ControlJSON(list.GetControl(index)); })}};
}

Json PatchJSON(Patch const& patch) {
  PatchNumbers const numbers = patch.GetPatchNumbers();
  return {{"number", patch.GetNumber().string()},
          {"name", patch.GetName().string()},
          {"program", NumberOrNull(numbers.program)},
          {"msb", NumberOrNull(numbers.msb)},
          {"lsb", NumberOrNull(numbers.lsb)},
          {"command", HexMessages(patch.GetCommand(TimeStamp(), 0, kAllDevices))},
          {"notes", NotesJSON(patch.GetNoteNames())},
          {"controls", ControlsJSON(patch.GetControlNames())}};
}

Json BankJSON(PatchBank const& bank) {
  return {{"name", bank.GetBankName().string()},
          {"listName", NameDocument::GetListName(bank).string()},
          {"msb", NumberOrNull(bank.GetController0Number())},
          {"lsb", NumberOrNull(bank.GetController32Number())},
          {"command", HexMessages(bank.GetCommand(TimeStamp(), 0, kAllDevices))},
          {"patches",
           Array(bank.CountPatches(), [&](int index) { return PatchJSON(bank.GetPatch(index)); })}};
}

Json NameSetJSON(DestinationNameSet const& nameSet) {
  return {{"name", nameSet.GetName().string()},
          {"channels", nameSet.GetChannels()},
          {"notes", NotesJSON(NameDocument::GetDefaultNotes(nameSet))},
          {"controls", ControlsJSON(NameDocument::GetDefaultControls(nameSet))},
          {"banks", Array(nameSet.CountBanks(),
                          [&](int index) { return BankJSON(nameSet.GetBank(index)); })}};
}

Json ModeJSON(DestinationMode const& mode) {
  DataBuffer enable;
  DataBuffer disable;
  mode.GetEnablingCommand(enable, TimeStamp(), kAllDevices);
  mode.GetDisablingCommand(disable, TimeStamp(), kAllDevices);
  Json const channels = Array(kChannels, [&](int channel) {
    DestinationNameSet const nameSet = mode.GetNameSet(static_cast<short>(channel));
    return nameSet.GetImplPtr() == nullptr ? Json() : Json(nameSet.GetName().string());
  });
  return {{"name", mode.GetName().string()},
          {"standard", mode.IsStandardMode()},
          {"enable", HexMessages(enable)},
          {"disable", HexMessages(disable)},
          {"channels", channels}};
}

Json FindingJSON(NameDocumentFinding const& finding) {
  return {{"line", finding.line == 0 ? Json() : Json(finding.line)},
          {"kind", kFindingKinds[finding.kind]},
          {"text", finding.text.string()}};
}

}  // namespace

std::vector<std::string> HexMessages(DataBuffer const& buffer) {
  std::vector<std::string> messages;
  for (std::size_t i = 0; i < buffer.size(); ++i) {
    DataPacket const packet = buffer[i];
    messages.push_back(ToHex(Bytes(packet.data, packet.data + packet.length)));
  }
  return messages;
}

std::string NameDocumentJSON(NameDocument const& document) {
  Json const json = {
      {"modes",
       Array(document.CountModes(), [&](int index) { return ModeJSON(document.GetMode(index)); })},
      {"supportsStandardModes",
       Array(document.CountSupportedStandardModes(),
             [&](int index) { return document.GetSupportedStandardMode(index).string(); })},
      {"nameSets", Array(document.CountNameSets(),
                         [&](int index) { return NameSetJSON(document.GetNameSet(index)); })}};
  return JsonText(json);
}

std::string NameChecksJSON(std::vector<CheckedNameDocument> const& files) {
  Json const json = Array(static_cast<int>(files.size()), [&](int index) -> Json {
    CheckedNameDocument const& file = files[static_cast<std::size_t>(index)];
    Json const findings = Array(static_cast<int>(file.check.findings.size()), [&](int place) {
      return FindingJSON(file.check.findings[static_cast<std::size_t>(place)]);
    });
    return {{"file", file.path},
            {"wellFormed", file.check.isWellFormed},
            {"valid", file.check.isStandard},
            {"findings", findings}};
  });
  return JsonText(json);
}

}  // namespace Ostinet::Tool

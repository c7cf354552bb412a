// SPDX-License-Identifier: MIT

#include "JsonText.h"
#include "NameLookup.h"
#include "NameText.h"

namespace Ostinet::Tool {
namespace {

Json NameOrNull(Object const& object) {
  return object.GetImplPtr() != nullptr ? Json(object.GetName().string()) : Json();
}

char const* TypeWord(Names const& names) {
  static constexpr char const* kWords[] = {"none", "master", "standard", "override", "edited"};
  return kWords[names.GetType()];
}

Json DocumentJson(Names const& names) {
  return {{"type", TypeWord(names)},
          {"name", names.GetName().string()},
          {"file", names.GetFile().GetFullPath().string()}};
}

Json PatchJson(Patch const& patch) {
  PatchNumbers const numbers = patch.GetPatchNumbers();
  return {{"number", patch.GetNumber().string()},
          {"name", patch.GetName().string()},
          {"program", NumberOrNull(numbers.program)},
          {"msb", NumberOrNull(numbers.msb)},
          {"lsb", NumberOrNull(numbers.lsb)}};
}

Json BankJson(PatchBank const& bank) {
  return {{"name", bank.GetBankName().string()},
          {"listName", bank.GetName().string()},
          {"msb", NumberOrNull(bank.GetController0Number())},
          {"lsb", NumberOrNull(bank.GetController32Number())}};
}

// Of the patches the banks show only how many there are, unless they are asked for.
template <class Add>
std::string BanksWith(std::vector<PatchBank> const& banks, Add const& add) {
  Json array = Json::array();
  for (PatchBank const& bank : banks) {
    Json json = BankJson(bank);
    add(bank, json);
    array.push_back(json);
  }
  return JsonText({{"banks", array}});
}

Json NotesOf(NoteNameList const& notes) {
  Json array = Json::array();
  for (int i = 0; i < notes.CountNoteNames(); ++i) {
    auto const [pitch, name] = notes.GetNoteName(i);
    array.push_back(
        {{"pitch", pitch}, {"name", name.string()}, {"group", notes.GetNoteGroupForPitch(pitch)}});
  }
  return array;
}

Json GroupsOf(NoteNameList const& notes) {
  Json array = Json::array();
  for (int i = 0; i < notes.CountNoteGroups(); ++i) {
    NoteGroup const group = notes.GetNoteGroup(i);
    Json pitches = Json::array();
    for (unsigned char const pitch : group.pitches) {
      pitches.push_back(pitch);
    }
    array.push_back({{"id", group.id}, {"name", group.name.string()}, {"pitches", pitches}});
  }
  return array;
}

Json ControlJson(Control const& control) {
  static constexpr char const* kTypes[] = {"7bit", "14bit", "RPN", "NRPN"};
  Json values = Json::array();
  for (int i = 0; i < control.CountValueNames(); ++i) {
    auto const [number, name] = control.GetValueName(i);
    values.push_back({{"number", number}, {"name", name.string()}});
  }
  bool const hasRange = control.HasValueRange();
  return {{"type", kTypes[control.GetType() & 3]},
          {"number", control.GetNumber()},
          {"name", control.GetName().string()},
          {"min", hasRange ? Json(control.GetMinValue()) : Json()},
          {"max", hasRange ? Json(control.GetMaxValue()) : Json()},
          {"default", control.HasDefaultValue() ? Json(control.GetDefaultValue()) : Json()},
          {"units", control.HasUnits() ? Json(control.GetUnits().string()) : Json()},
          {"values", values}};
}

}  // namespace

std::string NamesJSON(Destination const& destination) {
  Json channels = Json::array();
  for (short channel = 0; channel < 16; ++channel) {
    channels.push_back(NameOrNull(destination.GetCurrentNameSet(channel)));
  }
  Names const names = destination.GetNames();
  return JsonText({{"destination", destination.GetName().string()},
                   {"uniqueID", destination.GetUniqueID()},
                   {"names", names.Exists() ? DocumentJson(names) : Json()},
                   {"mode", NameOrNull(destination.GetCurrentMode())},
                   {"channels", channels}});
}

std::string OffersJSON(std::vector<NameDocumentOffer> const& offers) {
  Json array = Json::array();
  for (NameDocumentOffer const& offer : offers) {
    bool const isForDevice = offer.names.GetType() != Names::kStandardModeNames;
    Json json = DocumentJson(offer.names);
    json["manufacturer"] = isForDevice ? Json(offer.manufacturer.string()) : Json();
    json["model"] = isForDevice ? Json(offer.model.string()) : Json();
    array.push_back(json);
  }
  return JsonText({{"documents", array}});
}

std::string ModesJSON(Destination const& destination) {
  Json array = Json::array();
  for (DestinationMode const& mode : ModesOf(destination)) {
    Json channels = Json::array();
    for (short channel = 0; channel < 16; ++channel) {
      channels.push_back(NameOrNull(mode.GetNameSet(channel)));
    }
    array.push_back({{"name", mode.GetName().string()},
                     {"current", mode == destination.GetCurrentMode()},
                     {"standard", mode.IsStandardMode()},
                     {"selectableWithMIDI", mode.SelectableWithMIDI()},
                     {"channels", channels}});
  }
  return JsonText({{"modes", array}});
}

std::string BanksJSON(std::vector<PatchBank> const& banks) {
  return BanksWith(
      banks, [](PatchBank const& bank, Json& json) { json["patchCount"] = bank.CountPatches(); });
}

std::string PatchesJSON(std::vector<PatchBank> const& banks) {
  return BanksWith(banks, [](PatchBank const& bank, Json& json) {
    json["patches"] = Json::array();
    for (Patch const& patch : PatchesOf(bank)) {
      json["patches"].push_back(PatchJson(patch));
    }
  });
}

std::string PatchJSON(Patch const& patch) {
  Json json = PatchJson(patch);
  json["bank"] = patch.GetBank().GetName().string();
  return JsonText(json);
}

std::string NoteJSON(int pitch, std::string const& name) {
  return JsonText({{"pitch", pitch}, {"name", name}});
}

std::string NotesJSON(Patch const& patch) {
  NoteNameList const notes = patch.GetNoteNames();
  return JsonText(
      {{"patch", PatchJson(patch)}, {"notes", NotesOf(notes)}, {"groups", GroupsOf(notes)}});
}

std::string ControlsJSON(Patch const& patch) {
  ControlList const list = patch.GetControlNames();
  Json controls = Json::array();
  for (int i = 0; i < list.CountControls(); ++i) {
    controls.push_back(ControlJson(list.GetControl(i)));
  }
  return JsonText({{"patch", PatchJson(patch)}, {"controls", controls}});
}

}  // namespace Ostinet::Tool

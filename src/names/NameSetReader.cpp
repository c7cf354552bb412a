// SPDX-License-Identifier: MIT
//
// The reader of name documents: modes, name sets, banks and patches.
#include "names/DocumentNames.h"
#include "names/MessageForms.h"
#include "names/NameDocumentReader.h"
#include "names/NamedLists.h"

namespace Ostinet::Impl {

using namespace DocumentNames;

namespace {

constexpr unsigned kChannels = 16;
constexpr unsigned kMaxProgram = 127;

// Documents count channels from 1.
bool ReadChannel(DocumentCursor const& cursor, int& channel) {
  unsigned number = 0;
  if (!cursor.ReadRequired(kChannel, 1, kChannels, number)) {
    return false;
  }
  channel = static_cast<int>(number) - 1;
  return true;
}

void ReadModeCommands(DocumentCursor& cursor, MIDICommandList& commands) {
  if (cursor.Down(kMIDICommands)) {
    ReadCommands(cursor, SysexInCommands::kAllowed, commands);
    cursor.Up();
    cursor.PassOverOthers();
  }
}

void ReadAvailableChannels(DocumentCursor& cursor, DestNameSetImpl& nameSet) {
  for (; cursor.Down(kAvailableChannel); cursor.Up()) {
    int channel = 0;
    if (ReadChannel(cursor, channel)) {
      bool isAvailable = true;
      cursor.ReadOptional(kAvailable, XMLLib::kBoolAttribute, isAvailable);
      nameSet.SetChannelAvailable(channel, isAvailable);
    }
  }
}

}  // namespace

// `has` tells whether a channel has its name set, `assign` gives it one: the first assignment of a
// channel stands.
template <class HasNameSet, class Assign>
void NameDocumentReader::ReadAssignments(DocumentCursor& cursor, HasNameSet const& has,
                                         Assign const& assign) {
  for (; cursor.Down(kChannelNameSetAssign); cursor.Up()) {
    UString name;
    int channel = 0;
    if (!cursor.ReadRequired(kNameSet, name) || !ReadChannel(cursor, channel)) {
      continue;
    }
    if (has(channel)) {
      cursor.PassOver("is passed over: an assignment of this channel stands before it");
      continue;
    }
    RCPtrMT<DestNameSetImpl> const nameSet = DemandNameSet(name);
    cursor.PassOverIf([nameSet] { return nameSet->GetBanks().empty(); },
                      "names a set of names that has no banks");
    assign(channel, nameSet);
  }
}

void NameDocumentReader::ReadModeContent(DocumentCursor& cursor, DestModeImpl& mode) {
  for (; cursor.Down(); cursor.Up()) {
    ReadModeChild(cursor, mode);
  }
}

void NameDocumentReader::ReadModeChild(DocumentCursor& cursor, DestModeImpl& mode) {
  if (cursor.IsAt(kDeviceModeEnable)) {
    ReadModeCommands(cursor, mode.EnableCommands());
  } else if (cursor.IsAt(kDeviceModeDisable)) {
    ReadModeCommands(cursor, mode.DisableCommands());
  } else if (cursor.IsAt(kChannelNameSetAssignments)) {
    ReadAssignments(
        cursor, [&](int channel) { return mode.GetNameSet(channel) != nullptr; },
        [&](int channel, RCPtrMT<DestNameSetImpl> const& nameSet) {
          mode.SetNameSet(channel, nameSet);
        });
  } else if (!mode.IsStandard()) {
    cursor.PassOver("is not read in a mode of the device's own");
  } else if (cursor.IsAt(kChannelNameSet)) {
    ReadNameSet(cursor);
  } else {
    ReadDeviceList(cursor);
  }
}

void NameDocumentReader::ReadNameSet(DocumentCursor& cursor) {
  UString name;
  if (!cursor.ReadRequired(kName, name)) {
    return;
  }
  RCPtrMT<DestNameSetImpl> const nameSet = DemandNameSet(name);
  if (nameSet->GetBanks().empty()) {
    ReadNameSetContent(cursor, nameSet);
  } else {
    cursor.PassOver("is not read, as a set of this name stands before it");
  }
}

void NameDocumentReader::ReadNameSetContent(DocumentCursor& cursor,
                                            RCPtrMT<DestNameSetImpl> const& nameSet) {
  for (; cursor.Down(); cursor.Up()) {
    if (cursor.IsAt(kAvailableForChannels)) {
      ReadAvailableChannels(cursor, *nameSet);
    } else if (cursor.IsAt(kPatchBank)) {
      ReadBank(cursor, *nameSet);
    } else if (auto const notes = ReadNotesInPlace(cursor)) {
      uses.nameSetNotes[nameSet] = notes;
    } else if (auto const controls = ReadControlsInPlace(cursor)) {
      uses.nameSetControls[nameSet] = controls;
    } else {
      cursor.PassOver("is not read here");
    }
  }
}

void NameDocumentReader::ReadBank(DocumentCursor& cursor, DestNameSetImpl& nameSet) {
  RCPtrMT<PatchBankImpl> const bank(new PatchBankImpl(cursor.ReadText(kName)));
  nameSet.AddBank(bank);
  bool hasList = false;
  for (; cursor.Down(); cursor.Up()) {
    UString name;
    if (cursor.IsAt(kMIDICommands)) {
      ReadCommands(cursor, SysexInCommands::kAllowed, bank->Commands());
    } else if (hasList) {
      cursor.PassOver("is passed over: the bank has its list");
    } else if (cursor.IsAt(kPatchNameList)) {
      hasList = true;
      ReadInlinePatchList(cursor, bank);
    } else if (cursor.IsAt(kUsesPatchNameList)) {
      if (cursor.ReadRequired(kName, name)) {
        hasList = true;
        auto const list =
            DemandByName(patchLists_, name, [&] { return new PatchNameListData(name); });
        list->banks.push_back(bank);
        cursor.PassOverIf([list] { return list->patches.empty(); }, "names a list without patches");
      }
    } else {
      cursor.PassOver("is not read here");
    }
  }
}

// Such a list is no other bank's, whatever its name.
void NameDocumentReader::ReadInlinePatchList(DocumentCursor& cursor,
                                             RCPtrMT<PatchBankImpl> const& bank) {
  PatchNameListData list(cursor.ReadText(kName));
  list.banks.push_back(bank);
  ReadPatches(cursor, list);
  list.Attach(false, uses);
}

void NameDocumentReader::ReadPatches(DocumentCursor& cursor, PatchNameListData& list) {
  for (; cursor.Down(kPatch); cursor.Up()) {
    ReadPatch(cursor, list);
  }
}

void NameDocumentReader::ReadPatch(DocumentCursor& cursor, PatchNameListData& list) {
  UString name;
  UString number;
  if (!cursor.ReadRequired(kName, name) || !cursor.ReadRequired(kNumber, number)) {
    return;
  }
  RCPtrMT<PatchImpl> const patch(new PatchImpl(number, name));
  list.patches.push_back(patch);
  unsigned program = 0;
  if (cursor.ReadOptional(kProgramChange, kMaxProgram, program)) {
    patch->Commands().AddTwoBytes(kProgramChangeStatus, static_cast<unsigned char>(program));
  }
  for (; cursor.Down(); cursor.Up()) {
    if (cursor.IsAt(kPatchMIDICommands)) {
      ReadCommands(cursor, SysexInCommands::kPassedOver, patch->Commands());
    } else if (cursor.IsAt(kChannelNameSetAssignments)) {
      ReadAssignments(
          cursor,
          [&](int channel) {
            auto const* const nameSets = patch->GetChannelNameSets();
            return nameSets != nullptr && (*nameSets)[static_cast<std::size_t>(channel)];
          },
          [&](int channel, RCPtrMT<DestNameSetImpl> const& nameSet) {
            patch->DemandChannelNameSets()[static_cast<std::size_t>(channel)] = nameSet;
          });
    } else if (auto const notes = ReadNotesInPlace(cursor)) {
      uses.patchNotes[patch] = notes;
    } else if (auto const controls = ReadControlsInPlace(cursor)) {
      uses.patchControls[patch] = controls;
    } else {
      cursor.PassOver("is not read here");
    }
  }
}

RCPtrMT<DestNameSetImpl> NameDocumentReader::DemandNameSet(UString const& name) {
  return DemandByName(tree.nameSets, name,
                      [&] { return new DestNameSetImpl(owner_.destination, name); });
}

}  // namespace Ostinet::Impl

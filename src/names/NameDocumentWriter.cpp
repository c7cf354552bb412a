// SPDX-License-Identifier: MIT
#include "names/NameDocumentWriter.h"

#include <algorithm>

#include "model/DeviceImpl.h"
#include "model/EntityImpl.h"
#include "model/PropertyKeys.h"
#include "names/CommandWriter.h"
#include "names/DestNameSetImpl.h"
#include "names/DocumentNames.h"
#include "names/NameListWriter.h"
#include "ostinet/core/XML.h"

namespace Ostinet::Impl {

using namespace DocumentNames;

namespace {

UString DeviceNameOf(DestinationImpl const& destination) {
  EntityImpl const* const entity = destination.GetEntity();
  DeviceImpl const* const device = entity != nullptr ? entity->GetDevice() : nullptr;
  return device != nullptr ? device->GetName() : destination.GetName();
}

// A document from its mark to the element of the device, which both stay open.
void StartDocument(XMLLib::Writer& writer, XMLLib::Name const& deviceElement,
                   WrittenFor const& owner) {
  writer.ProcessingInstruction(kMarkTarget, kMarkData);
  writer.StartElement(kDocument);
  writer.Element(kAuthor, owner.author);
  writer.StartElement(deviceElement);
  writer.StartElement(kDevice);
  writer.Attribute(kName, owner.deviceName);
  UString uniqueID;
  uniqueID.Stream() << owner.uniqueID;
  writer.Attribute(kUniqueID, uniqueID);
  writer.EndElement();
}

void WriteNameSets(XMLLib::Writer& writer, ChannelNameSets const& nameSets) {
  writer.StartElement(kChannelNameSetAssignments);
  for (std::size_t channel = 0; channel < nameSets.size(); ++channel) {
    if (nameSets[channel]) {
      writer.StartElement(kChannelNameSetAssign);
      UString number;
      number.Stream() << static_cast<unsigned>(channel + 1);
      writer.Attribute(kChannel, number);
      writer.Attribute(kNameSet, nameSets[channel]->GetName());
      writer.EndElement();
    }
  }
  writer.EndElement();
}

// A program change alone is an attribute. Anything else becomes an element that reading passes over
// in a patch: documents that hosts keep have always been so, and a patch whose bank select came
// back would be found under other numbers than the host stored.
void WritePatchCommands(XMLLib::Writer& writer, MIDICommandList const& commands) {
  bool const isProgramAlone = commands.PendingProgram() != MIDICommandList::kNone &&
                              commands.PendingMSB() == MIDICommandList::kNone &&
                              commands.PendingLSB() == MIDICommandList::kNone;
  if (isProgramAlone) {
    UString program;
    program.Stream() << unsigned{commands.PendingProgram()};
    writer.Attribute(kProgramChange, program);
  } else if (!commands.IsEmpty()) {
    WriteCommands(writer, kMIDICommands, commands);
  }
}

void WritePatch(XMLLib::Writer& writer, PatchImpl const& patch, NameListRegistry& registry) {
  writer.StartElement(kPatch);
  writer.Attribute(kNumber, patch.GetNumber());
  writer.Attribute(kName, patch.GetName());
  WritePatchCommands(writer, patch.Commands());
  if (ChannelNameSets const* const nameSets = patch.GetChannelNameSets()) {
    WriteNameSets(writer, *nameSets);
  }
  if (NoteNameTable const* const notes = patch.GetNoteNames().get()) {
    if (notes->IsShared()) {
      writer.Element(kUsesNoteNameList, kName, registry.notes.NameOf(*notes));
    } else {
      WriteNotes(writer, notes->GetName(), *notes);
    }
  }
  // The format has no list without a control, and one that says nothing reads as none.
  ControlTable const* const controls = patch.GetControls().get();
  if (controls != nullptr && HasControlsToWrite(*controls)) {
    if (controls->IsShared()) {
      writer.Element(kUsesControlNameList, kName, registry.controls.NameOf(*controls));
    } else {
      WriteControls(writer, controls->GetName(), *controls, registry);
    }
  }
  writer.EndElement();
}

void WriteSharedLists(XMLLib::Writer& writer, NameListRegistry& registry) {
  for (auto const& entry : registry.notes.Entries()) {
    WriteNotes(writer, entry.name, *entry.list);
  }
  for (auto const& entry : registry.controls.Entries()) {
    WriteControls(writer, entry.name, *entry.list, registry);
  }
  for (auto const& entry : registry.values.Entries()) {
    WriteValues(writer, entry.name, *entry.list);
  }
}

// Names that a reader would take for the same one are kept apart.
std::vector<std::pair<WrittenBank, PatchBankImpl const*>> NameLists(
    std::vector<PatchBankImpl const*> const& banks) {
  std::vector<std::pair<WrittenBank, PatchBankImpl const*>> named;
  for (PatchBankImpl const* const bank : banks) {
    UString const name = MakeUniqueName(bank->GetName(), [&](UString const& taken) {
      return std::any_of(named.begin(), named.end(), [&](auto const& each) {
        return each.first.listName.equal(taken, UString::kCatalogKey);
      });
    });
    named.push_back({{name, bank->GetBankName()}, bank});
  }
  return named;
}

}  // namespace

WrittenFor::WrittenFor(DestinationImpl const& destination, UString author_)
    : author(std::move(author_)),
      deviceName(DeviceNameOf(destination)),
      uniqueID(destination.GetInt(Keys::kUniqueID, 0)) {}

void WriteStandardModeMaster(File const& file, WrittenFor const& owner, UString const& modeName) {
  XMLLib::Writer writer(file, kDocument, kPublicID, kSystemID);
  StartDocument(writer, kMasterDeviceNames, owner);
  writer.Element(kSupportsStandardDeviceMode, kName, modeName);
  writer.Close();
}

std::vector<WrittenBank> WriteBanks(File const& file, WrittenFor const& owner,
                                    std::vector<PatchBankImpl const*> const& banks) {
  XMLLib::Writer writer(file, kDocument, kPublicID, kSystemID);
  StartDocument(writer, kExtendingDeviceNames, owner);
  NameListRegistry registry;
  std::vector<WrittenBank> written;
  for (auto const& [names, bank] : NameLists(banks)) {
    writer.StartElement(kPatchNameList);
    writer.Attribute(kName, names.listName);
    for (RCPtrMT<PatchImpl> const& patch : bank->GetPatches()) {
      WritePatch(writer, *patch, registry);
    }
    writer.EndElement();
    written.push_back(names);
  }
  WriteSharedLists(writer, registry);
  writer.Close();
  std::sort(written.begin(), written.end(),
            [](WrittenBank const& a, WrittenBank const& b) { return a.listName < b.listName; });
  return written;
}

}  // namespace Ostinet::Impl

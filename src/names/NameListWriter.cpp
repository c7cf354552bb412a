// SPDX-License-Identifier: MIT
#include "names/NameListWriter.h"

#include <algorithm>

#include "names/DocumentNames.h"

namespace Ostinet::Impl {

namespace {

using namespace DocumentNames;

void WriteNumber(XMLLib::Writer& writer, XMLLib::Name const& attribute, unsigned number) {
  UString text;
  text.Stream() << number;
  writer.Attribute(attribute, text);
}

// The format allows no "+" here, so 1e+06 loses the one in its exponent.
void WriteNumber(XMLLib::Writer& writer, XMLLib::Name const& attribute, double number) {
  UString text;
  text.Stream() << number;
  if (auto const plus = text.find(u'+'); plus != UString::npos) {
    text.erase(plus, 1);
  }
  writer.Attribute(attribute, text);
}

void StartList(XMLLib::Writer& writer, XMLLib::Name const& element, UString const& name) {
  writer.StartElement(element);
  if (!name.empty()) {
    writer.Attribute(kName, name);
  }
}

void WriteNumberAndName(XMLLib::Writer& writer, XMLLib::Name const& element, unsigned number,
                        UString const& name) {
  writer.StartElement(element);
  WriteNumber(writer, kNumber, number);
  writer.Attribute(kName, name);
  writer.EndElement();
}

// True if anything was written.
bool WriteNoteGroups(XMLLib::Writer& writer, NoteNameTable const& table) {
  bool wroteAny = false;
  for (NoteGroupEntry const& group : table.GetGroups()) {
    if (group.inherited) {
      continue;
    }
    wroteAny = true;
    writer.StartElement(kNoteGroup);
    writer.Attribute(kName, group.name);
    for (unsigned char const pitch : group.pitches) {
      NoteEntry const* const note = table.FindNote(pitch);
      WriteNumberAndName(writer, kNote, pitch, note != nullptr ? note->name : UString());
    }
    writer.EndElement();
  }
  return wroteAny;
}

void WriteRange(XMLLib::Writer& writer, Control const& control, NameListRegistry& registry) {
  writer.StartElement(kValues);
  WriteNumber(writer, kMin, control.GetMinValue());
  WriteNumber(writer, kMax, control.GetMaxValue());
  if (control.HasDefaultValue()) {
    WriteNumber(writer, kDefault, control.GetDefaultValue());
  }
  if (control.HasUnits()) {
    writer.Attribute(kUnits, control.GetUnits());
  }
  if (control.CountValueNames() > 0) {
    ValueListImpl const& values = *ControlParts::ValueNames(control);
    if (values.IsNamed()) {
      writer.Element(kUsesValueNameList, kName, registry.values.NameOf(values));
    } else {
      WriteValues(writer, values.GetName(), values);
    }
  }
  writer.EndElement();
}

void WriteControl(XMLLib::Writer& writer, Control const& control, NameListRegistry& registry) {
  writer.StartElement(kControl);
  writer.Attribute(kType, kControlTypes, control.GetType());
  WriteNumber(writer, kNumber, unsigned{control.GetNumber()});
  writer.Attribute(kName, control.GetName());
  if (control.HasValueRange()) {
    WriteRange(writer, control, registry);
  }
  writer.EndElement();
}

}  // namespace

void WriteNotes(XMLLib::Writer& writer, UString const& name, NoteNameTable const& table) {
  StartList(writer, kNoteNameList, name);
  bool wroteAny = WriteNoteGroups(writer, table);
  for (NoteEntry const& note : table.GetNotes()) {
    if (!note.inherited && note.group == 0) {
      wroteAny = true;
      WriteNumberAndName(writer, kNote, note.pitch, note.name);
    }
  }
  for (unsigned char const pitch : table.GetHiddenPitches()) {
    // A pitch that was put into a group since has an entry, which alone must be read again.
    if (table.FindNote(pitch) == nullptr) {
      wroteAny = true;
      WriteNumberAndName(writer, kNote, pitch, UString());
    }
  }
  if (!wroteAny) {
    // The format wants something in a list. A group of no notes reads as nothing.
    writer.Element(kNoteGroup);
  }
  writer.EndElement();
}

bool HasControlsToWrite(ControlTable const& table) {
  auto const& controls = table.GetControls();
  return !table.GetHidden().empty() ||
         std::any_of(controls.begin(), controls.end(),
                     [](ControlEntry const& entry) { return !entry.inherited; });
}

void WriteControls(XMLLib::Writer& writer, UString const& name, ControlTable const& table,
                   NameListRegistry& registry) {
  StartList(writer, kControlNameList, name);
  for (ControlEntry const& entry : table.GetControls()) {
    if (!entry.inherited) {
      WriteControl(writer, entry.control, registry);
    }
  }
  for (ControlKey const& key : table.GetHidden()) {
    WriteControl(writer, Control(key.type, key.number, UString()), registry);
  }
  writer.EndElement();
}

void WriteValues(XMLLib::Writer& writer, UString const& name, ValueListImpl const& list) {
  StartList(writer, kValueNameList, name);
  for (auto const& [number, valueName] : list.GetValues()) {
    WriteNumberAndName(writer, kValue, number, valueName);
  }
  writer.EndElement();
}

}  // namespace Ostinet::Impl

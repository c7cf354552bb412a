// SPDX-License-Identifier: MIT
//
// The reader of name documents: lists of notes, controls and values.
#include <limits>

#include "names/DocumentNames.h"
#include "names/NameDocumentReader.h"
#include "names/NamedLists.h"

namespace Ostinet::Impl {

using namespace DocumentNames;

namespace {

constexpr unsigned kMaxPitch = 127;
constexpr char16_t kFirstNoPitch = 128;
constexpr unsigned kMaxNumber = std::numeric_limits<unsigned short>::max();

// A number from 0 to 127, or else the code of the text's first character. So "C3" is pitch 67: no
// note name was meant by those who first wrote this, but users' edits are stored under such
// pitches.
bool ReadPitch(DocumentCursor const& cursor, unsigned char& pitch) {
  UString const text = cursor.ReadText(kNumber);
  unsigned number = 0;
  if (ReadUnsigned(text, kMaxPitch, number)) {
    pitch = static_cast<unsigned char>(number);
    return true;
  }
  if (text.empty() || text[0] >= kFirstNoPitch) {
    cursor.PassOver("is passed over: it has no number");
    return false;
  }
  pitch = static_cast<unsigned char>(text[0]);
  cursor.PassOver("has no number from 0 to 127, and the code of its first character is taken");
  return true;
}

void ReadNote(DocumentCursor const& cursor, NoteNameData& list, int group) {
  UString name;
  unsigned char pitch = 0;
  if (cursor.ReadRequired(kName, name) && ReadPitch(cursor, pitch)) {
    list.SetNote(pitch, name, group);
  }
}

Control MakeControl(ControlKey key, UString const& name, double min, double max, bool hasDefault,
                    double defaultValue, UString const& units) {
  return hasDefault ? Control(key.type, key.number, name, min, max, defaultValue, units)
                    : Control(key.type, key.number, name, min, max, units);
}

}  // namespace

RCPtrMT<NoteNameData> NameDocumentReader::ReadNotesInPlace(DocumentCursor& cursor) {
  UString name;
  if (cursor.IsAt(kNoteNameList)) {
    RCPtrMT<NoteNameData> const list(new NoteNameData(cursor.ReadText(kName), false));
    ReadNotes(cursor, *list);
    return list;
  }
  if (!cursor.IsAt(kUsesNoteNameList) || !cursor.ReadRequired(kName, name)) {
    return {};
  }
  auto const list = DemandByName(noteLists_, name, [&] { return new NoteNameData(name, true); });
  cursor.PassOverIf([list] { return list->notes.empty(); }, "names a list without notes");
  return list;
}

RCPtrMT<ControlNameData> NameDocumentReader::ReadControlsInPlace(DocumentCursor& cursor) {
  UString name;
  if (cursor.IsAt(kControlNameList)) {
    RCPtrMT<ControlNameData> const list(new ControlNameData(cursor.ReadText(kName), false));
    ReadControls(cursor, *list);
    return list;
  }
  if (!cursor.IsAt(kUsesControlNameList) || !cursor.ReadRequired(kName, name)) {
    return {};
  }
  auto const list =
      DemandByName(controlLists_, name, [&] { return new ControlNameData(name, true); });
  cursor.PassOverIf([list] { return list->controls.empty(); }, "names a list without controls");
  return list;
}

void NameDocumentReader::ReadNotes(DocumentCursor& cursor, NoteNameData& list) {
  for (; cursor.Down(); cursor.Up()) {
    if (cursor.IsAt(kNote)) {
      ReadNote(cursor, list, 0);
    } else if (cursor.IsAt(kNoteGroup)) {
      list.groupNames.push_back(cursor.ReadText(kName));
      int const group = static_cast<int>(list.groupNames.size());
      for (; cursor.Down(kNote); cursor.Up()) {
        ReadNote(cursor, list, group);
      }
    } else {
      cursor.PassOver("is not read here");
    }
  }
}

void NameDocumentReader::ReadControls(DocumentCursor& cursor, ControlNameData& list) {
  for (; cursor.Down(kControl); cursor.Up()) {
    ReadControl(cursor, list);
  }
}

void NameDocumentReader::ReadControl(DocumentCursor& cursor, ControlNameData& list) {
  UString name;
  unsigned number = 0;
  if (!cursor.ReadRequired(kName, name) || !cursor.ReadRequired(kNumber, 0, kMaxNumber, number)) {
    return;
  }
  ControlKey key{ControlType(0), static_cast<unsigned short>(number)};
  cursor.ReadOptional(kType, kControlTypes, key.type);
  Control control(key.type, key.number, name);
  if (list.controls.find(control) != list.controls.end()) {
    cursor.PassOver("is passed over: a control of its type and number stands before it");
    return;
  }
  if (cursor.Down(kValues)) {
    ReadRange(cursor, control);
    cursor.Up();
    cursor.PassOverOthers();
  }
  list.controls.insert(control);
}

void NameDocumentReader::ReadRange(DocumentCursor& cursor, Control& control) {
  double min = 0;
  double max = 0;
  if (!cursor.ReadRequired(kMin, min) || !cursor.ReadRequired(kMax, max)) {
    return;
  }
  double defaultValue = 0;
  bool const hasDefault = ReadDouble(cursor.ReadText(kDefault), defaultValue);
  control = MakeControl(ControlParts::KeyOf(control), control.GetName(), min, max, hasDefault,
                        defaultValue, cursor.ReadText(kUnits));
  if (!cursor.Down()) {
    return;
  }
  if (auto const values = ReadValueListInPlace(cursor)) {
    ControlParts::SetValueNames(control, values);
  }
  cursor.Up();
  cursor.PassOverOthers();
}

RCPtrMT<ValueListImpl> NameDocumentReader::ReadValueListInPlace(DocumentCursor& cursor) {
  UString name;
  if (cursor.IsAt(kValueNameList)) {
    RCPtrMT<ValueListImpl> const list(new ValueListImpl(cursor.ReadText(kName), false));
    ReadValues(cursor, *list);
    return list;
  }
  if (!cursor.IsAt(kUsesValueNameList)) {
    cursor.PassOver("is not read here");
    return {};
  }
  if (!cursor.ReadRequired(kName, name)) {
    return {};
  }
  auto const list = DemandByName(valueLists_, name, [&] { return new ValueListImpl(name, true); });
  cursor.PassOverIf([list] { return list->GetValues().empty(); }, "names a list without values");
  return list;
}

void NameDocumentReader::ReadValues(DocumentCursor& cursor, ValueListImpl& list) {
  for (; cursor.Down(kValue); cursor.Up()) {
    UString name;
    unsigned number = 0;
    if (cursor.ReadRequired(kName, name) && cursor.ReadRequired(kNumber, 0, kMaxNumber, number)) {
      list.Add(static_cast<unsigned short>(number), name);
    }
  }
}

}  // namespace Ostinet::Impl

// SPDX-License-Identifier: MIT
#include "names/CommandReader.h"

#include <algorithm>
#include <limits>

#include "names/DocumentNames.h"
#include "names/MessageForms.h"

namespace Ostinet::Impl {

namespace {

using namespace DocumentNames;

constexpr unsigned kMaxData = 127;
constexpr unsigned kMaxMilliseconds = std::numeric_limits<int>::max();

bool ReadData(DocumentCursor const& cursor, char const* attribute, unsigned char& data) {
  unsigned value = 0;
  if (!cursor.ReadRequired(attribute, 0, kMaxData, value)) {
    return false;
  }
  data = static_cast<unsigned char>(value);
  return true;
}

void ReadMessage(DocumentCursor const& cursor, MessageForm const& form, MIDICommandList& commands) {
  unsigned char first = form.control;
  unsigned char second = 0;
  if ((form.first != nullptr && !ReadData(cursor, form.first, first)) ||
      (form.second != nullptr && !ReadData(cursor, form.second, second))) {
    return;
  }
  bool const hasOneByte = form.first != nullptr && form.second == nullptr;
  if (hasOneByte) {
    commands.AddTwoBytes(form.status, first);
  } else {
    commands.AddThreeBytes(form.status, first, second);
  }
}

void ReadLocalControl(DocumentCursor const& cursor, MIDICommandList& commands) {
  bool isOn = false;
  if (!cursor.GetParser().ReadReqAttribute(kValue, kOnOff, isOn)) {
    cursor.PassOver("is passed over: its \"Value\" is neither on nor off");
    return;
  }
  commands.AddThreeBytes(kControlChangeStatus, kLocalControlNumber, isOn ? kLocalOn : 0);
}

// Two digits make a byte. Anything else is passed over, also between the two, but not the end of
// the text: half a byte there is dropped.
void ReadSysexText(UString const& text, MIDICommandList& commands) {
  int high = -1;
  for (char16_t const unit : text) {
    int const digit = HexadecimalDigit(unit);
    if (digit < 0) {
      continue;
    }
    if (high < 0) {
      high = digit;
    } else {
      commands.AddSysexByte(static_cast<unsigned char>(high * 16 + digit));
      high = -1;
    }
  }
}

unsigned char ReadSysexNumber(DocumentCursor const& cursor, XMLLib::Name const& attribute,
                              unsigned char number) {
  ReadHexadecimalByte(cursor.ReadText(attribute), number);
  return number;
}

void ReadSysexMarker(DocumentCursor const& cursor, MIDICommandList& commands) {
  bool const isDeviceID = cursor.IsAt(kSysExDeviceID);
  if (!isDeviceID && !cursor.IsAt(kSysExChannel)) {
    cursor.PassOver("is not read here");
    return;
  }
  commands.AddSysexMarker(isDeviceID ? SysexByte::kDeviceIDMarker : SysexByte::kChannelMarker,
                          ReadSysexNumber(cursor, kOffset, 0),
                          ReadSysexNumber(cursor, kMultiplier, 1));
}

void ReadSysex(DocumentCursor& cursor, MIDICommandList& commands) {
  commands.BeginSysex();
  for (;;) {
    ReadSysexText(cursor.GetParser().ReadText(), commands);
    if (!cursor.Down()) {
      return;
    }
    ReadSysexMarker(cursor, commands);
    cursor.Up();
  }
}

void ReadDelay(DocumentCursor const& cursor, MIDICommandList& commands) {
  unsigned milliseconds = 0;
  if (cursor.ReadRequired(kMilliseconds, 0, kMaxMilliseconds, milliseconds)) {
    commands.AddDelay(milliseconds);
  }
}

}  // namespace

void ReadCommands(DocumentCursor& cursor, SysexInCommands sysex, MIDICommandList& commands) {
  for (; cursor.Down(); cursor.Up()) {
    std::string const& element = cursor.GetParser().CurrentElement().Text();
    auto const* const form =
        std::find_if(std::begin(kMessageForms), std::end(kMessageForms),
                     [&](MessageForm const& each) { return each.element == element; });
    if (form != std::end(kMessageForms)) {
      ReadMessage(cursor, *form, commands);
    } else if (cursor.IsAt(kLocalControl)) {
      ReadLocalControl(cursor, commands);
    } else if (cursor.IsAt(kMIDIDelay)) {
      ReadDelay(cursor, commands);
    } else if (cursor.IsAt(kSysEx) && sysex == SysexInCommands::kAllowed) {
      ReadSysex(cursor, commands);
    } else {
      cursor.PassOver(cursor.IsAt(kSysEx) ? "is not read in the commands of a patch"
                                          : "is not read here");
    }
  }
}

}  // namespace Ostinet::Impl

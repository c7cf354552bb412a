// SPDX-License-Identifier: MIT
#include "names/CommandWriter.h"

#include <algorithm>
#include <string>

#include "names/DocumentNames.h"
#include "names/MessageForms.h"

namespace Ostinet::Impl {

namespace {

using namespace DocumentNames;

constexpr unsigned long long kNanosPerMillisecond = 1'000'000;
constexpr unsigned char kFirstOn = 64;
constexpr unsigned char kBankMSB = 0;
constexpr unsigned char kBankLSB = 32;

void WriteNumber(XMLLib::Writer& writer, XMLLib::Name const& attribute, unsigned long long number) {
  UString text;
  text.Stream() << number;
  writer.Attribute(attribute, text);
}

MessageForm const* FindForm(unsigned char const* message) {
  auto const* const form = std::find_if(
      std::begin(kMessageForms), std::end(kMessageForms), [&](MessageForm const& each) {
        return each.status == message[0] && (each.first != nullptr || each.control == message[1]);
      });
  return form == std::end(kMessageForms) ? nullptr : form;
}

// A message that no form fits is left out.
void WriteMessage(XMLLib::Writer& writer, unsigned char const* message) {
  if (message[0] == kControlChangeStatus && message[1] == kLocalControlNumber) {
    writer.StartElement(kLocalControl);
    writer.Attribute(kValue, kOnOff, message[2] >= kFirstOn);
    writer.EndElement();
    return;
  }
  MessageForm const* const form = FindForm(message);
  if (form == nullptr) {
    return;
  }
  writer.StartElement(XMLLib::Name(std::string(form->element)));
  if (form->first != nullptr) {
    WriteNumber(writer, form->first, message[1]);
  }
  if (form->second != nullptr) {
    WriteNumber(writer, form->second, message[2]);
  }
  writer.EndElement();
}

// Two upper-case digits.
UString Hexadecimal(unsigned char byte) {
  constexpr char kDigits[] = "0123456789ABCDEF";
  char const digits[] = {kDigits[byte >> 4], kDigits[byte & 0xF]};
  return UString(digits, sizeof digits, UString::kASCII);
}

void WriteSysexByte(XMLLib::Writer& writer, SysexByte const& byte) {
  if (!byte.IsMarker()) {
    writer.Write(Hexadecimal(byte.value));
    return;
  }
  bool const isDeviceID = byte.value == SysexByte::kDeviceIDMarker;
  writer.StartElement(isDeviceID ? kSysExDeviceID : kSysExChannel);
  writer.Attribute(kOffset, Hexadecimal(byte.offset));
  writer.Attribute(kMultiplier, Hexadecimal(byte.multiplier));
  writer.EndElement();
}

void WriteSysex(XMLLib::Writer& writer, MIDICommandWalk& walk) {
  writer.StartElement(kSysEx);
  writer.SetMode(XMLLib::Writer::kOnOneLine);
  SysexByte byte;
  for (bool isFirst = true; walk.NextSysexByte(byte); isFirst = false) {
    if (!isFirst) {
      writer.Write(" ");
    }
    WriteSysexByte(writer, byte);
  }
  writer.EndElement();
  writer.ResetMode();
}

void WriteControlChange(XMLLib::Writer& writer, unsigned char control, unsigned char value) {
  if (value != MIDICommandList::kNone) {
    unsigned char const message[] = {kControlChangeStatus, control, value};
    WriteMessage(writer, message);
  }
}

void WritePending(XMLLib::Writer& writer, MIDICommandList const& commands) {
  WriteControlChange(writer, kBankMSB, commands.PendingMSB());
  WriteControlChange(writer, kBankLSB, commands.PendingLSB());
  if (commands.PendingProgram() != MIDICommandList::kNone) {
    unsigned char const message[] = {kProgramChangeStatus, commands.PendingProgram()};
    WriteMessage(writer, message);
  }
}

void WriteScript(XMLLib::Writer& writer, MIDICommandList const& commands) {
  for (MIDICommandWalk walk(commands); walk.Next();) {
    switch (walk.Item().kind) {
      case MIDICommandItem::kDelay:
        writer.StartElement(kMIDIDelay);
        WriteNumber(writer, kMilliseconds,
                    MIDITimeToNanoseconds(walk.Item().delay).Value() / kNanosPerMillisecond);
        writer.EndElement();
        break;
      case MIDICommandItem::kMessage:
        WriteMessage(writer, walk.Message());
        break;
      case MIDICommandItem::kSysex:
        WriteSysex(writer, walk);
        break;
    }
  }
}

}  // namespace

void WriteCommands(XMLLib::Writer& writer, XMLLib::Name const& element,
                   MIDICommandList const& commands) {
  writer.StartElement(element);
  if (commands.Bytes().empty()) {
    WritePending(writer, commands);
  } else {
    WriteScript(writer, commands);
  }
  writer.EndElement();
}

}  // namespace Ostinet::Impl

// SPDX-License-Identifier: MIT
#pragma once

#include <string_view>

namespace Ostinet::Impl {

/// How a channel message stands in a document: as an element of its own, with a data byte of 0 to
/// 127 in each attribute.
struct MessageForm {
  std::string_view element;
  unsigned char status;   ///< channel 0
  char const* first;      ///< attribute of the first data byte; null if `control` is it
  char const* second;     ///< attribute of the second, or null
  unsigned char control;  ///< the first data byte of a message without attributes
};

inline constexpr unsigned char kControlChangeStatus = 0xB0;
inline constexpr unsigned char kProgramChangeStatus = 0xC0;
inline constexpr unsigned char kLocalControlNumber = 122;
inline constexpr unsigned char kLocalOn = 127;

// The reader and the writer both walk this table, so a form that one knows the other knows too;
// the writer takes the first row that fits. The pitch bend has one data byte, because that is what
// documents in use have and hosts send on. "LocalControl", whose value is a word, is told apart
// from the table.
inline constexpr MessageForm kMessageForms[] = {
    {"NoteOff", 0x80, "Note", "Velocity", 0},
    {"NoteOn", 0x90, "Note", "Velocity", 0},
    {"PolyKeyPressure", 0xA0, "Note", "Pressure", 0},
    {"AllSoundOff", 0xB0, nullptr, nullptr, 120},
    {"ResetAllControllers", 0xB0, nullptr, nullptr, 121},
    {"AllNotesOff", 0xB0, nullptr, nullptr, 123},
    {"OmniOff", 0xB0, nullptr, nullptr, 124},
    {"OmniOn", 0xB0, nullptr, nullptr, 125},
    {"MonoMode", 0xB0, nullptr, nullptr, 126},
    {"PolyMode", 0xB0, nullptr, nullptr, 127},
    {"ControlChange", 0xB0, "Control", "Value", 0},
    {"ProgramChange", 0xC0, "Number", nullptr, 0},
    {"ChannelKeyPressure", 0xD0, "Pressure", nullptr, 0},
    {"PitchBendChange", 0xE0, "Value", nullptr, 0},
};

}  // namespace Ostinet::Impl

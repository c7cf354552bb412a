// SPDX-License-Identifier: MIT
#include "MessageText.h"

#include <algorithm>
#include <charconv>
#include <iterator>

#include "Messages.h"

namespace Ostinet::Tool {
namespace {

constexpr size_t kNameWidth = 18;
constexpr size_t kMaxSysexBytesShown = 24;

constexpr std::string_view kNoteNames[] = {"C",  "C#", "D",  "D#", "E",  "F",
                                           "F#", "G",  "G#", "A",  "A#", "B"};

struct ControllerName {
  int number;
  std::string_view name;
};

constexpr ControllerName kControllers[] = {
    {0, "bank select"},
    {1, "modulation"},
    {2, "breath"},
    {4, "foot"},
    {5, "portamento time"},
    {6, "data entry"},
    {7, "volume"},
    {8, "balance"},
    {10, "pan"},
    {11, "expression"},
    {32, "bank select fine"},
    {38, "data entry fine"},
    {64, "sustain"},
    {65, "portamento"},
    {66, "sostenuto"},
    {67, "soft pedal"},
    {71, "resonance"},
    {72, "release time"},
    {73, "attack time"},
    {74, "cutoff"},
    {91, "reverb"},
    {93, "chorus"},
    {96, "data increment"},
    {97, "data decrement"},
    {98, "NRPN fine"},
    {99, "NRPN"},
    {100, "RPN fine"},
    {101, "RPN"},
    {120, "all sound off"},
    {121, "reset controllers"},
    {122, "local control"},
    {123, "all notes off"},
};

constexpr std::string_view kSystemNames[] = {
    "sysex",        "time code",    "song position",  "song select",
    "undefined F4", "undefined F5", "tune request",   "end of sysex",
    "clock",        "undefined F9", "start",          "continue",
    "stop",         "undefined FD", "active sensing", "reset"};

std::string Number(int value) { return std::to_string(value); }

std::string ControllerText(int number) {
  auto const found = std::find_if(std::begin(kControllers), std::end(kControllers),
                                  [&](ControllerName const& row) { return row.number == number; });
  return found == std::end(kControllers) ? Number(number)
                                         : Number(number) + " (" + std::string(found->name) + ")";
}

std::string NoteText(int note) { return "note " + Number(note) + " (" + NoteName(note) + ")"; }

int FourteenBits(Bytes const& message) { return message[1] | message[2] << 7; }

std::string Padded(std::string text, size_t width) {
  text.resize(std::max(width, text.size() + 1), ' ');
  return text;
}

std::string Line(std::string name, unsigned char status, std::string const& rest) {
  return Padded(std::move(name), kNameWidth) + Padded("ch " + Number((status & 0x0F) + 1), 7) +
         rest;
}

std::string DescribeChannelMessage(Bytes const& message) {
  unsigned char const status = message[0];
  switch (status & 0xF0) {
    case 0x80:
      return Line("note off", status, NoteText(message[1]) + " velocity " + Number(message[2]));
    case 0x90:
      return Line("note on", status, NoteText(message[1]) + " velocity " + Number(message[2]));
    case 0xA0:
      return Line("note pressure", status, NoteText(message[1]) + " value " + Number(message[2]));
    case 0xB0:
      return Line("control change", status,
                  "control " + ControllerText(message[1]) + " value " + Number(message[2]));
    case 0xC0:
      return Line("program change", status, "program " + Number(message[1]));
    case 0xD0:
      return Line("channel pressure", status, "value " + Number(message[1]));
    default:
      return Line("pitch bend", status, "value " + Number(FourteenBits(message) - 8192));
  }
}

std::string DescribeBytes(std::string name, Bytes const& bytes) {
  Bytes const shown(bytes.begin(), bytes.begin() + static_cast<std::ptrdiff_t>(std::min(
                                                       bytes.size(), kMaxSysexBytesShown)));
  return Padded(std::move(name), kNameWidth) + Number(static_cast<int>(bytes.size())) + " bytes  " +
         ToHex(shown) + (shown.size() < bytes.size() ? " ..." : "");
}

std::string DescribeSystemMessage(Bytes const& message) {
  std::string const name(kSystemNames[message[0] & 0x0F]);
  switch (message[0]) {
    case kSysexStart:
      return DescribeBytes(name, message);
    case 0xF1:
      return Padded(name, kNameWidth) + "piece " + Number(message[1] >> 4) + " value " +
             Number(message[1] & 0x0F);
    case 0xF2:
      return Padded(name, kNameWidth) + "beat " + Number(FourteenBits(message));
    case 0xF3:
      return Padded(name, kNameWidth) + "song " + Number(message[1]);
    default:
      return name;
  }
}

}  // namespace

std::string NoteName(int note) {
  return std::string(kNoteNames[note % 12]) + std::to_string(note / 12 - 1);
}

int ParseNote(std::string_view text) {
  constexpr std::string_view kLetters = "C D EF G A B";
  int base = 0;
  if (!text.empty()) {
    char const letter = text[0] >= 'a' ? static_cast<char>(text[0] - 'a' + 'A') : text[0];
    size_t const at = letter == ' ' ? std::string_view::npos : kLetters.find(letter);
    if (at != std::string_view::npos) {
      base = static_cast<int>(at) + 12;
      text.remove_prefix(1);
      if (!text.empty() && (text[0] == '#' || text[0] == 'b')) {
        base += text[0] == '#' ? 1 : -1;
        text.remove_prefix(1);
      }
    }
  }
  int number = 0;
  auto const [end, error] = std::from_chars(text.data(), text.data() + text.size(), number);
  if (error != std::errc() || end != text.data() + text.size() || number > 127) {
    return -1;
  }
  int const note = base == 0 ? number : base + number * 12;
  return note >= 0 && note <= 127 ? note : -1;
}

std::string DescribeMessage(Bytes const& message) {
  if (message.empty()) {
    return "nothing";
  }
  size_t const length = MessageLength(message[0]);
  bool const whole = message[0] == kSysexStart || (length != 0 && message.size() >= length);
  if (!whole) {
    return DescribeBytes("piece", message);
  }
  return message[0] < kSysexStart ? DescribeChannelMessage(message)
                                  : DescribeSystemMessage(message);
}

}  // namespace Ostinet::Tool

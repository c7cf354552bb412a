// SPDX-License-Identifier: MIT
#include "SendVerbs.h"

#include <algorithm>
#include <charconv>
#include <iterator>

#include "Errors.h"
#include "MessageText.h"
#include "Messages.h"
#include "SendWords.h"

namespace Ostinet::Tool {
namespace {

constexpr auto kPlain = VerbKind::kSevenBits;

constexpr Verb kVerbs[] = {
    // name, kind, status, least, most, note, default, help
    {"on", kPlain, 0x90, 2, 2, true, 0, "on NOTE VELOCITY     note on"},
    {"off", kPlain, 0x80, 1, 2, true, 64, "off NOTE [VELOCITY]  note off; velocity 64 if left out"},
    {"pp", kPlain, 0xA0, 2, 2, true, 0, "pp NOTE VALUE        pressure of one note"},
    {"cc", kPlain, 0xB0, 2, 2, false, 0, "cc NUMBER VALUE      control change"},
    {"pc", kPlain, 0xC0, 1, 1, false, 0, "pc NUMBER            program change, 0 to 127"},
    {"at", kPlain, 0xD0, 1, 1, false, 0, "at VALUE             pressure of the channel"},
    {"pb", VerbKind::kPitchBend, 0xE0, 1, 1, false, 0,
     "pb VALUE             pitch bend, 0 to 16383 with 8192 at rest, or signed from -8192 to "
     "+8191"},
    {"syx", VerbKind::kSysex, kSysexStart, 0, 0, false, 0,
     "syx HEX              sysex; F0 and F7 may be left out"},
    {"start", kPlain, 0xFA, 0, 0, false, 0,
     "start                the transport: also continue, stop,"},
    {"continue", kPlain, 0xFB, 0, 0, false, 0, ""},
    {"stop", kPlain, 0xFC, 0, 0, false, 0, ""},
    {"clock", kPlain, 0xF8, 0, 0, false, 0, "                     clock, and reset"},
    {"reset", kPlain, 0xFF, 0, 0, false, 0, ""},
    {"ch", VerbKind::kChannel, 0, 1, 1, false, 0,
     "ch NUMBER            the channel of what follows, 1 to 16\n"
     "  +MS                  the time of what follows, as --at"},
};

int ParseSevenBits(Verb const& verb, std::string const& word, bool isNote) {
  int const note = isNote ? ParseNote(word) : -1;
  return note >= 0 ? note : ParseNumber(word, 0, 127, "\"" + std::string(verb.name) + "\"");
}

int ParsePitchBend(std::string const& word) {
  bool const isSigned = word.front() == '+' || word.front() == '-';
  return isSigned ? 8192 + ParseNumber(word, -8192, 8191, "\"pb\"")
                  : ParseNumber(word, 0, 16383, "\"pb\"");
}

}  // namespace

Verb const* FindVerb(std::string_view name) {
  auto const found = std::find_if(std::begin(kVerbs), std::end(kVerbs),
                                  [&](Verb const& verb) { return verb.name == name; });
  return found == std::end(kVerbs) ? nullptr : found;
}

bool LooksLikeNumber(std::string_view word) {
  return !word.empty() && word.size() <= 3 &&
         std::all_of(word.begin(), word.end(), [](char c) { return c >= '0' && c <= '9'; });
}

Bytes MakeVerbMessage(Verb const& verb, std::vector<std::string> const& numbers,
                      unsigned char channel) {
  bool const onChannel = verb.status < kSysexStart;
  Bytes message = {static_cast<unsigned char>(verb.status | (onChannel ? channel : 0))};
  if (verb.kind == VerbKind::kPitchBend) {
    int const value = ParsePitchBend(numbers.at(0));
    message.push_back(static_cast<unsigned char>(value & 0x7F));
    message.push_back(static_cast<unsigned char>(value >> 7));
    return message;
  }
  for (size_t i = 0; i < verb.maxNumbers; ++i) {
    int const value = i < numbers.size()
                          ? ParseSevenBits(verb, numbers[i], verb.firstIsNote && i == 0)
                          : verb.defaultNumber;
    message.push_back(static_cast<unsigned char>(value));
  }
  return message;
}

int ParseNumber(std::string_view text, int low, int high, std::string const& what) {
  std::string_view digits = text;
  if (digits.size() > 1 && digits[0] == '+') {
    digits.remove_prefix(1);
  }
  int value = 0;
  char const* const end = digits.data() + digits.size();
  auto const result = std::from_chars(digits.data(), end, value);
  if (result.ec != std::errc() || result.ptr != end || value < low || value > high) {
    throw UsageError(what + " takes a number from " + std::to_string(low) + " to " +
                     std::to_string(high) + ", not \"" + std::string(text) + "\"");
  }
  return value;
}

std::string SendVerbsHelp() {
  std::string text;
  for (Verb const& verb : kVerbs) {
    if (!verb.help.empty()) {
      text += "  " + std::string(verb.help) + "\n";
    }
  }
  return text;
}

}  // namespace Ostinet::Tool

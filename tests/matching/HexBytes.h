// SPDX-License-Identifier: MIT
#pragma once

#include <algorithm>
#include <sstream>
#include <string>

#include "ostinet/MatchData.h"
#include "support/Printers.h"

namespace Ostinet::Testing {

/// "00 4D 2A": bytes as tests write them; line breaks and runs of blanks count as one blank.
inline std::string ToHex(MatchData const& data) {
  constexpr char kDigits[] = "0123456789ABCDEF";
  std::string text;
  for (char const& byte : data) {
    auto const value = static_cast<unsigned char>(byte);
    text += {kDigits[value >> 4], kDigits[value & 15], ' '};
  }
  return text;
}

inline MatchData FromHex(std::string const& text) {
  std::istringstream stream(text);
  std::string bytes;
  for (std::string word; stream >> word;) {
    bytes += static_cast<char>(std::stoi(word, nullptr, 16));
  }
  MatchData data(bytes.size());
  std::copy(bytes.begin(), bytes.end(), data.begin());
  return data;
}

/// The text in the form of ToHex.
inline std::string Hex(std::string const& text) { return ToHex(FromHex(text)); }

inline MatchData FirstBytes(MatchData const& data, std::size_t count) {
  MatchData part(count);
  std::copy(data.begin(), data.begin() + count, part.begin());
  return part;
}

/// A source or destination, in each layout there is. The bytes are told in docs/references.md.
inline char const* const kExternalDestination =
    // Header: "Pad", a destination, of the machine's ports.
    "00 00 00 00  00 00 00 03  00 00 00 04  00 00 00 03  00 50 00 61 00 64 "
    // Section 1: unique ID 0x01020304, that of its port 0x0A0B0C0D, full name.
    "00 00 00 0D  00 00 00 00  01 02 03 04  0A 0B 0C 0D  01 "
    // Section 2: "Ac", "S", not direct, not software, General MIDI, not internal, slot.
    "00 00 00 2E  00 00 00 00  00 00 00 02 00 41 00 63  00 00 00 01 00 53  00 00 01 00 "
    "00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00";
inline char const* const kInternalSource =
    // Header: "FX", a source, of the plug-in engine.
    "00 00 00 00  00 00 00 04  00 00 00 03  00 00 00 02  00 46 00 58 "
    "00 00 00 0D  00 00 00 00  00 00 00 07  00 00 00 00  01 "
    // Section 2: no texts; direct, software, no General MIDI, internal; slot 1 to 6.
    "00 00 00 28  00 00 00 00  00 00 00 00  00 00 00 00  01 01 00 01 "
    "00 00 00 01 00 00 00 02 00 00 00 03 00 00 00 04 00 00 00 05 00 00 00 06";
inline char const* const kNameOnly =
    "00 00 00 00  00 00 00 00  00 00 00 04  00 00 00 02  00 41 00 42 "
    "00 00 00 04  00 00 00 00 "
    "00 00 00 0F  00 00 00 00  00 00 00 00  00 00 00 00  00 00 00";
inline char const* const kOlderSoftware =
    "00 00 00 00  00 00 00 02  00 00 00 03  00 00 00 01  00 53 "
    "00 00 00 0C  00 00 00 00  00 00 00 02  89 AB CD EF "
    "00 00 00 0F  00 00 00 00  00 00 00 00  00 00 00 00  01 01 00";
inline char const* const kOlderPort =
    "00 00 00 00  00 00 00 02  00 00 00 04  00 00 00 01  00 50 "
    "00 00 00 12  00 00 00 00  00 00 00 03  12 34  89 AB CD EF  FF FE  00 05 "
    "00 00 00 0F  00 00 00 00  00 00 00 00  00 00 00 00  01 00 00";
inline char const* const kOlderDevice =
    "00 00 00 00  00 00 00 02  00 00 00 04  00 00 00 01  00 44 "
    "00 00 00 1C  00 00 00 00  00 00 00 00  12 34  89 AB CD EF  FF FE  00 05 "
    "00 00 2A 00  00 00 00 1F  80 00 "
    "00 00 00 13  00 00 00 00  00 00 00 01 00 41  00 00 00 01 00 42  00 00 00";

inline char const* const kAllLayouts[] = {kExternalDestination, kInternalSource, kNameOnly,
                                          kOlderSoftware,       kOlderPort,      kOlderDevice};

}  // namespace Ostinet::Testing

// SPDX-License-Identifier: MIT
#pragma once

#include <cstddef>
#include <string>
#include <string_view>
#include <vector>

#include "HexBytes.h"

namespace Ostinet::Tool {

enum class VerbKind { kSevenBits, kPitchBend, kSysex, kChannel };

/// A word of `send` that makes a message from the numbers behind it.
struct Verb {
  std::string_view name;
  VerbKind kind;
  unsigned char status;  ///< without the channel
  size_t minNumbers;
  size_t maxNumbers;  ///< what is left out takes `defaultNumber`
  bool firstIsNote;   ///< the first may be a note's name
  unsigned char defaultNumber;
  std::string_view help;
};

/// The verb of that name, or null.
Verb const* FindVerb(std::string_view name);

/// Whether `word` can stand as a number behind an optional place.
bool LooksLikeNumber(std::string_view word);

/// The message of a verb. `numbers` are as many as the verb takes at least and at most.
/// `channel` from 0. Throws UsageError for a number out of range.
Bytes MakeVerbMessage(Verb const& verb, std::vector<std::string> const& numbers,
                      unsigned char channel);

/// A whole decimal number from `low` to `high`; throws UsageError that names `what` otherwise.
int ParseNumber(std::string_view text, int low, int high, std::string const& what);

}  // namespace Ostinet::Tool

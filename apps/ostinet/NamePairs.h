// SPDX-License-Identifier: MIT
#pragma once

#include <string>
#include <vector>

namespace Ostinet::Tool {

/// An input and an output of one thing, by their names.
struct NamePair {
  enum class Kind { kSame, kOpposing, kRelated };
  Kind kind = Kind::kSame;
  std::string common;  ///< what to call them together
  size_t source = 0;   ///< places in the lists
  size_t destination = 0;
};

/// Which belong together. Each is in one pair at most: those of the same name first, then those
/// that differ in "In" and "Out" alone, then those that share words.
std::vector<NamePair> PairNames(std::vector<std::string> const& sources,
                                std::vector<std::string> const& destinations);

/// "same", "opposing" or "related".
std::string KindText(NamePair::Kind kind);

}  // namespace Ostinet::Tool

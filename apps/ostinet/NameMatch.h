// SPDX-License-Identifier: MIT
#pragma once

#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace Ostinet::Tool {

/// Something that a user can name.
struct Candidate {
  std::string name;     ///< UTF-8
  int uniqueID = 0;     ///< 0 for what has none
  std::string where{};  ///< what tells it from others of its name, for people; may be empty
};

/// The place of the candidate that `wanted` means: the one of exactly this name, else the one whose
/// name is it but for case, else the only one that begins with it, else the only one that holds it,
/// both without regard to case. "#123" means the unique ID 123 where no name is meant. Throws
/// Failure where there is none or more than one, and then names the candidates; `kind` says in that
/// text what they are ("destination").
size_t MatchName(std::vector<Candidate> const& candidates, std::string const& wanted,
                 std::string const& kind);

/// The same, but nothing where none fits; more than one is still a Failure.
std::optional<size_t> FindName(std::vector<Candidate> const& candidates, std::string const& wanted,
                               std::string const& kind);

}  // namespace Ostinet::Tool

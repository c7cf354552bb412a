// SPDX-License-Identifier: MIT
#include "NameMatch.h"

#include "Errors.h"
#include "ostinet/core/UString.h"

namespace Ostinet::Tool {
namespace {

using Fits = bool (*)(UString const& name, UString const& wanted);

bool IsExactly(UString const& name, UString const& wanted) { return name == wanted; }

bool IsButForCase(UString const& name, UString const& wanted) {
  return name.equal(wanted, UString::kIgnoreCase);
}

bool HasAt(UString const& name, UString const& wanted, size_t position) {
  return name.substr(position, wanted.length()).equal(wanted, UString::kIgnoreCase);
}

bool BeginsWith(UString const& name, UString const& wanted) { return HasAt(name, wanted, 0); }

bool Holds(UString const& name, UString const& wanted) {
  for (size_t at = 0; at + wanted.length() <= name.length(); ++at) {
    if (HasAt(name, wanted, at)) {
      return true;
    }
  }
  return false;
}

// From the strictest on; the first that fits any candidate decides.
constexpr Fits kWaysToFit[] = {IsExactly, IsButForCase, BeginsWith, Holds};

std::string Listed(std::vector<Candidate> const& candidates, std::vector<size_t> const& places) {
  constexpr size_t kMost = 20;
  std::string text;
  for (size_t i = 0; i < places.size() && i < kMost; ++i) {
    Candidate const& candidate = candidates[places[i]];
    text += (text.empty() ? "\"" : ", \"") + candidate.name + "\"";
    if (candidate.uniqueID != 0) {
      text += " (#" + std::to_string(candidate.uniqueID) + ")";
    }
    if (!candidate.where.empty()) {
      text += " (" + candidate.where + ")";
    }
  }
  return text +
         (places.size() > kMost ? " and " + std::to_string(places.size() - kMost) + " more" : "");
}

std::vector<size_t> AllPlaces(size_t count) {
  std::vector<size_t> places;
  for (size_t i = 0; i < count; ++i) {
    places.push_back(i);
  }
  return places;
}

std::vector<size_t> FindByName(std::vector<Candidate> const& candidates, UString const& wanted) {
  std::vector<size_t> found;
  for (Fits const fits : kWaysToFit) {
    for (size_t i = 0; i < candidates.size(); ++i) {
      if (fits(UString(candidates[i].name), wanted)) {
        found.push_back(i);
      }
    }
    if (!found.empty()) {
      break;
    }
  }
  return found;
}

std::vector<size_t> FindByID(std::vector<Candidate> const& candidates, std::string const& wanted) {
  std::vector<size_t> found;
  for (size_t i = 0; i < candidates.size(); ++i) {
    int const id = candidates[i].uniqueID;
    if (id != 0 && wanted == "#" + std::to_string(id)) {
      found.push_back(i);
    }
  }
  return found;
}

}  // namespace

std::optional<size_t> FindName(std::vector<Candidate> const& candidates, std::string const& wanted,
                               std::string const& kind) {
  if (wanted.empty()) {
    throw UsageError("the name of a " + kind + " is empty");
  }
  std::vector<size_t> found = FindByName(candidates, UString(wanted));
  if (found.empty()) {
    found = FindByID(candidates, wanted);
  }
  if (found.size() > 1) {
    throw Failure("more than one " + kind + " fits \"" + wanted +
                  "\": " + Listed(candidates, found));
  }
  return found.empty() ? std::nullopt : std::optional<size_t>(found.front());
}

size_t MatchName(std::vector<Candidate> const& candidates, std::string const& wanted,
                 std::string const& kind) {
  if (auto const found = FindName(candidates, wanted, kind)) {
    return *found;
  }
  if (candidates.empty()) {
    throw Failure("there is no " + kind + " \"" + wanted + "\", nor any other");
  }
  throw Failure("there is no " + kind + " \"" + wanted + "\", only " +
                Listed(candidates, AllPlaces(candidates.size())));
}

}  // namespace Ostinet::Tool

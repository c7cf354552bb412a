// SPDX-License-Identifier: MIT
//
// What a ReferenceResolver found, for people.
#include <cstddef>

#include "ostinet/hostkit/ReferenceResolver.h"

namespace Ostinet {

namespace {

struct RankWords {
  ObjectMatch::MatchType criterion;
  int rank;
  char const* words;
};

// In the order in which people ask. Ranks that say nothing to them are left out.
constexpr RankWords kRankWords[] = {
    {ObjectMatch::kUniqueIDMatch, 2, "same ID"},
    {ObjectMatch::kUniqueIDMatch, 0, "other ID"},
    {ObjectMatch::kNameMatch, 2, "same name"},
    {ObjectMatch::kNameMatch, 1, "same name but for case and blanks"},
    {ObjectMatch::kNameMatch, 0, "other name"},
    {ObjectMatch::kManufacturerModelMatch, 4, "same model"},
    {ObjectMatch::kManufacturerModelMatch, 3, "same model but for case and blanks"},
    {ObjectMatch::kManufacturerModelMatch, 2, "other model of the same maker"},
    {ObjectMatch::kManufacturerModelMatch, 1, "other model of the same maker"},
    {ObjectMatch::kManufacturerModelMatch, 0, "other maker"},
    {ObjectMatch::kConnectionMatch, 1, "same interface"},
    {ObjectMatch::kConnectionMatch, 0, "other interface"},
    {ObjectMatch::kGeneralMIDIMatch, 0, "differs in General MIDI"},
};

void Append(std::string& text, std::string const& part) {
  if (!text.empty()) {
    text += ", ";
  }
  text += part;
}

}  // namespace

std::string ReferenceResolver::Candidate::InWords() const {
  std::string text;
  for (RankWords const& entry : kRankWords) {
    if (match.GetRank(entry.criterion) == entry.rank) {
      Append(text, entry.words);
    }
  }
  // An instrument within the host is told by its slot alone.
  bool const isBySlot =
      endpoint.IsInternalSoftware() && !match.HasValidRank(ObjectMatch::kNameMatch);
  if (isBySlot && match.HasValidRank(ObjectMatch::kUniqueIDMatch)) {
    text = match.GetRank(ObjectMatch::kUniqueIDMatch) == 2 ? "same slot" : "other slot";
  }
  return text;
}

std::string ReferenceResolver::Answer::InWords() const {
  switch (outcome) {
    case Outcome::kFound:
      return best.front().endpoint.GetName().string() + ": " + best.front().InWords();
    case Outcome::kAmbiguous: {
      std::string names;
      for (Candidate const& candidate : best) {
        Append(names, candidate.endpoint.GetName().string());
      }
      return std::to_string(best.size()) + " fit equally well (" + best.front().InWords() +
             "): " + names;
    }
    case Outcome::kNotFound:
      return "nothing in the studio resembles it";
    case Outcome::kNoEndpoint:
      return "it names no source or destination";
    case Outcome::kUnreadable:
      break;
  }
  return "the bytes hold no reference";
}

}  // namespace Ostinet

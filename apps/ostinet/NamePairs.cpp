// SPDX-License-Identifier: MIT
#include "NamePairs.h"

#include <algorithm>
#include <optional>

#include "ostinet/Endpoint.h"

namespace Ostinet::Tool {
namespace {

using Kind = NamePair::Kind;

std::string Trimmed(std::string text) {
  text.erase(text.find_last_not_of(' ') + 1);
  return text;
}

// What two names of that kind have in common, or nothing if they are of another kind.
std::optional<std::string> CommonOf(Kind kind, std::string const& source,
                                    std::string const& destination) {
  UString const name1(source);
  UString const name2(destination);
  UString common;
  UString rest1;
  UString rest2;
  switch (kind) {
    case Kind::kSame:
      return source == destination ? std::optional(source) : std::nullopt;
    case Kind::kOpposing:
      if (source != destination && Endpoint::MatchOpposingNames(name1, name2, common)) {
        return common.string();
      }
      break;
    case Kind::kRelated:
      if (Endpoint::MatchRelatedNames(name1, name2, common, rest1, rest2)) {
        return Trimmed(common.string());
      }
      break;
  }
  return std::nullopt;
}

}  // namespace

std::vector<NamePair> PairNames(std::vector<std::string> const& sources,
                                std::vector<std::string> const& destinations) {
  std::vector<NamePair> pairs;
  std::vector<bool> sourceTaken(sources.size());
  std::vector<bool> destinationTaken(destinations.size());
  for (Kind const kind : {Kind::kSame, Kind::kOpposing, Kind::kRelated}) {
    for (size_t i = 0; i < sources.size(); ++i) {
      for (size_t j = 0; !sourceTaken[i] && j < destinations.size(); ++j) {
        auto const common =
            destinationTaken[j] ? std::nullopt : CommonOf(kind, sources[i], destinations[j]);
        if (common) {
          pairs.push_back({kind, *common, i, j});
          sourceTaken[i] = true;
          destinationTaken[j] = true;
        }
      }
    }
  }
  std::stable_sort(pairs.begin(), pairs.end(),
                   [](NamePair const& a, NamePair const& b) { return a.source < b.source; });
  return pairs;
}

std::string KindText(NamePair::Kind kind) {
  switch (kind) {
    case Kind::kSame:
      return "same";
    case Kind::kOpposing:
      return "opposing";
    case Kind::kRelated:
      break;
  }
  return "related";
}

}  // namespace Ostinet::Tool

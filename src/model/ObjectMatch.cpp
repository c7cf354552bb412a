// SPDX-License-Identifier: MIT
#include <algorithm>

#include "ostinet/MatchData.h"

namespace Ostinet {

ObjectMatch::ObjectMatch() : ranks_{-1, -1, -1, -1, -1} {}

int ObjectMatch::GetRank(MatchType type) const {
  return type >= 0 && type < kTypes ? ranks_[type] : -1;
}

void ObjectMatch::SetRank(MatchType type, int rank) {
  if (type >= 0 && type < kTypes) {
    ranks_[type] = rank;
  }
}

bool ObjectMatch::HasValidRank(MatchType type) const { return GetRank(type) >= 0; }

bool ObjectMatch::operator==(ObjectMatch const& other) const {
  return std::equal(std::begin(ranks_), std::end(ranks_), std::begin(other.ranks_));
}

bool ObjectMatch::operator!=(ObjectMatch const& other) const { return !(*this == other); }

// Hosts weigh by these lines as they stand. A rank of 1 for the unique ID is asked for although
// nothing gives it.

std::vector<MatchLevel> const& StandardMatch() {
  static std::vector<MatchLevel> const levels = {{ObjectMatch::kUniqueIDMatch, 2, 8},
                                                 {ObjectMatch::kUniqueIDMatch, 1, 6},
                                                 {ObjectMatch::kNameMatch, 1, 4},
                                                 {ObjectMatch::kManufacturerModelMatch, 3, 2},
                                                 {ObjectMatch::kConnectionMatch, 1, 1}};
  return levels;
}

std::vector<MatchLevel> const& IDAndNameMatch() {
  static std::vector<MatchLevel> const levels = {{ObjectMatch::kUniqueIDMatch, 2, 8},
                                                 {ObjectMatch::kUniqueIDMatch, 1, 4},
                                                 {ObjectMatch::kNameMatch, 1, 1}};
  return levels;
}

std::vector<MatchLevel> const& NameAndIDMatch() {
  static std::vector<MatchLevel> const levels = {{ObjectMatch::kNameMatch, 1, 2},
                                                 {ObjectMatch::kUniqueIDMatch, 2, 1},
                                                 {ObjectMatch::kUniqueIDMatch, 1, 1}};
  return levels;
}

}  // namespace Ostinet

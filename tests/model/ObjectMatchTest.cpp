// SPDX-License-Identifier: MIT
#include <gtest/gtest.h>

#include <cstddef>
#include <stdexcept>
#include <string>

#include "ostinet/MatchData.h"

namespace Ostinet {
namespace {

static_assert(sizeof(BreviaDestinationMatch) == 278, "the older system's record");
static_assert(offsetof(BreviaDestinationMatch, fields.name) == 22, "the older system's record");
static_assert(offsetof(BreviaDestinationMatch, software.long2) == 2, "the older system's record");

bool operator==(MatchLevel const& a, MatchLevel const& b) {
  return a.matchType == b.matchType && a.minRank == b.minRank && a.weight == b.weight;
}

TEST(ObjectMatch, StartsWithNothingExamined) {
  ObjectMatch match;
  for (int type = 0; type < 5; ++type) {
    EXPECT_EQ(match.GetRank(ObjectMatch::MatchType(type)), -1);
    EXPECT_FALSE(match.HasValidRank(ObjectMatch::MatchType(type)));
  }
  ObjectMatch other;
  other.SetRank(ObjectMatch::kGeneralMIDIMatch, 0);
  EXPECT_TRUE(other.HasValidRank(ObjectMatch::kGeneralMIDIMatch));
  EXPECT_FALSE(match == other);
  EXPECT_TRUE(match != other);
}

TEST(MatchLevels, AreTheListsThatHostsWeighBy) {
  using OM = ObjectMatch;
  EXPECT_EQ(StandardMatch(), (std::vector<MatchLevel>{{OM::kUniqueIDMatch, 2, 8},
                                                      {OM::kUniqueIDMatch, 1, 6},
                                                      {OM::kNameMatch, 1, 4},
                                                      {OM::kManufacturerModelMatch, 3, 2},
                                                      {OM::kConnectionMatch, 1, 1}}));
  EXPECT_EQ(IDAndNameMatch(), (std::vector<MatchLevel>{{OM::kUniqueIDMatch, 2, 8},
                                                       {OM::kUniqueIDMatch, 1, 4},
                                                       {OM::kNameMatch, 1, 1}}));
  EXPECT_EQ(NameAndIDMatch(), (std::vector<MatchLevel>{{OM::kNameMatch, 1, 2},
                                                       {OM::kUniqueIDMatch, 2, 1},
                                                       {OM::kUniqueIDMatch, 1, 1}}));
}

TEST(MatchDataBytes, AreAValueOfBytes) {
  MatchData data(3);
  EXPECT_EQ(data.size(), 3U);
  data[1] = 'b';
  data.at(2) = 'c';
  EXPECT_EQ(std::string(data.begin(), data.end()), std::string("\0bc", 3));
  EXPECT_EQ(std::string(data.rbegin(), data.rend()), std::string("cb\0", 3));
  MatchData const copy = data;
  EXPECT_TRUE(copy == data);
  data[0] = 'a';
  EXPECT_TRUE(copy != data);
  EXPECT_EQ(copy[0], '\0');
}

TEST(MatchDataBytes, TellTheirClassWhenAnIndexIsOutOfRange) {
  MatchData const empty;
  EXPECT_TRUE(empty.empty());
  try {
    empty.at(0);
    FAIL() << "at(0) of no bytes";
  } catch (std::out_of_range const& error) {
    EXPECT_STREQ(error.what(), "Ostinet::MatchData");
  }
}

}  // namespace
}  // namespace Ostinet

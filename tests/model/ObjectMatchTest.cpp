// SPDX-License-Identifier: MIT
#include <gtest/gtest.h>

#include <array>
#include <cstddef>
#include <stdexcept>
#include <string>

#include "ostinet/MatchData.h"

namespace Ostinet {
namespace {

static_assert(sizeof(BreviaDestinationMatch) == 278, "the older system's record");
static_assert(offsetof(BreviaDestinationMatch, fields.name) == 22, "the older system's record");
static_assert(offsetof(BreviaDestinationMatch, software.long2) == 2, "the older system's record");

using Line = std::array<int, 3>;

std::vector<Line> LinesOf(std::vector<MatchLevel> const& levels) {
  std::vector<Line> lines;
  for (MatchLevel const& level : levels) {
    lines.push_back({level.matchType, level.minRank, level.weight});
  }
  return lines;
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
  EXPECT_EQ(LinesOf(StandardMatch()),
            (std::vector<Line>{{0, 2, 8}, {0, 1, 6}, {1, 1, 4}, {2, 3, 2}, {3, 1, 1}}));
  EXPECT_EQ(LinesOf(IDAndNameMatch()), (std::vector<Line>{{0, 2, 8}, {0, 1, 4}, {1, 1, 1}}));
  EXPECT_EQ(LinesOf(NameAndIDMatch()), (std::vector<Line>{{1, 1, 2}, {0, 2, 1}, {0, 1, 1}}));
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

// SPDX-License-Identifier: MIT
#include <gtest/gtest.h>

#include "NamePairs.h"

namespace Ostinet::Tool {
namespace {

using Names = std::vector<std::string>;

// "common: source + destination (kind)" for each pair.
Names Pairs(Names const& sources, Names const& destinations) {
  Names lines;
  for (NamePair const& pair : PairNames(sources, destinations)) {
    lines.push_back(pair.common + ": " + sources[pair.source] + " + " +
                    destinations[pair.destination] + " (" + KindText(pair.kind) + ")");
  }
  return lines;
}

TEST(NamePairs, FindsThreeKinds) {
  EXPECT_EQ(Pairs({"USB", "MIDI In 2", "Synth A"}, {"Synth B", "MIDI Out 2", "USB"}),
            (Names{"USB: USB + USB (same)", "MIDI In/Out 2: MIDI In 2 + MIDI Out 2 (opposing)",
                   "Synth: Synth A + Synth B (related)"}));
}

TEST(NamePairs, PrefersTheStricterKindWhateverTheOrder) {
  EXPECT_EQ(Pairs({"Desk In 1"}, {"Desk Out 2", "Desk Out 1"}),
            (Names{"Desk In/Out 1: Desk In 1 + Desk Out 1 (opposing)"}));
}

TEST(NamePairs, TakesEachNameOnce) {
  EXPECT_EQ(Pairs({"USB", "USB", "USB"}, {"USB", "USB"}),
            (Names{"USB: USB + USB (same)", "USB: USB + USB (same)"}));
}

TEST(NamePairs, LeavesStrangersAlone) {
  EXPECT_TRUE(Pairs({"Keyboard"}, {"Synth"}).empty());
  EXPECT_TRUE(Pairs({}, {"Synth"}).empty());
}

}  // namespace
}  // namespace Ostinet::Tool

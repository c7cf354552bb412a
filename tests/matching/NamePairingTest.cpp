// SPDX-License-Identifier: MIT
#include <gtest/gtest.h>

#include "ostinet/Endpoint.h"
#include "support/Printers.h"

namespace Ostinet {
namespace {

struct OpposingCase {
  char const* name1;
  char const* name2;
  char const* joined;  // null: they do not belong together
};

class OpposingNames : public testing::TestWithParam<OpposingCase> {};

TEST_P(OpposingNames, AreFoundAndJoined) {
  OpposingCase const& names = GetParam();
  UString joined("before");
  bool const match = Endpoint::MatchOpposingNames(names.name1, names.name2, joined);
  EXPECT_EQ(match, names.joined != nullptr);
  EXPECT_EQ(joined, UString(match ? names.joined : "before"));
}

INSTANTIATE_TEST_SUITE_P(
    Table, OpposingNames,
    testing::Values(OpposingCase{"MIDI In 2", "MIDI Out 2", "MIDI In/Out 2"},
                    OpposingCase{"MIDI Out 2", "MIDI In 2", "MIDI In/Out 2"},
                    OpposingCase{"In", "Out", "In/Out"}, OpposingCase{"Out", "In", "In/Out"},
                    // The same text leaves the joined name as it was.
                    OpposingCase{"MIDI 1", "MIDI 1", "before"}, OpposingCase{"", "", "before"},
                    // Case counts, and so does every unit around the words.
                    OpposingCase{"MIDI In", "MIDI in", nullptr},
                    OpposingCase{"MIDI In", "MIDI out", nullptr},
                    OpposingCase{"MIDI In 2", "MIDI Out 3", nullptr},
                    OpposingCase{"MIDI In 2", "MIDI Out 22", nullptr},
                    OpposingCase{"AIDI In 2", "MIDI Out 2", nullptr},
                    OpposingCase{"MIDI Out 2", "AIDI In 2", nullptr},
                    OpposingCase{"MIDI Out 2", "MIDI In 3", nullptr},
                    OpposingCase{"Synth", "Synth 2", nullptr}, OpposingCase{"In", "In 2", nullptr},
                    OpposingCase{"Out", "", nullptr}, OpposingCase{"", "Out", nullptr},
                    // The first places count.
                    OpposingCase{"In In", "Out In", "In/Out In"},
                    OpposingCase{"In In", "In Out", nullptr},
                    // A failure of the first test goes on to the second.
                    OpposingCase{"In Out", "In In", "In In/Out"},
                    OpposingCase{"Out In", "In In", "In/Out In"}));

// The second test does not ask where the second name has "In". Hosts' documents hold texts that
// were joined so.
INSTANTIATE_TEST_SUITE_P(
    TheSecondTestIsNoMirror, OpposingNames,
    testing::Values(
        // "In" stands before the place of "Out", and what follows it begins alike.
        OpposingCase{"InXOutX", "InXXXX", "InXIn/OutX"},
        // No "In" at all: what follows the first unit is compared.
        OpposingCase{"Out", "ab", "In/Out"}, OpposingCase{"Outb", "abc", "In/Outb"},
        OpposingCase{"Outc", "abc", nullptr},
        // Units of the second name behind what is compared do not matter.
        OpposingCase{"Outb", "xbz", "In/Outb"},
        // The first test does ask.
        OpposingCase{"ab", "Out", nullptr}, OpposingCase{"InXXXX", "InXOutX", nullptr},
        // Too short behind "In".
        OpposingCase{"OutXYZ", "XXXIn", nullptr}));

struct RelatedCase {
  char const* name1;
  char const* name2;
  char const* common;  // null: they are not related
  char const* rest1;
  char const* rest2;
};

class RelatedNames : public testing::TestWithParam<RelatedCase> {};

TEST_P(RelatedNames, AreFoundAndSplit) {
  RelatedCase const& names = GetParam();
  UString common("before");
  UString rest1("before");
  UString rest2("before");
  bool const match = Endpoint::MatchRelatedNames(names.name1, names.name2, common, rest1, rest2);
  EXPECT_EQ(match, names.common != nullptr);
  EXPECT_EQ(common, UString(match ? names.common : ""));
  EXPECT_EQ(rest1, UString(match ? names.rest1 : ""));
  EXPECT_EQ(rest2, UString(match ? names.rest2 : ""));
}

// Hosts store texts that were made from these names, so the blank at the end must stay.
INSTANTIATE_TEST_SUITE_P(
    FrontMatchEndsInOneBlank, RelatedNames,
    testing::Values(RelatedCase{"Synth A", "Synth B", "Synth ", "A", "B"},
                    RelatedCase{"Synth:A", "Synth:B", "Synth ", "A", "B"},
                    RelatedCase{"Big Synth Out", "Big Synth In", "Big Synth ", "Out", "In"},
                    // A number that both bear follows it.
                    RelatedCase{"Synth A (2)", "Synth B (2)", "Synth (2)", "A", "B"},
                    // The second name may be the shared front alone; the first may not.
                    RelatedCase{"Synth Two", "Synth", "Synth ", "Two", ""}));

INSTANTIATE_TEST_SUITE_P(
    Table, RelatedNames,
    testing::Values(RelatedCase{"A Synth", "B Synth", "Synth", "A", "B"},
                    RelatedCase{"A Synth (2)", "B Synth (2)", "Synth (2)", "A", "B"},
                    RelatedCase{"One (2)", "Two (2)", "(2)", "One", "Two"},
                    RelatedCase{"MIDI In 2", "MIDI Out 2", "2", "MIDI In", "MIDI Out"},
                    RelatedCase{"Port 1 In", "Port 1 Out", nullptr, "", ""},
                    RelatedCase{"Synth", "Synth Two", nullptr, "", ""},
                    RelatedCase{"Synth", "Synth", nullptr, "", ""},
                    RelatedCase{"", "", nullptr, "", ""}, RelatedCase{"A", "", nullptr, "", ""},
                    RelatedCase{"A", "B", nullptr, "", ""},
                    // Only these words carry no identity.
                    RelatedCase{"Port A", "Port B", nullptr, "", ""},
                    RelatedCase{"In/Out A", "In/Out B", nullptr, "", ""},
                    RelatedCase{"port A", "port B", "port ", "A", "B"},
                    // Two digits, or other brackets, are no number of the system's.
                    RelatedCase{"A X (22)", "B X (22)", "X (22)", "A", "B"},
                    RelatedCase{"One (x)", "Two (x)", "(x)", "One", "Two"},
                    // A number alone is a name.
                    RelatedCase{"(2)", "(2)", nullptr, "", ""}));

TEST(RelatedNames, MayWriteOverTheNames) {
  UString first("Synth A");
  UString second("Synth B");
  UString common;
  ASSERT_TRUE(Endpoint::MatchRelatedNames(first, second, common, first, second));
  EXPECT_EQ(common, UString("Synth "));
  EXPECT_EQ(first, UString("A"));
  EXPECT_EQ(second, UString("B"));
}

}  // namespace
}  // namespace Ostinet

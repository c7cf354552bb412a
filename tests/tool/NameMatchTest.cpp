// SPDX-License-Identifier: MIT
#include <gtest/gtest.h>

#include <algorithm>

#include "Errors.h"
#include "NameMatch.h"

namespace Ostinet::Tool {
namespace {

std::vector<Candidate> const kPorts = {{"Interface 1", 11},
                                       {"Interface 10", 12},
                                       {"Soft Synth", 13},
                                       {"soft synth", 14},
                                       {"Drums", 15}};

size_t Match(std::string const& wanted) { return MatchName(kPorts, wanted, "destination"); }

std::string Complaint(std::string const& wanted) {
  try {
    Match(wanted);
  } catch (Failure const& failure) {
    return failure.what();
  }
  return "matched";
}

TEST(MatchName, TakesTheExactNameThoughOthersBeginWithIt) { EXPECT_EQ(Match("Interface 1"), 0u); }

TEST(MatchName, TakesTheExactCaseBeforeAnyOther) {
  EXPECT_EQ(Match("Soft Synth"), 2u);
  EXPECT_EQ(Match("soft synth"), 3u);
}

TEST(MatchName, IgnoresCaseWhereTheExactNameFails) { EXPECT_EQ(Match("INTERFACE 10"), 1u); }

TEST(MatchName, TakesTheOnlyOneThatBeginsSo) { EXPECT_EQ(Match("dr"), 4u); }

TEST(MatchName, TakesTheOnlyOneThatHoldsThePart) { EXPECT_EQ(Match("RUM"), 4u); }

TEST(MatchName, PrefersABeginningToAPart) {
  EXPECT_EQ(MatchName({{"Piano", 1}, {"Grand Piano", 2}}, "pia", "source"), 0u);
}

TEST(MatchName, NamesTheCandidatesOfAnAmbiguousName) {
  EXPECT_EQ(Complaint("Interf"),
            "more than one destination fits \"Interf\": \"Interface 1\" (#11), "
            "\"Interface 10\" (#12)");
}

TEST(MatchName, TellsCandidatesOfOneNameApart) {
  try {
    MatchName({{"Piano", 0, "Preset A"}, {"Piano", 0, "User"}}, "pi", "patch");
    FAIL();
  } catch (Failure const& failure) {
    EXPECT_STREQ(failure.what(),
                 "more than one patch fits \"pi\": \"Piano\" (Preset A), \"Piano\" (User)");
  }
}

TEST(MatchName, NamesTwentyCandidatesAtMost) {
  std::vector<Candidate> const many(23, Candidate{"P"});
  try {
    MatchName(many, "nothing", "patch");
    FAIL();
  } catch (Failure const& failure) {
    std::string const text = failure.what();
    EXPECT_EQ(std::count(text.begin(), text.end(), 'P'), 20);
    EXPECT_NE(text.find("\"P\" and 3 more"), std::string::npos);
  }
}

TEST(MatchName, CountsTwoOfTheSameNameAsAmbiguous) {
  EXPECT_THROW(MatchName({{"A", 1}, {"A", 2}}, "A", "source"), Failure);
}

TEST(MatchName, TakesAUniqueID) { EXPECT_EQ(Match("#13"), 2u); }

TEST(MatchName, TakesANameThatLooksLikeAnIDAsAName) {
  EXPECT_EQ(MatchName({{"X", 7}, {"#7", 8}}, "#7", "source"), 1u);
}

TEST(MatchName, SaysWhatThereIsWhereNothingFits) {
  EXPECT_EQ(MatchName({{"A", 1}}, "a", "source"), 0u);
  std::string const complaint = Complaint("Harp");
  EXPECT_NE(complaint.find("there is no destination \"Harp\""), std::string::npos);
  EXPECT_NE(complaint.find("\"Drums\" (#15)"), std::string::npos);
  EXPECT_THROW(MatchName({}, "Harp", "source"), Failure);
}

TEST(MatchName, RefusesTheEmptyName) { EXPECT_THROW(Match(""), UsageError); }

TEST(MatchName, ComparesLettersOutsideASCII) {
  EXPECT_EQ(MatchName({{"\xC3\x84ther", 1}, {"Other", 2}}, "\xC3\xA4th", "source"), 0u);
}

}  // namespace
}  // namespace Ostinet::Tool

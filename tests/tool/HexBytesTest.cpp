// SPDX-License-Identifier: MIT
#include <gtest/gtest.h>

#include "Errors.h"
#include "HexBytes.h"

namespace Ostinet::Tool {
namespace {

TEST(ParseHex, TakesPairsWithAndWithoutBlanks) {
  Bytes const expected = {0x90, 0x3C, 0x40};
  EXPECT_EQ(ParseHex("90 3C 40"), expected);
  EXPECT_EQ(ParseHex("903c40"), expected);
  EXPECT_EQ(ParseHex("\t903C  40\n"), expected);
}

TEST(ParseHex, TakesSingleDigitsThatStandAlone) {
  EXPECT_EQ(ParseHex("B0 7 F"), (Bytes{0xB0, 0x07, 0x0F}));
}

TEST(ParseHex, MakesNothingOfNothing) {
  EXPECT_TRUE(ParseHex("").empty());
  EXPECT_TRUE(ParseHex("  ").empty());
}

TEST(ParseHex, RefusesOddRunsAndOtherLetters) {
  EXPECT_THROW(ParseHex("903"), UsageError);
  EXPECT_THROW(ParseHex("9G"), UsageError);
  EXPECT_THROW(ParseHex("0x90"), UsageError);
  EXPECT_THROW(ParseHex("-1"), UsageError);
}

TEST(ParseHex, NamesTheWordThatIsWrong) {
  try {
    ParseHex("90 zz 40");
    FAIL() << "zz was taken";
  } catch (UsageError const& error) {
    EXPECT_NE(std::string(error.what()).find("\"zz\""), std::string::npos);
  }
}

TEST(ToHex, WritesUpperCaseWithBlanksBetween) {
  EXPECT_EQ(ToHex({0x90, 0x3c, 0x0a}), "90 3C 0A");
  EXPECT_EQ(ToHex({}), "");
}

TEST(SplitWords, CutsAtAnyWhiteSpace) {
  EXPECT_EQ(SplitWords("  on 60\t100\n"), (std::vector<std::string>{"on", "60", "100"}));
}

}  // namespace
}  // namespace Ostinet::Tool

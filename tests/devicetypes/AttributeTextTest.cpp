// SPDX-License-Identifier: MIT
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "devicetypes/AttributeText.h"

namespace Ostinet::Impl {
namespace {

using ::testing::ElementsAre;
using ::testing::IsEmpty;
using ::testing::Optional;

TEST(DecimalText, IgnoresWhatStandsBehindTheDigits) {
  EXPECT_EQ(ParseDecimal("16", 255), 16U);
  EXPECT_EQ(ParseDecimal("16 channels", 255), 16U);
  EXPECT_EQ(ParseDecimal("7.9", 255), 7U);
  EXPECT_EQ(ParseDecimal("1,000", 255), 1U);
}

TEST(DecimalText, MayBeginWithWhiteSpaceAndASign) {
  EXPECT_EQ(ParseDecimal(" \t12", 255), 12U);
  EXPECT_EQ(ParseDecimal("+12", 255), 12U);
  EXPECT_EQ(ParseDecimal("-0", 255), 0U);
}

TEST(DecimalText, IsNothingOutOfRange) {
  EXPECT_EQ(ParseDecimal("255", 255), 255U);
  EXPECT_EQ(ParseDecimal("256", 255), std::nullopt);
  EXPECT_EQ(ParseDecimal("-1", 255), std::nullopt);
  EXPECT_EQ(ParseDecimal("18446744073709551617", 255), std::nullopt);
}

TEST(DecimalText, IsNothingWithoutDigits) {
  for (char const* text : {"", " ", "x1", "- 1", "+", "0x"}) {
    EXPECT_EQ(ParseDecimal(text, 255), *text == '0' ? std::optional<unsigned>(0) : std::nullopt)
        << text;
  }
}

TEST(HexText, TakesDigitsInPairsWithWhiteSpaceAnywhere) {
  EXPECT_THAT(ParseHexBytes("41"), Optional(ElementsAre(0x41)));
  EXPECT_THAT(ParseHexBytes("00 01 02"), Optional(ElementsAre(0, 1, 2)));
  EXPECT_THAT(ParseHexBytes("\t0 0\n017F "), Optional(ElementsAre(0, 1, 0x7F)));
}

TEST(HexText, OfNoDigitsIsNoBytes) { EXPECT_THAT(ParseHexBytes(" "), Optional(IsEmpty())); }

TEST(HexText, IsInvalidWithAnyOtherCharacter) {
  for (char const* text : {"4a", "4A,", "0x41", "4-1", "G0"}) {
    EXPECT_EQ(ParseHexBytes(text), std::nullopt) << text;
  }
}

TEST(HexText, IsInvalidAboveSevenBits) {
  EXPECT_THAT(ParseHexBytes("7F"), Optional(ElementsAre(0x7F)));
  EXPECT_EQ(ParseHexBytes("80"), std::nullopt);
}

TEST(HexText, IsInvalidWithADigitLeftOver) {
  EXPECT_EQ(ParseHexBytes("4"), std::nullopt);
  EXPECT_EQ(ParseHexBytes("41 4"), std::nullopt);
}

}  // namespace
}  // namespace Ostinet::Impl

// SPDX-License-Identifier: MIT
#include <gtest/gtest.h>

#include <limits>

#include "ostinet/core/UString.h"
#include "support/Printers.h"

namespace Ostinet {
namespace {

constexpr auto kDecimal = vantor::NumFormat(1);
constexpr auto kHexadecimal = vantor::NumFormat(0);
constexpr long long kMin = std::numeric_limits<long long>::min();
constexpr long long kMax = std::numeric_limits<long long>::max();

UString TextOf(long long number, vantor::NumFormat format = kDecimal) {
  UString text("left over");
  vantor::NumToUString(number, format, text);
  return text;
}

TEST(NumToUString, WritesDecimalNumbers) {
  EXPECT_EQ(TextOf(0), UString("0"));
  EXPECT_EQ(TextOf(-15), UString("-15"));
  EXPECT_EQ(TextOf(kMin), UString("-9223372036854775808"));
}

TEST(NumToUString, WritesHexadecimalNumbersInUpperCase) {
  EXPECT_EQ(TextOf(0xAF09, kHexadecimal), UString("AF09"));
  EXPECT_EQ(TextOf(-1, kHexadecimal), UString("FFFFFFFFFFFFFFFF"));
}

TEST(UStringToNum, ReadsBackWhatWasWritten) {
  for (long long const number : {0LL, 1LL, -1LL, 4711LL, kMin, kMax}) {
    EXPECT_EQ(vantor::UStringToNum(TextOf(number), kDecimal), number);
    EXPECT_EQ(vantor::UStringToNum(TextOf(number, kHexadecimal), kHexadecimal), number);
  }
}

TEST(UStringToNum, AllowsWhiteSpaceAroundAndOneSign) {
  EXPECT_EQ(vantor::UStringToNum(" \n-7\t", kDecimal), -7);
  EXPECT_EQ(vantor::UStringToNum("+7", kDecimal), 7);
}

TEST(UStringToNum, GivesZeroForWhatIsNoNumber) {
  for (char const* const text : {"", " ", "x", "7x", "1 2", "+-7", "--7", "+", "-", "0x10", "1.5",
                                 "9223372036854775808", "\xC2\xB2"}) {
    EXPECT_EQ(vantor::UStringToNum(text, kDecimal), 0) << text;
  }
}

TEST(UStringToInt32, GivesZeroForWhatDoesNotFit) {
  EXPECT_EQ(vantor::UStringToInt32("2147483647", kDecimal), 2147483647);
  EXPECT_EQ(vantor::UStringToInt32("2147483648", kDecimal), 0);
  EXPECT_EQ(vantor::UStringToInt32("-2147483648", kDecimal), -2147483647 - 1);
  EXPECT_EQ(vantor::UStringToInt32("-2147483649", kDecimal), 0);
}

TEST(FormattedStreamProxy, AppendsNumbersAndText) {
  UString text("at ");
  text.Stream() << "Port " << 2 << ' ' << -3L << '/' << 18446744073709551615ULL << UString("!");
  EXPECT_EQ(text, UString("at Port 2 -3/18446744073709551615!"));
}

TEST(FormattedStreamProxy, WritesTheShortestDoubleThatReadsBack) {
  UString text;
  text.Stream() << 0.1 << ' ' << 127.0 << ' ' << -0.5;
  EXPECT_EQ(text, UString("0.1 127 -0.5"));
}

}  // namespace
}  // namespace Ostinet

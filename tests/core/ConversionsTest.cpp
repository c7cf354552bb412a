// SPDX-License-Identifier: MIT
#include <gtest/gtest.h>

#include <cmath>
#include <limits>

#include "core/Conversions.h"

namespace Ostinet {
namespace {

constexpr std::uint64_t kTopBit = 0x8000000000000000;

TEST(DoubleToUnsigned64, Truncates) {
  EXPECT_EQ(DoubleToUnsigned64(0.0), 0U);
  EXPECT_EQ(DoubleToUnsigned64(-0.0), 0U);
  EXPECT_EQ(DoubleToUnsigned64(0.99), 0U);
  EXPECT_EQ(DoubleToUnsigned64(9.9), 9U);
  EXPECT_EQ(DoubleToUnsigned64(9007199254740991.0), 9007199254740991U);
}

TEST(DoubleToUnsigned64, KeepsTheTopBitOfLargeNumbers) {
  EXPECT_EQ(DoubleToUnsigned64(std::nextafter(std::ldexp(1.0, 63), 0.0)), kTopBit - 1024);
  EXPECT_EQ(DoubleToUnsigned64(std::ldexp(1.0, 63)), kTopBit);
  EXPECT_EQ(DoubleToUnsigned64(std::ldexp(1.5, 63)), kTopBit | (kTopBit >> 1));
  EXPECT_EQ(DoubleToUnsigned64(std::nextafter(std::ldexp(1.0, 64), 0.0)), 0xFFFFFFFFFFFFF800U);
}

// Times before the start of a session come out negative, and hosts have stored these bits.
TEST(DoubleToUnsigned64, KeepsTheBitsOfNegativeNumbers) {
  EXPECT_EQ(DoubleToUnsigned64(-0.5), 0U);
  EXPECT_EQ(DoubleToUnsigned64(-1.0), 0xFFFFFFFFFFFFFFFFU);
  EXPECT_EQ(DoubleToUnsigned64(-2.9), 0xFFFFFFFFFFFFFFFEU);
  EXPECT_EQ(DoubleToUnsigned64(-std::ldexp(1.0, 63)), kTopBit);
}

TEST(DoubleToUnsigned64, IsDefinedBeyondTheRange) {
  EXPECT_EQ(DoubleToUnsigned64(std::ldexp(1.0, 64)), 0U);
  EXPECT_EQ(DoubleToUnsigned64(std::numeric_limits<double>::infinity()), 0U);
  EXPECT_EQ(DoubleToUnsigned64(-std::ldexp(1.0, 70)), kTopBit);
  EXPECT_EQ(DoubleToUnsigned64(-std::numeric_limits<double>::infinity()), kTopBit);
  EXPECT_EQ(DoubleToUnsigned64(std::numeric_limits<double>::quiet_NaN()), kTopBit);
}

TEST(Unsigned64ToDouble, CountsTheTopBitAsPositive) {
  EXPECT_EQ(Unsigned64ToDouble(0), 0.0);
  EXPECT_EQ(Unsigned64ToDouble(kTopBit), std::ldexp(1.0, 63));
  EXPECT_EQ(Unsigned64ToDouble(std::numeric_limits<std::uint64_t>::max()), std::ldexp(1.0, 64));
}

}  // namespace
}  // namespace Ostinet

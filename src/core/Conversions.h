// SPDX-License-Identifier: MIT
#pragma once

#include <cstdint>

namespace Ostinet {

/// A double as an unsigned count, truncated. Hosts have stored times that came out of one
/// processor's conversion, so its results hold for every input: a number below 0 is truncated as
/// a signed one and its bits are kept; from 2^63 on, 2^63 is taken off before the truncation and
/// its bit put back after it. 2^64 and above gives 0; what is no number, or below -2^63, gives
/// the top bit alone.
constexpr std::uint64_t DoubleToUnsigned64(double value) {
  constexpr double kTwoTo63 = 9223372036854775808.0;
  constexpr std::uint64_t kTopBit = std::uint64_t{1} << 63;
  if (value >= kTwoTo63) {
    double const rest = value - kTwoTo63;
    std::uint64_t const bits = rest < kTwoTo63 ? static_cast<std::uint64_t>(rest) : kTopBit;
    return bits ^ kTopBit;
  }
  bool const fits = value >= -kTwoTo63;  // false for what is no number
  return fits ? static_cast<std::uint64_t>(static_cast<std::int64_t>(value)) : kTopBit;
}

/// An unsigned count as the nearest double.
constexpr double Unsigned64ToDouble(std::uint64_t value) { return static_cast<double>(value); }

}  // namespace Ostinet

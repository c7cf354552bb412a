// SPDX-License-Identifier: MIT
#pragma once

#include "ostinet/core/UString.h"

namespace Ostinet::Impl {

// Numbers as name documents have them, without regard to any locale. White space in front is
// passed over, and the first character that is no digit ends the number, so "12 Hz" is 12. Each
// gives false, and `out` as it was, for a text that does not begin with a number, and for a number
// out of range.

/// Digits without a sign, 0 to `max`.
bool ReadUnsigned(UString const& text, unsigned max, unsigned& out);
/// 32 bits; "-" may stand in front.
bool ReadSigned(UString const& text, int& out);
/// Also with a sign, a decimal point and an exponent.
bool ReadDouble(UString const& text, double& out);
/// The low byte of a text that is nothing but hexadecimal digits, at least one.
bool ReadHexadecimalByte(UString const& text, unsigned char& out);

/// The value of a hexadecimal digit, or -1.
int HexadecimalDigit(char16_t unit);

}  // namespace Ostinet::Impl

// SPDX-License-Identifier: MIT
#pragma once

#include <cstddef>

namespace Ostinet::Impl {

/// Writes an unsigned integer with its highest byte first, and returns the place behind it.
template <class Unsigned>
char* WriteBigEndian(char* out, Unsigned value) {
  for (std::size_t i = sizeof(Unsigned); i > 0; --i) {
    *out++ = static_cast<char>(static_cast<unsigned char>(value >> (8 * (i - 1))));
  }
  return out;
}

}  // namespace Ostinet::Impl

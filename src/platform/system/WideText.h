// SPDX-License-Identifier: MIT
#pragma once

#include <algorithm>
#include <cstddef>
#include <string>

#include "ostinet/core/UString.h"
#include "platform/system/WindowsTypes.h"

namespace Ostinet::Impl {

/// The text of a fixed array of the system's, which need not end in a 0.
template <std::size_t N>
UString TextOf(WCHAR const (&text)[N]) {
  std::size_t const length = static_cast<std::size_t>(std::find(text, text + N, WCHAR{0}) - text);
  return UString(std::u16string(text, text + length));
}

}  // namespace Ostinet::Impl

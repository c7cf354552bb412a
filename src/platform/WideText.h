// SPDX-License-Identifier: MIT
#pragma once

#include <cstddef>

#include "ostinet/core/UString.h"
#include "platform/system/WindowsTypes.h"

namespace Ostinet::Impl {

/// The text of a fixed array of the system's, which need not end in a 0.
template <std::size_t N>
UString TextOf(WCHAR const (&text)[N]) {
  UString result;
  for (std::size_t i = 0; i < N && text[i] != 0; ++i) {
    result += static_cast<unsigned short>(text[i]);
  }
  return result;
}

}  // namespace Ostinet::Impl

// SPDX-License-Identifier: MIT
#pragma once

#include <string_view>

#include "ostinet/core/UString.h"

namespace Ostinet::Impl {

/// Below, at or above 0, as `a` comes before, with or behind `b` under the flags.
int CompareUnits(std::u16string_view a, std::u16string_view b, UString::CompareFlags flags);

}  // namespace Ostinet::Impl

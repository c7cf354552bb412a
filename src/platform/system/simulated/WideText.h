// SPDX-License-Identifier: MIT
#pragma once

#include <cstddef>
#include <string>

#include "platform/system/WindowsTypes.h"

namespace Ostinet::Impl::Simulated {

/// UTF-8 to UTF-16; what is not UTF-8 becomes U+FFFD.
std::u16string Widen(std::string const& text);

/// Copies at most `room` - 1 units and a final 0, and cuts no surrogate pair.
void CopyWide(std::u16string const& text, WCHAR* to, std::size_t room);

}  // namespace Ostinet::Impl::Simulated

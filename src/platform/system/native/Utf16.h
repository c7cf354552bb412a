// SPDX-License-Identifier: MIT
#pragma once

#include <string>

namespace Ostinet::Impl {

/// Malformed input becomes U+FFFD.
std::u16string Utf16FromUtf8(std::string const& text);

}  // namespace Ostinet::Impl

// SPDX-License-Identifier: MIT
#include "platform/system/native/Utf16.h"

#include "ostinet/core/UString.h"

namespace Ostinet::Impl {

std::u16string Utf16FromUtf8(std::string const& text) { return UString(text).utf16_str(); }

}  // namespace Ostinet::Impl

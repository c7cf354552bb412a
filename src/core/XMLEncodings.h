// SPDX-License-Identifier: MIT
#pragma once

#include <string_view>

namespace Ostinet::Impl {

/// The characters of the bytes of a single-byte encoding, found by its name in any case. False
/// for an encoding that is not known. A byte without a character gives -1.
bool FindSingleByteEncoding(std::string_view name, int (&characters)[256]);

}  // namespace Ostinet::Impl

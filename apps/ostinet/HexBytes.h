// SPDX-License-Identifier: MIT
#pragma once

#include <string>
#include <string_view>
#include <vector>

namespace Ostinet::Tool {

using Bytes = std::vector<unsigned char>;

/// The bytes of "90 3C 40" or "903C40", upper or lower case. Between blanks stand single digits
/// or pairs of them. Throws UsageError for anything else.
Bytes ParseHex(std::string_view text);

/// "90 3C 40": pairs of upper-case digits, one blank between them.
std::string ToHex(Bytes const& bytes);

/// The words of a text, cut at white space.
std::vector<std::string> SplitWords(std::string_view text);

}  // namespace Ostinet::Tool

// SPDX-License-Identifier: MIT
#pragma once

#include <cstddef>
#include <optional>
#include <vector>

#include "devicetypes/DeviceTypeInfoImpl.h"
#include "ostinet/core/XML.h"

namespace Ostinet::Impl {

/// The decimal number that `text` begins with, if it is at most `max`. White space and a sign may
/// stand in front; whatever follows the digits is ignored.
std::optional<unsigned> ParseDecimal(UString const& text, unsigned max);

/// The same of an attribute of the current element; nothing if the attribute is absent.
std::optional<unsigned> ReadDecimal(XMLLib::Parser const& parser, XMLLib::Name const& name,
                                    unsigned max);

/// The bytes that `text` spells: pairs of digits 0-9 and A-F, each 00 to 7F, with white space
/// anywhere. Nothing if anything else stands there, small letters among them.
std::optional<std::vector<unsigned char>> ParseHexBytes(UString const& text);

}  // namespace Ostinet::Impl

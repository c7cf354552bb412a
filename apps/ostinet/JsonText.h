// SPDX-License-Identifier: MIT
#pragma once

#include <nlohmann/json.hpp>
#include <string>

namespace Ostinet::Tool {

/// Keys stay in the order in which they were put in.
using Json = nlohmann::ordered_json;

/// JSON as one line, and indented for reading. Names may hold what is no whole character; the text
/// is UTF-8 all the same.
std::string JsonLine(Json const& json);
std::string JsonText(Json const& json);

/// Null for an empty text.
Json TextOrNull(std::string const& text);

/// A number of the names: 255 means none, which is null.
Json NumberOrNull(unsigned char number);

}  // namespace Ostinet::Tool

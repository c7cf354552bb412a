// SPDX-License-Identifier: MIT
#include "JsonText.h"

namespace Ostinet::Tool {
namespace {

std::string Dump(Json const& json, int indentation) {
  return json.dump(indentation, ' ', false, Json::error_handler_t::replace);
}

}  // namespace

std::string JsonLine(Json const& json) { return Dump(json, -1); }

std::string JsonText(Json const& json) { return Dump(json, 2); }

Json TextOrNull(std::string const& text) { return text.empty() ? Json() : Json(text); }

Json NumberOrNull(unsigned char number) { return number != 255 ? Json(number) : Json(); }

}  // namespace Ostinet::Tool

// SPDX-License-Identifier: MIT
#include "MonitorLine.h"

#include <algorithm>
#include <cstdio>

#include "JsonText.h"
#include "MessageText.h"

namespace Ostinet::Tool {
namespace {

constexpr size_t kSourceWidth = 20;
constexpr double kClocksPerSecond = 1e7;

}  // namespace

std::string MonitorText(MonitoredMessage const& message, bool hex) {
  std::string source = message.source;
  source.resize(std::max(kSourceWidth, source.size() + 2), ' ');
  return source + (hex ? ToHex(message.bytes) : DescribeMessage(message.bytes));
}

std::string MonitorJSON(MonitoredMessage const& message) {
  Json const json = {
      {"source", message.source}, {"clocks", message.clocks}, {"bytes", ToHex(message.bytes)}};
  return JsonLine(json);
}

std::string SecondsText(unsigned long long clocks, unsigned long long start) {
  auto const ticks = static_cast<long long>(clocks - start);
  char text[40];
  std::snprintf(text, sizeof text, "%11.6f", static_cast<double>(ticks) / kClocksPerSecond);
  return text;
}

}  // namespace Ostinet::Tool

// SPDX-License-Identifier: MIT
#pragma once

#include <string>

#include "HexBytes.h"

namespace Ostinet::Tool {

/// One message that arrived.
struct MonitoredMessage {
  std::string source;
  unsigned long long clocks;  ///< of 100 ns
  Bytes bytes;
};

/// A line for people: the source, then the message in words or in hexadecimal.
std::string MonitorText(MonitoredMessage const& message, bool hex);

/// One JSON object in one line: "source", "clocks", "bytes".
std::string MonitorJSON(MonitoredMessage const& message);

/// "   1.234567": the seconds from `start` to `clocks`, both in clocks of 100 ns. What came before
/// the start is negative.
std::string SecondsText(unsigned long long clocks, unsigned long long start);

}  // namespace Ostinet::Tool

// SPDX-License-Identifier: MIT
#pragma once

#include <optional>
#include <string>
#include <utility>
#include <vector>

#include "ostinet/hostkit/DetectionRun.h"

namespace Ostinet::Tool {

// What a detection found as plain values, as lines for people and as JSON, whose keys docs/tool.md
// lists. Texts are UTF-8.

struct PortName {
  std::string name;
  int uniqueID = 0;
};

struct FindingView {
  std::vector<std::pair<std::string, std::string>> types;  ///< makers and models, likeliest first
  std::optional<int> deviceID;                             ///< as it goes over the wire
  PortName source;
  std::string identity;  ///< hexadecimal bytes, or empty
  std::string reply;
  std::optional<PortName> device;  ///< the device that was made for it
};

struct DetectedPort {
  PortName port;
  DetectionRun::Outcome outcome = DetectionRun::Outcome::kWaiting;
  std::vector<FindingView> findings;
};

DetectedPort ViewPort(DetectionRun::Port const& port);

/// The port, and a line for each instrument on it.
std::vector<std::string> DetectLines(DetectedPort const& port);
std::string DetectJSON(std::vector<DetectedPort> const& ports);

/// One line of at most `width` characters that shows how far the run is.
std::string ProgressLine(DetectionRun::Progress const& progress, std::string const& port,
                         std::size_t width);

}  // namespace Ostinet::Tool

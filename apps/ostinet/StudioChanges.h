// SPDX-License-Identifier: MIT
#pragma once

#include <optional>
#include <string>
#include <vector>

#include "StudioView.h"

namespace Ostinet::Tool {

/// One thing that happened to the studio.
struct Change {
  std::string event;  ///< "added", "removed", "online", ...: docs/tool.md has them all
  std::string kind;   ///< "device", "source" or "destination"
  std::string name;
  int uniqueID = 0;
  std::optional<std::string> was;      ///< of "renamed": the name before
  std::optional<std::string> with;     ///< of "connected" and "disconnected": what hangs there
  std::vector<PlayingView> playing;    ///< of "patch": what plays there now
  std::optional<unsigned short> mask;  ///< of "patch" and "names": the channels, bit 0 the first
};

/// What turned `before` into `after`: first what went, then what came, then what changed.
std::vector<Change> FindChanges(StudioView const& before, StudioView const& after);

/// The change as a line for people.
std::string ChangeText(Change const& change);

/// The change as one JSON object in one line.
std::string ChangeJSON(Change const& change);

}  // namespace Ostinet::Tool

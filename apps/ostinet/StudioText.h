// SPDX-License-Identifier: MIT
#pragma once

#include <optional>
#include <string>
#include <vector>

#include "StudioView.h"

namespace Ostinet::Tool {

/// The studio as a tree for people, one line an element.
std::vector<std::string> StudioLines(StudioView const& view);

/// The studio as one JSON object, indented.
std::string StudioJSON(StudioView const& view);

/// "5 Piano on channel 1".
std::string PlayingText(PlayingView const& patch);

/// "1-4, 10" for a mask of channels, of which bit 0 is channel 1; "none" for 0.
std::string ChannelsText(unsigned short mask);

/// The mask of such a text, or of "all"; nothing for a text that names no channel.
std::optional<unsigned short> ParseChannels(std::string const& text);

}  // namespace Ostinet::Tool

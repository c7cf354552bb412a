// SPDX-License-Identifier: MIT
#pragma once

#include <string>
#include <vector>

#include "ostinet/NameDocument.h"

namespace Ostinet::Tool {

// Name documents as lines for people and as JSON, whose keys docs/tool.md lists.

/// The whole tree. Commands are those of channel 1 and of a device whose ID is not known.
std::string NameDocumentJSON(NameDocument const& document);
/// Modes, name sets, banks and patches, without notes and controls.
std::vector<std::string> NameDocumentLines(NameDocument const& document);

/// What came of checking one file.
struct CheckedNameDocument {
  std::string path;
  NameDocumentCheck check;
};

/// "FILE:LINE: text" for each finding, and a line that says whether the document is standard.
std::vector<std::string> NameCheckLines(CheckedNameDocument const& file);
std::string NameChecksJSON(std::vector<CheckedNameDocument> const& files);

/// The MIDI channels of a cable.
inline constexpr int kChannels = 16;

/// Each message as upper-case hexadecimal bytes.
std::vector<std::string> HexMessages(DataBuffer const& buffer);

}  // namespace Ostinet::Tool

// SPDX-License-Identifier: MIT
#pragma once

#include <string>
#include <utility>
#include <vector>

#include "ostinet/DeviceTypeCatalog.h"

namespace Ostinet::Tool {

// Device types as lines for people and as JSON, whose keys docs/tool.md lists.

/// Makers with the numbers of their types.
using MakerCounts = std::vector<std::pair<std::string, int>>;

std::vector<std::string> MakerLines(MakerCounts const& makers);
std::string MakersJSON(MakerCounts const& makers);

std::vector<std::string> ModelLines(std::vector<DeviceTypeInfo> const& types);
std::string ModelsJSON(std::string const& maker, std::vector<DeviceTypeInfo> const& types);

std::vector<std::string> TypeLines(DeviceTypeInfo const& type);
std::string TypeJSON(DeviceTypeInfo const& type);

/// What came of checking one file.
struct CheckedFile {
  std::string path;
  DeviceTypeFileCheck check;
};

/// "FILE:LINE: text" for each note, or one line that says that all is well.
std::vector<std::string> CheckLines(CheckedFile const& file);
std::string ChecksJSON(std::vector<CheckedFile> const& files);

}  // namespace Ostinet::Tool

// SPDX-License-Identifier: MIT
#pragma once

#include <optional>
#include <string>
#include <vector>

#include "ostinet/DeviceObject.h"

namespace Ostinet::Tool {

/// One thing that a user can say about a device or a port, as text.
struct NamedValue {
  std::string key;
  std::string value;
};

/// All of them, in the order of the help.
std::vector<NamedValue> ReadProperties(DeviceObject const& object);

/// One of them. Throws UsageError for a key that does not exist.
std::string ReadProperty(DeviceObject const& object, std::string const& key);

/// Sets one. Throws UsageError for a key that does not exist or a value that it does not take.
void WriteProperty(DeviceObject const& object, std::string const& key, std::string const& value);

/// All of them as one JSON object: texts, booleans, numbers, and masks of channels.
std::string PropertiesJSON(DeviceObject const& object);

/// The number in sysex messages, 0 to 127; none where nobody stored one.
std::optional<int> SysexDeviceIDOf(DeviceObject const& object);

/// A line for each key, for the help.
std::string PropertiesHelp();

}  // namespace Ostinet::Tool

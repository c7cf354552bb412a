// SPDX-License-Identifier: MIT
#pragma once

#include <map>

#include "JsonText.h"

namespace Ostinet {
class Setup;
}

namespace Ostinet::Tool {

/// What the objects of a studio hold under their own property keys, by the key of the handle. What
/// an object inherits does not stand there again. Numbers, texts, lists and objects of these; a
/// path is a text, with the kind of its folder in front where it starts from one.
using StoredProperties = std::map<unsigned long long, Json>;

/// Reads them through the library's own export, so that keys without an operation show too. Needs
/// a folder for temporary files; throws where it has none. On the polling thread.
StoredProperties ReadStoredProperties(Setup const& setup);

}  // namespace Ostinet::Tool

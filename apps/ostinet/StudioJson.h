// SPDX-License-Identifier: MIT
#pragma once

#include "StoredProperties.h"
#include "StudioView.h"

namespace Ostinet::Tool {

/// The studio as one JSON object. An object whose properties are there has a key `properties` more.
Json StudioTree(StudioView const& view, StoredProperties const& properties);

}  // namespace Ostinet::Tool

// SPDX-License-Identifier: MIT
#pragma once

#include "ostinet/core/XML.h"

namespace Ostinet::Impl {

/// Writes the "Path" element of `path` into the current "File" element; none for an empty path.
void WritePath(XMLLib::Writer& writer, UString const& path);

/// Reads the "Path" child of the current "File" element as a full path, of a file that need not
/// exist. Empty if the child or its folder is missing.
UString ReadPath(XMLLib::Parser& parser);

}  // namespace Ostinet::Impl

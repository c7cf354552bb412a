// SPDX-License-Identifier: MIT
#pragma once

#include <filesystem>

#include "ostinet/core/Files.h"

// Between the texts that hosts see and the paths that the system takes: UTF-8 bytes on one
// system, UTF-16 on another, told apart by the path's own character type.

namespace Ostinet::Impl {

std::filesystem::path ToPath(UString const& text);
inline std::filesystem::path ToPath(FileSpecification const& file) {
  return ToPath(file.GetFullPath());
}

UString FromPath(std::filesystem::path const& path);
inline FileSpecification SpecificationOf(std::filesystem::path const& path) {
  return FileSpecification(FromPath(path));
}

/// A file name made of `name` that every system takes: characters that some cannot hold become
/// "_", and one that would be too long is cut in front of its ending.
UString MakeFileName(UString const& name);
/// "name.ext" with a number put in: "name 2.ext".
UString NumberedFileName(UString const& name, int number);

}  // namespace Ostinet::Impl

// SPDX-License-Identifier: MIT
#pragma once

#include <filesystem>
#include <fstream>
#include <iterator>
#include <string>

#include "ostinet/core/Files.h"
#include "support/TemporaryPath.h"

namespace Ostinet::Testing {

/// A temporary path as the library's own classes see it.
class TemporaryFolder : public TemporaryPath {
 public:
  TemporaryFolder() {}  // not defaulted, so that one may be const

  Folder GetFolder() const { return Folder(FileSpecification(UString(Path().c_str()))); }

  /// A file of this content, with the folders on the way to it.
  File Write(std::string const& name, std::string const& content) const {
    std::filesystem::path const path = Path() / name;
    std::filesystem::create_directories(path.parent_path());
    std::ofstream(path, std::ios::binary) << content;
    return File(FileSpecification(UString(path.c_str())));
  }

  std::string Read(std::string const& name) const {
    std::ifstream stream(Path() / name, std::ios::binary);
    return {std::istreambuf_iterator<char>(stream), std::istreambuf_iterator<char>()};
  }

  std::size_t CountEntries() const {
    return static_cast<std::size_t>(std::distance(std::filesystem::directory_iterator(Path()),
                                                  std::filesystem::directory_iterator()));
  }
};

}  // namespace Ostinet::Testing

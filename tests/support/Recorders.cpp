// SPDX-License-Identifier: MIT
#include "support/Recorders.h"

#include <fstream>

namespace Ostinet::Testing {

UString SystemPath(UString const& path) {
  std::filesystem::path const separators = std::filesystem::path("/").make_preferred();
  UString written;
  for (std::size_t i = 0; i < path.length(); ++i) {
    written += path[i] == u'/' ? static_cast<char16_t>(separators.string()[0]) : path[i];
  }
  return written;
}

UString MemoryPrefs::MakeFile(std::string const& name, std::string const& content) {
  std::filesystem::path const path = (folder / name).make_preferred();
  std::filesystem::create_directories(path.parent_path());
  std::ofstream(path, std::ios::binary) << content;
  return UString(path.string().c_str());
}

}  // namespace Ostinet::Testing

// SPDX-License-Identifier: MIT
#pragma once

#include <atomic>
#include <chrono>
#include <filesystem>
#include <fstream>
#include <iterator>
#include <string>

#include "ostinet/core/Files.h"

namespace Ostinet::Testing {

/// An empty folder that goes with all its content when the test ends.
class TemporaryFolder {
 public:
  TemporaryFolder() {
    static std::atomic<int> sCount{0};
    auto const now = std::chrono::steady_clock::now().time_since_epoch().count();
    do {
      path_ = std::filesystem::temp_directory_path() /
              ("ostinet-test-" + std::to_string(now) + "-" + std::to_string(++sCount));
    } while (!std::filesystem::create_directories(path_));
  }
  TemporaryFolder(TemporaryFolder const&) = delete;
  TemporaryFolder& operator=(TemporaryFolder const&) = delete;
  ~TemporaryFolder() {
    std::error_code ignored;
    std::filesystem::remove_all(path_, ignored);
  }

  std::filesystem::path const& Path() const { return path_; }
  Folder GetFolder() const { return Folder(FileSpecification(UString(path_.c_str()))); }

  /// A file of this content, with the folders on the way to it.
  File Write(std::string const& name, std::string const& content) const {
    std::filesystem::path const path = path_ / name;
    std::filesystem::create_directories(path.parent_path());
    std::ofstream(path, std::ios::binary) << content;
    return File(FileSpecification(UString(path.c_str())));
  }

  std::string Read(std::string const& name) const {
    std::ifstream stream(path_ / name, std::ios::binary);
    return {std::istreambuf_iterator<char>(stream), std::istreambuf_iterator<char>()};
  }

  std::size_t CountEntries() const {
    return static_cast<std::size_t>(std::distance(std::filesystem::directory_iterator(path_),
                                                  std::filesystem::directory_iterator()));
  }

 private:
  std::filesystem::path path_;
};

}  // namespace Ostinet::Testing

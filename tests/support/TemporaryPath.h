// SPDX-License-Identifier: MIT
#pragma once

#include <atomic>
#include <chrono>
#include <filesystem>
#include <string>

namespace Ostinet::Testing {

/// The path of an empty folder that goes with all its content when the test ends. No two have one
/// path, also of a test that runs once more while a program that it left behind still holds files.
class TemporaryPath {
 public:
  TemporaryPath() {
    static std::atomic<int> sCount{0};
    auto const now = std::chrono::steady_clock::now().time_since_epoch().count();
    do {
      path_ = std::filesystem::temp_directory_path() /
              ("ostinet-test-" + std::to_string(now) + "-" + std::to_string(++sCount));
    } while (!std::filesystem::create_directories(path_));
  }
  TemporaryPath(TemporaryPath const&) = delete;
  TemporaryPath& operator=(TemporaryPath const&) = delete;
  ~TemporaryPath() {
    std::error_code ignored;
    std::filesystem::remove_all(path_, ignored);
  }

  std::filesystem::path const& Path() const { return path_; }

 private:
  std::filesystem::path path_;
};

}  // namespace Ostinet::Testing

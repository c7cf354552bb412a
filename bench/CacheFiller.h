// SPDX-License-Identifier: MIT
#pragma once

#include <benchmark/benchmark.h>

#include <cstddef>
#include <vector>

namespace Ostinet::Bench {

/// Fills the caches with memory of its own.
class CacheFiller {
 public:
  void Fill() {
    for (std::size_t i = 0; i < memory_.size(); i += kLine) {
      ++memory_[i];
    }
    benchmark::DoNotOptimize(memory_.data());
  }

 private:
  static constexpr std::size_t kLine = 64;
  std::vector<unsigned char> memory_ = std::vector<unsigned char>(64u << 20);
};

}  // namespace Ostinet::Bench

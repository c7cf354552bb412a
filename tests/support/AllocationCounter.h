// SPDX-License-Identifier: MIT
#pragma once

#include <cstddef>

namespace Ostinet::Testing {

/// Counts what `operator new` is asked for in this program, on all threads, while it lives. A
/// program that uses it has AllocationCounter.cpp among its sources, which replaces the operators.
class AllocationCounter {
 public:
  AllocationCounter();
  AllocationCounter(AllocationCounter const&) = delete;
  AllocationCounter& operator=(AllocationCounter const&) = delete;

  /// The allocations since the counter was made.
  std::size_t Count() const;

 private:
  std::size_t start_;
};

}  // namespace Ostinet::Testing

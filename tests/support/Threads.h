// SPDX-License-Identifier: MIT
#pragma once

#include <functional>
#include <thread>
#include <vector>

#include "support/Latch.h"

namespace Ostinet::Testing {

/// Runs `work(index)` on so many threads, which all start at one moment, and waits for them.
inline void RunTogether(int count, std::function<void(int)> const& work) {
  Latch ready(count);
  std::vector<std::thread> threads;
  for (int i = 0; i < count; ++i) {
    threads.emplace_back([&ready, &work, i] {
      ready.arrive_and_wait();
      work(i);
    });
  }
  for (std::thread& thread : threads) {
    thread.join();
  }
}

}  // namespace Ostinet::Testing

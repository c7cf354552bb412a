// SPDX-License-Identifier: MIT
#include <gtest/gtest.h>

#include <atomic>
#include <thread>
#include <vector>

#include "core/PerThread.h"

namespace Ostinet {
namespace {

std::atomic<int> sAlive{0};

struct Counted {
  Counted() { ++sAlive; }
  ~Counted() {
    for (int const value : values) sum += value;
    --sAlive;
  }
  std::vector<int> values;
  int sum = 0;
};

TEST(PerThread, GivesEachThreadItsOwnAndFreesItAtTheThreadsEnd) {
  static PerThread<Counted> sSlot;
  (*sSlot).values.push_back(1);
  for (int round = 0; round < 50; ++round) {
    std::thread other([] {
      EXPECT_TRUE((*sSlot).values.empty());
      (*sSlot).values.assign(100, 2);
      EXPECT_EQ(sAlive, 2);
    });
    other.join();
    ASSERT_EQ(sAlive, 1);
  }
  EXPECT_EQ((*sSlot).values, std::vector<int>{1});
}

}  // namespace
}  // namespace Ostinet

// SPDX-License-Identifier: MIT
#include <gtest/gtest.h>

#include <thread>

#include "core/Semaphore.h"

namespace Ostinet {
namespace {

TEST(BinarySemaphore, StartsAsItIsTold) {
  VantorBinarySemaphore signalled(true);
  signalled.Wait();
  VantorBinarySemaphore silent(false);
  EXPECT_EQ(silent.TimedWait(0), WakeReason::kTimedOut);
}

TEST(BinarySemaphore, CountsManySignalsAsOne) {
  VantorBinarySemaphore semaphore(false);
  semaphore.Signal();
  semaphore.Signal();
  EXPECT_EQ(semaphore.TimedWait(0), WakeReason::kSignalled);
  EXPECT_EQ(semaphore.TimedWait(0), WakeReason::kTimedOut);
}

TEST(BinarySemaphore, GivesUpWhenItsTimeIsOver) {
  VantorBinarySemaphore semaphore(false);
  EXPECT_EQ(semaphore.TimedWait(1000), WakeReason::kTimedOut);
}

TEST(BinarySemaphoreThreads, WakeWhoeverWaits) {
  VantorBinarySemaphore there(false);
  VantorBinarySemaphore back(false);
  std::thread other([&] {
    for (int i = 0; i < 1000; ++i) {
      there.Wait();
      back.Signal();
    }
  });
  for (int i = 0; i < 1000; ++i) {
    there.Signal();
    // The longest wait there is: only a lost signal could end it.
    ASSERT_EQ(back.TimedWait(~0ULL), WakeReason::kSignalled);
  }
  other.join();
}

}  // namespace
}  // namespace Ostinet

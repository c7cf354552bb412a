// SPDX-License-Identifier: MIT
#include <gtest/gtest.h>

#include <atomic>
#include <thread>

#include "platform/system/SystemWaits.h"

namespace Ostinet::Impl {
namespace {

constexpr DWORD kFirst = WAIT_OBJECT_0;

class SystemWaits : public testing::Test {
 protected:
  std::unique_ptr<Waits> waits_ = MakeSystemWaits();
};

TEST_F(SystemWaits, SemaphoreCountsDownToATimeout) {
  HANDLE const semaphore = waits_->CreateSemaphoreW(2, 256);
  EXPECT_EQ(waits_->WaitForSingleObject(semaphore, 0), kFirst);
  EXPECT_EQ(waits_->WaitForSingleObject(semaphore, 0), kFirst);
  EXPECT_EQ(waits_->WaitForSingleObject(semaphore, 0), WAIT_TIMEOUT);
  EXPECT_TRUE(waits_->CloseHandle(semaphore));
}

TEST_F(SystemWaits, ReleasingBeyondTheMaximumFailsAndKeepsTheCount) {
  HANDLE const semaphore = waits_->CreateSemaphoreW(2, 3);
  EXPECT_FALSE(waits_->ReleaseSemaphore(semaphore, 2));
  EXPECT_EQ(waits_->GetLastError(), 298u);
  EXPECT_TRUE(waits_->ReleaseSemaphore(semaphore, 1));
  for (int i = 0; i < 3; ++i) EXPECT_EQ(waits_->WaitForSingleObject(semaphore, 0), kFirst);
  EXPECT_EQ(waits_->WaitForSingleObject(semaphore, 0), WAIT_TIMEOUT);
  waits_->CloseHandle(semaphore);
}

TEST_F(SystemWaits, ImpossibleSemaphoresAreRefused) {
  EXPECT_EQ(waits_->CreateSemaphoreW(2, 1), nullptr);
  EXPECT_EQ(waits_->GetLastError(), DWORD{ERROR_INVALID_PARAMETER});
  EXPECT_EQ(waits_->CreateSemaphoreW(0, 0), nullptr);
  EXPECT_EQ(waits_->CreateSemaphoreW(-1, 1), nullptr);
}

TEST_F(SystemWaits, EventResetsItselfAndSignalsDoNotAddUp) {
  HANDLE const event = waits_->CreateEventW();
  EXPECT_EQ(waits_->WaitForSingleObject(event, 0), WAIT_TIMEOUT);
  waits_->SetEvent(event);
  waits_->SetEvent(event);
  EXPECT_EQ(waits_->WaitForSingleObject(event, 0), kFirst);
  EXPECT_EQ(waits_->WaitForSingleObject(event, 0), WAIT_TIMEOUT);
  waits_->CloseHandle(event);
}

TEST_F(SystemWaits, TimerStaysSignalledUntilItIsSetAgain) {
  HANDLE const timer = waits_->CreateWaitableTimerW();
  EXPECT_EQ(waits_->WaitForSingleObject(timer, 0), WAIT_TIMEOUT);
  EXPECT_TRUE(waits_->SetWaitableTimer(timer, -10000));
  EXPECT_EQ(waits_->WaitForSingleObject(timer, INFINITE), kFirst);
  EXPECT_EQ(waits_->WaitForSingleObject(timer, 0), kFirst);
  EXPECT_TRUE(waits_->SetWaitableTimer(timer, -36000000000));
  EXPECT_EQ(waits_->WaitForSingleObject(timer, 0), WAIT_TIMEOUT);
  EXPECT_TRUE(waits_->SetWaitableTimer(timer, 0));
  EXPECT_EQ(waits_->WaitForSingleObject(timer, INFINITE), kFirst);
  waits_->CloseHandle(timer);
}

TEST_F(SystemWaits, WaitForAnyTakesTheFirstThatIsSignalledAndLeavesTheOthers) {
  HANDLE const objects[] = {waits_->CreateSemaphoreW(0, 1), waits_->CreateSemaphoreW(1, 1),
                            waits_->CreateSemaphoreW(1, 1)};
  EXPECT_EQ(waits_->WaitForMultipleObjects(3, objects, INFINITE), kFirst + 1);
  EXPECT_EQ(waits_->WaitForMultipleObjects(3, objects, INFINITE), kFirst + 2);
  EXPECT_EQ(waits_->WaitForMultipleObjects(3, objects, 0), WAIT_TIMEOUT);
  for (HANDLE object : objects) waits_->CloseHandle(object);
}

TEST_F(SystemWaits, ClosedHandlesAreNoHandles) {
  HANDLE const semaphore = waits_->CreateSemaphoreW(0, 1);
  EXPECT_TRUE(waits_->CloseHandle(semaphore));
  EXPECT_FALSE(waits_->ReleaseSemaphore(semaphore, 1));
  EXPECT_EQ(waits_->GetLastError(), DWORD{ERROR_INVALID_HANDLE});
  EXPECT_EQ(waits_->WaitForSingleObject(semaphore, 0), WAIT_FAILED);
  EXPECT_FALSE(waits_->CloseHandle(semaphore));
}

TEST(SystemWaitsThreads, EveryReleaseWakesOneWaiterOnce) {
  auto const waits = MakeSystemWaits();
  HANDLE const quit = waits->CreateSemaphoreW(0, 4);
  HANDLE const items = waits->CreateSemaphoreW(0, 4000);
  std::atomic<int> taken{0};
  std::thread workers[4];
  for (auto& worker : workers) {
    worker = std::thread([&] {
      HANDLE const objects[] = {items, quit};
      while (waits->WaitForMultipleObjects(2, objects, INFINITE) == kFirst) ++taken;
    });
  }
  for (int i = 0; i < 4000; ++i) EXPECT_TRUE(waits->ReleaseSemaphore(items, 1));
  // Items stand first in the wait, so all of them are taken before a worker sees the end.
  waits->ReleaseSemaphore(quit, 4);
  for (auto& worker : workers) worker.join();
  EXPECT_EQ(taken, 4000);
  waits->CloseHandle(items);
  waits->CloseHandle(quit);
}

TEST(SystemWaitsThreads, ATimerThatIsSetEarlierWakesItsWaiter) {
  auto const waits = MakeSystemWaits();
  HANDLE const timer = waits->CreateWaitableTimerW();
  waits->SetWaitableTimer(timer, -36000000000);
  DWORD result = 1;
  std::thread waiter([&] { result = waits->WaitForSingleObject(timer, INFINITE); });
  waits->SetWaitableTimer(timer, 0);
  waiter.join();
  EXPECT_EQ(result, kFirst);
  waits->CloseHandle(timer);
}

TEST(SystemWaitsThreads, ErrorsBelongToTheirThread) {
  auto const waits = MakeSystemWaits();
  HANDLE const semaphore = waits->CreateSemaphoreW(1, 1);
  // Making or joining a thread may itself set this thread's error: neither happens in between.
  std::atomic<bool> mayFail{false};
  std::atomic<bool> hasFailed{false};
  std::thread other([&] {
    while (!mayFail) {
    }
    waits->CloseHandle(nullptr);
    hasFailed = true;
  });
  EXPECT_FALSE(waits->ReleaseSemaphore(semaphore, 1));
  mayFail = true;
  while (!hasFailed) {
  }
  EXPECT_EQ(waits->GetLastError(), 298u);
  other.join();
  waits->CloseHandle(semaphore);
}

}  // namespace
}  // namespace Ostinet::Impl

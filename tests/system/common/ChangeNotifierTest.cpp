// SPDX-License-Identifier: MIT
#include <gtest/gtest.h>

#include <atomic>
#include <thread>

#include "platform/system/common/ChangeNotifier.h"
#include "platform/system/common/ChangeWatch.h"
#include "support/Latch.h"

namespace Ostinet::Impl {
namespace {

TEST(ChangeNotifier, CallsEachListenerUntilItsPlaceIsGivenUp) {
  ChangeNotifier notifier;
  int first = 0;
  int second = 0;
  auto place = notifier.Add([&first] { ++first; });
  auto const other = notifier.Add([&second] { ++second; });
  notifier.Notify();
  place.reset();
  notifier.Notify();
  EXPECT_EQ(first, 1);
  EXPECT_EQ(second, 2);
  EXPECT_TRUE(notifier.HasListeners());
}

TEST(ChangeNotifier, AListenerMayGiveItsPlaceUpInItsCall) {
  ChangeNotifier notifier;
  int calls = 0;
  std::shared_ptr<void> place;
  place = notifier.Add([&] {
    ++calls;
    place.reset();
  });
  notifier.Notify();
  notifier.Notify();
  EXPECT_EQ(calls, 1);
}

TEST(ChangeNotifier, APlaceOutlivesTheNotifier) {
  std::shared_ptr<void> place;
  {
    ChangeNotifier notifier;
    place = notifier.Add([] {});
  }
  place.reset();
  EXPECT_EQ(place, nullptr);
}

TEST(ChangeNotifier, GivingUpWaitsForARunningCall) {
  ChangeNotifier notifier;
  Testing::Latch entered(1);
  Testing::Latch mayLeave(1);
  std::atomic<bool> left{false};
  auto place = notifier.Add([&] {
    entered.count_down();
    mayLeave.wait();
    left = true;
  });
  std::thread notifying([&notifier] { notifier.Notify(); });
  entered.wait();
  std::thread helper([&mayLeave] { mayLeave.count_down(); });
  place.reset();
  EXPECT_TRUE(left);
  notifying.join();
  helper.join();
}

TEST(ChangeWatch, TellsOnlyWhenALookFoundAChange) {
  std::atomic<int> looks{0};
  std::atomic<int> looksWhenTold{0};
  Testing::Latch told(1);
  ChangeWatch watch([&looks] { return ++looks == 2; });
  auto const place = watch.Add([&] {
    looksWhenTold = looks.load();
    told.count_down();
  });
  watch.Hint();
  EXPECT_TRUE(told.wait_for(std::chrono::seconds(20)));
  EXPECT_EQ(looksWhenTold, 2);
}

}  // namespace
}  // namespace Ostinet::Impl

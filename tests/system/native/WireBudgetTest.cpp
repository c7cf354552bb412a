// SPDX-License-Identifier: MIT
#include <gtest/gtest.h>

#include "platform/system/native/WireBudget.h"

namespace Ostinet::Impl {
namespace {

using std::chrono::seconds;

WireBudget::Time At(std::chrono::steady_clock::duration since) {
  return WireBudget::Time(std::chrono::hours(1) + since);
}

TEST(WireBudget, ABurstGoesOutAtOnce) {
  WireBudget budget;
  for (int i = 0; i < 8; ++i) EXPECT_EQ(budget.Spend(256, At({})).count(), 0);
  EXPECT_GT(budget.Spend(256, At({})).count(), 0);
}

TEST(WireBudget, ADumpThenFlowsAtTheRateOfACable) {
  WireBudget budget;
  budget.Spend(2048, At({}));
  auto const wait = budget.Spend(3125, At({}));
  EXPECT_NEAR(std::chrono::duration<double>(wait).count(), 1.0, 0.001);
}

TEST(WireBudget, ARestEarnsTheBurstAgain) {
  WireBudget budget;
  budget.Spend(2048, At({}));
  EXPECT_EQ(budget.Spend(2048, At(seconds(1))).count(), 0);
}

TEST(WireBudget, ShortMessagesAreHeldUpMuchLater) {
  WireBudget budget;
  int count = 0;
  while (budget.Spend(3, At({})).count() == 0) ++count;
  EXPECT_NEAR(count, 2048 * 20 / 3, 1);
}

}  // namespace
}  // namespace Ostinet::Impl

// SPDX-License-Identifier: MIT
#include <gtest/gtest.h>

#include <thread>

#include "core/Future.h"
#include "support/Printers.h"

namespace Ostinet {
namespace {

VantorError ErrorOf(VantorFuture<int> const& future) {
  try {
    future.Try(0);
  } catch (VantorError const& error) {
    return error;
  }
  return VantorError();
}

TEST(Future, GivesNothingUntilThereIsAValue) {
  VantorPromise<int> promise;
  auto const future = promise.GetFuture();
  EXPECT_EQ(future->Try(0), std::nullopt);
  EXPECT_EQ(future->Try(1), std::nullopt);
  EXPECT_FALSE(future->IsComplete());
  promise.Complete(5);
  EXPECT_TRUE(future->IsComplete());
  EXPECT_EQ(future->Try(0), 5);
}

TEST(Future, GivesItsValueAgain) {
  VantorPromise<int> promise;
  promise.Complete(5);
  EXPECT_EQ(promise.GetFuture()->Try(0), 5);
  EXPECT_EQ(promise.GetFuture()->Try(0), 5);
}

TEST(Future, ThrowsTheErrorThatStandsForTheValue) {
  VantorPromise<int> promise;
  promise.Fail(VantorError("Windows", "", 5, "no"));
  EXPECT_EQ(ErrorOf(*promise.GetFuture()).Code(), 5);
}

TEST(Future, TakesTheFirstOutcomeOnly) {
  VantorPromise<int> promise;
  promise.Complete(5);
  promise.Complete(6);
  promise.Cancel();
  EXPECT_EQ(promise.GetFuture()->Try(0), 5);
}

TEST(Future, OfADroppedPromiseIsCancelled) {
  auto const future = VantorPromise<int>().GetFuture();
  VantorError const error = ErrorOf(*future);
  EXPECT_EQ(error.Domain(), "VantorThreads");
  EXPECT_EQ(error.Component(), "VantorJobQueue");
  EXPECT_EQ(error.Code(), 0);
  EXPECT_EQ(error.Text(), "Job cancelled");
}

TEST(FutureThreads, WakeWhoeverWaits) {
  for (int round = 0; round < 200; ++round) {
    auto promise = std::make_unique<VantorPromise<int>>();
    auto const future = promise->GetFuture();
    std::thread other([&promise, round] {
      promise->Complete(round);
      promise.reset();
    });
    EXPECT_EQ(future->Try(60'000), round);
    other.join();
  }
}

}  // namespace
}  // namespace Ostinet

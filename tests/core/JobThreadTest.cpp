// SPDX-License-Identifier: MIT
#include <gtest/gtest.h>

#include <stdexcept>
#include <vector>

#include "core/JobThread.h"
#include "support/Latch.h"
#include "support/Printers.h"
#include "support/Threads.h"

namespace Ostinet {
namespace {

constexpr unsigned int kPatience = 60'000;  // milliseconds; a wait that ends sooner or fails

template <class T>
VantorError AwaitedErrorOf(VantorFuture<T> const& future) {
  try {
    future.Try(kPatience);
  } catch (VantorError const& error) {
    return error;
  }
  return VantorError();
}

TEST(JobThreads, RunJobsInTheirOrderOnOneThread) {
  VantorJobThread thread("Test Thread", 0);
  thread.Start();
  std::vector<int> order;
  std::shared_ptr<VantorFuture<std::thread::id>> last;
  for (int i = 0; i < 10; ++i) {
    last = thread.Post<std::thread::id>([&order, i] {
      order.push_back(i);
      return std::this_thread::get_id();
    });
  }
  EXPECT_NE(last->Try(kPatience), std::this_thread::get_id());
  EXPECT_EQ(order, (std::vector<int>{0, 1, 2, 3, 4, 5, 6, 7, 8, 9}));
}

TEST(JobThreads, HoldJobsUntilTheyAreStarted) {
  VantorJobThread thread("Test Thread");
  auto const future = thread.Post<int>([] { return 5; });
  EXPECT_EQ(future->Try(0), std::nullopt);
  thread.Start();
  thread.Start();
  EXPECT_EQ(future->Try(kPatience), 5);
}

// Who takes down what the work used has the outcome as his sign that the thread is done with it.
TEST(JobThreads, LetGoOfWhatTheWorkHoldsBeforeItsOutcomeIsTold) {
  VantorJobThread thread("Test Thread");
  std::shared_ptr<VantorFuture<int>> future;
  bool wasTold = true;
  std::shared_ptr<int> held(new int(5), [&](int* value) {
    wasTold = future->IsComplete();
    delete value;
  });
  future = thread.Post<int>([held] { return *held; });
  held.reset();
  thread.Start();
  EXPECT_EQ(future->Try(kPatience), 5);
  EXPECT_FALSE(wasTold);
}

TEST(JobThreads, PassErrorsToTheFutureAndGoOn) {
  VantorJobThread thread("Test Thread");
  thread.Start();
  auto const failing = thread.Post<int>([]() -> int { throw VantorError(7); });
  auto const odd = thread.Post<int>([]() -> int { throw std::runtime_error("no luck"); });
  EXPECT_EQ(AwaitedErrorOf(*failing).Code(), 7);
  EXPECT_EQ(AwaitedErrorOf(*odd).Text(), "no luck");
  EXPECT_EQ(thread.Post<int>([] { return 1; })->Try(kPatience), 1);
}

struct ThrowingJob : VantorJobQueueJob {
  void Run() override { throw 4711; }
  void Cancel() override {}
};

TEST(JobThreads, SurviveAJobThatThrows) {
  VantorJobThread thread("Test Thread");
  thread.Start();
  thread.GetJobQueue().push(std::make_shared<ThrowingJob>());
  EXPECT_EQ(thread.Post<int>([] { return 1; })->Try(kPatience), 1);
}

TEST(JobThreads, FinishTheRunningJobAndCancelTheOthersAtTheEnd) {
  VantorJobThread thread("Test Thread");
  Testing::Latch started(1);
  Testing::Latch goOn(1);
  auto const running = thread.Post<int>([&] {
    started.count_down();
    goOn.wait();
    return 1;
  });
  auto const waiting = thread.Post<int>([] { return 2; });
  thread.Start();
  started.wait();
  std::thread ender([&thread] { thread.Terminate(); });
  VantorError const error = AwaitedErrorOf(*waiting);
  goOn.count_down();
  ender.join();
  EXPECT_EQ(error.Component(), "VantorJobQueue");
  EXPECT_EQ(error.Text(), "Job cancelled");
  EXPECT_EQ(running->Try(0), 1);
}

TEST(JobThreads, RefuseWorkOnceTerminated) {
  VantorJobThread thread("Test Thread");
  thread.Start();
  EXPECT_FALSE(thread.IsTerminated());
  thread.Terminate();
  thread.Terminate();
  EXPECT_TRUE(thread.IsTerminated());
  auto const future = thread.Post<int>([] { return 1; });
  ASSERT_TRUE(future->IsComplete());
  VantorError const error = AwaitedErrorOf(*future);
  EXPECT_EQ(error.Domain(), "VantorThreads");
  EXPECT_EQ(error.Component(), "VantorJobThread");
  EXPECT_EQ(error.Text(), "Thread terminated");
}

TEST(JobThreads, AreNotStartedOnceTerminated) {
  VantorJobThread thread("Test Thread");
  auto const future = thread.Post<int>([] { return 1; });
  thread.Terminate();
  thread.Start();
  EXPECT_EQ(AwaitedErrorOf(*future).Text(), "Job cancelled");
}

TEST(JobThreads, MayBeTerminatedByAJobOfTheirOwn) {
  VantorJobThread thread("Test Thread");
  thread.Start();
  auto const future = thread.Post<int>([&thread] {
    thread.Terminate();
    return 1;
  });
  EXPECT_EQ(future->Try(kPatience), 1);
  EXPECT_TRUE(thread.IsTerminated());
}

TEST(JobThreads, CompleteEveryFutureWhateverTheMomentOfTheEnd) {
  for (int round = 0; round < 100; ++round) {
    VantorJobThread thread("Test Thread");
    thread.Start();
    std::shared_ptr<VantorFuture<int>> futures[3];
    Testing::RunTogether(4, [&](int index) {
      if (index == 3) {
        thread.Terminate();
      } else {
        futures[index] = thread.Post<int>([] { return 1; });
      }
    });
    for (auto const& future : futures) {
      EXPECT_TRUE(future->IsComplete());
    }
  }
}

}  // namespace
}  // namespace Ostinet

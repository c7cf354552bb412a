// SPDX-License-Identifier: MIT
#include <gtest/gtest.h>

#include <atomic>
#include <future>
#include <stdexcept>
#include <thread>
#include <vector>

#include "ostinet/hostkit/PollLoop.h"

namespace Ostinet {
namespace {

using std::chrono::hours;
using std::chrono::milliseconds;

// Counts its calls; polls come once, input as fast as it can.
class Loop : public testing::Test {
 protected:
  PollLoop::Calls Calls() {
    return {[this] { ++polls; }, [this] { ++setupChanges; },
            [this] {
              ++inputs;
              if (onInput) {
                onInput();
              }
            },
            hours(1), hours(1)};
  }

  static PollLoop::Options Options() {
    PollLoop::Options options;
    options.inputPeriod = milliseconds(1);
    options.hurriedInterval = milliseconds(1);
    options.hurryLasts = hours(1);
    return options;
  }

  std::atomic<int> polls{0};
  std::atomic<int> setupChanges{0};
  std::atomic<int> inputs{0};
  std::function<void()> onInput;
};

TEST_F(Loop, CallsWhatIsDueOnTheCallersThread) {
  PollLoop loop(Options(), Calls());
  std::thread::id inputThread;
  onInput = [&] { inputThread = std::this_thread::get_id(); };
  loop.Run([&] { return inputs < 3; });
  EXPECT_EQ(polls, 1);
  EXPECT_EQ(setupChanges, 1);
  EXPECT_EQ(inputs, 3);
  EXPECT_EQ(inputThread, std::this_thread::get_id());
}

TEST_F(Loop, RunsOnAThreadOfItsOwn) {
  PollLoop loop(Options(), Calls());
  loop.Start();
  std::thread::id const thread = loop.Call([] { return std::this_thread::get_id(); });
  EXPECT_NE(thread, std::this_thread::get_id());
  EXPECT_FALSE(loop.IsLoopThread());
  EXPECT_TRUE(loop.Call([&] { return loop.IsLoopThread(); }));
  loop.Stop();
}

TEST_F(Loop, RunsTasksInTheOrderOfTheirPosting) {
  PollLoop loop(Options(), Calls());
  std::vector<int> order;
  for (int i = 0; i < 5; ++i) {
    loop.Post([&order, i] { order.push_back(i); });
  }
  loop.Run([&] { return order.size() < 5; });
  EXPECT_EQ(order, (std::vector<int>{0, 1, 2, 3, 4}));
}

TEST_F(Loop, TakesTasksFromManyThreads) {
  PollLoop loop(Options(), Calls());
  loop.Start();
  int count = 0;  // Only the loop's thread touches it.
  std::vector<std::thread> threads;
  for (int i = 0; i < 4; ++i) {
    threads.emplace_back([&] {
      for (int k = 0; k < 100; ++k) {
        loop.Call([&] { ++count; });
      }
    });
  }
  for (std::thread& thread : threads) {
    thread.join();
  }
  EXPECT_EQ(loop.Call([&] { return count; }), 400);
}

TEST_F(Loop, CallsAtOnceOnItsOwnThread) {
  PollLoop loop(Options(), Calls());
  loop.Start();
  EXPECT_EQ(loop.Call([&] { return loop.Call([] { return 7; }); }), 7);
}

TEST_F(Loop, GivesTheErrorOfACallToItsCaller) {
  PollLoop loop(Options(), Calls());
  loop.Start();
  EXPECT_THROW(loop.Call([]() -> int { throw std::runtime_error("no"); }), std::runtime_error);
  EXPECT_EQ(loop.Call([] { return 1; }), 1);
}

TEST_F(Loop, TellsErrorsOfPollsAndTasksAndGoesOn) {
  PollLoop::Options options = Options();
  int errors = 0;
  options.onError = [&](std::exception_ptr) { ++errors; };
  PollLoop loop(options, Calls());
  onInput = [&] {
    if (inputs == 1) {
      throw std::runtime_error("once");
    }
  };
  loop.Post([] { throw 5; });
  loop.Run([&] { return inputs < 3; });
  EXPECT_EQ(errors, 2);
}

TEST_F(Loop, GoesOnWithoutAnybodyToTellErrors) {
  PollLoop loop(Options(), Calls());
  onInput = [] { throw std::runtime_error("always"); };
  loop.Run([&] { return inputs < 3; });
  EXPECT_EQ(inputs, 3);
}

TEST_F(Loop, StopsFromWithinACall) {
  PollLoop loop(Options(), Calls());
  onInput = [&] { loop.Stop(); };
  loop.Run();
  EXPECT_EQ(inputs, 1);
}

TEST_F(Loop, StopsBeforeTheNextTask) {
  PollLoop loop(Options(), Calls());
  bool second = false;
  loop.Post([&] { loop.Stop(); });
  loop.Post([&] { second = true; });
  loop.Run();
  EXPECT_FALSE(second);
  EXPECT_EQ(inputs, 0);
}

// The input period would let it sleep for an hour.
TEST_F(Loop, StopsPromptlyWhileItWaits) {
  PollLoop::Options options = Options();
  options.inputPeriod = hours(1);
  PollLoop loop(options, Calls());
  loop.Start();
  loop.Call([] {});
  loop.Stop();
  EXPECT_LE(inputs, 1);
}

TEST_F(Loop, AStopBeforeTheRunEndsIt) {
  PollLoop loop(Options(), Calls());
  loop.Stop();
  loop.Run();
  EXPECT_EQ(inputs, 0);
  loop.Run([&] { return inputs < 1; });  // Only the one run was stopped.
  EXPECT_EQ(inputs, 1);
}

TEST_F(Loop, StartsAnewAfterAStop) {
  PollLoop loop(Options(), Calls());
  loop.Start();
  loop.Stop();
  loop.Start();
  EXPECT_EQ(loop.Call([] { return 3; }), 3);
}

TEST_F(Loop, ACallThatAStopDropsDoesNotWaitForEver) {
  PollLoop loop(Options(), Calls());
  loop.Stop();
  EXPECT_THROW(loop.Call([] {}), std::future_error);
}

TEST_F(Loop, ACallThatWaitsWhenTheLoopStopsEnds) {
  PollLoop loop(Options(), Calls());
  std::promise<void> entered;
  std::promise<void> goOn;
  loop.Start();
  loop.Post([&] {
    entered.set_value();
    goOn.get_future().wait();
    loop.Stop();
  });
  entered.get_future().wait();
  auto waiting = std::async(std::launch::async, [&] {
    goOn.set_value();
    loop.Call([] {});
  });
  EXPECT_THROW(waiting.get(), std::future_error);
}

TEST_F(Loop, HurriesWithPollsForChanges) {
  PollLoop loop(Options(), Calls());
  loop.Hurry();
  loop.Run([&] { return setupChanges < 5; });
  EXPECT_EQ(setupChanges, 5);
  EXPECT_EQ(polls, 1);
}

TEST_F(Loop, TravelsOnWithWhatTheConditionThrows) {
  PollLoop loop(Options(), Calls());
  EXPECT_THROW(loop.Run([]() -> bool { throw std::runtime_error("enough"); }), std::runtime_error);
  EXPECT_FALSE(loop.IsLoopThread());
}

}  // namespace
}  // namespace Ostinet

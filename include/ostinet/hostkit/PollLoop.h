// SPDX-License-Identifier: MIT
#pragma once

#include <chrono>
#include <exception>
#include <functional>
#include <future>
#include <memory>
#include <utility>

#include "ostinet/core/Noncopyable.h"

namespace Ostinet {

/// Drives the library on one thread: Setup::Poll and Setup::PollSetupChanges at the intervals
/// that they ask for, Setup::ProcessInput at a short period, and whatever other threads hand in
/// to be done where the model lives.
///
/// Ownership    The host's. Destroying it stops it.
/// Threads      The loop runs either on a thread of its own (Start) or on the caller's (Run);
///              that thread is the one to sign in, to sign out and to touch the model on. Post,
///              Call, Hurry and Stop: [any thread].
/// Errors       What a poll, input or a posted task throws goes to Options::onError, and the
///              loop goes on. What a task of Call throws reaches its caller.
class PollLoop : private Noncopyable<PollLoop> {
 public:
  using Clock = std::chrono::steady_clock;
  using Duration = Clock::duration;

  /// What the loop calls, and how often.
  struct Calls {
    std::function<void()> poll;
    std::function<void()> pollSetupChanges;
    std::function<void()> processInput;
    Duration pollInterval;
    Duration pollSetupChangesInterval;
  };
  /// The calls of Setup::Instance, at the intervals that it names (1 and 2 seconds). While it is
  /// signed out they do nothing.
  static Calls SetupCalls();

  struct Options {
    /// Between two calls of ProcessInput: the longest that input waits. Above 0.
    Duration inputPeriod = std::chrono::milliseconds(2);
    /// After Hurry: the interval of PollSetupChanges, and how long it stays in force.
    Duration hurriedInterval = std::chrono::milliseconds(20);
    Duration hurryLasts = std::chrono::seconds(1);
    /// Called on the loop's thread; null drops errors.
    std::function<void(std::exception_ptr)> onError;
  };

  /// Drives Setup::Instance, which is reached for the first time when the loop begins to run: so
  /// a loop may be there before the host's callbacks are.
  PollLoop();
  explicit PollLoop(Options options);
  /// Drives something else in its stead.
  PollLoop(Options options, Calls calls);
  ~PollLoop();

  /// Starts a thread that runs the loop. Not while the loop runs already.
  void Start();

  /// Runs the loop on this thread until Stop, or until `goOn`, where given, returns false; it is
  /// asked once a round, that is once each inputPeriod or more often. Returns at once if Stop was
  /// called since the last run.
  void Run(std::function<bool()> const& goOn = nullptr);

  /// Ends the loop after the call that it is in, and waits for the loop's own thread, if there is
  /// one and this is another. Tasks that were not begun are dropped.
  void Stop();

  /// Has `task` called on the loop's thread, in the order of the calls of Post. Tasks wait for a
  /// loop that does not run yet; from Stop until it runs anew they are dropped.
  void Post(std::function<void()> task);

  /// Has `function` called on the loop's thread, waits for it and gives back its result. On that
  /// thread itself it is called at once. A task that Stop drops throws std::future_error.
  template <class Function>
  auto Call(Function function) -> decltype(function()) {
    if (IsLoopThread()) {
      return function();
    }
    using Task = std::packaged_task<decltype(function())()>;
    auto task = std::make_shared<Task>(std::move(function));
    auto result = task->get_future();
    // The queue's is the one hold on the task, so that dropping it there ends the wait here.
    Post([held = std::move(task)] { (*held)(); });
    return result.get();
  }

  /// Something is known to have changed: polls for changes of the studio soon and often for a
  /// while, instead of at leisure.
  void Hurry();

  /// Whether this is the thread that the loop runs on.
  bool IsLoopThread() const;

 private:
  struct State;

  std::unique_ptr<State> state_;
};

}  // namespace Ostinet

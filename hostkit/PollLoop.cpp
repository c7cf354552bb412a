// SPDX-License-Identifier: MIT
#include "ostinet/hostkit/PollLoop.h"

#include <condition_variable>
#include <deque>
#include <mutex>
#include <optional>
#include <thread>

#include "PollSchedule.h"
#include "ostinet/Setup.h"

// PollLoop: one thread meets the model, and everybody else leaves tasks for it.
//
// The mutex guards the queue and the requests (stop, hurry) alone and is never held while the
// library or a task is called, so whatever they do they may post, hurry and stop. The schedule
// belongs to the running loop; a hurry is a flag that the loop picks up.

namespace Ostinet {

struct PollLoop::State {
  explicit State(Options someOptions) : options(std::move(someOptions)) {}

  Options options;
  std::optional<Calls> calls;  // Unset: those of the setup, which is not made before the loop runs.

  std::mutex mutex;
  std::condition_variable changed;
  std::thread thread;  // the loop's own, until someone joins it
  bool hasOwnThread = false;
  std::deque<std::function<void()>> tasks;
  std::thread::id loopThread;  // of the loop that runs; none otherwise
  bool stopped = false;
  bool hurry = false;

  // What a round has to do, taken from the requests.
  struct Requests {
    std::deque<std::function<void()>> tasks;
    bool hurry = false;
    bool stopped = false;
  };

  Requests WaitUntil(Clock::time_point due) {
    std::unique_lock<std::mutex> lock(mutex);
    changed.wait_until(lock, due, [&] { return stopped || hurry || !tasks.empty(); });
    Requests requests;
    requests.stopped = stopped;
    requests.hurry = std::exchange(hurry, false);
    requests.tasks.swap(tasks);
    return requests;
  }

  bool IsStopped() {
    std::lock_guard<std::mutex> lock(mutex);
    return stopped;
  }

  void Guarded(std::function<void()> const& call) {
    try {
      call();
    } catch (...) {
      if (options.onError) {
        options.onError(std::current_exception());
      }
    }
  }

  void RunTasks(std::deque<std::function<void()>>& some) {
    while (!some.empty() && !IsStopped()) {
      Guarded(some.front());
      some.pop_front();
    }
  }

  void RunDue(PollSchedule::Due const& due) {
    if (due.poll) {
      Guarded(calls->poll);
    }
    if (due.setupChanges && !IsStopped()) {
      Guarded(calls->pollSetupChanges);
    }
    if (due.input && !IsStopped()) {
      Guarded(calls->processInput);
    }
  }

  void Loop(std::function<bool()> const& goOn) {
    if (!calls) {
      calls = SetupCalls();
    }
    PollSchedule schedule(
        {options.inputPeriod, calls->pollInterval, calls->pollSetupChangesInterval,
         options.hurriedInterval, options.hurryLasts},
        Clock::now());
    while (!goOn || goOn()) {
      Requests requests = WaitUntil(schedule.NextDue());
      if (requests.stopped) {
        return;
      }
      if (requests.hurry) {
        schedule.Hurry(Clock::now());
      }
      RunTasks(requests.tasks);
      if (!IsStopped()) {
        RunDue(schedule.TakeDue(Clock::now()));
      }
    }
  }
};

PollLoop::Calls PollLoop::SetupCalls() {
  Setup& setup = Setup::Instance();
  auto const whileSignedIn = [&setup](void (Setup::*operation)()) {
    return [&setup, operation] {
      if (setup.IsSignedIn()) {
        (setup.*operation)();
      }
    };
  };
  auto const interval = [](double seconds) {
    return std::chrono::duration_cast<Duration>(std::chrono::duration<double>(seconds));
  };
  return {whileSignedIn(&Setup::Poll), whileSignedIn(&Setup::PollSetupChanges),
          whileSignedIn(&Setup::ProcessInput), interval(setup.PollInterval()),
          interval(setup.PollSetupChangesInterval())};
}

PollLoop::PollLoop() : PollLoop(Options()) {}

PollLoop::PollLoop(Options options) : state_(std::make_unique<State>(std::move(options))) {}

PollLoop::PollLoop(Options options, Calls calls) : PollLoop(std::move(options)) {
  state_->calls = std::move(calls);
}

PollLoop::~PollLoop() { Stop(); }

void PollLoop::Start() {
  std::lock_guard<std::mutex> lock(state_->mutex);
  state_->stopped = false;
  state_->hasOwnThread = true;
  state_->thread = std::thread([this] { Run(); });
}

void PollLoop::Run(std::function<bool()> const& goOn) {
  {
    std::lock_guard<std::mutex> lock(state_->mutex);
    state_->loopThread = std::this_thread::get_id();
  }
  struct Ending {
    State& state;
    ~Ending() {
      std::lock_guard<std::mutex> lock(state.mutex);
      state.loopThread = std::thread::id();
      // A loop with a thread of its own stays stopped until it is started anew.
      state.stopped = state.stopped && state.hasOwnThread;
    }
  } const ending{*state_};
  state_->Loop(goOn);
}

void PollLoop::Stop() {
  std::deque<std::function<void()>> dropped;
  std::thread ended;
  {
    std::lock_guard<std::mutex> lock(state_->mutex);
    state_->stopped = true;
    dropped.swap(state_->tasks);
    if (state_->loopThread != std::this_thread::get_id()) {
      ended.swap(state_->thread);
    }
  }
  state_->changed.notify_all();
  if (ended.joinable()) {
    ended.join();
  }
}

void PollLoop::Post(std::function<void()> task) {
  {
    std::lock_guard<std::mutex> lock(state_->mutex);
    if (state_->stopped) {
      return;
    }
    state_->tasks.push_back(std::move(task));
  }
  state_->changed.notify_all();
}

void PollLoop::Hurry() {
  {
    std::lock_guard<std::mutex> lock(state_->mutex);
    state_->hurry = true;
  }
  state_->changed.notify_all();
}

bool PollLoop::IsLoopThread() const {
  std::lock_guard<std::mutex> lock(state_->mutex);
  return state_->loopThread == std::this_thread::get_id();
}

}  // namespace Ostinet

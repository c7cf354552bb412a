// SPDX-License-Identifier: MIT
#pragma once

#include <atomic>
#include <functional>
#include <memory>
#include <thread>
#include <utility>

#include "core/BlockingQueue.h"
#include "core/Future.h"
#include "ostinet/core/UString.h"

namespace Ostinet {

/// A piece of work for a job thread. Either Run or Cancel is called, once.
class VantorJobQueueJob : private Noncopyable<VantorJobQueueJob> {
 public:
  virtual ~VantorJobQueueJob();
  /// Does the work, on the job thread. What it throws is dropped.
  virtual void Run() = 0;
  /// Called in place of Run when the thread ends first, on the thread that ends it.
  virtual void Cancel() = 0;

 protected:
  VantorJobQueueJob() = default;
};

/// A named thread that runs jobs in the order in which they came.
///
/// Ownership    Owns its thread: the destructor terminates it.
/// Threads      [any thread] Start and Terminate belong to the owner.
class VantorJobThread : private Noncopyable<VantorJobThread> {
 public:
  using JobQueue = blocking_queue<std::shared_ptr<VantorJobQueueJob>>;

  /// `priority` 0 is that of other threads. Higher ones are asked of the system where it grants
  /// them to any program.
  explicit VantorJobThread(UString const& name, int priority = 0);
  ~VantorJobThread();

  /// Starts the thread. A second time, or after Terminate, it does nothing.
  void Start();
  /// Lets the job that runs finish, cancels those that wait, and waits for the thread; called
  /// on the thread itself, it does not wait. A second time it does nothing.
  void Terminate();
  bool IsTerminated() const { return terminated_.load(std::memory_order_acquire); }
  JobQueue& GetJobQueue() { return *queue_; }

  /// Runs `work` on the thread; the future gets what it returns, or the error that it throws.
  /// On a terminated thread the future is complete at once, with the error "Thread terminated".
  template <class T>
  std::shared_ptr<VantorFuture<T>> Post(std::function<T()> work);

  /// The error of work that is posted to a thread that has ended.
  static VantorError TerminatedError();

 private:
  static void RunJobs(JobQueue& queue);

  UString const name_;
  int const priority_;
  // The thread shares it. Where the system ends all threads before it destroys static objects, as
  // Windows does, the queue on which a thread died is never destroyed: nobody could wake it.
  std::shared_ptr<JobQueue> const queue_ = std::make_shared<JobQueue>();
  // Stored by the thread that terminates; any thread may ask, and then sees the closed queue.
  std::atomic<bool> terminated_{false};
  VantorCoreMutex mutex_;
  std::thread thread_ OSTINET_GUARDED_BY(mutex_);
};

namespace Impl {

/// A job whose outcome goes to a future.
template <class T>
class FutureJob : public VantorJobQueueJob {
 public:
  explicit FutureJob(std::function<T()> work) : work_(std::move(work)) {}
  std::shared_ptr<VantorFuture<T>> GetFuture() const { return promise_.GetFuture(); }
  void Fail(VantorError const& error) { promise_.Fail(error); }

  void Run() override {
    try {
      promise_.Complete(RunOnce());
    } catch (...) {
      promise_.Fail(VantorError::GetCurrentError());
    }
  }
  void Cancel() override { promise_.Cancel(); }

 private:
  /// Lets go of what the work holds before anyone hears of the outcome: who does may count on it.
  T RunOnce() {
    std::function<T()> const work = std::exchange(work_, nullptr);
    return work();
  }

  std::function<T()> work_;
  VantorPromise<T> promise_;
};

}  // namespace Impl

template <class T>
std::shared_ptr<VantorFuture<T>> VantorJobThread::Post(std::function<T()> work) {
  auto const job = std::make_shared<Impl::FutureJob<T>>(std::move(work));
  if (!queue_->push(job)) {
    job->Fail(TerminatedError());
  }
  return job->GetFuture();
}

}  // namespace Ostinet

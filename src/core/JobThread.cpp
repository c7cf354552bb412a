// SPDX-License-Identifier: MIT
#include "core/JobThread.h"

#include "core/SystemServices.h"

namespace Ostinet {

VantorJobQueueJob::~VantorJobQueueJob() = default;

VantorJobThread::VantorJobThread(UString const& name, int priority)
    : name_(name), priority_(priority) {}

VantorJobThread::~VantorJobThread() { Terminate(); }

void VantorJobThread::Start() {
  MutexHolder lock(mutex_);
  if (!thread_.joinable() && !IsTerminated()) {
    thread_ = std::thread([queue = queue_, name = name_, priority = priority_] {
      SystemServices::NameThisThread(name, priority);
      RunJobs(*queue);
    });
  }
}

void VantorJobThread::Terminate() {
  auto const waiting = queue_->close();
  terminated_.store(true, std::memory_order_release);
  for (auto const& job : waiting) {
    job->Cancel();
  }
  MutexHolder lock(mutex_);
  if (thread_.joinable() && thread_.get_id() != std::this_thread::get_id()) {
    thread_.join();
  }
}

VantorError VantorJobThread::TerminatedError() {
  return VantorError("VantorThreads", "VantorJobThread", 0, "Thread terminated");
}

void VantorJobThread::RunJobs(JobQueue& queue) {
  while (auto job = queue.pop()) {
    try {
      (*job)->Run();
    } catch (...) {
      // A job that fails ends alone: those behind it still run.
    }
  }
}

}  // namespace Ostinet

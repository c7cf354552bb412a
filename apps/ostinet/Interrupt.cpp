// SPDX-License-Identifier: MIT
#include "Interrupt.h"

#include <atomic>
#include <csignal>

namespace Ostinet::Tool {
namespace {

// Stored by the handler, loaded by the loop; nothing else depends on it, so no order is needed.
std::atomic<bool> gInterrupted{false};
static_assert(std::atomic<bool>::is_always_lock_free, "a signal handler may store it");

extern "C" void HandleInterrupt(int signal) {
  std::signal(signal, SIG_DFL);
  gInterrupted.store(true, std::memory_order_relaxed);
}

}  // namespace

void CatchInterrupts() {
  std::signal(SIGINT, HandleInterrupt);
  std::signal(SIGTERM, HandleInterrupt);
}

bool IsInterrupted() { return gInterrupted.load(std::memory_order_relaxed); }

}  // namespace Ostinet::Tool

// SPDX-License-Identifier: MIT
#include "core/Atomics.h"

#include <thread>

// Popping one node means reading its link, and between that and taking it off, the node could be
// popped, freed and even pushed again by others. A version count in the head would notice the
// last case but not stop the read of freed memory. So the lowest bit of the head, which no node's
// address uses, is the tag of a pop in progress: only the thread that set it may take nodes off,
// hence the first node stays where it is while its link is read. Pushes go on all the while and
// carry the tag along.

namespace Ostinet {

namespace {

constexpr std::uintptr_t kPopping = 1;
constexpr int kSpinsBeforeYield = 64;

using Head = std::atomic_ref<void*>;

std::uintptr_t BitsOf(void* word) { return reinterpret_cast<std::uintptr_t>(word); }
void* NodeOf(void* word) { return reinterpret_cast<void*>(BitsOf(word) & ~kPopping); }
bool IsTagged(void* word) { return (BitsOf(word) & kPopping) != 0; }
void* Tagged(void* node) { return reinterpret_cast<void*>(BitsOf(node) | kPopping); }
void*& LinkOf(void* node) { return *static_cast<void**>(node); }

// Waits out another thread's pop; gives the head as it is then, without the tag.
void* LoadUntagged(Head head) {
  void* seen = head.load(std::memory_order_acquire);
  for (int spins = 0; IsTagged(seen); seen = head.load(std::memory_order_acquire)) {
    if (++spins >= kSpinsBeforeYield) {
      std::this_thread::yield();
    }
  }
  return seen;
}

}  // namespace

void EnqueueAtomic(void** head, void* node) {
  Head const top(*head);
  void* seen = top.load(std::memory_order_relaxed);
  void* wanted = nullptr;
  do {
    LinkOf(node) = NodeOf(seen);
    wanted = IsTagged(seen) ? Tagged(node) : node;
  } while (!top.compare_exchange_weak(seen, wanted, std::memory_order_release,
                                      std::memory_order_relaxed));
}

void* DequeueAtomic(void** head) {
  Head const top(*head);
  void* seen = nullptr;
  do {
    seen = LoadUntagged(top);
    if (seen == nullptr) {
      return nullptr;
    }
  } while (!top.compare_exchange_weak(seen, Tagged(seen), std::memory_order_acquire,
                                      std::memory_order_relaxed));
  seen = Tagged(seen);
  // This thread alone takes nodes off now; a push in between only makes it look again.
  while (!top.compare_exchange_weak(seen, LinkOf(NodeOf(seen)), std::memory_order_acq_rel,
                                    std::memory_order_acquire)) {
  }
  return NodeOf(seen);
}

void* DetachAtomic(void** head) {
  Head const top(*head);
  void* seen = LoadUntagged(top);
  while (seen != nullptr && !top.compare_exchange_weak(seen, nullptr, std::memory_order_acquire,
                                                       std::memory_order_relaxed)) {
    seen = LoadUntagged(top);
  }
  return seen;
}

}  // namespace Ostinet

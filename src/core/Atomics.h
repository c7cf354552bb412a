// SPDX-License-Identifier: MIT
#pragma once

#include <atomic>
#include <cstdint>

namespace Ostinet {

/// Adds to a word; any thread.
inline void AtomicAdd32Implementation(std::int32_t* word, std::int32_t amount) {
  std::atomic_ref<std::int32_t>(*word).fetch_add(amount, std::memory_order_acq_rel);
}

/// Adds to a word and gives the sum; any thread. It wraps round.
inline std::int32_t AtomicAddAndReturn32Implementation(std::int32_t* word, std::int32_t amount) {
  auto const before =
      std::atomic_ref<std::int32_t>(*word).fetch_add(amount, std::memory_order_acq_rel);
  return static_cast<std::int32_t>(static_cast<std::uint32_t>(before) +
                                   static_cast<std::uint32_t>(amount));
}

/// Sets a word to 0 and tells whether it was anything else; any thread.
inline bool AtomicTestAndClear32(std::int32_t* word) {
  return std::atomic_ref<std::int32_t>(*word).exchange(0, std::memory_order_acq_rel) != 0;
}

// A stack of nodes whose first word is the link to the next, shared by any threads. The head is
// a word that starts as null and is touched by these three operations only; so is the first word
// of a node from its push to its pop. A node may be freed as soon as it has been popped or
// detached.

/// Pushes a node. [realtime]
void EnqueueAtomic(void** head, void* node);
/// Pops the node last pushed, or gives null. Threads that pop at the same moment take turns for
/// a few instructions; one that pushes never waits.
void* DequeueAtomic(void** head);
/// Takes all nodes at once, the one last pushed first, linked by their first words and ended by
/// null. [realtime] where no thread pops single nodes.
void* DetachAtomic(void** head);

}  // namespace Ostinet

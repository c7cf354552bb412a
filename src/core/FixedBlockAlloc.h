// SPDX-License-Identifier: MIT
#pragma once

#include <array>
#include <atomic>
#include <cstddef>
#include <cstdint>

#include "core/Mutex.h"

namespace Ostinet {

/// A pool of blocks of one size, each aligned for any type.
///
/// Ownership    Owns its memory and gives it back to the heap when it is destroyed, at once and
///              with whatever is still allocated from it.
/// Threads      [any thread] [realtime] once warm: as long as blocks given back are at hand, it
///              takes no lock and leaves the heap alone.
/// Errors       std::bad_alloc.
class FixedBlockAllocMT : private Noncopyable<FixedBlockAllocMT> {
 public:
  /// `blocksInChunk`: how many blocks the first growth makes, at least 1; each later growth
  /// makes as many as there are.
  FixedBlockAllocMT(std::size_t blockSize, std::size_t blocksInChunk);
  ~FixedBlockAllocMT();

  /// A block of at least `size` bytes. One larger than the pool's comes from the heap.
  void* allocate(std::size_t size);
  /// Gives back what allocate gave for the same size; null is passed over.
  void deallocate(void* block, std::size_t size) noexcept;

  /// How many blocks the pool has made, used and free.
  std::size_t CountBlocks() const;

 private:
  struct Header;
  static constexpr int kMaxChunks = 32;

  Header* HeaderAt(std::uint32_t index) const;
  Header* Pop();
  void Push(Header* header) noexcept;
  void Grow() OSTINET_REQUIRES(growing_);

  std::size_t const blockSize_;
  std::size_t const stride_;
  std::uint32_t const firstChunk_;
  // Free blocks as a stack of block numbers: a count of changes in the upper half, the number of
  // the first block plus 1, or 0 for none, in the lower.
  std::atomic<std::uint64_t> head_{0};
  // Written while growing, before the head that leads to their blocks is released.
  std::array<std::atomic<unsigned char*>, kMaxChunks> chunks_{};
  mutable VantorCoreMutex growing_;
  int chunkCount_ OSTINET_GUARDED_BY(growing_) = 0;
};

}  // namespace Ostinet

// SPDX-License-Identifier: MIT
#include "core/FixedBlockAlloc.h"

#include <algorithm>
#include <bit>
#include <limits>
#include <new>

// A thread that pops a block reads the link of a block that another may have popped meanwhile.
// Three things make that harmless: links stand in a header before the block, which no user of
// the block touches, so they stay readable as links; memory never goes back while the pool lives;
// and the head counts its changes in 32 bits, so an outdated link never gets in. Blocks are
// numbered, so that number and count fit one word. Chunk 0 holds the first `firstChunk_` blocks
// and each later chunk as many as all before it together.

namespace Ostinet {

struct FixedBlockAllocMT::Header {
  std::atomic<std::uint32_t> next{0};  // the number of the next free block plus 1
  std::uint32_t number = 0;            // plus 1; never changes
};

namespace {

constexpr std::size_t kAlignment = alignof(std::max_align_t);
constexpr std::size_t kHeaderSize = kAlignment;
constexpr std::uint64_t kNumberMask = 0xFFFFFFFF;
constexpr std::uint64_t kOneChange = std::uint64_t{1} << 32;

constexpr std::size_t RoundUp(std::size_t size) {
  return (size + kAlignment - 1) / kAlignment * kAlignment;
}

}  // namespace

FixedBlockAllocMT::FixedBlockAllocMT(std::size_t blockSize, std::size_t blocksInChunk)
    : blockSize_(blockSize),
      stride_(kHeaderSize + RoundUp(std::max<std::size_t>(blockSize, 1))),
      firstChunk_(static_cast<std::uint32_t>(std::clamp<std::size_t>(blocksInChunk, 1, 1U << 20))) {
  static_assert(sizeof(Header) <= kHeaderSize);
}

FixedBlockAllocMT::~FixedBlockAllocMT() {
  for (auto& chunk : chunks_) {
    ::operator delete(chunk.load(std::memory_order_relaxed));
  }
}

void* FixedBlockAllocMT::allocate(std::size_t size) {
  if (size > blockSize_) {
    return ::operator new(size);
  }
  Header* header = Pop();
  if (header == nullptr) {
    MutexHolder lock(growing_);
    while ((header = Pop()) == nullptr) {
      Grow();
    }
  }
  return reinterpret_cast<unsigned char*>(header) + kHeaderSize;
}

void FixedBlockAllocMT::deallocate(void* block, std::size_t size) noexcept {
  if (block == nullptr) {
    return;
  }
  if (size > blockSize_) {
    ::operator delete(block);
    return;
  }
  Push(reinterpret_cast<Header*>(static_cast<unsigned char*>(block) - kHeaderSize));
}

std::size_t FixedBlockAllocMT::CountBlocks() const {
  MutexHolder lock(growing_);
  return chunkCount_ == 0 ? 0 : std::size_t{firstChunk_} << (chunkCount_ - 1);
}

FixedBlockAllocMT::Header* FixedBlockAllocMT::HeaderAt(std::uint32_t index) const {
  // Chunk k > 0 starts at block firstChunk_ << (k - 1).
  int const chunk = static_cast<int>(std::bit_width(index / firstChunk_));
  std::uint32_t const start = chunk == 0 ? 0 : firstChunk_ << (chunk - 1);
  unsigned char* const blocks =
      chunks_[static_cast<std::size_t>(chunk)].load(std::memory_order_relaxed);
  return reinterpret_cast<Header*>(blocks + std::size_t{index - start} * stride_);
}

FixedBlockAllocMT::Header* FixedBlockAllocMT::Pop() {
  std::uint64_t seen = head_.load(std::memory_order_acquire);
  while ((seen & kNumberMask) != 0) {
    Header* const header = HeaderAt(static_cast<std::uint32_t>(seen & kNumberMask) - 1);
    std::uint64_t const next = header->next.load(std::memory_order_relaxed);
    std::uint64_t const wanted = ((seen & ~kNumberMask) + kOneChange) | next;
    if (head_.compare_exchange_weak(seen, wanted, std::memory_order_acq_rel,
                                    std::memory_order_acquire)) {
      return header;
    }
  }
  return nullptr;
}

void FixedBlockAllocMT::Push(Header* header) noexcept {
  std::uint64_t seen = head_.load(std::memory_order_relaxed);
  std::uint64_t wanted = 0;
  do {
    header->next.store(static_cast<std::uint32_t>(seen & kNumberMask), std::memory_order_relaxed);
    wanted = ((seen & ~kNumberMask) + kOneChange) | header->number;
  } while (!head_.compare_exchange_weak(seen, wanted, std::memory_order_release,
                                        std::memory_order_relaxed));
}

void FixedBlockAllocMT::Grow() {
  std::uint64_t const made = chunkCount_ == 0 ? 0 : std::uint64_t{firstChunk_} << (chunkCount_ - 1);
  std::uint64_t const count = chunkCount_ == 0 ? firstChunk_ : made;
  if (chunkCount_ == kMaxChunks || made + count >= kNumberMask) {
    throw std::bad_alloc();
  }
  auto* const blocks = static_cast<unsigned char*>(::operator new(count* stride_));
  chunks_[static_cast<std::size_t>(chunkCount_)].store(blocks, std::memory_order_relaxed);
  ++chunkCount_;
  for (std::uint64_t i = count; i-- > 0;) {
    auto* const header = new (blocks + i * stride_) Header;
    header->number = static_cast<std::uint32_t>(made + i + 1);
    Push(header);
  }
}

}  // namespace Ostinet

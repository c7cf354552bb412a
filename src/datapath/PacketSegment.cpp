// SPDX-License-Identifier: MIT
#include <new>

#include "core/FixedBlockAlloc.h"
#include "datapath/PacketNode.h"

namespace Ostinet::Impl {
namespace {

static_assert(alignof(PacketSegment) <= alignof(std::max_align_t), "what the pool gives");

constexpr std::size_t kSegmentsInFirstChunk = 4;

// Never destroyed: the system's threads may still queue while the process ends.
FixedBlockAllocMT& Pool() {
  static FixedBlockAllocMT& pool =
      *new FixedBlockAllocMT(sizeof(PacketSegment), kSegmentsInFirstChunk);
  return pool;
}

}  // namespace

PacketSegment* PacketSegment::Make() {
  return new (Pool().allocate(sizeof(PacketSegment))) PacketSegment;
}

void PacketSegment::Free(PacketSegment* segment) {
  Pool().deallocate(segment, sizeof(PacketSegment));
}

}  // namespace Ostinet::Impl

// SPDX-License-Identifier: MIT
#pragma once

#include <atomic>
#include <cstddef>
#include <memory>

#include "datapath/SysexImpl.h"
#include "ostinet/TimeStamp.h"

namespace Ostinet::Impl {

/// A place for one packet in a queue. The packet's bytes are those of a sysex message, or a copy:
/// up to kInlineBytes within the node, more of them on the heap.
struct PacketNode {
  static constexpr std::size_t kInlineBytes = 16;

  /// Lets go of what the packet's bytes need.
  void Release() {
    // Most packets need nothing: two looks are cheaper than two calls.
    if (sysex.get() != nullptr) {
      sysex = nullptr;
    }
    if (heapBytes != nullptr) {
      heapBytes.reset();
    }
  }

  // Stored once by the producer, with release, when the packet is complete; loaded by the consumer,
  // with acquire, before it looks at the packet.
  std::atomic<bool> arrived{false};
  DataPacket packet;
  RCPtrMT<SysexImpl> sysex;
  std::unique_ptr<unsigned char[]> heapBytes;
  unsigned char inlineBytes[kInlineBytes];
};

/// As many places as a queue takes at a time, and the link to the next ones.
///
/// Ownership  Segments come from one pool of the process through Make and go back through Free,
///            which does not look at the nodes: they are released by then.
/// Threads    Make and Free on any thread.
struct alignas(16) PacketSegment {
  static constexpr std::size_t kNodes = 16;

  /// A segment of empty places. Throws std::bad_alloc.
  static PacketSegment* Make();
  static void Free(PacketSegment* segment);

  // Stored once, with release, by the producer that made the next segment; loaded by the consumer.
  std::atomic<PacketSegment*> next{nullptr};
  PacketNode nodes[kNodes];
};

}  // namespace Ostinet::Impl

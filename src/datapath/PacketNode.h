// SPDX-License-Identifier: MIT
#pragma once

#include <array>
#include <atomic>
#include <cstddef>
#include <cstring>
#include <memory>
#include <utility>

#include "datapath/SysexImpl.h"
#include "ostinet/TimeStamp.h"

namespace Ostinet::Impl {

/// One packet in a queue with what its bytes need: a reference on a sysex message, or a copy, up to
/// kInlineBytes within the node, more of them on the heap.
class PacketNode {
 public:
  static constexpr std::size_t kInlineBytes = 16;

  /// A copy of up to kInlineBytes.
  PacketNode(TimeStamp const& stamp, unsigned char const* bytes, std::size_t length);
  /// Takes the copy of more bytes over.
  PacketNode(TimeStamp const& stamp, std::unique_ptr<unsigned char[]> bytes, std::size_t length);
  PacketNode(TimeStamp const& stamp, SysexImpl* sysex);
  ~PacketNode();
  PacketNode(PacketNode const&) = delete;
  PacketNode& operator=(PacketNode const&) = delete;

  /// A view of the packet; of a sysex message with the bytes that it has now.
  DataPacket const& View();

 private:
  DataPacket packet_;
  // One counted reference, or null. Counted by hand, as most packets have none and the calls of a
  // counted pointer would cost them as much as all the rest.
  SysexImpl* const sysex_;
  std::unique_ptr<unsigned char[]> const heapBytes_;
  unsigned char inlineBytes_[kInlineBytes];
};

static_assert(sizeof(void*) != 8 || sizeof(PacketNode) == 72, "nine words");

/// As many places for nodes as a queue takes at a time, and the link to the next ones.
///
/// Ownership  Segments come from one pool of the process through Make and go back through Free,
///            which does not look at the places: their nodes are destroyed by then.
/// Threads    Make and Free on any thread.
struct alignas(16) PacketSegment {
  static constexpr std::size_t kNodes = 16;

  /// A segment of empty places. Throws std::bad_alloc.
  static PacketSegment* Make();
  static void Free(PacketSegment* segment);

  /// Where the node is or will be.
  void* Place(std::size_t index) { return places + index * sizeof(PacketNode); }
  PacketNode& Node(std::size_t index) { return *static_cast<PacketNode*>(Place(index)); }

  // Stored once, with release, by the producer that made the next segment; loaded by the consumer.
  std::atomic<PacketSegment*> next{nullptr};
  // Whether the node in a place is complete. Stored once by its producer, with release; loaded by
  // the consumer, with acquire, before it looks at the node.
  std::array<std::atomic<bool>, kNodes> arrived{};
  alignas(PacketNode) unsigned char places[kNodes * sizeof(PacketNode)];
};

inline PacketNode::PacketNode(TimeStamp const& stamp, unsigned char const* bytes,
                              std::size_t length)
    : packet_{inlineBytes_, length, stamp}, sysex_(nullptr) {
  constexpr std::size_t kShortMessageBytes = 3;
  if (length == kShortMessageBytes) {
    std::memcpy(inlineBytes_, bytes, kShortMessageBytes);  // most packets, without a call
  } else if (length > 0) {
    std::memcpy(inlineBytes_, bytes, length);
  }
}

inline PacketNode::PacketNode(TimeStamp const& stamp, std::unique_ptr<unsigned char[]> bytes,
                              std::size_t length)
    : packet_{bytes.get(), length, stamp}, sysex_(nullptr), heapBytes_(std::move(bytes)) {}

inline PacketNode::PacketNode(TimeStamp const& stamp, SysexImpl* sysex) : sysex_(sysex) {
  packet_.stamp = stamp;
  if (sysex_ != nullptr) {
    sysex_->AddReference();
  }
}

inline PacketNode::~PacketNode() {
  if (sysex_ != nullptr) {
    sysex_->RemoveReference();
  }
}

inline DataPacket const& PacketNode::View() {
  if (sysex_ != nullptr) {
    packet_.data = sysex_->begin();
    packet_.length = sysex_->Size();
  }
  return packet_;
}

}  // namespace Ostinet::Impl

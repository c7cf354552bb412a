// SPDX-License-Identifier: MIT
#pragma once

#include <memory>

#include "datapath/SysexImpl.h"
#include "ostinet/TimeStamp.h"

namespace Ostinet::Impl {

/// One packet in a queue. Its bytes are those of a sysex message, or a copy: up to kInlineBytes
/// within the node, more of them on the heap.
///
/// Ownership  Nodes come from one pool of the process, through the two functions named Make, and go
///            back through Free.
/// Threads    Any; one node belongs to one thread at a time.
struct PacketNode {
  static constexpr std::size_t kInlineBytes = 16;

  static PacketNode* Make(DataPacket const& packet);
  static PacketNode* Make(TimeStamp const& stamp, RCPtrMT<SysexImpl> const& sysex);
  static void Free(PacketNode* node);

  /// A view of the node's bytes, valid until it is freed.
  DataPacket View() const;

  void* next = nullptr;  // the first word, where the lock-free stack keeps its link
  TimeStamp stamp;
  unsigned long long length = 0;  // of the copy
  RCPtrMT<SysexImpl> sysex;
  std::unique_ptr<unsigned char[]> heapBytes;
  unsigned char inlineBytes[kInlineBytes];
};

static_assert(sizeof(void*) != 8 || sizeof(PacketNode) == 72, "nine words");

/// Frees the node at the end of a scope.
struct PacketNodeDeleter {
  void operator()(PacketNode* node) const { PacketNode::Free(node); }
};
using PacketNodePtr = std::unique_ptr<PacketNode, PacketNodeDeleter>;

}  // namespace Ostinet::Impl

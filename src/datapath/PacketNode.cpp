// SPDX-License-Identifier: MIT
#include "datapath/PacketNode.h"

#include <cstring>
#include <new>

#include "core/FixedBlockAlloc.h"

namespace Ostinet::Impl {
namespace {

constexpr int kNodesPerChunk = 16;

// Never destroyed: the system's threads may still queue while the process ends.
FixedBlockAllocMT& Pool() {
  static FixedBlockAllocMT& pool = *new FixedBlockAllocMT(sizeof(PacketNode), kNodesPerChunk);
  return pool;
}

PacketNodePtr MakeEmpty() {
  return PacketNodePtr(new (Pool().allocate(sizeof(PacketNode))) PacketNode);
}

}  // namespace

PacketNode* PacketNode::Make(DataPacket const& packet) {
  PacketNodePtr node = MakeEmpty();
  node->stamp = packet.stamp;
  node->length = packet.data != nullptr ? packet.length : 0;
  unsigned char* bytes = node->inlineBytes;
  auto const count = static_cast<std::size_t>(node->length);
  if (count > kInlineBytes) {
    node->heapBytes.reset(new unsigned char[count]);
    bytes = node->heapBytes.get();
  }
  if (count > 0) {
    std::memcpy(bytes, packet.data, count);
  }
  return node.release();
}

PacketNode* PacketNode::Make(TimeStamp const& stamp, RCPtrMT<SysexImpl> const& sysex) {
  PacketNodePtr node = MakeEmpty();
  node->stamp = stamp;
  node->sysex = sysex;
  return node.release();
}

void PacketNode::Free(PacketNode* node) {
  node->~PacketNode();
  Pool().deallocate(node, sizeof(PacketNode));
}

DataPacket PacketNode::View() const {
  if (sysex.get() != nullptr) {
    return {sysex->begin(), sysex->Size(), stamp};
  }
  return {heapBytes ? heapBytes.get() : inlineBytes, length, stamp};
}

}  // namespace Ostinet::Impl

// SPDX-License-Identifier: MIT

// From the system's callback threads to the host's polling thread.
//
// Packets stand in segments of 16 nodes, linked in order of arrival. One word, the tail, names the
// last segment and how many of its nodes are reserved, so that a producer reserves a node with a
// single exchange, fills it, and marks it arrived. Who finds the segment full swaps a fresh one in,
// of which it has the first node, and links it behind the full one. The consumer walks the nodes,
// and a segment is done with when all its packets are taken and the next one is linked: from then
// on no producer can reach it, for the tail has left it, and each of its nodes was marked by its
// producer last of all. Nothing here blocks or, once the pool is warm, allocates: callbacks may run
// at interrupt-like priority.

#include "datapath/PacketQueue.h"

#include <cstring>
#include <utility>

#include "datapath/PacketNode.h"

namespace Ostinet::Impl {
namespace {

constexpr std::uintptr_t kReservedMask = PacketSegment::kNodes - 1;
static_assert(alignof(PacketSegment) >= PacketSegment::kNodes, "the low bits hold the count");

PacketSegment* SegmentOf(std::uintptr_t tail) {
  return reinterpret_cast<PacketSegment*>(tail & ~kReservedMask);
}

// Of a tail with a segment: 1 to kNodes.
std::size_t ReservedOf(std::uintptr_t tail) { return (tail & kReservedMask) + 1; }

constexpr std::size_t kShortMessageBytes = 3;

// Releases the node at the end of a scope.
class NodeReleaser {
 public:
  explicit NodeReleaser(PacketNode& node) : node_(node) {}
  ~NodeReleaser() { node_.Release(); }
  NodeReleaser(NodeReleaser const&) = delete;
  NodeReleaser& operator=(NodeReleaser const&) = delete;

 private:
  PacketNode& node_;
};

void Deliver(PacketNode& node, Receiver* target, bool filtered, Source const& source) {
  NodeReleaser const releaser(node);
  if (node.sysex.get() != nullptr) {
    node.packet.data = node.sysex->begin();
    node.packet.length = node.sysex->Size();
  }
  if (target != nullptr && (!filtered || target->WantsPacket(node.packet, source))) {
    target->HandlePacket(node.packet, source);
  }
}

}  // namespace

// A drain. What a node holds may be in use by the drain around this one, so segments stay until the
// outermost drain is over.
class PacketQueue::DrainScope {
 public:
  explicit DrainScope(PacketQueue& queue) : queue_(queue) { ++queue_.drains_; }
  ~DrainScope() {
    if (--queue_.drains_ == 0) {
      queue_.FreeRetired();
    }
  }
  DrainScope(DrainScope const&) = delete;
  DrainScope& operator=(DrainScope const&) = delete;

 private:
  PacketQueue& queue_;
};

PacketQueue::~PacketQueue() {
  // Without a receiver, a drain releases what has arrived.
  Drain(nullptr, nullptr, Source(), false);
  PacketSegment* segment = current_;
  while (segment != nullptr) {
    PacketSegment::Free(std::exchange(segment, segment->next.load(std::memory_order_acquire)));
  }
}

void PacketQueue::Enqueue(DataPacket const& packet) {
  // What may throw comes first: a node that is reserved must arrive.
  auto const length = static_cast<std::size_t>(packet.data != nullptr ? packet.length : 0);
  std::unique_ptr<unsigned char[]> heapBytes;
  if (length > PacketNode::kInlineBytes) {
    heapBytes.reset(new unsigned char[length]);
  }
  PacketNode& node = ReserveNode();
  unsigned char* const bytes = heapBytes ? heapBytes.get() : node.inlineBytes;
  if (length == kShortMessageBytes) {
    std::memcpy(bytes, packet.data, kShortMessageBytes);  // most packets, without a call
  } else if (length > 0) {
    std::memcpy(bytes, packet.data, length);
  }
  node.packet = {bytes, length, packet.stamp};
  if (heapBytes) {
    node.heapBytes = std::move(heapBytes);
  }
  node.arrived.store(true, std::memory_order_release);
}

void PacketQueue::Enqueue(TimeStamp const& stamp, RCPtrMT<SysexImpl> const& sysex) {
  PacketNode& node = ReserveNode();
  node.packet.stamp = stamp;
  node.sysex = sysex;
  node.arrived.store(true, std::memory_order_release);
}

PacketNode& PacketQueue::ReserveNode() {
  // Acquire: the segment was made before the tail named it. The exchanges release, so that they
  // hand that on.
  std::uintptr_t tail = tail_.load(std::memory_order_acquire);
  for (;;) {
    PacketSegment* const segment = SegmentOf(tail);
    if (segment != nullptr && ReservedOf(tail) < PacketSegment::kNodes) {
      if (tail_.compare_exchange_weak(tail, tail + 1, std::memory_order_acq_rel,
                                      std::memory_order_acquire)) {
        return segment->nodes[ReservedOf(tail)];
      }
      continue;
    }
    PacketSegment* const fresh = PacketSegment::Make();
    if (tail_.compare_exchange_strong(tail, reinterpret_cast<std::uintptr_t>(fresh),
                                      std::memory_order_acq_rel, std::memory_order_acquire)) {
      (segment != nullptr ? segment->next : firstSegment_).store(fresh, std::memory_order_release);
      return fresh->nodes[0];
    }
    PacketSegment::Free(fresh);  // another producer was quicker
  }
}

void PacketQueue::Drain(Receiver* setupReceiver, Source const& source, bool applyFilter) {
  Drain(setupReceiver, source.hasDirectReceiver() ? source.getDirectReceiver() : nullptr, source,
        applyFilter);
}

void PacketQueue::Drain(Receiver* setupReceiver, Receiver* directReceiver, Source const& source,
                        bool applyFilter) {
  Receiver* const target = directReceiver != nullptr ? directReceiver : setupReceiver;
  bool const filtered = applyFilter && directReceiver == nullptr;
  DrainScope const scope(*this);
  // A total, and not a count, as the receiver may drain from within.
  unsigned long long const goal = totalTaken_ + CountReserved();
  while (totalTaken_ < goal) {
    PacketNode* const node = FirstNode();
    if (node == nullptr) {
      return;  // its producer is still filling it
    }
    // Taken before it is delivered, so that the receiver may throw, or drain from within.
    ++taken_;
    ++totalTaken_;
    Deliver(*node, target, filtered, source);
  }
}

// How many nodes are reserved and not taken.
unsigned long long PacketQueue::CountReserved() {
  std::uintptr_t const tail = tail_.load(std::memory_order_acquire);
  PacketSegment const* const last = SegmentOf(tail);
  if (current_ == nullptr) {
    current_ = firstSegment_.load(std::memory_order_acquire);
  }
  unsigned long long count = 0;
  std::size_t taken = taken_;
  for (PacketSegment const* segment = current_; segment != nullptr;
       segment = segment->next.load(std::memory_order_acquire)) {
    if (segment == last) {
      return count + (ReservedOf(tail) - taken);
    }
    count += PacketSegment::kNodes - taken;
    taken = 0;
  }
  return count;  // the last link is about to be made
}

// The oldest packet that was not taken, if it has arrived.
PacketNode* PacketQueue::FirstNode() {
  if (taken_ == PacketSegment::kNodes) {
    PacketSegment* const next = current_->next.load(std::memory_order_acquire);
    if (next == nullptr) {
      return nullptr;
    }
    current_->next.store(retired_, std::memory_order_relaxed);  // ours alone from here on
    retired_ = std::exchange(current_, next);
    taken_ = 0;
  }
  PacketNode& node = current_->nodes[taken_];
  return node.arrived.load(std::memory_order_acquire) ? &node : nullptr;
}

void PacketQueue::FreeRetired() {
  while (retired_ != nullptr) {
    PacketSegment::Free(std::exchange(retired_, retired_->next.load(std::memory_order_relaxed)));
  }
}

}  // namespace Ostinet::Impl

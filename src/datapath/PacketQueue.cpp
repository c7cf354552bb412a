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
#include <new>
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

// The node in a place, which it leaves at the end of a scope.
class TakenNode {
 public:
  TakenNode(PacketSegment& segment, std::size_t index) : node_(segment.Node(index)) {}
  ~TakenNode() { node_.~PacketNode(); }
  TakenNode(TakenNode const&) = delete;
  TakenNode& operator=(TakenNode const&) = delete;
  DataPacket const& View() const { return node_.View(); }

 private:
  PacketNode& node_;
};

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
  CountReserved();
  while (current_ != nullptr && FindArrived()) {
    TakenNode const node(*current_, taken_++);
  }
  FreeRetired();
  if (current_ != nullptr) {
    PacketSegment::Free(current_);
  }
}

void PacketQueue::Enqueue(DataPacket const& packet) {
  auto const length = static_cast<std::size_t>(packet.data != nullptr ? packet.length : 0);
  if (length <= PacketNode::kInlineBytes) {
    Put(packet.stamp, packet.data, length);
    return;
  }
  std::unique_ptr<unsigned char[]> bytes(new unsigned char[length]);
  std::memcpy(bytes.get(), packet.data, length);
  Put(packet.stamp, std::move(bytes), length);
}

void PacketQueue::Enqueue(TimeStamp const& stamp, RCPtrMT<SysexImpl> const& sysex) {
  Put(stamp, sysex.get());
}

// Making the node must not throw: a place that is reserved must be filled.
template <class... Args>
void PacketQueue::Put(Args&&... args) {
  Reservation const place = Reserve();
  new (place.segment->Place(place.index)) PacketNode(std::forward<Args>(args)...);
  place.segment->arrived[place.index].store(true, std::memory_order_release);
}

PacketQueue::Reservation PacketQueue::Reserve() {
  // Acquire: the segment was made before the tail named it. The exchanges release, so that they
  // hand that on.
  std::uintptr_t tail = tail_.load(std::memory_order_acquire);
  for (;;) {
    PacketSegment* const segment = SegmentOf(tail);
    if (segment != nullptr && ReservedOf(tail) < PacketSegment::kNodes) {
      if (tail_.compare_exchange_weak(tail, tail + 1, std::memory_order_acq_rel,
                                      std::memory_order_acquire)) {
        return {segment, ReservedOf(tail)};
      }
      continue;
    }
    PacketSegment* const fresh = PacketSegment::Make();
    if (tail_.compare_exchange_strong(tail, reinterpret_cast<std::uintptr_t>(fresh),
                                      std::memory_order_acq_rel, std::memory_order_acquire)) {
      (segment != nullptr ? segment->next : firstSegment_).store(fresh, std::memory_order_release);
      return {fresh, 0};
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
  // A node that is reserved but not complete ends the drain.
  while (totalTaken_ < goal && FindArrived()) {
    // Taken before it is delivered, so that the receiver may throw, or drain from within.
    TakenNode const node(*current_, taken_++);
    ++totalTaken_;
    DataPacket const& packet = node.View();
    if (target != nullptr && (!filtered || target->WantsPacket(packet, source))) {
      target->HandlePacket(packet, source);
    }
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

// Moves to the oldest node that was not taken, in a segment that is there; whether it has arrived.
bool PacketQueue::FindArrived() {
  if (taken_ == PacketSegment::kNodes) {
    PacketSegment* const next = current_->next.load(std::memory_order_acquire);
    if (next == nullptr) {
      return false;
    }
    current_->next.store(retired_, std::memory_order_relaxed);  // ours alone from here on
    retired_ = std::exchange(current_, next);
    taken_ = 0;
  }
  return current_->arrived[taken_].load(std::memory_order_acquire);
}

void PacketQueue::FreeRetired() {
  while (retired_ != nullptr) {
    PacketSegment::Free(std::exchange(retired_, retired_->next.load(std::memory_order_relaxed)));
  }
}

}  // namespace Ostinet::Impl

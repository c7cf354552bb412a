// SPDX-License-Identifier: MIT

// From the system's callback threads to the host's polling thread.
//
// Producers push on a lock-free stack. The one consumer detaches the whole stack at once and turns
// it over in place, which restores the order of arrival, and appends it to what an earlier drain
// left. It takes one node after the other from the front, so that a receiver may throw, or drain
// again from within, and every node is still delivered once, in order, and freed. Nothing here
// blocks or, once the pool is warm, allocates: callbacks may run at interrupt-like priority.

#include "datapath/PacketQueue.h"

#include "core/Atomics.h"
#include "datapath/PacketNode.h"

namespace Ostinet::Impl {

PacketQueue::~PacketQueue() {
  CollectArrivals();
  while (first_ != nullptr) {
    PacketNodePtr const node(TakeFirst());
  }
}

void PacketQueue::Enqueue(DataPacket const& packet) {
  EnqueueAtomic(arrivals_, PacketNode::Make(packet));
}

void PacketQueue::Enqueue(TimeStamp const& stamp, RCPtrMT<SysexImpl> const& sysex) {
  EnqueueAtomic(arrivals_, PacketNode::Make(stamp, sysex));
}

void PacketQueue::Drain(Receiver* setupReceiver, Source const& source, bool applyFilter) {
  Drain(setupReceiver, source.hasDirectReceiver() ? source.getDirectReceiver() : nullptr, source,
        applyFilter);
}

void PacketQueue::Drain(Receiver* setupReceiver, Receiver* directReceiver, Source const& source,
                        bool applyFilter) {
  Receiver* const target = directReceiver != nullptr ? directReceiver : setupReceiver;
  bool const filtered = applyFilter && directReceiver == nullptr;
  CollectArrivals();
  while (first_ != nullptr) {
    PacketNodePtr const node(TakeFirst());
    DataPacket const packet = node->View();
    if (target != nullptr && (!filtered || target->WantsPacket(packet, source))) {
      target->HandlePacket(packet, source);
    }
  }
}

void PacketQueue::CollectArrivals() {
  auto* newest = static_cast<PacketNode*>(DetachAtomic(arrivals_));
  if (newest == nullptr) {
    return;
  }
  PacketNode* oldest = nullptr;
  for (PacketNode* node = newest; node != nullptr;) {
    auto* const older = static_cast<PacketNode*>(node->next);
    node->next = oldest;
    oldest = node;
    node = older;
  }
  if (first_ == nullptr) {
    first_ = oldest;
  } else {
    last_->next = oldest;
  }
  last_ = newest;
}

PacketNode* PacketQueue::TakeFirst() {
  PacketNode* const node = first_;
  first_ = static_cast<PacketNode*>(node->next);
  return node;
}

}  // namespace Ostinet::Impl

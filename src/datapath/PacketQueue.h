// SPDX-License-Identifier: MIT
#pragma once

#include "ostinet/Endpoint.h"
#include "ostinet/SysexRef.h"
#include "ostinet/TimeStamp.h"

namespace Ostinet::Impl {

struct PacketNode;

/// Input on its way from the system's threads to the host's polling thread, in order of arrival.
///
/// Ownership  Belongs to the port or virtual source whose input it holds. Its owner keeps it alive
///            for the length of a Drain, whatever the receiver does to the studio.
/// Threads    Enqueue on any thread, Drain on the polling thread alone.
class PacketQueue {
 public:
  PacketQueue() = default;
  ~PacketQueue();
  PacketQueue(PacketQueue const&) = delete;
  PacketQueue& operator=(PacketQueue const&) = delete;

  /// Copies the packet in. Up to 16 bytes need no memory beyond the queue's own pool. [realtime]
  /// Throws std::bad_alloc where a longer one finds no room.
  void Enqueue(DataPacket const& packet);
  /// Takes a reference on the message, whose bytes are read when it is drained. [realtime]
  void Enqueue(TimeStamp const& stamp, RCPtrMT<SysexImpl> const& sysex);

  /// Hands all that has arrived to the source's direct receiver, unfiltered, or, where it has none,
  /// to the receiver of the setup: with `applyFilter` only what that one wants. With neither
  /// receiver the packets are dropped. What a receiver throws travels on, and the packets behind
  /// the one that it threw at wait for the next drain.
  void Drain(Receiver* setupReceiver, Source const& source, bool applyFilter);
  void Drain(Receiver& setupReceiver, Source const& source, bool applyFilter) {
    Drain(&setupReceiver, source, applyFilter);
  }
  /// The same with the direct receiver at hand, or null.
  void Drain(Receiver* setupReceiver, Receiver* directReceiver, Source const& source,
             bool applyFilter);

 private:
  void CollectArrivals();
  PacketNode* TakeFirst();

  alignas(16) void* arrivals_[2] = {nullptr, nullptr};  // a stack: the newest on top
  PacketNode* first_ = nullptr;                         // collected, the oldest first
  PacketNode* last_ = nullptr;                          // valid while first_ is not null
};

}  // namespace Ostinet::Impl

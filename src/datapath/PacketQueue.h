// SPDX-License-Identifier: MIT
#pragma once

#include <atomic>
#include <cstddef>
#include <cstdint>

#include "ostinet/Endpoint.h"
#include "ostinet/SysexRef.h"
#include "ostinet/TimeStamp.h"

namespace Ostinet::Impl {

struct PacketSegment;

/// Input on its way from the system's threads to the host's polling thread, in order of arrival.
///
/// Ownership  Belongs to the port or virtual source whose input it holds. Its owner keeps it alive
///            for the length of a Drain, whatever the receiver does to the studio.
/// Threads    Enqueue on any thread, Drain on the polling thread alone. No Enqueue runs any more
///            when the queue is destroyed.
class PacketQueue {
 public:
  PacketQueue() = default;
  ~PacketQueue();
  PacketQueue(PacketQueue const&) = delete;
  PacketQueue& operator=(PacketQueue const&) = delete;

  /// Copies the packet in. Up to 16 bytes need no memory beyond the pool of all queues. [realtime]
  /// Throws std::bad_alloc where there is no room; the packet is then left out.
  void Enqueue(DataPacket const& packet);
  /// Takes a reference on the message, whose bytes are read when it is drained. [realtime]
  void Enqueue(TimeStamp const& stamp, RCPtrMT<SysexImpl> const& sysex);

  /// Hands all that has arrived to the source's direct receiver, unfiltered, or, where it has none,
  /// to the receiver of the setup: with `applyFilter` only what that one wants. With neither
  /// receiver the packets are dropped. What arrives meanwhile waits for the next drain. What a
  /// receiver throws travels on, and the packets behind the one that it threw at wait, too.
  void Drain(Receiver* setupReceiver, Source const& source, bool applyFilter);
  void Drain(Receiver& setupReceiver, Source const& source, bool applyFilter) {
    Drain(&setupReceiver, source, applyFilter);
  }
  /// The same with the direct receiver at hand, or null.
  void Drain(Receiver* setupReceiver, Receiver* directReceiver, Source const& source,
             bool applyFilter);

 private:
  class DrainScope;

  struct Reservation {
    PacketSegment* segment;
    std::size_t index;
  };

  template <class... Args>
  void Put(Args&&... args);
  Reservation Reserve();
  unsigned long long CountReserved();
  bool FindArrived();
  void FreeRetired();

  // The producers' end: where the last segment is, and in the low bits how many of its nodes are
  // reserved, less one. 0 before the first packet.
  alignas(64) std::atomic<std::uintptr_t> tail_{0};
  // Stored once by the producer of the first packet, loaded by the consumer.
  std::atomic<PacketSegment*> firstSegment_{nullptr};

  // The consumer's end: the segment it is in, and how many of its nodes it has taken.
  alignas(64) PacketSegment* current_ = nullptr;
  std::size_t taken_ = 0;
  unsigned long long totalTaken_ = 0;
  PacketSegment* retired_ = nullptr;  // segments that are done with, freed after the drain
  int drains_ = 0;                    // under way, one within the other
};

}  // namespace Ostinet::Impl

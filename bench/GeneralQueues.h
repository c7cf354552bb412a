// SPDX-License-Identifier: MIT
#pragma once

// Two general queues with the operations of the library's own, as baselines.

#include <concurrentqueue/concurrentqueue.h>

#include <boost/lockfree/queue.hpp>
#include <cstring>
#include <memory>

#include "datapath/PacketQueue.h"
#include "datapath/SysexImpl.h"

namespace Ostinet::Bench {

/// A short packet as a plain structure, the only kind that Boost's queue takes.
struct PlainPacket {
  PlainPacket() = default;
  explicit PlainPacket(DataPacket const& packet) : stamp(packet.stamp), length(packet.length) {
    std::memcpy(bytes, packet.data, static_cast<std::size_t>(length));
  }
  DataPacket View() const { return {bytes, length, stamp}; }

  TimeStamp stamp;
  unsigned long long length = 0;
  unsigned char bytes[16];
};

/// All that the library's queue carries: also a reference on a sysex message, or bytes on the heap.
struct OwningPacket {
  OwningPacket() = default;
  explicit OwningPacket(DataPacket const& packet) : stamp(packet.stamp), length(packet.length) {
    auto const count = static_cast<std::size_t>(length);
    if (count > sizeof inlineBytes) {
      heapBytes.reset(new unsigned char[count]);
    }
    std::memcpy(heapBytes ? heapBytes.get() : inlineBytes, packet.data, count);
  }
  DataPacket View() const {
    if (sysex.get() != nullptr) {
      return {sysex->begin(), sysex->Size(), stamp};
    }
    return {heapBytes ? heapBytes.get() : inlineBytes, length, stamp};
  }

  TimeStamp stamp;
  unsigned long long length = 0;
  RCPtrMT<Impl::SysexImpl> sysex;
  std::unique_ptr<unsigned char[]> heapBytes;
  unsigned char inlineBytes[16];
};

class OurQueue {
 public:
  void Put(DataPacket const& packet) { queue_.Enqueue(packet); }
  void TakeAll(Receiver& receiver, Source const& source) {
    queue_.Drain(&receiver, nullptr, source, false);
  }

 private:
  Impl::PacketQueue queue_;
};

class BoostQueue {
 public:
  void Put(DataPacket const& packet) { queue_.push(PlainPacket(packet)); }
  void TakeAll(Receiver& receiver, Source const& source) {
    queue_.consume_all(
        [&](PlainPacket const& packet) { receiver.HandlePacket(packet.View(), source); });
  }

 private:
  boost::lockfree::queue<PlainPacket> queue_{1024};
};

template <class Packet>
class MoodycamelQueue {
 public:
  void Put(DataPacket const& packet) { queue_.enqueue(Packet(packet)); }
  void TakeAll(Receiver& receiver, Source const& source) {
    while (std::size_t const count = queue_.try_dequeue_bulk(taken_, std::size(taken_))) {
      for (std::size_t i = 0; i < count; ++i) {
        receiver.HandlePacket(taken_[i].View(), source);
      }
    }
  }

 private:
  moodycamel::ConcurrentQueue<Packet> queue_{1024};
  Packet taken_[64];
};

}  // namespace Ostinet::Bench

// SPDX-License-Identifier: MIT
#pragma once

#include <cstddef>
#include <vector>

#include "ostinet/TimeStamp.h"

namespace Ostinet::Impl {

/// A first-in, first-out queue of packets with their bytes. It keeps the room that it has grown
/// to, so that it allocates nothing in the steady state. Not locked.
class PacketRing {
 public:
  struct Packet {
    TimeStamp stamp;
    std::vector<unsigned char> bytes;
  };

  bool IsEmpty() const { return count_ == 0; }
  Packet const& Front() const { return slots_[first_]; }

  void PushBack(DataPacket const& packet) {
    if (count_ == slots_.size()) {
      Grow();
    }
    Packet& slot = slots_[(first_ + count_) % slots_.size()];
    slot.stamp = packet.stamp;
    slot.bytes.assign(packet.data, packet.data + packet.length);
    ++count_;
  }
  void PopBack() { --count_; }
  /// Swaps the oldest packet into `packet`, whose room the slot takes over.
  void PopFront(Packet& packet) {
    std::swap(packet, slots_[first_]);
    first_ = (first_ + 1) % slots_.size();
    --count_;
  }
  void Clear() {
    first_ = 0;
    count_ = 0;
  }

 private:
  static constexpr std::size_t kFirstRoom = 16;
  static constexpr std::size_t kUsualBytes = 16;

  void Grow() {
    std::vector<Packet> larger(slots_.empty() ? kFirstRoom : slots_.size() * 2);
    for (Packet& slot : larger) {
      slot.bytes.reserve(kUsualBytes);
    }
    for (std::size_t i = 0; i < count_; ++i) {
      std::swap(larger[i], slots_[(first_ + i) % slots_.size()]);
    }
    slots_.swap(larger);
    first_ = 0;
  }

  std::vector<Packet> slots_;
  std::size_t first_ = 0;
  std::size_t count_ = 0;
};

}  // namespace Ostinet::Impl

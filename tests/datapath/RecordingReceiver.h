// SPDX-License-Identifier: MIT
#pragma once

#include <functional>
#include <vector>

#include "ostinet/Endpoint.h"

namespace Ostinet::Testing {

/// Keeps what it is given, and wants what it is told to want.
class RecordingReceiver : public Receiver {
 public:
  struct Arrival {
    std::vector<unsigned char> bytes;
    TimeStamp stamp;
  };

  bool WantsPacket(DataPacket const& packet, Source const&) override {
    ++asked;
    return !wants || wants(packet);
  }
  void HandlePacket(DataPacket const& packet, Source const&) override {
    arrivals.push_back({{packet.data, packet.data + packet.length}, packet.stamp});
    if (onPacket) {
      onPacket(packet);
    }
  }

  /// The first byte of each packet that arrived.
  std::vector<int> FirstBytes() const {
    std::vector<int> bytes;
    for (Arrival const& arrival : arrivals) {
      bytes.push_back(arrival.bytes.empty() ? -1 : arrival.bytes.front());
    }
    return bytes;
  }

  std::function<bool(DataPacket const&)> wants;
  std::function<void(DataPacket const&)> onPacket;
  std::vector<Arrival> arrivals;
  int asked = 0;
};

}  // namespace Ostinet::Testing

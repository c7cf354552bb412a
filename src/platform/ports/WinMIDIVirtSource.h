// SPDX-License-Identifier: MIT
#pragma once

#include <memory>

#include "datapath/PacketQueue.h"
#include "platform/WinMIDIImplImpl.h"

namespace Ostinet::Impl {

/// The source of a virtual pair: what is sent to its destination waits here for the next poll.
class WinMIDIVirtSource : public WinMIDIImplImpl {
 public:
  explicit WinMIDIVirtSource(WinMIDISetup& setup)
      : WinMIDIImplImpl(setup, nullptr), queue_(std::make_shared<PacketQueue>()) {}

  /// Never null; the destination and its senders share it.
  std::shared_ptr<PacketQueue> const& Queue() const { return queue_; }

 private:
  std::shared_ptr<PacketQueue> const queue_;
};

}  // namespace Ostinet::Impl

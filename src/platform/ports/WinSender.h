// SPDX-License-Identifier: MIT
#pragma once

#include <memory>

#include "datapath/ChannelPatchState.h"
#include "model/DeviceObjectImpl.h"
#include "ostinet/Endpoint.h"

namespace Ostinet::Impl {

/// The way out for `object`, a destination: its port, or that of the direct destination it hangs
/// on, or the source of its virtual pair. Never null; what leads nowhere answers CanSend with
/// false.
///
/// Threads  Made on the polling thread. A sender belongs to one thread at a time; it stays
///          harmless, and sends nothing, when its port is detached or the studio signed out.
std::unique_ptr<Sender> MakeWinSender(DeviceObjectImpl* object);

/// Base of the three ways out: follows the program changes that pass.
class TrackingSender : public Sender {
 public:
  explicit TrackingSender(RCPtrMT<ChannelPatchState> const& tracker) : tracker_(tracker) {}

  // Senders come and go with every single packet, so they live in a pool of blocks.
  static void* operator new(std::size_t size);
  static void operator delete(void* sender, std::size_t size);

  void Send(DataPacket const& packet) final;

 protected:
  virtual void Transmit(DataPacket const& packet) = 0;

 private:
  RCPtrMT<ChannelPatchState> const tracker_;
};

}  // namespace Ostinet::Impl

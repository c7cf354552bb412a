// SPDX-License-Identifier: MIT

#include "platform/ports/WinSender.h"

#include "core/FixedBlockAlloc.h"
#include "model/DestinationImpl.h"
#include "platform/WinMIDIPort.h"
#include "platform/ports/DMusSender.h"
#include "platform/ports/WinDMusMIDIOutPort.h"
#include "platform/ports/WinLegacyMIDIOutPort.h"
#include "platform/ports/WinMIDIVirtDest.h"

namespace Ostinet::Impl {

namespace {

constexpr std::size_t kSenderBlock = 128;

FixedBlockAllocMT& SenderPool() {
  // Never destroyed: a host may drop its last sender while the process ends.
  static FixedBlockAllocMT* const pool = new FixedBlockAllocMT(kSenderBlock, 16);
  return *pool;
}

class NowhereSender : public TrackingSender {
 public:
  using TrackingSender::TrackingSender;
  void Flush() override {}
  bool CanSend() const override { return false; }

 protected:
  void Transmit(DataPacket const&) override {}
};

class LegacySender : public TrackingSender {
 public:
  LegacySender(RCPtrMT<ChannelPatchState> const& tracker, std::shared_ptr<LegacyOutDevice> device)
      : TrackingSender(tracker), device_(std::move(device)) {}
  void Flush() override {}
  bool CanSend() const override { return device_->IsOpen(); }

 protected:
  void Transmit(DataPacket const& packet) override { device_->SendPacket(packet); }

 private:
  std::shared_ptr<LegacyOutDevice> const device_;
};

class VirtualSender : public TrackingSender {
 public:
  VirtualSender(RCPtrMT<ChannelPatchState> const& tracker, std::shared_ptr<PacketQueue> queue)
      : TrackingSender(tracker), queue_(std::move(queue)) {}
  void Flush() override {}
  bool CanSend() const override { return true; }

 protected:
  void Transmit(DataPacket const& packet) override { queue_->Enqueue(packet); }

 private:
  std::shared_ptr<PacketQueue> const queue_;
};

DestinationImpl* DirectDestination(DeviceObjectImpl* object) {
  auto* const destination = dynamic_cast<DestinationImpl*>(object);
  if (destination == nullptr || destination->IsDirect()) {
    return destination;
  }
  return dynamic_cast<DestinationImpl*>(destination->GetDirectEndpoint());
}

}  // namespace

std::unique_ptr<Sender> MakeWinSender(DeviceObjectImpl* object) {
  DestinationImpl* const destination = DirectDestination(object);
  if (destination == nullptr) {
    return std::make_unique<NowhereSender>(nullptr);
  }
  RCPtrMT<ChannelPatchState> const tracker = destination->GetChannelState();
  if (destination->IsVirtual()) {
    auto* const peer = dynamic_cast<WinMIDIVirtDest*>(destination->Peer());
    if (peer != nullptr) {
      return std::make_unique<VirtualSender>(tracker, peer->Queue());
    }
  } else if (WinMIDIPort const* const port = WinMIDIPort::Of(*destination)) {
    if (port->GetWhichAPI() == WinMIDIPort::kLegacy) {
      auto* const legacy = static_cast<WinLegacyMIDIOutPort*>(port->GetActiveImpl());
      return std::make_unique<LegacySender>(tracker, legacy->Device());
    }
    if (port->GetWhichAPI() == WinMIDIPort::kDirectMusic) {
      auto* const directMusic = static_cast<WinDMusMIDIOutPort*>(port->GetActiveImpl());
      return std::make_unique<DMusSender>(tracker, directMusic->Line());
    }
  }
  return std::make_unique<NowhereSender>(tracker);
}

void* TrackingSender::operator new(std::size_t size) {
  return size <= kSenderBlock ? SenderPool().allocate(kSenderBlock) : ::operator new(size);
}

void TrackingSender::operator delete(void* sender, std::size_t size) {
  if (size <= kSenderBlock) {
    SenderPool().deallocate(sender, kSenderBlock);
  } else {
    ::operator delete(sender);
  }
}

void TrackingSender::Send(DataPacket const& packet) {
  if (packet.data == nullptr || packet.length == 0) {
    return;
  }
  if (tracker_) {
    tracker_->Track(packet);
  }
  Transmit(packet);
}

}  // namespace Ostinet::Impl

// SPDX-License-Identifier: MIT
#pragma once

#include "platform/ports/WinDMusMIDIPort.h"
#include "platform/ports/WinSender.h"

namespace Ostinet::Impl {

/// Packs stamped messages into a borrowed buffer, which DirectMusic plays at their time.
class DMusSender : public TrackingSender {
 public:
  /// `line` may be null: the port is closed.
  DMusSender(RCPtrMT<ChannelPatchState> const& tracker, std::shared_ptr<DMusLine> line);

  ~DMusSender() override;

  void Flush() override;
  bool CanSend() const override;

 protected:
  void Transmit(DataPacket const& packet) override;

 private:
  class Packer;
  void PlayAndFlush();
  void NotePacked(HRESULT result, DWORD bytes);

  std::shared_ptr<DMusLine> const line_;
  ComPtr<IReferenceClock> latencyClock_;
  BufferPool::Loan loan_;
  // Of the borrowed buffer, which nobody else touches: asking it for each packet costs more than
  // the packing.
  DWORD bufferUsed_ = 0;
  DWORD bufferMax_ = 0;
};

}  // namespace Ostinet::Impl

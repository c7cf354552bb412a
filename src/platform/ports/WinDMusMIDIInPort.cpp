// SPDX-License-Identifier: MIT

#include "platform/ports/WinDMusMIDIInPort.h"

namespace Ostinet::Impl {

namespace {

// A driver that never runs dry must not hang the poll: what is left waits for the next one.
constexpr int kMostBuffersADrain = 4096;

void HandOver(DataPacket const& packet, Receiver* receiver, Source const& source) {
  if (receiver != nullptr && receiver->WantsPacket(packet, source)) {
    receiver->HandlePacket(packet, source);
  }
}

}  // namespace

WinDMusMIDIInPort::~WinDMusMIDIInPort() { CloseEvent(); }

void WinDMusMIDIInPort::Open(DMUS_PORTCAPS const& caps) {
  WinDMusMIDIPort::Open(caps);
  notification_ = GetSession()->GetWaits().CreateEventW();
  if (notification_ != nullptr && Port()->SetReadNotificationHandle(notification_) != S_OK) {
    CloseEvent();  // the port is never read then
  }
}

void WinDMusMIDIInPort::Deactivate() {
  WinDMusMIDIPort::Deactivate();
  CloseEvent();
}

void WinDMusMIDIInPort::CloseEvent() {
  if (notification_ != nullptr) {
    GetSession()->GetWaits().CloseHandle(notification_);
    notification_ = nullptr;
  }
}

void WinDMusMIDIInPort::DrainInput(Receiver* receiver, Source const& source) {
  Waits& waits = GetSession()->GetWaits();
  if (Port() == nullptr || notification_ == nullptr ||
      waits.WaitForSingleObject(notification_, 0) != WAIT_OBJECT_0) {
    return;
  }
  // The receiver may take this port out of the studio while it is being drained.
  std::shared_ptr<DMusLine> const line = Line();
  try {
    BufferPool::Loan const loan = BufferPool::Borrow(GetSession()->Pool());
    DrainBuffers(*loan->buffer.get(), receiver, source);
  } catch (...) {
    // The host hears of its own failure where it happened; the poll goes on.
  }
}

void WinDMusMIDIInPort::DrainBuffers(IDirectMusicBuffer& buffer, Receiver* receiver,
                                     Source const& source) {
  buffer.Flush();
  for (int round = 0; Port() != nullptr && Port()->Read(&buffer) == S_OK; ++round) {
    if (round == kMostBuffersADrain) {
      GetSession()->GetWaits().SetEvent(notification_);
      return;
    }
    buffer.ResetReadPtr();
    REFERENCE_TIME time = 0;
    DWORD length = 0;
    BYTE* data = nullptr;
    while (buffer.GetNextEvent(&time, nullptr, &length, &data) == S_OK) {
      HandOver({data, length, TimeStamp(Clocks(static_cast<unsigned long long>(time)))}, receiver,
               source);
    }
    buffer.Flush();
  }
}

}  // namespace Ostinet::Impl

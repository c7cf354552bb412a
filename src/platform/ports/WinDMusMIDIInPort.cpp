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

/// Reads until nothing is left or the port is closed, which the receiver may do. False when the
/// driver never ran dry.
bool DrainBuffers(DMusLine const& line, IDirectMusicBuffer& buffer, Receiver* receiver,
                  Source const& source) {
  buffer.Flush();
  for (int round = 0; line.isOpen && line.port->Read(&buffer) == S_OK; ++round) {
    if (round == kMostBuffersADrain) {
      return false;
    }
    buffer.ResetReadPtr();
    REFERENCE_TIME time = 0;
    DWORD length = 0;
    BYTE* data = nullptr;
    while (line.isOpen && buffer.GetNextEvent(&time, nullptr, &length, &data) == S_OK) {
      HandOver({data, length, TimeStamp(Clocks(static_cast<unsigned long long>(time)))}, receiver,
               source);
    }
    buffer.Flush();
  }
  return true;
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
  if (Port() == nullptr || notification_ == nullptr ||
      GetSession()->GetWaits().WaitForSingleObject(notification_, 0) != WAIT_OBJECT_0) {
    return;
  }
  // The receiver may take this port out of the studio, and with it this object: what the drain
  // still needs then is held here.
  std::shared_ptr<DMusLine> const line = Line();
  HANDLE const notification = notification_;
  try {
    BufferPool::Loan const loan = BufferPool::Borrow(line->session->Pool());
    bool const isDry = DrainBuffers(*line, *loan->buffer.get(), receiver, source);
    if (!isDry && line->isOpen) {
      line->session->GetWaits().SetEvent(notification);
    }
  } catch (...) {
    // The host hears of its own failure where it happened; the poll goes on.
  }
}

}  // namespace Ostinet::Impl

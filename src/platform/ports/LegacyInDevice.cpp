// SPDX-License-Identifier: MIT

#include "platform/ports/LegacyInDevice.h"

#include <algorithm>
#include <mutex>

namespace Ostinet::Impl {

namespace {

/// A device that did not close may still call back: what it calls back with, and the buffers that
/// it fills, live as long as the process.
void KeepForever(std::shared_ptr<LegacyInDevice> device) {
  static std::mutex mutex;
  static auto* const kept = new std::vector<std::shared_ptr<LegacyInDevice>>;
  std::lock_guard<std::mutex> const lock(mutex);
  kept->push_back(std::move(device));
}

}  // namespace

LegacyInDevice::LegacyInDevice(std::shared_ptr<Session> session) : session_(std::move(session)) {}

LegacyInDevice::~LegacyInDevice() { UnprepareBuffers(); }

void LegacyInDevice::Open(UINT device) {
  System& system = session_->GetSystem();
  HMIDIIN handle = nullptr;
  auto const callback = reinterpret_cast<DWORD_PTR>(&LegacyInDevice::OnMessage);
  if (system.midiInOpen(&handle, device, callback, reinterpret_cast<DWORD_PTR>(this),
                        CALLBACK_FUNCTION) == MMSYSERR_NOERROR) {
    handle_ = handle;
  }
  bufferDevice_ = handle;
  AddBuffers();
  startEventTime_ = system.timeGetTime() / 1000.0;
  system.midiInStart(handle);
}

void LegacyInDevice::AddBuffers() {
  System& system = session_->GetSystem();
  bufferBytes_.resize(kBufferBytes * kBufferCount);
  headers_.resize(kBufferCount);
  for (std::size_t i = 0; i < kBufferCount; ++i) {
    headers_[i].lpData = &bufferBytes_[i * kBufferBytes];
    headers_[i].dwBufferLength = kBufferBytes;
    if (system.midiInPrepareHeader(bufferDevice_, &headers_[i], sizeof(MIDIHDR)) ==
        MMSYSERR_NOERROR) {
      system.midiInAddBuffer(bufferDevice_, &headers_[i], sizeof(MIDIHDR));
    }
  }
}

void LegacyInDevice::UnprepareBuffers() {
  for (MIDIHDR& header : headers_) {
    session_->GetSystem().midiInUnprepareHeader(bufferDevice_, &header, sizeof header);
  }
  headers_.clear();
}

void LegacyInDevice::SetTarget(Source const& source, Receiver* receiver) {
  ownedTarget_ = std::make_unique<Target>(Target{source, receiver});
  target_ = ownedTarget_.get();
}

void LegacyInDevice::Close() {
  bool hasClosed = true;
  if (HMIDIIN const handle = handle_) {
    System& system = session_->GetSystem();
    system.midiInStop(handle);
    system.midiInReset(handle);
    hasClosed = system.midiInClose(handle) == MMSYSERR_NOERROR;
    handle_ = nullptr;
  }
  target_ = nullptr;
  for (int inUse = inUseCount_; inUse != 0; inUse = inUseCount_) {
    inUseCount_.wait(inUse);
  }
  ownedTarget_.reset();
  if (!hasClosed) {
    KeepForever(shared_from_this());
  }
}

void LegacyInDevice::Drain() {
  if (ownedTarget_ != nullptr) {
    // The receiver may take this port out of the studio while it is being drained.
    Source const source = ownedTarget_->source;
    queue_.Drain(ownedTarget_->receiver, source, false);
  }
}

void CALLBACK LegacyInDevice::OnMessage(HMIDIIN, UINT message, DWORD_PTR instance,
                                        DWORD_PTR parameter1, DWORD_PTR parameter2) {
  auto& device = *reinterpret_cast<LegacyInDevice*>(instance);
  ++device.inUseCount_;
  auto const milliseconds = static_cast<DWORD>(parameter2);
  switch (message) {
    case MIM_CLOSE:
      device.handle_ = nullptr;
      break;
    case MIM_DATA:
    case MIM_MOREDATA:
      device.OnShortMessage(static_cast<DWORD>(parameter1), milliseconds);
      break;
    case MIM_LONGDATA:
      device.OnLongMessage(*reinterpret_cast<MIDIHDR*>(parameter1), milliseconds);
      break;
    default:
      break;
  }
  --device.inUseCount_;
  device.inUseCount_.notify_all();
}

void LegacyInDevice::OnShortMessage(DWORD message, DWORD milliseconds) {
  // Three bytes whatever the status: hosts count on the third, which is 0 in a shorter message.
  unsigned char const bytes[] = {static_cast<unsigned char>(message),
                                 static_cast<unsigned char>(message >> 8),
                                 static_cast<unsigned char>(message >> 16)};
  Keep(bytes, sizeof bytes, milliseconds);
}

void LegacyInDevice::OnLongMessage(MIDIHDR& header, DWORD milliseconds) {
  DWORD const length = std::min(header.dwBytesRecorded, kBufferBytes);
  if (length == 0) {
    return;  // a reset gives the buffer back: it must not be added again
  }
  Keep(reinterpret_cast<unsigned char const*>(header.lpData), length, milliseconds);
  if (HMIDIIN const handle = handle_) {
    session_->GetSystem().midiInAddBuffer(handle, &header, sizeof header);
  }
}

void LegacyInDevice::Keep(unsigned char const* data, DWORD length, DWORD milliseconds) noexcept {
  Target const* const target = target_;
  if (target == nullptr || target->receiver == nullptr) {
    return;
  }
  try {
    TimeStamp const stamp(EventTimeToMIDITime(startEventTime_ + milliseconds / 1000.0));
    DataPacket const packet{data, length, stamp};
    if (target->receiver->WantsPacket(packet, target->source)) {
      queue_.Enqueue(packet);
    }
  } catch (...) {
    // Nothing may be thrown into the system's thread; the packet is lost.
  }
}

}  // namespace Ostinet::Impl

// SPDX-License-Identifier: MIT
#pragma once

#include <memory>
#include <utility>

#include "platform/system/System.h"

namespace Ostinet::Bench {

/// Another system, whose last opened input can be called back directly.
class TappedSystem final : public Impl::System {
 public:
  using Callback = void CALLBACK(HMIDIIN, UINT, DWORD_PTR, DWORD_PTR, DWORD_PTR);

  explicit TappedSystem(std::shared_ptr<System> inner) : inner_(std::move(inner)) {}

  /// A short message comes in, `milliseconds` after the start of the device.
  void CallBack(DWORD message, DWORD milliseconds) {
    callback_(input_, MIM_DATA, instance_, message, milliseconds);
  }

  UINT midiInGetNumDevs() override { return inner_->midiInGetNumDevs(); }
  MMRESULT midiInGetDevCapsW(UINT_PTR device, MIDIINCAPSW* caps, UINT size) override {
    return inner_->midiInGetDevCapsW(device, caps, size);
  }
  MMRESULT midiInOpen(HMIDIIN* handle, UINT device, DWORD_PTR callback, DWORD_PTR instance,
                      DWORD flags) override {
    MMRESULT const result = inner_->midiInOpen(handle, device, callback, instance, flags);
    input_ = *handle;
    callback_ = reinterpret_cast<Callback*>(callback);
    instance_ = instance;
    return result;
  }
  MMRESULT midiInClose(HMIDIIN handle) override { return inner_->midiInClose(handle); }
  MMRESULT midiInStart(HMIDIIN handle) override { return inner_->midiInStart(handle); }
  MMRESULT midiInStop(HMIDIIN handle) override { return inner_->midiInStop(handle); }
  MMRESULT midiInReset(HMIDIIN handle) override { return inner_->midiInReset(handle); }
  MMRESULT midiInPrepareHeader(HMIDIIN handle, MIDIHDR* header, UINT size) override {
    return inner_->midiInPrepareHeader(handle, header, size);
  }
  MMRESULT midiInUnprepareHeader(HMIDIIN handle, MIDIHDR* header, UINT size) override {
    return inner_->midiInUnprepareHeader(handle, header, size);
  }
  MMRESULT midiInAddBuffer(HMIDIIN handle, MIDIHDR* header, UINT size) override {
    return inner_->midiInAddBuffer(handle, header, size);
  }

  UINT midiOutGetNumDevs() override { return inner_->midiOutGetNumDevs(); }
  MMRESULT midiOutGetDevCapsW(UINT_PTR device, MIDIOUTCAPSW* caps, UINT size) override {
    return inner_->midiOutGetDevCapsW(device, caps, size);
  }
  MMRESULT midiOutOpen(HMIDIOUT* handle, UINT device, DWORD_PTR callback, DWORD_PTR instance,
                       DWORD flags) override {
    return inner_->midiOutOpen(handle, device, callback, instance, flags);
  }
  MMRESULT midiOutClose(HMIDIOUT handle) override { return inner_->midiOutClose(handle); }
  MMRESULT midiOutReset(HMIDIOUT handle) override { return inner_->midiOutReset(handle); }
  MMRESULT midiOutShortMsg(HMIDIOUT handle, DWORD message) override {
    return inner_->midiOutShortMsg(handle, message);
  }
  MMRESULT midiOutPrepareHeader(HMIDIOUT handle, MIDIHDR* header, UINT size) override {
    return inner_->midiOutPrepareHeader(handle, header, size);
  }
  MMRESULT midiOutUnprepareHeader(HMIDIOUT handle, MIDIHDR* header, UINT size) override {
    return inner_->midiOutUnprepareHeader(handle, header, size);
  }
  MMRESULT midiOutLongMsg(HMIDIOUT handle, MIDIHDR* header, UINT size) override {
    return inner_->midiOutLongMsg(handle, header, size);
  }

  DWORD timeGetTime() override { return inner_->timeGetTime(); }
  HRESULT CreateDirectMusic(IDirectMusic** result) override {
    return inner_->CreateDirectMusic(result);
  }
  HRESULT CreateDirectMusicLoader(IDirectMusicLoader** result) override {
    return inner_->CreateDirectMusicLoader(result);
  }
  std::vector<Impl::AudioSession> SnapshotAudioSessions() override {
    return inner_->SnapshotAudioSessions();
  }
  Impl::Waits& GetWaits() override { return inner_->GetWaits(); }

 private:
  std::shared_ptr<System> const inner_;
  HMIDIIN input_ = nullptr;
  Callback* callback_ = nullptr;
  DWORD_PTR instance_ = 0;
};

}  // namespace Ostinet::Bench

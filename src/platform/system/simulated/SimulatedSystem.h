// SPDX-License-Identifier: MIT
#pragma once

#include <functional>
#include <memory>
#include <utility>

#include "platform/system/System.h"
#include "platform/system/simulated/Studio.h"

namespace Ostinet::Impl::Simulated {

/// The seam's operations over a simulated studio.
///
/// Threads  Any.
class SimulatedSystem : public System {
 public:
  SimulatedSystem() : studio_(std::make_shared<Studio>()) {}

  Studio& GetStudio() const { return *studio_; }

  // WinMMInput.cpp
  UINT midiInGetNumDevs() override;
  MMRESULT midiInGetDevCapsW(UINT_PTR device, MIDIINCAPSW* caps, UINT size) override;
  MMRESULT midiInOpen(HMIDIIN* handle, UINT device, DWORD_PTR callback, DWORD_PTR instance,
                      DWORD flags) override;
  MMRESULT midiInClose(HMIDIIN handle) override;
  MMRESULT midiInStart(HMIDIIN handle) override;
  MMRESULT midiInStop(HMIDIIN handle) override;
  MMRESULT midiInReset(HMIDIIN handle) override;
  MMRESULT midiInPrepareHeader(HMIDIIN handle, MIDIHDR* header, UINT size) override;
  MMRESULT midiInUnprepareHeader(HMIDIIN handle, MIDIHDR* header, UINT size) override;
  MMRESULT midiInAddBuffer(HMIDIIN handle, MIDIHDR* header, UINT size) override;

  // WinMMOutput.cpp
  UINT midiOutGetNumDevs() override;
  MMRESULT midiOutGetDevCapsW(UINT_PTR device, MIDIOUTCAPSW* caps, UINT size) override;
  MMRESULT midiOutOpen(HMIDIOUT* handle, UINT device, DWORD_PTR callback, DWORD_PTR instance,
                       DWORD flags) override;
  MMRESULT midiOutClose(HMIDIOUT handle) override;
  MMRESULT midiOutReset(HMIDIOUT handle) override;
  MMRESULT midiOutShortMsg(HMIDIOUT handle, DWORD message) override;
  MMRESULT midiOutPrepareHeader(HMIDIOUT handle, MIDIHDR* header, UINT size) override;
  MMRESULT midiOutUnprepareHeader(HMIDIOUT handle, MIDIHDR* header, UINT size) override;
  MMRESULT midiOutLongMsg(HMIDIOUT handle, MIDIHDR* header, UINT size) override;

  // SimulatedSystem.cpp
  DWORD timeGetTime() override;
  HRESULT CreateDirectMusic(IDirectMusic** result) override;
  HRESULT CreateDirectMusicLoader(IDirectMusicLoader** result) override;
  std::vector<AudioSession> SnapshotAudioSessions() override;
  Waits& GetWaits() override { return studio_->GetWaits(); }
  std::shared_ptr<void> WatchDeviceChanges(std::function<void()> changed) override {
    return studio_->Watch(std::move(changed));
  }

 private:
  std::shared_ptr<Studio> const studio_;
};

}  // namespace Ostinet::Impl::Simulated

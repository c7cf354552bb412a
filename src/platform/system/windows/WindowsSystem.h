// SPDX-License-Identifier: MIT
#pragma once

#include <memory>
#include <string>
#include <vector>

#include "platform/system/System.h"
#include "platform/system/common/ChangeWatch.h"
#include "platform/system/windows/ComApartment.h"

namespace Ostinet::Impl {

/// Windows behind the seam: each operation is the system's own.
class WindowsSystem final : public System {
 public:
  explicit WindowsSystem(std::unique_ptr<Waits> waits);

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

  DWORD timeGetTime() override;
  HRESULT CreateDirectMusic(IDirectMusic** result) override;
  HRESULT CreateDirectMusicLoader(IDirectMusicLoader** result) override;
  std::vector<AudioSession> SnapshotAudioSessions() override;
  Waits& GetWaits() override { return *waits_; }
  std::shared_ptr<void> WatchDeviceChanges(std::function<void()> changed) override;

 private:
  ComApartment const apartment_;
  std::unique_ptr<Waits> const waits_;
  ChangeWatch watch_;
};

}  // namespace Ostinet::Impl

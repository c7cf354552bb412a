// SPDX-License-Identifier: MIT
#pragma once

#include <memory>
#include <vector>

#include "platform/system/System.h"
#include "platform/system/common/ChangeWatch.h"
#include "platform/system/common/HandleTable.h"
#include "platform/system/native/NativeInput.h"
#include "platform/system/native/NativeOutput.h"
#include "platform/system/native/PortTable.h"

namespace Ostinet::Impl {

/// The ports of a Linux machine behind the seam: each is a WinMM device, and DirectMusic's emulated
/// port of the same name.
class NativeSystem : public System {
 public:
  NativeSystem(std::vector<std::shared_ptr<MidiService>> services, std::unique_ptr<Waits> waits);
  ~NativeSystem() override;

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
  /// None: DirectMusic makes no sound here.
  std::vector<AudioSession> SnapshotAudioSessions() override { return {}; }
  Waits& GetWaits() override { return *waits_; }
  std::shared_ptr<void> WatchDeviceChanges(std::function<void()> changed) override;

 private:
  std::vector<std::shared_ptr<MidiService>> const services_;
  std::unique_ptr<Waits> const waits_;
  std::shared_ptr<PortTable> const ports_;
  HandleTable<HMIDIIN, NativeInput> inputs_;
  HandleTable<HMIDIOUT, NativeOutput> outputs_;
  ChangeWatch watch_;  // last: it looks at the ports
};

}  // namespace Ostinet::Impl

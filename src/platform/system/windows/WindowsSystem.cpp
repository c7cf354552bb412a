// SPDX-License-Identifier: MIT
#include "platform/system/windows/WindowsSystem.h"

#include <utility>

#include "platform/system/windows/WindowsAudioSessions.h"

namespace Ostinet::Impl {
namespace {

// What WinMM says of its devices, which is where a change shows first.
std::vector<std::wstring> ListDeviceNames() {
  std::vector<std::wstring> names;
  UINT const inputs = ::midiInGetNumDevs();
  for (UINT i = 0; i < inputs; ++i) {
    MIDIINCAPSW caps{};
    if (::midiInGetDevCapsW(i, &caps, sizeof caps) == MMSYSERR_NOERROR) {
      names.push_back(std::wstring(L"in ") + caps.szPname);
    }
  }
  UINT const outputs = ::midiOutGetNumDevs();
  for (UINT i = 0; i < outputs; ++i) {
    MIDIOUTCAPSW caps{};
    if (::midiOutGetDevCapsW(i, &caps, sizeof caps) == MMSYSERR_NOERROR) {
      names.push_back(std::wstring(L"out ") + caps.szPname);
    }
  }
  return names;
}

}  // namespace

WindowsSystem::WindowsSystem(std::unique_ptr<Waits> waits)
    : waits_(std::move(waits)), watch_([seen = ListDeviceNames()]() mutable {
        std::vector<std::wstring> const before = std::exchange(seen, ListDeviceNames());
        return before != seen;
      }) {}

UINT WindowsSystem::midiInGetNumDevs() { return ::midiInGetNumDevs(); }

MMRESULT WindowsSystem::midiInGetDevCapsW(UINT_PTR device, MIDIINCAPSW* caps, UINT size) {
  return ::midiInGetDevCapsW(device, caps, size);
}

MMRESULT WindowsSystem::midiInOpen(HMIDIIN* handle, UINT device, DWORD_PTR callback,
                                   DWORD_PTR instance, DWORD flags) {
  return ::midiInOpen(handle, device, callback, instance, flags);
}

MMRESULT WindowsSystem::midiInClose(HMIDIIN handle) { return ::midiInClose(handle); }

MMRESULT WindowsSystem::midiInStart(HMIDIIN handle) { return ::midiInStart(handle); }

MMRESULT WindowsSystem::midiInStop(HMIDIIN handle) { return ::midiInStop(handle); }

MMRESULT WindowsSystem::midiInReset(HMIDIIN handle) { return ::midiInReset(handle); }

MMRESULT WindowsSystem::midiInPrepareHeader(HMIDIIN handle, MIDIHDR* header, UINT size) {
  return ::midiInPrepareHeader(handle, header, size);
}

MMRESULT WindowsSystem::midiInUnprepareHeader(HMIDIIN handle, MIDIHDR* header, UINT size) {
  return ::midiInUnprepareHeader(handle, header, size);
}

MMRESULT WindowsSystem::midiInAddBuffer(HMIDIIN handle, MIDIHDR* header, UINT size) {
  return ::midiInAddBuffer(handle, header, size);
}

UINT WindowsSystem::midiOutGetNumDevs() { return ::midiOutGetNumDevs(); }

MMRESULT WindowsSystem::midiOutGetDevCapsW(UINT_PTR device, MIDIOUTCAPSW* caps, UINT size) {
  return ::midiOutGetDevCapsW(device, caps, size);
}

MMRESULT WindowsSystem::midiOutOpen(HMIDIOUT* handle, UINT device, DWORD_PTR callback,
                                    DWORD_PTR instance, DWORD flags) {
  return ::midiOutOpen(handle, device, callback, instance, flags);
}

MMRESULT WindowsSystem::midiOutClose(HMIDIOUT handle) { return ::midiOutClose(handle); }

MMRESULT WindowsSystem::midiOutReset(HMIDIOUT handle) { return ::midiOutReset(handle); }

MMRESULT WindowsSystem::midiOutShortMsg(HMIDIOUT handle, DWORD message) {
  return ::midiOutShortMsg(handle, message);
}

MMRESULT WindowsSystem::midiOutPrepareHeader(HMIDIOUT handle, MIDIHDR* header, UINT size) {
  return ::midiOutPrepareHeader(handle, header, size);
}

MMRESULT WindowsSystem::midiOutUnprepareHeader(HMIDIOUT handle, MIDIHDR* header, UINT size) {
  return ::midiOutUnprepareHeader(handle, header, size);
}

MMRESULT WindowsSystem::midiOutLongMsg(HMIDIOUT handle, MIDIHDR* header, UINT size) {
  return ::midiOutLongMsg(handle, header, size);
}

DWORD WindowsSystem::timeGetTime() { return ::timeGetTime(); }

HRESULT WindowsSystem::CreateDirectMusic(IDirectMusic** result) {
  return ::CoCreateInstance(CLSID_DirectMusic, nullptr, CLSCTX_INPROC, IID_IDirectMusic,
                            reinterpret_cast<void**>(result));
}

HRESULT WindowsSystem::CreateDirectMusicLoader(IDirectMusicLoader** result) {
  return ::CoCreateInstance(CLSID_DirectMusicLoader, nullptr, CLSCTX_INPROC, IID_IDirectMusicLoader,
                            reinterpret_cast<void**>(result));
}

std::vector<AudioSession> WindowsSystem::SnapshotAudioSessions() { return ListOwnAudioSessions(); }

std::shared_ptr<void> WindowsSystem::WatchDeviceChanges(std::function<void()> changed) {
  return watch_.Add(std::move(changed));
}

}  // namespace Ostinet::Impl

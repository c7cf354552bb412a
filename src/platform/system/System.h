// SPDX-License-Identifier: MIT
#pragma once

// The seam: everything that the library asks of the operating system's MIDI, under the names,
// parameters and results that the system publishes. The backend, the port classes and the sender
// call nothing else. Each implementation behind it (windows, simulated, native) is one folder.

#include <functional>
#include <memory>
#include <string>
#include <vector>

#include "platform/system/WindowsTypes.h"

namespace Ostinet::Impl {

/// Waitable objects. Handles are opaque and belong to the Waits that made them.
///
/// Threads  Any.
class Waits {
 public:
  virtual ~Waits() = default;

  /// Null on failure. `maximum` of 1 or more, `initial` from 0 to `maximum`.
  virtual HANDLE CreateSemaphoreW(LONG initial, LONG maximum) = 0;
  /// FALSE, with ERROR_TOO_MANY_POSTS (298) and the count as it was, beyond the maximum.
  virtual BOOL ReleaseSemaphore(HANDLE semaphore, LONG count) = 0;
  /// An auto-reset event, unsignalled.
  virtual HANDLE CreateEventW() = 0;
  virtual BOOL SetEvent(HANDLE event) = 0;
  /// A timer that stays signalled once due until it is set again (manual reset).
  virtual HANDLE CreateWaitableTimerW() = 0;
  /// `due` in units of 100 ns; negative counts from now, 0 is at once.
  virtual BOOL SetWaitableTimer(HANDLE timer, LONGLONG due) = 0;
  /// WAIT_OBJECT_0, WAIT_TIMEOUT or WAIT_FAILED. `milliseconds` may be INFINITE.
  virtual DWORD WaitForSingleObject(HANDLE object, DWORD milliseconds) = 0;
  /// Waits for any one; WAIT_OBJECT_0 + the smallest index that is signalled.
  virtual DWORD WaitForMultipleObjects(DWORD count, HANDLE const* objects, DWORD milliseconds) = 0;
  virtual BOOL CloseHandle(HANDLE object) = 0;
  /// The error of the last call that failed on this thread.
  virtual DWORD GetLastError() = 0;
};

/// One audio session of this process, as the system's session enumerator lists it.
struct AudioSession {
  std::u16string identifier;
  bool operator<(AudioSession const& other) const { return identifier < other.identifier; }
  bool operator==(AudioSession const& other) const { return identifier == other.identifier; }
};

class System {
 public:
  virtual ~System() = default;

  // WinMM input.
  virtual UINT midiInGetNumDevs() = 0;
  virtual MMRESULT midiInGetDevCapsW(UINT_PTR device, MIDIINCAPSW* caps, UINT size) = 0;
  virtual MMRESULT midiInOpen(HMIDIIN* handle, UINT device, DWORD_PTR callback, DWORD_PTR instance,
                              DWORD flags) = 0;
  virtual MMRESULT midiInClose(HMIDIIN handle) = 0;
  virtual MMRESULT midiInStart(HMIDIIN handle) = 0;
  virtual MMRESULT midiInStop(HMIDIIN handle) = 0;
  virtual MMRESULT midiInReset(HMIDIIN handle) = 0;
  virtual MMRESULT midiInPrepareHeader(HMIDIIN handle, MIDIHDR* header, UINT size) = 0;
  virtual MMRESULT midiInUnprepareHeader(HMIDIIN handle, MIDIHDR* header, UINT size) = 0;
  virtual MMRESULT midiInAddBuffer(HMIDIIN handle, MIDIHDR* header, UINT size) = 0;

  // WinMM output.
  virtual UINT midiOutGetNumDevs() = 0;
  virtual MMRESULT midiOutGetDevCapsW(UINT_PTR device, MIDIOUTCAPSW* caps, UINT size) = 0;
  virtual MMRESULT midiOutOpen(HMIDIOUT* handle, UINT device, DWORD_PTR callback,
                               DWORD_PTR instance, DWORD flags) = 0;
  virtual MMRESULT midiOutClose(HMIDIOUT handle) = 0;
  virtual MMRESULT midiOutReset(HMIDIOUT handle) = 0;
  virtual MMRESULT midiOutShortMsg(HMIDIOUT handle, DWORD message) = 0;
  virtual MMRESULT midiOutPrepareHeader(HMIDIOUT handle, MIDIHDR* header, UINT size) = 0;
  virtual MMRESULT midiOutUnprepareHeader(HMIDIOUT handle, MIDIHDR* header, UINT size) = 0;
  virtual MMRESULT midiOutLongMsg(HMIDIOUT handle, MIDIHDR* header, UINT size) = 0;

  /// Milliseconds since the system's start, modulo 2^32.
  virtual DWORD timeGetTime() = 0;

  /// CoCreateInstance of CLSID_DirectMusic and CLSID_DirectMusicLoader, in process. The caller
  /// owns one reference of what is given back.
  virtual HRESULT CreateDirectMusic(IDirectMusic** result) = 0;
  virtual HRESULT CreateDirectMusicLoader(IDirectMusicLoader** result) = 0;

  /// The sessions of this process on all render endpoints; may throw a VantorError.
  virtual std::vector<AudioSession> SnapshotAudioSessions() = 0;

  virtual Waits& GetWaits() = 0;

  /// Calls `changed` on a thread of the system's own after ports came, went or were renamed, until
  /// the last copy of the result goes; letting go waits for a running call. Null: this system tells
  /// nothing.
  virtual std::shared_ptr<void> WatchDeviceChanges(std::function<void()> changed) {
    static_cast<void>(changed);
    return nullptr;
  }
};

/// The system in use, chosen at the first call: a studio file named by the environment variable
/// OSTINET_STUDIO, else the machine's own MIDI, else an empty simulated one. Any thread.
std::shared_ptr<System> CurrentSystem();

/// Installs another system, before the first Setup::Instance or while signed out; null returns to
/// the automatic choice. Signed-in ports keep the system that they were opened on.
void InstallSystem(std::shared_ptr<System> system);

}  // namespace Ostinet::Impl

// SPDX-License-Identifier: MIT
#pragma once

// Every operation of the seam by name, and the book that counts them, makes them fail on demand
// and, when asked, writes each one down.

#include <array>
#include <atomic>
#include <cstddef>
#include <cstdint>
#include <initializer_list>
#include <mutex>
#include <string>
#include <vector>

#include "ostinet/SimulatedMIDI.h"

namespace Ostinet::Impl::Simulated {

enum class Op : std::uint8_t {
  kMidiInGetNumDevs,
  kMidiInGetDevCaps,
  kMidiInOpen,
  kMidiInClose,
  kMidiInStart,
  kMidiInStop,
  kMidiInReset,
  kMidiInPrepareHeader,
  kMidiInUnprepareHeader,
  kMidiInAddBuffer,
  kMidiOutGetNumDevs,
  kMidiOutGetDevCaps,
  kMidiOutOpen,
  kMidiOutClose,
  kMidiOutReset,
  kMidiOutShortMsg,
  kMidiOutPrepareHeader,
  kMidiOutUnprepareHeader,
  kMidiOutLongMsg,
  kTimeGetTime,
  kCreateDirectMusic,
  kCreateDirectMusicLoader,
  kSnapshotAudioSessions,
  kEnumPort,
  kCreateMusicBuffer,
  kCreatePort,
  kGetMasterClock,
  kSetDirectSound,
  kGetTime,
  kActivate,
  kPlayBuffer,
  kSetReadNotificationHandle,
  kRead,
  kDownloadInstrument,
  kUnloadInstrument,
  kGetLatencyClock,
  kFlush,
  kPackStructured,
  kPackUnstructured,
  kResetReadPtr,
  kGetNextEvent,
  kGetRawBufferPtr,
  kGetStartTime,
  kSetStartTime,
  kGetUsedBytes,
  kSetUsedBytes,
  kGetMaxBytes,
  kGetObject,
  kEnumInstrument,
  kGetInstrument,
  kDestroy,
  kCreateSemaphore,
  kReleaseSemaphore,
  kCreateEvent,
  kSetEvent,
  kCreateWaitableTimer,
  kSetWaitableTimer,
  kWaitForSingleObject,
  kWaitForMultipleObjects,
  kCloseHandle,
  kCount,
};

/// The published name of an operation, for instance "midiOutOpen".
char const* NameOf(Op op);

/// Counts, faults and the log.
///
/// Threads  Any. Without a fault and without the log a call costs two atomic additions.
class CallBook {
 public:
  using Arguments = std::initializer_list<long long>;

  /// Counts one call. True when it has to fail; `result` is then what it gives back.
  bool Fails(Op op, long long& result);
  /// Writes a finished call down when the log is on.
  void Log(Op op, long long result, Arguments arguments = {}, std::string const* port = nullptr);

  /// `name` is an operation's name, or "*" for any. `nth` of 1 is the next call; `last` the last
  /// one that fails. Throws std::invalid_argument for an unknown name.
  void AddFault(std::string const& name, std::uint64_t nth, std::uint64_t last,
                long long const* result);
  void ClearFaults();
  std::uint64_t Count(std::string const& name) const;
  void ResetCounts();

  void SetLogging(bool on) { logging_.store(on, std::memory_order_relaxed); }
  std::vector<SimulatedCall> TakeLog();

 private:
  struct Fault {
    int op = 0;  // -1 for any
    std::uint64_t seen = 0;
    std::uint64_t nth = 1;
    std::uint64_t last = 1;
    bool hasResult = false;
    long long result = 0;
  };

  bool MatchFaults(Op op, long long& result);

  // Counters only: nothing is published through them.
  std::array<std::atomic<std::uint64_t>, static_cast<std::size_t>(Op::kCount)> counts_{};
  std::atomic<std::uint64_t> total_{0};
  std::atomic<bool> logging_{false};
  std::atomic<bool> armed_{false};
  mutable std::mutex mutex_;
  std::vector<Fault> faults_;
  std::vector<SimulatedCall> log_;
};

}  // namespace Ostinet::Impl::Simulated

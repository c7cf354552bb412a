// SPDX-License-Identifier: MIT
#pragma once

#include <cstddef>
#include <cstdint>
#include <functional>
#include <memory>
#include <stdexcept>
#include <string>
#include <vector>

#include "ostinet/DeviceChanges.h"
#include "ostinet/Export.h"

namespace Ostinet {

namespace Impl::Simulated {
class SimulatedSystem;
}

/// A studio file that cannot be read, or text that is not the description of a studio. what() is
/// one sentence that names the file, line or key.
class OSTINET_EXPORT StudioFileError : public std::runtime_error {
 public:
  using std::runtime_error::runtime_error;
};

/// One port of the simulated system.
struct SimulatedPort {
  enum class Kind { kWinMMOut, kWinMMIn, kDirectMusicOut, kDirectMusicIn };

  /// UTF-8. The system shows 31 UTF-16 units of a WinMM port's name.
  std::string name;
  Kind kind = Kind::kWinMMOut;
  /// Of a WinMM output: 1 a MIDI port, 2 to 7 a synthesizer.
  int technology = 1;
  /// A WinMM port: whether DirectMusic lists it too, as "NAME [Emulated]".
  bool directMusic = true;
  /// A DirectMusic port: leads to a jack and not to software.
  bool external = false;
  /// A DirectMusic output: a software synthesizer that takes instruments.
  bool dls = false;
  /// A DirectMusic output: has the General MIDI sounds built in.
  bool gmInHardware = false;
  /// A DirectMusic port: listed as an emulated one, though WinMM has no device for it.
  bool emulated = false;
  /// A DirectMusic output: how far its latency clock runs ahead, in microseconds.
  long long latencyMicroseconds = 0;
};

/// What answers behind an output.
struct SimulatedInstrument {
  struct Reply {
    /// Both as hexadecimal bytes; "??" in `to` stands for any byte.
    std::string to;
    std::string with;
  };

  /// Names of the output that it listens to and of the input that it answers on.
  std::string out;
  std::string in;
  /// 0 to 127.
  int deviceID = 0;
  /// Hexadecimal bytes from the manufacturer on, as the answer to the universal inquiry holds
  /// them; a missing version counts as zeros. Empty: the inquiry is not answered.
  std::string identity;
  std::vector<Reply> replies;
};

/// What one channel of a simulated instrument plays; -1 is "never told".
struct SimulatedChannel {
  int program = -1;
  int bankMSB = -1;
  int bankLSB = -1;
  /// The held notes, rising.
  std::vector<int> notes;
};

/// One message that left through an output. Times are those of the master clock, in units of
/// 100 ns.
struct SimulatedMessage {
  std::string port;
  std::vector<unsigned char> bytes;
  /// When the library handed it over, when it was to leave, and when it left.
  long long handedOver = 0;
  long long due = 0;
  long long left = 0;
};

/// One call at the boundary to the operating system.
struct SimulatedCall {
  /// The published name, for instance "midiOutOpen". "Destroy" is the end of a COM object.
  std::string operation;
  /// The port that it is about, or the interface of a destroyed object; else empty.
  std::string port;
  /// Its numbers: indices, sizes, packed messages, times.
  std::vector<long long> arguments;
  long long result = 0;
};

/// A whole MIDI system in memory, for running hosts and testing studio logic on a machine without
/// MIDI. While installed it takes the place of the machine's own ports.
///
/// Ownership    A handle; copies name the same system, which lives while a handle, the library or
///              a port that was opened on it does.
/// Null handle  Only InUse() gives one. IsNull() tells; everything else throws std::logic_error.
/// Threads      [any thread] throughout.
/// Errors       std::invalid_argument for names of operations that do not exist, malformed
///              hexadecimal bytes and values out of range; StudioFileError for descriptions.
class OSTINET_EXPORT SimulatedMIDI {
 public:
  /// An empty studio.
  SimulatedMIDI();
  /// From the text or the file of a studio (see docs/studio-files.md). Throws StudioFileError.
  static SimulatedMIDI FromJSON(std::string const& text);
  static SimulatedMIDI FromFile(std::string const& path);
  /// The one that the library uses now; null when it uses the machine's own ports.
  static SimulatedMIDI InUse();
  bool IsNull() const { return system_ == nullptr; }

  /// Makes it the library's MIDI system. Before the first Setup::Instance, or while signed out.
  void Install() const;
  /// Returns the library to its automatic choice, if this one is in use. While signed out.
  void Remove() const;

  // Ports. Each change tells those who watch, unless SetNotifying(false) was called.

  void AddPort(SimulatedPort const& port) const;
  /// Takes away every port of that name, and of that kind if one is given. False if there was none.
  bool RemovePort(std::string const& name) const;
  bool RemovePort(std::string const& name, SimulatedPort::Kind kind) const;
  bool RenamePort(std::string const& name, std::string const& newName) const;
  /// Adds a second port of each kind that has the name.
  bool DuplicatePort(std::string const& name) const;
  std::vector<SimulatedPort> Ports() const;

  /// Whatever leaves through the output arrives at the input. Cables go by name, so they may be
  /// there before their ports. An input may be named as `from` when no output has the name.
  void AddCable(std::string const& from, std::string const& to) const;
  bool RemoveCable(std::string const& from, std::string const& to) const;

  /// The index of the new instrument.
  int AddInstrument(SimulatedInstrument const& instrument) const;
  int CountInstruments() const;
  /// `channel` 0 to 15.
  SimulatedChannel WhatPlays(int instrument, int channel) const;

  /// Calls `changed` on the thread that changes a port, as long as the subscription lives. While
  /// this studio is installed, WatchDeviceChanges leads here too.
  DeviceChangeSubscription WatchDevices(std::function<void()> changed) const;
  void NotifyDevicesChanged() const;
  void SetNotifying(bool automatically) const;

  // Data.

  /// Bytes arrive at every input of that name. False if there is none.
  bool Inject(std::string const& port, std::vector<unsigned char> const& bytes) const;
  /// What left, oldest first: the newest 65,536 messages, or as many as were reserved.
  std::vector<SimulatedMessage> Sent() const;
  std::vector<SimulatedMessage> Sent(std::string const& port) const;
  void ClearSent() const;
  void SetRecording(bool on) const;
  /// Makes room for `messages` messages of up to 24 bytes, beyond which the oldest go; recording
  /// then allocates nothing.
  void ReserveRecording(std::size_t messages) const;
  /// Messages that wait on a DirectMusic port for their time.
  int CountScheduled() const;

  // Time, in units of 100 ns.

  long long Now() const;
  /// Runs with the machine's clock (the default), or by hand from `start` on; without a start
  /// from the present reading.
  void UseRealTime() const;
  void MoveClockByHand() const;
  void MoveClockByHand(long long start) const;
  /// Moves the clock and lets everything happen that is due on the way, in order and each at its
  /// own time. Between two times it waits for the library's threads as Settle does.
  bool AdvanceClocks(long long clocks) const;
  /// Each reading of the master clock moves a clock that is moved by hand by so much. A sign-in
  /// measures the tick, so it needs a clock that moves: 1 before it, 0 after it.
  void SetStepPerReading(long long clocks) const;
  /// How the master clock answers: whether it stands still, its tick, whether it reads 0 for ever.
  void SetMasterClockStill(bool still) const;
  void SetMasterClockTick(long long clocks) const;
  void SetMasterClockAbsent(bool absent) const;
  /// Waits until every callback has returned and every thread of the library that waits on
  /// something has nothing to do. False if that took longer than `milliseconds`.
  bool Settle(int milliseconds = 20000) const;
  /// Starts the studio file's timeline now. Without this it starts when the host signs in.
  void StartTimeline() const;

  // Faults and measurements.

  /// The `nth` call (1 is the next) of an operation fails; "*" counts all of them except waiting.
  /// Without a result an MMRESULT is 1, an HRESULT E_FAIL, a handle null, a wait WAIT_FAILED.
  void Fail(std::string const& operation, std::uint64_t nth = 1) const;
  void FailWith(std::string const& operation, long long result, std::uint64_t nth = 1) const;
  /// The same, and all further calls.
  void FailFrom(std::string const& operation, std::uint64_t nth = 1) const;
  void FailFromWith(std::string const& operation, long long result, std::uint64_t nth = 1) const;
  void ClearFaults() const;
  std::uint64_t CountCalls(std::string const& operation = "*") const;
  void ResetCalls() const;
  /// The log is off at first.
  void LogCalls(bool on) const;
  /// What was logged since the last call of this.
  std::vector<SimulatedCall> TakeLog() const;
  /// An output's header counts as still playing for so many tries to unprepare it.
  void HoldLongMessages(int tries) const;
  /// "EnumPort", "EnumInstrument" or "Read" never comes to an end.
  void SetEndless(std::string const& operation, bool on) const;
  /// The instruments of the default collection, by patch number. At first the 128 General MIDI
  /// ones.
  void SetCollection(std::vector<std::uint32_t> const& patches) const;
  /// Downloaded instruments that were not unloaded.
  int CountDownloaded(std::string const& port) const;
  /// COM objects alive of an interface, for instance "IDirectMusicPort"; "*" for all.
  int CountObjects(std::string const& interfaceName = "*") const;
  /// Open WinMM devices, and handles of semaphores, events and timers.
  int CountOpenDevices() const;
  int CountWaitHandles() const;
  /// The audio sessions that the system reports.
  void SetAudioSessions(std::vector<std::string> const& identifiers) const;

  /// The system behind, for the library.
  std::shared_ptr<Impl::Simulated::SimulatedSystem> const& GetSystem() const { return system_; }

 private:
  explicit SimulatedMIDI(std::shared_ptr<Impl::Simulated::SimulatedSystem> system);
  Impl::Simulated::SimulatedSystem& Get() const;

  std::shared_ptr<Impl::Simulated::SimulatedSystem> system_;
};

}  // namespace Ostinet

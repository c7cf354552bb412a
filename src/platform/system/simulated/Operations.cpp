// SPDX-License-Identifier: MIT
#include "platform/system/simulated/Operations.h"

#include <stdexcept>
#include <utility>

namespace Ostinet::Impl::Simulated {

namespace {

constexpr long long kMMError = 1;              // MMSYSERR_ERROR
constexpr long long kComError = -2147467259;   // E_FAIL
constexpr long long kNone = 0;                 // FALSE, a null handle, no devices
constexpr long long kWaitFailed = 0xFFFFFFFF;  // WAIT_FAILED

struct Row {
  char const* name;
  long long failure;  // what the call gives back when it is told to fail
  bool swept;         // counted by "*": the waits of idle threads would spoil a sweep's order
};

// In the order of Op.
constexpr Row kRows[] = {
    {"midiInGetNumDevs", kNone, true},
    {"midiInGetDevCapsW", kMMError, true},
    {"midiInOpen", kMMError, true},
    {"midiInClose", kMMError, true},
    {"midiInStart", kMMError, true},
    {"midiInStop", kMMError, true},
    {"midiInReset", kMMError, true},
    {"midiInPrepareHeader", kMMError, true},
    {"midiInUnprepareHeader", kMMError, true},
    {"midiInAddBuffer", kMMError, true},
    {"midiOutGetNumDevs", kNone, true},
    {"midiOutGetDevCapsW", kMMError, true},
    {"midiOutOpen", kMMError, true},
    {"midiOutClose", kMMError, true},
    {"midiOutReset", kMMError, true},
    {"midiOutShortMsg", kMMError, true},
    {"midiOutPrepareHeader", kMMError, true},
    {"midiOutUnprepareHeader", kMMError, true},
    {"midiOutLongMsg", kMMError, true},
    {"timeGetTime", kNone, false},
    {"CreateDirectMusic", kComError, true},
    {"CreateDirectMusicLoader", kComError, true},
    {"SnapshotAudioSessions", kComError, true},
    {"EnumPort", kComError, true},
    {"CreateMusicBuffer", kComError, true},
    {"CreatePort", kComError, true},
    {"GetMasterClock", kComError, true},
    {"SetDirectSound", kComError, true},
    {"GetTime", kComError, true},
    {"Activate", kComError, true},
    {"PlayBuffer", kComError, true},
    {"SetReadNotificationHandle", kComError, true},
    {"Read", kComError, true},
    {"DownloadInstrument", kComError, true},
    {"UnloadInstrument", kComError, true},
    {"GetLatencyClock", kComError, true},
    {"Flush", kComError, true},
    {"PackStructured", kComError, true},
    {"PackUnstructured", kComError, true},
    {"ResetReadPtr", kComError, true},
    {"GetNextEvent", kComError, true},
    {"GetRawBufferPtr", kComError, true},
    {"GetStartTime", kComError, true},
    {"SetStartTime", kComError, true},
    {"GetUsedBytes", kComError, true},
    {"SetUsedBytes", kComError, true},
    {"GetMaxBytes", kComError, true},
    {"GetObject", kComError, true},
    {"EnumInstrument", kComError, true},
    {"GetInstrument", kComError, true},
    {"Destroy", kNone, false},
    {"CreateSemaphoreW", kNone, true},
    {"ReleaseSemaphore", kNone, true},
    {"CreateEventW", kNone, true},
    {"SetEvent", kNone, true},
    {"CreateWaitableTimerW", kNone, true},
    {"SetWaitableTimer", kNone, true},
    {"WaitForSingleObject", kWaitFailed, false},
    {"WaitForMultipleObjects", kWaitFailed, false},
    {"CloseHandle", kNone, true},
};
static_assert(sizeof(kRows) / sizeof(kRows[0]) == static_cast<std::size_t>(Op::kCount));

Row const& RowOf(Op op) { return kRows[static_cast<std::size_t>(op)]; }

int Find(std::string const& name) {
  if (name == "*") return -1;
  for (int i = 0; i < static_cast<int>(Op::kCount); ++i) {
    if (name == kRows[i].name) return i;
  }
  throw std::invalid_argument("No operation of the MIDI system is named \"" + name + "\"");
}

}  // namespace

char const* NameOf(Op op) { return RowOf(op).name; }

bool CallBook::Fails(Op op, long long& result) {
  counts_[static_cast<std::size_t>(op)].fetch_add(1, std::memory_order_relaxed);
  if (RowOf(op).swept) total_.fetch_add(1, std::memory_order_relaxed);
  if (!armed_.load(std::memory_order_relaxed)) return false;
  return MatchFaults(op, result);
}

bool CallBook::MatchFaults(Op op, long long& result) {
  std::lock_guard lock(mutex_);
  bool fails = false;
  for (Fault& fault : faults_) {
    bool const meant = fault.op < 0 ? RowOf(op).swept : fault.op == static_cast<int>(op);
    if (!meant) continue;
    ++fault.seen;
    if (fails || fault.seen < fault.nth || fault.seen > fault.last) continue;
    fails = true;
    result = fault.hasResult ? fault.result : RowOf(op).failure;
  }
  if (fails && logging_.load(std::memory_order_relaxed)) {
    log_.push_back({NameOf(op), {}, {}, result});
  }
  return fails;
}

void CallBook::Log(Op op, long long result, Arguments arguments, std::string const* port) {
  if (!logging_.load(std::memory_order_relaxed)) return;
  std::lock_guard lock(mutex_);
  log_.push_back({NameOf(op), port != nullptr ? *port : std::string(), arguments, result});
}

void CallBook::AddFault(std::string const& name, std::uint64_t nth, std::uint64_t last,
                        long long const* result) {
  Fault fault;
  fault.op = Find(name);
  fault.nth = nth;
  fault.last = last;
  fault.hasResult = result != nullptr;
  fault.result = result != nullptr ? *result : 0;
  std::lock_guard lock(mutex_);
  faults_.push_back(fault);
  armed_.store(true, std::memory_order_relaxed);
}

void CallBook::ClearFaults() {
  std::lock_guard lock(mutex_);
  faults_.clear();
  armed_.store(false, std::memory_order_relaxed);
}

std::uint64_t CallBook::Count(std::string const& name) const {
  int const op = Find(name);
  auto const& counter = op < 0 ? total_ : counts_[static_cast<std::size_t>(op)];
  return counter.load(std::memory_order_relaxed);
}

void CallBook::ResetCounts() {
  for (auto& count : counts_) count.store(0, std::memory_order_relaxed);
  total_.store(0, std::memory_order_relaxed);
}

std::vector<SimulatedCall> CallBook::TakeLog() {
  std::lock_guard lock(mutex_);
  return std::exchange(log_, {});
}

}  // namespace Ostinet::Impl::Simulated

// SPDX-License-Identifier: MIT
#pragma once

// The simulated studio: ports, cables, instruments, the clock and what is due by it.
//
// One mutex guards it all, input devices included. Callbacks, listeners and the actions of a
// timeline run outside of it. While it is held the waits' own mutex may be taken, never the other
// way round.

#include <array>
#include <atomic>
#include <condition_variable>
#include <cstdint>
#include <functional>
#include <memory>
#include <mutex>
#include <optional>
#include <set>
#include <string>
#include <thread>
#include <unordered_map>
#include <utility>
#include <vector>

#include "ostinet/SimulatedMIDI.h"
#include "platform/system/common/ChangeNotifier.h"
#include "platform/system/simulated/Instrument.h"
#include "platform/system/simulated/ObjectCounts.h"
#include "platform/system/simulated/Operations.h"
#include "platform/system/simulated/Recorder.h"
#include "platform/system/simulated/SimClock.h"
#include "platform/system/simulated/SimulatedWaits.h"

namespace Ostinet::Impl::Simulated {

/// Takes what arrives at an input port. Called with the studio's mutex held.
class InputSink {
 public:
  virtual void Take(std::uint8_t const* bytes, std::size_t size) = 0;

 protected:
  ~InputSink() = default;
};

struct Port {
  SimulatedPort spec;
  std::string const* name = nullptr;  // interned, never freed before the studio
  std::u16string wideName;
  std::uint32_t id = 0;  // part of its GUID
  bool present = true;
  bool opened = false;  // by WinMM, which opens a device once
  int downloaded = 0;
  std::vector<InputSink*> sinks;  // each takes itself off before it ends

  bool IsOutput() const {
    return spec.kind == SimulatedPort::Kind::kWinMMOut ||
           spec.kind == SimulatedPort::Kind::kDirectMusicOut;
  }
  bool IsWinMM() const {
    return spec.kind == SimulatedPort::Kind::kWinMMOut ||
           spec.kind == SimulatedPort::Kind::kWinMMIn;
  }
};
using PortPtr = std::shared_ptr<Port>;

class OpenInput;
struct OpenOutput;

class Studio : public std::enable_shared_from_this<Studio> {
 public:
  Studio();
  ~Studio();

  std::mutex& Mutex() { return mutex_; }
  CallBook& Book() { return book_; }
  SimClock& Clock() { return clock_; }
  SimulatedWaits& GetWaits() { return waits_; }
  ObjectCounts& Objects() { return objects_; }

  // Ports (StudioPorts.cpp).
  void AddPort(SimulatedPort const& spec);
  bool RemovePorts(std::string const& name, SimulatedPort::Kind const* kind);
  /// The counterpart of adding one: takes away the port of that name that was added first, and
  /// those of its kind that share the name.
  bool RemoveFirstPort(std::string const& name);
  bool RenamePorts(std::string const& name, std::string const& newName);
  bool DuplicatePorts(std::string const& name);
  std::vector<SimulatedPort> Ports();
  void AddCable(std::string const& from, std::string const& to);
  bool RemoveCable(std::string const& from, std::string const& to);
  int AddInstrument(SimulatedInstrument const& description);
  int CountInstruments();
  SimulatedChannel WhatPlays(int instrument, int channel);
  /// The devices as WinMM counts them, and the ports as DirectMusic does.
  UINT CountDevices(bool outputs);
  PortPtr Device(bool output, UINT_PTR index);
  PortPtr MusicPortAt(DWORD index);
  PortPtr MusicPortWith(std::uint32_t id);
  int CountDownloaded(std::string const& port);

  /// Those who are told of changed ports; the place goes with the last copy of the result.
  std::shared_ptr<void> Watch(std::function<void()> changed) {
    return notifier_.Add(std::move(changed));
  }
  void Notify() { notifier_.Notify(); }
  /// Whether each change tells them by itself.
  void SetNotifying(bool on) { notifying_.store(on, std::memory_order_relaxed); }

  // Data (StudioData.cpp). The first two with the mutex held.
  void Emit(Port& port, std::uint8_t const* bytes, std::size_t size, Recorder::Times const& times);
  bool Deliver(std::string const& input, std::uint8_t const* bytes, std::size_t size, int depth);
  bool Inject(std::string const& input, std::vector<unsigned char> const& bytes);
  Recorder& Sent() { return recorder_; }  // with the mutex held

  // Time (StudioTime.cpp).
  /// Plays a message at its time, at once when that has come. With the mutex held.
  void Schedule(PortPtr const& port, void const* owner, std::int64_t due, std::uint8_t const* bytes,
                std::size_t size);
  /// Drops what an owner has scheduled. With the mutex held.
  void Unschedule(void const* owner);
  int CountScheduled();
  /// An action at a time of the timeline, again every `every` clocks up to `times` times.
  void AddTimelineEvent(std::int64_t at, std::int64_t every, int times,
                        std::function<void()> action);
  void StartTimeline();
  void UseRealTime();
  void MoveClockByHand(std::int64_t const* start);
  bool Advance(std::int64_t clocks);
  bool Settle(int milliseconds);

  // Open WinMM devices, by handle (WinMMInput.cpp, WinMMOutput.cpp). With the mutex held.
  std::unordered_map<std::uintptr_t, std::shared_ptr<OpenInput>> openInputs;
  std::unordered_map<std::uintptr_t, std::shared_ptr<OpenOutput>> openOutputs;
  std::uintptr_t NextHandle() { return handles_ += 16; }
  /// Signalled when a callback thread runs out of work.
  std::condition_variable callbacksIdle;

  // Options, with the mutex held.
  int longMessageTries = 0;
  bool endlessPorts = false;
  bool endlessInstruments = false;
  bool endlessRead = false;
  std::vector<std::uint32_t> collection;
  std::vector<std::string> audioSessions;

 private:
  struct Due {
    std::int64_t time = 0;
    std::uint64_t order = 0;  // of two with one time, the one that came first
    int timeline = -1;        // an action, else a message:
    PortPtr port;
    void const* owner = nullptr;
    std::int64_t handedOver = 0;
    std::size_t size = 0;
    std::array<std::uint8_t, Recorder::kInlineBytes> inlineBytes{};
    std::vector<std::uint8_t> moreBytes;

    static bool Later(Due const& a, Due const& b) {
      return a.time != b.time ? a.time > b.time : a.order > b.order;
    }
  };
  struct TimelineEvent {
    std::int64_t at = 0;
    std::int64_t every = 0;
    int times = 1;
    std::function<void()> action;
  };

  void AddPortLocked(SimulatedPort const& spec);
  std::string const* Intern(std::string const& name);
  void RefreshLists();
  void NotifyIfWanted();
  bool HasOutput(std::string const& name) const;

  void Push(Due&& due);
  void PushTimeline(int index, std::int64_t time);
  void RunDue(std::int64_t time);
  std::optional<std::int64_t> EarliestDue();
  void RunClockThread();
  bool CallbacksAreIdle() const;

  CallBook book_;
  SimClock clock_;
  SimulatedWaits waits_;
  ObjectCounts objects_;

  std::mutex mutex_;
  std::set<std::string> names_;
  std::vector<PortPtr> ports_;
  bool listsFresh_ = false;
  std::vector<PortPtr> outputs_;
  std::vector<PortPtr> inputs_;
  std::vector<PortPtr> music_;
  std::unordered_map<std::uint32_t, PortPtr> musicByID_;
  std::uint32_t lastID_ = 0;
  struct Cable {
    std::string from;
    std::string to;
  };
  std::vector<Cable> cables_;
  std::vector<std::unique_ptr<Instrument>> instruments_;
  Recorder recorder_;
  std::uintptr_t handles_ = 0;

  std::vector<Due> due_;  // a heap, the earliest at its front
  std::uint64_t order_ = 0;
  std::vector<TimelineEvent> timeline_;
  bool timelineStarted_ = false;
  std::condition_variable dueChanged_;
  bool quit_ = false;
  std::thread clockThread_;        // started with the first thing that is due later
  std::recursive_mutex runMutex_;  // one thread at a time lets things happen

  ChangeNotifier notifier_;
  std::atomic<bool> notifying_{true};
};

}  // namespace Ostinet::Impl::Simulated

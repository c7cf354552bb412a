// SPDX-License-Identifier: MIT
#pragma once

#include <atomic>
#include <cstdint>
#include <functional>
#include <vector>

#include "ostinet/PluginHost.h"

namespace Ostinet::Testing {

/// One record as a plug-in reads it.
struct PluginRecord {
  static constexpr std::size_t kBytes = 270;

  explicit PluginRecord(unsigned char const* record) : raw(record, record + kBytes) {}

  std::uint64_t LowFirst(std::size_t at, std::size_t count) const {
    std::uint64_t value = 0;
    for (std::size_t i = 0; i < count; ++i) {
      value |= std::uint64_t{raw[at + i]} << (8 * i);
    }
    return value;
  }
  long long SampleTime() const { return static_cast<long long>(LowFirst(0, 8)); }
  std::size_t Count() const { return LowFirst(10, 2); }
  int Kind() const { return static_cast<int>(LowFirst(12, 2)); }
  std::vector<unsigned char> Bytes() const {
    auto const first = raw.begin() + 14;
    return {first, first + static_cast<std::ptrdiff_t>(Count())};
  }
  /// What the fields leave over: between them, and behind the bytes.
  bool RestIsZero() const {
    bool zero = raw[8] == 0 && raw[9] == 0;
    for (std::size_t i = 14 + Count(); i < kBytes; ++i) {
      zero = zero && raw[i] == 0;
    }
    return zero;
  }

  std::vector<unsigned char> raw;
};

/// Where a plug-in's MIDI ends: it notes what comes.
class FakePluginEnd : public ISynapMIDIDestination {
 public:
  void HostOperation1() override { ++hostOperations; }
  void HostOperation2() override { ++hostOperations; }
  void Retain() override { ++references; }
  void Release() override { --references; }
  void Send(void const* sent, int count) override {
    ++sends;
    pageOffset = reinterpret_cast<std::uintptr_t>(sent) % 4096;
    for (int i = 0; i < count; ++i) {
      records.emplace_back(static_cast<unsigned char const*>(sent) +
                           static_cast<std::size_t>(i) * PluginRecord::kBytes);
    }
  }
  void Flush() override { ++flushes; }

  std::atomic<int> references{0};
  int hostOperations = 0;
  int sends = 0;
  int flushes = 0;
  std::uintptr_t pageOffset = 0;  // of the last records
  std::vector<PluginRecord> records;
};

/// A plug-in of the host's engine.
class FakePlugin : public SynapMidiPort {
 public:
  void SetActivatedObject(Impl::SYNAP_MIDIDestImplImpl* peer) override {
    told.push_back(peer);
    if (onTold) {
      onTold(peer);
    }
  }
  bool IsPregen() override { return isPregen; }
  ISynapMIDIDestination* GetDestination() override { return hasEnd ? &end : nullptr; }

  SynapPeer Peer() const { return SynapPeer(told.empty() ? nullptr : told.back()); }

  bool isPregen = false;
  bool hasEnd = true;
  FakePluginEnd end;
  std::vector<Impl::SYNAP_MIDIDestImplImpl*> told;
  std::function<void(Impl::SYNAP_MIDIDestImplImpl*)> onTold;
};

}  // namespace Ostinet::Testing

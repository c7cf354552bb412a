// SPDX-License-Identifier: MIT
#pragma once

#include <jack/jack.h>

#include <atomic>
#include <cstddef>
#include <cstdint>
#include <functional>
#include <memory>
#include <string>
#include <vector>

namespace Ostinet::Impl {

/// A client of a JACK server that carries no MIDI: it sees the ports, joins them, counts the
/// server's cycles, and knows when the server has died. Whoever sends must ask it, because a send
/// without a live server never returns.
///
/// Threads  Any; `changed` is called on the server's notification thread.
class JackClient {
 public:
  /// Null when no server answers; none is ever started.
  static std::shared_ptr<JackClient> Connect(std::string const& name,
                                             std::function<void()> changed);
  ~JackClient();
  JackClient(JackClient const&) = delete;
  JackClient& operator=(JackClient const&) = delete;

  bool IsAlive() const { return alive_; }
  /// MIDI ports with `flags` (JackPortIsInput or JackPortIsOutput), in the server's order.
  std::vector<std::string> ListMidiPorts(unsigned long flags) const;
  bool HasPort(std::string const& name) const;
  bool Join(std::string const& from, std::string const& to) const;
  /// What one MIDI port holds in one cycle, in bytes.
  std::size_t MidiBufferSize() const { return midiBufferSize_; }
  /// Cycles that the server has run since this client connected.
  std::uint64_t CycleCount() const { return cycles_; }
  /// False when the server dies or stands still for `kStandstill` before.
  bool WaitForCycle(std::uint64_t count) const;

 private:
  explicit JackClient(std::function<void()> changed);
  bool Open(std::string const& name);

  std::function<void()> const changed_;
  jack_client_t* client_ = nullptr;
  std::size_t midiBufferSize_ = 0;
  // Stored on the server's threads, loaded on any; they order nothing else.
  std::atomic<bool> alive_{false};
  std::atomic<std::uint64_t> cycles_{0};
};

}  // namespace Ostinet::Impl

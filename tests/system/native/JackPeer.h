// SPDX-License-Identifier: MIT
#pragma once

#include <jack/jack.h>

#include <atomic>
#include <cstddef>
#include <string>
#include <vector>

#include "platform/system/native/MessageRing.h"

namespace Ostinet::Testing {

using Bytes = std::vector<unsigned char>;

/// Another program on the JACK server, with a MIDI port "in" that it hears and one "out" that it
/// plays.
class JackPeer {
 public:
  explicit JackPeer(std::string const& name);
  ~JackPeer();
  JackPeer(JackPeer const&) = delete;
  JackPeer& operator=(JackPeer const&) = delete;

  /// Plays one event a cycle.
  void Play(Bytes const& event);
  /// All events heard so far, once they are at least `count` or half a minute has passed.
  std::vector<Bytes> WaitForEvents(std::size_t count);
  /// The same by bytes, whatever the events.
  Bytes WaitForBytes(std::size_t count);
  /// Events that reached "in", taken or not. [any thread]
  std::size_t CountHeard() const { return countHeard_; }
  /// What "out" is called from now on.
  void RenameOut(std::string const& name);

 private:
  void Process(jack_nframes_t frames);
  template <class Enough>
  void WaitUntil(Enough enough);
  void TakeHeard();

  jack_client_t* client_ = nullptr;
  jack_port_t* in_ = nullptr;
  jack_port_t* out_ = nullptr;
  Impl::MessageRing heardRing_;
  Impl::MessageRing playRing_;
  std::vector<Bytes> heard_;
  std::atomic<std::size_t> countHeard_{0};
  Bytes next_;  // of the process callback
};

}  // namespace Ostinet::Testing

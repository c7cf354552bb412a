// SPDX-License-Identifier: MIT
#include "system/native/JackPeer.h"

#include <jack/midiport.h>

#include <chrono>
#include <cstdint>
#include <thread>

namespace Ostinet::Testing {

constexpr auto kPeerPatience = std::chrono::seconds(30);

JackPeer::JackPeer(std::string const& name) {
  client_ = jack_client_open(name.c_str(), JackNoStartServer, nullptr);
  in_ = jack_port_register(client_, "in", JACK_DEFAULT_MIDI_TYPE, JackPortIsInput, 0);
  out_ = jack_port_register(client_, "out", JACK_DEFAULT_MIDI_TYPE, JackPortIsOutput, 0);
  next_.reserve(Impl::MessageRing::kCapacity);
  jack_set_process_callback(
      client_,
      [](jack_nframes_t frames, void* self) {
        static_cast<JackPeer*>(self)->Process(frames);
        return 0;
      },
      this);
  jack_activate(client_);
}

JackPeer::~JackPeer() { jack_client_close(client_); }

void JackPeer::Process(jack_nframes_t frames) {
  void* const in = jack_port_get_buffer(in_, frames);
  jack_midi_event_t event;
  for (std::uint32_t i = 0; jack_midi_event_get(&event, in, i) == 0; ++i) {
    heardRing_.Push(0, event.buffer, event.size);
    ++countHeard_;
  }
  void* const out = jack_port_get_buffer(out_, frames);
  jack_midi_clear_buffer(out);
  std::uint32_t time = 0;
  if (!playRing_.Pop(time, next_)) return;
  jack_midi_event_write(out, 0, next_.data(), next_.size());
}

void JackPeer::Play(Bytes const& event) { playRing_.Push(0, event.data(), event.size()); }

void JackPeer::TakeHeard() {
  Bytes event;
  std::uint32_t time = 0;
  while (heardRing_.Pop(time, event)) heard_.push_back(event);
}

template <class Enough>
void JackPeer::WaitUntil(Enough enough) {
  auto const deadline = std::chrono::steady_clock::now() + kPeerPatience;
  for (TakeHeard(); !enough() && std::chrono::steady_clock::now() < deadline; TakeHeard()) {
    std::this_thread::sleep_for(std::chrono::milliseconds(1));
  }
}

std::vector<Bytes> JackPeer::WaitForEvents(std::size_t count) {
  WaitUntil([&] { return heard_.size() >= count; });
  return heard_;
}

Bytes JackPeer::WaitForBytes(std::size_t count) {
  Bytes bytes;
  WaitUntil([&] {
    bytes.clear();
    for (Bytes const& event : heard_) bytes.insert(bytes.end(), event.begin(), event.end());
    return bytes.size() >= count;
  });
  return bytes;
}

void JackPeer::RenameOut(std::string const& name) { jack_port_rename(client_, out_, name.c_str()); }

}  // namespace Ostinet::Testing

// SPDX-License-Identifier: MIT
#include "platform/system/native/JackClient.h"

#include <chrono>
#include <thread>
#include <utility>

namespace Ostinet::Impl {
namespace {

// A server's longest usual period is 171 ms (8192 frames at 48 kHz).
constexpr auto kStandstill = std::chrono::seconds(2);
constexpr auto kLook = std::chrono::microseconds(500);

// JACK's library writes its troubles to standard error unless told otherwise, also that no server
// runs, which is no trouble here.
void KeepJackQuiet() {
  static bool const done = [] {
    jack_set_error_function([](char const*) {});
    jack_set_info_function([](char const*) {});
    return true;
  }();
  static_cast<void>(done);
}

}  // namespace

std::shared_ptr<JackClient> JackClient::Connect(std::string const& name,
                                                std::function<void()> changed) {
  KeepJackQuiet();
  std::shared_ptr<JackClient> client(new JackClient(std::move(changed)));
  return client->Open(name) ? client : nullptr;
}

JackClient::JackClient(std::function<void()> changed) : changed_(std::move(changed)) {}

JackClient::~JackClient() {
  if (client_ != nullptr) jack_client_close(client_);
}

bool JackClient::Open(std::string const& name) {
  client_ = jack_client_open(name.c_str(), JackNoStartServer, nullptr);
  if (client_ == nullptr) return false;
  midiBufferSize_ = jack_port_type_get_buffer_size(client_, JACK_DEFAULT_MIDI_TYPE);
  alive_ = true;
  jack_on_shutdown(
      client_,
      [](void* self) {
        static_cast<JackClient*>(self)->alive_ = false;
        static_cast<JackClient*>(self)->changed_();
      },
      this);
  jack_set_process_callback(
      client_,
      [](jack_nframes_t, void* self) {
        static_cast<JackClient*>(self)->cycles_.fetch_add(1, std::memory_order_relaxed);
        return 0;
      },
      this);
  jack_set_port_registration_callback(
      client_, [](jack_port_id_t, int, void* self) { static_cast<JackClient*>(self)->changed_(); },
      this);
  jack_set_port_rename_callback(
      client_,
      [](jack_port_id_t, char const*, char const*, void* self) {
        static_cast<JackClient*>(self)->changed_();
      },
      this);
  return jack_activate(client_) == 0;
}

std::vector<std::string> JackClient::ListMidiPorts(unsigned long flags) const {
  std::vector<std::string> names;
  if (!alive_) return names;
  char const** ports = jack_get_ports(client_, nullptr, JACK_DEFAULT_MIDI_TYPE, flags);
  if (ports == nullptr) return names;
  for (char const** port = ports; *port != nullptr; ++port) names.emplace_back(*port);
  jack_free(ports);
  return names;
}

bool JackClient::HasPort(std::string const& name) const {
  return alive_ && jack_port_by_name(client_, name.c_str()) != nullptr;
}

bool JackClient::Join(std::string const& from, std::string const& to) const {
  return alive_ && jack_connect(client_, from.c_str(), to.c_str()) == 0;
}

bool JackClient::WaitForCycle(std::uint64_t count) const {
  auto const deadline = std::chrono::steady_clock::now() + kStandstill;
  while (alive_ && cycles_ < count) {
    if (std::chrono::steady_clock::now() >= deadline) return false;
    std::this_thread::sleep_for(kLook);
  }
  return alive_;
}

}  // namespace Ostinet::Impl

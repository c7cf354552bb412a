// SPDX-License-Identifier: MIT
#include "platform/system/native/JackService.h"

#include <utility>

#include "platform/system/native/JackWires.h"
#include "platform/system/native/PortNames.h"
#include "platform/system/native/RtMidiSupport.h"

namespace Ostinet::Impl {

JackService::JackService() : hint_(std::make_shared<ChangeHint>()) {}

// The present server's client, else one of a server that has come meanwhile, else null.
std::shared_ptr<JackClient> JackService::Client() {
  std::scoped_lock lock(mutex_);
  if (client_ && client_->IsAlive()) return client_;
  if (client_) {
    dead_ = client_;
    client_.reset();
  }
  if (!dead_.expired()) return nullptr;
  client_ = JackClient::Connect(NextWireClientName(), [hint = hint_] {
    std::scoped_lock hintLock(hint->mutex);
    if (hint->call) hint->call();
  });
  return client_;
}

bool JackService::IsAlive() { return Client() != nullptr; }

std::vector<ServicePort> JackService::List(PortDirection direction) {
  std::vector<ServicePort> ports;
  auto const client = Client();
  if (!client) return ports;
  // What a JACK port gives out is what this program hears.
  unsigned long const flags =
      direction == PortDirection::kInput ? JackPortIsOutput : JackPortIsInput;
  for (std::string& id : client->ListMidiPorts(flags)) {
    if (id.starts_with(kWireClientPrefix)) continue;
    std::string name = JackPortName(id);
    ports.push_back({std::move(id), std::move(name)});
  }
  return ports;
}

std::unique_ptr<OutputWire> JackService::OpenOutput(std::string const& id) {
  auto const client = Client();
  return client ? OpenJackOutput(client, id) : nullptr;
}

std::unique_ptr<InputWire> JackService::OpenInput(std::string const& id, InputSink sink) {
  auto const client = Client();
  return client ? OpenJackInput(client, id, std::move(sink)) : nullptr;
}

void JackService::SetChangeHint(std::function<void()> hint) {
  std::scoped_lock lock(hint_->mutex);
  hint_->call = std::move(hint);
}

}  // namespace Ostinet::Impl

// SPDX-License-Identifier: MIT
#include <algorithm>

#include "platform/system/simulated/Studio.h"

namespace Ostinet::Impl::Simulated {

namespace {

// Cables from input to input could lead in a circle.
constexpr int kMostCables = 8;

}  // namespace

void Studio::Emit(Port& port, std::uint8_t const* bytes, std::size_t size,
                  Recorder::Times const& times) {
  if (!port.present) return;
  recorder_.Add(*port.name, bytes, size, times);
  for (auto const& instrument : instruments_) {
    if (instrument->Out() != *port.name) continue;
    auto const answer = instrument->Receive(bytes, size);
    if (!answer.empty()) Deliver(instrument->In(), answer.data(), answer.size(), 0);
  }
  for (Cable const& cable : cables_) {
    if (cable.from == *port.name) Deliver(cable.to, bytes, size, 0);
  }
}

bool Studio::HasOutput(std::string const& name) const {
  return std::any_of(ports_.begin(), ports_.end(),
                     [&](PortPtr const& port) { return port->IsOutput() && *port->name == name; });
}

bool Studio::Deliver(std::string const& input, std::uint8_t const* bytes, std::size_t size,
                     int depth) {
  bool found = false;
  for (PortPtr const& port : ports_) {
    if (port->IsOutput() || *port->name != input) continue;
    found = true;
    for (InputSink* sink : port->sinks) sink->Take(bytes, size);
  }
  if (!found || depth >= kMostCables) return found;
  for (Cable const& cable : cables_) {
    // A cable belongs to the output of its name; only without one does it start at the input.
    if (cable.from == input && !HasOutput(input)) Deliver(cable.to, bytes, size, depth + 1);
  }
  return true;
}

bool Studio::Inject(std::string const& input, std::vector<unsigned char> const& bytes) {
  std::lock_guard lock(mutex_);
  return Deliver(input, bytes.data(), bytes.size(), 0);
}

}  // namespace Ostinet::Impl::Simulated

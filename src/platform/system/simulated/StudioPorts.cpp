// SPDX-License-Identifier: MIT
#include <algorithm>
#include <stdexcept>

#include "platform/system/simulated/Studio.h"
#include "platform/system/simulated/WideText.h"

namespace Ostinet::Impl::Simulated {

Studio::Studio() : waits_(book_, clock_) {
  // Room for what a host schedules in one go, so that playing allocates nothing.
  due_.reserve(256);
  for (std::uint32_t patch = 0; patch < 128; ++patch) collection.push_back(patch);
}

void Studio::AddPort(SimulatedPort const& spec) {
  {
    std::lock_guard lock(mutex_);
    AddPortLocked(spec);
  }
  NotifyIfWanted();
}

void Studio::AddPortLocked(SimulatedPort const& spec) {
  if (spec.latencyMicroseconds < 0) {
    throw std::invalid_argument("A port's latency cannot be negative");
  }
  auto port = std::make_shared<Port>();
  port->spec = spec;
  port->name = Intern(spec.name);
  port->wideName = Widen(spec.name);
  port->id = ++lastID_;
  ports_.push_back(std::move(port));
  listsFresh_ = false;
}

std::string const* Studio::Intern(std::string const& name) { return &*names_.insert(name).first; }

bool Studio::RemovePorts(std::string const& name, SimulatedPort::Kind const* kind) {
  {
    std::lock_guard lock(mutex_);
    auto const removed = std::erase_if(ports_, [&](PortPtr const& port) {
      if (*port->name != name || (kind != nullptr && port->spec.kind != *kind)) return false;
      // Whoever has it open keeps it, unplugged.
      port->present = false;
      return true;
    });
    if (removed == 0) return false;
    listsFresh_ = false;
  }
  NotifyIfWanted();
  return true;
}

bool Studio::RemoveFirstPort(std::string const& name) {
  SimulatedPort::Kind kind;
  {
    std::lock_guard lock(mutex_);
    auto const first = std::find_if(ports_.begin(), ports_.end(),
                                    [&](PortPtr const& port) { return *port->name == name; });
    if (first == ports_.end()) return false;
    kind = (*first)->spec.kind;
  }
  return RemovePorts(name, &kind);
}

bool Studio::RenamePorts(std::string const& name, std::string const& newName) {
  bool found = false;
  {
    std::lock_guard lock(mutex_);
    for (PortPtr const& port : ports_) {
      if (*port->name != name) continue;
      found = true;
      port->spec.name = newName;
      port->name = Intern(newName);
      port->wideName = Widen(newName);
    }
  }
  if (found) NotifyIfWanted();
  return found;
}

bool Studio::DuplicatePorts(std::string const& name) {
  {
    std::lock_guard lock(mutex_);
    std::vector<SimulatedPort> copies;
    for (PortPtr const& port : ports_) {
      if (*port->name == name) copies.push_back(port->spec);
    }
    if (copies.empty()) return false;
    for (SimulatedPort const& copy : copies) AddPortLocked(copy);
  }
  NotifyIfWanted();
  return true;
}

std::vector<SimulatedPort> Studio::Ports() {
  std::lock_guard lock(mutex_);
  std::vector<SimulatedPort> result;
  for (PortPtr const& port : ports_) result.push_back(port->spec);
  return result;
}

void Studio::AddCable(std::string const& from, std::string const& to) {
  std::lock_guard lock(mutex_);
  cables_.push_back({from, to});
}

bool Studio::RemoveCable(std::string const& from, std::string const& to) {
  std::lock_guard lock(mutex_);
  auto const found = std::find_if(cables_.begin(), cables_.end(), [&](Cable const& cable) {
    return cable.from == from && cable.to == to;
  });
  if (found == cables_.end()) return false;
  cables_.erase(found);
  return true;
}

int Studio::AddInstrument(SimulatedInstrument const& description) {
  auto instrument = std::make_unique<Instrument>(description);
  std::lock_guard lock(mutex_);
  instruments_.push_back(std::move(instrument));
  return static_cast<int>(instruments_.size()) - 1;
}

int Studio::CountInstruments() {
  std::lock_guard lock(mutex_);
  return static_cast<int>(instruments_.size());
}

SimulatedChannel Studio::WhatPlays(int instrument, int channel) {
  std::lock_guard lock(mutex_);
  if (instrument < 0 || instrument >= static_cast<int>(instruments_.size()) || channel < 0 ||
      channel > 15) {
    throw std::invalid_argument("There is no such instrument or channel");
  }
  return instruments_[static_cast<std::size_t>(instrument)]->WhatPlays(channel);
}

void Studio::RefreshLists() {
  if (listsFresh_) return;
  outputs_.clear();
  inputs_.clear();
  music_.clear();
  musicByID_.clear();
  for (PortPtr const& port : ports_) {
    if (port->IsWinMM()) (port->IsOutput() ? outputs_ : inputs_).push_back(port);
    if (!port->IsWinMM() || port->spec.directMusic) {
      music_.push_back(port);
      musicByID_[port->id] = port;
    }
  }
  listsFresh_ = true;
}

UINT Studio::CountDevices(bool outputs) {
  std::lock_guard lock(mutex_);
  RefreshLists();
  return static_cast<UINT>((outputs ? outputs_ : inputs_).size());
}

PortPtr Studio::Device(bool output, UINT_PTR index) {
  std::lock_guard lock(mutex_);
  RefreshLists();
  auto const& devices = output ? outputs_ : inputs_;
  return index < devices.size() ? devices[index] : nullptr;
}

PortPtr Studio::MusicPortAt(DWORD index) {
  std::lock_guard lock(mutex_);
  RefreshLists();
  if (endlessPorts && !music_.empty()) return music_[index % music_.size()];
  return index < music_.size() ? music_[index] : nullptr;
}

PortPtr Studio::MusicPortWith(std::uint32_t id) {
  std::lock_guard lock(mutex_);
  RefreshLists();
  auto const found = musicByID_.find(id);
  return found != musicByID_.end() ? found->second : nullptr;
}

int Studio::CountDownloaded(std::string const& port) {
  std::lock_guard lock(mutex_);
  int sum = 0;
  for (PortPtr const& each : ports_) {
    if (*each->name == port) sum += each->downloaded;
  }
  return sum;
}

void Studio::NotifyIfWanted() {
  if (notifying_.load(std::memory_order_relaxed)) Notify();
}

}  // namespace Ostinet::Impl::Simulated

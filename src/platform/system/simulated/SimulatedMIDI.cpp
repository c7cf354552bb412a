// SPDX-License-Identifier: MIT
#include "ostinet/SimulatedMIDI.h"

#include <utility>

#include "platform/system/Registry.h"
#include "platform/system/System.h"
#include "platform/system/simulated/SimulatedSystem.h"
#include "platform/system/simulated/StudioFile.h"

namespace Ostinet {

using Impl::Simulated::SimulatedSystem;
using Impl::Simulated::Studio;

SimulatedMIDI::SimulatedMIDI() : system_(std::make_shared<SimulatedSystem>()) {}

SimulatedMIDI::SimulatedMIDI(std::shared_ptr<SimulatedSystem> system)
    : system_(std::move(system)) {}

SimulatedSystem& SimulatedMIDI::Get() const {
  if (system_ == nullptr) throw std::logic_error("There is no simulated MIDI system here");
  return *system_;
}

SimulatedMIDI SimulatedMIDI::FromJSON(std::string const& text) {
  SimulatedMIDI result;
  Impl::Simulated::ReadStudioText(text, result.system_->GetStudio());
  return result;
}

SimulatedMIDI SimulatedMIDI::FromFile(std::string const& path) {
  SimulatedMIDI result;
  Impl::Simulated::ReadStudioFile(path, result.system_->GetStudio());
  return result;
}

SimulatedMIDI SimulatedMIDI::InUse() {
  return SimulatedMIDI(std::dynamic_pointer_cast<SimulatedSystem>(Impl::CurrentSystem()));
}

void SimulatedMIDI::Install() const {
  Get();
  Impl::InstallSystem(system_);
}

void SimulatedMIDI::Remove() const {
  Get();
  Impl::UninstallSystem(system_.get());
}

void SimulatedMIDI::AddPort(SimulatedPort const& port) const { Get().GetStudio().AddPort(port); }

bool SimulatedMIDI::RemovePort(std::string const& name) const {
  return Get().GetStudio().RemovePorts(name, nullptr);
}

bool SimulatedMIDI::RemovePort(std::string const& name, SimulatedPort::Kind kind) const {
  return Get().GetStudio().RemovePorts(name, &kind);
}

bool SimulatedMIDI::RenamePort(std::string const& name, std::string const& newName) const {
  return Get().GetStudio().RenamePorts(name, newName);
}

bool SimulatedMIDI::DuplicatePort(std::string const& name) const {
  return Get().GetStudio().DuplicatePorts(name);
}

std::vector<SimulatedPort> SimulatedMIDI::Ports() const { return Get().GetStudio().Ports(); }

void SimulatedMIDI::AddCable(std::string const& from, std::string const& to) const {
  Get().GetStudio().AddCable(from, to);
}

bool SimulatedMIDI::RemoveCable(std::string const& from, std::string const& to) const {
  return Get().GetStudio().RemoveCable(from, to);
}

int SimulatedMIDI::AddInstrument(SimulatedInstrument const& instrument) const {
  return Get().GetStudio().AddInstrument(instrument);
}

int SimulatedMIDI::CountInstruments() const { return Get().GetStudio().CountInstruments(); }

SimulatedChannel SimulatedMIDI::WhatPlays(int instrument, int channel) const {
  return Get().GetStudio().WhatPlays(instrument, channel);
}

DeviceChangeSubscription SimulatedMIDI::WatchDevices(std::function<void()> changed) const {
  return DeviceChangeSubscription(Get().GetStudio().Watch(std::move(changed)));
}

void SimulatedMIDI::NotifyDevicesChanged() const { Get().GetStudio().Notify(); }

void SimulatedMIDI::SetNotifying(bool automatically) const {
  Get().GetStudio().SetNotifying(automatically);
}

bool SimulatedMIDI::Inject(std::string const& port, std::vector<unsigned char> const& bytes) const {
  return Get().GetStudio().Inject(port, bytes);
}

std::vector<SimulatedMessage> SimulatedMIDI::Sent() const {
  Studio& studio = Get().GetStudio();
  std::lock_guard lock(studio.Mutex());
  return studio.Sent().Read(nullptr);
}

std::vector<SimulatedMessage> SimulatedMIDI::Sent(std::string const& port) const {
  Studio& studio = Get().GetStudio();
  std::lock_guard lock(studio.Mutex());
  return studio.Sent().Read(&port);
}

void SimulatedMIDI::ClearSent() const {
  Studio& studio = Get().GetStudio();
  std::lock_guard lock(studio.Mutex());
  studio.Sent().Clear();
}

void SimulatedMIDI::SetRecording(bool on) const {
  Studio& studio = Get().GetStudio();
  std::lock_guard lock(studio.Mutex());
  studio.Sent().SetOn(on);
}

void SimulatedMIDI::ReserveRecording(std::size_t messages) const {
  Studio& studio = Get().GetStudio();
  std::lock_guard lock(studio.Mutex());
  studio.Sent().Reserve(messages);
}

int SimulatedMIDI::CountScheduled() const { return Get().GetStudio().CountScheduled(); }

}  // namespace Ostinet

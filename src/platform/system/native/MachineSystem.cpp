// SPDX-License-Identifier: MIT
#include "platform/system/MachineSystem.h"

#include <algorithm>
#include <utility>
#include <vector>

#include "ostinet/MachineMIDI.h"
#include "platform/system/SystemWaits.h"
#include "platform/system/native/AlsaService.h"
#include "platform/system/native/JackService.h"
#include "platform/system/native/NativeSystem.h"

namespace Ostinet {
namespace {

std::vector<std::shared_ptr<Impl::MidiService>> MakeServices() {
  return {std::make_shared<Impl::AlsaService>(), std::make_shared<Impl::JackService>()};
}

bool AnyAlive(std::vector<std::shared_ptr<Impl::MidiService>> const& services) {
  return std::any_of(services.begin(), services.end(),
                     [](auto const& service) { return service->IsAlive(); });
}

}  // namespace

std::string WhyNoMachineMIDI() {
  if (AnyAlive(MakeServices())) return {};
  return "No MIDI on this machine: the ALSA sequencer (/dev/snd/seq) cannot be opened, and no JACK "
         "server runs.";
}

namespace Impl {

std::shared_ptr<System> MakeMachineSystem() {
  auto services = MakeServices();
  if (!AnyAlive(services)) return nullptr;
  return std::make_shared<NativeSystem>(std::move(services), MakeSystemWaits());
}

}  // namespace Impl
}  // namespace Ostinet

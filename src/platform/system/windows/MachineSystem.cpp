// SPDX-License-Identifier: MIT
#include "platform/system/MachineSystem.h"

#include "ostinet/MachineMIDI.h"
#include "platform/system/SystemWaits.h"
#include "platform/system/windows/WindowsSystem.h"

namespace Ostinet {

// MIDI is part of Windows, also where nothing is plugged in.
std::string WhyNoMachineMIDI() { return {}; }

namespace Impl {

std::shared_ptr<System> MakeMachineSystem() {
  return std::make_shared<WindowsSystem>(MakeSystemWaits());
}

}  // namespace Impl
}  // namespace Ostinet

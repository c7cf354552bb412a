// SPDX-License-Identifier: MIT
#pragma once

#include <memory>

#include "platform/system/System.h"

namespace Ostinet::Impl {

/// The MIDI of this machine: Windows' own there, ALSA's and JACK's ports on Linux. Null when the
/// machine has none.
std::shared_ptr<System> MakeMachineSystem();

}  // namespace Ostinet::Impl

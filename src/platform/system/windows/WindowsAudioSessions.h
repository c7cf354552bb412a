// SPDX-License-Identifier: MIT
#pragma once

#include <vector>

#include "platform/system/System.h"

namespace Ostinet::Impl {

/// The audio sessions of this process on all active render endpoints. What cannot be asked counts
/// as having none: a machine without sound still has MIDI.
std::vector<AudioSession> ListOwnAudioSessions();

}  // namespace Ostinet::Impl

// SPDX-License-Identifier: MIT
#pragma once

#include "names/DocumentCursor.h"
#include "names/MIDICommandList.h"

namespace Ostinet::Impl {

enum class SysexInCommands : bool { kPassedOver, kAllowed };

/// Records the messages of the command block on which the cursor stands. An element that has not
/// all that it needs adds nothing.
void ReadCommands(DocumentCursor& cursor, SysexInCommands sysex, MIDICommandList& commands);

}  // namespace Ostinet::Impl

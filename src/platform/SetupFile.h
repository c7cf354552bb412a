// SPDX-License-Identifier: MIT
#pragma once

#include "ostinet/core/XML.h"

namespace Ostinet::Impl {

class WinMIDISetup;

// The user's studio, "Ostinet.xml" in the host's settings folder: the ports seen so far, with
// their properties, and the devices made by hand.

inline XMLLib::Name const kSetupFileRoot("Ostinet");

/// Reads the file into the studio. A missing one gives nothing; of a damaged one, what stands
/// before the damage is kept. Without a prefs handler it does nothing.
void LoadSetupFile(WinMIDISetup& setup);

/// Writes the file. On a failure the old one stays, and nobody is told. Without a prefs handler it
/// does nothing.
void SaveSetupFile(WinMIDISetup& setup);

}  // namespace Ostinet::Impl

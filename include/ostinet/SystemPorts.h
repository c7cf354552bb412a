// SPDX-License-Identifier: MIT
#pragma once

#include <vector>

#include "ostinet/Export.h"
#include "ostinet/core/UString.h"

namespace Ostinet {

/// One entry of a list of ports as the MIDI system itself keeps it. The system lists most ports
/// twice, as a WinMM device and as a DirectMusic port; the studio has one endpoint for both, or
/// none. For reports and support: a host plays on the studio's endpoints.
///
/// Ownership    A value.
struct SystemPort {
  enum Kind : int { kWinMMOut = 0, kWinMMIn = 1, kDirectMusicOut = 2, kDirectMusicIn = 3 };

  Kind kind = kWinMMOut;
  /// Where it stands: among the WinMM devices of its direction, or among all DirectMusic ports.
  unsigned int index = 0;
  /// As the system writes it; empty where it does not describe the port.
  UString name;
  /// Of a WinMM output, in the system's own numbers: 1 a MIDI port, 2 to 7 a synthesizer.
  unsigned int technology = 0;
  /// Of a DirectMusic port, in the system's own bits: 1 takes instruments, 2 leads outside of the
  /// machine, 16 has the General MIDI sounds.
  unsigned int flags = 0;
  /// 0, or the number by which the system refused to describe the port.
  unsigned int error = 0;
};

/// What the MIDI system lists at this moment: WinMM outputs, WinMM inputs, DirectMusic ports, each
/// in the system's order. Needs no signed-in Setup. It takes as long as the drivers take. Throws a
/// VantorError if the environment names a studio that does not load. [any thread]
OSTINET_EXPORT std::vector<SystemPort> ListSystemPorts();

}  // namespace Ostinet

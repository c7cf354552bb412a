// SPDX-License-Identifier: MIT
#pragma once

#include <boost/variant.hpp>
#include <vector>

#include "ostinet/core/UString.h"
#include "platform/system/System.h"

namespace Ostinet::Impl {

// The ports that the system lists. DirectMusic lists every driver of WinMM once more, as an
// emulated port, so a port is found on both sides by its name and opened on the better one.

struct DMusInput {
  DMUS_PORTCAPS caps;
};
struct DMusOutput {
  DMUS_PORTCAPS caps;
};
struct LegacyInput {
  MIDIINCAPSW caps;
  UINT device;
};
struct LegacyOutput {
  MIDIOUTCAPSW caps;
  UINT device;
};

/// One port, in the order of the tags 0 to 3.
using PortInfo = boost::variant<DMusInput, DMusOutput, LegacyInput, LegacyOutput>;
using PortList = std::vector<PortInfo>;

struct DMusPortName {
  UString name;
  bool isEmulated;  // a driver of WinMM behind it, told by a suffix that `name` no longer has
};
DMusPortName NameOfPort(DMUS_PORTCAPS const& caps);
UString NameOfPort(PortInfo const& port);
bool IsSource(PortInfo const& port);

/// Lists the ports: outputs that WinMM and DirectMusic share, inputs that they share, then the
/// outputs and the inputs of DirectMusic alone. Touches no object of the model, so it may run on
/// any thread.
PortList EnumeratePorts(System& system, IDirectMusic& directMusic);

}  // namespace Ostinet::Impl

// SPDX-License-Identifier: MIT
#pragma once

#include "platform/PortList.h"

namespace Ostinet::Impl {

class PortAttacher;
class WinMIDISetup;

/// Merges a newly listed set of ports with the direct endpoints of the studio: attaches what came,
/// detaches what went and marks it offline. True if the host has to hear of it.
bool Reconcile(WinMIDISetup& setup, PortAttacher& attacher, PortList const& ports);

}  // namespace Ostinet::Impl

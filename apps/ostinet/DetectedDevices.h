// SPDX-License-Identifier: MIT
#pragma once

#include <optional>

#include "ostinet/Setup.h"
#include "ostinet/hostkit/DetectionRun.h"

namespace Ostinet::Tool {

/// Describes an instrument that answered on `port`: makes a device of its likeliest type, with its
/// maker, model and device ID, and hangs it on that port and on the one that its answer came in by.
/// Nothing for one of no known type, and where such a device hangs on the port already.
std::optional<Device> CreateDetectedDevice(Setup& setup, Destination const& port,
                                           DetectionRun::Finding const& finding);

}  // namespace Ostinet::Tool

// SPDX-License-Identifier: MIT
#pragma once

#include "ostinet/core/UString.h"

namespace Ostinet::Impl {

/// True for a device with a driver of its own that is an instrument and no interface, so that
/// nothing hangs on its ports. The list is the resource "StandaloneDevices", read once.
bool IsStandaloneDevice(UString const& manufacturer, UString const& model);

}  // namespace Ostinet::Impl

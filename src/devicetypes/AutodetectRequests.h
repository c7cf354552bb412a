// SPDX-License-Identifier: MIT
#pragma once

#include "devicetypes/DeviceTypeCatalogImpl.h"

namespace Ostinet::Impl {

/// The universal inquiry for `types`, and behind it what the resource "AutoDetect" asks, merged and
/// with the ranges of device IDs. Types that only the resource names are appended to `types`, so
/// the inquiry does not know them. Without the resource there is the inquiry alone.
AutodetectRequests BuildAutodetectRequests(DeviceTypes& types);

}  // namespace Ostinet::Impl

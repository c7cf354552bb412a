// SPDX-License-Identifier: MIT
#pragma once

#include "devicetypes/DeviceTypeCatalogImpl.h"

namespace Ostinet::Impl {

/// True if one reply could satisfy both.
bool ResponsesConflict(AutodetectResponseImpl const& a, AutodetectResponseImpl const& b);

/// Adds `request`: into the first of `requests` that can take it, so that a detection asks as
/// seldom as possible, else as a new one. The first of `requests`, the universal inquiry, never
/// takes another.
void MergeRequest(AutodetectRequests& requests, RCPtrMT<AutodetectRequestImpl> const& request);

/// Sets the device IDs that `request`, and each one that follows on it, is sent with: from the
/// lowest to the highest of the types that its answers name; `idOfAll`, 0 to 127, where no type
/// tells. Follow-ups do not widen the range of the request before them.
void ComputeDeviceIDRange(AutodetectRequestImpl& request, std::uint8_t idOfAll);

}  // namespace Ostinet::Impl

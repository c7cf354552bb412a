// SPDX-License-Identifier: MIT
#pragma once

#include "devicetypes/DeviceTypeCatalogImpl.h"

namespace Ostinet::Impl {

/// The universal device inquiry, whose answers name those of `types` that tell their identity. Its
/// range of device IDs is not computed yet.
RCPtrMT<AutodetectRequestImpl> BuildInquiryRequest(DeviceTypes const& types);

}  // namespace Ostinet::Impl

// SPDX-License-Identifier: MIT
#pragma once

#include <vector>

#include "ostinet/Common.h"

namespace Ostinet::Impl {

/// The six lists of the studio, each in order of creation. They own what stands in them, and
/// belong to the host's polling thread.
struct Studio {
  std::vector<RCPtrMT<DeviceImpl>> devices;
  std::vector<RCPtrMT<EntityImpl>> entities;
  std::vector<RCPtrMT<EndpointImpl>> sources;
  std::vector<RCPtrMT<DestinationImpl>> destinations;
  std::vector<RCPtrMT<EndpointImpl>> privateSources;
  std::vector<RCPtrMT<DestinationImpl>> privateDestinations;
};

}  // namespace Ostinet::Impl

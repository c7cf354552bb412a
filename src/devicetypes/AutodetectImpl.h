// SPDX-License-Identifier: MIT
#pragma once

#include <cstdint>
#include <list>
#include <vector>

#include "devicetypes/DeviceTypeInfoImpl.h"
#include "ostinet/Autodetect.h"

namespace Ostinet::Impl {

/// The first value of an answer's table that is no byte: it takes any byte and forgets it. Those
/// above it, up to 0xFF, keep it in one of the seven slots of the identity.
inline constexpr unsigned char kAnyByte = 0xF8;

/// How one answer to a request looks, and what it tells. Read-only once the catalog is built.
class AutodetectResponseImpl : public RCObjectMT<AutodetectResponseImpl> {
 public:
  std::vector<MatchEntry> table;
  bool strict = false;
  std::vector<RCPtrMT<DeviceTypeInfoImpl>> deviceTypes;
  std::vector<RCPtrMT<AutodetectRequestImpl>> requests;  // to be asked next
};

/// What to ask, and what may come back. Read-only once the catalog is built.
class AutodetectRequestImpl : public RCObjectMT<AutodetectRequestImpl> {
 public:
  std::list<std::vector<MatchEntry>> messages;  // in sending order
  std::uint8_t minDeviceID = 0;
  std::uint8_t maxDeviceID = 0;
  std::vector<RCPtrMT<AutodetectResponseImpl>> responses;
};

}  // namespace Ostinet::Impl

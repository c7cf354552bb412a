// SPDX-License-Identifier: MIT
#pragma once

#include <array>
#include <cstdint>
#include <utility>
#include <vector>

#include "ostinet/Common.h"
#include "ostinet/DeviceObject.h"

namespace Ostinet::Impl {

/// A fact that a device type states, denies, or says nothing of. What is unset is never written to
/// a device.
enum class TriBool : std::int32_t { kFalse = 0, kTrue = 1, kUnset = 2 };

/// So many facts, all unset.
template <std::size_t N>
constexpr std::array<TriBool, N> UnsetFlags() {
  std::array<TriBool, N> flags{};
  flags.fill(TriBool::kUnset);
  return flags;
}

/// One entity of an instrument, seen from the instrument: an input of it is a destination of the
/// studio, an output a source. The texts are the ports' names, empty where none was given.
struct DeviceTypePortGroup {
  UString name;
  std::vector<UString> ins;
  std::vector<UString> outs;
};

/// What one type tells of receiving or of sending. `N` flags, as DeviceTypeFlags.h lists them.
template <std::size_t N>
struct DeviceTypeTraffic {
  std::uint16_t maxChannels = 16;  // 0 to 16
  std::array<TriBool, N> flags = UnsetFlags<N>();
};

/// An instrument model. Filled while its file is read, never changed later.
///
/// Ownership  Counted: shared by the catalog, the responses of autodetect and hosts' handles.
class DeviceTypeInfoImpl : public RCObjectMT<DeviceTypeInfoImpl> {
 public:
  DeviceTypeInfoImpl(UString maker, UString modelName)
      : manufacturer(std::move(maker)), model(std::move(modelName)) {}

  UString const manufacturer;
  UString const model;
  UString image;              // a bare file name, or empty
  ModelInfo inquiryResponse;  // all 0xFF: none given
  std::array<TriBool, 7> capabilities = UnsetFlags<7>();
  bool hasDeviceID = false;
  // What goes over the wire: the numbers on the panel less what the panel calls 0.
  std::uint8_t defaultDeviceID = 0xFF;
  std::uint8_t minDeviceID = 0xFF;
  std::uint8_t maxDeviceID = 0xFF;
  DeviceTypeTraffic<7> receives;
  DeviceTypeTraffic<6> transmits;
  std::vector<DeviceTypePortGroup> portGroups;  // in file order
};

}  // namespace Ostinet::Impl

// SPDX-License-Identifier: MIT
//
// Arbitrary bytes as a device type file. Start it on tests/corpus/device_types.
#include <cstdlib>

#include "DeviceTypeInput.h"

extern "C" int LLVMFuzzerTestOneInput(std::uint8_t const* bytes, std::size_t count) {
  if (!Ostinet::Fuzz::TryDeviceTypes(bytes, count)) {
    std::abort();
  }
  return 0;
}

// SPDX-License-Identifier: MIT
#pragma once

#include <cstddef>
#include <cstdint>
#include <vector>

#include "devicetypes/DevTypeFileReader.h"
#include "ostinet/core/Error.h"

namespace Ostinet::Fuzz {

/// Reads a device type file of these bytes. True if what came of it is whole, and the same whether
/// somebody listens to what is passed over or not.
inline bool TryDeviceTypes(std::uint8_t const* bytes, std::size_t count) {
  std::vector<DeviceTypeFileNote> notes;
  Impl::DevTypeFileReader noted{File(), &notes};
  Impl::DevTypeFileReader silent{File()};
  for (Impl::DevTypeFileReader* reader : {&noted, &silent}) {
    try {
      XMLLib::Parser parser(bytes, count);
      reader->Read(parser);
    } catch (VantorError const&) {
    }
  }
  bool ok = noted.Types().size() == silent.Types().size() && noted.Author() == silent.Author();
  ok = ok && noted.Types().size() == noted.Lines().size();
  for (auto const& type : noted.Types()) {
    ok = ok && type->receives.maxChannels <= 16 && type->transmits.maxChannels <= 16;
    ok = ok && (type->hasDeviceID || type->minDeviceID == 0xFF);
    ok = ok && DeviceTypeInfo(type).GetFacts().ports.size() == type->portGroups.size();
  }
  for (DeviceTypeFileNote const& note : notes) {
    ok = ok && note.line > 0 && !note.text.empty();
  }
  return ok;
}

}  // namespace Ostinet::Fuzz

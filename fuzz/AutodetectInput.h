// SPDX-License-Identifier: MIT
#pragma once

#include <algorithm>
#include <cstddef>
#include <cstdint>

#include "devicetypes/AutodetectFileReader.h"
#include "devicetypes/AutodetectMerging.h"
#include "ostinet/core/Error.h"

namespace Ostinet::Fuzz {

/// What a request sends and hears. True if the answers agree with each other.
inline bool TryRequest(Autodetect::Request const& request, std::uint8_t const* bytes,
                       std::size_t count) {
  bool ok = true;
  DataBuffer const sweep = request.GetMessageW(Clocks(1));
  for (std::size_t i = 0; i < sweep.size(); ++i) {
    ok = ok && sweep[i].stamp.AsMIDITime().Value() == 1;
  }
  for (int i = 0; i < request.CountResponses(); ++i) {
    Autodetect::Response const response = request.GetResponse(i);
    Autodetect::Matcher const matcher = response.GetMatcher();
    unsigned char deviceID = 0;
    Array<unsigned char, 7> captured = {};
    // In one piece and in two: the same.
    std::size_t const whole = matcher.Match(Data(bytes, count), 0, deviceID, captured);
    std::size_t position = matcher.Match(Data(bytes, count / 2), 0, deviceID, captured);
    if (position != 0 || count / 2 == 0) {
      std::size_t const rest = count - count / 2;
      position = matcher.Match(Data(bytes + count / 2, rest), position, deviceID, captured);
    }
    ok = ok && position == whole && whole <= matcher.Success();
    response.GetMatchedDeviceTypeInfo(captured);
    for (int j = 0; j < response.CountRequests(); ++j) {
      ok = TryRequest(response.GetRequest(j), bytes, count) && ok;
    }
  }
  return ok;
}

/// Reads the bytes as an autodetect file, merges what it asks, and hears the same bytes as a reply.
inline bool TryAutodetectFile(std::uint8_t const* bytes, std::size_t count) {
  Impl::DeviceTypes types;
  Impl::AutodetectRequests requests;
  try {
    XMLLib::Parser parser(bytes, count);
    Impl::AutodetectFileReader(parser, types).ReadRequests(requests);
  } catch (VantorError const&) {
    // What was read before the fault counts.
  }
  Impl::AutodetectRequests merged = {new Impl::AutodetectRequestImpl};
  for (auto const& request : requests) {
    MergeRequest(merged, request);
  }
  bool ok = merged.size() <= requests.size() + 1;
  for (auto const& request : merged) {
    Impl::ComputeDeviceIDRange(*request, 127);
    ok = ok && request->minDeviceID <= request->maxDeviceID;
    ok = TryRequest(Autodetect::Request(request), bytes, std::min<std::size_t>(count, 64)) && ok;
  }
  return ok;
}

}  // namespace Ostinet::Fuzz

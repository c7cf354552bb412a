// SPDX-License-Identifier: MIT
#include "devicetypes/AutodetectRequests.h"

#include "devicetypes/AutodetectFileReader.h"
#include "devicetypes/AutodetectInquiry.h"
#include "devicetypes/AutodetectMerging.h"

namespace Ostinet::Impl {

namespace {

// Where no type tells which device IDs it has, a question goes out once: the inquiry to 7E, all
// others to 7F, which every instrument takes for its own. Hosts know the inquiry's by heart.
constexpr std::uint8_t kInquiryID = 126;
constexpr std::uint8_t kAllCallID = 127;

// What stands before a fault of the file counts.
AutodetectRequests ReadResource(DeviceTypes& types) {
  AutodetectRequests requests;
  try {
    XMLLib::Parser parser(ResourceAccess::Instance().GetFile("AutoDetect", "xml"));
    AutodetectFileReader(parser, types).ReadRequests(requests);
  } catch (...) {
  }
  return requests;
}

}  // namespace

AutodetectRequests BuildAutodetectRequests(DeviceTypes& types) {
  AutodetectRequests requests = {BuildInquiryRequest(types)};
  ComputeDeviceIDRange(*requests.front(), kInquiryID);
  for (auto const& request : ReadResource(types)) {
    MergeRequest(requests, request);
  }
  for (std::size_t i = 1; i < requests.size(); ++i) {
    ComputeDeviceIDRange(*requests[i], kAllCallID);
  }
  return requests;
}

}  // namespace Ostinet::Impl

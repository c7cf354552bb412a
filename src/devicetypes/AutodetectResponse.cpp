// SPDX-License-Identifier: MIT
#include <algorithm>
#include <iterator>

#include "devicetypes/AutodetectImpl.h"

namespace Ostinet {

namespace Autodetect {

namespace {

bool IsUntouched(Array<unsigned char, 7> const& captured) {
  return std::all_of(std::begin(captured.elements), std::end(captured.elements),
                     [](unsigned char byte) { return byte == 0xFF; });
}

bool HasIdentity(Impl::DeviceTypeInfoImpl const& type, Array<unsigned char, 7> const& captured) {
  return std::equal(std::begin(captured.elements), std::end(captured.elements),
                    std::begin(type.inquiryResponse.bytes));
}

}  // namespace

Response::Response(RCPtrMT<Impl::AutodetectResponseImpl> const& impl) : impl_(impl) {}
Response::Response(Response const& other) = default;
Response& Response::operator=(Response const& other) = default;
Response::~Response() = default;

int Response::CountDeviceTypeInfos() const {
  return impl_ ? static_cast<int>(impl_->deviceTypes.size()) : 0;
}

DeviceTypeInfo Response::GetDeviceTypeInfo(int index) const {
  bool const isThere = index >= 0 && index < CountDeviceTypeInfos();
  return isThere ? DeviceTypeInfo(impl_->deviceTypes[static_cast<size_t>(index)])
                 : DeviceTypeInfo();
}

int Response::CountRequests() const { return impl_ ? static_cast<int>(impl_->requests.size()) : 0; }

Request Response::GetRequest(int index) const {
  bool const isThere = index >= 0 && index < CountRequests();
  return Request(isThere ? impl_->requests[static_cast<size_t>(index)] : nullptr);
}

Matcher Response::GetMatcher() const {
  return impl_ ? Matcher(impl_->table, impl_->strict) : Matcher({}, false);
}

DeviceTypeInfo Response::GetMatchedDeviceTypeInfo(Array<unsigned char, 7> const& captured) const {
  if (!impl_) {
    return DeviceTypeInfo();
  }
  if (impl_->deviceTypes.size() == 1 && IsUntouched(captured)) {
    return DeviceTypeInfo(impl_->deviceTypes.front());
  }
  for (auto const& type : impl_->deviceTypes) {
    if (HasIdentity(*type, captured)) {
      return DeviceTypeInfo(type);
    }
  }
  return DeviceTypeInfo();
}

}  // namespace Autodetect

}  // namespace Ostinet

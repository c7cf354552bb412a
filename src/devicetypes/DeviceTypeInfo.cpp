// SPDX-License-Identifier: MIT
#include "devicetypes/AutodetectImpl.h"
#include "devicetypes/DeviceTypeFlags.h"
#include "devicetypes/DeviceTypeInfoImpl.h"
#include "ostinet/DeviceTypeCatalog.h"

namespace Ostinet {

template class RCPtrMT<Impl::DeviceTypeInfoImpl>;
template class RCPtrMT<Impl::AutodetectRequestImpl>;
template class RCPtrMT<Impl::AutodetectResponseImpl>;

DeviceTypeInfo::DeviceTypeInfo() = default;
DeviceTypeInfo::DeviceTypeInfo(RCPtrMT<Impl::DeviceTypeInfoImpl> const& impl) : impl_(impl) {}
DeviceTypeInfo::DeviceTypeInfo(DeviceTypeInfo const& other) = default;
DeviceTypeInfo& DeviceTypeInfo::operator=(DeviceTypeInfo const& other) = default;

bool DeviceTypeInfo::operator==(DeviceTypeInfo const& other) const { return impl_ == other.impl_; }
bool DeviceTypeInfo::operator!=(DeviceTypeInfo const& other) const { return !(*this == other); }

bool DeviceTypeInfo::Exists() const { return impl_.get() != nullptr; }

UString DeviceTypeInfo::GetMfrName() const { return Exists() ? impl_->manufacturer : UString(); }

UString DeviceTypeInfo::GetModelName() const { return Exists() ? impl_->model : UString(); }

bool DeviceTypeInfo::MatchesDevice(Device const& device) const {
  return Exists() && device.GetManufacturer() == impl_->manufacturer &&
         device.GetModel() == impl_->model;
}

namespace {

template <std::size_t N>
void AddFlags(Impl::DeviceTypeFlag const (&forms)[N], std::array<Impl::TriBool, N> const& flags,
              DeviceTypeFacts& facts) {
  for (std::size_t i = 0; i < N; ++i) {
    if (flags[i] != Impl::TriBool::kUnset) {
      facts.flags.emplace_back(forms[i].key, flags[i] == Impl::TriBool::kTrue);
    }
  }
}

}  // namespace

DeviceTypeFacts DeviceTypeInfo::GetFacts() const {
  DeviceTypeFacts facts;
  if (!Exists()) {
    return facts;
  }
  facts.image = impl_->image;
  facts.inquiryResponse = impl_->inquiryResponse;
  facts.hasDeviceID = impl_->hasDeviceID;
  facts.defaultDeviceID = impl_->defaultDeviceID;
  facts.minDeviceID = impl_->minDeviceID;
  facts.maxDeviceID = impl_->maxDeviceID;
  facts.receiveMaxChannels = impl_->receives.maxChannels;
  facts.transmitMaxChannels = impl_->transmits.maxChannels;
  AddFlags(Impl::kCapabilityFlags, impl_->capabilities, facts);
  AddFlags(Impl::kReceiveFlags, impl_->receives.flags, facts);
  AddFlags(Impl::kTransmitFlags, impl_->transmits.flags, facts);
  for (Impl::DeviceTypePortGroup const& group : impl_->portGroups) {
    facts.ports.push_back({group.name, group.ins, group.outs});
  }
  return facts;
}

}  // namespace Ostinet

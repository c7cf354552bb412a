// SPDX-License-Identifier: MIT
#include "devicetypes/AutodetectImpl.h"
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

}  // namespace Ostinet

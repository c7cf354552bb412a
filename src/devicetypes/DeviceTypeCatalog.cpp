// SPDX-License-Identifier: MIT
#include "ostinet/DeviceTypeCatalog.h"

#include <algorithm>

#include "devicetypes/AutodetectRequests.h"
#include "devicetypes/DeviceTypeCatalogImpl.h"

namespace Ostinet {

namespace Impl {

DeviceTypeCatalogImpl::DeviceTypeCatalogImpl()
    : types_(ReadDeviceTypeFiles()), requests_(BuildAutodetectRequests(types_)) {}

DeviceTypeInfo DeviceTypeCatalogImpl::GetType(int index) const {
  bool const isThere = index >= 0 && static_cast<std::size_t>(index) < types_.size();
  return isThere ? DeviceTypeInfo(types_[static_cast<std::size_t>(index)]) : DeviceTypeInfo();
}

// Exact, though loading takes names that differ in case or white space for one: what a host stored
// must name the very type that it was taken from.
DeviceTypeInfo DeviceTypeCatalogImpl::FindType(UString const& manufacturer,
                                               UString const& model) const {
  for (auto const& type : types_) {
    if (type->manufacturer == manufacturer && type->model == model) {
      return type;
    }
  }
  return DeviceTypeInfo();
}

void DeviceTypeCatalogImpl::CollectModels(UString const& manufacturer,
                                          std::vector<DeviceTypeInfo>& models) const {
  for (auto const& type : types_) {
    if (type->manufacturer == manufacturer) {
      models.emplace_back(type);
    }
  }
  std::stable_sort(models.begin(), models.end(),
                   [](DeviceTypeInfo const& a, DeviceTypeInfo const& b) {
                     return a.GetModelName().less(b.GetModelName(), UString::kForPeople);
                   });
}

Autodetect::Request DeviceTypeCatalogImpl::GetRequest(int index) const {
  bool const isThere = index >= 0 && index < CountRequests();
  return Autodetect::Request(isThere ? requests_[static_cast<std::size_t>(index)] : nullptr);
}

}  // namespace Impl

DeviceTypeCatalog::DeviceTypeCatalog()
    : impl_(std::make_unique<Impl::DeviceTypeCatalogImpl const>()) {}
DeviceTypeCatalog::~DeviceTypeCatalog() = default;

DeviceTypeCatalog& DeviceTypeCatalog::Instance() {
  static DeviceTypeCatalog instance;
  return instance;
}

int DeviceTypeCatalog::CountDeviceTypes() const {
  return static_cast<int>(impl_->GetTypes().size());
}

DeviceTypeInfo DeviceTypeCatalog::GetDeviceType(int index) const { return impl_->GetType(index); }

DeviceTypeInfo DeviceTypeCatalog::GetDeviceType(UString const& manufacturer,
                                                UString const& model) const {
  return impl_->FindType(manufacturer, model);
}

void DeviceTypeCatalog::CollectModels(UString const& manufacturer,
                                      std::vector<DeviceTypeInfo>& models) const {
  impl_->CollectModels(manufacturer, models);
}

int DeviceTypeCatalog::CountAutodetectRequests() const { return impl_->CountRequests(); }

Autodetect::Request DeviceTypeCatalog::GetAutodetectRequest(int index) const {
  return impl_->GetRequest(index);
}

}  // namespace Ostinet

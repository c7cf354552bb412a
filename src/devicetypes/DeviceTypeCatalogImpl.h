// SPDX-License-Identifier: MIT
#pragma once

#include <vector>

#include "devicetypes/AutodetectImpl.h"
#include "devicetypes/DeviceTypeInfoImpl.h"
#include "ostinet/DeviceTypeCatalog.h"
#include "ostinet/core/Noncopyable.h"

namespace Ostinet::Impl {

using DeviceTypes = std::vector<RCPtrMT<DeviceTypeInfoImpl>>;
using AutodetectRequests = std::vector<RCPtrMT<AutodetectRequestImpl>>;

/// What DeviceTypeCatalog holds: the types of the device type files, sorted by maker and model,
/// behind them the types that only the autodetect file names; and the requests, of which the first
/// is the universal inquiry.
///
/// Threads    [any thread] Read-only after construction.
class DeviceTypeCatalogImpl : private Noncopyable<DeviceTypeCatalogImpl> {
 public:
  /// Reads everything from the data folders of this moment. What cannot be read is passed over.
  DeviceTypeCatalogImpl();

  DeviceTypes const& GetTypes() const { return types_; }
  /// A null handle out of range.
  DeviceTypeInfo GetType(int index) const;
  /// The type of exactly these texts, or a null handle.
  DeviceTypeInfo FindType(UString const& manufacturer, UString const& model) const;
  /// Appends the types of exactly this maker and sorts all of `models`.
  void CollectModels(UString const& manufacturer, std::vector<DeviceTypeInfo>& models) const;

  int CountRequests() const { return static_cast<int>(requests_.size()); }
  /// A null handle out of range.
  Autodetect::Request GetRequest(int index) const;

 private:
  DeviceTypes types_;
  AutodetectRequests requests_;  // after the types, to which it adds
};

/// The types of all files that end in ".middev", the user's first, one for each maker and model.
DeviceTypes ReadDeviceTypeFiles();

}  // namespace Ostinet::Impl

// SPDX-License-Identifier: MIT
#pragma once

#include <vector>

#include "ostinet/Common.h"
#include "ostinet/DeviceObject.h"
#include "ostinet/core/Files.h"
#include "ostinet/core/SortedVector.h"

namespace Ostinet {
namespace Autodetect {
class Request;
}
class DeviceTypeInfo {
 public:
  DeviceTypeInfo();
  DeviceTypeInfo(RCPtrMT<Impl::DeviceTypeInfoImpl> const&);
  DeviceTypeInfo(DeviceTypeInfo const&);
  DeviceTypeInfo& operator=(DeviceTypeInfo const&);
  bool operator==(DeviceTypeInfo const&) const;
  bool operator!=(DeviceTypeInfo const&) const;
  bool Exists() const;
  UString GetMfrName() const;
  UString GetModelName() const;
  bool MatchesDevice(Device const&) const;
};
class DeviceTypeCatalog {
 public:
  static DeviceTypeCatalog& Instance();
  int CountDeviceTypes() const;
  DeviceTypeInfo GetDeviceType(int) const;
  DeviceTypeInfo GetDeviceType(UString const& manufacturer, UString const& model) const;
  template <class C>
  void CollectManufacturers(sorted_vector_set<UString, C>&) const;
  void CollectModels(UString const& manufacturer, std::vector<DeviceTypeInfo>&) const;
  int CountAutodetectRequests() const;
  Autodetect::Request GetAutodetectRequest(int) const;
};
namespace Impl {
class XMLFilesVisitor {
 public:
  virtual ~XMLFilesVisitor();
  virtual void Visit(File const&, bool inUserFolder) = 0;
};
void VisitXMLFiles(XMLFilesVisitor&, char const* extension);
}  // namespace Impl
}  // namespace Ostinet

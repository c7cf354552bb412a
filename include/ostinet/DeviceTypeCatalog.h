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

/// An instrument model of the catalog.
///
/// Ownership    Counted; the type stays valid as long as a handle refers to it.
/// Null handle  Default-constructed. Exists is false, the names are empty.
/// Threads      The host's polling thread.
class OSTINET_EXPORT DeviceTypeInfo {
 public:
  DeviceTypeInfo();
  DeviceTypeInfo(RCPtrMT<Impl::DeviceTypeInfoImpl> const& impl);
  DeviceTypeInfo(DeviceTypeInfo const& other);
  DeviceTypeInfo& operator=(DeviceTypeInfo const& other);
  bool operator==(DeviceTypeInfo const& other) const;
  bool operator!=(DeviceTypeInfo const& other) const;
  bool Exists() const;
  UString GetMfrName() const;
  UString GetModelName() const;
  /// True if the device's manufacturer and model are this type's.
  bool MatchesDevice(Device const& device) const;
};

/// The instrument models that the device type files describe.
///
/// Ownership    One object, which lives to the end of the process.
/// Threads      Instance: [any thread]; the rest the host's polling thread.
class OSTINET_EXPORT DeviceTypeCatalog {
 public:
  static DeviceTypeCatalog& Instance();
  int CountDeviceTypes() const;
  /// A null handle out of range.
  DeviceTypeInfo GetDeviceType(int index) const;
  DeviceTypeInfo GetDeviceType(UString const& manufacturer, UString const& model) const;
  template <class C>
  void CollectManufacturers(sorted_vector_set<UString, C>& manufacturers) const;
  void CollectModels(UString const& manufacturer, std::vector<DeviceTypeInfo>& models) const;
  int CountAutodetectRequests() const;
  Autodetect::Request GetAutodetectRequest(int index) const;
};

namespace Impl {

/// Is shown the data files of one kind, those of the user first.
class OSTINET_EXPORT XMLFilesVisitor {
 public:
  virtual ~XMLFilesVisitor();
  virtual void Visit(File const& file, bool inUserFolder) = 0;
};

/// Walks the files that end in `extension`, without its dot, in any case.
OSTINET_EXPORT void VisitXMLFiles(XMLFilesVisitor& visitor, char const* extension);

}  // namespace Impl

}  // namespace Ostinet

// SPDX-License-Identifier: MIT
#pragma once

#include "devicetypes/DeviceTypeCatalogImpl.h"
#include "ostinet/core/XML.h"

namespace Ostinet::Impl {

/// Reads one autodetect file. docs/autodetect.md tells its form.
class AutodetectFileReader {
 public:
  /// Both outlive the reader. Types that the file names and `types` lacks are appended to it.
  AutodetectFileReader(XMLLib::Parser& parser, DeviceTypes& types)
      : parser_(parser), types_(types) {}

  /// Appends the requests to `requests`, each when it is complete. Throws a VantorError at a fault
  /// of the file, with all requests before it appended.
  void ReadRequests(AutodetectRequests& requests);

 private:
  enum class Template { kRequest, kResponse };

  RCPtrMT<AutodetectRequestImpl> ReadRequest();
  RCPtrMT<AutodetectResponseImpl> ReadResponse();
  std::vector<MatchEntry> ReadTemplate(Template which);
  RCPtrMT<DeviceTypeInfoImpl> ReadDevice();

  XMLLib::Parser& parser_;
  DeviceTypes& types_;
};

}  // namespace Ostinet::Impl

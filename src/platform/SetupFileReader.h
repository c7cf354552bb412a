// SPDX-License-Identifier: MIT
#pragma once

#include "model/DeviceObjectImpl.h"
#include "ostinet/core/XML.h"

namespace Ostinet::Impl {

class WinMIDISetup;

/// Reads devices and ports from the XML of a setup file into the studio. An element that lacks
/// what it must have is skipped whole, and its siblings are read.
class SetupFileReader {
 public:
  enum Purpose {
    kLoad,    ///< the studio as it was saved: identities and connections included
    kImport,  ///< a device from elsewhere: no identities, connections by the names of ports
  };

  SetupFileReader(WinMIDISetup& setup, XMLLib::Parser& parser, Purpose purpose)
      : setup_(setup), parser_(parser), purpose_(purpose) {}

  /// The whole file, with the parser above the root.
  void ReadStudio();
  /// With the parser on a "Device" element; null if that is skipped.
  RCPtrMT<DeviceImpl> ReadDevice();

 private:
  void ReadEntity(DeviceImpl& device);
  void ReadEntityChild(EntityImpl& entity);
  void ReadBarePort(bool isSource);
  void ReadEndpoint(EntityImpl& entity, bool isSource);
  bool ReadEndpointAttributes(bool& isDirect) const;
  void ReadProperties(ImplImpl& peer);
  void AddSource(RCPtrMT<EndpointImpl> const& source);
  void AddDestination(RCPtrMT<DestinationImpl> const& destination);
  void ReadConnection(ImplImpl& peer, bool isSource);

  WinMIDISetup& setup_;
  XMLLib::Parser& parser_;
  Purpose const purpose_;
};

}  // namespace Ostinet::Impl

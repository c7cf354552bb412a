// SPDX-License-Identifier: MIT
#pragma once

#include "model/DestinationImpl.h"
#include "model/DeviceObjectImpl.h"

namespace Ostinet::Impl {

/// One group of ports of a device; owns its endpoints.
class EntityImpl : public DeviceObjectImpl {
 public:
  using Sources = std::vector<RCPtrMT<EndpointImpl>>;
  using Destinations = std::vector<RCPtrMT<DestinationImpl>>;

  /// `device` outlives its place in it: DeviceImpl clears the link when either goes. The entity is
  /// direct as its device is.
  EntityImpl(std::unique_ptr<ImplImpl> peer, DeviceImpl* device);
  ~EntityImpl() override;

  UString GetName() const override;
  void Deactivate(bool fromParent) override;
  bool HandlePropertyChanges(PropertyKeys const& keys) override;
  void WriteXML(XMLLib::Writer& writer) const override;

  /// Null once the entity left its device.
  DeviceImpl* GetDevice() const { return device_; }
  Sources const& GetSources() const { return sources_; }
  Destinations const& GetDestinations() const { return destinations_; }
  /// Adding and removing clear the cached names of all endpoints of the entity.
  void AddSource(RCPtrMT<EndpointImpl> const& source);
  void AddDestination(RCPtrMT<DestinationImpl> const& destination);
  void RemoveSource(EndpointImpl* source);
  void RemoveDestination(EndpointImpl* destination);
  /// For an endpoint that takes itself out: its siblings keep their cached names, as hosts that
  /// show them during the change rely on.
  void ForgetEndpoint(EndpointImpl* endpoint);
  void ClearCachedNames();
  /// For a device that goes without Deactivate, at the end of the process.
  void LeaveDevice() { device_ = nullptr; }

 private:
  DeviceImpl* device_;  // cleared by Deactivate
  Sources sources_;
  Destinations destinations_;
};

}  // namespace Ostinet::Impl

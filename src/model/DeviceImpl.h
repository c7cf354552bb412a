// SPDX-License-Identifier: MIT
#pragma once

#include "model/DeviceObjectImpl.h"
#include "model/EntityImpl.h"

namespace Ostinet::Impl {

/// A box in the studio; owns its entities.
class DeviceImpl : public DeviceObjectImpl {
 public:
  using Entities = std::vector<RCPtrMT<EntityImpl>>;

  DeviceImpl(std::unique_ptr<ImplImpl> peer, bool isDirect);
  ~DeviceImpl() override;

  void Deactivate(bool fromParent) override;
  bool HandlePropertyChanges(PropertyKeys const& keys) override;
  void WriteXML(XMLLib::Writer& writer) const override;

  Entities const& GetEntities() const { return entities_; }
  /// Both clear the cached names of all endpoints of the device, which count siblings.
  void AddEntity(RCPtrMT<EntityImpl> const& entity);
  void RemoveEntity(EntityImpl* entity);
  void ClearCachedNames();
  /// The entity that Device::GetSpecialEntity gives, or null.
  EntityImpl* GetSpecialEntity(Device::SpecialEntityType type) const;

 private:
  Entities entities_;
};

}  // namespace Ostinet::Impl

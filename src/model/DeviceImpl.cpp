// SPDX-License-Identifier: MIT
#include "model/DeviceImpl.h"

#include <algorithm>
#include <utility>

#include "model/PropertyKeys.h"
#include "model/XMLNames.h"

namespace Ostinet::Impl {

namespace {

struct SpecialEntity {
  Device::SpecialEntityType type;
  int deviceType;
  int portNumber;
};

constexpr SpecialEntity kSpecialEntities[] = {
    {Device::kDeviceCommonEntity, 3, 0}, {Device::kDeviceCommonEntity, 5, 0},
    {Device::kDeviceCommonEntity, 6, 0}, {Device::kSecondCommonEntity, 3, 17},
    {Device::kThirdCommonEntity, 3, 99},
};

}  // namespace

DeviceImpl::DeviceImpl(std::unique_ptr<ImplImpl> peer, bool isDirect)
    : DeviceObjectImpl(std::move(peer), isDirect) {
  Peer()->Activate(this);
}

DeviceImpl::~DeviceImpl() {
  for (RCPtrMT<EntityImpl> const& entity : entities_) {
    entity->LeaveDevice();
  }
}

void DeviceImpl::Deactivate(bool fromParent) {
  Entities const leaving = std::exchange(entities_, Entities());
  for (RCPtrMT<EntityImpl> const& entity : leaving) {
    entity->Deactivate(true);
  }
  DeviceObjectImpl::Deactivate(fromParent);
}

bool DeviceImpl::HandlePropertyChanges(PropertyKeys const& keys) {
  bool result = DeviceObjectImpl::HandlePropertyChanges(keys);
  Entities const entities = entities_;
  for (RCPtrMT<EntityImpl> const& entity : entities) {
    result |= entity->HandlePropertyChanges(keys);
  }
  return result;
}

void DeviceImpl::WriteXML(XMLLib::Writer& writer) const {
  writer.Attribute(XMLNames::kDirect, XMLLib::kBoolAttribute, IsDirect());
  writer.Attribute(XMLNames::kFake, XMLLib::kBoolAttribute, Peer()->IsFake());
  WriteProperties(writer);
  for (RCPtrMT<EntityImpl> const& entity : entities_) {
    writer.StartElement(XMLNames::kEntity);
    entity->WriteXML(writer);
    writer.EndElement();
  }
}

void DeviceImpl::AddEntity(RCPtrMT<EntityImpl> const& entity) {
  entities_.push_back(entity);
  ClearCachedNames();
}

void DeviceImpl::RemoveEntity(EntityImpl* entity) {
  entities_.erase(std::remove(entities_.begin(), entities_.end(), RCPtrMT<EntityImpl>(entity)),
                  entities_.end());
  ClearCachedNames();
}

void DeviceImpl::ClearCachedNames() {
  for (RCPtrMT<EntityImpl> const& entity : entities_) {
    entity->ClearCachedNames();
  }
}

EntityImpl* DeviceImpl::GetSpecialEntity(Device::SpecialEntityType type) const {
  if (type == Device::kRealtimeEntity) {
    int const index = GetInt(Keys::kSingleRealtimeEntity, -1);
    bool const isThere = index >= 0 && static_cast<std::size_t>(index) < entities_.size();
    return isThere ? entities_[static_cast<std::size_t>(index)].get() : nullptr;
  }
  int const deviceType = GetInt(Keys::kDeviceType, 0);
  for (SpecialEntity const& special : kSpecialEntities) {
    if (special.type == type && special.deviceType == deviceType) {
      auto const place =
          std::find_if(entities_.begin(), entities_.end(), [&](RCPtrMT<EntityImpl> const& entity) {
            int port = 0;
            return entity->Peer()->GetInt(Keys::kPortNumber, port) && port == special.portNumber;
          });
      return place != entities_.end() ? place->get() : nullptr;
    }
  }
  return nullptr;
}

}  // namespace Ostinet::Impl

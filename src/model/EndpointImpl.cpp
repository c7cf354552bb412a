// SPDX-License-Identifier: MIT
#include "model/EndpointImpl.h"

#include <algorithm>
#include <utility>

#include "model/DeviceImpl.h"
#include "model/EntityImpl.h"
#include "model/PropertyKeys.h"
#include "model/StandaloneDevices.h"
#include "model/XMLNames.h"

namespace Ostinet::Impl {

EndpointKind EndpointKind::InEntity(EntityImpl& entity) {
  EndpointKind kind;
  kind.entity = &entity;
  kind.isDirect = entity.IsDirect();
  return kind;
}

EndpointKind EndpointKind::Software(bool isPrivate, bool isInternal) {
  EndpointKind kind;
  kind.isDirect = true;
  kind.isSoftware = true;
  kind.isInternalSoftware = isInternal;
  kind.isPrivate = isPrivate;
  return kind;
}

EndpointKind EndpointKind::Virtual(EndpointImpl* matching, bool isPrivate, bool isInternal) {
  EndpointKind kind = Software(isPrivate, isInternal);
  kind.matchingVirtual = matching;
  kind.isVirtual = true;
  return kind;
}

EndpointKind EndpointKind::Bare(bool isDirect, bool isPrivate) {
  EndpointKind kind;
  kind.isDirect = isDirect;
  kind.isPrivate = isPrivate;
  return kind;
}

EndpointImpl::EndpointImpl(std::unique_ptr<ImplImpl> peer, Setup& setup, EndpointKind const& kind)
    : EndpointImpl(std::move(peer), setup, kind, false) {}

EndpointImpl::EndpointImpl(std::unique_ptr<ImplImpl> peer, Setup& setup, EndpointKind const& kind,
                           bool isDestination)
    : DeviceObjectImpl(std::move(peer), kind.isDirect),
      setup_(setup),
      kind_(kind),
      isDestination_(isDestination) {
  if (kind_.matchingVirtual != nullptr) {
    kind_.matchingVirtual->kind_.matchingVirtual = this;
  }
  Peer()->Activate(this);
  isStandalone_ = WorkOutStandalone();
}

EndpointImpl::~EndpointImpl() {
  Disconnect();
  Unpair();
}

bool EndpointImpl::WorkOutStandalone() const {
  if (!IsDirect()) {
    return false;
  }
  return kind_.entity == nullptr ||
         IsStandaloneDevice(GetString(Keys::kManufacturer), GetString(Keys::kModel));
}

void EndpointImpl::Deactivate(bool fromParent) {
  if (kind_.entity != nullptr && !fromParent) {
    kind_.entity->ForgetEndpoint(this);
  }
  kind_.entity = nullptr;
  Disconnect();
  Unpair();
  DeviceObjectImpl::Deactivate(fromParent);
}

// A pair's ends find each other by these links, so neither may outlast the other's.
void EndpointImpl::Unpair() {
  EndpointImpl* const other = std::exchange(kind_.matchingVirtual, nullptr);
  if (other != nullptr && other->kind_.matchingVirtual == this) {
    other->kind_.matchingVirtual = nullptr;
  }
}

void EndpointImpl::SetName(UString const& name) {
  DeviceObjectImpl::SetName(name);
  ClearCachedNames();
}

bool EndpointImpl::IsOnline() const {
  if (!DeviceObjectImpl::IsOnline()) {
    return false;
  }
  return IsDirect() || (directEndpoint_ != nullptr && directEndpoint_->IsOnline());
}

bool EndpointImpl::HandlePropertyChanges(PropertyKeys const& keys) {
  auto const changed = [&](UString const& key) { return keys.count(key) != 0; };
  bool const result = DeviceObjectImpl::HandlePropertyChanges(keys);
  // Either, or: a change of name and model in one round leaves the flag as it was until the next
  // change. Hosts that rename and retype a device at once see their interfaces keep their kind.
  if (changed(Keys::kName)) {
    name_ = boost::none;
  } else if (changed(Keys::kManufacturer) || changed(Keys::kModel)) {
    isStandalone_ = WorkOutStandalone();
  }
  if (kind_.matchingVirtual != nullptr && !Peer()->IsFake()) {
    kind_.matchingVirtual->HandlePropertyChanges(keys);
  }
  return changed(Keys::kConnUniqueID) || changed(Keys::kUniqueID) || changed(Keys::kEmbedded) ||
         result;
}

void EndpointImpl::WriteXML(XMLLib::Writer& writer) const {
  writer.Attribute(XMLNames::kDirect, XMLLib::kBoolAttribute, IsDirect());
  writer.Attribute(XMLNames::kSoftware, XMLLib::kBoolAttribute, IsSoftware());
  writer.Attribute(XMLNames::kFake, XMLLib::kBoolAttribute, Peer()->IsFake());
  WriteProperties(writer);
  if (directEndpoint_ != nullptr) {
    writer.StartElement(XMLNames::kConnection);
    writer.Attribute(XMLNames::kName, directEndpoint_->GetName());
    writer.Attribute(XMLNames::kManufacturer, directEndpoint_->GetString(Keys::kManufacturer));
    writer.Attribute(XMLNames::kModel, directEndpoint_->GetString(Keys::kModel));
    writer.EndElement();
  }
}

MatchObjectID EndpointImpl::GetObjectID() const { return Source::kObjectID; }

unsigned short EndpointImpl::GetChannels() const {
  constexpr int kAllChannels = 0xFFFF;
  int mask = 0;
  if (Peer()->GetInt(KeyPairs::kChannels.For(isDestination_), mask) && mask != 0) {
    return static_cast<unsigned short>(mask);
  }
  int count = 16;
  Peer()->GetInt(KeyPairs::kMaxChannels.For(isDestination_), count);
  return static_cast<unsigned short>(kAllChannels >> (16 - std::clamp(count, 0, 16)));
}

bool EndpointImpl::HasConnections() const {
  return GetInt(Keys::kEmbedded, 0) == 0 && IsDirect() && !IsSoftware();
}

boost::optional<bool> EndpointImpl::IsInterface() const {
  if (!HasConnections() || isStandalone_) {
    return false;
  }
  if (!connected_.empty()) {
    return true;
  }
  DeviceImpl const* const device = kind_.entity != nullptr ? kind_.entity->GetDevice() : nullptr;
  if (device != nullptr && device->GetName().starts_with("INTERFACE")) {
    return true;
  }
  return boost::none;
}

}  // namespace Ostinet::Impl

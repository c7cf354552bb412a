// SPDX-License-Identifier: MIT
#include "model/EntityImpl.h"

#include <algorithm>
#include <utility>

#include "model/DeviceImpl.h"
#include "model/XMLNames.h"

namespace Ostinet::Impl {

namespace {

template <class List>
bool Erase(List& list, EndpointImpl const* endpoint) {
  auto const place = std::find_if(list.begin(), list.end(),
                                  [=](auto const& member) { return member.get() == endpoint; });
  if (place == list.end()) {
    return false;
  }
  list.erase(place);
  return true;
}

template <class List>
void WriteEndpoints(XMLLib::Writer& writer, XMLLib::Name const& element, List const& list) {
  for (auto const& endpoint : list) {
    writer.StartElement(element);
    endpoint->WriteXML(writer);
    writer.EndElement();
  }
}

}  // namespace

EntityImpl::EntityImpl(std::unique_ptr<ImplImpl> peer, DeviceImpl* device)
    : DeviceObjectImpl(std::move(peer), device->IsDirect()), device_(device) {
  Peer()->Activate(this);
}

EntityImpl::~EntityImpl() {
  for (RCPtrMT<EndpointImpl> const& source : sources_) {
    source->LeaveEntity();
  }
  for (RCPtrMT<DestinationImpl> const& destination : destinations_) {
    destination->LeaveEntity();
  }
}

UString EntityImpl::GetName() const {
  UString const raw = DeviceObjectImpl::GetName();
  if (device_ == nullptr) {
    return raw;
  }
  UString const deviceName = device_->GetName();
  return device_->GetEntities().size() > 1 ? deviceName + " " + raw : deviceName;
}

void EntityImpl::Deactivate(bool fromParent) {
  if (device_ != nullptr && !fromParent) {
    device_->RemoveEntity(this);
  }
  device_ = nullptr;
  // The lists stay until the endpoints have gone: each reads its siblings no more, but its own
  // last reference may stand here.
  for (RCPtrMT<EndpointImpl> const& source : sources_) {
    source->Deactivate(true);
  }
  for (RCPtrMT<DestinationImpl> const& destination : destinations_) {
    destination->Deactivate(true);
  }
  sources_.clear();
  destinations_.clear();
  DeviceObjectImpl::Deactivate(fromParent);
}

bool EntityImpl::HandlePropertyChanges(PropertyKeys const& keys) {
  bool result = DeviceObjectImpl::HandlePropertyChanges(keys);
  Sources const sources = sources_;
  Destinations const destinations = destinations_;
  for (RCPtrMT<EndpointImpl> const& source : sources) {
    result |= source->HandlePropertyChanges(keys);
  }
  for (RCPtrMT<DestinationImpl> const& destination : destinations) {
    result |= destination->HandlePropertyChanges(keys);
  }
  return result;
}

void EntityImpl::WriteXML(XMLLib::Writer& writer) const {
  writer.Attribute(XMLNames::kDirect, XMLLib::kBoolAttribute, IsDirect());
  writer.Attribute(XMLNames::kFake, XMLLib::kBoolAttribute, Peer()->IsFake());
  WriteProperties(writer);
  WriteEndpoints(writer, XMLNames::kSource, sources_);
  WriteEndpoints(writer, XMLNames::kDestination, destinations_);
}

void EntityImpl::AddSource(RCPtrMT<EndpointImpl> const& source) {
  sources_.push_back(source);
  ClearCachedNames();
}

void EntityImpl::AddDestination(RCPtrMT<DestinationImpl> const& destination) {
  destinations_.push_back(destination);
  ClearCachedNames();
}

void EntityImpl::RemoveSource(EndpointImpl* source) {
  Erase(sources_, source);
  ClearCachedNames();
}

void EntityImpl::RemoveDestination(EndpointImpl* destination) {
  Erase(destinations_, destination);
  ClearCachedNames();
}

void EntityImpl::ForgetEndpoint(EndpointImpl* endpoint) {
  if (!Erase(sources_, endpoint)) {
    Erase(destinations_, endpoint);
  }
}

void EntityImpl::ClearCachedNames() {
  for (RCPtrMT<EndpointImpl> const& source : sources_) {
    source->ClearCachedNames();
  }
  for (RCPtrMT<DestinationImpl> const& destination : destinations_) {
    destination->ClearCachedNames();
  }
}

}  // namespace Ostinet::Impl

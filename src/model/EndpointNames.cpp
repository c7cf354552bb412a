// SPDX-License-Identifier: MIT
//
// EndpointImpl: the names to show, built from those of device, entity and endpoint.
//
// A part of a device says no more than is needed to tell it from its siblings: a lone port bears
// the device's name alone. So a name depends on how many siblings there are, and is kept until
// those change.
#include <algorithm>

#include "model/DeviceImpl.h"
#include "model/EndpointImpl.h"
#include "model/EntityImpl.h"
#include "model/PropertyKeys.h"

namespace Ostinet::Impl {

namespace {

// -1 for an endpoint that is not in the list.
template <class List>
int IndexOf(List const& list, EndpointImpl const* endpoint) {
  auto const place = std::find_if(list.begin(), list.end(),
                                  [=](auto const& member) { return member.get() == endpoint; });
  return place != list.end() ? static_cast<int>(place - list.begin()) : -1;
}

UString InBrackets(int number) {
  UString text;
  text.Stream() << " (" << number << ")";
  return text;
}

}  // namespace

EndpointImpl::Place EndpointImpl::FindPlace() const {
  Place place;
  if (EntityImpl const* const entity = kind_.entity) {
    place.index = IndexOf(entity->GetSources(), this);
    if (place.index >= 0) {
      place.hasSiblings = entity->GetSources().size() > 1;
      return place;
    }
    place.index = IndexOf(entity->GetDestinations(), this);
    place.hasSiblings = place.index >= 0 && entity->GetDestinations().size() > 1;
  }
  return place;
}

UString const& EndpointImpl::NameToShow() const {
  if (!name_) {
    name_ = BuildName();
  }
  return *name_;
}

UString EndpointImpl::BuildName() const {
  UString name;
  DeviceImpl const* const device = kind_.entity != nullptr ? kind_.entity->GetDevice() : nullptr;
  if (device != nullptr && device->Peer()->GetString(Keys::kName, name)) {
    Place const place = FindPlace();
    bool const hasManyEntities = device->GetEntities().size() > 1;
    if (hasManyEntities || place.hasSiblings) {
      // Through the peers, so that a part without a name bears its parent's.
      UString const entityName = kind_.entity->GetString(Keys::kName);
      UString const ownName = GetString(Keys::kName);
      bool const isNamedAsEntity = ownName == entityName;
      if (hasManyEntities && (place.hasSiblings || isNamedAsEntity) && entityName != name) {
        name += " " + entityName;
      }
      if (!isNamedAsEntity) {
        name += " " + ownName;
      } else if (place.hasSiblings) {
        name += InBrackets(place.index + 1);
      }
    }
  }
  return name.empty() ? GetString(Keys::kName) : name;
}

UString EndpointImpl::GetEntityAndEndpointName() const {
  if (!entityAndEndpointName_) {
    entityAndEndpointName_ = BuildEntityAndEndpointName();
  }
  return *entityAndEndpointName_;
}

// Always the number, never the endpoint's own name: hosts' stored menus hold texts of this form.
UString EndpointImpl::BuildEntityAndEndpointName() const {
  UString name;
  if (kind_.entity == nullptr || !kind_.entity->Peer()->GetString(Keys::kName, name)) {
    return GetString(Keys::kName);
  }
  Place const place = FindPlace();
  return place.hasSiblings ? name + InBrackets(place.index + 1) : name;
}

void EndpointImpl::ClearCachedNames() {
  name_ = boost::none;
  entityAndEndpointName_ = boost::none;
}

}  // namespace Ostinet::Impl

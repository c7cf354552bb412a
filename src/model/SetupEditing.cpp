// SPDX-License-Identifier: MIT
//
// Setup: what the host creates and deletes. Making is the backend's; here stands who may.
#include <algorithm>

#include "model/SetupState.h"

namespace Ostinet {

using Impl::ImplOf;

namespace {

bool MayEdit(DeviceObject const& object) { return object.Exists() && !object.IsDirect(); }

}  // namespace

Device Setup::CreateDevice(UString const& name) {
  Impl::DeviceTypeInfoImpl* const noType = nullptr;
  return PlatformCreateDevice(noType, MakeUniqueDevName(name));
}

Device Setup::CreateDevice(XMLLib::Parser& parser) { return PlatformCreateDevice(parser); }

Entity Setup::CreateEntity(Device const& device, UString const& name, int sources,
                           int destinations) {
  if (!MayEdit(device)) {
    return Entity();
  }
  RCPtrMT<Impl::DeviceImpl> impl(ImplOf(device));
  return PlatformCreateEntity(impl, name, std::max(sources, 0), std::max(destinations, 0));
}

void Setup::DeleteDevice(Device const& device) {
  if (!device.Exists() || (device.IsDirect() && device.IsOnline())) {
    return;
  }
  RCPtrMT<Impl::DeviceImpl> impl(ImplOf(device));
  PlatformWillDeleteDevice(impl);
  RemoveDevice(impl);
}

void Setup::DeleteEntity(Entity const& entity) {
  if (MayEdit(entity)) {
    RCPtrMT<Impl::EntityImpl> impl(ImplOf(entity));
    PlatformWillDeleteEntity(impl);
    RemoveEntity(impl);
  }
}

void Setup::SetEntitySources(Entity const& entity, int count) {
  if (MayEdit(entity)) {
    RCPtrMT<Impl::EntityImpl> impl(ImplOf(entity));
    PlatformSetEntitySources(impl, std::max(count, 0));
  }
}

void Setup::SetEntityDestinations(Entity const& entity, int count) {
  if (MayEdit(entity)) {
    RCPtrMT<Impl::EntityImpl> impl(ImplOf(entity));
    PlatformSetEntityDestinations(impl, std::max(count, 0));
  }
}

std::pair<Source, Destination> Setup::CreateVirtualEndpoint(UString const& name, SrcOrDest source,
                                                            SrcOrDest destination) {
  auto const pair = PlatformCreateVirtualEndpoint(name, 0, source, destination);
  return {Source(pair.first), Destination(pair.second)};
}

void Setup::DeleteVirtualEndpoint(Endpoint const& endpoint) {
  if (!endpoint.Exists() || !endpoint.IsVirtual()) {
    return;
  }
  Impl::EndpointImpl* const one = ImplOf(endpoint);
  Impl::EndpointImpl* const other = one->GetMatchingVirtual();
  RCPtrMT<Impl::EndpointImpl> source(one->IsDestination() ? other : one);
  RCPtrMT<Impl::DestinationImpl> destination(
      Impl::AsDestination(one->IsDestination() ? one : other));
  PlatformDeleteVirtualEndpoint(source, destination);
  RemoveSource(source);
  RemoveDestination(destination);
}

void Setup::DeleteBareEndpoint(Endpoint const& endpoint) {
  if (!endpoint.Exists() || !endpoint.IsDirect() || endpoint.IsOnline() ||
      endpoint.GetEntity().Exists()) {
    return;
  }
  RCPtrMT<Impl::EndpointImpl> impl(ImplOf(endpoint));
  PlatformWillDeleteBareEndpoint(impl);
  if (Impl::DestinationImpl* const destination = Impl::AsDestination(impl.get())) {
    RemoveDestination(destination);
  } else {
    RemoveSource(impl);
  }
}

namespace {

// What goes was mostly added last, so the search starts there.
template <class T>
void Erase(std::vector<RCPtrMT<T>>& list, RCPtrMT<T> const& object) {
  auto const place = std::find(list.rbegin(), list.rend(), object);
  if (place != list.rend()) {
    list.erase(std::next(place).base());
  }
}

}  // namespace

void Setup::RemoveDevice(RCPtrMT<Impl::DeviceImpl> device) {
  if (device.get() == nullptr) {
    return;
  }
  Erase(GetStudio().devices, device);
  Impl::DeviceImpl::Entities const entities = device->GetEntities();
  std::for_each(entities.rbegin(), entities.rend(),
                [this](RCPtrMT<Impl::EntityImpl> const& entity) { RemoveEntity(entity); });
  device->Deactivate(false);
}

void Setup::RemoveEntity(RCPtrMT<Impl::EntityImpl> entity) {
  if (entity.get() == nullptr) {
    return;
  }
  Erase(GetStudio().entities, entity);
  Impl::EntityImpl::Sources const sources = entity->GetSources();
  std::for_each(sources.rbegin(), sources.rend(),
                [this](RCPtrMT<Impl::EndpointImpl> const& source) { RemoveSource(source); });
  Impl::EntityImpl::Destinations const destinations = entity->GetDestinations();
  std::for_each(destinations.rbegin(), destinations.rend(),
                [this](RCPtrMT<Impl::DestinationImpl> const& destination) {
                  RemoveDestination(destination);
                });
  entity->Deactivate(false);
}

void Setup::RemoveSource(RCPtrMT<Impl::EndpointImpl> source) {
  if (source.get() == nullptr) {
    return;
  }
  Erase(GetStudio().sources, source);
  Erase(GetStudio().privateSources, source);
  source->Deactivate(false);
}

void Setup::RemoveDestination(RCPtrMT<Impl::DestinationImpl> destination) {
  if (destination.get() == nullptr) {
    return;
  }
  if (Impl::DestinationNames* const names = destination->GetNames()) {
    names->WillRemove();
  }
  Erase(GetStudio().destinations, destination);
  Erase(GetStudio().privateDestinations, destination);
  destination->Deactivate(false);
}

}  // namespace Ostinet

// SPDX-License-Identifier: MIT
#include "StudioView.h"

#include <type_traits>

#include "ostinet/Setup.h"

namespace Ostinet::Tool {
namespace {

std::string Text(UString const& text) { return text.string(); }

// What sources and destinations name differently.
Source DirectOf(Source const& source) { return source.GetDirectSource(); }
Destination DirectOf(Destination const& destination) { return destination.GetDirectDestination(); }
int CountConnected(Source const& source) { return source.CountConnectedSources(); }
int CountConnected(Destination const& port) { return port.CountConnectedDestinations(); }
Source ConnectedOf(Source const& source, int i) { return source.GetConnectedSource(i); }
Destination ConnectedOf(Destination const& port, int i) { return port.GetConnectedDestination(i); }

EndpointView ViewPlainEndpoint(Endpoint const& endpoint) {
  EndpointView view;
  view.key = endpoint.GetKey();
  view.name = Text(endpoint.GetName());
  view.uniqueID = endpoint.GetUniqueID();
  view.direct = endpoint.IsDirect();
  view.online = endpoint.IsOnline();
  view.software = endpoint.IsSoftware();
  view.internalSoftware = endpoint.IsInternalSoftware();
  view.isVirtual = endpoint.IsVirtual();
  view.isPrivate = endpoint.IsPrivate();
  view.channels = endpoint.GetChannels();
  if (auto const isInterface = endpoint.IsInterface()) {
    view.isInterface = *isInterface;
  }
  view.scheduleAheadMuSec = endpoint.GetAdvanceScheduleMicroseconds();
  return view;
}

template <class EndpointHandle>
EndpointView ViewEndpoint(EndpointHandle const& endpoint) {
  EndpointView view = ViewPlainEndpoint(endpoint);
  view.isSource = std::is_same_v<EndpointHandle, Source>;
  if (auto const direct = DirectOf(endpoint); direct.GetImplPtr() != nullptr) {
    view.port = Text(direct.GetName());
    view.portKey = direct.GetKey();
  }
  for (int i = 0; i < CountConnected(endpoint); ++i) {
    view.connected.push_back(Text(ConnectedOf(endpoint, i).GetName()));
  }
  return view;
}

// `get(i)` for each i below `count`, into views.
template <class Get>
auto ViewEach(int count, Get get) {
  std::vector<decltype(get(0))> views;
  for (int i = 0; i < count; ++i) {
    views.push_back(get(i));
  }
  return views;
}

EntityView ViewEntity(Entity const& entity) {
  EntityView view;
  view.key = entity.GetKey();
  view.name = Text(entity.GetName());
  view.uniqueID = entity._get_impl_id();
  view.online = entity.IsOnline();
  view.sources =
      ViewEach(entity.CountSources(), [&](int i) { return ViewEndpoint(entity.GetSource(i)); });
  view.destinations = ViewEach(entity.CountDestinations(),
                               [&](int i) { return ViewEndpoint(entity.GetDestination(i)); });
  return view;
}

DeviceView ViewDevice(Device const& device) {
  DeviceView view;
  view.key = device.GetKey();
  view.name = Text(device.GetName());
  view.uniqueID = device._get_impl_id();
  view.manufacturer = Text(device.GetManufacturer());
  view.model = Text(device.GetModel());
  view.direct = device.IsDirect();
  view.online = device.IsOnline();
  view.entities =
      ViewEach(device.CountEntities(), [&](int i) { return ViewEntity(device.GetEntity(i)); });
  return view;
}

template <class EndpointHandle>
void AddWithoutEntity(EndpointHandle const& endpoint, std::vector<EndpointView>& views) {
  if (endpoint.GetEntity().GetImplPtr() == nullptr) {
    views.push_back(ViewEndpoint(endpoint));
  }
}

}  // namespace

StudioView ViewStudio(Setup const& setup) {
  StudioView view;
  view.devices =
      ViewEach(setup.CountDevices(), [&](int i) { return ViewDevice(setup.GetDevice(i)); });
  for (int i = 0; i < setup.CountSources(); ++i) {
    AddWithoutEntity(setup.GetSource(i), view.sources);
  }
  for (int i = 0; i < setup.CountPrivateSources(); ++i) {
    AddWithoutEntity(setup.GetPrivateSource(i), view.sources);
  }
  for (int i = 0; i < setup.CountDestinations(); ++i) {
    AddWithoutEntity(setup.GetDestination(i), view.destinations);
  }
  for (int i = 0; i < setup.CountPrivateDestinations(); ++i) {
    AddWithoutEntity(setup.GetPrivateDestination(i), view.destinations);
  }
  return view;
}

}  // namespace Ostinet::Tool

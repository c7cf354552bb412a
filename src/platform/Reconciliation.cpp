// SPDX-License-Identifier: MIT

#include "platform/Reconciliation.h"

#include <algorithm>
#include <utility>
#include <vector>

#include "model/DestinationImpl.h"
#include "model/PropertyKeys.h"
#include "platform/PortAttacher.h"
#include "platform/WinMIDISetup.h"

namespace Ostinet::Impl {

namespace {

// Sorted by name, each name once. A studio may have ten thousand of them, so they stand side by
// side and their names are made once.
template <class Thing>
struct Named {
  UString name;
  Thing thing;
};
using PortsByName = std::vector<Named<PortInfo const*>>;
using EndpointsByName = std::vector<Named<EndpointImpl*>>;

/// Of two things of one name the later one counts.
template <class List>
void SortByName(List& list) {
  std::stable_sort(list.begin(), list.end(),
                   [](auto const& a, auto const& b) { return a.name < b.name; });
  auto const ofOneName = [](auto const& a, auto const& b) { return a.name == b.name; };
  list.erase(list.begin(), std::unique(list.rbegin(), list.rend(), ofOneName).base());
}

template <class Endpoints>
EndpointsByName ByName(Endpoints const& endpoints) {
  EndpointsByName result;
  result.reserve(endpoints.size());
  for (auto const& endpoint : endpoints) {
    if (endpoint->IsDirect() && !endpoint->IsVirtual() && !endpoint->IsInternalSoftware()) {
      result.push_back({endpoint->GetName(), endpoint.get()});
    }
  }
  SortByName(result);
  return result;
}

/// The endpoint's port is gone. True if it was online until now.
bool TakeOffline(EndpointImpl& endpoint) {
  int const wasOffline = endpoint.GetInt(Keys::kOffline, 0);
  if (WinMIDIPort* const port = WinMIDIPort::Of(endpoint)) {
    port->Detach();
  }
  if (wasOffline != 1 || endpoint.GetInt(Keys::kOffline, 0) != 1) {
    endpoint.Peer()->SetInt(Keys::kOffline, 1);
  }
  return wasOffline == 0;
}

/// Port and endpoint bear one name. A name that stays while the port changes its kind leaves
/// both untouched: hosts keep such an endpoint as it was until the port comes back.
bool Join(PortAttacher& attacher, PortInfo const& port, EndpointImpl& endpoint) {
  if (!PortAttacher::IsPair(endpoint, port)) {
    return false;
  }
  WinMIDIPort* const peer = WinMIDIPort::Of(endpoint);
  bool const isDetached = peer != nullptr && peer->GetActiveImpl() == nullptr;
  if (isDetached) {
    attacher.Attach(port);
  }
  endpoint.Peer()->SetInt(Keys::kOffline, 0);
  return isDetached;
}

bool Merge(PortAttacher& attacher, PortsByName const& ports, EndpointsByName const& endpoints) {
  bool changed = false;
  auto port = ports.begin();
  auto endpoint = endpoints.begin();
  while (port != ports.end() || endpoint != endpoints.end()) {
    bool const isNewPort =
        endpoint == endpoints.end() || (port != ports.end() && port->name < endpoint->name);
    if (isNewPort) {
      attacher.Attach(*port->thing);
      changed = true;
      ++port;
    } else if (port == ports.end() || endpoint->name < port->name) {
      changed |= TakeOffline(*endpoint->thing);
      ++endpoint;
    } else {
      changed |= Join(attacher, *port->thing, *endpoint->thing);
      ++port;
      ++endpoint;
    }
  }
  return changed;
}

}  // namespace

bool Reconcile(WinMIDISetup& setup, PortAttacher& attacher, PortList const& ports) {
  PortsByName newSources, newDestinations;
  for (PortInfo const& port : ports) {
    (IsSource(port) ? newSources : newDestinations).push_back({NameOfPort(port), &port});
  }
  SortByName(newSources);
  SortByName(newDestinations);
  EndpointsByName const sources = ByName(setup.Lists().sources);
  EndpointsByName const destinations = ByName(setup.Lists().destinations);
  bool const sourcesChanged = Merge(attacher, newSources, sources);
  bool const destinationsChanged = Merge(attacher, newDestinations, destinations);
  return sourcesChanged || destinationsChanged;
}

}  // namespace Ostinet::Impl

// SPDX-License-Identifier: MIT

#include "platform/Reconciliation.h"

#include <algorithm>
#include <cstddef>
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
  std::size_t order;  // in the list that it comes from
};
using PortsByName = std::vector<Named<PortInfo const*>>;
using EndpointsByName = std::vector<Named<EndpointImpl*>>;

/// Of two things of one name the later one counts.
template <class List>
void SortByName(List& list) {
  // Ties are told by their order, which spares the copy that a stable sort works on.
  std::sort(list.begin(), list.end(), [](auto const& a, auto const& b) {
    return a.name < b.name || (!(b.name < a.name) && a.order < b.order);
  });
  auto const ofOneName = [](auto const& a, auto const& b) { return a.name == b.name; };
  list.erase(list.begin(), std::unique(list.rbegin(), list.rend(), ofOneName).base());
}

template <class Endpoints>
EndpointsByName ByName(Endpoints const& endpoints) {
  EndpointsByName result;
  result.reserve(endpoints.size());
  for (auto const& endpoint : endpoints) {
    if (endpoint->IsDirect() && !endpoint->IsVirtual() && !endpoint->IsInternalSoftware()) {
      result.push_back({endpoint->GetName(), endpoint.get(), result.size()});
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

/// The endpoints that were found with their ports, each at its place in the studio's list. All get
/// their "offline" written, as hosts rely on, but in the order of the list and not of the names:
/// that is how they lie in memory.
class Present {
 public:
  explicit Present(std::size_t count) : endpoints_(count) {}
  void Add(Named<EndpointImpl*> const& endpoint) { endpoints_[endpoint.order] = endpoint.thing; }
  void SetOnline() {
    for (EndpointImpl* const endpoint : endpoints_) {
      if (endpoint != nullptr) {
        endpoint->Peer()->SetInt(Keys::kOffline, 0);
      }
    }
  }

 private:
  std::vector<EndpointImpl*> endpoints_;
};

/// Port and endpoint bear one name. A name that stays while the port changes its kind leaves
/// both untouched: hosts keep such an endpoint as it was until the port comes back.
bool Join(PortAttacher& attacher, PortInfo const& port, Named<EndpointImpl*> const& endpoint,
          Present& present) {
  if (!PortAttacher::IsPair(*endpoint.thing, port)) {
    return false;
  }
  WinMIDIPort* const peer = WinMIDIPort::Of(*endpoint.thing);
  bool const isDetached = peer != nullptr && peer->GetActiveImpl() == nullptr;
  if (isDetached) {
    attacher.Attach(port);
  }
  present.Add(endpoint);
  return isDetached;
}

bool Merge(PortAttacher& attacher, PortsByName const& ports, EndpointsByName const& endpoints,
           std::size_t count) {
  bool changed = false;
  Present present(count);
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
      changed |= Join(attacher, *port->thing, *endpoint, present);
      ++port;
      ++endpoint;
    }
  }
  present.SetOnline();
  return changed;
}

}  // namespace

bool Reconcile(WinMIDISetup& setup, PortAttacher& attacher, PortList const& ports) {
  PortsByName newSources, newDestinations;
  newSources.reserve(ports.size());
  newDestinations.reserve(ports.size());
  for (PortInfo const& port : ports) {
    PortsByName& list = IsSource(port) ? newSources : newDestinations;
    list.push_back({NameOfPort(port), &port, list.size()});
  }
  SortByName(newSources);
  SortByName(newDestinations);
  auto const& studio = setup.Lists();
  EndpointsByName const sources = ByName(studio.sources);
  EndpointsByName const destinations = ByName(studio.destinations);
  std::size_t const sourceCount = studio.sources.size();
  std::size_t const destinationCount = studio.destinations.size();
  bool const sourcesChanged = Merge(attacher, newSources, sources, sourceCount);
  bool const destinationsChanged = Merge(attacher, newDestinations, destinations, destinationCount);
  return sourcesChanged || destinationsChanged;
}

}  // namespace Ostinet::Impl

// SPDX-License-Identifier: MIT

#include "platform/Reconciliation.h"

#include <map>

#include "model/DestinationImpl.h"
#include "model/PropertyKeys.h"
#include "platform/PortAttacher.h"
#include "platform/WinMIDISetup.h"

namespace Ostinet::Impl {

namespace {

// Of two ports, or endpoints, of one name the later one counts.
using PortsByName = std::map<UString, PortInfo const*>;
using EndpointsByName = std::map<UString, RCPtrMT<EndpointImpl>>;

template <class Endpoints>
EndpointsByName ByName(Endpoints const& endpoints) {
  EndpointsByName result;
  for (auto const& endpoint : endpoints) {
    if (endpoint->IsDirect() && !endpoint->IsVirtual() && !endpoint->IsInternalSoftware()) {
      result[endpoint->GetName()] = endpoint;
    }
  }
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
        endpoint == endpoints.end() || (port != ports.end() && port->first < endpoint->first);
    if (isNewPort) {
      attacher.Attach(*port->second);
      changed = true;
      ++port;
    } else if (port == ports.end() || endpoint->first < port->first) {
      changed |= TakeOffline(*endpoint->second);
      ++endpoint;
    } else {
      changed |= Join(attacher, *port->second, *endpoint->second);
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
    (IsSource(port) ? newSources : newDestinations)[NameOfPort(port)] = &port;
  }
  EndpointsByName const sources = ByName(setup.Lists().sources);
  EndpointsByName const destinations = ByName(setup.Lists().destinations);
  bool const sourcesChanged = Merge(attacher, newSources, sources);
  bool const destinationsChanged = Merge(attacher, newDestinations, destinations);
  return sourcesChanged || destinationsChanged;
}

}  // namespace Ostinet::Impl

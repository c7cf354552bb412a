// SPDX-License-Identifier: MIT

#include "platform/Reconciliation.h"

#include <algorithm>
#include <functional>
#include <utility>
#include <vector>

#include "model/DestinationImpl.h"
#include "model/PropertyKeys.h"
#include "platform/PortAttacher.h"
#include "platform/WinMIDISetup.h"

namespace Ostinet::Impl {

namespace {

// A studio may have ten thousand ports of which one came or went. So ports and endpoints meet by
// the hash of their names, each endpoint is looked at once, and only what has to be done is put in
// the order of the names.

/// The ports of one direction. Of two of one name the later one counts.
class PortsByName {
 public:
  struct Entry {
    std::size_t hash;
    PortInfo const* port;
    bool isKnown = false;  // an endpoint bears its name
  };

  void Add(PortInfo const& port) {
    entries_.push_back({std::hash<UString>()(NameOfPort(port)), &port});
  }
  /// To be called once, when all are there.
  void Sort() {
    std::reverse(entries_.begin(), entries_.end());
    std::stable_sort(entries_.begin(), entries_.end(),
                     [](Entry const& a, Entry const& b) { return a.hash < b.hash; });
    auto const ofOneName = [](Entry const& a, Entry const& b) {
      return a.hash == b.hash && NameOfPort(*a.port) == NameOfPort(*b.port);
    };
    entries_.erase(std::unique(entries_.begin(), entries_.end(), ofOneName), entries_.end());
  }
  /// Null if there is none.
  Entry* Find(UString const& name) {
    std::size_t const hash = std::hash<UString>()(name);
    auto place = std::lower_bound(entries_.begin(), entries_.end(), hash,
                                  [](Entry const& entry, std::size_t h) { return entry.hash < h; });
    for (; place != entries_.end() && place->hash == hash; ++place) {
      if (NameOfPort(*place->port) == name) {
        return &*place;
      }
    }
    return nullptr;
  }
  std::vector<Entry> const& Entries() const { return entries_; }

 private:
  std::vector<Entry> entries_;
};

struct Step {
  UString name;
  PortInfo const* port;    // null: it is gone
  EndpointImpl* endpoint;  // null: there is none yet
};
using Steps = std::vector<Step>;

void SetOnline(EndpointImpl& endpoint) { endpoint.Peer()->SetInt(Keys::kOffline, 0); }

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
void Join(PortInfo const& port, EndpointImpl& endpoint, UString name, Steps& steps) {
  if (!PortAttacher::IsPair(endpoint, port)) {
    return;
  }
  WinMIDIPort const* const peer = WinMIDIPort::Of(endpoint);
  if (peer != nullptr && peer->GetActiveImpl() == nullptr) {
    steps.push_back({std::move(name), &port, &endpoint});
  } else {
    SetOnline(endpoint);  // written each time, as hosts rely on
  }
}

/// What has to be done in the order of the names. Of two endpoints of one name the later one
/// counts, so they are looked at from the end.
template <class Endpoints>
Steps FindSteps(PortsByName ports, Endpoints const& endpoints) {
  Steps steps;
  for (auto place = endpoints.rbegin(); place != endpoints.rend(); ++place) {
    EndpointImpl& endpoint = **place;
    if (!endpoint.IsDirect() || endpoint.IsVirtual() || endpoint.IsInternalSoftware()) {
      continue;
    }
    UString name = endpoint.GetName();
    PortsByName::Entry* const listed = ports.Find(name);
    if (listed == nullptr) {
      steps.push_back({std::move(name), nullptr, &endpoint});
    } else if (!std::exchange(listed->isKnown, true)) {
      Join(*listed->port, endpoint, std::move(name), steps);
    }
  }
  for (PortsByName::Entry const& listed : ports.Entries()) {
    if (!listed.isKnown) {
      steps.push_back({NameOfPort(*listed.port), listed.port, nullptr});
    }
  }
  std::stable_sort(steps.begin(), steps.end(),
                   [](Step const& a, Step const& b) { return a.name < b.name; });
  auto const ofOneName = [](Step const& a, Step const& b) { return a.name == b.name; };
  steps.erase(std::unique(steps.begin(), steps.end(), ofOneName), steps.end());
  return steps;
}

bool Take(Steps const& steps, PortAttacher& attacher) {
  bool changed = false;
  for (Step const& step : steps) {
    if (step.port == nullptr) {
      changed |= TakeOffline(*step.endpoint);
      continue;
    }
    changed = true;
    attacher.Attach(*step.port);
    if (step.endpoint != nullptr) {
      SetOnline(*step.endpoint);
    }
  }
  return changed;
}

}  // namespace

bool Reconcile(WinMIDISetup& setup, PortAttacher& attacher, PortList const& ports) {
  PortsByName newSources, newDestinations;
  for (PortInfo const& port : ports) {
    (IsSource(port) ? newSources : newDestinations).Add(port);
  }
  newSources.Sort();
  newDestinations.Sort();
  auto const& studio = setup.Lists();
  bool const sourcesChanged = Take(FindSteps(std::move(newSources), studio.sources), attacher);
  bool const destinationsChanged =
      Take(FindSteps(std::move(newDestinations), studio.destinations), attacher);
  return sourcesChanged || destinationsChanged;
}

}  // namespace Ostinet::Impl

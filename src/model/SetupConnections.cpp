// SPDX-License-Identifier: MIT
//
// Setup: connections as the properties tell them.
//
// A port stores the IDs of what hangs on it. For each, the first endpoint of that ID in list
// order that no port has claimed in this round joins it; so the first port in list order wins,
// and a number without an endpoint waits. The endpoints are indexed by ID once a round, in list
// order, so that a round over a large studio does not walk it once for every number.
#include <algorithm>
#include <cstddef>
#include <vector>

#include "model/PropertyKeys.h"
#include "model/SetupState.h"
#include "model/XMLNames.h"

namespace Ostinet {

namespace Keys = Impl::Keys;

namespace {

template <class T>
class Round {
 public:
  using List = std::vector<RCPtrMT<T>>;

  explicit Round(List const& list) {
    for (RCPtrMT<T> const& endpoint : list) {
      if (!endpoint->IsDirect()) {
        places_.push_back({endpoint->GetInt(Keys::kUniqueID, 0), &endpoint});
      }
    }
    std::stable_sort(places_.begin(), places_.end(),
                     [](Place const& a, Place const& b) { return a.id < b.id; });
  }

  /// Ties to `port` what its property names and `claim` lets it have.
  template <class Claim>
  void Connect(T& port, Claim const& claim) {
    ids_.clear();
    port.Peer()->GetIntList(Keys::kConnUniqueID, ids_);
    found_.clear();
    for (int const id : ids_) {
      if (T* const endpoint = Take(id, claim)) {
        found_.push_back(endpoint);
      }
    }
    port.SetConnections(found_);
  }

 private:
  struct Place {
    int id = 0;
    RCPtrMT<T> const* endpoint = nullptr;
    std::size_t taken = 0;  // of the first of an ID: how many of that ID were claimed in this round
  };

  template <class Claim>
  T* Take(int id, Claim const& claim) {
    auto const first =
        std::lower_bound(places_.begin(), places_.end(), id,
                         [](Place const& place, int wanted) { return place.id < wanted; });
    std::size_t const left = static_cast<std::size_t>(places_.end() - first);
    while (left > 0 && first->taken < left) {
      Place const& place = first[static_cast<std::ptrdiff_t>(first->taken)];
      if (place.id != id) {
        break;
      }
      ++first->taken;
      if (claim(*place.endpoint)) {
        return place.endpoint->get();
      }
    }
    return nullptr;
  }

  std::vector<Place> places_;  // by unique ID, and in list order
  std::vector<int> ids_;
  std::vector<Impl::EndpointImpl*> found_;
};

template <class T>
void ConnectAll(std::vector<RCPtrMT<T>> const& list) {
  Round<T> round(list);
  for (RCPtrMT<T> const& endpoint : list) {
    if (endpoint->HasConnections()) {
      round.Connect(*endpoint, [](RCPtrMT<T> const&) { return true; });
    }
  }
}

template <class T, class Used>
void ConnectOne(std::vector<RCPtrMT<T>> const& list, T& port, Used& used) {
  Round<T>(list).Connect(port,
                         [&](RCPtrMT<T> const& endpoint) { return used.insert(endpoint).second; });
}

// What an imported endpoint says of the port that it hung on.
struct PortDescription {
  UString name;
  UString manufacturer;
  UString model;

  bool Read(XMLLib::Parser const& parser) {
    return parser.ReadReqAttribute(Impl::XMLNames::kName, name) &&
           parser.ReadReqAttribute(Impl::XMLNames::kManufacturer, manufacturer) &&
           parser.ReadReqAttribute(Impl::XMLNames::kModel, model);
  }
  bool Fits(Impl::EndpointImpl const& endpoint) const {
    return endpoint.HasConnections() && endpoint.GetName() == name &&
           endpoint.GetString(Keys::kManufacturer) == manufacturer &&
           endpoint.GetString(Keys::kModel) == model;
  }
};

template <class List>
Impl::EndpointImpl* FindPort(List const& list, PortDescription const& wanted) {
  auto const place = std::find_if(list.begin(), list.end(),
                                  [&](auto const& endpoint) { return wanted.Fits(*endpoint); });
  return place != list.end() ? place->get() : nullptr;
}

}  // namespace

void Setup::UpdateConnections() {
  ConnectAll(GetStudio().sources);
  ConnectAll(GetStudio().destinations);
}

void Setup::UpdateSourceConnections(
    RCPtrMT<Impl::EndpointImpl> const& source,
    sorted_vector_set<RCPtrMT<Impl::EndpointImpl>, std::less<RCPtrMT<Impl::EndpointImpl>>>& used) {
  ConnectOne(GetStudio().sources, *source, used);
}

void Setup::UpdateDestConnections(
    RCPtrMT<Impl::DestinationImpl> const& destination,
    sorted_vector_set<RCPtrMT<Impl::DestinationImpl>, std::less<RCPtrMT<Impl::DestinationImpl>>>&
        used) {
  ConnectOne(GetStudio().destinations, *destination, used);
}

void Setup::HandleImportConnection(XMLLib::Parser& parser, Impl::ImplImpl& peer, bool isSource) {
  PortDescription wanted;
  int id = 0;
  if (!wanted.Read(parser) || !peer.GetInt(Keys::kUniqueID, id)) {
    return;
  }
  Impl::EndpointImpl* const port =
      isSource ? FindPort(GetStudio().sources, wanted) : FindPort(GetStudio().destinations, wanted);
  if (port == nullptr) {
    return;
  }
  std::vector<int> ids;
  port->Peer()->GetIntList(Keys::kConnUniqueID, ids);
  ids.push_back(id);
  port->Peer()->SetIntList(Keys::kConnUniqueID, ids);
  peer.SetIntList(Keys::kConnUniqueID, std::vector<int>(1, port->GetInt(Keys::kUniqueID, 0)));
}

}  // namespace Ostinet

// SPDX-License-Identifier: MIT
#include <algorithm>

#include "ostinet/Setup.h"

namespace Ostinet {

namespace {

using EndpointFilters = std::vector<ObjectFilter<Endpoint>>;

// A filter may change the studio while the snapshot is taken, so the count is asked for anew.
template <class List, class Filter, class Handle>
void Fill(List& list, Filter const& filter, int (Setup::*count)() const,
          Handle (Setup::*get)(int) const) {
  Setup const& setup = Setup::Instance();
  list.clear();
  for (int i = 0; i < (setup.*count)(); ++i) {
    Handle const handle = (setup.*get)(i);
    if (filter(handle)) {
      list.push_back(handle);
    }
  }
}

// Each partition keeps the order within its two groups, so the one made last, by the first
// filter, weighs most.
template <class List>
void SortBy(List& list, EndpointFilters const& filters) {
  std::sort(list.begin(), list.end(), CompMIDIEndpointNames);
  std::for_each(filters.rbegin(), filters.rend(), [&](ObjectFilter<Endpoint> const& filter) {
    std::stable_partition(list.begin(), list.end(),
                          [&](Endpoint const& endpoint) { return filter(endpoint); });
  });
}

void FillDefaults(EndpointFilters& filters) {
  if (filters.empty()) {
    filters.push_back(OnlineEndpoint() & DefinitelyNonInterfaceEndpoint());
    filters.push_back(DefinitelyNonInterfaceEndpoint());
    filters.push_back(DefinitelyInterfaceEndpoint());
  }
}

}  // namespace

EndpointFilters DestinationList::sDefaultSortFilters;
EndpointFilters SourceList::sDefaultSortFilters;

DestinationList::DestinationList() { FillDefaults(sDefaultSortFilters); }

DestinationList::DestinationList(ObjectFilter<Endpoint> const& filter) : DestinationList() {
  Reset(filter);
}

void DestinationList::Reset(ObjectFilter<Endpoint> const& filter) {
  Fill(*this, filter, &Setup::CountDestinations, &Setup::GetDestination);
}

void DestinationList::Sort(EndpointFilters& filters) { SortBy(*this, filters); }

SourceList::SourceList() { FillDefaults(sDefaultSortFilters); }

SourceList::SourceList(ObjectFilter<Endpoint> const& filter) : SourceList() { Reset(filter); }

void SourceList::Reset(ObjectFilter<Endpoint> const& filter) {
  Fill(*this, filter, &Setup::CountSources, &Setup::GetSource);
}

void SourceList::Sort(EndpointFilters& filters) { SortBy(*this, filters); }

DeviceList::DeviceList() = default;

DeviceList::DeviceList(ObjectFilter<Device> const& filter) { Reset(filter); }

void DeviceList::Reset(ObjectFilter<Device> const& filter) {
  Fill(*this, filter, &Setup::CountDevices, &Setup::GetDevice);
}

}  // namespace Ostinet

// SPDX-License-Identifier: MIT
#include <algorithm>

#include "StudioView.h"

namespace Ostinet::Tool {
namespace {

template <class Element, class Predicate>
void Drop(std::vector<Element>& elements, Predicate unwanted) {
  elements.erase(std::remove_if(elements.begin(), elements.end(), unwanted), elements.end());
}

void FilterEndpoints(std::vector<EndpointView>& endpoints, bool wanted, bool onlyConnected) {
  Drop(endpoints, [&](EndpointView const& endpoint) {
    bool const connected = endpoint.port.has_value() || !endpoint.connected.empty();
    return !wanted || (onlyConnected && !connected);
  });
}

}  // namespace

StudioView Filtered(StudioView view, ViewFilter const& filter) {
  bool const all = filter.sources && filter.destinations && !filter.onlyConnected;
  for (DeviceView& device : view.devices) {
    for (EntityView& entity : device.entities) {
      FilterEndpoints(entity.sources, filter.sources, filter.onlyConnected);
      FilterEndpoints(entity.destinations, filter.destinations, filter.onlyConnected);
    }
    Drop(device.entities, [&](EntityView const& entity) {
      return !all && entity.sources.empty() && entity.destinations.empty();
    });
  }
  Drop(view.devices, [&](DeviceView const& device) { return !all && device.entities.empty(); });
  FilterEndpoints(view.sources, filter.sources && filter.withoutEntity, filter.onlyConnected);
  FilterEndpoints(view.destinations, filter.destinations && filter.withoutEntity,
                  filter.onlyConnected);
  return view;
}

}  // namespace Ostinet::Tool

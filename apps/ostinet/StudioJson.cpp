// SPDX-License-Identifier: MIT

#include "JsonText.h"
#include "StudioText.h"

// The keys are a promise to scripts: docs/tool.md lists them, and more may come, but none goes.

namespace Ostinet::Tool {
namespace {

template <class View, class ToJson>
Json Array(std::vector<View> const& views, ToJson toJson) {
  Json array = Json::array();
  for (View const& view : views) {
    array.push_back(toJson(view));
  }
  return array;
}

Json PlayingJson(PlayingView const& patch) {
  return {{"channel", patch.channel}, {"number", patch.number}, {"name", patch.name}};
}

Json EndpointJson(EndpointView const& endpoint) {
  return {{"name", endpoint.name},
          {"uniqueID", endpoint.uniqueID},
          {"direct", endpoint.direct},
          {"online", endpoint.online},
          {"software", endpoint.software},
          {"internalSoftware", endpoint.internalSoftware},
          {"virtual", endpoint.isVirtual},
          {"private", endpoint.isPrivate},
          {"channels", endpoint.channels},
          {"isInterface", endpoint.isInterface ? Json(*endpoint.isInterface) : Json()},
          {"scheduleAheadMuSec", endpoint.scheduleAheadMuSec},
          {"port", endpoint.port ? Json(*endpoint.port) : Json()},
          {"connected", endpoint.connected},
          {"playing", Array(endpoint.playing, PlayingJson)}};
}

Json EntityJson(EntityView const& entity) {
  return {{"name", entity.name},
          {"uniqueID", entity.uniqueID},
          {"sources", Array(entity.sources, EndpointJson)},
          {"destinations", Array(entity.destinations, EndpointJson)}};
}

Json DeviceJson(DeviceView const& device) {
  return {{"name", device.name},
          {"uniqueID", device.uniqueID},
          {"manufacturer", device.manufacturer},
          {"model", device.model},
          {"direct", device.direct},
          {"online", device.online},
          {"entities", Array(device.entities, EntityJson)}};
}

}  // namespace

std::string StudioJSON(StudioView const& view) {
  Json const studio = {{"devices", Array(view.devices, DeviceJson)},
                       {"sources", Array(view.sources, EndpointJson)},
                       {"destinations", Array(view.destinations, EndpointJson)}};
  return JsonText(studio);
}

}  // namespace Ostinet::Tool

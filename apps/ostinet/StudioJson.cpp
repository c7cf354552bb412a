// SPDX-License-Identifier: MIT

#include "StudioJson.h"

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

class Tree {
 public:
  explicit Tree(StoredProperties const& properties) : properties_(properties) {}

  Json Endpoints(std::vector<EndpointView> const& endpoints) const {
    return Array(endpoints, [this](EndpointView const& endpoint) { return OfEndpoint(endpoint); });
  }
  Json Devices(std::vector<DeviceView> const& devices) const {
    return Array(devices, [this](DeviceView const& device) { return OfDevice(device); });
  }

 private:
  Json OfEndpoint(EndpointView const& endpoint) const {
    return WithProperties(
        endpoint.key, {{"name", endpoint.name},
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
                       {"playing", Array(endpoint.playing, PlayingJson)}});
  }

  Json OfEntity(EntityView const& entity) const {
    return WithProperties(entity.key, {{"name", entity.name},
                                       {"uniqueID", entity.uniqueID},
                                       {"sources", Endpoints(entity.sources)},
                                       {"destinations", Endpoints(entity.destinations)}});
  }

  Json OfDevice(DeviceView const& device) const {
    return WithProperties(device.key,
                          {{"name", device.name},
                           {"uniqueID", device.uniqueID},
                           {"manufacturer", device.manufacturer},
                           {"model", device.model},
                           {"direct", device.direct},
                           {"online", device.online},
                           {"entities", Array(device.entities, [this](EntityView const& entity) {
                              return OfEntity(entity);
                            })}});
  }

  Json WithProperties(unsigned long long key, Json object) const {
    auto const found = properties_.find(key);
    if (found != properties_.end()) {
      object["properties"] = found->second;
    }
    return object;
  }

  StoredProperties const& properties_;
};

}  // namespace

Json StudioTree(StudioView const& view, StoredProperties const& properties) {
  Tree const tree(properties);
  return {{"devices", tree.Devices(view.devices)},
          {"sources", tree.Endpoints(view.sources)},
          {"destinations", tree.Endpoints(view.destinations)}};
}

std::string StudioJSON(StudioView const& view) { return JsonText(StudioTree(view, {})); }

}  // namespace Ostinet::Tool

// SPDX-License-Identifier: MIT
#include "StudioChanges.h"

#include <algorithm>
#include <map>

#include "JsonText.h"
#include "StudioText.h"

namespace Ostinet::Tool {
namespace {

// An element of the studio, whatever it is, with the facts whose change is told.
struct Item {
  unsigned long long key = 0;
  std::string kind;
  std::string name;
  int uniqueID = 0;
  bool online = false;
  std::string otherFacts;  // Told as one "changed".
  std::vector<std::string> connected;
};

Item ItemOf(EndpointView const& endpoint) {
  Item item{endpoint.key,      endpoint.isSource ? "source" : "destination",
            endpoint.name,     endpoint.uniqueID,
            endpoint.online,   {},
            endpoint.connected};
  int const interfaceFact = endpoint.isInterface ? int{*endpoint.isInterface} : -1;
  item.otherFacts = std::to_string(endpoint.channels) + "/" +
                    std::to_string(endpoint.scheduleAheadMuSec) + "/" +
                    std::to_string(interfaceFact);
  return item;
}

Item ItemOf(DeviceView const& device) {
  return {device.key,
          "device",
          device.name,
          device.uniqueID,
          device.online,
          device.manufacturer + "/" + device.model + "/" + std::to_string(device.entities.size()),
          {}};
}

std::vector<Item> ItemsOf(StudioView const& view) {
  std::vector<Item> items;
  auto const add = [&](auto const& views) {
    for (auto const& element : views) {
      items.push_back(ItemOf(element));
    }
  };
  add(view.devices);
  for (DeviceView const& device : view.devices) {
    for (EntityView const& entity : device.entities) {
      add(entity.sources);
      add(entity.destinations);
    }
  }
  add(view.sources);
  add(view.destinations);
  return items;
}

std::map<unsigned long long, Item> ByKey(std::vector<Item> const& items) {
  std::map<unsigned long long, Item> map;
  for (Item const& item : items) {
    map.emplace(item.key, item);
  }
  return map;
}

Change Event(std::string event, Item const& item) {
  Change change;
  change.event = std::move(event);
  change.kind = item.kind;
  change.name = item.name;
  change.uniqueID = item.uniqueID;
  return change;
}

bool Has(std::vector<std::string> const& names, std::string const& name) {
  return std::find(names.begin(), names.end(), name) != names.end();
}

// An event for each of `names` that is not in `others`.
void AddLinks(std::string const& event, Item const& item, std::vector<std::string> const& names,
              std::vector<std::string> const& others, std::vector<Change>& changes) {
  for (std::string const& name : names) {
    if (!Has(others, name)) {
      changes.push_back(Event(event, item));
      changes.back().with = name;
    }
  }
}

void CompareItem(Item const& before, Item const& after, std::vector<Change>& changes) {
  if (before.name != after.name) {
    changes.push_back(Event("renamed", after));
    changes.back().was = before.name;
  }
  if (before.online != after.online) {
    changes.push_back(Event(after.online ? "online" : "offline", after));
  }
  AddLinks("disconnected", after, before.connected, after.connected, changes);
  AddLinks("connected", after, after.connected, before.connected, changes);
  if (before.otherFacts != after.otherFacts || before.uniqueID != after.uniqueID) {
    changes.push_back(Event("changed", after));
  }
}

}  // namespace

std::vector<Change> FindChanges(StudioView const& before, StudioView const& after) {
  std::vector<Item> const oldItems = ItemsOf(before);
  std::vector<Item> const newItems = ItemsOf(after);
  auto const oldByKey = ByKey(oldItems);
  auto const newByKey = ByKey(newItems);
  std::vector<Change> changes;
  for (Item const& item : oldItems) {
    if (newByKey.count(item.key) == 0) {
      changes.push_back(Event("removed", item));
    }
  }
  for (Item const& item : newItems) {
    if (oldByKey.count(item.key) == 0) {
      changes.push_back(Event("added", item));
    }
  }
  for (Item const& item : newItems) {
    auto const old = oldByKey.find(item.key);
    if (old != oldByKey.end()) {
      CompareItem(old->second, item, changes);
    }
  }
  return changes;
}

std::string ChangeText(Change const& change) {
  std::string event = change.event;
  event.resize(std::max<size_t>(event.size() + 1, 13), ' ');
  std::string kind = change.kind;
  kind.resize(std::max<size_t>(kind.size() + 1, 12), ' ');
  std::string text = event + kind + change.name;
  text += change.was ? "  (was " + *change.was + ")" : "";
  text += change.with ? "  (" + *change.with + ")" : "";
  for (PlayingView const& patch : change.playing) {
    text += "  (" + PlayingText(patch) + ")";
  }
  text += change.mask ? "  (channels " + ChannelsText(*change.mask) + ")" : "";
  return text;
}

std::string ChangeJSON(Change const& change) {
  Json json = {{"event", change.event},
               {"kind", change.kind},
               {"name", change.name},
               {"uniqueID", change.uniqueID}};
  if (change.was) {
    json["was"] = *change.was;
  }
  if (change.with) {
    json["with"] = *change.with;
  }
  for (PlayingView const& patch : change.playing) {
    json["playing"].push_back(
        {{"channel", patch.channel}, {"number", patch.number}, {"name", patch.name}});
  }
  if (change.mask) {
    json["channels"] = *change.mask;
  }
  return JsonLine(json);
}

}  // namespace Ostinet::Tool

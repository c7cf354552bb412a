// SPDX-License-Identifier: MIT
#include <map>

#include "StudioView.h"
#include "ostinet/NamesCatalog.h"
#include "ostinet/Setup.h"

namespace Ostinet::Tool {
namespace {

using DestinationsByKey = std::map<unsigned long long, Destination>;

void AddPlayingTo(std::vector<EndpointView>& views, DestinationsByKey const& destinations) {
  for (EndpointView& view : views) {
    auto const place = destinations.find(view.key);
    if (place != destinations.end()) {
      view.playing = ViewPlaying(place->second, view.channels);
    }
  }
}

}  // namespace

std::vector<PlayingView> ViewPlaying(Destination const& destination, unsigned short channels) {
  std::vector<PlayingView> playing;
  for (short channel = 0; channel < 16; ++channel) {
    Patch const patch = destination.GetCurrentPatch(channel);
    if ((channels >> channel & 1) != 0 && patch.GetImplPtr() != nullptr) {
      playing.push_back({channel + 1, patch.GetNumber().string(), patch.GetName().string()});
    }
  }
  return playing;
}

void AddPlaying(StudioView& view, Setup const& setup) {
  DestinationsByKey destinations;
  for (int i = 0; i < setup.CountDestinations(); ++i) {
    destinations.emplace(setup.GetDestination(i).GetKey(), setup.GetDestination(i));
  }
  AddPlayingTo(view.destinations, destinations);
  for (DeviceView& device : view.devices) {
    for (EntityView& entity : device.entities) {
      AddPlayingTo(entity.destinations, destinations);
    }
  }
}

}  // namespace Ostinet::Tool

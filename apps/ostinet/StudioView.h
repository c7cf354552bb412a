// SPDX-License-Identifier: MIT
#pragma once

#include <optional>
#include <string>
#include <vector>

namespace Ostinet {
class Destination;
class Setup;
}  // namespace Ostinet

namespace Ostinet::Tool {

// The studio as plain values, taken at one moment. Listings, JSON and the search for changes all
// read this, so the walk over the model is made in one place. Texts are UTF-8.

/// The patch on a channel.
struct PlayingView {
  int channel = 0;  ///< 1 to 16
  std::string number;
  std::string name;

  bool operator==(PlayingView const&) const = default;
};

struct EndpointView {
  unsigned long long key = 0;  ///< the same for the same object as long as the program runs
  bool isSource = false;
  std::string name;
  int uniqueID = 0;
  bool direct = false;
  bool online = false;
  bool software = false;
  bool internalSoftware = false;
  bool isVirtual = false;
  bool isPrivate = false;
  unsigned short channels = 0;  ///< bit 0 is channel 1
  std::optional<bool> isInterface;
  int scheduleAheadMuSec = 0;
  std::optional<std::string> port;     ///< of an instrument: the port that it hangs on
  unsigned long long portKey = 0;      ///< that port's key
  std::vector<std::string> connected;  ///< of a port: what hangs on it
  std::vector<PlayingView> playing;    ///< of a destination: what AddPlaying found

  bool operator==(EndpointView const&) const = default;
};

struct EntityView {
  unsigned long long key = 0;
  std::string name;
  int uniqueID = 0;
  bool online = false;
  std::vector<EndpointView> sources;
  std::vector<EndpointView> destinations;
};

struct DeviceView {
  unsigned long long key = 0;
  std::string name;
  int uniqueID = 0;
  std::string manufacturer;
  std::string model;
  bool direct = false;
  bool online = false;
  std::vector<EntityView> entities;
};

struct StudioView {
  std::vector<DeviceView> devices;
  std::vector<EndpointView> sources;       ///< those without an entity, public ones first
  std::vector<EndpointView> destinations;  ///< likewise
};

/// Looks at the whole studio. On the polling thread.
StudioView ViewStudio(Setup const& setup);

/// The patches that play on those channels of `channels`, bit 0 being channel 1, as far as they
/// were selected through this program.
std::vector<PlayingView> ViewPlaying(Destination const& destination, unsigned short channels);
/// Fills in what plays on every public destination.
void AddPlaying(StudioView& view, Setup const& setup);

/// Which part of a studio is asked for.
struct ViewFilter {
  bool sources = true;
  bool destinations = true;
  bool withoutEntity = true;  ///< also endpoints that belong to no device
  bool onlyConnected = false;
};

/// The part that passes. A device or entity of which no endpoint passes is left out, unless
/// nothing of it was to be left out.
StudioView Filtered(StudioView view, ViewFilter const& filter);

}  // namespace Ostinet::Tool

// SPDX-License-Identifier: MIT
#include "StudioText.h"

#include <algorithm>
#include <charconv>
#include <sstream>

namespace Ostinet::Tool {
namespace {

constexpr unsigned short kAllChannels = 0xFFFF;

void AddWord(std::string& line, std::string const& word) {
  line += line.empty() ? word : ", " + word;
}

std::string EndpointFacts(EndpointView const& endpoint) {
  std::string facts = endpoint.online ? "online" : "offline";
  if (endpoint.isInterface.value_or(false)) {
    AddWord(facts, "interface");
  } else if (endpoint.isInterface && !endpoint.direct && !endpoint.software) {
    AddWord(facts, "instrument");  // Of a port it would only say that nothing hangs on it.
  }
  if (endpoint.software) {
    AddWord(facts, endpoint.internalSoftware ? "internal software" : "software");
  }
  if (endpoint.isVirtual) {
    AddWord(facts, "virtual");
  }
  if (endpoint.isPrivate) {
    AddWord(facts, "private");
  }
  if (endpoint.channels != kAllChannels) {
    AddWord(facts, "channels " + ChannelsText(endpoint.channels));
  }
  return facts;
}

class Lines {
 public:
  void Add(int depth, std::string const& text) {
    lines_.push_back(std::string(static_cast<size_t>(depth) * 2, ' ') + text);
  }

  void AddEndpoint(int depth, std::string const& label, EndpointView const& endpoint) {
    Add(depth, label + endpoint.name + "  (" + EndpointFacts(endpoint) + ")  #" +
                   std::to_string(endpoint.uniqueID));
    if (endpoint.port) {
      Add(depth + 1, "on port " + *endpoint.port);
    }
    for (PlayingView const& patch : endpoint.playing) {
      Add(depth + 1, "plays " + PlayingText(patch));
    }
    for (std::string const& instrument : endpoint.connected) {
      Add(depth + 1, "carries " + instrument);
    }
  }

  void AddDevice(DeviceView const& device) {
    std::string type = device.manufacturer;
    type += (type.empty() || device.model.empty() ? "" : " ") + device.model;
    Add(1, device.name + (type.empty() ? "" : "  [" + type + "]") +
               (device.online ? "  (online)" : "  (offline)") + "  #" +
               std::to_string(device.uniqueID));
    for (EntityView const& entity : device.entities) {
      Add(2, entity.name);
      for (EndpointView const& source : entity.sources) {
        AddEndpoint(3, "input  ", source);
      }
      for (EndpointView const& destination : entity.destinations) {
        AddEndpoint(3, "output ", destination);
      }
    }
  }

  void AddEndpoints(std::string const& heading, std::vector<EndpointView> const& endpoints) {
    if (!endpoints.empty()) {
      Add(0, heading);
    }
    for (EndpointView const& endpoint : endpoints) {
      AddEndpoint(1, "", endpoint);
    }
  }

  std::vector<std::string> Take() { return std::move(lines_); }

 private:
  std::vector<std::string> lines_;
};

}  // namespace

std::vector<std::string> StudioLines(StudioView const& view) {
  Lines lines;
  if (!view.devices.empty()) {
    lines.Add(0, "Devices");
  }
  for (DeviceView const& device : view.devices) {
    lines.AddDevice(device);
  }
  lines.AddEndpoints("Inputs", view.sources);
  lines.AddEndpoints("Outputs", view.destinations);
  return lines.Take();
}

std::string PlayingText(PlayingView const& patch) {
  return patch.number + " " + patch.name + " on channel " + std::to_string(patch.channel);
}

std::string ChannelsText(unsigned short mask) {
  std::string text;
  for (int first = 0; first < 16; ++first) {
    if ((mask >> first & 1) == 0) {
      continue;
    }
    int last = first;
    while (last < 15 && (mask >> (last + 1) & 1) != 0) {
      ++last;
    }
    AddWord(text, std::to_string(first + 1) +
                      (last > first ? "-" + std::to_string(last + 1) : std::string()));
    first = last;
  }
  return text.empty() ? "none" : text;
}

namespace {

// A channel from 1 to 16 that takes the whole text.
std::optional<int> ParseChannel(std::string const& text) {
  int channel = 0;
  char const* const end = text.data() + text.size();
  auto const [stop, error] = std::from_chars(text.data(), end, channel);
  bool const isChannel = error == std::errc() && stop == end && channel >= 1 && channel <= 16;
  return isChannel ? std::optional<int>(channel) : std::nullopt;
}

}  // namespace

std::optional<unsigned short> ParseChannels(std::string const& text) {
  if (text == "all") {
    return kAllChannels;
  }
  std::string compact = text;
  compact.erase(std::remove(compact.begin(), compact.end(), ' '), compact.end());
  std::istringstream ranges(compact + ",");
  unsigned short mask = 0;
  for (std::string range; std::getline(ranges, range, ',');) {
    size_t const dash = range.find('-');
    auto const first = ParseChannel(range.substr(0, dash));
    auto const last = dash == range.npos ? first : ParseChannel(range.substr(dash + 1));
    if (!first || !last || *last < *first) {
      return std::nullopt;
    }
    for (int channel = *first; channel <= *last; ++channel) {
      mask = static_cast<unsigned short>(mask | 1 << (channel - 1));
    }
  }
  return mask;
}

}  // namespace Ostinet::Tool

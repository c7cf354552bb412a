// SPDX-License-Identifier: MIT
//
// Where a picture of the studio has its things.
//
// Ports stand in the rack in the order of the studio, software below. Each device wants to stand
// beside its ports; devices of one side keep the order of their ports, so that cables cross little,
// and are pushed apart where they would overlap. That is a least-squares problem with an order,
// which pooling neighbours solves exactly.
#include <algorithm>
#include <limits>
#include <map>
#include <numeric>

#include "Drawing.h"
#include "NamePairs.h"

namespace Ostinet::Tool {
namespace {

constexpr double kMargin = 36;
constexpr double kTop = 92;     // below the title
constexpr double kBottom = 64;  // above which the legend stands
constexpr double kCardWidth = 236;
constexpr double kRackWidth = 228;
constexpr double kCableRoom = 210;
constexpr double kPortHeight = 30;
constexpr double kPortPitch = 36;
constexpr double kWidestPitch = 64;
constexpr double kEar = 5;        // by which a row stands out of the rack
constexpr double kRackEdge = 44;  // its heading
constexpr double kRackFoot = 12;
constexpr double kSoftwareGap = 26;
constexpr double kCardHead = 48;
constexpr double kEndsPitch = 22;
constexpr double kCardGap = 14;
constexpr double kJackOffset = 6;
constexpr std::size_t kOneSide = 4;  // so few devices stand on one side

bool IsSoftware(EndpointView const& endpoint) { return endpoint.software || endpoint.isVirtual; }

std::vector<std::string> NamesOf(std::vector<EndpointView> const& endpoints) {
  std::vector<std::string> names;
  for (EndpointView const& endpoint : endpoints) {
    names.push_back(endpoint.name);
  }
  return names;
}

DrawnPort PortOf(EndpointView const& endpoint) {
  DrawnPort port;
  port.name = endpoint.name;
  (endpoint.isSource ? port.source : port.destination) = endpoint.key;
  port.online = endpoint.online;
  port.software = IsSoftware(endpoint);
  return port;
}

// An output with the input that belongs to it by name; what only shares words stays apart.
std::vector<DrawnPort> PortsOf(StudioView const& studio) {
  std::map<std::size_t, NamePair> pairByOutput;
  std::vector<bool> isPaired(studio.sources.size());
  for (NamePair const& pair : PairNames(NamesOf(studio.sources), NamesOf(studio.destinations))) {
    bool const alike = IsSoftware(studio.sources[pair.source]) ==
                       IsSoftware(studio.destinations[pair.destination]);
    if (pair.kind != NamePair::Kind::kRelated && alike) {
      pairByOutput[pair.destination] = pair;
      isPaired[pair.source] = true;
    }
  }
  std::vector<DrawnPort> ports;
  for (std::size_t i = 0; i < studio.destinations.size(); ++i) {
    DrawnPort port = PortOf(studio.destinations[i]);
    auto const pair = pairByOutput.find(i);
    if (pair != pairByOutput.end()) {
      EndpointView const& source = studio.sources[pair->second.source];
      port.name = pair->second.common;
      port.source = source.key;
      port.online = port.online || source.online;
    }
    ports.push_back(port);
  }
  for (std::size_t i = 0; i < studio.sources.size(); ++i) {
    if (!isPaired[i]) {
      ports.push_back(PortOf(studio.sources[i]));
    }
  }
  std::stable_partition(ports.begin(), ports.end(),
                        [](DrawnPort const& port) { return !port.software; });
  return ports;
}

// The row of each port's ends, by their keys.
std::map<unsigned long long, std::size_t> RowsByKey(std::vector<DrawnPort> const& ports) {
  std::map<unsigned long long, std::size_t> rows;
  for (std::size_t i = 0; i < ports.size(); ++i) {
    for (unsigned long long const key : {ports[i].source, ports[i].destination}) {
      if (key != 0) {
        rows[key] = i;
      }
    }
  }
  return rows;
}

/// A device on its way to its place.
struct Card {
  DeviceView const* view;
  DrawnDevice drawn;
  std::vector<std::size_t> rows;  // of the ports that it hangs on
  double wantedY = 0;             // of its top

  double MeanRow() const {
    return rows.empty()
               ? std::numeric_limits<double>::max()
               : std::accumulate(rows.begin(), rows.end(), 0.0) / static_cast<double>(rows.size());
  }
};

// Without the name of the device, which stands above it.
std::string OwnName(EntityView const& entity, DeviceView const& device) {
  std::string const front = device.name + " ";
  bool const isFront = entity.name.compare(0, front.size(), front) == 0;
  return isFront ? entity.name.substr(front.size()) : entity.name;
}

class Layout {
 public:
  explicit Layout(StudioView const& studio) : ports_(PortsOf(studio)), rows_(RowsByKey(ports_)) {
    for (DeviceView const& device : studio.devices) {
      cards_.push_back(CardOf(device));
    }
    std::stable_sort(cards_.begin(), cards_.end(),
                     [](Card const& a, Card const& b) { return a.MeanRow() < b.MeanRow(); });
  }

  Drawing Draw() {
    ChooseSides();
    PlacePorts();
    PlaceSide(true);
    PlaceSide(false);
    Drawing drawing;
    drawing.width = (hasLeft_ ? kCardWidth + kCableRoom : 0) + kRackWidth +
                    (cards_.empty() ? 0 : kCardWidth + kCableRoom) + 2 * kMargin;
    drawing.rack = rack_;
    drawing.ports = ports_;
    double bottom = rack_.Bottom();
    for (Card& card : cards_) {
      AddCables(card, drawing);
      bottom = std::max(bottom, card.drawn.box.Bottom());
      drawing.devices.push_back(card.drawn);
    }
    drawing.height = bottom + kBottom;
    return drawing;
  }

 private:
  Card CardOf(DeviceView const& view) const {
    Card card{&view, {}, {}, 0};
    card.drawn.name = view.name;
    card.drawn.type = view.manufacturer;
    card.drawn.type += (view.manufacturer.empty() || view.model.empty() ? "" : " ") + view.model;
    for (EntityView const& entity : view.entities) {
      AddEnds(entity, view.entities.size() > 1, card);
    }
    card.drawn.connected = !card.rows.empty();
    double const lines = static_cast<double>(std::max<std::size_t>(card.drawn.ends.size(), 1));
    bool const isPlain = card.drawn.ends.size() == 1 && card.drawn.ends[0].label.empty();
    card.drawn.box.width = kCardWidth;
    card.drawn.box.height = isPlain ? kCardHead : kCardHead + lines * kEndsPitch;
    return card;
  }

  // A line for each pair of ends; one line without a label where there is no more than that.
  void AddEnds(EntityView const& entity, bool hasSiblings, Card& card) const {
    std::size_t const lines = std::max(entity.sources.size(), entity.destinations.size());
    for (std::size_t i = 0; i < lines; ++i) {
      DrawnEnds ends;
      ends.hasSource = i < entity.sources.size();
      ends.hasDestination = i < entity.destinations.size();
      if (hasSiblings || lines > 1) {
        ends.label = OwnName(entity, *card.view) + (lines > 1 ? " · " + std::to_string(i + 1) : "");
      }
      card.drawn.ends.push_back(ends);
      if (ends.hasSource) {
        AddRow(entity.sources[i], card);
      }
      if (ends.hasDestination) {
        AddRow(entity.destinations[i], card);
      }
    }
  }

  void AddRow(EndpointView const& end, Card& card) const {
    auto const row = rows_.find(end.portKey);
    if (end.portKey != 0 && row != rows_.end()) {
      card.rows.push_back(row->second);
      card.drawn.online = card.drawn.online || end.online;
    }
  }

  // In turn to the side that is shorter, so that both keep the order of the ports.
  void ChooseSides() {
    double left = 0;
    double right = 0;
    hasLeft_ = cards_.size() > kOneSide;
    for (Card& card : cards_) {
      card.drawn.onLeft = hasLeft_ && left <= right;
      (card.drawn.onLeft ? left : right) += card.drawn.box.height + kCardGap;
      for (std::size_t const row : card.rows) {
        ports_[row].used = true;
      }
    }
    sideHeight_ = std::max(left, right);
  }

  void PlacePorts() {
    auto const count = static_cast<double>(ports_.size());
    bool const hasBoth = !ports_.empty() && !ports_.front().software && ports_.back().software;
    double const gap = hasBoth ? kSoftwareGap : 0;
    double const room = sideHeight_ - kRackEdge - kRackFoot - gap;
    double const pitch = count > 0 ? std::clamp(room / count, kPortPitch, kWidestPitch) : 0;
    rack_ = {kMargin + (hasLeft_ ? kCardWidth + kCableRoom : 0), kTop, kRackWidth,
             kRackEdge + std::max(count * pitch, kPortPitch) + gap + kRackFoot};
    rack_.y += std::max(0.0, (sideHeight_ - rack_.height) / 2);
    double y = rack_.y + kRackEdge;
    int hue = 0;
    for (std::size_t i = 0; i < ports_.size(); ++i) {
      y += hasBoth && i > 0 && ports_[i].software && !ports_[i - 1].software ? gap : 0;
      ports_[i].box = {rack_.x - kEar, y + (pitch - kPortHeight) / 2, rack_.width + 2 * kEar,
                       kPortHeight};
      ports_[i].hue = ports_[i].used ? hue++ % kHues : 0;
      y += pitch;
    }
  }

  static double CenterOf(DrawnBox const& box) { return box.y + box.height / 2; }

  void PlaceSide(bool left) {
    std::vector<Card*> side;
    for (Card& card : cards_) {
      if (card.drawn.onLeft == left) {
        card.wantedY = WantedY(card);
        side.push_back(&card);
      }
    }
    std::vector<double> const tops = TopsOf(side);
    for (std::size_t i = 0; i < side.size(); ++i) {
      DrawnDevice& device = side[i]->drawn;
      device.box.x = left ? kMargin : rack_.Right() + kCableRoom;
      device.box.y = tops[i];
      bool const isPlain = device.box.height == kCardHead;
      double y = device.box.y + (isPlain ? kCardHead / 2 : kCardHead + kEndsPitch / 2 - 6);
      for (DrawnEnds& ends : device.ends) {
        ends.y = y;
        y += kEndsPitch;
      }
      device.hue = side[i]->rows.empty() ? -1 : ports_[side[i]->rows.front()].hue;
    }
  }

  // Beside its ports; what hangs nowhere goes to the end.
  double WantedY(Card const& card) const {
    if (card.rows.empty()) {
      return kTop + std::max(sideHeight_, rack_.height);
    }
    double sum = 0;
    for (std::size_t const row : card.rows) {
      sum += CenterOf(ports_[row].box);
    }
    return sum / static_cast<double>(card.rows.size()) - card.drawn.box.height / 2;
  }

  // The places nearest to the wanted ones at which nothing overlaps.
  std::vector<double> TopsOf(std::vector<Card*> const& side) const {
    struct Pool {
      double sum;
      std::size_t count;
      double Mean() const { return sum / static_cast<double>(count); }
    };
    // Each in a frame of its own, in which those before it take no room.
    std::vector<double> offsets;
    std::vector<Pool> pools;
    double offset = 0;
    for (Card const* const card : side) {
      offsets.push_back(offset);
      pools.push_back({card->wantedY - offset, 1});
      while (pools.size() > 1 && pools.back().Mean() < pools[pools.size() - 2].Mean()) {
        Pool const last = pools.back();
        pools.pop_back();
        pools.back() = {pools.back().sum + last.sum, pools.back().count + last.count};
      }
      offset += card->drawn.box.height + kCardGap;
    }
    // Between the title and the end of the longer side or the rack.
    double const lowest =
        std::max(kTop, kTop + std::max(sideHeight_, rack_.Bottom() - kTop + kCardGap) - offset);
    std::vector<double> tops;
    for (Pool const& pool : pools) {
      for (std::size_t i = 0; i < pool.count; ++i) {
        tops.push_back(std::clamp(pool.Mean(), kTop, lowest) + offsets[tops.size()]);
      }
    }
    return tops;
  }

  void AddCables(Card const& card, Drawing& drawing) const {
    std::size_t line = 0;
    for (EntityView const& entity : card.view->entities) {
      std::size_t const lines = std::max(entity.sources.size(), entity.destinations.size());
      for (std::size_t i = 0; i < lines; ++i, ++line) {
        DrawnEnds const& ends = card.drawn.ends[line];
        if (ends.hasSource) {
          AddCable(entity.sources[i], card.drawn, ends.SourceY(), drawing);
        }
        if (ends.hasDestination) {
          AddCable(entity.destinations[i], card.drawn, ends.DestinationY(), drawing);
        }
      }
    }
  }

  void AddCable(EndpointView const& end, DrawnDevice const& device, double y,
                Drawing& drawing) const {
    auto const row = rows_.find(end.portKey);
    if (end.portKey == 0 || row == rows_.end()) {
      return;
    }
    DrawnPort const& port = ports_[row->second];
    double const portX = device.onLeft ? port.box.x : port.box.Right();
    DrawnCable cable;
    cable.hue = port.hue;
    cable.online = end.online;
    if (end.isSource) {
      cable.x1 = device.JackX();
      cable.y1 = y;
      cable.x2 = portX;
      cable.y2 = port.SourceY();
    } else {
      cable.x1 = portX;
      cable.y1 = port.DestinationY();
      cable.x2 = device.JackX();
      cable.y2 = y;
    }
    drawing.cables.push_back(cable);
  }

  std::vector<DrawnPort> ports_;
  std::map<unsigned long long, std::size_t> const rows_;
  std::vector<Card> cards_;
  DrawnBox rack_;
  double sideHeight_ = 0;
  bool hasLeft_ = false;
};

// Two jacks side by side leave the middle; one alone has it.
double JackY(double middle, bool hasOther, double offset) {
  return hasOther ? middle + offset : middle;
}

}  // namespace

double DrawnPort::SourceY() const {
  return JackY(box.y + box.height / 2, destination != 0, kJackOffset);
}
double DrawnPort::DestinationY() const {
  return JackY(box.y + box.height / 2, source != 0, -kJackOffset);
}
double DrawnEnds::SourceY() const { return JackY(y, hasDestination, kJackOffset); }
double DrawnEnds::DestinationY() const { return JackY(y, hasSource, -kJackOffset); }

Drawing LayOut(StudioView const& studio) { return Layout(studio).Draw(); }

}  // namespace Ostinet::Tool

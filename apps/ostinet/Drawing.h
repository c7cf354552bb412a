// SPDX-License-Identifier: MIT
#pragma once

#include <string>
#include <vector>

#include "StudioView.h"

namespace Ostinet::Tool {

// The studio as a picture: its ports in a rack in the middle, its devices on both sides, each
// beside the ports that it hangs on, and a cable for each connection. Lengths are in pixels, y
// downwards.

struct DrawnBox {
  double x = 0;
  double y = 0;
  double width = 0;
  double height = 0;

  double Right() const { return x + width; }
  double Bottom() const { return y + height; }
};

/// One row of the rack: an input, an output, or the two that belong together.
struct DrawnPort {
  std::string name;
  DrawnBox box;
  unsigned long long source = 0;       ///< the key of its input, 0 for none
  unsigned long long destination = 0;  ///< of its output
  bool online = false;
  bool software = false;
  bool used = false;
  int hue = 0;  ///< which of the picture's colours its cables have

  double SourceY() const;
  double DestinationY() const;
};

/// One line of a device with the jacks of its ends.
struct DrawnEnds {
  std::string label;  ///< empty where it would say nothing
  double y = 0;
  bool hasSource = false;
  bool hasDestination = false;

  double SourceY() const;
  double DestinationY() const;
};

struct DrawnDevice {
  std::string name;
  std::string type;  ///< manufacturer and model
  DrawnBox box;
  bool onLeft = false;
  bool online = false;  ///< an end hangs on a port that is online
  bool connected = false;
  int hue = -1;  ///< of its first port; -1 for none
  std::vector<DrawnEnds> ends;

  /// Where its cables end.
  double JackX() const { return onLeft ? box.Right() : box.x; }
};

/// From where MIDI comes to where it goes.
struct DrawnCable {
  double x1 = 0;
  double y1 = 0;
  double x2 = 0;
  double y2 = 0;
  bool online = false;
  int hue = 0;
};

struct Drawing {
  double width = 0;
  double height = 0;
  DrawnBox rack;
  std::vector<DrawnPort> ports;
  std::vector<DrawnDevice> devices;
  std::vector<DrawnCable> cables;
};

/// How many colours a picture has for cables.
constexpr int kHues = 10;

/// Where everything stands. The same studio always gives the same picture.
Drawing LayOut(StudioView const& studio);

/// The picture as an SVG document.
std::string DrawingSVG(Drawing const& drawing);

}  // namespace Ostinet::Tool

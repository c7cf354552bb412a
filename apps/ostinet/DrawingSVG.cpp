// SPDX-License-Identifier: MIT
#include <algorithm>
#include <array>
#include <cmath>
#include <locale>
#include <sstream>

#include "Drawing.h"

namespace Ostinet::Tool {
namespace {

// Apart from each other also for most who see few colours, and dark enough on white.
constexpr std::array<char const*, kHues> kColours = {"#2563eb", "#d9480f", "#0f8a5f", "#a21caf",
                                                     "#b7791f", "#0891b2", "#be123c", "#4d7c0f",
                                                     "#6d28d9", "#64748b"};

constexpr char kStyle[] = R"(
  text { font-family: Inter, "Segoe UI", "Helvetica Neue", Helvetica, Arial, sans-serif; }
  .title { font-size: 22px; font-weight: 600; fill: #111827; }
  .facts { font-size: 13px; fill: #6b7280; }
  .heading { font-size: 12px; font-weight: 600; fill: #cbd5e1; letter-spacing: 1.5px; }
  .name { font-size: 14px; font-weight: 600; fill: #111827; }
  .type, .ends { font-size: 11.5px; fill: #6b7280; }
  .port { font-size: 12.5px; fill: #111827; text-anchor: middle; }
  .rack { fill: #1f2937; }
  .row { fill: #f8fafc; stroke: #cbd5e1; stroke-width: 1; }
  .software { fill: #e0e7ff; stroke: #c7d2fe; }
  .unused text { fill: #64748b; }
  .unused circle { opacity: 0.6; }
  .card { fill: #ffffff; stroke: #d7dde5; stroke-width: 1; }
  .off { opacity: 0.5; }
  .cable { fill: none; stroke-width: 2; stroke-linecap: round; }
  .halo { fill: none; stroke: #f6f7f9; stroke-width: 5.5; }
  .legend { font-size: 12px; fill: #6b7280; })";

// Of the size of the letters: the average of those of the alphabets, and of East Asia's square
// ones.
constexpr double kLetterWidth = 0.56;
constexpr double kSquareWidth = 1.0;

std::string Number(double value) {
  std::ostringstream text;
  text.imbue(std::locale::classic());
  text << std::round(value * 10) / 10;
  return text.str();
}

bool StartsLetter(char c) { return (static_cast<unsigned char>(c) & 0xC0) != 0x80; }

// The width of the letter that starts with this byte of UTF-8. Square ones stand from U+3000 on.
double WidthOf(char c) {
  return static_cast<unsigned char>(c) >= 0xE3 ? kSquareWidth : kLetterWidth;
}

std::string Escaped(std::string const& text) {
  std::string escaped;
  for (char const c : text) {
    switch (c) {
      case '&':
        escaped += "&amp;";
        break;
      case '<':
        escaped += "&lt;";
        break;
      case '>':
        escaped += "&gt;";
        break;
      case '"':
        escaped += "&quot;";
        break;
      default:
        // XML has no way to write the others.
        escaped += static_cast<unsigned char>(c) < 0x20 || c == 0x7F ? ' ' : c;
    }
  }
  return escaped;
}

// What fits into a width, with an ellipsis where letters were left out.
std::string Shortened(std::string const& text, double width, double size) {
  double const room = width / size;
  double taken = 0;
  std::size_t cut = 0;  // behind the last letter that leaves room for the ellipsis
  for (std::size_t i = 0; i < text.size(); ++i) {
    if (!StartsLetter(text[i])) {
      continue;
    }
    cut = taken + kLetterWidth <= room ? i : cut;
    taken += WidthOf(text[i]);
  }
  return taken <= room ? text : text.substr(0, cut) + "…";
}

class Document {
 public:
  explicit Document(Drawing const& drawing) : drawing_(drawing) {}

  std::string Write() {
    out_ << "<?xml version=\"1.0\" encoding=\"UTF-8\"?>\n"
         << "<svg xmlns=\"http://www.w3.org/2000/svg\" width=\"" << Number(Width())
         << "\" height=\"" << Number(drawing_.height) << "\" viewBox=\"0 0 " << Number(Width())
         << " " << Number(drawing_.height) << "\">\n<style>" << kStyle << "\n</style>\n"
         << "<rect width=\"100%\" height=\"100%\" fill=\"#f6f7f9\"/>\n";
    Title();
    Rack();
    Cables();
    for (DrawnPort const& port : drawing_.ports) {
      Port(port);
    }
    for (DrawnDevice const& device : drawing_.devices) {
      Device(device);
    }
    // Above the boxes that the cables end at.
    for (DrawnCable const& cable : drawing_.cables) {
      Arrow(cable);
    }
    Legend();
    out_ << "</svg>\n";
    return out_.str();
  }

 private:
  static constexpr double kLegendWidth = 620;

  double Width() const { return std::max(drawing_.width, kLegendWidth); }

  void Text(double x, double y, char const* kind, std::string const& text) {
    out_ << "<text class=\"" << kind << "\" x=\"" << Number(x) << "\" y=\"" << Number(y) << "\">"
         << Escaped(text) << "</text>\n";
  }

  static std::string Counted(std::size_t count, std::string const& one) {
    return std::to_string(count) + " " + one + (count == 1 ? "" : "s");
  }

  void Title() {
    Text(36, 44, "title", "MIDI studio");
    Text(36, 66, "facts",
         Counted(drawing_.devices.size(), "device") + "  ·  " +
             Counted(drawing_.ports.size(), "port") + "  ·  " +
             Counted(drawing_.cables.size(), "connection"));
  }

  void Box(DrawnBox const& box, char const* kind, double round) {
    out_ << "<rect class=\"" << kind << "\" x=\"" << Number(box.x) << "\" y=\"" << Number(box.y)
         << "\" width=\"" << Number(box.width) << "\" height=\"" << Number(box.height) << "\" rx=\""
         << Number(round) << "\"/>\n";
  }

  void Rack() {
    Box(drawing_.rack, "rack", 12);
    Text(drawing_.rack.x + 16, drawing_.rack.y + 27, "heading",
         drawing_.ports.empty() ? "NO PORTS" : "PORTS");
  }

  void Open(std::string const& kind, std::string const& tip) {
    out_ << "<g" << (kind.empty() ? "" : " class=\"" + kind + "\"") << "><title>" << Escaped(tip)
         << "</title>\n";
  }
  void Close() { out_ << "</g>\n"; }

  // Filled where a cable ends in it.
  void Jack(double x, double y) {
    auto const cable =
        std::find_if(drawing_.cables.begin(), drawing_.cables.end(), [&](DrawnCable const& one) {
          return (one.x1 == x && one.y1 == y) || (one.x2 == x && one.y2 == y);
        });
    bool const used = cable != drawing_.cables.end();
    char const* const colour = used ? kColours[static_cast<std::size_t>(cable->hue)] : "#ffffff";
    out_ << "<circle cx=\"" << Number(x) << "\" cy=\"" << Number(y) << "\" r=\"3.6\" fill=\""
         << colour << "\" stroke=\"" << (used ? "#ffffff" : "#94a3b8")
         << "\" stroke-width=\"1.2\"/>\n";
  }

  void Port(DrawnPort const& port) {
    std::string const ways = port.source == 0        ? "output"
                             : port.destination == 0 ? "input"
                                                     : "input and output";
    Open(!port.online ? "off"
         : port.used  ? ""
                      : "unused",
         port.name + " (" + ways + (port.software ? ", software" : "") +
             (port.online ? "" : ", offline") + ")");
    Box(port.box, port.software ? "row software" : "row", 6);
    Text(port.box.x + port.box.width / 2, port.box.y + port.box.height / 2 + 4.5, "port",
         Shortened(port.name, port.box.width - 28, 12.5));
    for (double const x : {port.box.x, port.box.Right()}) {
      if (port.source != 0) {
        Jack(x, port.SourceY());
      }
      if (port.destination != 0) {
        Jack(x, port.DestinationY());
      }
    }
    Close();
  }

  void Device(DrawnDevice const& device) {
    DrawnBox const& box = device.box;
    Open(device.connected && !device.online ? "off" : "",
         device.name + (device.type.empty() ? "" : " [" + device.type + "]") +
             (device.connected ? device.online ? "" : ", offline" : ", hangs on no port"));
    Box(box, "card", 8);
    std::string const colour =
        device.hue >= 0 ? kColours[static_cast<std::size_t>(device.hue)] : "#cbd5e1";
    double const barX = device.onLeft ? box.x + 6 : box.Right() - 10;
    out_ << "<rect x=\"" << Number(barX) << "\" y=\"" << Number(box.y + 8)
         << "\" width=\"4\" height=\"" << Number(box.height - 16) << "\" rx=\"2\" fill=\"" << colour
         << "\"/>\n";
    double const textX = box.x + (device.onLeft ? 20 : 16);
    bool const hasType = !device.type.empty();
    Text(textX, box.y + (hasType ? 21 : 29), "name", Shortened(device.name, box.width - 40, 14));
    if (hasType) {
      Text(textX, box.y + 37, "type", Shortened(device.type, box.width - 40, 11.5));
    }
    for (DrawnEnds const& ends : device.ends) {
      Ends(device, ends, textX);
    }
    Close();
  }

  void Ends(DrawnDevice const& device, DrawnEnds const& ends, double textX) {
    if (!ends.label.empty()) {
      Text(textX, ends.y + 4, "ends", Shortened(ends.label, device.box.width - 40, 11.5));
    }
    if (ends.hasSource) {
      Jack(device.JackX(), ends.SourceY());
    }
    if (ends.hasDestination) {
      Jack(device.JackX(), ends.DestinationY());
    }
  }

  static std::string PathOf(DrawnCable const& cable) {
    double const bend = (cable.x2 - cable.x1) * 0.5;
    return "d=\"M" + Number(cable.x1) + " " + Number(cable.y1) + "C" + Number(cable.x1 + bend) +
           " " + Number(cable.y1) + " " + Number(cable.x2 - bend) + " " + Number(cable.y2) + " " +
           Number(cable.x2) + " " + Number(cable.y2) + "\"";
  }

  void Halo(DrawnCable const& cable) { out_ << "<path class=\"halo\" " << PathOf(cable) << "/>\n"; }

  void Cable(DrawnCable const& cable) {
    out_ << "<path class=\"cable\" stroke=\"" << kColours[static_cast<std::size_t>(cable.hue)]
         << "\"" << (cable.online ? "" : " stroke-dasharray=\"2 6\"") << " " << PathOf(cable)
         << "/>\n";
  }

  // A halo sets cables off from those that they cross, but not from those of their own port.
  void Cables() {
    for (int hue = 0; hue < kHues; ++hue) {
      for (DrawnCable const& cable : drawing_.cables) {
        if (cable.hue == hue) {
          Halo(cable);
        }
      }
      for (DrawnCable const& cable : drawing_.cables) {
        if (cable.hue == hue) {
          Cable(cable);
        }
      }
    }
  }

  // At its end, pointing the way that MIDI goes.
  void Arrow(DrawnCable const& cable) {
    double const way = cable.x2 > cable.x1 ? 1 : -1;
    double const tip = cable.x2 - way * 3;
    out_ << "<path fill=\"" << kColours[static_cast<std::size_t>(cable.hue)] << "\" d=\"M"
         << Number(tip) << " " << Number(cable.y2) << "l" << Number(-way * 9) << " -4.2v8.4z\"/>\n";
  }

  void Legend() {
    double const y = drawing_.height - 26;
    DrawnCable sample;
    sample.x1 = 40;
    sample.x2 = 92;
    sample.y1 = sample.y2 = y - 4;
    sample.online = true;
    Cable(sample);
    Arrow(sample);
    Text(102, y, "legend", "the way MIDI goes");
    sample.x1 = 238;
    sample.x2 = 290;
    sample.online = false;
    Cable(sample);
    Text(300, y, "legend", "offline");
    Box(
        {
            366,
            y - 13,
            30,
            16,
        },
        "row software", 4);
    Text(404, y, "legend", "made by software");
  }

  Drawing const& drawing_;
  std::ostringstream out_;
};

}  // namespace

std::string DrawingSVG(Drawing const& drawing) { return Document(drawing).Write(); }

}  // namespace Ostinet::Tool

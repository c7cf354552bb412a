// SPDX-License-Identifier: MIT
#include "platform/system/simulated/StudioFile.h"

#include <algorithm>
#include <cstdint>
#include <filesystem>
#include <fstream>
#include <initializer_list>
#include <iterator>
#include <limits>
#include <nlohmann/json.hpp>
#include <stdexcept>
#include <system_error>
#include <utility>

namespace Ostinet::Impl::Simulated {

namespace {

using Json = nlohmann::json;

constexpr std::int64_t kClocksPerMillisecond = 10000;
constexpr std::int64_t kMostMilliseconds = 1000LL * 60 * 60 * 24 * 365;

struct KindName {
  char const* name;
  SimulatedPort::Kind kind;
};
constexpr KindName kKinds[] = {
    {"winmm-out", SimulatedPort::Kind::kWinMMOut},
    {"winmm-in", SimulatedPort::Kind::kWinMMIn},
    {"directmusic-out", SimulatedPort::Kind::kDirectMusicOut},
    {"directmusic-in", SimulatedPort::Kind::kDirectMusicIn},
};

// An object of the file, with the words for where it stands, such as `ports[2]`.
class Node {
 public:
  Node(Json const& json, std::string place) : json_(json), place_(std::move(place)) {}

  [[noreturn]] void Fail(std::string const& what) const {
    throw StudioFileError("In " + place_ + ": " + what);
  }

  /// It has to be an object without other keys than these.
  void Allow(std::initializer_list<char const*> keys) const {
    if (!json_.is_object()) Fail("an object is expected");
    for (auto const& [key, value] : json_.items()) {
      bool const known = std::any_of(keys.begin(), keys.end(),
                                     [&, k = key](char const* each) { return k == each; });
      if (!known) Fail("the key \"" + key + "\" is unknown");
    }
  }

  bool Has(char const* key) const { return json_.contains(key); }

  Node At(char const* key) const {
    if (!Has(key)) Fail("the key \"" + std::string(key) + "\" is missing");
    return {json_.at(key), place_ + "." + key};
  }

  std::string Text(char const* key) const {
    Node const node = At(key);
    if (!node.json_.is_string()) node.Fail("a text is expected");
    return node.json_.get<std::string>();
  }
  std::string Text(char const* key, std::string const& absent) const {
    return Has(key) ? Text(key) : absent;
  }

  bool Flag(char const* key, bool absent) const {
    if (!Has(key)) return absent;
    Node const node = At(key);
    if (!node.json_.is_boolean()) node.Fail("true or false is expected");
    return node.json_.get<bool>();
  }

  std::int64_t Number(char const* key, std::int64_t least, std::int64_t most) const {
    Node const node = At(key);
    bool const fits = node.json_.is_number_integer() &&
                      !(node.json_.is_number_unsigned() &&
                        node.json_.get<std::uint64_t>() > static_cast<std::uint64_t>(most)) &&
                      node.json_.get<std::int64_t>() >= least &&
                      node.json_.get<std::int64_t>() <= most;
    if (!fits) {
      node.Fail("a whole number from " + std::to_string(least) + " to " + std::to_string(most) +
                " is expected");
    }
    return node.json_.get<std::int64_t>();
  }
  std::int64_t Number(char const* key, std::int64_t least, std::int64_t most,
                      std::int64_t absent) const {
    return Has(key) ? Number(key, least, most) : absent;
  }

  /// Calls `each(Node)` for every element of a list that may be absent.
  template <class Each>
  void ForEach(char const* key, Each const& each) const {
    if (!Has(key)) return;
    Node const list = At(key);
    if (!list.json_.is_array()) list.Fail("a list is expected");
    for (std::size_t i = 0; i < list.json_.size(); ++i) {
      each(Node(list.json_[i], list.place_ + "[" + std::to_string(i) + "]"));
    }
  }

  std::vector<unsigned char> Bytes(char const* key) const {
    std::string const text = Text(key);
    try {
      return ParseHex(text);
    } catch (std::invalid_argument const& error) {
      At(key).Fail(error.what());
    }
  }

  bool IsText() const { return json_.is_string(); }

 private:
  Json const& json_;
  std::string place_;
};

SimulatedPort::Kind ReadKind(Node const& node) {
  std::string const text = node.Text("kind");
  for (KindName const& each : kKinds) {
    if (text == each.name) return each.kind;
  }
  node.Fail("\"" + text +
            "\" is no kind of port; there are winmm-out, winmm-in, directmusic-out and "
            "directmusic-in");
}

SimulatedPort ReadPort(Node const& node) {
  node.Allow({"name", "kind", "technology", "directmusic", "external", "dls", "gm-in-hardware",
              "emulated", "latency-us"});
  SimulatedPort port;
  port.name = node.Text("name");
  if (port.name.empty()) node.Fail("a port needs a name");
  port.kind = ReadKind(node);
  port.technology = static_cast<int>(node.Number("technology", 1, 7, port.technology));
  port.directMusic = node.Flag("directmusic", port.directMusic);
  port.external = node.Flag("external", port.external);
  port.dls = node.Flag("dls", port.dls);
  port.gmInHardware = node.Flag("gm-in-hardware", port.gmInHardware);
  port.emulated = node.Flag("emulated", port.emulated);
  port.latencyMicroseconds = node.Number("latency-us", 0, 10000000, 0);
  return port;
}

SimulatedInstrument ReadInstrument(Node const& node) {
  node.Allow({"out", "in", "device-id", "identity", "replies"});
  SimulatedInstrument instrument;
  instrument.out = node.Text("out");
  instrument.in = node.Text("in", "");
  instrument.deviceID = static_cast<int>(node.Number("device-id", 0, 127, 0));
  instrument.identity = node.Text("identity", "");
  node.ForEach("replies", [&](Node const& reply) {
    reply.Allow({"to", "with"});
    instrument.replies.push_back({reply.Text("to"), reply.Text("with")});
  });
  return instrument;
}

using Action = std::function<void()>;

struct Pair {
  std::string first;
  std::string second;
};

Pair ReadPair(Node const& node) {
  node.Allow({"from", "to"});
  return {node.Text("from"), node.Text("to")};
}

Action ReadRemoval(Node const& event, Studio& studio) {
  Node const node = event.At("remove");
  if (node.IsText()) {
    return [&studio, name = event.Text("remove")] { studio.RemoveFirstPort(name); };
  }
  node.Allow({"name", "kind"});
  auto const kind = ReadKind(node);
  return [&studio, name = node.Text("name"), kind] { studio.RemovePorts(name, &kind); };
}

Action ReadInput(Node const& event, Studio& studio) {
  Node const node = event.At("input");
  node.Allow({"port", "bytes"});
  return [&studio, port = node.Text("port"), bytes = node.Bytes("bytes")] {
    studio.Inject(port, bytes);
  };
}

// A row for each thing that can happen.
struct ActionForm {
  char const* key;
  Action (*read)(Node const& event, Studio& studio);
};
constexpr ActionForm kActions[] = {
    {"add",
     [](Node const& event, Studio& studio) -> Action {
       return [&studio, port = ReadPort(event.At("add"))] { studio.AddPort(port); };
     }},
    {"remove", ReadRemoval},
    {"rename",
     [](Node const& event, Studio& studio) -> Action {
       return [&studio, pair = ReadPair(event.At("rename"))] {
         studio.RenamePorts(pair.first, pair.second);
       };
     }},
    {"duplicate",
     [](Node const& event, Studio& studio) -> Action {
       return [&studio, name = event.Text("duplicate")] { studio.DuplicatePorts(name); };
     }},
    {"connect",
     [](Node const& event, Studio& studio) -> Action {
       return [&studio, pair = ReadPair(event.At("connect"))] {
         studio.AddCable(pair.first, pair.second);
       };
     }},
    {"disconnect",
     [](Node const& event, Studio& studio) -> Action {
       return [&studio, pair = ReadPair(event.At("disconnect"))] {
         studio.RemoveCable(pair.first, pair.second);
       };
     }},
    {"input", ReadInput},
};

void ReadEvent(Node const& node, Studio& studio) {
  node.Allow({"at-ms", "every-ms", "times", "add", "remove", "rename", "duplicate", "connect",
              "disconnect", "input"});
  std::int64_t const at = node.Number("at-ms", 0, kMostMilliseconds) * kClocksPerMillisecond;
  std::int64_t const every =
      node.Number("every-ms", 1, kMostMilliseconds, 0) * kClocksPerMillisecond;
  constexpr std::int64_t kEver = std::numeric_limits<int>::max();
  auto const times = static_cast<int>(node.Number("times", 1, kEver, kEver));
  Action action;
  for (ActionForm const& form : kActions) {
    if (!node.Has(form.key)) continue;
    if (action) node.Fail("only one thing can happen in one event");
    action = form.read(node, studio);
  }
  if (!action)
    node.Fail(
        "nothing happens: add, remove, rename, duplicate, connect, disconnect "
        "or input is expected");
  studio.AddTimelineEvent(at, every, times, std::move(action));
}

Json Parse(std::string const& text) {
  try {
    return Json::parse(text);
  } catch (Json::parse_error const& error) {
    // error.byte counts from 1; the last byte that was read is the one that is wrong.
    std::size_t const end = std::min<std::size_t>(error.byte, text.size());
    auto const stop = text.begin() + static_cast<std::ptrdiff_t>(end);
    auto const line = 1 + std::count(text.begin(), stop, '\n');
    throw StudioFileError("Line " + std::to_string(line) + " is not well-formed JSON");
  }
}

}  // namespace

void ReadStudioText(std::string const& text, Studio& studio) {
  Json const json = Parse(text);
  Node const root(json, "the studio");
  root.Allow({"ports", "cables", "instruments", "events"});
  root.ForEach("ports", [&](Node const& node) { studio.AddPort(ReadPort(node)); });
  root.ForEach("cables", [&](Node const& node) {
    Pair const pair = ReadPair(node);
    studio.AddCable(pair.first, pair.second);
  });
  root.ForEach("instruments", [&](Node const& node) {
    SimulatedInstrument const instrument = ReadInstrument(node);
    try {
      studio.AddInstrument(instrument);
    } catch (std::invalid_argument const& error) {
      node.Fail(error.what());
    }
  });
  root.ForEach("events", [&](Node const& node) { ReadEvent(node, studio); });
}

void ReadStudioFile(std::string const& path, Studio& studio) {
  std::error_code ignored;
  // The bytes of a path are UTF-8 on every machine.
  std::filesystem::path const file(std::u8string(path.begin(), path.end()));
  std::ifstream stream(file, std::ios::binary);
  if (!stream || std::filesystem::is_directory(file, ignored)) {
    throw StudioFileError("The studio file \"" + path + "\" cannot be read");
  }
  std::string const text((std::istreambuf_iterator<char>(stream)), {});
  try {
    ReadStudioText(text, studio);
  } catch (StudioFileError const& error) {
    throw StudioFileError("The studio file \"" + path + "\" cannot be used: " + error.what());
  }
}

}  // namespace Ostinet::Impl::Simulated

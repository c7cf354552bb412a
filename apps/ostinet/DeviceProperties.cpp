// SPDX-License-Identifier: MIT
#include "DeviceProperties.h"

#include <optional>
#include <variant>

#include "Errors.h"
#include "JsonText.h"
#include "StudioText.h"

namespace Ostinet::Tool {
namespace {

struct TextKind {
  UString (DeviceObject::*get)() const;
  void (DeviceObject::*set)(UString const&) const;
};
struct FlagKind {
  bool (DeviceObject::*get)() const;
  void (DeviceObject::*set)(bool) const;
};
struct ChannelsKind {
  unsigned short (DeviceObject::*get)() const;
  void (DeviceObject::*set)(unsigned short) const;
};
struct DeviceIDKind {};
struct MicrosecondsKind {};

using Kind = std::variant<TextKind, FlagKind, ChannelsKind, DeviceIDKind, MicrosecondsKind>;

struct Property {
  char const* key;
  Kind kind;
  char const* help;
};

using D = DeviceObject;

// Reading, writing and the help all walk this table.
Property const kProperties[] = {
    {"manufacturer", TextKind{&D::GetManufacturer, &D::SetManufacturer}, "who made it"},
    {"model", TextKind{&D::GetModel, &D::SetModel}, "what it is called by its maker"},
    {"device-id", DeviceIDKind{}, "its sysex device ID, 0 to 127, or none"},
    {"schedule-ahead", MicrosecondsKind{}, "microseconds that it wants its messages early"},
    {"receive-channels", ChannelsKind{&D::ReceiveChannels, &D::SetReceiveChannels},
     "channels like 1-4,10, or all"},
    {"transmit-channels", ChannelsKind{&D::TransmitChannels, &D::SetTransmitChannels}, "likewise"},
    {"drum-machine", FlagKind{&D::IsADrumMachine, &D::SetIsADrumMachine}, "yes or no"},
    {"mixer", FlagKind{&D::IsAMixer, &D::SetIsAMixer}, ""},
    {"sampler", FlagKind{&D::IsASampler, &D::SetIsASampler}, ""},
    {"effects-unit", FlagKind{&D::IsAnEffectsUnit, &D::SetIsAnEffectsUnit}, ""},
    {"general-midi", FlagKind{&D::SupportsGeneralMIDI, &D::SetSupportsGeneralMIDI}, ""},
    {"mmc", FlagKind{&D::SupportsMMC, &D::SetSupportsMMC}, ""},
    {"receives-notes", FlagKind{&D::ReceivesNotes, &D::SetReceivesNotes}, ""},
    {"receives-program-change", FlagKind{&D::ReceivesProgramChange, &D::SetReceivesProgramChange},
     ""},
    {"receives-bank-select-0", FlagKind{&D::ReceivesBankSelect0, &D::SetReceivesBankSelect0}, ""},
    {"receives-bank-select-32", FlagKind{&D::ReceivesBankSelect32, &D::SetReceivesBankSelect32},
     ""},
    {"receives-clock", FlagKind{&D::ReceivesClock, &D::SetReceivesClock}, ""},
    {"receives-mtc", FlagKind{&D::ReceivesMTC, &D::SetReceivesMTC}, ""},
    {"transmits-notes", FlagKind{&D::TransmitsNotes, &D::SetTransmitsNotes}, ""},
    {"transmits-program-change",
     FlagKind{&D::TransmitsProgramChange, &D::SetTransmitsProgramChange}, ""},
    {"transmits-bank-select-0", FlagKind{&D::TransmitsBankSelect0, &D::SetTransmitsBankSelect0},
     ""},
    {"transmits-bank-select-32", FlagKind{&D::TransmitsBankSelect32, &D::SetTransmitsBankSelect32},
     ""},
    {"transmits-clock", FlagKind{&D::TransmitsClock, &D::SetTransmitsClock}, ""},
    {"transmits-mtc", FlagKind{&D::TransmitsMTC, &D::SetTransmitsMTC}, ""},
};

constexpr char kChannelPrefix[] = "channel-";
constexpr int kChannelCount = 16;

std::string ChannelKey(int channel) { return kChannelPrefix + std::to_string(channel + 1); }

UsageError WrongValue(std::string const& key, std::string const& takes, std::string const& value) {
  return UsageError("\"" + key + "\" is " + takes + ", not \"" + value + "\"");
}

std::optional<bool> ParseFlag(std::string const& text) {
  for (char const* const word : {"yes", "true", "on", "1"}) {
    if (text == word) {
      return true;
    }
  }
  for (char const* const word : {"no", "false", "off", "0"}) {
    if (text == word) {
      return false;
    }
  }
  return std::nullopt;
}

int ParseNumber(std::string const& key, std::string const& text, int last) {
  std::string const takes = "a number from 0 to " + std::to_string(last);
  bool const isNumber =
      !text.empty() && text.size() < 10 && text.find_first_not_of("0123456789") == text.npos;
  int const number = isNumber ? std::stoi(text) : -1;
  if (number < 0 || number > last) {
    throw WrongValue(key, takes, text);
  }
  return number;
}

// What each kind reads as text and as JSON, and how it is written.
struct ReadText {
  D const& object;
  std::string operator()(TextKind const& kind) const { return (object.*kind.get)().string(); }
  std::string operator()(FlagKind const& kind) const { return (object.*kind.get)() ? "yes" : "no"; }
  std::string operator()(ChannelsKind const& kind) const {
    unsigned short const mask = (object.*kind.get)();
    return mask == 0 || mask == 0xFFFF ? "all" : ChannelsText(mask);  // 0: nobody said
  }
  std::string operator()(DeviceIDKind const&) const {
    std::optional<int> const id = SysexDeviceIDOf(object);
    return id ? std::to_string(*id) : "none";
  }
  std::string operator()(MicrosecondsKind const&) const {
    return std::to_string(object.GetAdvanceScheduleMicroseconds());
  }
};

struct ReadJson {
  D const& object;
  Json operator()(TextKind const& kind) const { return (object.*kind.get)().string(); }
  Json operator()(FlagKind const& kind) const { return (object.*kind.get)(); }
  Json operator()(ChannelsKind const& kind) const {
    unsigned short const mask = (object.*kind.get)();
    return mask == 0 ? 0xFFFF : mask;
  }
  Json operator()(DeviceIDKind const&) const {
    std::optional<int> const id = SysexDeviceIDOf(object);
    return id ? Json(*id) : Json();
  }
  Json operator()(MicrosecondsKind const&) const { return object.GetAdvanceScheduleMicroseconds(); }
};

struct WriteText {
  D const& object;
  std::string const& key;
  std::string const& value;
  void operator()(TextKind const& kind) const { (object.*kind.set)(UString(value)); }
  void operator()(FlagKind const& kind) const {
    std::optional<bool> const flag = ParseFlag(value);
    if (!flag) {
      throw WrongValue(key, "yes or no", value);
    }
    (object.*kind.set)(*flag);
  }
  void operator()(ChannelsKind const& kind) const {
    std::optional<unsigned short> const mask = ParseChannels(value);
    if (!mask) {
      throw WrongValue(key, "channels like 1-4,10, or all", value);
    }
    (object.*kind.set)(*mask);
  }
  void operator()(DeviceIDKind const&) const {
    object.SetSysexDeviceID(static_cast<char>(value == "none" ? -1 : ParseNumber(key, value, 127)));
  }
  void operator()(MicrosecondsKind const&) const {
    object.SetAdvanceScheduleMicroseconds(ParseNumber(key, value, 10000000));
  }
};

Property const* FindProperty(std::string const& key) {
  for (Property const& property : kProperties) {
    if (key == property.key) {
      return &property;
    }
  }
  return nullptr;
}

// The channel of a key like "channel-3", counted from 0.
std::optional<int> ChannelOf(std::string const& key) {
  for (int channel = 0; channel < kChannelCount; ++channel) {
    if (key == ChannelKey(channel)) {
      return channel;
    }
  }
  return std::nullopt;
}

UsageError NoSuchKey(std::string const& key) {
  return UsageError("there is no property \"" + key + "\"; see ostinet device set --help");
}

}  // namespace

std::vector<NamedValue> ReadProperties(DeviceObject const& object) {
  std::vector<NamedValue> values;
  for (Property const& property : kProperties) {
    values.push_back({property.key, std::visit(ReadText{object}, property.kind)});
  }
  for (int channel = 0; channel < kChannelCount; ++channel) {
    std::string const name = object.GetChannelName(channel).string();
    if (!name.empty()) {
      values.push_back({ChannelKey(channel), name});
    }
  }
  return values;
}

std::string ReadProperty(DeviceObject const& object, std::string const& key) {
  if (Property const* const property = FindProperty(key)) {
    return std::visit(ReadText{object}, property->kind);
  }
  if (std::optional<int> const channel = ChannelOf(key)) {
    return object.GetChannelName(*channel).string();
  }
  throw NoSuchKey(key);
}

void WriteProperty(DeviceObject const& object, std::string const& key, std::string const& value) {
  if (Property const* const property = FindProperty(key)) {
    std::visit(WriteText{object, key, value}, property->kind);
  } else if (std::optional<int> const channel = ChannelOf(key)) {
    object.SetChannelName(*channel, UString(value));
  } else {
    throw NoSuchKey(key);
  }
}

std::string PropertiesJSON(DeviceObject const& object) {
  Json json = {{"name", object.GetName().string()}, {"uniqueID", object._get_impl_id()}};
  for (Property const& property : kProperties) {
    json[property.key] = std::visit(ReadJson{object}, property.kind);
  }
  for (int channel = 0; channel < kChannelCount; ++channel) {
    json[ChannelKey(channel)] = object.GetChannelName(channel).string();
  }
  return JsonText(json);
}

// On some machines a plain char has no sign.
std::optional<int> SysexDeviceIDOf(DeviceObject const& object) {
  auto const id = static_cast<unsigned char>(object.GetSysexDeviceID());
  return id < 0x80 ? std::optional<int>(id) : std::nullopt;
}

std::string PropertiesHelp() {
  std::string text;
  for (Property const& property : kProperties) {
    std::string line = std::string("  ") + property.key;
    if (*property.help != '\0') {
      line.resize(28, ' ');
      line += property.help;
    }
    text += line + "\n";
  }
  return text + "  channel-1 to channel-16   what the channel is called";
}

}  // namespace Ostinet::Tool

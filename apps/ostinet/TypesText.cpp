// SPDX-License-Identifier: MIT
#include "TypesText.h"

#include "JsonText.h"

namespace Ostinet::Tool {
namespace {

std::string Counted(size_t count, std::string const& thing) {
  return std::to_string(count) + " " + thing + (count == 1 ? "" : "s");
}

std::string TwoDigits(unsigned char byte) {
  constexpr char kDigits[] = "0123456789ABCDEF";
  return {kDigits[byte >> 4], kDigits[byte & 15]};
}

// "41 53 01 00 00", or nothing where no identity is known. A maker of one byte leaves two unset.
std::string IdentityText(ModelInfo const& info) {
  constexpr unsigned char kNone = 0xFF;
  std::string text;
  for (unsigned char const byte : info.bytes) {
    if (byte != kNone) {
      text += (text.empty() ? "" : " ") + TwoDigits(byte);
    }
  }
  return text;
}

std::vector<std::string> Texts(std::vector<UString> const& names) {
  std::vector<std::string> texts;
  for (UString const& name : names) {
    texts.push_back(name.string());
  }
  return texts;
}

std::string PortsText(std::string const& kind, std::vector<UString> const& names) {
  std::string named;
  for (UString const& name : names) {
    if (!name.empty()) {
      named += (named.empty() ? "" : ", ") + name.string();
    }
  }
  return Counted(names.size(), kind) + (named.empty() ? "" : " (" + named + ")");
}

void AddPorts(DeviceTypeFacts const& facts, std::vector<std::string>& lines) {
  for (size_t i = 0; i < facts.ports.size(); ++i) {
    DeviceTypePorts const& ports = facts.ports[i];
    std::string const name =
        ports.name.empty() ? "Port " + std::to_string(i + 1) : ports.name.string();
    lines.push_back("  " + name + ": " + PortsText("input", ports.ins) + ", " +
                    PortsText("output", ports.outs));
  }
}

Json PortsJson(DeviceTypeFacts const& facts) {
  Json array = Json::array();
  for (DeviceTypePorts const& ports : facts.ports) {
    array.push_back({{"name", ports.name.string()},
                     {"inputs", Texts(ports.ins)},
                     {"outputs", Texts(ports.outs)}});
  }
  return array;
}

Json DeviceIDJson(DeviceTypeFacts const& facts) {
  if (!facts.hasDeviceID) {
    return Json();
  }
  return {
      {"default", facts.defaultDeviceID}, {"min", facts.minDeviceID}, {"max", facts.maxDeviceID}};
}

}  // namespace

std::vector<std::string> MakerLines(MakerCounts const& makers) {
  std::vector<std::string> lines;
  for (auto const& [name, count] : makers) {
    lines.push_back(name + " (" + Counted(static_cast<size_t>(count), "model") + ")");
  }
  return lines;
}

std::string MakersJSON(MakerCounts const& makers) {
  Json array = Json::array();
  for (auto const& [name, count] : makers) {
    array.push_back({{"manufacturer", name}, {"models", count}});
  }
  return JsonLine({{"manufacturers", array}});
}

std::vector<std::string> ModelLines(std::vector<DeviceTypeInfo> const& types) {
  std::vector<std::string> lines;
  for (DeviceTypeInfo const& type : types) {
    lines.push_back(type.GetModelName().string());
  }
  return lines;
}

std::string ModelsJSON(std::string const& maker, std::vector<DeviceTypeInfo> const& types) {
  return JsonLine({{"manufacturer", maker}, {"models", ModelLines(types)}});
}

std::vector<std::string> TypeLines(DeviceTypeInfo const& type) {
  DeviceTypeFacts const facts = type.GetFacts();
  std::vector<std::string> lines{type.GetMfrName().string() + " " + type.GetModelName().string()};
  auto const add = [&lines](std::string const& name, std::string const& value) {
    lines.push_back("  " + name + ": " + value);
  };
  if (std::string const identity = IdentityText(facts.inquiryResponse); !identity.empty()) {
    add("identity", identity);
  }
  if (facts.hasDeviceID) {
    add("device ID", std::to_string(facts.defaultDeviceID) + " of " +
                         std::to_string(facts.minDeviceID) + " to " +
                         std::to_string(facts.maxDeviceID));
  }
  add("channels", "receives on " + std::to_string(facts.receiveMaxChannels) + ", transmits on " +
                      std::to_string(facts.transmitMaxChannels));
  for (auto const& [name, value] : facts.flags) {
    add(name.string(), value ? "yes" : "no");
  }
  if (!facts.image.empty()) {
    add("picture", facts.image.string());
  }
  AddPorts(facts, lines);
  return lines;
}

std::string TypeJSON(DeviceTypeInfo const& type) {
  DeviceTypeFacts const facts = type.GetFacts();
  Json flags = Json::object();
  for (auto const& [name, value] : facts.flags) {
    flags[name.string()] = value;
  }
  return JsonLine({{"manufacturer", type.GetMfrName().string()},
                   {"model", type.GetModelName().string()},
                   {"identity", TextOrNull(IdentityText(facts.inquiryResponse))},
                   {"deviceID", DeviceIDJson(facts)},
                   {"receiveMaxChannels", facts.receiveMaxChannels},
                   {"transmitMaxChannels", facts.transmitMaxChannels},
                   {"flags", flags},
                   {"image", TextOrNull(facts.image.string())},
                   {"ports", PortsJson(facts)}});
}

std::vector<std::string> CheckLines(CheckedFile const& file) {
  std::vector<std::string> lines;
  for (DeviceTypeFileNote const& note : file.check.notes) {
    lines.push_back(file.path + ":" + std::to_string(note.line) + ": " + note.text.string());
  }
  if (lines.empty()) {
    lines.push_back(file.path + ": " + Counted(file.check.types.size(), "type") +
                    ", nothing is skipped");
  }
  return lines;
}

std::string ChecksJSON(std::vector<CheckedFile> const& files) {
  Json array = Json::array();
  for (CheckedFile const& file : files) {
    Json types = Json::array();
    for (DeviceTypeInfo const& type : file.check.types) {
      types.push_back(
          {{"manufacturer", type.GetMfrName().string()}, {"model", type.GetModelName().string()}});
    }
    Json notes = Json::array();
    for (DeviceTypeFileNote const& note : file.check.notes) {
      notes.push_back({{"line", note.line}, {"text", note.text.string()}});
    }
    array.push_back({{"file", file.path},
                     {"author", file.check.author.string()},
                     {"types", types},
                     {"notes", notes}});
  }
  return JsonLine({{"files", array}});
}

}  // namespace Ostinet::Tool

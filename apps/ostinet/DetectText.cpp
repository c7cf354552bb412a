// SPDX-License-Identifier: MIT
#include "DetectText.h"

#include <algorithm>

#include "HexBytes.h"
#include "JsonText.h"

namespace Ostinet::Tool {
namespace {

using Outcome = DetectionRun::Outcome;

struct OutcomeWords {
  Outcome outcome;
  char const* key;
  char const* sentence;  // what a user has to know of it; empty: nothing
};

constexpr OutcomeWords kOutcomes[] = {
    {Outcome::kWaiting, "cancelled", "not asked"},
    {Outcome::kAsking, "cancelled", "not asked to the end"},
    {Outcome::kDone, "done", ""},
    {Outcome::kTimeLimit, "time-limit", "its time was over before everything was asked"},
    {Outcome::kOffline, "offline", "went offline"},
    {Outcome::kCancelled, "cancelled", "not asked to the end"},
};

OutcomeWords const& WordsOf(Outcome outcome) {
  return *std::find_if(std::begin(kOutcomes), std::end(kOutcomes),
                       [&](OutcomeWords const& words) { return words.outcome == outcome; });
}

PortName NameOf(Endpoint const& endpoint) {
  return {endpoint.GetName().string(), endpoint.GetUniqueID()};
}

FindingView ViewFinding(DetectionRun::Finding const& finding) {
  FindingView view;
  for (DeviceTypeInfo const& type : finding.types) {
    view.types.emplace_back(type.GetMfrName().string(), type.GetModelName().string());
  }
  if (finding.deviceID != DetectionRun::kNoDeviceID) {
    view.deviceID = finding.deviceID;
  }
  view.source = NameOf(finding.source);
  view.identity = ToHex(finding.identity);
  view.reply = ToHex(finding.reply);
  return view;
}

// "Maker A, B or C": a maker that stays the same is named once.
std::string TypesText(FindingView const& finding) {
  std::string text;
  for (std::size_t i = 0; i < finding.types.size(); ++i) {
    auto const& [maker, model] = finding.types[i];
    bool const isLast = i + 1 == finding.types.size();
    bool const isNewMaker = i == 0 || finding.types[i - 1].first != maker;
    text += i == 0 ? "" : isLast ? " or " : ", ";
    if (isNewMaker) {
      text.append(maker).append(" ");
    }
    text += model;
  }
  return text.empty() ? "an instrument of no known type, identity " + finding.identity : text;
}

std::string FindingLine(FindingView const& finding) {
  std::string line = "  " + TypesText(finding);
  if (finding.deviceID) {
    line += "  device ID " + std::to_string(*finding.deviceID);
  }
  line += "  on " + finding.source.name;
  if (finding.device) {
    line += "  made " + finding.device->name + " #" + std::to_string(finding.device->uniqueID);
  }
  return line;
}

Json NameJson(PortName const& name) { return {{"name", name.name}, {"uniqueID", name.uniqueID}}; }

Json FindingJson(FindingView const& finding) {
  Json types = Json::array();
  for (auto const& [maker, model] : finding.types) {
    types.push_back({{"manufacturer", maker}, {"model", model}});
  }
  return {{"types", types},
          {"deviceID", finding.deviceID ? Json(*finding.deviceID) : Json()},
          {"source", NameJson(finding.source)},
          {"identity", TextOrNull(finding.identity)},
          {"reply", TextOrNull(finding.reply)},
          {"device", finding.device ? NameJson(*finding.device) : Json()}};
}

// The beginning of a text, cut between characters. A character counts as one column.
std::string FirstColumns(std::string const& text, std::size_t columns) {
  std::size_t end = 0;
  for (std::size_t count = 0; end < text.size(); ++end) {
    bool const startsCharacter = (static_cast<unsigned char>(text[end]) & 0xC0) != 0x80;
    if (startsCharacter && count++ == columns) {
      break;
    }
  }
  return text.substr(0, end);
}

}  // namespace

DetectedPort ViewPort(DetectionRun::Port const& port) {
  DetectedPort view;
  view.port = NameOf(port.destination);
  view.outcome = port.outcome;
  for (DetectionRun::Finding const& finding : port.findings) {
    view.findings.push_back(ViewFinding(finding));
  }
  return view;
}

std::vector<std::string> DetectLines(DetectedPort const& port) {
  std::vector<std::string> lines = {port.port.name + "  #" + std::to_string(port.port.uniqueID)};
  for (FindingView const& finding : port.findings) {
    lines.push_back(FindingLine(finding));
  }
  std::string const sentence = WordsOf(port.outcome).sentence;
  if (!sentence.empty()) {
    lines.push_back("  (" + sentence + ")");
  } else if (port.findings.empty()) {
    lines.push_back("  nothing answered");
  }
  return lines;
}

std::string DetectJSON(std::vector<DetectedPort> const& ports) {
  Json list = Json::array();
  for (DetectedPort const& port : ports) {
    Json findings = Json::array();
    for (FindingView const& finding : port.findings) {
      findings.push_back(FindingJson(finding));
    }
    list.push_back({{"name", port.port.name},
                    {"uniqueID", port.port.uniqueID},
                    {"outcome", WordsOf(port.outcome).key},
                    {"instruments", findings}});
  }
  Json const all = {{"ports", list}};
  return JsonLine(all);
}

std::string ProgressLine(DetectionRun::Progress const& progress, std::string const& port,
                         std::size_t width) {
  constexpr std::size_t kCells = 20;
  auto const full = static_cast<std::size_t>(progress.fraction * static_cast<double>(kCells));
  auto const percent = static_cast<int>(progress.fraction * 100.0);
  std::string const bar = "[" + std::string(std::min(full, kCells), '#') +
                          std::string(kCells - std::min(full, kCells), '.') + "] ";
  std::string const port1 = std::to_string(std::min(progress.port + 1, progress.ports));
  return FirstColumns(bar + std::to_string(percent) + " %  port " + port1 + " of " +
                          std::to_string(progress.ports) + "  " + port,
                      width);
}

}  // namespace Ostinet::Tool

// SPDX-License-Identifier: MIT

#include "DiagReport.h"

#include <algorithm>
#include <chrono>
#include <cstdio>

#include "StudioJson.h"
#include "StudioText.h"

namespace Ostinet::Tool {
namespace {

struct KindWord {
  SystemPort::Kind kind;
  char const* word;
};

// The words of studio files.
constexpr KindWord kKindWords[] = {{SystemPort::kWinMMOut, "winmm-out"},
                                   {SystemPort::kWinMMIn, "winmm-in"},
                                   {SystemPort::kDirectMusicOut, "directmusic-out"},
                                   {SystemPort::kDirectMusicIn, "directmusic-in"}};

std::string KindWordOf(SystemPort::Kind kind) {
  auto const* const found =
      std::find_if(std::begin(kKindWords), std::end(kKindWords),
                   [kind](KindWord const& each) { return each.kind == kind; });
  return found != std::end(kKindWords) ? found->word : "unknown";
}

template <class Item, class ToJson>
Json ListOf(std::vector<Item> const& items, ToJson const& toJson) {
  Json list = Json::array();
  for (Item const& item : items) {
    list.push_back(toJson(item));
  }
  return list;
}

Json PortJson(SystemPort const& port) {
  return {{"kind", KindWordOf(port.kind)}, {"index", port.index}, {"name", port.name.string()},
          {"technology", port.technology}, {"flags", port.flags}, {"error", port.error}};
}

Json OfflineJson(EndpointView const& port) {
  return {{"name", port.name},
          {"kind", port.isSource ? "source" : "destination"},
          {"uniqueID", port.uniqueID}};
}

Json DocumentInUseJson(DocumentInUse const& document) {
  return {{"destination", document.destination},
          {"type", document.type},
          {"name", document.name},
          {"file", document.file},
          {"state", document.state}};
}

Json FileJson(SettingsFile const& file) {
  return {{"name", file.name},
          {"bytes", file.bytes},
          {"modified", file.modified},
          {"fault", TextOrNull(file.fault)}};
}

Json FolderJson(DataFolder const& folder) {
  return {{"kind", folder.kind},
          {"path", TextOrNull(folder.path)},
          {"exists", folder.exists},
          {"deviceTypeFiles", folder.deviceTypeFiles},
          {"nameDocuments", folder.nameDocuments}};
}

// Sections of lines, each under a heading of its own.
class ReportLines {
 public:
  void Section(std::string const& heading) {
    if (!lines_.empty()) {
      lines_.emplace_back();
    }
    lines_.push_back(heading);
  }
  void Add(std::string const& line) { lines_.push_back("  " + line); }
  void Fact(std::string const& name, std::string const& value) { Add(name + ": " + value); }
  template <class Items, class ToLine>
  void List(Items const& items, ToLine const& toLine) {
    for (auto const& item : items) {
      Add(toLine(item));
    }
    if (items.empty()) {
      Add("none");
    }
  }

  std::vector<std::string> Take() { return std::move(lines_); }

 private:
  std::vector<std::string> lines_;
};

std::string SystemText(DiagReport const& report) {
  if (report.systemKind == "simulated") {
    return "simulated studio " + report.studioFile;
  }
  return report.systemKind == "none" ? "none: " + report.notice : "the machine's own";
}

std::string PortText(SystemPort const& port) {
  std::string text = KindWordOf(port.kind) + " " + std::to_string(port.index) + ": ";
  if (port.error != 0) {
    return text + "not described, error " + std::to_string(port.error);
  }
  text += port.name.string();
  if (port.kind == SystemPort::kWinMMOut) {
    text += "  technology " + std::to_string(port.technology);
  } else if (port.kind != SystemPort::kWinMMIn) {
    text += "  flags " + std::to_string(port.flags);
  }
  return text;
}

std::string DocumentText(DocumentInUse const& document) {
  return document.destination + ": " + document.type + " " + document.name + "  " + document.file +
         (document.state == "read" ? "" : "  (" + document.state + ")");
}

std::string FileText(SettingsFile const& file) {
  return file.name + "  " + std::to_string(file.bytes) + " bytes  " + file.modified +
         (file.fault.empty() ? "" : "  (broken: " + file.fault + ")");
}

std::string FolderText(DataFolder const& folder) {
  std::string const text = folder.kind + ": " + (folder.path.empty() ? "none" : folder.path);
  if (!folder.exists) {
    return text + (folder.path.empty() ? "" : "  (not there)");
  }
  if (folder.kind == "resources") {
    return text;
  }
  return text + "  " + std::to_string(folder.deviceTypeFiles) + " device type files, " +
         std::to_string(folder.nameDocuments) + " name documents";
}

void AddProperties(ReportLines& lines, std::string const& object, unsigned long long key,
                   StoredProperties const& properties) {
  auto const found = properties.find(key);
  if (found == properties.end()) {
    return;
  }
  lines.Add(object);
  for (auto const& [name, value] : found->second.items()) {
    lines.Add("  " + name + " = " + JsonLine(value));
  }
}

void AddEndpointProperties(ReportLines& lines, std::vector<EndpointView> const& endpoints,
                           StoredProperties const& properties) {
  for (EndpointView const& endpoint : endpoints) {
    AddProperties(lines, (endpoint.isSource ? "input " : "output ") + endpoint.name, endpoint.key,
                  properties);
  }
}

void AddStudio(ReportLines& lines, DiagReport const& report) {
  lines.Section("Studio");
  lines.List(StudioLines(report.studio), [](std::string const& line) { return line; });
  lines.Section("Offline ports");
  lines.List(OfflinePorts(report.studio), [](EndpointView const& port) {
    return (port.isSource ? "input " : "output ") + port.name;
  });
  lines.Section("Stored properties");
  for (DeviceView const& device : report.studio.devices) {
    AddProperties(lines, "device " + device.name, device.key, report.properties);
    for (EntityView const& entity : device.entities) {
      AddProperties(lines, "entity " + entity.name, entity.key, report.properties);
      AddEndpointProperties(lines, entity.sources, report.properties);
      AddEndpointProperties(lines, entity.destinations, report.properties);
    }
  }
  AddEndpointProperties(lines, report.studio.sources, report.properties);
  AddEndpointProperties(lines, report.studio.destinations, report.properties);
  if (report.properties.empty()) {
    lines.Add("none");
  }
}

}  // namespace

std::string UniversalTime(long long seconds) {
  using namespace std::chrono;
  sys_seconds const time{std::chrono::seconds(seconds)};
  auto const day = floor<days>(time);
  year_month_day const date(day);
  hh_mm_ss const clock(time - day);
  char text[64];
  std::snprintf(text, sizeof text, "%04d-%02u-%02u %02d:%02d:%02d UTC",
                static_cast<int>(date.year()), static_cast<unsigned>(date.month()),
                static_cast<unsigned>(date.day()), static_cast<int>(clock.hours().count()),
                static_cast<int>(clock.minutes().count()),
                static_cast<int>(clock.seconds().count()));
  return text;
}

std::vector<EndpointView> OfflinePorts(StudioView const& studio) {
  std::vector<EndpointView> offline;
  for (std::vector<EndpointView> const* list : {&studio.sources, &studio.destinations}) {
    std::copy_if(list->begin(), list->end(), std::back_inserter(offline),
                 [](EndpointView const& port) { return port.direct && !port.online; });
  }
  return offline;
}

std::vector<std::string> DiagLines(DiagReport const& report) {
  ReportLines lines;
  lines.Section("Ostinet " + report.version);
  lines.Fact("MIDI system", SystemText(report));
  lines.Fact("backend", report.backend + " version " + std::to_string(report.backendVersion));
  lines.Fact("sign-in", report.signIn.empty() ? "done" : "failed: " + report.signIn);
  lines.Section("Ports of the system");
  lines.List(report.ports, PortText);
  AddStudio(lines, report);
  lines.Section("Name documents in use");
  lines.List(report.documents, DocumentText);
  lines.Section("Settings in " +
                (report.settingsFolder.empty() ? "no folder" : report.settingsFolder));
  lines.List(report.settingsFiles, FileText);
  lines.Section("Data folders");
  lines.List(report.dataFolders, FolderText);
  lines.Section("Errors");
  lines.List(report.errors, [](std::string const& error) { return error; });
  return lines.Take();
}

std::string DiagJSON(DiagReport const& report) {
  Json const json = {
      {"version", report.version},
      {"system",
       {{"kind", report.systemKind},
        {"studioFile", TextOrNull(report.studioFile)},
        {"notice", TextOrNull(report.notice)}}},
      {"backend", {{"name", report.backend}, {"version", report.backendVersion}}},
      {"signIn", {{"done", report.signIn.empty()}, {"fault", TextOrNull(report.signIn)}}},
      {"ports", ListOf(report.ports, PortJson)},
      {"studio", StudioTree(report.studio, report.properties)},
      {"offline", ListOf(OfflinePorts(report.studio), OfflineJson)},
      {"documents", ListOf(report.documents, DocumentInUseJson)},
      {"settings",
       {{"folder", TextOrNull(report.settingsFolder)},
        {"files", ListOf(report.settingsFiles, FileJson)}}},
      {"dataFolders", ListOf(report.dataFolders, FolderJson)},
      {"errors", report.errors}};
  return JsonText(json);
}

}  // namespace Ostinet::Tool

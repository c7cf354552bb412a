// SPDX-License-Identifier: MIT
#include <gmock/gmock.h>

#include "DiagReport.h"
#include "SomeStudio.h"

namespace Ostinet::Tool {
namespace {

using testing::Contains;
using testing::ElementsAre;
using testing::Not;

DiagReport SomeReport() {
  DiagReport report;
  report.version = "1.2.3";
  report.systemKind = "simulated";
  report.studioFile = "studio.json";
  report.backend = "WinMIDI";
  SystemPort port;
  port.name = UString("Out 1");
  port.technology = 1;
  SystemPort dumb;
  dumb.kind = SystemPort::kWinMMIn;
  dumb.index = 3;
  dumb.error = 6;
  report.ports = {port, dumb};
  report.studio = SomeStudio();
  report.studio.sources[0].online = false;
  report.properties[1] = {{"name", "Synth"}};
  report.properties[6] = {{"connUniqueID", {104}}, {"name", "Out 1"}};
  report.documents = {{"Synth", "master", "Model", "a.midnam", "missing"}};
  report.settingsFolder = "settings";
  report.settingsFiles = {
      {"Ostinet.xml", 5, "1970-01-01 00:00:00 UTC", "line 1: no element found"}};
  report.dataFolders = {
      {"user", "", false, 0, 0}, {"system", "data", true, 2, 7}, {"resources", "res", true, 0, 0}};
  report.errors = {"a sentence"};
  return report;
}

TEST(DiagLines, HaveASectionForEachPart) {
  EXPECT_THAT(
      DiagLines(SomeReport()),
      ElementsAre(
          "Ostinet 1.2.3", "  MIDI system: simulated studio studio.json",
          "  backend: WinMIDI version 0", "  sign-in: done", "", "Ports of the system",
          "  winmm-out 0: Out 1  technology 1", "  winmm-in 3: not described, error 6", "",
          "Studio", "  Devices", "    Synth  [Maker Model]  (online)  #101", "      Port 1",
          "        input  Synth  (online)  #103",
          "        output Synth  (online, channels 1-4, 10)  #104", "          on port Out 1",
          "  Inputs", "    In 1  (offline)  #105", "  Outputs",
          "    Out 1  (online, interface)  #106", "      carries Synth", "", "Offline ports",
          "  input In 1", "", "Stored properties", "  device Synth", "    name = \"Synth\"",
          "  output Out 1", "    connUniqueID = [104]", "    name = \"Out 1\"", "",
          "Name documents in use", "  Synth: master Model  a.midnam  (missing)", "",
          "Settings in settings",
          "  Ostinet.xml  5 bytes  1970-01-01 00:00:00 UTC  (broken: line 1: no element found)", "",
          "Data folders", "  user: none", "  system: data  2 device type files, 7 name documents",
          "  resources: res", "", "Errors", "  a sentence"));
}

TEST(DiagLines, SayWhereThereIsNothing) {
  DiagReport report;
  report.systemKind = "none";
  report.notice = "no ports";
  report.signIn = "no clock";
  std::vector<std::string> const lines = DiagLines(report);
  EXPECT_THAT(lines, Contains("  MIDI system: none: no ports"));
  EXPECT_THAT(lines, Contains("  sign-in: failed: no clock"));
  EXPECT_THAT(lines, Contains("Settings in no folder"));
  EXPECT_EQ(std::count(lines.begin(), lines.end(), "  none"), 8);
}

TEST(DiagJSON, HasTheKeysThatScriptsRelyOn) {
  Json const report = Json::parse(DiagJSON(SomeReport()));
  std::vector<std::string> keys;
  for (auto const& [key, value] : report.items()) {
    keys.push_back(key);
  }
  EXPECT_THAT(keys, ElementsAre("version", "system", "backend", "signIn", "ports", "studio",
                                "offline", "documents", "settings", "dataFolders", "errors"));
  EXPECT_EQ(report["system"],
            Json::parse(R"({"kind": "simulated", "studioFile": "studio.json", "notice": null})"));
  EXPECT_EQ(report["backend"], Json::parse(R"({"name": "WinMIDI", "version": 0})"));
  EXPECT_EQ(report["signIn"], Json::parse(R"({"done": true, "fault": null})"));
  EXPECT_EQ(report["ports"], Json::parse(R"([
      {"kind": "winmm-out", "index": 0, "name": "Out 1", "technology": 1, "flags": 0, "error": 0},
      {"kind": "winmm-in", "index": 3, "name": "", "technology": 0, "flags": 0, "error": 6}])"));
  EXPECT_EQ(report["offline"],
            Json::parse(R"([{"name": "In 1", "kind": "source", "uniqueID": 105}])"));
  EXPECT_EQ(report["documents"], Json::parse(R"([{"destination": "Synth", "type": "master",
      "name": "Model", "file": "a.midnam", "state": "missing"}])"));
  EXPECT_EQ(report["settings"], Json::parse(R"({"folder": "settings", "files": [
      {"name": "Ostinet.xml", "bytes": 5, "modified": "1970-01-01 00:00:00 UTC",
       "fault": "line 1: no element found"}]})"));
  EXPECT_EQ(report["dataFolders"][0], Json::parse(R"({"kind": "user", "path": null,
      "exists": false, "deviceTypeFiles": 0, "nameDocuments": 0})"));
  EXPECT_EQ(report["errors"], Json::parse(R"(["a sentence"])"));
}

TEST(DiagJSON, GivesEachObjectItsProperties) {
  Json const studio = Json::parse(DiagJSON(SomeReport()))["studio"];
  EXPECT_EQ(studio["devices"][0]["properties"], Json::parse(R"({"name": "Synth"})"));
  EXPECT_EQ(studio["destinations"][0]["properties"]["connUniqueID"], Json::parse("[104]"));
  EXPECT_FALSE(studio["sources"][0].contains("properties"));
}

TEST(OfflinePorts, AreThoseOfTheMachineThatAreNotThere) {
  StudioView studio = SomeStudio();
  EXPECT_TRUE(OfflinePorts(studio).empty());
  studio.destinations[0].online = false;
  studio.devices[0].entities[0].sources[0].online = false;  // an instrument is no port
  std::vector<EndpointView> const offline = OfflinePorts(studio);
  ASSERT_EQ(offline.size(), 1u);
  EXPECT_EQ(offline[0].name, "Out 1");
}

TEST(UniversalTime, IsWrittenWithItsZone) {
  EXPECT_EQ(UniversalTime(0), "1970-01-01 00:00:00 UTC");
  EXPECT_EQ(UniversalTime(951782399), "2000-02-28 23:59:59 UTC");
  EXPECT_EQ(UniversalTime(951782400), "2000-02-29 00:00:00 UTC");
}

}  // namespace
}  // namespace Ostinet::Tool

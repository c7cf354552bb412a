// SPDX-License-Identifier: MIT
#include <gmock/gmock.h>

#include "RunTool.h"

namespace Ostinet::Tool {
namespace {

using testing::HasSubstr;
using testing::IsEmpty;

class DiagCommand : public ToolTest {
 protected:
  json ReportOn(std::string const& studio, testing::Matcher<std::string> const& notice = "") {
    ToolRun const run = RunOn(studio, {"diag", "--json"});
    EXPECT_EQ(run.exitCode, kDone) << run.err;
    EXPECT_THAT(run.err, notice);
    return json::parse(run.out);
  }
  /// The one of a list whose `key` is this text.
  static json Find(json const& list, char const* key, std::string const& text) {
    for (json const& each : list) {
      if (each[key] == text) {
        return each;
      }
    }
    ADD_FAILURE() << "no " << text << " in " << list.dump(2);
    return json();
  }
  static json Named(json const& list, std::string const& name) { return Find(list, "name", name); }
  static json DocumentOf(json const& report, std::string const& destination) {
    return Find(report["documents"], "destination", destination);
  }
};

char const* const kThreePorts = R"({ "ports": [
  {"name": "Out 1", "kind": "winmm-out", "technology": 1},
  {"name": "Old", "kind": "winmm-out", "technology": 4, "directmusic": false},
  {"name": "In 1", "kind": "winmm-in"} ] })";

TEST_F(DiagCommand, TellsPeopleInSections) {
  ToolRun const run = RunOn(kThreePorts, {"diag"});
  EXPECT_EQ(run.exitCode, kDone) << run.err;
  EXPECT_EQ(run.err, "");
  for (char const* const heading :
       {"Ostinet ", "Ports of the system\n", "Studio\n", "Offline ports\n", "Stored properties\n",
        "Name documents in use\n", "Settings in ", "Data folders\n", "Errors\n  none\n"}) {
    EXPECT_THAT(run.out, HasSubstr(heading));
  }
}

// The system's list has what the studio leaves out, and each port that the studio joins twice.
TEST_F(DiagCommand, ListsThePortsAsTheSystemHasThem) {
  json const report = ReportOn(kThreePorts);
  std::vector<std::string> ports;
  for (json const& port : report["ports"]) {
    ports.push_back(port["kind"].get<std::string>() + " " + port["name"].get<std::string>());
  }
  EXPECT_THAT(ports, testing::ElementsAre("winmm-out Out 1", "winmm-out Old", "winmm-in In 1",
                                          "directmusic-out Out 1 [Emulated]",
                                          "directmusic-in In 1 [Emulated]"));
  EXPECT_EQ(report["ports"][1]["technology"], 4);
  EXPECT_EQ(report["studio"]["destinations"].size(), 1u);
  EXPECT_EQ(report["system"]["kind"], "simulated");
  EXPECT_EQ(report["signIn"]["done"], true);
  EXPECT_THAT(report["errors"], IsEmpty());
}

TEST_F(DiagCommand, ShowsWhatIsStored) {
  ASSERT_EQ(RunOn(kThreePorts, {"device", "new", "Synth"}).exitCode, kDone);
  ASSERT_EQ(RunOn(kThreePorts, {"device", "set", "Synth", "manufacturer", "Maker"}).exitCode,
            kDone);
  ASSERT_EQ(RunOn(kThreePorts, {"connect", "Synth", "Out 1", "-o"}).exitCode, kDone);
  ASSERT_EQ(RunOn(kThreePorts, {"names", "Synth", "--standard", "General MIDI"}).exitCode, kDone);
  json const report = ReportOn(kThreePorts);
  json const& device = report["studio"]["devices"][0];
  EXPECT_EQ(device["properties"]["manufacturer"], "Maker");
  EXPECT_EQ(device["properties"]["uniqueID"], device["uniqueID"]);
  json const& entity = device["entities"][0];
  EXPECT_EQ(entity["properties"]["name"], "Port 1");
  json const port = Named(report["studio"]["destinations"], "Out 1");
  EXPECT_EQ(port["properties"]["offline"], 0);
  EXPECT_EQ(port["properties"]["which API"], 2);
  EXPECT_EQ(port["properties"]["connUniqueID"],
            json::array({entity["destinations"][0]["uniqueID"]}));
  EXPECT_TRUE(entity["destinations"][0]["properties"].contains("nameConfiguration"));
  json const document = DocumentOf(report, "Synth");
  EXPECT_EQ(document["type"], "standard");
  EXPECT_EQ(document["name"], "General MIDI");
  EXPECT_EQ(document["state"], "read");
  EXPECT_EQ(Named(report["settings"]["files"], "Ostinet.xml")["fault"], nullptr);
}

TEST_F(DiagCommand, NamesPortsThatAreGone) {
  ASSERT_EQ(RunOn(kThreePorts, {"device", "set", "Out 1", "model", "x"}).exitCode, kDone);
  json const report = ReportOn(R"({"ports": [{"name": "In 1", "kind": "winmm-in"},
                                             {"name": "Out 2", "kind": "winmm-out"}]})");
  ASSERT_EQ(report["offline"].size(), 1u) << report["offline"].dump(2);
  EXPECT_EQ(report["offline"][0]["name"], "Out 1");
  EXPECT_EQ(report["offline"][0]["kind"], "destination");
}

TEST_F(DiagCommand, TellsOfABrokenSetupFileAndGoesOn) {
  ASSERT_EQ(RunOn(kThreePorts, {"device", "new", "Synth"}).exitCode, kDone);
  WriteFile("settings/Ostinet.xml", "<Setup>\n<Device");
  json const report = ReportOn(kThreePorts, HasSubstr("cannot be read to its end"));
  EXPECT_THAT(Named(report["settings"]["files"], "Ostinet.xml")["fault"].get<std::string>(),
              HasSubstr("line 2"));
  ASSERT_EQ(report["errors"].size(), 1u);
  EXPECT_THAT(report["errors"][0].get<std::string>(), HasSubstr("Ostinet.xml"));
  EXPECT_EQ(report["studio"]["destinations"].size(), 1u);
}

TEST_F(DiagCommand, TellsOfABrokenDocument) {
  std::string const document = WriteFile("box.midnam", R"(<?xml version="1.0" encoding="UTF-8"?>
<MIDINameDocument><Author/><MasterDeviceNames><Manufacturer>Maker</Manufacturer><Model>Box</Model>
<CustomDeviceMode Name="Default"><ChannelNameSetAssignments/></CustomDeviceMode>
</MasterDeviceNames></MIDINameDocument>)");
  ASSERT_EQ(RunOn(kThreePorts, {"device", "new", "Synth"}).exitCode, kDone);
  ASSERT_EQ(RunOn(kThreePorts, {"device", "set", "Synth", "manufacturer", "Maker"}).exitCode,
            kDone);
  ASSERT_EQ(RunOn(kThreePorts, {"device", "set", "Synth", "model", "Box"}).exitCode, kDone);
  ASSERT_EQ(RunOn(kThreePorts, {"names", "Synth", "--set", document}).exitCode, kDone);
  WriteFile("box.midnam", "<MIDINameDocument>");
  json const report = ReportOn(kThreePorts);
  EXPECT_EQ(DocumentOf(report, "Synth")["state"], "broken");
  EXPECT_EQ(DocumentOf(report, "Out 1")["state"], "read");
  EXPECT_EQ(report["errors"].size(), 1u);
}

TEST_F(DiagCommand, GoesOnWithoutAFolderForSettings) {
  std::string const notAFolder = WriteFile("file", "content");
  ToolRun const run = RunBare({"diag", "--json", "--studio", WriteFile("studio.json", kThreePorts),
                               "--settings", notAFolder});
  EXPECT_EQ(run.exitCode, kDone);
  json const report = json::parse(run.out);
  EXPECT_EQ(report["signIn"]["done"], false);
  EXPECT_THAT(report["signIn"]["fault"].get<std::string>(), HasSubstr("the settings folder"));
  EXPECT_EQ(report["ports"].size(), 5u);
  EXPECT_EQ(report["errors"].size(), 1u);
}

TEST_F(DiagCommand, FailsWhereTheStudioCannotBeRead) {
  ToolRun const run = RunOn("{", {"diag"});
  EXPECT_EQ(run.exitCode, kFailed);
  EXPECT_EQ(run.out, "");
  EXPECT_EQ(std::count(run.err.begin(), run.err.end(), '\n'), 1) << run.err;
}

// Not even the time at which the studio was saved.
TEST_F(DiagCommand, SavesNothing) {
  ASSERT_EQ(RunOn(kThreePorts, {"device", "new", "Synth"}).exitCode, kDone);
  json const before = ReportOn(kThreePorts);
  json const after = ReportOn(kThreePorts);
  EXPECT_EQ(Named(before["settings"]["files"], "Ostinet.xml"),
            Named(after["settings"]["files"], "Ostinet.xml"));
  EXPECT_EQ(before["studio"], after["studio"]);
}

}  // namespace
}  // namespace Ostinet::Tool

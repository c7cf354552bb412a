// SPDX-License-Identifier: MIT
//
// The commands that edit the studio, and what the next run finds.
#include <gmock/gmock.h>

#include <filesystem>
#include <fstream>
#include <iterator>

#include "RunTool.h"

namespace Ostinet::Tool {
namespace {

using testing::ElementsAre;
using testing::HasSubstr;
using testing::Not;
using testing::StartsWith;

char const* const kDesk = R"({ "ports": [
  {"name": "Desk 1", "kind": "winmm-out"}, {"name": "Desk 1", "kind": "winmm-in"},
  {"name": "Desk 2", "kind": "winmm-out"}, {"name": "Desk 2", "kind": "winmm-in"},
  {"name": "Chip", "kind": "winmm-out", "technology": 4} ] })";

/// Runs on one studio; what a run saves, the next one finds.
class EditCommands : public ToolTest {
 protected:
  ToolRun Tool(std::vector<std::string> const& arguments) { return RunOn(kDesk, arguments); }
  /// The run must succeed, without a word on the standard error.
  ToolRun Do(std::vector<std::string> const& arguments) {
    ToolRun const run = Tool(arguments);
    EXPECT_EQ(run.exitCode, kDone) << testing::PrintToString(arguments);
    EXPECT_EQ(run.err, "") << testing::PrintToString(arguments);
    return run;
  }
  /// The run must fail with one sentence and save nothing.
  std::string Fails(std::vector<std::string> const& arguments, int exitCode = kFailed) {
    std::string const before = Kept();
    ToolRun const run = Tool(arguments);
    EXPECT_EQ(run.exitCode, exitCode) << testing::PrintToString(arguments);
    EXPECT_EQ(run.out, "") << testing::PrintToString(arguments);
    EXPECT_EQ(std::count(run.err.begin(), run.err.end(), '\n'), 1) << run.err;
    EXPECT_THAT(run.err, StartsWith("ostinet: "));
    EXPECT_EQ(Kept(), before) << testing::PrintToString(arguments);
    return run.err;
  }
  json List() { return json::parse(Do({"list", "--json"}).out); }
  json FirstDevice() { return List()["devices"].at(0); }
  json PortNamed(char const* list, std::string const& name) {
    auto const studio = List();
    for (auto const& port : studio[list]) {
      if (port["name"] == name) {
        return port;
      }
    }
    ADD_FAILURE() << "no port " << name;
    return {};
  }
  std::string Kept() const { return ReadFile("Ostinet.xml") + ReadFile("virtual.json"); }
  std::string SettingsFile(std::string const& name) const {
    return (std::filesystem::path(PathOf("settings")) / name).string();
  }
  std::string ReadFile(std::string const& name) const {
    std::ifstream stream(SettingsFile(name), std::ios::binary);
    return {std::istreambuf_iterator<char>(stream), std::istreambuf_iterator<char>()};
  }
};

TEST_F(EditCommands, ADeviceIsMadeKeptAndDeleted) {
  ToolRun const made = Do({"device", "new", "Synth"});
  EXPECT_THAT(made.out, MatchesPattern("Synth  #[0-9]+\n"));
  auto const device = FirstDevice();
  EXPECT_EQ(device["name"], "Synth");
  EXPECT_EQ("Synth  #" + device["uniqueID"].dump() + "\n", made.out);
  ASSERT_EQ(device["entities"].size(), 1u);
  EXPECT_EQ(device["entities"][0]["sources"].size(), 1u);
  EXPECT_EQ(device["entities"][0]["destinations"].size(), 1u);
  // A part of a name is enough, so what went is told.
  EXPECT_EQ(Do({"device", "delete", "syn"}).out, made.out);
  EXPECT_TRUE(List()["devices"].empty());
}

TEST_F(EditCommands, ATakenNameGetsANumber) {
  Do({"device", "new", "Synth"});
  auto const made = json::parse(Do({"device", "new", "--json", "Synth"}).out);
  EXPECT_EQ(made["name"], "Synth 2");
  EXPECT_TRUE(made["uniqueID"].is_number());
  EXPECT_EQ(List()["devices"].size(), 2u);
}

TEST_F(EditCommands, ANewDeviceHasAsManyEndsAsAsked) {
  Do({"device", "new", "Rack", "--inputs", "0", "--outputs", "3"});
  auto const entity = FirstDevice()["entities"][0];
  EXPECT_EQ(entity["sources"].size(), 0u);
  EXPECT_EQ(entity["destinations"].size(), 3u);
  EXPECT_THAT(Fails({"device", "new", "X", "--inputs", "65"}, kUsage), HasSubstr("--inputs"));
  EXPECT_THAT(Fails({"device", "new", "X", "--outputs", "-1"}, kUsage), HasSubstr("--outputs"));
  EXPECT_THAT(Fails({"device", "new", "X", "--outputs", "two"}, kUsage), HasSubstr("--outputs"));
}

TEST_F(EditCommands, ANameNeedsLetters) {
  EXPECT_THAT(Fails({"device", "new", ""}, kUsage), HasSubstr("empty"));
  EXPECT_THAT(Fails({"device", "new", "  "}, kUsage), HasSubstr("empty"));
  Do({"device", "new", "Synth"});
  Fails({"device", "rename", "Synth", ""}, kUsage);
  Fails({"entity", "new", "Synth", " "}, kUsage);
  Fails({"virtual", "new", ""}, kUsage);
}

TEST_F(EditCommands, ADeviceIsRenamedUnlessAnotherHasTheName) {
  Do({"device", "new", "Synth"});
  Do({"device", "new", "Drums"});
  EXPECT_THAT(Fails({"device", "rename", "Synth", "drums"}), HasSubstr("\"Drums\" already"));
  Do({"device", "rename", "Synth", "SYNTH"});
  Do({"device", "rename", "SYNTH", "Pad & Bass <1>"});
  EXPECT_EQ(FirstDevice()["name"], "Pad & Bass <1>");
  EXPECT_EQ(FirstDevice()["entities"][0]["destinations"][0]["name"], "Pad & Bass <1>");
}

TEST_F(EditCommands, WhatIsNotThereIsNamed) {
  EXPECT_THAT(Fails({"device", "delete", "Nobody"}), HasSubstr("no device \"Nobody\""));
  Do({"device", "new", "Synth A"});
  Do({"device", "new", "Synth B"});
  EXPECT_THAT(Fails({"device", "delete", "Synth"}), HasSubstr("more than one device"));
  EXPECT_THAT(Fails({"device", "rename", "Nobody", "X"}), HasSubstr("\"Synth A\""));
  EXPECT_THAT(Fails({"entity", "delete", "Synth A", "Port 9"}), HasSubstr("no entity"));
  EXPECT_THAT(Fails({"device", "set", "Nobody", "model", "X"}), HasSubstr("device or port"));
  EXPECT_THAT(Fails({"device", "type", "Synth A", "Nobody", "X"}), HasSubstr("no maker"));
  EXPECT_THAT(Fails({"virtual", "delete", "Nobody"}), HasSubstr("virtual endpoint"));
}

TEST_F(EditCommands, WrongUseIsTold) {
  Fails({"device"}, kUsage);
  Fails({"device", "frobnicate"}, kUsage);
  Fails({"device", "new"}, kUsage);
  Fails({"device", "new", "X", "Maker"}, kUsage);
  Fails({"device", "set", "X", "model"}, kUsage);
  Fails({"entity", "new", "X"}, kUsage);
  Fails({"connect", "X"}, kUsage);
  Fails({"virtual", "new", "X", "-i", "-o"}, kUsage);
  Fails({"draw", "-o"}, kUsage);
}

TEST_F(EditCommands, PropertiesAreSetAndRead) {
  Do({"device", "new", "Synth"});
  std::vector<std::pair<std::string, std::string>> const values = {{"manufacturer", "Acme & Sons"},
                                                                   {"model", "S-1"},
                                                                   {"device-id", "17"},
                                                                   {"schedule-ahead", "1500"},
                                                                   {"receive-channels", "1-4, 10"},
                                                                   {"transmit-channels", "16"},
                                                                   {"drum-machine", "yes"},
                                                                   {"receives-clock", "yes"},
                                                                   {"receives-notes", "no"},
                                                                   {"channel-1", "Lead"},
                                                                   {"channel-16", "Drums"}};
  for (auto const& [key, value] : values) {
    Do({"device", "set", "Synth", key, value});
  }
  for (auto const& [key, value] : values) {
    EXPECT_EQ(Do({"device", "get", "Synth", key}).out, value + "\n") << key;
  }
  auto const lines = Do({"device", "get", "Synth"}).Lines();
  EXPECT_THAT(lines, testing::Contains("model: S-1"));
  EXPECT_THAT(lines, testing::Contains("mixer: no"));
  EXPECT_THAT(lines, testing::Contains("channel-16: Drums"));
  EXPECT_THAT(lines, Not(testing::Contains(StartsWith("channel-2"))));
  auto const answer = json::parse(Do({"device", "get", "Synth", "--json"}).out);
  EXPECT_EQ(answer["name"], "Synth");
  EXPECT_EQ(answer["device-id"], 17);
  EXPECT_EQ(answer["receive-channels"], 0x20F);
  EXPECT_EQ(answer["drum-machine"], true);
  EXPECT_EQ(answer["channel-2"], "");
}

TEST_F(EditCommands, ADeviceOfWhichNothingWasSaidHasDefaults) {
  Do({"device", "new", "Synth"});
  EXPECT_EQ(Do({"device", "get", "Synth", "device-id"}).out, "none\n");
  EXPECT_EQ(Do({"device", "get", "Synth", "receive-channels"}).out, "all\n");
  EXPECT_EQ(Do({"device", "get", "Synth", "receives-notes"}).out, "yes\n");
  EXPECT_EQ(Do({"device", "get", "Synth", "receives-clock"}).out, "no\n");
  EXPECT_TRUE(json::parse(Do({"device", "get", "Synth", "--json"}).out)["device-id"].is_null());
  Do({"device", "set", "Synth", "device-id", "5"});
  Do({"device", "set", "Synth", "device-id", "none"});
  EXPECT_EQ(Do({"device", "get", "Synth", "device-id"}).out, "none\n");
}

TEST_F(EditCommands, AValueThatAPropertyDoesNotTakeIsRefused) {
  Do({"device", "new", "Synth"});
  std::vector<std::pair<std::string, std::string>> const wrong = {{"device-id", "128"},
                                                                  {"device-id", "-1"},
                                                                  {"device-id", "1x"},
                                                                  {"device-id", ""},
                                                                  {"schedule-ahead", "fast"},
                                                                  {"receive-channels", "0"},
                                                                  {"receive-channels", "17"},
                                                                  {"receive-channels", "4-1"},
                                                                  {"receive-channels", ""},
                                                                  {"receive-channels", "1,,2"},
                                                                  {"mixer", "maybe"},
                                                                  {"channel-17", "X"},
                                                                  {"schedule-ahead", "99999999"},
                                                                  {"no-such-key", "1"}};
  for (auto const& [key, value] : wrong) {
    EXPECT_THAT(Fails({"device", "set", "Synth", key, value}, kUsage), HasSubstr(key));
  }
  Fails({"device", "get", "Synth", "no-such-key"}, kUsage);
}

TEST_F(EditCommands, APortHasPropertiesToo) {
  Do({"device", "set", "Chip", "manufacturer", "Acme"});
  EXPECT_EQ(Do({"device", "get", "Chip", "manufacturer"}).out, "\n")
      << "software ports are not kept";
  Do({"device", "set", "#" + PortNamed("destinations", "Desk 1")["uniqueID"].dump(), "model",
      "Desk"});
  auto const id = PortNamed("destinations", "Desk 1")["uniqueID"].dump();
  EXPECT_EQ(Do({"device", "get", "#" + id, "model"}).out, "Desk\n");
  EXPECT_THAT(Fails({"device", "get", "Desk 1"}), HasSubstr("more than one device or port"));
}

TEST_F(EditCommands, ADeviceBecomesOneOfACataloguedType) {
  Do({"device", "new", "Lead", "Access", "Virus TI"});
  auto const lead = FirstDevice();
  EXPECT_EQ(lead["manufacturer"], "Access");
  EXPECT_EQ(lead["model"], "Virus TI");
  EXPECT_EQ(lead["entities"].size(), 2u);
  Do({"device", "new", "Other"});
  Do({"device", "type", "Other", "access", "virus ti"});
  auto const other = List()["devices"][1];
  EXPECT_EQ(other["name"], "Other");
  EXPECT_EQ(other["model"], "Virus TI");
  EXPECT_EQ(other["entities"].size(), 2u);
  Fails({"device", "new", "X", "Access", "Nothing of theirs"});
}

TEST_F(EditCommands, EntitiesComeAndGo) {
  Do({"device", "new", "Rack"});
  ToolRun const made = Do({"entity", "new", "Rack", "Port 2", "--inputs", "0", "--outputs", "2"});
  EXPECT_THAT(made.out, StartsWith("Rack Port 2  #"));
  auto entities = FirstDevice()["entities"];
  ASSERT_EQ(entities.size(), 2u);
  EXPECT_EQ(entities[1]["sources"].size(), 0u);
  EXPECT_EQ(entities[1]["destinations"].size(), 2u);
  EXPECT_EQ(Do({"entity", "delete", "Rack", "Port 2"}).out, made.out);
  EXPECT_EQ(FirstDevice()["entities"].size(), 1u);
  Fails({"entity", "new", "Nobody", "Port"});
}

TEST_F(EditCommands, AnInstrumentHangsOnAPortBothWays) {
  Do({"device", "new", "Synth"});
  EXPECT_EQ(Do({"connect", "Synth", "Desk 1"}).out, "");
  auto const entity = FirstDevice()["entities"][0];
  EXPECT_EQ(entity["sources"][0]["port"], "Desk 1");
  EXPECT_EQ(entity["destinations"][0]["port"], "Desk 1");
  EXPECT_EQ(entity["destinations"][0]["online"], true);
  EXPECT_THAT(PortNamed("destinations", "Desk 1")["connected"], ElementsAre("Synth"));
  EXPECT_EQ(Do({"list", "-l"}).Lines().size(), 13u);
  Do({"connect", "Synth", "Desk 1"});  // again
  Do({"disconnect", "Synth"});
  EXPECT_TRUE(FirstDevice()["entities"][0]["destinations"][0]["port"].is_null());
  EXPECT_TRUE(FirstDevice()["entities"][0]["sources"][0]["port"].is_null());
  EXPECT_TRUE(PortNamed("destinations", "Desk 1")["connected"].empty());
}

TEST_F(EditCommands, OneDirectionCanBeAskedFor) {
  Do({"device", "new", "Synth"});
  Do({"connect", "-o", "Synth", "Desk 1"});
  Do({"connect", "-i", "Synth", "Desk 2"});
  auto entity = FirstDevice()["entities"][0];
  EXPECT_EQ(entity["destinations"][0]["port"], "Desk 1");
  EXPECT_EQ(entity["sources"][0]["port"], "Desk 2");
  Do({"disconnect", "-i", "Synth"});
  entity = FirstDevice()["entities"][0];
  EXPECT_EQ(entity["destinations"][0]["port"], "Desk 1");
  EXPECT_TRUE(entity["sources"][0]["port"].is_null());
  EXPECT_THAT(Fails({"disconnect", "-i", "Synth"}), HasSubstr("hangs on no port"));
}

TEST_F(EditCommands, AnInstrumentThatIsConnectedAnewMoves) {
  Do({"device", "new", "Synth"});
  Do({"connect", "Synth", "Desk 1"});
  Do({"connect", "Synth", "Desk 2"});
  EXPECT_EQ(FirstDevice()["entities"][0]["destinations"][0]["port"], "Desk 2");
  EXPECT_TRUE(PortNamed("destinations", "Desk 1")["connected"].empty());
}

TEST_F(EditCommands, WhatCannotBeConnectedIsTold) {
  Do({"device", "new", "Synth"});
  EXPECT_THAT(Fails({"connect", "Nobody", "Desk 1"}), HasSubstr("\"Nobody\""));
  EXPECT_THAT(Fails({"connect", "Synth", "Nowhere"}), HasSubstr("port \"Nowhere\""));
  EXPECT_THAT(Fails({"connect", "Synth", "Desk"}), HasSubstr("more than one"));
  EXPECT_THAT(Fails({"connect", "-o", "Synth", "Chip"}), HasSubstr("software"));
  EXPECT_THAT(Fails({"disconnect", "Synth"}), HasSubstr("hangs on no port"));
  Do({"connect", "Synth", "Desk 1"});
  EXPECT_THAT(Fails({"disconnect", "Synth", "Desk 2"}), HasSubstr("not on \"Desk 2\""));
  Do({"disconnect", "Synth", "Desk 1"});
}

// The ends of a device share its ID, so the second cannot hang on the first port that lists it.
TEST_F(EditCommands, AConnectionThatWouldNotComeBackIsRefused) {
  Do({"device", "new", "Rack", "--inputs", "0", "--outputs", "2"});
  auto const ends = FirstDevice()["entities"][0]["destinations"];
  std::string const first = ends[0]["name"];
  std::string const second = ends[1]["name"];
  ASSERT_NE(first, second);
  EXPECT_THAT(Fails({"connect", second, "Desk 1"}), HasSubstr("in the order of the ports"));
  Do({"connect", first, "Desk 1"});
  Do({"connect", second, "Desk 2"});
  auto const kept = FirstDevice()["entities"][0]["destinations"];
  EXPECT_EQ(kept[0]["port"], "Desk 1");
  EXPECT_EQ(kept[1]["port"], "Desk 2");
}

TEST_F(EditCommands, ADeletedDeviceLeavesNoNumberWithItsPort) {
  Do({"device", "new", "Synth"});
  Do({"connect", "Synth", "Desk 1"});
  Do({"device", "delete", "Synth"});
  EXPECT_THAT(ReadFile("Ostinet.xml"), Not(HasSubstr("IntItem")));
}

// Else the first end, which bears the same number, could not be taken off its port any more.
TEST_F(EditCommands, ATypeWithFewerEndsLeavesNoNumberWithTheirPorts) {
  Do({"device", "new", "Lead", "Access", "Virus TI"});
  auto const entities = FirstDevice()["entities"];
  ASSERT_EQ(entities.size(), 2u);
  Do({"connect", entities[0]["sources"][0]["name"], "Desk 1"});
  Do({"connect", entities[1]["sources"][0]["name"], "Desk 2"});
  Do({"device", "type", "Lead", "Roland", "JD-Xi"});
  EXPECT_EQ(FirstDevice()["entities"][0]["sources"][0]["port"], "Desk 1");
  EXPECT_EQ(FirstDevice()["entities"][0]["destinations"][0]["port"], "Desk 1");
  Do({"disconnect", "Lead"});
  EXPECT_THAT(ReadFile("Ostinet.xml"), Not(HasSubstr("IntItem")));
}

TEST_F(EditCommands, AVirtualEndpointIsThereInEveryRunUntilItIsDeleted) {
  auto const made = json::parse(Do({"virtual", "new", "Loop", "--json"}).out);
  EXPECT_EQ(made["name"], "Loop");
  for (int run = 0; run < 2; ++run) {
    auto const source = PortNamed("sources", "Loop");
    EXPECT_EQ(source["virtual"], true);
    EXPECT_EQ(source["private"], false);
    EXPECT_EQ(source["uniqueID"], made["uniqueID"]);
    EXPECT_EQ(PortNamed("destinations", "Loop")["private"], true);
  }
  ToolRun const heard =
      Do({"monitor", "Loop", "--hex", "--count", "1", "--send", "Loop: 90 3C 40"});
  EXPECT_THAT(heard.out, HasSubstr("90 3C 40"));
  EXPECT_EQ(json::parse(Do({"virtual", "delete", "loop", "--json"}).out), made);
  EXPECT_THAT(List()["sources"].dump(), Not(HasSubstr("Loop")));
}

TEST_F(EditCommands, AVirtualEndpointMayShowItsOutput) {
  Do({"virtual", "new", "-o", "Bus"});
  EXPECT_EQ(PortNamed("destinations", "Bus")["private"], false);
  EXPECT_EQ(PortNamed("sources", "Bus")["private"], true);
  EXPECT_THAT(Do({"monitor", "Bus", "--hex", "--count", "1", "--send", "Bus: F8"}).out,
              HasSubstr("F8"));
}

TEST_F(EditCommands, AFileOfVirtualEndpointsThatIsDamagedIsKeptAndTold) {
  Do({"virtual", "new", "Loop"});
  for (char const* const damage :
       {"{", "[]", R"({"virtual": [{"public": "both", "reference": "00"}]})",
        R"({"virtual": [{"public": "source", "reference": "xy"}]})"}) {
    std::ofstream(SettingsFile("virtual.json"), std::ios::binary) << damage;
    EXPECT_THAT(Fails({"virtual", "new", "Other"}), HasSubstr("virtual.json"));
  }
}

TEST_F(EditCommands, AStudioThatCannotBeReadIsKeptAndTold) {
  Do({"device", "new", "Synth"});
  std::string const whole = ReadFile("Ostinet.xml");
  for (std::string const& damaged : {whole.substr(0, whole.size() - 5), std::string("<Other/>")}) {
    std::ofstream(SettingsFile("Ostinet.xml"), std::ios::binary) << damaged;
    ToolRun const edit = Tool({"device", "new", "Other"});
    EXPECT_EQ(edit.exitCode, kFailed);
    EXPECT_EQ(edit.out, "");
    EXPECT_THAT(edit.err, HasSubstr("nothing is saved over a studio that cannot be read"));
    EXPECT_EQ(Kept(), damaged);
    ToolRun const look = Tool({"list"});
    EXPECT_EQ(look.exitCode, kDone);
    EXPECT_THAT(look.err, HasSubstr("Ostinet.xml\" cannot be read to its end: "));
  }
  std::ofstream(SettingsFile("Ostinet.xml"), std::ios::binary) << "";
  Do({"device", "new", "Synth"});
}

// A folder where the file should be: nothing can be renamed over it.
TEST_F(EditCommands, ASaveThatFailsIsTold) {
  std::filesystem::create_directories(SettingsFile("Ostinet.xml"));
  ToolRun const run = Tool({"device", "new", "Synth"});
  EXPECT_EQ(run.exitCode, kFailed);
  EXPECT_EQ(run.out, "");
  EXPECT_THAT(run.err, HasSubstr("could not be saved"));
}

TEST_F(EditCommands, LookingSavesNothing) {
  Do({"device", "new", "Synth"});
  auto const time = std::filesystem::last_write_time(SettingsFile("Ostinet.xml"));
  Do({"list"});
  Do({"device", "get", "Synth"});
  Do({"draw"});
  EXPECT_EQ(std::filesystem::last_write_time(SettingsFile("Ostinet.xml")), time);
}

TEST_F(EditCommands, ThePictureGoesToTheOutputOrToAFile) {
  Do({"device", "new", "Synth & Co"});
  Do({"connect", "Synth & Co", "Desk 1"});
  ToolRun const printed = Do({"draw"});
  EXPECT_THAT(printed.out, StartsWith("<?xml"));
  EXPECT_THAT(printed.out, testing::EndsWith("</svg>\n"));
  EXPECT_THAT(printed.out, HasSubstr("Synth &amp; Co"));
  std::string const path = PathOf("studio.svg");
  EXPECT_EQ(Do({"draw", "-o", path}).out, "");
  std::ifstream stream(path, std::ios::binary);
  std::string const written{std::istreambuf_iterator<char>(stream),
                            std::istreambuf_iterator<char>()};
  EXPECT_EQ(written.size(), printed.out.size());
  EXPECT_THAT(Fails({"draw", "-o", PathOf("no/such/folder/x.svg")}),
              HasSubstr("cannot be written"));
}

}  // namespace
}  // namespace Ostinet::Tool

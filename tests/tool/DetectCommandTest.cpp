// SPDX-License-Identifier: MIT
#include <gmock/gmock.h>

#include "RunTool.h"

namespace Ostinet::Tool {
namespace {

using testing::HasSubstr;

// On one port, a Korg M1 and a Waldorf Blofeld, which answers by another input.
constexpr char kStudio[] = R"({
  "ports": [ {"name": "Desk Out", "kind": "winmm-out"}, {"name": "Desk In", "kind": "winmm-in"},
             {"name": "Rack Out", "kind": "winmm-out"}, {"name": "Rack In", "kind": "winmm-in"} ],
  "instruments": [
    {"out": "Desk Out", "in": "Desk In", "device-id": 3, "identity": "42 19 00 00 00 13 00 01 00"},
    {"out": "Desk Out", "in": "Rack In", "device-id": 5, "identity": "3E 13 00 00 00"} ] })";

// Long enough for the inquiry and the wait for its answers.
constexpr char kSeconds[] = "1.2";

class DetectCommand : public ToolTest {
 protected:
  // What the ports answered, by their names.
  std::map<std::string, json> Detect(std::vector<std::string> arguments) {
    arguments.insert(arguments.begin(), {"detect", "--json", "--timeout", kSeconds});
    ToolRun const run = RunOn(kStudio, arguments);
    EXPECT_EQ(run.exitCode, kDone) << run.err;
    auto const lines = run.JSONLines();
    std::map<std::string, json> ports;
    for (json const& port : lines.at(0)["ports"]) {
      ports[port["name"].get<std::string>()] = port;
    }
    return ports;
  }
};

json const* FindModel(json const& port, std::string const& model) {
  for (json const& instrument : port["instruments"]) {
    if (instrument["types"].at(0)["model"] == model) {
      return &instrument;
    }
  }
  return nullptr;
}

TEST_F(DetectCommand, TellsWhichInstrumentsAnswerOnAPort) {
  auto const ports = Detect({});
  ASSERT_EQ(ports.size(), 2u);
  json const& desk = ports.at("Desk Out");
  EXPECT_EQ(desk["outcome"], "time-limit");
  EXPECT_EQ(desk["instruments"].size(), 2u);
  json const* const m1 = FindModel(desk, "M1");
  ASSERT_NE(m1, nullptr) << desk;
  EXPECT_EQ((*m1)["types"][0]["manufacturer"], "Korg");
  EXPECT_EQ((*m1)["deviceID"], 3);
  EXPECT_EQ((*m1)["source"]["name"], "Desk In");
  EXPECT_EQ((*m1)["identity"], "42 19 00 00 00");
  EXPECT_TRUE((*m1)["device"].is_null());
  json const* const blofeld = FindModel(desk, "Blofeld");
  ASSERT_NE(blofeld, nullptr) << desk;
  EXPECT_EQ((*blofeld)["source"]["name"], "Rack In");
  EXPECT_TRUE(ports.at("Rack Out")["instruments"].empty());
}

TEST_F(DetectCommand, TellsPeopleInLines) {
  ToolRun const run = RunOn(kStudio, {"detect", "desk", "--timeout", kSeconds});
  EXPECT_EQ(run.exitCode, kDone) << run.err;
  EXPECT_THAT(run.out, HasSubstr("\n  Korg M1  device ID 3  on Desk In\n"));
  EXPECT_THAT(run.out, HasSubstr("\n  (its time was over before everything was asked)\n"));
  EXPECT_EQ(run.err, "") << "no terminal, no progress";
}

TEST_F(DetectCommand, AsksThePortsThatAreNamed) {
  auto const ports = Detect({"rack"});
  ASSERT_EQ(ports.size(), 1u);
  EXPECT_EQ(ports.count("Rack Out"), 1u);
}

TEST_F(DetectCommand, LeavesOutWhatIsExcluded) {
  auto const ports = Detect({"--exclude", "Rack Out", "--exclude", "Rack In"});
  ASSERT_EQ(ports.size(), 1u);
  EXPECT_NE(FindModel(ports.at("Desk Out"), "M1"), nullptr);
  EXPECT_EQ(FindModel(ports.at("Desk Out"), "Blofeld"), nullptr) << "its input is not heard";
}

TEST_F(DetectCommand, FailsForPortsThatAreNotThere) {
  EXPECT_EQ(RunOn(kStudio, {"detect", "nowhere"}).exitCode, kFailed);
  EXPECT_EQ(RunOn(kStudio, {"detect", "--exclude", "nowhere"}).exitCode, kFailed);
  EXPECT_EQ(RunOn("{}", {"detect"}).exitCode, kFailed);
  EXPECT_EQ(RunOn(kStudio, {"detect", "--timeout", "-1"}).exitCode, kUsage);
}

// The whole road: what answers becomes part of the studio, and is there at the next start.
TEST_F(DetectCommand, MakesDevicesThatAreThereAtTheNextStart) {
  auto const ports = Detect({"desk", "--create"});
  json const* const m1 = FindModel(ports.at("Desk Out"), "M1");
  ASSERT_NE(m1, nullptr);
  EXPECT_EQ((*m1)["device"]["name"], "M1");

  json const studio = json::parse(RunOn(kStudio, {"list", "--json"}).out);
  ASSERT_EQ(studio["devices"].size(), 2u);
  for (json const& device : studio["devices"]) {
    bool const isM1 = device["name"] == "M1";
    EXPECT_EQ(device["manufacturer"], isM1 ? "Korg" : "Waldorf");
    EXPECT_EQ(device["model"], isM1 ? "M1" : "Blofeld");
    EXPECT_EQ(device["online"], true);
    json const& entity = device["entities"].at(0);
    EXPECT_EQ(entity["destinations"].at(0)["port"], "Desk Out");
    EXPECT_EQ(entity["sources"].at(0)["port"], isM1 ? "Desk In" : "Rack In");
  }

  // A second time there is nothing to make.
  auto const again = Detect({"desk", "--create"});
  EXPECT_TRUE((*FindModel(again.at("Desk Out"), "M1"))["device"].is_null());
  json const after = json::parse(RunOn(kStudio, {"list", "--json"}).out);
  EXPECT_EQ(after["devices"].size(), 2u);
}

}  // namespace
}  // namespace Ostinet::Tool

// SPDX-License-Identifier: MIT
#include <gmock/gmock.h>

#include "RunTool.h"

namespace Ostinet::Tool {
namespace {

using testing::HasSubstr;
using testing::Not;

class ListCommand : public ToolTest {
 protected:
  json ListJSON(std::string const& studio, std::vector<std::string> arguments = {}) {
    arguments.insert(arguments.begin(), {"list", "--json"});
    ToolRun const run = RunOn(studio, arguments);
    EXPECT_EQ(run.exitCode, kDone) << run.err;
    EXPECT_EQ(run.err, "");
    return json::parse(run.out);
  }
};

char const* const kManyPorts = R"({ "ports": [
  {"name": "Interface 1", "kind": "winmm-out", "technology": 1},
  {"name": "Interface 1", "kind": "winmm-in"},
  {"name": "Old Port", "kind": "winmm-out", "directmusic": false},
  {"name": "Chip", "kind": "winmm-out", "technology": 4},
  {"name": "Native", "kind": "directmusic-out", "external": true, "latency-us": 1499},
  {"name": "Soft Synth", "kind": "directmusic-out", "dls": true} ] })";

TEST_F(ListCommand, GivesEmptyListsForAStudioWithoutPorts) {
  EXPECT_EQ(ListJSON(R"({"ports": []})"),
            json::parse(R"({"devices": [], "sources": [], "destinations": []})"));
}

TEST_F(ListCommand, PrintsNothingForAStudioWithoutPorts) {
  ToolRun const run = RunOn(R"({"ports": []})", {"list"});
  EXPECT_EQ(run.exitCode, kDone);
  EXPECT_EQ(run.out, "");
}

TEST_F(ListCommand, ShowsEachPortWithItsFacts) {
  auto const studio = ListJSON(kManyPorts);
  std::map<std::string, json> byName;
  for (auto const& destination : studio["destinations"]) {
    byName[destination["name"]] = destination;
  }
  ASSERT_EQ(byName.size(), 4u) << studio.dump(2);
  ASSERT_EQ(studio["sources"].size(), 1u);
  for (auto const& [name, port] : byName) {
    EXPECT_EQ(port["direct"], true) << name;
    EXPECT_EQ(port["online"], true) << name;
    EXPECT_EQ(port["virtual"], false) << name;
    EXPECT_EQ(port["private"], false) << name;
    EXPECT_EQ(port["channels"], 65535) << name;
    EXPECT_TRUE(port["port"].is_null()) << name;
    EXPECT_EQ(port["connected"], json::array()) << name;
    EXPECT_NE(port["uniqueID"], 0) << name;
  }
  EXPECT_EQ(byName["Interface 1"]["software"], false);
  EXPECT_EQ(byName["Chip"]["software"], true);
  EXPECT_EQ(byName["Soft Synth"]["software"], true);
  EXPECT_EQ(byName["Native"]["software"], false);
  EXPECT_EQ(studio["sources"][0]["name"], "Interface 1");
}

// DirectMusic does not list it, and a port that only WinMM knows makes no endpoint.
TEST_F(ListCommand, LeavesOutAPortThatDirectMusicDoesNotKnow) {
  EXPECT_THAT(ListJSON(kManyPorts).dump(), Not(HasSubstr("Old Port")));
}

TEST_F(ListCommand, ShowsATreeForPeople) {
  ToolRun const run = RunOn(kCabledStudio, {"list"});
  EXPECT_EQ(run.exitCode, kDone);
  auto const lines = run.Lines();
  ASSERT_EQ(lines.size(), 4u) << run.out;
  EXPECT_EQ(lines[0], "Inputs");
  EXPECT_THAT(lines[1], HasSubstr("  In 1  (online"));
  EXPECT_EQ(lines[2], "Outputs");
  EXPECT_THAT(lines[3], HasSubstr("  Out 1  (online"));
}

TEST_F(ListCommand, ShowsOnlyInputsOrOutputs) {
  EXPECT_TRUE(ListJSON(kCabledStudio, {"-i"})["destinations"].empty());
  EXPECT_EQ(ListJSON(kCabledStudio, {"-i"})["sources"].size(), 1u);
  EXPECT_TRUE(ListJSON(kCabledStudio, {"-o"})["sources"].empty());
  EXPECT_EQ(ListJSON(kCabledStudio, {"-o"})["destinations"].size(), 1u);
  EXPECT_EQ(ListJSON(kCabledStudio, {"-io"}), ListJSON(kCabledStudio, {"-i", "-o"}));
}

TEST_F(ListCommand, ShowsNoLoosePortsAmongDevicesAndConnections) {
  EXPECT_TRUE(ListJSON(kCabledStudio, {"-d"})["sources"].empty());
  EXPECT_TRUE(ListJSON(kCabledStudio, {"-l"})["destinations"].empty());
}

}  // namespace
}  // namespace Ostinet::Tool

// SPDX-License-Identifier: MIT
#include <gmock/gmock.h>

#include "RunTool.h"

namespace Ostinet::Tool {
namespace {

using testing::Contains;
using testing::ElementsAre;
using testing::HasSubstr;
using testing::SizeIs;

/// The device types that ship, which the program finds in the tree that it was built in.
class Types : public ToolTest {
 protected:
  std::string WriteTypes(std::string const& content) {
    return WriteFile("mine.middev", "<MIDIDeviceTypes>\n" + content + "</MIDIDeviceTypes>");
  }
};

TEST_F(Types, ListsTheMakers) {
  ToolRun const run = Run({"types"});
  EXPECT_EQ(run.exitCode, kDone) << run.err;
  EXPECT_THAT(run.Lines(), Contains(MatchesPattern("Roland \\([0-9]+ models\\)")));
  EXPECT_THAT(run.Lines(), Contains("Strymon (1 model)"));
  json const makers = json::parse(Run({"types", "--json"}).out)["manufacturers"];
  EXPECT_GT(makers.size(), 30u);
  EXPECT_EQ(makers[0].size(), 2u);
  EXPECT_GT(makers[0]["models"], 0);
}

TEST_F(Types, ListsTheModelsOfAMakerAsPeopleSortThem) {
  ToolRun const run = Run({"types", "arturia"});
  EXPECT_EQ(run.exitCode, kDone) << run.err;
  EXPECT_THAT(run.Lines(),
              ElementsAre("BeatStep", "KeyLab 25", "KeyLab 49", "KeyLab 88", "MiniLab mkII"));
  json const answer = json::parse(Run({"types", "Arturia", "--json"}).out);
  EXPECT_EQ(answer["manufacturer"], "Arturia");
  EXPECT_THAT(answer["models"], SizeIs(5));
}

TEST_F(Types, ShowsWhatIsKnownOfAModel) {
  ToolRun const run = Run({"types", "Roland", "v-synth"});
  EXPECT_EQ(run.exitCode, kDone) << run.err;
  EXPECT_THAT(
      run.Lines(),
      ElementsAre("Roland V-Synth", "  identity: 41 53 01 00 00", "  device ID: 16 of 16 to 31",
                  "  channels: receives on 16, transmits on 16", "  transmits program changes: yes",
                  "  Port 1: 1 input, 1 output"));
}

TEST_F(Types, ShowsAModelAsJSON) {
  json const type = json::parse(Run({"types", "Akai", "MPC60 II", "--json"}).out);
  EXPECT_EQ(type["manufacturer"], "Akai");
  EXPECT_EQ(type["model"], "MPC60 II");
  EXPECT_EQ(type["identity"], nullptr);
  EXPECT_EQ(type["deviceID"], nullptr);
  EXPECT_EQ(type["image"], nullptr);
  EXPECT_EQ(type["receiveMaxChannels"], 16);
  EXPECT_EQ(type["flags"], json({{"is sampler", true}, {"is drum machine", true}}));
  ASSERT_THAT(type["ports"], SizeIs(4));
  EXPECT_EQ(type["ports"][3],
            json({{"name", ""}, {"inputs", json::array()}, {"outputs", json::array({""})}}));
  json const other = json::parse(Run({"types", "Korg", "M1", "--json"}).out);
  EXPECT_EQ(other["identity"], "42 19 00 00 00");
  EXPECT_EQ(other["deviceID"], json({{"default", 0}, {"min", 0}, {"max", 15}}));
}

TEST_F(Types, WhatIsNotThereFails) {
  ToolRun const maker = Run({"types", "Nobody"});
  EXPECT_EQ(maker.exitCode, kFailed);
  EXPECT_THAT(maker.err, HasSubstr("there is no maker \"Nobody\""));
  ToolRun const model = Run({"types", "Roland", "KeyLab"});
  EXPECT_EQ(model.exitCode, kFailed);
  EXPECT_THAT(model.err, HasSubstr("there is no model \"KeyLab\""));
  ToolRun const many = Run({"types", "Arturia", "Key"});
  EXPECT_EQ(many.exitCode, kFailed);
  EXPECT_THAT(many.err,
              HasSubstr("more than one model fits \"Key\": \"KeyLab 25\", \"KeyLab 49\""));
}

TEST_F(Types, ChecksGoodFiles) {
  std::string const file = WriteTypes("<MIDIDeviceType Manufacturer='Acme' Model='Lead'/>");
  ToolRun const run = Run({"types", "--check", file});
  EXPECT_EQ(run.exitCode, kDone) << run.err;
  EXPECT_THAT(run.Lines(), ElementsAre(file + ": 1 type, nothing is skipped"));
}

TEST_F(Types, TellsWhatOfAFileWouldBeSkipped) {
  std::string const bad = WriteTypes(
      "<MIDIDeviceType Manufacturer='Acme' Model='Lead'>\n<Receives MaxChannels='17'/>\n"
      "<Strange/></MIDIDeviceType>");
  std::string const none = PathOf("none.middev");
  ToolRun const run = Run({"types", "--check", bad, none});
  EXPECT_EQ(run.exitCode, kFailed);
  EXPECT_THAT(run.Lines(),
              ElementsAre(bad + ":3: \"MaxChannels\" is no number from 0 to 16: it is skipped",
                          HasSubstr(bad + ":4: nothing is known of \"Strange\""),
                          HasSubstr(none + ":0: the file cannot be read: ")));
  EXPECT_THAT(run.err, HasSubstr("not all of it would be read"));

  json const files = json::parse(Run({"types", "--check", "--json", bad}).out)["files"];
  ASSERT_THAT(files, SizeIs(1));
  EXPECT_EQ(files[0]["file"], bad);
  EXPECT_EQ(files[0]["author"], "");
  EXPECT_EQ(files[0]["types"][0], json({{"manufacturer", "Acme"}, {"model", "Lead"}}));
  EXPECT_EQ(files[0]["notes"][0]["line"], 3);
  EXPECT_THAT(files[0]["notes"], SizeIs(2));
}

TEST_F(Types, WrongUsageEndsWithTwo) {
  EXPECT_EQ(Run({"types", "a", "b", "c"}).exitCode, kUsage);
  EXPECT_EQ(Run({"types", "--check"}).exitCode, kUsage);
}

}  // namespace
}  // namespace Ostinet::Tool

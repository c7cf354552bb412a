// SPDX-License-Identifier: MIT
#include <gmock/gmock.h>

#include "RunTool.h"

namespace Ostinet::Tool {
namespace {

using testing::HasSubstr;

char const* const kReferredDesk = R"({ "ports": [
  {"name": "Desk Out 1", "kind": "winmm-out"}, {"name": "Desk Out 2", "kind": "winmm-out"},
  {"name": "Desk In 1", "kind": "winmm-in"} ] })";
char const* const kTwins = R"({ "ports": [
  {"name": "Desk Out 1", "kind": "winmm-out"}, {"name": "desk out 1", "kind": "winmm-out"},
  {"name": "Desk In 1", "kind": "winmm-in"} ] })";

class ReferenceCommands : public ToolTest {
 protected:
  std::string Reference(std::vector<std::string> arguments) {
    arguments.insert(arguments.begin(), "ref");
    ToolRun const run = RunOn(kReferredDesk, arguments);
    EXPECT_EQ(run.exitCode, kDone) << run.err;
    EXPECT_EQ(run.Lines().size(), 1u);
    return run.Lines().empty() ? "" : run.Lines().front();
  }
};

TEST_F(ReferenceCommands, PrintAReferenceFromABareName) {
  EXPECT_EQ(Reference({"--name-only", "destination", "AB"}),
            "0000000000000000000000040000000200410042"
            "0000000400000000"
            "0000000F00000000000000000000000000"
            "0000");
}

TEST_F(ReferenceCommands, FindAnEndpointByItsReference) {
  std::string const reference = Reference({"Desk Out 2"});
  EXPECT_THAT(reference, testing::StartsWith("00000000000000030000000400000"
                                             "00A"));
  ToolRun const run = RunOn(kReferredDesk, {"resolve", reference});
  EXPECT_EQ(run.exitCode, kDone) << run.err;
  EXPECT_THAT(run.Lines().front(), testing::StartsWith("Desk Out 2 (#"));
  EXPECT_THAT(run.Lines().front(), HasSubstr("same name"));
}

TEST_F(ReferenceCommands, ReferToASource) {
  auto const run = RunOn(kReferredDesk, {"ref", "--json", "-i", "Desk"});
  ASSERT_EQ(run.exitCode, kDone) << run.err;
  auto const answer = json::parse(run.out);
  EXPECT_EQ(answer["type"], "source");
  EXPECT_EQ(answer["name"], "Desk In 1");
  EXPECT_EQ(answer["valid"], true);
  EXPECT_EQ(answer["direct"], true);
  EXPECT_EQ(Reference({"Desk In 1"}), answer["reference"]);
}

TEST_F(ReferenceCommands, ExplainInJSON) {
  std::string const reference = Reference({"--name-only", "destination", "Desk Out 1"});
  ToolRun const run = RunOn(kReferredDesk, {"resolve", "--json", "--name-id", reference});
  ASSERT_EQ(run.exitCode, kDone) << run.err;
  auto const answer = json::parse(run.out);
  EXPECT_EQ(answer["outcome"], "found");
  EXPECT_EQ(answer["best"][0]["name"], "Desk Out 1");
  EXPECT_EQ(answer["best"][0]["weight"], 2);
  EXPECT_EQ(answer["best"][0]["ranks"]["name"], 2);
  EXPECT_TRUE(answer["best"][0]["ranks"]["uniqueID"].is_null());
  EXPECT_EQ(answer["best"][0]["levels"].size(), 1u);
}

TEST_F(ReferenceCommands, SayWhyNothingIsFound) {
  ToolRun const none =
      RunOn(kReferredDesk, {"resolve", Reference({"--name-only", "destination", "Nowhere"})});
  EXPECT_EQ(none.exitCode, kFailed);
  EXPECT_THAT(none.err, HasSubstr("nothing in the studio resembles it"));
  ToolRun const patch =
      RunOn(kReferredDesk, {"resolve", Reference({"--name-only", "patch", "Piano"})});
  EXPECT_EQ(patch.exitCode, kFailed);
  EXPECT_THAT(patch.err, HasSubstr("names no source or destination"));
  ToolRun const broken = RunOn(kReferredDesk, {"resolve", "00 01"});
  EXPECT_EQ(broken.exitCode, kFailed);
  EXPECT_THAT(broken.err, HasSubstr("the bytes hold no reference"));
}

TEST_F(ReferenceCommands, PreferTheExactNameOfTwins) {
  ToolRun const run =
      RunOn(kTwins, {"resolve", Reference({"--name-only", "destination", "Desk Out 1"})});
  ASSERT_EQ(run.exitCode, kDone) << run.err;
  ASSERT_EQ(run.Lines().size(), 2u);
  EXPECT_THAT(run.Lines()[1], HasSubstr("same name but for case and blanks"));
}

TEST_F(ReferenceCommands, TellWrongUse) {
  EXPECT_EQ(RunOn(kReferredDesk, {"resolve", "xyz"}).exitCode, kUsage);
  EXPECT_EQ(RunOn(kReferredDesk, {"ref", "--name-only", "thing", "A"}).exitCode, kUsage);
  EXPECT_EQ(RunOn(kReferredDesk, {"ref", "--name-only", "device"}).exitCode, kUsage);
  EXPECT_EQ(RunOn(kReferredDesk, {"ref", "Nobody"}).exitCode, kFailed);
  EXPECT_EQ(RunOn(kReferredDesk, {"resolve", "00", "--id-name", "--name-id"}).exitCode, kUsage);
}

TEST_F(ReferenceCommands, PairInputsWithOutputs) {
  ToolRun const run = RunOn(kReferredDesk, {"pair"});
  EXPECT_EQ(run.exitCode, kDone) << run.err;
  EXPECT_EQ(run.out, "Desk In/Out 1: Desk In 1 + Desk Out 1 (opposing)\n");
  auto const answer = json::parse(RunOn(kReferredDesk, {"pair", "--json"}).out);
  EXPECT_EQ(answer["pairs"][0]["kind"], "opposing");
}

}  // namespace
}  // namespace Ostinet::Tool

// SPDX-License-Identifier: MIT
#include <gmock/gmock.h>

#include "RunTool.h"

namespace Ostinet::Tool {
namespace {

using testing::HasSubstr;

class MonitorCommand : public ToolTest {
 protected:
  // Ends by itself, also where nothing arrives.
  ToolRun Monitor(std::string const& studio, std::vector<std::string> arguments) {
    arguments.insert(arguments.begin(), {"monitor", "--for", "30"});
    return RunOn(studio, arguments);
  }
};

std::string StudioWithInput(std::string const& events) {
  return R"({ "ports": [ {"name": "Out 1", "kind": "winmm-out", "technology": 1},
                         {"name": "Out 2", "kind": "winmm-out", "technology": 1},
                         {"name": "In 1", "kind": "winmm-in"}, {"name": "In 2", "kind": "winmm-in"} ],
              "events": [ )" +
         events + "] }";
}

std::string InputAt(int ms, std::string const& port, std::string const& bytes) {
  return R"({"at-ms": )" + std::to_string(ms) + R"(, "input": {"port": ")" + port +
         R"(", "bytes": ")" + bytes + R"("}})";
}

TEST_F(MonitorCommand, PrintsInputAsJSON) {
  ToolRun const run =
      Monitor(StudioWithInput(InputAt(50, "In 1", "90 3C 40")), {"--json", "--count", "1"});
  EXPECT_EQ(run.exitCode, kDone) << run.err;
  EXPECT_EQ(run.err, "");
  auto const lines = run.JSONLines();
  ASSERT_EQ(lines.size(), 1u);
  EXPECT_EQ(lines[0].size(), 3u);
  EXPECT_EQ(lines[0]["source"], "In 1");
  EXPECT_EQ(lines[0]["bytes"], "90 3C 40");
  EXPECT_GT(lines[0]["clocks"].get<unsigned long long>(), 0u);
}

// The road from end to end: out of a port, through its cable, and back in.
TEST_F(MonitorCommand, SeesWhatItSendsComeBackThroughACable) {
  ToolRun const run = Monitor(kCabledStudio, {"In 1", "--json", "--count", "3", "--send",
                                              "Out 1: on 60 100 B0 07 7F pc 5"});
  EXPECT_EQ(run.exitCode, kDone) << run.err;
  auto const lines = run.JSONLines();
  ASSERT_EQ(lines.size(), 3u);
  EXPECT_EQ(lines[0]["bytes"], "90 3C 64");
  EXPECT_EQ(lines[1]["bytes"], "B0 07 7F");
  EXPECT_EQ(lines[2]["bytes"], "C0 05");
}

TEST_F(MonitorCommand, SeesASysexComeBackWhole) {
  std::string hex = "F0";
  for (int i = 0; i < 600; ++i) {
    hex += " 2A";
  }
  hex += " F7";
  ToolRun const run = Monitor(kCabledStudio, {"--json", "--count", "1", "--send", "Out 1: " + hex});
  auto const lines = run.JSONLines();
  ASSERT_EQ(lines.size(), 1u) << run.err;
  EXPECT_EQ(lines[0]["bytes"], hex);
}

TEST_F(MonitorCommand, ReceivesScheduledMessagesAtTheirDistance) {
  ToolRun const run =
      Monitor(kCabledStudio, {"--json", "--count", "2", "--send", "Out 1: on 60 100 +300 off 60"});
  auto const lines = run.JSONLines();
  ASSERT_EQ(lines.size(), 2u) << run.err;
  EXPECT_EQ(lines[1]["bytes"], "80 3C 40");
  auto const apart = lines[1]["clocks"].get<long long>() - lines[0]["clocks"].get<long long>();
  // Stamps of input are in milliseconds, and the first message may be late on a busy machine.
  EXPECT_GT(apart, 100 * 10000);
}

TEST_F(MonitorCommand, HearsOnlyTheSourcesThatWereNamed) {
  std::string const studio =
      StudioWithInput(InputAt(50, "In 1", "90 01 01") + "," + InputAt(60, "In 2", "90 02 02"));
  ToolRun const run = Monitor(studio, {"in 2", "--json", "--count", "1"});
  auto const lines = run.JSONLines();
  ASSERT_EQ(lines.size(), 1u) << run.err;
  EXPECT_EQ(lines[0]["source"], "In 2");
}

TEST_F(MonitorCommand, TellsMessagesInWords) {
  ToolRun const run = Monitor(StudioWithInput(InputAt(50, "In 1", "C1 05")), {"--count", "1"});
  EXPECT_EQ(run.out, "In 1                program change    ch 2   program 5\n") << run.err;
}

TEST_F(MonitorCommand, TellsBytesAndTimesWhenAsked) {
  ToolRun const run =
      Monitor(StudioWithInput(InputAt(50, "In 1", "90 3C 40")), {"--count", "1", "--hex", "--ts"});
  ASSERT_EQ(run.Lines().size(), 1u) << run.err;
  EXPECT_THAT(run.Lines()[0], MatchesPattern(" *[0-9]+\\.[0-9]+  In 1 +90 3C 40"));
}

TEST_F(MonitorCommand, PrintsNoMoreThanTheCount) {
  ToolRun const run = Monitor(
      kCabledStudio, {"--json", "--count", "2", "--send", "Out 1: on 1 1 on 2 2 on 3 3 on 4 4"});
  EXPECT_EQ(run.JSONLines().size(), 2u);
  EXPECT_EQ(run.exitCode, kDone);
}

TEST_F(MonitorCommand, EndsAfterItsTimeWithoutInput) {
  ToolRun const run = RunOn(kCabledStudio, {"monitor", "--for", "0.1"});
  EXPECT_EQ(run.exitCode, kDone) << run.err;
  EXPECT_EQ(run.out, "");
}

TEST_F(MonitorCommand, FailsForASourceOrDestinationThatIsNotThere) {
  ToolRun run = Monitor(kCabledStudio, {"Harp"});
  EXPECT_EQ(run.exitCode, kFailed);
  EXPECT_THAT(run.err, HasSubstr("there is no source \"Harp\""));
  run = Monitor(kCabledStudio, {"--send", "Harp: on 60 1"});
  EXPECT_EQ(run.exitCode, kFailed);
  EXPECT_THAT(run.err, HasSubstr("there is no destination \"Harp\""));
}

TEST_F(MonitorCommand, RefusesWordsWithoutADestination) {
  EXPECT_EQ(Monitor(kCabledStudio, {"--send", "90 3C 40"}).exitCode, kUsage);
  EXPECT_EQ(Monitor(kCabledStudio, {"--send", "Out 1: 90 zz"}).exitCode, kUsage);
}

}  // namespace
}  // namespace Ostinet::Tool

// SPDX-License-Identifier: MIT
#include <gmock/gmock.h>

#include "RunTool.h"

namespace Ostinet::Tool {
namespace {

class WatchCommand : public ToolTest {
 protected:
  // Ends by itself, also where nothing happens.
  ToolRun Watch(std::string const& studio, std::vector<std::string> arguments) {
    arguments.insert(arguments.begin(), {"watch", "--for", "60"});
    return RunOn(studio, arguments);
  }
};

std::string StudioWithEvents(std::string const& events) {
  return R"({ "ports": [ {"name": "Out 1", "kind": "winmm-out", "technology": 1},
                         {"name": "In 1", "kind": "winmm-in"} ],
              "events": [ )" +
         events + "] }";
}

char const* const kComeAndGo = R"(
  {"at-ms": 100, "remove": "Out 1"},
  {"at-ms": 1500, "add": {"name": "Out 1", "kind": "winmm-out", "technology": 1}},
  {"at-ms": 3000, "add": {"name": "Out 2", "kind": "winmm-out", "technology": 1}} )";

TEST_F(WatchCommand, SeesPortsComeAndGo) {
  ToolRun const run = Watch(StudioWithEvents(kComeAndGo), {"--json", "--count", "3"});
  EXPECT_EQ(run.exitCode, kDone) << run.err;
  EXPECT_EQ(run.err, "");
  auto const lines = run.JSONLines();
  ASSERT_EQ(lines.size(), 3u) << run.out;
  EXPECT_EQ(lines[0]["event"], "offline");
  EXPECT_EQ(lines[0]["kind"], "destination");
  EXPECT_EQ(lines[0]["name"], "Out 1");
  EXPECT_EQ(lines[1]["event"], "online");
  EXPECT_EQ(lines[1]["uniqueID"], lines[0]["uniqueID"]);
  EXPECT_EQ(lines[2]["event"], "added");
  EXPECT_EQ(lines[2]["name"], "Out 2");
}

TEST_F(WatchCommand, TellsPeopleInWords) {
  ToolRun const run =
      Watch(StudioWithEvents(R"({"at-ms": 100, "remove": "In 1"})"), {"--count", "1"});
  EXPECT_EQ(run.out, "offline      source      In 1\n") << run.err;
}

TEST_F(WatchCommand, EndsAfterItsTimeWithoutChanges) {
  ToolRun const run = RunOn(kCabledStudio, {"watch", "--for", "0.1"});
  EXPECT_EQ(run.exitCode, kDone) << run.err;
  EXPECT_EQ(run.out, "");
}

// The shell waits for the first line, so the program is at work when the interrupt comes.
TEST_F(WatchCommand, EndsOnCtrlC) {
  if (!IsPOSIX()) {
    GTEST_SKIP() << "needs a shell that sends interrupts";
  }
  std::string const studio =
      WriteFile("studio.json", StudioWithEvents(R"({"at-ms": 50, "remove": "In 1"})"));
  std::string const lines = PathOf("lines");
  ToolRun const run = RunShell(
      "PROGRAM watch --for 60 --studio \"" + studio + "\" --settings \"" + PathOf("settings") +
      "\" > \"" + lines + "\" & process=$!; until [ -s \"" + lines +
      "\" ] || ! kill -0 $process; do sleep 0.02; done; kill -INT $process; wait $process; "
      "echo \"exit $?\"");
  EXPECT_EQ(run.out, "exit 0\n");
  EXPECT_EQ(run.err, "");
}

}  // namespace
}  // namespace Ostinet::Tool

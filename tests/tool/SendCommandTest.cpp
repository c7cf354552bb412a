// SPDX-License-Identifier: MIT
#include <gmock/gmock.h>

#include <chrono>

#include "RunTool.h"

namespace Ostinet::Tool {
namespace {

using testing::HasSubstr;
using Seconds = std::chrono::duration<double>;

class SendCommand : public ToolTest {
 protected:
  ToolRun Send(std::vector<std::string> arguments) {
    arguments.insert(arguments.begin(), "send");
    return RunOn(kCabledStudio, arguments);
  }
};

TEST_F(SendCommand, SendsQuietly) {
  ToolRun const run = Send({"Out 1", "90 3C 40"});
  EXPECT_EQ(run.exitCode, kDone) << run.err;
  EXPECT_EQ(run.out, "");
  EXPECT_EQ(run.err, "");
}

TEST_F(SendCommand, TakesWordsInEveryForm) {
  for (std::vector<std::string> const& words :
       std::vector<std::vector<std::string>>{{"903C40"},
                                             {"90", "3C", "40"},
                                             {"on", "60", "100"},
                                             {"off C4"},
                                             {"pb", "-100"},
                                             {"syx 41 10"},
                                             {"--channel", "10", "on", "36", "100"},
                                             {"pc", "5", "-c", "2", "pc", "6"},
                                             {WriteFile("dump.syx", "\xF0\x41\xF7")}}) {
    std::vector<std::string> arguments = {"Out 1"};
    arguments.insert(arguments.end(), words.begin(), words.end());
    ToolRun const run = Send(arguments);
    EXPECT_EQ(run.exitCode, kDone) << words[0] << ": " << run.err;
  }
}

TEST_F(SendCommand, FindsTheDestinationByPartOfItsName) {
  EXPECT_EQ(Send({"out", "F8"}).exitCode, kDone);
  EXPECT_EQ(Send({"T 1", "F8"}).exitCode, kDone);
}

TEST_F(SendCommand, WaitsUntilWhatIsScheduledHasGoneOut) {
  auto const start = std::chrono::steady_clock::now();
  EXPECT_EQ(Send({"Out 1", "on 60 1", "--at", "+400", "off 60"}).exitCode, kDone);
  EXPECT_GE(Seconds(std::chrono::steady_clock::now() - start).count(), 0.4);
}

TEST_F(SendCommand, TakesATimeForWhatFollowsItOnly) {
  ToolRun const run = Send({"Out 1", "--at", "+10", "F8", "--at=+20", "FA", "+30", "FC"});
  EXPECT_EQ(run.exitCode, kDone) << run.err;
}

TEST_F(SendCommand, FailsForADestinationThatIsNotThere) {
  ToolRun const run = Send({"Harp", "F8"});
  EXPECT_EQ(run.exitCode, kFailed);
  EXPECT_EQ(run.out, "");
  EXPECT_THAT(run.err, HasSubstr("there is no destination \"Harp\", only \"Out 1\" (#"));
  EXPECT_EQ(std::count(run.err.begin(), run.err.end(), '\n'), 1);
}

TEST_F(SendCommand, NamesTheCandidatesOfAnAmbiguousName) {
  ToolRun const run =
      RunOn(R"({ "ports": [ {"name": "Port A", "kind": "winmm-out", "technology": 1},
                                            {"name": "Port B", "kind": "winmm-out", "technology": 1} ] })",
            {"send", "Port", "F8"});
  EXPECT_EQ(run.exitCode, kFailed);
  EXPECT_THAT(run.err, HasSubstr("\"Port A\""));
  EXPECT_THAT(run.err, HasSubstr("\"Port B\""));
}

TEST_F(SendCommand, RefusesMalformedBytes) {
  for (char const* words : {"90 3G 40", "90 3C", "3C 40", "903", "on 60", "on 200 1", "ch 17"}) {
    ToolRun const run = Send({"Out 1", words});
    EXPECT_EQ(run.exitCode, kUsage) << words;
    EXPECT_EQ(run.out, "");
    EXPECT_EQ(std::count(run.err.begin(), run.err.end(), '\n'), 1) << run.err;
  }
  EXPECT_EQ(Send({"Out 1", "--channel", "0", "pc 1"}).exitCode, kUsage);
  EXPECT_EQ(Send({"Out 1", "--at", "soon", "F8"}).exitCode, kUsage);
  EXPECT_EQ(Send({"Out 1"}).exitCode, kUsage);
  EXPECT_EQ(Send({}).exitCode, kUsage);
}

TEST_F(SendCommand, FailsForASysexFileThatCannotBeRead) {
  ToolRun const run = Send({"Out 1", PathOf("missing.syx")});
  EXPECT_EQ(run.exitCode, kFailed);
  EXPECT_THAT(run.err, HasSubstr("missing.syx"));
}

// The message of an hour from now cannot have gone out.
// In the foreground, timeout sends one interrupt and not two, of which the second would kill.
TEST_F(SendCommand, FailsWhereItIsInterruptedBeforeTheEnd) {
  if (!IsPOSIX()) {
    GTEST_SKIP() << "needs a program that sends interrupts";
  }
  std::string const studio = WriteFile("studio.json", kCabledStudio);
  ToolRun const run = RunShell(
      "timeout --foreground --preserve-status -s INT 5 PROGRAM send 'Out 1' F8 +3600000 FA "
      "--studio \"" +
      studio + "\" --settings \"" + PathOf("settings") + "\"");
  EXPECT_EQ(run.exitCode, kFailed);
  EXPECT_EQ(run.err, "ostinet: interrupted before all messages had gone out\n");
}

// More than a port's queue holds at once: what did not fit would be lost.
TEST_F(SendCommand, LosesNothingOfALongSchedule) {
  static char const kDigits[] = "0123456789ABCDEF";
  std::string words = "Out 1:";
  for (int i = 0; i < 600; ++i) {
    // As short as can be: a command of the Windows shell ends after 8,191 characters.
    words += " +" + std::to_string(i) + " C0 " + kDigits[i / 16 % 8] + kDigits[i % 16];
  }
  ToolRun const run =
      RunOn(kCabledStudio, {"monitor", "--json", "--for", "60", "--count", "600", "--send", words});
  auto const lines = run.JSONLines();
  ASSERT_EQ(lines.size(), 600u) << run.err;
  EXPECT_EQ(lines[599]["bytes"], "C0 57");
}

TEST_F(SendCommand, PanicSilencesEverythingAndEnds) {
  ToolRun const run = RunOn(kCabledStudio, {"panic"});
  EXPECT_EQ(run.exitCode, kDone) << run.err;
  EXPECT_EQ(run.out, "");
}

}  // namespace
}  // namespace Ostinet::Tool

// SPDX-License-Identifier: MIT
#include <gmock/gmock.h>

#include <chrono>
#include <filesystem>

#include "RunTool.h"

namespace Ostinet::Tool {
namespace {

using testing::HasSubstr;

class Usage : public ToolTest {
 protected:
  // In front of a command of the shell: with this variable.
  static std::string Setting(std::string const& name, std::string const& value) {
    return IsPOSIX() ? name + "=\"" + value + "\" " : "set \"" + name + "=" + value + "\"&& ";
  }
  // The variable that names the folder above the user's own settings.
  static char const* SettingsVariable() { return IsPOSIX() ? "XDG_CONFIG_HOME" : "APPDATA"; }
};

TEST_F(Usage, HelpGoesToTheStandardOutput) {
  for (std::vector<std::string> const& arguments :
       std::vector<std::vector<std::string>>{{"--help"},
                                             {"list", "--help"},
                                             {"watch", "--help"},
                                             {"monitor", "--help"},
                                             {"send", "--help"},
                                             {"panic", "--help"}}) {
    ToolRun const run = RunBare(arguments);
    EXPECT_EQ(run.exitCode, kDone);
    EXPECT_THAT(run.out, HasSubstr("--"));
    EXPECT_EQ(run.err, "");
  }
}

TEST_F(Usage, HelpNamesEachCommand) {
  std::string const help = RunBare({"--help"}).out;
  for (char const* command : {"list", "watch", "monitor", "send", "panic", "--studio", "--json"}) {
    EXPECT_THAT(help, HasSubstr(command));
  }
}

TEST_F(Usage, WrongUsageEndsWithTwo) {
  for (std::vector<std::string> const& arguments :
       std::vector<std::vector<std::string>>{{},
                                             {"dance"},
                                             {"list", "--no-such-option"},
                                             {"list", "surplus"},
                                             {"watch", "--for", "x"},
                                             {"watch", "--for", "-1"},
                                             {"watch", "--count", "0"},
                                             {"monitor", "--count"}}) {
    ToolRun const run = RunBare(arguments);
    EXPECT_EQ(run.exitCode, kUsage);
    EXPECT_EQ(run.out, "");
    EXPECT_EQ(std::count(run.err.begin(), run.err.end(), '\n'), 1) << run.err;
  }
  EXPECT_THAT(RunBare({"dance"}).err, HasSubstr("there is no command or option \"dance\""));
}

TEST_F(Usage, TakesGlobalOptionsBeforeAndBehindTheCommand) {
  std::string const studio = WriteFile("studio.json", kCabledStudio);
  std::string const settings = PathOf("settings");
  ToolRun const before =
      RunBare({"--json", "--studio", studio, "--settings", settings, "list", "-i"});
  ToolRun const behind =
      RunBare({"list", "-i", "--settings", settings, "--studio", studio, "--json"});
  EXPECT_EQ(before.exitCode, kDone) << before.err;
  EXPECT_EQ(behind.exitCode, kDone) << behind.err;
  EXPECT_EQ(json::parse(before.out)["sources"][0]["name"], "In 1");
  EXPECT_EQ(json::parse(behind.out)["sources"][0]["name"], "In 1");
}

TEST_F(Usage, AStudioFileThatIsNotThereFails) {
  ToolRun const run = Run({"list", "--studio", PathOf("none.json")});
  EXPECT_EQ(run.exitCode, kFailed);
  EXPECT_EQ(run.out, "");
  EXPECT_THAT(run.err, HasSubstr("none.json"));
  EXPECT_EQ(std::count(run.err.begin(), run.err.end(), '\n'), 1) << run.err;
}

TEST_F(Usage, AStudioFileThatDoesNotParseFails) {
  for (char const* text :
       {"", "{", "[1]", R"({"ports": 5})", R"({"ports": [{"name": "A", "kind": "no"}]})"}) {
    ToolRun const run = RunOn(text, {"list"});
    EXPECT_EQ(run.exitCode, kFailed) << text;
    EXPECT_EQ(run.out, "");
    EXPECT_EQ(std::count(run.err.begin(), run.err.end(), '\n'), 1) << run.err;
  }
}

TEST_F(Usage, ASettingsFolderThatCannotBeWrittenFails) {
  std::string const notAFolder = WriteFile("file", "content");
  ToolRun const run = RunBare(
      {"list", "--studio", WriteFile("studio.json", kCabledStudio), "--settings", notAFolder});
  EXPECT_EQ(run.exitCode, kFailed);
  EXPECT_EQ(run.out, "");
  EXPECT_THAT(run.err, HasSubstr("the settings folder"));
  EXPECT_EQ(std::count(run.err.begin(), run.err.end(), '\n'), 1) << run.err;
}

TEST_F(Usage, MakesTheSettingsFolderWithThoseAboveIt) {
  ToolRun const run = RunBare({"list", "--studio", WriteFile("studio.json", kCabledStudio),
                               "--settings", PathOf("a") + "/b/c"});
  EXPECT_EQ(run.exitCode, kDone) << run.err;
}

TEST_F(Usage, GoesOnWithoutTheUsersOwnSettingsWhereTheyCannotBeKept) {
  ToolRun const run =
      RunShell(Setting(SettingsVariable(), WriteFile("no folder", "")) +
               "PROGRAM list --json --studio \"" + WriteFile("studio.json", kCabledStudio) + "\"");
  EXPECT_EQ(run.exitCode, kDone);
  EXPECT_EQ(json::parse(run.out)["sources"].size(), 1u);
  EXPECT_THAT(run.err, HasSubstr("going on without settings"));
}

TEST_F(Usage, KeepsTheUsersOwnSettingsInTheirPlace) {
  ToolRun const run =
      RunShell(Setting(SettingsVariable(), PathOf("config")) + "PROGRAM list --studio \"" +
               WriteFile("studio.json", kCabledStudio) + "\"");
  EXPECT_EQ(run.exitCode, kDone) << run.err;
  EXPECT_TRUE(std::filesystem::is_directory(PathOf("config") + "/ostinet"));
}

// Whether the machine of the test has MIDI or not: data stays clean, and a notice is one line that
// says what to do.
TEST_F(Usage, SaysOnceWhereTheMachineHasNoMIDI) {
  if (!IsPOSIX()) {
    GTEST_SKIP() << "unsets a variable as a POSIX shell does";
  }
  ToolRun const run = RunShell("env -u OSTINET_STUDIO PROGRAM list --json --settings \"" +
                               PathOf("settings") + "\"");
  EXPECT_EQ(run.exitCode, kDone) << run.err;
  EXPECT_TRUE(json::parse(run.out).contains("devices"));
  if (!run.err.empty()) {
    EXPECT_THAT(run.err, HasSubstr("--studio FILE.json"));
    EXPECT_EQ(std::count(run.err.begin(), run.err.end(), '\n'), 1) << run.err;
  }
}

TEST_F(Usage, TheEnvironmentChoosesAStudioToo) {
  std::string const studio = WriteFile("studio.json", kCabledStudio);
  std::string const list = "PROGRAM list --json --settings \"" + PathOf("settings") + "\"";
  ToolRun const run = RunShell(Setting("OSTINET_STUDIO", studio) + list);
  ASSERT_EQ(run.exitCode, kDone) << run.err;
  EXPECT_EQ(json::parse(run.out)["sources"][0]["name"], "In 1");
}

TEST_F(Usage, ABadStudioOfTheEnvironmentFails) {
  std::string const studio = WriteFile("studio.json", "{");
  ToolRun const run = RunShell(Setting("OSTINET_STUDIO", studio) + "PROGRAM list --settings \"" +
                               PathOf("settings") + "\"");
  EXPECT_EQ(run.exitCode, kFailed);
  EXPECT_EQ(std::count(run.err.begin(), run.err.end(), '\n'), 1) << run.err;
}

// The reader goes at once; the first line comes later, and is the last that is tried.
TEST_F(Usage, AClosedPipeEndsQuietly) {
  if (!IsPOSIX()) {
    GTEST_SKIP() << "needs a POSIX shell";
  }
  std::string const studio = WriteFile("studio.json", R"({
      "ports": [ {"name": "Out 1", "kind": "winmm-out"}, {"name": "In 1", "kind": "winmm-in"} ],
      "events": [ {"at-ms": 500, "input": {"port": "In 1", "bytes": "90 3C 40"}} ] })");
  auto const start = std::chrono::steady_clock::now();
  ToolRun const run =
      RunShell("{ PROGRAM monitor --for 60 --studio \"" + studio + "\" --settings \"" +
               PathOf("settings") + "\"; echo \"exit $?\" >&2; } | true");
  EXPECT_EQ(run.err, "exit 0\n");
  EXPECT_LT(std::chrono::steady_clock::now() - start, std::chrono::seconds(50));
}

TEST_F(Usage, AnOutputThatCannotBeWrittenFails) {
  if (!IsPOSIX()) {
    GTEST_SKIP() << "needs /dev/full";
  }
  std::string const studio = WriteFile("studio.json", kCabledStudio);
  ToolRun const run = RunShell("PROGRAM list --studio \"" + studio + "\" --settings \"" +
                               PathOf("settings") + "\" > /dev/full");
  EXPECT_EQ(run.exitCode, kFailed);
  EXPECT_THAT(run.err, HasSubstr("cannot be written"));
}

}  // namespace
}  // namespace Ostinet::Tool

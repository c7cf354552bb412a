// SPDX-License-Identifier: MIT
#pragma once

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <nlohmann/json.hpp>
#include <regex>
#include <string>
#include <vector>

#include "support/TemporaryPath.h"

namespace Ostinet::Tool {

using nlohmann::json;

/// What a run of the program left behind. Lines end in a line feed on every system.
struct ToolRun {
  int exitCode = -1;
  std::string out;
  std::string err;

  std::vector<std::string> Lines() const;
  /// Each line of the output as JSON.
  std::vector<json> JSONLines() const;
};

/// GoogleTest's own matcher knows no classes of characters on Windows.
MATCHER_P(MatchesPattern, pattern, std::string("matches \"") + pattern + "\"") {
  return std::regex_match(arg, std::regex(pattern));
}

constexpr int kDone = 0;
constexpr int kFailed = 1;
constexpr int kUsage = 2;

/// Runs the built program over studios that it writes into a folder of its own. The user's own
/// settings and the machine's ports are never touched.
class ToolTest : public testing::Test {
 protected:
  /// Runs with these arguments, which may hold blanks but no quotes, and with a settings folder.
  ToolRun Run(std::vector<std::string> arguments);
  /// The same, on the studio of this description.
  ToolRun RunOn(std::string const& studio, std::vector<std::string> arguments);
  /// Runs exactly these arguments.
  ToolRun RunBare(std::vector<std::string> const& arguments);
  /// Runs a whole shell command in which PROGRAM stands for the program.
  ToolRun RunShell(std::string command);

  /// Writes a file into the test's folder and gives its path.
  std::string WriteFile(std::string const& name, std::string const& content);
  std::string PathOf(std::string const& name) const;

  static bool IsPOSIX();

 private:
  Testing::TemporaryPath folder_;
};

/// A studio of the output "Out 1" with a cable to the input "In 1".
extern char const* const kCabledStudio;

}  // namespace Ostinet::Tool

// SPDX-License-Identifier: MIT
#include "RunTool.h"

#include <algorithm>
#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <iterator>
#include <sstream>

namespace Ostinet::Tool {
namespace {

namespace fs = std::filesystem;

std::string ReadText(fs::path const& path) {
  std::ifstream file(path, std::ios::binary);
  std::string text((std::istreambuf_iterator<char>(file)), std::istreambuf_iterator<char>());
  text.erase(std::remove(text.begin(), text.end(), '\r'), text.end());
  return text;
}

std::string Quoted(std::string const& text) { return "\"" + text + "\""; }

// The path as the shell of this system takes it.
std::string Native(fs::path const& path) { return fs::absolute(path).make_preferred().string(); }

std::string ProgramText() { return Quoted(Native(OSTINET_TOOL)); }

}  // namespace

char const* const kCabledStudio = R"({
  "ports": [ {"name": "Out 1", "kind": "winmm-out", "technology": 1},
             {"name": "In 1", "kind": "winmm-in"} ],
  "cables": [ {"from": "Out 1", "to": "In 1"} ] })";

std::vector<std::string> ToolRun::Lines() const {
  std::vector<std::string> lines;
  std::istringstream stream(out);
  for (std::string line; std::getline(stream, line);) {
    lines.push_back(line);
  }
  return lines;
}

std::vector<json> ToolRun::JSONLines() const {
  std::vector<json> objects;
  for (std::string const& line : Lines()) {
    objects.push_back(json::parse(line));
  }
  return objects;
}

ToolRun ToolTest::Run(std::vector<std::string> arguments) {
  arguments.push_back("--settings");
  arguments.push_back(PathOf("settings"));
  return RunBare(arguments);
}

ToolRun ToolTest::RunOn(std::string const& studio, std::vector<std::string> arguments) {
  arguments.push_back("--studio");
  arguments.push_back(WriteFile("studio.json", studio));
  return Run(std::move(arguments));
}

ToolRun ToolTest::RunBare(std::vector<std::string> const& arguments) {
  std::string command = "PROGRAM";
  for (std::string const& argument : arguments) {
    command += " " + Quoted(argument);
  }
  return RunShell(command);
}

ToolRun ToolTest::RunShell(std::string command) {
  for (size_t at = command.find("PROGRAM"); at != std::string::npos; at = command.find("PROGRAM")) {
    command.replace(at, 7, ProgramText());
  }
  command = (IsPOSIX() ? "{ " + command + " ; }" : command) + " > " + Quoted(PathOf("out")) +
            " 2> " + Quoted(PathOf("err"));
  // The Windows shell takes one pair of quotes away from the whole.
  int const status = std::system((IsPOSIX() ? command : Quoted(command)).c_str());
  ToolRun run;
  run.exitCode = IsPOSIX() && status >= 256 ? status / 256 : status;
  run.out = ReadText(PathOf("out"));
  run.err = ReadText(PathOf("err"));
  return run;
}

std::string ToolTest::WriteFile(std::string const& name, std::string const& content) {
  std::ofstream(PathOf(name), std::ios::binary) << content;
  return PathOf(name);
}

std::string ToolTest::PathOf(std::string const& name) const {
  return Native(folder_.Path() / name);
}

bool ToolTest::IsPOSIX() { return fs::path::preferred_separator == '/'; }

}  // namespace Ostinet::Tool

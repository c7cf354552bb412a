// SPDX-License-Identifier: MIT
#include <CLI/CLI.hpp>
#include <filesystem>

#include "Commands.h"
#include "Drawing.h"
#include "Errors.h"
#include "Output.h"

namespace Ostinet::Tool {
namespace {

void WritePicture(std::string const& path, std::string const& picture) {
  try {
    std::u8string const text(path.begin(), path.end());
    std::u16string const full = std::filesystem::absolute(std::filesystem::path(text)).u16string();
    File(FileSpecification(UString(full))).Replace(picture.data(), picture.size());
  } catch (std::exception const& error) {
    throw Failure("\"" + path + "\" cannot be written: " + error.what());
  }
}

void Draw(GlobalOptions const& globals, std::string const& path) {
  Session const session(globals, nullptr, nullptr);
  std::string picture = DrawingSVG(LayOut(ViewStudio(session.GetSetup())));
  if (path.empty()) {
    picture.pop_back();  // The line end, which printing adds.
    PrintLine(picture);
  } else {
    WritePicture(path, picture);
  }
}

}  // namespace

void AddDrawCommand(CLI::App& app, CommandLine& line) {
  auto const path = std::make_shared<std::string>();
  CLI::App* const command = app.add_subcommand("draw", "Draw the studio as an SVG picture");
  command->add_option("-o,--output", *path, "The file to write, instead of the standard output")
      ->type_name("FILE");
  command->callback([&line, path] { line.run = [&line, path] { Draw(line.options, *path); }; });
}

}  // namespace Ostinet::Tool

// SPDX-License-Identifier: MIT
#include <CLI/CLI.hpp>

#include "Commands.h"
#include "Errors.h"
#include "Output.h"
#include "TypeLookup.h"
#include "TypesText.h"

namespace Ostinet::Tool {
namespace {

struct TypesOptions {
  std::vector<std::string> words;  // a maker and a model, or files to check
  bool check = false;
};

void Print(bool asJSON, std::string const& json, std::vector<std::string> const& lines) {
  if (asJSON) {
    PrintLine(json);
    return;
  }
  for (std::string const& line : lines) {
    PrintLine(line);
  }
}

void ListTypes(bool asJSON, std::vector<std::string> const& words) {
  DeviceTypeCatalog const& catalog = DeviceTypeCatalog::Instance();
  MakerCounts const makers = MakersOf(catalog);
  if (words.empty()) {
    Print(asJSON, MakersJSON(makers), MakerLines(makers));
    return;
  }
  std::string const maker = FindMaker(makers, words[0]);
  std::vector<DeviceTypeInfo> types;
  catalog.CollectModels(UString(maker), types);
  if (words.size() == 1) {
    Print(asJSON, ModelsJSON(maker, types), ModelLines(types));
    return;
  }
  DeviceTypeInfo const type = FindModel(types, words[1]);
  Print(asJSON, TypeJSON(type), TypeLines(type));
}

void CheckFiles(bool asJSON, std::vector<std::string> const& paths) {
  std::vector<CheckedFile> files;
  std::vector<std::string> lines;
  bool isClean = true;
  for (std::string const& path : paths) {
    files.push_back({path, CheckDeviceTypeFile(File(FileSpecification(UString(path))))});
    isClean = isClean && files.back().check.notes.empty();
    std::vector<std::string> const more = CheckLines(files.back());
    lines.insert(lines.end(), more.begin(), more.end());
  }
  Print(asJSON, ChecksJSON(files), lines);
  if (!isClean) {
    throw Failure("not all of it would be read");
  }
}

void Types(GlobalOptions const& globals, TypesOptions const& options) {
  constexpr size_t kMakerAndModel = 2;
  if (options.check && options.words.empty()) {
    throw UsageError("name the files to check");
  }
  if (!options.check && options.words.size() > kMakerAndModel) {
    throw UsageError("name a maker and a model; a name with blanks goes in quotes");
  }
  if (options.check) {
    CheckFiles(globals.json, options.words);
  } else {
    ListTypes(globals.json, options.words);
  }
}

}  // namespace

void AddTypesCommand(CLI::App& app, CommandLine& line) {
  auto const options = std::make_shared<TypesOptions>();
  CLI::App* const command =
      app.add_subcommand("types", "Show the makers, models and facts of the device types");
  command->add_option("words", options->words, "A maker, or a maker and a model")
      ->type_name("[MAKER [MODEL]]");
  command->add_flag("--check", options->check,
                    "Take the words for device type files, and tell what of them would be skipped");
  command->callback(
      [&line, options] { line.run = [&line, options] { Types(line.options, *options); }; });
}

}  // namespace Ostinet::Tool

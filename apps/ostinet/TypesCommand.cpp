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
  std::string maker;
  std::string model;
  std::vector<std::string> files;
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

void ListTypes(bool asJSON, TypesOptions const& options) {
  DeviceTypeCatalog const& catalog = DeviceTypeCatalog::Instance();
  MakerCounts const makers = MakersOf(catalog);
  if (options.maker.empty()) {
    Print(asJSON, MakersJSON(makers), MakerLines(makers));
    return;
  }
  std::string const maker = FindMaker(makers, options.maker);
  std::vector<DeviceTypeInfo> types;
  catalog.CollectModels(UString(maker), types);
  if (options.model.empty()) {
    Print(asJSON, ModelsJSON(maker, types), ModelLines(types));
    return;
  }
  DeviceTypeInfo const type = FindModel(types, options.model);
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
  if (options.files.empty()) {
    ListTypes(globals.json, options);
  } else if (options.maker.empty()) {
    CheckFiles(globals.json, options.files);
  } else {
    throw UsageError("--check takes files, and no maker");
  }
}

}  // namespace

void AddTypesCommand(CLI::App& app, CommandLine& line) {
  auto const options = std::make_shared<TypesOptions>();
  CLI::App* const command =
      app.add_subcommand("types", "Show the makers, models and facts of the device types");
  command->add_option("maker", options->maker, "List the models of this maker");
  command->add_option("model", options->model, "Show what is known of this model");
  command
      ->add_option("--check", options->files,
                   "Tell what of these device type files would be skipped, and why")
      ->type_name("FILE")
      ->expected(1, -1);
  command->callback(
      [&line, options] { line.run = [&line, options] { Types(line.options, *options); }; });
}

}  // namespace Ostinet::Tool

// SPDX-License-Identifier: MIT
//
// `names` with a destination, and `names list`.
#include <CLI/CLI.hpp>
#include <filesystem>

#include "Errors.h"
#include "NameLookup.h"
#include "NameMatch.h"
#include "NameText.h"
#include "NamesCommand.h"
#include "Output.h"

namespace Ostinet::Tool {
namespace {

struct NamesOptions {
  std::string destination;
  std::string file;
  std::string standard;
};

struct CatalogOptions {
  std::string maker;
  std::string model;
};

Names DocumentAt(std::string const& path) {
  std::u8string const text(path.begin(), path.end());
  std::u16string const full = std::filesystem::absolute(std::filesystem::path(text)).u16string();
  FileSpecification const file{UString(full)};
  if (!file.IsFile()) {
    throw Failure("there is no file \"" + path + "\"");
  }
  return Names(Names::kMasterNames, file);
}

Names StandardModeNamed(std::string const& name) {
  std::vector<Names> modes;
  NamesCatalog::Instance().FindStandardModes(modes);
  std::vector<Candidate> candidates;
  for (Names const& mode : modes) {
    candidates.push_back({mode.GetName().string(), 0});
  }
  return modes[MatchName(candidates, name, "standard mode")];
}

void ShowNames(GlobalOptions const& globals, NamesOptions const& options) {
  Session session(globals, nullptr, nullptr);
  Destination const destination = FindAnyDestination(session.GetSetup(), options.destination);
  bool const isEdit = !options.file.empty() || !options.standard.empty();
  if (isEdit) {
    destination.SetNames(options.file.empty() ? StandardModeNamed(options.standard)
                                              : DocumentAt(options.file));
  }
  PrintOne(globals.json, NamesJSON(destination), NamesLines(destination));
  if (isEdit) {
    session.Save();
  }
}

CatalogView LookInCatalog(CatalogOptions const& options) {
  NamesCatalog& catalog = NamesCatalog::Instance();
  CatalogView view;
  if (options.maker.empty()) {
    catalog.FindStandardModes(view.documents);
    return view;
  }
  UString const maker(options.maker);
  std::vector<UString> models;
  if (!options.model.empty()) {
    models.push_back(UString(options.model));
  } else {
    std::vector<DeviceTypeInfo> types;
    DeviceTypeCatalog::Instance().CollectModels(maker, types);
    for (DeviceTypeInfo const& type : types) {
      models.push_back(type.GetModelName());
    }
  }
  for (UString const& model : models) {
    catalog.FindMasters(maker, model, view.documents);
    catalog.FindOverrides(maker, model, view.documents);
  }
  return view;
}

void ListCatalog(GlobalOptions const& globals, CatalogOptions const& options) {
  CatalogView const view = LookInCatalog(options);
  PrintOne(globals.json, CatalogJSON(view), CatalogLines(view));
}

}  // namespace

void AddNamesOfDestination(CLI::App& names, CommandLine& line) {
  auto const options = std::make_shared<NamesOptions>();
  names.add_option("DESTINATION", options->destination, "Its name, or an unambiguous part");
  CLI::Option* const file =
      names.add_option("--set", options->file, "Take the names from this document")
          ->type_name("FILE");
  names.add_option("--standard", options->standard, "Take those of a standard mode")
      ->type_name("NAME")
      ->excludes(file);
  names.callback([&line, options, &names] {
    if (names.get_subcommands().empty()) {
      line.run = [&line, options] {
        if (options->destination.empty()) {
          throw UsageError("name a destination, or see ostinet names --help");
        }
        ShowNames(line.options, *options);
      };
    }
  });
}

void AddNamesList(CLI::App& names, CommandLine& line) {
  auto const options = std::make_shared<CatalogOptions>();
  CLI::App* const command = names.add_subcommand(
      "list",
      "List what the name documents of this machine offer: standard modes, or the "
      "documents of a maker's models");
  command->add_option("MAKER", options->maker, "Exactly as in the documents");
  command->add_option("MODEL", options->model, "Exactly as in the documents");
  command->callback(
      [&line, options] { line.run = [&line, options] { ListCatalog(line.options, *options); }; });
}

}  // namespace Ostinet::Tool

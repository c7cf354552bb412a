// SPDX-License-Identifier: MIT
//
// `names` with a destination, and `names list`.
#include <CLI/CLI.hpp>
#include <algorithm>
#include <filesystem>
#include <iterator>

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

// What the documents of this machine offer. One that cannot be read stops nothing.
std::vector<NameDocumentOffer> AllOffers() {
  std::vector<FileSpecification> unreadable;
  std::vector<NameDocumentOffer> offers = ListNameDocuments(unreadable);
  for (FileSpecification const& file : unreadable) {
    Notify("\"" + file.GetFullPath().string() +
           "\" cannot be read; ostinet names check tells where");
  }
  return offers;
}

Names StandardModeNamed(std::string const& name) {
  std::vector<Names> modes;
  std::vector<Candidate> candidates;
  for (NameDocumentOffer const& offer : AllOffers()) {
    if (offer.names.GetType() == Names::kStandardModeNames) {
      modes.push_back(offer.names);
      candidates.push_back({offer.names.GetName().string()});
    }
  }
  return modes[MatchName(candidates, name, "standard mode")];
}

// A document is read for the maker and the model of the destination, whatever else it holds.
void FailWithoutNames(Destination const& destination, std::string const& path) {
  if (destination.CountModes() > 0) {
    return;
  }
  std::string const maker = destination.GetManufacturer().string();
  std::string const model = destination.GetModel().string();
  throw Failure("\"" + path + "\" has no names for \"" + destination.GetName().string() + "\", " +
                (maker.empty() || model.empty() ? "whose maker and model are not known"
                                                : "which is a " + maker + " " + model));
}

void ShowNames(GlobalOptions const& globals, NamesOptions const& options) {
  Session session(globals, nullptr, nullptr);
  Destination const destination = FindAnyDestination(session.GetSetup(), options.destination);
  bool const isEdit = !options.file.empty() || !options.standard.empty();
  if (isEdit) {
    FailIfNothingIsKept(destination);
    destination.SetNames(options.file.empty() ? StandardModeNamed(options.standard)
                                              : DocumentAt(options.file));
  }
  if (!options.file.empty()) {
    FailWithoutNames(destination, options.file);
  }
  PrintOne(globals.json, NamesJSON(destination), NamesLines(destination));
  if (isEdit) {
    session.Save();
  }
}

/// Those whose `text` is the one that `wanted` means.
std::vector<NameDocumentOffer> Narrowed(std::vector<NameDocumentOffer> const& offers,
                                        UString NameDocumentOffer::*text, std::string const& wanted,
                                        std::string const& kind) {
  sorted_vector_set<UString> texts;
  for (NameDocumentOffer const& offer : offers) {
    if (offer.names.GetType() != Names::kStandardModeNames) {
      texts.insert(offer.*text);
    }
  }
  std::vector<Candidate> candidates;
  for (UString const& each : texts) {
    candidates.push_back({each.string()});
  }
  UString const chosen(candidates[MatchName(candidates, wanted, kind)].name);
  std::vector<NameDocumentOffer> narrowed;
  std::copy_if(offers.begin(), offers.end(), std::back_inserter(narrowed),
               [&](NameDocumentOffer const& offer) { return offer.*text == chosen; });
  return narrowed;
}

void ListCatalog(GlobalOptions const& globals, CatalogOptions const& options) {
  std::vector<NameDocumentOffer> offers = AllOffers();
  if (!options.maker.empty()) {
    offers = Narrowed(offers, &NameDocumentOffer::manufacturer, options.maker, "maker");
  }
  if (!options.model.empty()) {
    offers = Narrowed(offers, &NameDocumentOffer::model, options.model, "model");
  }
  PrintOne(globals.json, OffersJSON(offers), OffersLines(offers));
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
      "List what the name documents of this machine offer: standard modes, and documents for "
      "makers and models");
  command->add_option("MAKER", options->maker, "Only for this maker");
  command->add_option("MODEL", options->model, "Only for this model");
  command->callback(
      [&line, options] { line.run = [&line, options] { ListCatalog(line.options, *options); }; });
}

}  // namespace Ostinet::Tool

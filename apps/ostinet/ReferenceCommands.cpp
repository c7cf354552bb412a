// SPDX-License-Identifier: MIT
#include <CLI/CLI.hpp>

#include "Commands.h"
#include "Errors.h"
#include "Lookup.h"
#include "Output.h"
#include "ReferenceText.h"

namespace Ostinet::Tool {
namespace {

struct RefOptions {
  std::vector<std::string> words;
  bool input = false;
  bool shortForm = false;
  bool nameOnly = false;
};

struct ResolveOptions {
  std::vector<std::string> words;
  bool standard = false;
  bool idAndName = false;
  bool nameAndID = false;
};

template <class List>
std::vector<std::string> NamesOf(List const& endpoints) {
  std::vector<std::string> names;
  for (auto const& endpoint : endpoints) {
    names.push_back(endpoint.GetName().string());
  }
  return names;
}

// A destination if it can be meant, else a source.
Endpoint FindEndpoint(Setup const& setup, std::string const& name, bool input) {
  if (input) {
    return Find(SourcesOf(setup), name, "source");
  }
  try {
    return Find(DestinationsOf(setup), name, "destination");
  } catch (Failure const& failure) {
    try {
      return Find(SourcesOf(setup), name, "source");
    } catch (Failure const&) {
      throw failure;
    }
  }
}

MatchData MakeReference(GlobalOptions const& globals, RefOptions const& options) {
  if (options.nameOnly) {
    if (options.words.size() != 2) {
      throw UsageError("--name-only takes a type and a name: ref --name-only destination Piano");
    }
    return MatchTranslator().TranslateFromNameOnly(ParseObjectType(options.words[0]),
                                                   UString(options.words[1]));
  }
  if (options.words.size() != 1) {
    throw UsageError("name one source or destination");
  }
  Session const session(globals, nullptr, nullptr);
  Endpoint const endpoint = FindEndpoint(session.GetSetup(), options.words.front(), options.input);
  return options.shortForm ? endpoint.GetShortMatchData() : endpoint.GetMatchData();
}

void Ref(GlobalOptions const& globals, RefOptions const& options) {
  MatchData const data = MakeReference(globals, options);
  PrintLine(globals.json ? ReferenceJSON(data) : ReferenceText(data));
}

// The short form names one endpoint or none; it has no ranks.
ReferenceResolver::Answer ResolveShortForm(Setup const& setup, MatchData const& data) {
  ReferenceResolver::Answer answer;
  auto const add = [&](auto const& endpoints) {
    for (auto const& endpoint : endpoints) {
      if (endpoint.MatchToShortData(data)) {
        ReferenceResolver resolver(IDAndNameMatch(), 0);
        answer = resolver.Resolve(endpoint.GetMatchData());
      }
    }
  };
  add(SourcesOf(setup));
  add(DestinationsOf(setup));
  return answer;
}

std::vector<MatchLevel> const& LevelsOf(ResolveOptions const& options) {
  if (options.idAndName) {
    return IDAndNameMatch();
  }
  return options.nameAndID ? NameAndIDMatch() : StandardMatch();
}

std::string Joined(std::vector<std::string> const& words) {
  std::string text;
  for (std::string const& word : words) {
    text += word + " ";
  }
  return text;
}

void Resolve(GlobalOptions const& globals, ResolveOptions const& options) {
  MatchData const data = ParseReference(Joined(options.words));
  Session const session(globals, nullptr, nullptr);
  ReferenceResolver::Answer answer = ReferenceResolver(LevelsOf(options)).Resolve(data);
  constexpr size_t kShortForm = 16;
  if (answer.outcome == ReferenceResolver::Outcome::kUnreadable && data.size() == kShortForm) {
    answer = ResolveShortForm(session.GetSetup(), data);
  }
  if (globals.json) {
    PrintLine(AnswerJSON(answer));
  } else {
    for (std::string const& line : AnswerLines(answer)) {
      PrintLine(line);
    }
  }
  if (answer.Winner() == nullptr) {
    throw Failure(answer.InWords());
  }
}

void Pair(GlobalOptions const& globals) {
  Session const session(globals, nullptr, nullptr);
  std::vector<std::string> const sources = NamesOf(SourcesOf(session.GetSetup()));
  std::vector<std::string> const destinations = NamesOf(DestinationsOf(session.GetSetup()));
  std::vector<NamePair> const pairs = PairNames(sources, destinations);
  if (globals.json) {
    PrintLine(PairsJSON(pairs, sources, destinations));
    return;
  }
  for (NamePair const& pair : pairs) {
    PrintLine(pair.common + ": " + sources[pair.source] + " + " + destinations[pair.destination] +
              " (" + KindText(pair.kind) + ")");
  }
}

}  // namespace

void AddRefCommand(CLI::App& app, CommandLine& line) {
  auto const options = std::make_shared<RefOptions>();
  CLI::App* const command =
      app.add_subcommand("ref", "Print a lasting reference to a source or destination");
  command->add_option("NAME", options->words, "Its name, or an unambiguous part of it")->required();
  command->add_flag("-i,--input", options->input,
                    "Only a source; else a destination where the name means one");
  command->add_flag("--short", options->shortForm, "The short form, good on this machine");
  command->add_flag("--name-only", options->nameOnly,
                    "From a type and a name, without looking: --name-only destination Piano");
  command->callback(
      [&line, options] { line.run = [&line, options] { Ref(line.options, *options); }; });
}

void AddResolveCommand(CLI::App& app, CommandLine& line) {
  auto const options = std::make_shared<ResolveOptions>();
  CLI::App* const command =
      app.add_subcommand("resolve", "Tell who a reference means now, and why");
  command->add_option("REF", options->words, "What ref printed")->required();
  auto* const first =
      command->add_flag("--standard", options->standard, "By everything (the default)");
  auto* const second = command->add_flag("--id-name", options->idAndName, "By ID, else by name");
  auto* const third = command->add_flag("--name-id", options->nameAndID, "By name, else by ID");
  first->excludes(second)->excludes(third);
  second->excludes(third);
  command->callback(
      [&line, options] { line.run = [&line, options] { Resolve(line.options, *options); }; });
}

void AddPairCommand(CLI::App& app, CommandLine& line) {
  CLI::App* const command =
      app.add_subcommand("pair", "List which inputs and outputs belong together by their names");
  command->callback([&line] { line.run = [&line] { Pair(line.options); }; });
}

}  // namespace Ostinet::Tool

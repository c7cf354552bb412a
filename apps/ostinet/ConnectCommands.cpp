// SPDX-License-Identifier: MIT
#include <CLI/CLI.hpp>
#include <map>

#include "Commands.h"
#include "Errors.h"
#include "Lookup.h"
#include "StudioEditing.h"

namespace Ostinet::Tool {
namespace {

struct ConnectOptions {
  std::string instrument;
  std::string port;
  bool inputs = false;
  bool outputs = false;

  bool IsWanted(bool isInput) const {
    bool const all = inputs == outputs;
    return all || (isInput ? inputs : outputs);
  }
};

// What the two directions name differently.
struct Inputs {
  using Handle = Source;
  static constexpr char const* kKind = "input";
  static std::vector<Source> List(Setup const& setup) { return SourcesOf(setup); }
  static Source PortOf(Source const& end) { return end.GetDirectSource(); }
  static void Tie(Source const& port, Source const& end) { port.AddConnectedSource(end); }
  static void Untie(Source const& port, Source const& end) { port.RemoveConnectedSource(end); }
};
struct Outputs {
  using Handle = Destination;
  static constexpr char const* kKind = "output";
  static std::vector<Destination> List(Setup const& setup) { return DestinationsOf(setup); }
  static Destination PortOf(Destination const& end) { return end.GetDirectDestination(); }
  static void Tie(Destination const& port, Destination const& end) {
    port.AddConnectedDestination(end);
  }
  static void Untie(Destination const& port, Destination const& end) {
    port.RemoveConnectedDestination(end);
  }
};

template <class Way>
std::vector<typename Way::Handle> Ends(Setup const& setup, bool ofInstruments) {
  std::vector<typename Way::Handle> ends;
  for (auto const& end : Way::List(setup)) {
    if (end.IsDirect() != ofInstruments) {
      ends.push_back(end);
    }
  }
  return ends;
}

std::string Quoted(Object const& object) { return "\"" + object.GetName().string() + "\""; }

// Why a direction could not be done; empty where it was.
using Reasons = std::vector<std::string>;

// Who hangs on which port.
using Links = std::map<unsigned long long, unsigned long long>;

template <class Way>
void AddLinks(Setup const& setup, Links& links) {
  for (auto const& end : Ends<Way>(setup, true)) {
    links[end.GetKey()] = Way::PortOf(end).GetKey();
  }
}

Links LinksOf(Setup const& setup) {
  Links links;
  AddLinks<Inputs>(setup, links);
  AddLinks<Outputs>(setup, links);
  return links;
}

// The ends of one device bear one ID, by which ports find them anew, and so the first of them takes
// the first port that lists it. What would not come back like this is not saved.
void FailIfLinksWouldMove(Setup& setup) {
  Links const meant = LinksOf(setup);
  setup.PollSetupChanges();
  if (LinksOf(setup) != meant) {
    throw Failure(
        "the ends of one device take ports in the order of the ports, the first end first: connect "
        "them in that order");
  }
}

template <class Way>
Reasons ConnectWay(Setup const& setup, ConnectOptions const& options) {
  auto const ends = Ends<Way>(setup, true);
  auto const ports = Ends<Way>(setup, false);
  auto const end = TryFind(ends, options.instrument, std::string("instrument's ") + Way::kKind);
  auto const port = TryFind(ports, options.port, std::string(Way::kKind) + " port");
  if (!end.Exists()) {
    return {"no instrument has the " + std::string(Way::kKind) + " \"" + options.instrument + "\""};
  }
  if (!port.Exists()) {
    return {"there is no " + std::string(Way::kKind) + " port \"" + options.port + "\""};
  }
  if (!port.HasConnections()) {
    return {"nothing can hang on " + Quoted(port) + ", which is software"};
  }
  auto const old = Way::PortOf(end);
  if (old.Exists() && old != port) {
    Way::Untie(old, end);
  }
  Way::Tie(port, end);
  return {};
}

template <class Way>
Reasons DisconnectWay(Setup const& setup, ConnectOptions const& options) {
  auto const ends = Ends<Way>(setup, true);
  auto const end = TryFind(ends, options.instrument, std::string("instrument's ") + Way::kKind);
  if (!end.Exists()) {
    return {"no instrument has the " + std::string(Way::kKind) + " \"" + options.instrument + "\""};
  }
  auto const port = Way::PortOf(end);
  if (!port.Exists()) {
    return {"the " + std::string(Way::kKind) + " " + Quoted(end) + " hangs on no port"};
  }
  bool const isMeant =
      options.port.empty() ||
      TryFind(std::vector<typename Way::Handle>{port}, options.port, "port").Exists();
  if (!isMeant) {
    return {"the " + std::string(Way::kKind) + " " + Quoted(end) + " hangs on " + Quoted(port) +
            ", not on \"" + options.port + "\""};
  }
  Way::Untie(port, end);
  return {};
}

// Both directions where none is asked for; done if one of them can be.
template <class WorkInputs, class WorkOutputs>
void Edit(GlobalOptions const& globals, ConnectOptions const& options, WorkInputs inputs,
          WorkOutputs outputs) {
  Session session(globals, nullptr, nullptr);
  std::vector<Reasons> why;
  if (options.IsWanted(true)) {
    why.push_back(inputs(session.GetSetup(), options));
  }
  if (options.IsWanted(false)) {
    why.push_back(outputs(session.GetSetup(), options));
  }
  bool isDone = false;
  std::string sentence;
  for (Reasons const& reasons : why) {
    isDone = isDone || reasons.empty();
    for (std::string const& reason : reasons) {
      sentence += (sentence.empty() ? "" : ", and ") + reason;
    }
  }
  if (!isDone) {
    throw Failure(sentence);
  }
  FailIfLinksWouldMove(session.GetSetup());
  session.Save();
}

CLI::App* AddCommand(CLI::App& app, std::string const& name, std::string const& help,
                     ConnectOptions& options) {
  CLI::App* const command = app.add_subcommand(name, help);
  command
      ->add_option("INSTRUMENT", options.instrument,
                   "A device of one input or output, or one "
                   "of its ends")
      ->required();
  command->add_option("PORT", options.port, "The port of the interface");
  command->add_flag("-i,--inputs", options.inputs, "Only the way in, from the instrument");
  command->add_flag("-o,--outputs", options.outputs, "Only the way out, to the instrument");
  return command;
}

}  // namespace

void AddConnectCommand(CLI::App& app, CommandLine& line) {
  auto const options = std::make_shared<ConnectOptions>();
  CLI::App* const command =
      AddCommand(app, "connect", "Say which port an instrument hangs on", *options);
  command->get_option("PORT")->required();
  command->callback([&line, options] {
    line.run = [&line, options] {
      Edit(line.options, *options, ConnectWay<Inputs>, ConnectWay<Outputs>);
    };
  });
}

void AddDisconnectCommand(CLI::App& app, CommandLine& line) {
  auto const options = std::make_shared<ConnectOptions>();
  CLI::App* const command =
      AddCommand(app, "disconnect", "Take an instrument off its port", *options);
  command->callback([&line, options] {
    line.run = [&line, options] {
      Edit(line.options, *options, DisconnectWay<Inputs>, DisconnectWay<Outputs>);
    };
  });
}

}  // namespace Ostinet::Tool

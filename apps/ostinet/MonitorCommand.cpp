// SPDX-License-Identifier: MIT
#include <CLI/CLI.hpp>
#include <map>
#include <set>

#include "Commands.h"
#include "Errors.h"
#include "Lookup.h"
#include "MessageJoiner.h"
#include "MonitorLine.h"
#include "Outgoing.h"
#include "Output.h"

namespace Ostinet::Tool {
namespace {

struct MonitorOptions {
  std::vector<std::string> sources;
  std::vector<std::string> sends;
  bool hex = false;
  bool ts = false;
  Limits limits;
};

// Gathers what arrives, within the polls, and makes messages of it.
class Input : public Receiver {
 public:
  // Runs on the system's threads too, so it decides nothing: HandlePacket does.
  bool WantsPacket(DataPacket const&, Source const&) override { return true; }

  void HandlePacket(DataPacket const& packet, Source const& source) override {
    unsigned long long const key = source.GetKey();
    if (!chosen_.empty() && chosen_.count(key) == 0) {
      return;
    }
    std::string const name = source.GetName().string();
    Bytes const bytes(packet.data, packet.data + packet.length);
    joiners_[key].Take(packet.stamp.AsMIDITime().Value(), bytes,
                       [&](unsigned long long clocks, Bytes const& message) {
                         arrived_.push_back({name, clocks, message});
                       });
  }

  void Choose(Source const& source) { chosen_.insert(source.GetKey()); }

  std::vector<MonitoredMessage> Take() { return std::exchange(arrived_, {}); }

 private:
  std::set<unsigned long long> chosen_;  // Empty: all.
  std::map<unsigned long long, MessageJoiner> joiners_;
  std::vector<MonitoredMessage> arrived_;
};

void ChooseSources(Setup const& setup, std::vector<std::string> const& names, Input& input) {
  std::vector<Source> sources = SourcesOf(setup);
  for (int i = 0; i < setup.CountPrivateSources(); ++i) {
    sources.push_back(setup.GetPrivateSource(i));  // The near end of a virtual destination.
  }
  for (std::string const& name : names) {
    input.Choose(Find(sources, name, "source"));
  }
}

struct ToSend {
  std::string destination;
  std::vector<ScheduledMessage> messages;
};

// "DEST: WORDS". Names may hold colons, words hold none with a blank behind it.
ToSend ParseSend(std::string const& text) {
  size_t const colon = text.rfind(": ");
  if (colon == std::string::npos || colon == 0) {
    throw UsageError("\"--send\" takes a destination and words, like \"Synth: on 60 100\", not \"" +
                     text + "\"");
  }
  SendWords words;
  words.Add(text.substr(colon + 2));
  return {text.substr(0, colon), words.Take()};
}

class Monitor {
 public:
  Monitor(MonitorOptions const& options, bool json) : options_(options), json_(json) {}

  void Run(GlobalOptions const& globals, std::vector<ToSend> const& sends) {
    Session session(globals, &input_, nullptr);
    ChooseSources(session.GetSetup(), options_.sources, input_);
    std::vector<Outgoing> outgoing;
    for (ToSend const& send : sends) {
      outgoing.emplace_back(FindDestination(session.GetSetup(), send.destination), send.messages);
    }
    startClocks_ = CurrentMIDITime().Value();
    auto const start = PollLoop::Clock::now();
    session.Run([&] {
      PrintArrived();
      for (Outgoing& some : outgoing) {
        some.Step();
      }
      return !options_.limits.AreReached(start, printed_);
    });
    PrintArrived();
  }

 private:
  void PrintArrived() {
    for (MonitoredMessage const& message : input_.Take()) {
      if (options_.limits.count && printed_ >= *options_.limits.count) {
        return;
      }
      PrintLine(json_ ? MonitorJSON(message) : Text(message));
      ++printed_;
    }
  }

  std::string Text(MonitoredMessage const& message) const {
    std::string const time = options_.ts ? SecondsText(message.clocks, startClocks_) + "  " : "";
    return time + MonitorText(message, options_.hex);
  }

  MonitorOptions const& options_;
  bool json_;
  Input input_;
  unsigned long long startClocks_ = 0;
  long long printed_ = 0;
};

void RunMonitor(GlobalOptions const& globals, MonitorOptions const& options) {
  std::vector<ToSend> sends;
  for (std::string const& text : options.sends) {
    sends.push_back(ParseSend(text));
  }
  Monitor(options, globals.json).Run(globals, sends);
}

}  // namespace

void AddMonitorCommand(CLI::App& app, CommandLine& line) {
  auto const options = std::make_shared<MonitorOptions>();
  CLI::App* const command = app.add_subcommand("monitor", "Print what arrives, a line a message");
  command->add_option("SOURCES", options->sources,
                      "Names of inputs, or unambiguous parts of them; all where none is given");
  command->add_flag("--hex", options->hex, "The bytes instead of words");
  command->add_flag("--ts", options->ts, "The time of each message, in seconds from the start");
  command
      ->add_option("--send", options->sends,
                   "\"DEST: WORDS\": send this first, with the words of the command send")
      ->allow_extra_args(false);
  AddLimits(*command, options->limits);
  command->footer(
      "Ctrl-C ends it. Long sysex is put together before it is printed.\n"
      "Example: ostinet monitor --count 1 --send \"Out 1: 90 3C 40\"");
  command->callback(
      [&line, options] { line.run = [&line, options] { RunMonitor(line.options, *options); }; });
}

}  // namespace Ostinet::Tool

// SPDX-License-Identifier: MIT
#include <CLI/CLI.hpp>
#include <cstdlib>

#include "Commands.h"
#include "Output.h"
#include "StudioChanges.h"

namespace Ostinet::Tool {
namespace {

Change ChannelsChange(std::string event, Destination const& destination, unsigned short channels) {
  Change change;
  change.event = std::move(event);
  change.kind = "destination";
  change.name = destination.GetName().string();
  change.uniqueID = destination.GetUniqueID();
  change.mask = channels;
  return change;
}

// Collects what the studio tells, within its polls, and prints it between them.
class Watcher : public SetupListener {
 public:
  void SetupChanged() override { studioChanged_ = true; }

  void CurrentPatchChanged(Destination destination, unsigned short channels) override {
    changes_.push_back(ChannelsChange("patch", destination, channels));
    changes_.back().playing = ViewPlaying(destination, channels);
  }

  void DestinationNamesChanged(Destination destination, unsigned short channels) override {
    changes_.push_back(ChannelsChange("names", destination, channels));
  }

  void Watch(Session& session, bool json, Limits const& limits) {
    view_ = ViewStudio(session.GetSetup());
    auto const start = PollLoop::Clock::now();
    session.Run([&] {
      Compare(session.GetSetup());
      PrintChanges(json, limits);
      return !limits.AreReached(start, printed_);
    });
  }

 private:
  void Compare(Setup const& setup) {
    if (!std::exchange(studioChanged_, false)) {
      return;
    }
    StudioView after = ViewStudio(setup);
    std::vector<Change> const found = FindChanges(view_, after);
    changes_.insert(changes_.end(), found.begin(), found.end());
    view_ = std::move(after);
  }

  void PrintChanges(bool json, Limits const& limits) {
    for (Change const& change : std::exchange(changes_, {})) {
      if (!limits.count || printed_ < *limits.count) {
        PrintLine(json ? ChangeJSON(change) : ChangeText(change));
        ++printed_;
      }
    }
  }

  StudioView view_;
  std::vector<Change> changes_;
  bool studioChanged_ = false;
  long long printed_ = 0;
};

// Complains in words; the library's own check prints the largest number that there is.
std::function<std::string(std::string const&)> AtLeast(double least, std::string const& what) {
  return [least, what](std::string const& text) {
    char* end = nullptr;
    double const value = std::strtod(text.c_str(), &end);
    bool const fits = !text.empty() && *end == '\0' && value >= least;
    return fits ? std::string() : "takes " + what + ", not \"" + text + "\"";
  };
}

void Watch(GlobalOptions const& globals, Limits const& limits) {
  Watcher watcher;
  Session session(globals, nullptr, &watcher);
  watcher.Watch(session, globals.json, limits);
}

}  // namespace

void AddLimits(CLI::App& command, Limits& limits) {
  command.add_option("--for", limits.seconds, "End after so many seconds")
      ->type_name("SECONDS")
      ->check(AtLeast(0, "a number of seconds from 0 on"));
  command.add_option("--count", limits.count, "End after so many lines")
      ->type_name("LINES")
      ->check(AtLeast(1, "a number of lines from 1 on"));
}

void AddWatchCommand(CLI::App& app, CommandLine& line) {
  auto const limits = std::make_shared<Limits>();
  CLI::App* const command =
      app.add_subcommand("watch", "Print a line for each change of the studio");
  AddLimits(*command, *limits);
  command->footer("Ports that come and go, names, connections, patches. Ctrl-C ends it.");
  command->callback(
      [&line, limits] { line.run = [&line, limits] { Watch(line.options, *limits); }; });
}

}  // namespace Ostinet::Tool

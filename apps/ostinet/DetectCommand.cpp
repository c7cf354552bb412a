// SPDX-License-Identifier: MIT
#include <CLI/CLI.hpp>
#include <algorithm>
#include <cstdio>
#include <utility>

#include "Commands.h"
#include "DetectText.h"
#include "DetectedDevices.h"
#include "Errors.h"
#include "Lookup.h"
#include "Output.h"
#include "ostinet/core/Terminal.h"

namespace Ostinet::Tool {
namespace {

struct DetectOptions {
  std::vector<std::string> ports;
  std::vector<std::string> excluded;
  double timeout = 0.0;
  bool create = false;
};

// Lets through what the run, which hears the sources directly, is to get.
class SysexFilter : public Receiver {
 public:
  bool WantsPacket(DataPacket const& packet, Source const&) override {
    return DetectionRun::IsSysex(packet);
  }
  void HandlePacket(DataPacket const&, Source const&) override {}
};

// The line of a terminal that is written over and over.
class ProgressDisplay {
 public:
  ProgressDisplay() : isShown_(IsErrorOutputATerminal()) {}
  ~ProgressDisplay() { Clear(); }
  ProgressDisplay(ProgressDisplay const&) = delete;
  ProgressDisplay& operator=(ProgressDisplay const&) = delete;

  void Show(DetectionRun const& run) {
    auto const progress = run.GetProgress();
    if (isShown_ && progress.port < run.Ports().size()) {
      std::string const port = run.Ports()[progress.port].destination.GetName().string();
      std::string const line = ProgressLine(progress, port, kWidth);
      if (line != last_) {
        Write(line);
        last_ = line;
      }
    }
  }

  void Clear() {
    if (!std::exchange(last_, "").empty()) {
      Write("");
    }
  }

 private:
  static constexpr std::size_t kWidth = 78;

  static void Write(std::string const& line) {
    std::string const blanks(kWidth, ' ');
    std::fprintf(stderr, "\r%s\r%s", blanks.c_str(), line.c_str());
    std::fflush(stderr);
  }

  bool const isShown_;
  std::string last_;  // what stands on the line
};

// A name stands for the output and for the input that it fits; it has to fit one of them.
std::vector<Endpoint> Excluded(std::vector<std::string> const& names) {
  std::vector<Destination> const destinations = DetectionRun::DestinationsToAsk();
  std::vector<Source> const sources = DetectionRun::SourcesToHear();
  std::vector<Endpoint> excluded;
  for (std::string const& name : names) {
    Destination const destination = TryFind(destinations, name, "port");
    Source const source = TryFind(sources, name, "port");
    if (!destination.Exists() && !source.Exists()) {
      Find(destinations, name, "port");  // Throws, and tells which there are.
    }
    excluded.push_back(destination);
    excluded.push_back(source);
  }
  return excluded;
}

std::vector<Destination> Chosen(std::vector<Destination> const& all,
                                std::vector<std::string> const& names) {
  std::vector<Destination> chosen;
  for (std::string const& name : names) {
    Destination const port = Find(all, name, "port");
    if (std::find(chosen.begin(), chosen.end(), port) == chosen.end()) {
      chosen.push_back(port);
    }
  }
  return names.empty() ? all : chosen;
}

void Print(bool asJSON, std::vector<DetectedPort> const& ports) {
  if (asJSON) {
    PrintLine(DetectJSON(ports));
    return;
  }
  for (DetectedPort const& port : ports) {
    for (std::string const& line : DetectLines(port)) {
      PrintLine(line);
    }
  }
}

std::vector<DetectedPort> View(DetectionRun const& run) {
  std::vector<DetectedPort> ports;
  for (DetectionRun::Port const& port : run.Ports()) {
    ports.push_back(ViewPort(port));
  }
  return ports;
}

// Notes in the views what was made. True if anything was.
bool CreateDevices(Setup& setup, DetectionRun const& run, std::vector<DetectedPort>& views) {
  bool isAnyMade = false;
  for (std::size_t i = 0; i < views.size(); ++i) {
    DetectionRun::Port const& port = run.Ports()[i];
    for (std::size_t j = 0; j < port.findings.size(); ++j) {
      if (auto const device = CreateDetectedDevice(setup, port.destination, port.findings[j])) {
        views[i].findings[j].device = PortName{device->GetName().string(), device->_get_impl_id()};
        isAnyMade = true;
      }
    }
  }
  return isAnyMade;
}

void ForgetDevices(std::vector<DetectedPort>& views) {
  for (DetectedPort& port : views) {
    for (FindingView& finding : port.findings) {
      finding.device.reset();
    }
  }
}

// What was found took its time, so it is printed also where the devices cannot be kept.
void KeepDevices(GlobalOptions const& globals, Session& session, std::vector<DetectedPort>& views) {
  try {
    session.Save();
  } catch (...) {
    ForgetDevices(views);
    Print(globals.json, views);
    throw;
  }
}

// Runs to the end, or until Ctrl-C.
void RunShown(Session& session, DetectionRun& run, ProgressDisplay& display) {
  display.Show(run);
  session.Run([&] {
    bool const goesOn = run.Step();
    display.Show(run);
    return goesOn;
  });
  display.Clear();
}

void Detect(GlobalOptions const& globals, DetectOptions const& options) {
  SysexFilter filter;
  Session session(globals, &filter, nullptr);
  std::vector<Endpoint> const excluded = Excluded(options.excluded);
  auto const destinations = Chosen(DetectionRun::DestinationsToAsk(excluded), options.ports);
  if (destinations.empty()) {
    throw Failure("there is no port to ask");
  }
  DetectionRun::Options runOptions;
  runOptions.portTimeLimit = options.timeout;
  DetectionRun run(destinations, DetectionRun::SourcesToHear(excluded), std::move(runOptions));
  ProgressDisplay display;
  RunShown(session, run, display);
  bool const isWhole = run.IsDone();
  run.Cancel();

  std::vector<DetectedPort> views = View(run);
  if (isWhole && options.create && CreateDevices(session.GetSetup(), run, views)) {
    KeepDevices(globals, session, views);
  }
  Print(globals.json, views);
  if (!isWhole) {
    throw Failure("interrupted before all ports were asked");
  }
}

}  // namespace

void AddDetectCommand(CLI::App& app, CommandLine& line) {
  auto const options = std::make_shared<DetectOptions>();
  CLI::App* const command =
      app.add_subcommand("detect", "Find out which instruments answer on which ports");
  command->add_option("PORTS", options->ports,
                      "Names of outputs, or unambiguous parts of them; all where none is given");
  command
      ->add_option("--exclude", options->excluded,
                   "Neither ask nor hear this port; can be given several times")
      ->type_name("PORT")
      ->allow_extra_args(false);
  command
      ->add_option("--timeout", options->timeout,
                   "At most so many seconds for each port; without it, as many as it takes")
      ->type_name("SECONDS")
      ->check(CLI::Range(0.1, 3600.0));
  command->add_flag("--create", options->create,
                    "Make a device of the right type for each instrument, on its port");
  command->footer(
      "A port takes about half a minute. Instruments are asked by sysex; what they play stays.\n"
      "Example: ostinet detect --exclude \"Drum Pad\" --create");
  command->callback(
      [&line, options] { line.run = [&line, options] { Detect(line.options, *options); }; });
}

}  // namespace Ostinet::Tool

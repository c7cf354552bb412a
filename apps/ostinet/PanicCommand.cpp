// SPDX-License-Identifier: MIT
#include <CLI/CLI.hpp>

#include "Commands.h"

namespace Ostinet::Tool {
namespace {

// 16 channels of two messages of three bytes take 31 ms on a MIDI cable.
constexpr auto kTimeToLeave = std::chrono::milliseconds(100);

void Panic(GlobalOptions const& globals) {
  Session session(globals, nullptr, nullptr);
  session.GetSetup().Panic();
  session.RunFor(kTimeToLeave);
}

}  // namespace

void AddPanicCommand(CLI::App& app, CommandLine& line) {
  CLI::App* const command =
      app.add_subcommand("panic", "Silence everything: all sound off and pedals up, everywhere");
  command->callback([&line] { line.run = [&line] { Panic(line.options); }; });
}

}  // namespace Ostinet::Tool

// SPDX-License-Identifier: MIT
#include <CLI/CLI.hpp>

#include "Commands.h"
#include "Errors.h"
#include "Outgoing.h"

namespace Ostinet::Tool {
namespace {

// The options of the command line whose order counts.
struct SendOptions {
  std::string destination;
  std::vector<std::string> words;
  std::vector<std::string> times;
  std::vector<std::string> channels;
  CLI::Option* wordsOption = nullptr;
  CLI::Option* timesOption = nullptr;
  CLI::Option* channelsOption = nullptr;
};

// A time or a channel holds for the words behind it, so the arguments are read in the order in
// which they were given.
std::vector<ScheduledMessage> MessagesOf(CLI::App const& command, SendOptions const& options) {
  SendWords reader;
  auto word = options.words.begin();
  auto time = options.times.begin();
  auto channel = options.channels.begin();
  for (CLI::Option const* const option : command.parse_order()) {
    if (option == options.wordsOption) {
      reader.Add(*word++);
    } else if (option == options.timesOption) {
      reader.SetTime(*time++);
    } else if (option == options.channelsOption) {
      reader.SetChannel(*channel++);
    }
  }
  std::vector<ScheduledMessage> messages = reader.Take();
  if (messages.empty()) {
    throw UsageError("there is nothing to send: give bytes like 90 3C 40, a verb or a .syx file");
  }
  return messages;
}

void Send(GlobalOptions const& globals, std::string const& destination,
          std::vector<ScheduledMessage> messages) {
  Session session(globals, nullptr, nullptr);
  Outgoing outgoing(FindDestination(session.GetSetup(), destination), std::move(messages));
  session.Run([&] {
    outgoing.Step();
    return !outgoing.IsDone();
  });
  if (!outgoing.IsDone()) {
    throw Failure("interrupted before all messages had gone out");
  }
}

CLI::Option* AddRepeatable(CLI::App& command, std::string const& name,
                           std::vector<std::string>& values, std::string const& help) {
  // One value at each place, however often it stands there.
  return command.add_option(name, values, help)->allow_extra_args(false)->type_name("");
}

}  // namespace

void AddSendCommand(CLI::App& app, CommandLine& line) {
  auto const options = std::make_shared<SendOptions>();
  CLI::App* const command = app.add_subcommand("send", "Send messages to a destination");
  command->add_option("DESTINATION", options->destination, "Its name, or an unambiguous part of it")
      ->required();
  options->wordsOption =
      command->add_option("WORDS", options->words,
                          "Bytes in hexadecimal, .syx files, and the verbs below, in any order");
  options->timesOption =
      AddRepeatable(*command, "--at", options->times,
                    "+MS: what follows goes out so many milliseconds after the start");
  options->channelsOption = AddRepeatable(*command, "-c,--channel", options->channels,
                                          "1 to 16: the channel of the verbs that follow (1)");
  command->footer("Verbs:\n" + SendVerbsHelp() +
                  "\nNOTE is a number from 0 to 127 or a name like C4 (60), F#3, Bb2."
                  "\nVerbs are in lower case: cc is a verb, CC a byte."
                  "\nExample: ostinet send Synth pc 5 on C4 100 --at +500 off C4");
  command->callback([&line, command, options] {
    line.run = [&line, command, options] {
      Send(line.options, options->destination, MessagesOf(*command, *options));
    };
  });
}

}  // namespace Ostinet::Tool

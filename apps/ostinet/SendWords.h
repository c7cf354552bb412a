// SPDX-License-Identifier: MIT
#pragma once

#include <string>
#include <string_view>
#include <vector>

#include "HexBytes.h"

namespace Ostinet::Tool {

/// One message on its way out.
struct ScheduledMessage {
  double afterMs;  ///< milliseconds after the start of sending, 0 for at once
  Bytes bytes;     ///< one whole message
};

/// Reads the words that `send` takes: hexadecimal bytes, names of .syx files, and verbs with their
/// numbers. Words are read in order; a channel or a time ("+500") holds for what follows it.
///
/// Errors       UsageError for words that make no message, Failure for files that cannot be read.
class SendWords {
 public:
  /// One argument of the command line: a word, several in one text, or the name of a .syx file.
  void Add(std::string const& argument);

  /// "1" to "16".
  void SetChannel(std::string_view text);

  /// "+500": milliseconds after the start, 0 or more; the sign may be left out.
  void SetTime(std::string_view text);

  /// All messages in order of time, those of one time in the order given.
  std::vector<ScheduledMessage> Take();

 private:
  void AddWord(std::string const& word);
  bool TakeForVerb(std::string const& word);
  void FinishVerb();
  void FinishHex();
  void AddFile(std::string const& path);
  void Append(std::vector<Bytes> const& messages);

  std::vector<ScheduledMessage> messages_;
  std::vector<std::string> verb_;  // A verb and the numbers read for it so far.
  std::string hex_;                // Adjacent words of hexadecimal bytes, read as one run.
  unsigned char channel_ = 0;      // From 0.
  double afterMs_ = 0;
};

/// The help text of the verbs.
std::string SendVerbsHelp();

}  // namespace Ostinet::Tool

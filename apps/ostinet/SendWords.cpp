// SPDX-License-Identifier: MIT
#include "SendWords.h"

#include <algorithm>
#include <cmath>
#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <iterator>

#include "Errors.h"
#include "Messages.h"
#include "SendVerbs.h"

namespace Ostinet::Tool {
namespace {

bool IsSysexFileName(std::string const& argument) {
  constexpr std::string_view kEnding = ".syx";
  if (argument.size() <= kEnding.size()) {
    return false;
  }
  return std::equal(kEnding.begin(), kEnding.end(), argument.end() - 4,
                    [](char a, char b) { return a == b || (b >= 'A' && b <= 'Z' && a == b + 32); });
}

// File names come from the command line as UTF-8.
std::filesystem::path PathOf(std::string const& text) {
  return std::filesystem::path(std::u8string(text.begin(), text.end()));
}

Bytes ReadFile(std::string const& path) {
  std::ifstream file(PathOf(path), std::ios::binary);
  Bytes bytes((std::istreambuf_iterator<char>(file)), std::istreambuf_iterator<char>());
  if (!file) {
    throw Failure("the file \"" + path + "\" cannot be read");
  }
  return bytes;
}

// A sysex may be given with or without its first and last byte.
Bytes FramedSysex(Bytes bytes) {
  if (bytes.empty() || bytes.front() != kSysexStart) {
    bytes.insert(bytes.begin(), kSysexStart);
  }
  if (bytes.back() != kSysexEnd) {
    bytes.push_back(kSysexEnd);
  }
  return bytes;
}

}  // namespace

void SendWords::Add(std::string const& argument) {
  if (IsSysexFileName(argument)) {
    FinishVerb();
    FinishHex();
    AddFile(argument);
    return;
  }
  for (std::string const& word : SplitWords(argument)) {
    AddWord(word);
  }
}

// True if the word is a number of the verb that was begun. The bytes behind "syx" are gathered as
// any others; its end comes with the next word that is none.
bool SendWords::TakeForVerb(std::string const& word) {
  Verb const& verb = *FindVerb(verb_.front());
  size_t const have = verb_.size() - 1;
  bool const demanded = have < verb.minNumbers;
  if (demanded || (have < verb.maxNumbers && LooksLikeNumber(word))) {
    verb_.push_back(word);
    if (have + 1 == verb.maxNumbers) {
      FinishVerb();
    }
    return true;
  }
  if (verb.kind != VerbKind::kSysex || FindVerb(word) != nullptr) {
    FinishVerb();
  }
  return false;
}

void SendWords::AddWord(std::string const& word) {
  if (!verb_.empty() && TakeForVerb(word)) {
    return;
  }
  if (word.front() == '+') {
    SetTime(word);
    return;
  }
  Verb const* const verb = FindVerb(word);
  if (verb == nullptr) {
    hex_ += word + ' ';
    return;
  }
  FinishHex();
  verb_ = {word};
  if (verb->maxNumbers == 0 && verb->kind != VerbKind::kSysex) {
    FinishVerb();
  }
}

void SendWords::FinishVerb() {
  if (verb_.empty()) {
    return;
  }
  Verb const& verb = *FindVerb(verb_.front());
  std::vector<std::string> const numbers(verb_.begin() + 1, verb_.end());
  verb_.clear();
  if (numbers.size() < verb.minNumbers) {
    throw UsageError("\"" + std::string(verb.name) + "\" needs " + std::to_string(verb.minNumbers) +
                     (verb.minNumbers == 1 ? " number behind it" : " numbers behind it"));
  }
  if (verb.kind == VerbKind::kChannel) {
    SetChannel(numbers.front());
  } else if (verb.kind == VerbKind::kSysex) {
    Bytes const bytes = ParseHex(hex_);
    hex_.clear();
    if (bytes.empty()) {
      throw UsageError("\"syx\" needs hexadecimal bytes behind it");
    }
    Append(SplitMessages(FramedSysex(bytes)));
  } else {
    Append({MakeVerbMessage(verb, numbers, channel_)});
  }
}

void SendWords::FinishHex() {
  Bytes const run = ParseHex(hex_);
  hex_.clear();
  Append(SplitMessages(run));
}

void SendWords::AddFile(std::string const& path) {
  Bytes const bytes = ReadFile(path);
  std::vector<Bytes> messages;
  try {
    messages = SplitMessages(bytes);
  } catch (UsageError const& error) {
    throw Failure("the file \"" + path + "\" holds no whole MIDI messages: " + error.what());
  }
  if (messages.empty()) {
    throw Failure("the file \"" + path + "\" is empty");
  }
  Append(messages);
}

void SendWords::Append(std::vector<Bytes> const& messages) {
  for (Bytes const& message : messages) {
    messages_.push_back({afterMs_, message});
  }
}

void SendWords::SetChannel(std::string_view text) {
  FinishVerb();
  FinishHex();
  channel_ = static_cast<unsigned char>(ParseNumber(text, 1, 16, "a channel") - 1);
}

void SendWords::SetTime(std::string_view text) {
  FinishVerb();
  FinishHex();
  std::string const number(text);
  char* end = nullptr;
  double const milliseconds = std::strtod(number.c_str(), &end);
  constexpr double kWeek = 7 * 24 * 3600e3;
  if (number.empty() || *end != '\0' || !(milliseconds >= 0) || milliseconds > kWeek) {
    throw UsageError("a time is given in milliseconds from the start, like +500, not \"" + number +
                     "\"");
  }
  afterMs_ = milliseconds;
}

std::vector<ScheduledMessage> SendWords::Take() {
  FinishVerb();
  FinishHex();
  std::stable_sort(messages_.begin(), messages_.end(),
                   [](auto const& a, auto const& b) { return a.afterMs < b.afterMs; });
  return std::move(messages_);
}

}  // namespace Ostinet::Tool

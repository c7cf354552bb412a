// SPDX-License-Identifier: MIT
#pragma once

#include <array>
#include <bitset>
#include <cstdint>
#include <optional>
#include <string>
#include <vector>

#include "ostinet/SimulatedMIDI.h"
#include "platform/system/simulated/StreamParser.h"

namespace Ostinet::Impl::Simulated {

/// Hexadecimal bytes such as "F0 41 10"; "??" gives a nothing where `wildcards` allows it. Throws
/// std::invalid_argument with a sentence that quotes what is wrong.
std::vector<std::optional<std::uint8_t>> ParseHexPattern(std::string const& text, bool wildcards);
std::vector<std::uint8_t> ParseHex(std::string const& text);

/// An instrument behind an output: answers inquiries and remembers what it was told to play.
///
/// Threads  Guarded by the studio's mutex.
class Instrument final : private StreamParser::Sink {
 public:
  explicit Instrument(SimulatedInstrument const& description);

  std::string const& Out() const { return out_; }
  std::string const& In() const { return in_; }
  /// Takes what left through the output; gives the bytes that it answers, usually none.
  std::vector<std::uint8_t> Receive(std::uint8_t const* bytes, std::size_t size);
  SimulatedChannel WhatPlays(int channel) const;

 private:
  struct Channel {
    int program = -1;
    int bankMSB = -1;
    int bankLSB = -1;
    int pendingMSB = -1;
    int pendingLSB = -1;
    std::bitset<128> notes;
  };
  struct Answer {
    std::vector<std::optional<std::uint8_t>> to;
    std::vector<std::uint8_t> with;
  };

  void Short(std::uint8_t const (&bytes)[3], int length) override;
  void SysexByte(std::uint8_t byte) override;
  void SysexEnd(bool whole) override;
  void Stray(std::uint8_t) override {}

  static void ControlChange(Channel& channel, int number, int value);
  bool IsInquiry() const;

  std::string out_;
  std::string in_;
  std::uint8_t deviceID_;
  std::vector<std::uint8_t> identity_;
  std::vector<Answer> answers_;
  std::array<Channel, 16> channels_;
  StreamParser parser_;
  std::vector<std::uint8_t> sysex_;
  std::vector<std::uint8_t> reply_;
};

}  // namespace Ostinet::Impl::Simulated

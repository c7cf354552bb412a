// SPDX-License-Identifier: MIT
#include "platform/system/simulated/Instrument.h"

#include <algorithm>
#include <cctype>
#include <stdexcept>
#include <utility>

namespace Ostinet::Impl::Simulated {

namespace {

int Digit(char c) {
  if (c >= '0' && c <= '9') return c - '0';
  if (c >= 'A' && c <= 'F') return c - 'A' + 10;
  if (c >= 'a' && c <= 'f') return c - 'a' + 10;
  return -1;
}

bool IsBlank(char c) { return std::isspace(static_cast<unsigned char>(c)) != 0; }

// The manufacturer takes one byte or, after 00, three; family and member two each; version four.
void CompleteIdentity(std::vector<std::uint8_t>& identity) {
  if (identity.empty()) return;
  std::size_t const whole = identity.front() == 0 ? 11 : 9;
  if (identity.size() < whole) identity.resize(whole, 0);
}

}  // namespace

std::vector<std::optional<std::uint8_t>> ParseHexPattern(std::string const& text, bool wildcards) {
  std::vector<std::optional<std::uint8_t>> result;
  for (std::size_t i = 0; i < text.size();) {
    if (IsBlank(text[i])) {
      ++i;
      continue;
    }
    char const first = text[i];
    char const second = i + 1 < text.size() ? text[i + 1] : ' ';
    if (wildcards && first == '?' && second == '?') {
      result.emplace_back();
    } else if (Digit(first) >= 0 && Digit(second) >= 0) {
      result.emplace_back(static_cast<std::uint8_t>(Digit(first) * 16 + Digit(second)));
    } else {
      throw std::invalid_argument("\"" + text + "\" is not a row of hexadecimal bytes");
    }
    i += 2;
  }
  return result;
}

std::vector<std::uint8_t> ParseHex(std::string const& text) {
  std::vector<std::uint8_t> result;
  for (auto const& byte : ParseHexPattern(text, false)) result.push_back(*byte);
  return result;
}

Instrument::Instrument(SimulatedInstrument const& description)
    : out_(description.out),
      in_(description.in),
      deviceID_(static_cast<std::uint8_t>(description.deviceID)),
      identity_(ParseHex(description.identity)) {
  if (description.deviceID < 0 || description.deviceID > 127) {
    throw std::invalid_argument("The device ID " + std::to_string(description.deviceID) +
                                " is not within 0 to 127");
  }
  CompleteIdentity(identity_);
  for (auto const& reply : description.replies) {
    answers_.push_back({ParseHexPattern(reply.to, true), ParseHex(reply.with)});
  }
}

std::vector<std::uint8_t> Instrument::Receive(std::uint8_t const* bytes, std::size_t size) {
  parser_.Parse(bytes, size, *this);
  return std::exchange(reply_, {});
}

SimulatedChannel Instrument::WhatPlays(int channel) const {
  Channel const& from = channels_.at(static_cast<std::size_t>(channel));
  SimulatedChannel result{from.program, from.bankMSB, from.bankLSB, {}};
  for (std::size_t note = 0; note < 128; ++note) {
    if (from.notes[note]) result.notes.push_back(static_cast<int>(note));
  }
  return result;
}

void Instrument::Short(std::uint8_t const (&bytes)[3], int) {
  if (bytes[0] == 0xFF) {
    for (Channel& each : channels_) each = Channel();
    return;
  }
  Channel& channel = channels_[bytes[0] & 0x0F];
  switch (bytes[0] & 0xF0) {
    case 0x80:
      channel.notes.reset(bytes[1]);
      break;
    case 0x90:
      channel.notes.set(bytes[1], bytes[2] != 0);
      break;
    case 0xB0:
      ControlChange(channel, bytes[1], bytes[2]);
      break;
    case 0xC0:
      channel.program = bytes[1];
      channel.bankMSB = channel.pendingMSB;
      channel.bankLSB = channel.pendingLSB;
      break;
    default:
      break;
  }
}

void Instrument::ControlChange(Channel& channel, int number, int value) {
  if (number == 0) channel.pendingMSB = value;
  if (number == 32) channel.pendingLSB = value;
  // All sound off, and from all notes off on the channel modes that end all notes too.
  if (number == 120 || number >= 123) channel.notes.reset();
}

void Instrument::SysexByte(std::uint8_t byte) {
  if (byte == 0xF0) sysex_.clear();
  sysex_.push_back(byte);
}

bool Instrument::IsInquiry() const {
  return !identity_.empty() && sysex_.size() == 6 && sysex_[1] == 0x7E && sysex_[3] == 0x06 &&
         sysex_[4] == 0x01 && (sysex_[2] == deviceID_ || sysex_[2] == 0x7F);
}

void Instrument::SysexEnd(bool whole) {
  if (!whole) return;
  if (IsInquiry()) {
    std::uint8_t const head[] = {0xF0, 0x7E, deviceID_, 0x06, 0x02};
    reply_.insert(reply_.end(), std::begin(head), std::end(head));
    reply_.insert(reply_.end(), identity_.begin(), identity_.end());
    reply_.push_back(0xF7);
  }
  for (Answer const& answer : answers_) {
    bool const asked = std::equal(
        sysex_.begin(), sysex_.end(), answer.to.begin(), answer.to.end(),
        [](std::uint8_t byte, auto const& wanted) { return !wanted || *wanted == byte; });
    if (asked) reply_.insert(reply_.end(), answer.with.begin(), answer.with.end());
  }
}

}  // namespace Ostinet::Impl::Simulated

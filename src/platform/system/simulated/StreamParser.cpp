// SPDX-License-Identifier: MIT
#include "platform/system/simulated/StreamParser.h"

namespace Ostinet::Impl::Simulated {

namespace {

// Length of the message with this status; 0 for the undefined ones.
int LengthOf(std::uint8_t status) {
  if (status < 0xF0) return (status & 0xE0) == 0xC0 ? 2 : 3;
  switch (status) {
    case 0xF1:
    case 0xF3:
      return 2;
    case 0xF2:
      return 3;
    case 0xF4:
    case 0xF5:
      return 0;
    default:
      return 1;
  }
}

}  // namespace

void StreamParser::Parse(std::uint8_t const* bytes, std::size_t size, Sink& sink) {
  for (std::size_t i = 0; i < size; ++i) {
    std::uint8_t const byte = bytes[i];
    if (byte >= 0xF8) {
      std::uint8_t const realtime[3] = {byte, 0, 0};
      sink.Short(realtime, 1);
    } else if (byte >= 0x80) {
      Status(byte, sink);
    } else {
      Data(byte, sink);
    }
  }
}

void StreamParser::Status(std::uint8_t byte, Sink& sink) {
  if (byte == 0xF7) {
    if (inSysex_) {
      sink.SysexByte(byte);
      sink.SysexEnd(true);
    } else {
      sink.Stray(byte);
    }
    inSysex_ = false;
    have_ = 0;
    return;
  }
  if (inSysex_) sink.SysexEnd(false);
  inSysex_ = byte == 0xF0;
  have_ = 0;
  if (inSysex_) {
    sink.SysexByte(byte);
    return;
  }
  need_ = LengthOf(byte);
  if (need_ == 0) {
    sink.Stray(byte);
    return;
  }
  message_[0] = byte;
  message_[1] = message_[2] = 0;
  have_ = 1;
  if (need_ == 1) {
    sink.Short(message_, 1);
    have_ = 0;
  }
}

void StreamParser::Data(std::uint8_t byte, Sink& sink) {
  if (inSysex_) {
    sink.SysexByte(byte);
    return;
  }
  if (have_ == 0) {
    sink.Stray(byte);
    return;
  }
  message_[have_++] = byte;
  if (have_ < need_) return;
  sink.Short(message_, need_);
  // Channel messages may run on without a new status; system ones may not.
  have_ = message_[0] < 0xF0 ? 1 : 0;
  message_[1] = message_[2] = 0;
}

}  // namespace Ostinet::Impl::Simulated

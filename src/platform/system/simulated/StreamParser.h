// SPDX-License-Identifier: MIT
#pragma once

#include <cstddef>
#include <cstdint>

namespace Ostinet::Impl::Simulated {

/// Takes a stream of MIDI bytes apart, as an input driver does: running status is completed,
/// realtime messages are taken out of the middle of others, sysex goes on byte by byte.
class StreamParser {
 public:
  class Sink {
   public:
    /// A whole message of 1 to 3 bytes that starts with a status; the rest of `bytes` is 0.
    virtual void Short(std::uint8_t const (&bytes)[3], int length) = 0;
    /// One byte of a sysex message, F0 and F7 included.
    virtual void SysexByte(std::uint8_t byte) = 0;
    /// The sysex message ended: `whole` when by F7, else by another status.
    virtual void SysexEnd(bool whole) = 0;
    /// A byte that belongs to no message.
    virtual void Stray(std::uint8_t byte) = 0;

   protected:
    ~Sink() = default;
  };

  void Parse(std::uint8_t const* bytes, std::size_t size, Sink& sink);

 private:
  void Status(std::uint8_t byte, Sink& sink);
  void Data(std::uint8_t byte, Sink& sink);

  std::uint8_t message_[3] = {0, 0, 0};
  int have_ = 0;  // bytes in message_; 0 when no status holds
  int need_ = 0;
  bool inSysex_ = false;
};

}  // namespace Ostinet::Impl::Simulated

// SPDX-License-Identifier: MIT
#pragma once

#include <functional>

#include "HexBytes.h"

namespace Ostinet::Tool {

/// Makes whole messages of one source's packets. Ports hand long sysex over in pieces, and short
/// messages always as three bytes, of which the last may mean nothing; a message printed with
/// such a byte could not be sent again.
///
/// Threads      One thread at a time.
class MessageJoiner {
 public:
  /// Gets each message with the stamp of its first piece, in clocks of 100 ns.
  using Sink = std::function<void(unsigned long long clocks, Bytes const& message)>;

  /// Takes one packet and calls `sink` for each message that it completes. Anything but real time
  /// that interrupts a sysex ends it there: the piece goes to the sink as it is.
  void Take(unsigned long long clocks, Bytes const& packet, Sink const& sink);

  /// Gives out what a sysex without an end has gathered, if anything.
  void Finish(Sink const& sink);

 private:
  void TakeRest(unsigned long long clocks, Bytes const& rest, Sink const& sink);
  void TakeSysexBytes(unsigned long long clocks, Bytes const& packet, Sink const& sink);

  Bytes sysex_;
  unsigned long long sysexClocks_ = 0;
};

}  // namespace Ostinet::Tool

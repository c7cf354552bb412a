// SPDX-License-Identifier: MIT
#pragma once

#include <string>
#include <vector>

#include "SendWords.h"
#include "ostinet/Endpoint.h"
#include "ostinet/hostkit/PollLoop.h"

namespace Ostinet {
class Setup;
}

namespace Ostinet::Tool {

/// The destination of that name. Throws Failure where there is none, or it is offline.
Destination FindDestination(Setup const& setup, std::string const& name);

/// Sends messages, each at its time, while the studio's loop runs. What lies in the future is
/// stamped and left to the system, which keeps the time better than any loop; but only so much of
/// it at once, since the queue of a port drops what it cannot hold.
///
/// Threads      The polling thread.
class Outgoing {
 public:
  Outgoing(Destination const& destination, std::vector<ScheduledMessage> messages);

  /// Hands over what the system can take now. The first call sets the start, from which all times
  /// count. Throws Failure where the destination takes nothing any more.
  void Step();

  /// Whether the last message has gone out, as far as its time and its length tell.
  bool IsDone() const;

  /// How many messages were not handed over.
  size_t CountLeft() const { return messages_.size() - next_; }

 private:
  using Clock = PollLoop::Clock;

  void Start();
  void Send(ScheduledMessage const& message);
  Clock::time_point DueOf(ScheduledMessage const& message) const;

  Destination destination_;
  std::vector<ScheduledMessage> messages_;
  size_t next_ = 0;
  bool started_ = false;
  Clock::time_point start_;
  unsigned long long startClocks_ = 0;
  Clock::time_point busyUntil_;  // When the last bytes handed over have left the wire.
};

}  // namespace Ostinet::Tool

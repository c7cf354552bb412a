// SPDX-License-Identifier: MIT
#pragma once

#include "ostinet/hostkit/PollLoop.h"

namespace Ostinet {

/// When which of the loop's calls is due. It knows no clock but what it is told.
class PollSchedule {
 public:
  using Time = PollLoop::Clock::time_point;
  using Duration = PollLoop::Duration;

  struct Intervals {
    Duration input;
    Duration poll;
    Duration setupChanges;
    Duration hurried;
    Duration hurryLasts;
  };

  struct Due {
    bool input = false;
    bool poll = false;
    bool setupChanges = false;
  };

  /// All calls are due at `start`.
  PollSchedule(Intervals const& intervals, Time start);

  /// What is due at `now`; each is due again one interval after `now`. A loop that was held up
  /// catches up with one call, not with those that it missed.
  Due TakeDue(Time now);

  /// The earliest time at which something is due.
  Time NextDue() const;

  /// Polls for changes of the studio at the hurried interval, from now on, for as long as a hurry
  /// lasts. Hurrying again prolongs it.
  void Hurry(Time now);

 private:
  Duration SetupChangesInterval(Time now) const;

  Intervals intervals_;
  Time input_;
  Time poll_;
  Time setupChanges_;
  Time hurryEnds_;
};

}  // namespace Ostinet

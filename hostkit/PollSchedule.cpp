// SPDX-License-Identifier: MIT
#include "PollSchedule.h"

#include <algorithm>

namespace Ostinet {
namespace {

bool Take(PollSchedule::Time& due, PollSchedule::Time now, PollSchedule::Duration interval) {
  if (now < due) {
    return false;
  }
  due = now + interval;
  return true;
}

}  // namespace

PollSchedule::PollSchedule(Intervals const& intervals, Time start)
    : intervals_(intervals), input_(start), poll_(start), setupChanges_(start), hurryEnds_(start) {}

PollSchedule::Due PollSchedule::TakeDue(Time now) {
  Due due;
  due.poll = Take(poll_, now, intervals_.poll);
  due.setupChanges = Take(setupChanges_, now, SetupChangesInterval(now));
  due.input = Take(input_, now, intervals_.input);
  return due;
}

PollSchedule::Time PollSchedule::NextDue() const {
  return std::min({input_, poll_, setupChanges_});
}

void PollSchedule::Hurry(Time now) {
  hurryEnds_ = now + intervals_.hurryLasts;
  setupChanges_ = std::min(setupChanges_, now + SetupChangesInterval(now));
}

PollSchedule::Duration PollSchedule::SetupChangesInterval(Time now) const {
  return now < hurryEnds_ ? std::min(intervals_.hurried, intervals_.setupChanges)
                          : intervals_.setupChanges;
}

}  // namespace Ostinet

// SPDX-License-Identifier: MIT
#include <gtest/gtest.h>

#include "PollSchedule.h"

namespace Ostinet {
namespace {

using std::chrono::milliseconds;

class Schedule : public testing::Test {
 protected:
  // The calls that are due so many milliseconds after the start: i(nput), p(oll), s(etup changes).
  std::string DueAt(int ms) {
    PollSchedule::Due const due = schedule_.TakeDue(At(ms));
    return std::string(due.poll ? "p" : "") + (due.setupChanges ? "s" : "") +
           (due.input ? "i" : "");
  }

  PollSchedule::Time At(int ms) const { return PollSchedule::Time() + milliseconds(ms); }

  PollSchedule schedule_{{milliseconds(2), milliseconds(1000), milliseconds(2000), milliseconds(20),
                          milliseconds(100)},
                         PollSchedule::Time()};
};

TEST_F(Schedule, CallsEverythingAtTheStart) {
  EXPECT_EQ(schedule_.NextDue(), At(0));
  EXPECT_EQ(DueAt(0), "psi");
  EXPECT_EQ(DueAt(0), "");
}

TEST_F(Schedule, KeepsEachInterval) {
  DueAt(0);
  EXPECT_EQ(DueAt(1), "");
  EXPECT_EQ(DueAt(2), "i");
  EXPECT_EQ(schedule_.NextDue(), At(4));
  EXPECT_EQ(DueAt(999), "i");
  EXPECT_EQ(DueAt(1000), "p");
  EXPECT_EQ(DueAt(2000), "psi");
}

TEST_F(Schedule, CatchesUpWithOneCall) {
  DueAt(0);
  EXPECT_EQ(DueAt(10000), "psi");
  EXPECT_EQ(DueAt(10001), "");
  EXPECT_EQ(DueAt(11000), "pi");
}

TEST_F(Schedule, PollsForChangesSoonAndOftenInAHurry) {
  DueAt(0);
  schedule_.Hurry(At(500));
  EXPECT_EQ(DueAt(519), "i");
  EXPECT_EQ(DueAt(520), "s");
  EXPECT_EQ(DueAt(540), "si");
  EXPECT_EQ(DueAt(599), "si");
}

TEST_F(Schedule, ReturnsToLeisureAfterAHurry) {
  DueAt(0);
  schedule_.Hurry(At(0));
  EXPECT_EQ(DueAt(100), "si");
  EXPECT_EQ(DueAt(2099), "pi");
  EXPECT_EQ(DueAt(2100), "s");
}

TEST_F(Schedule, DoesNotPutAPollOffInAHurry) {
  DueAt(0);
  schedule_.Hurry(At(1990));
  EXPECT_EQ(DueAt(2000), "psi");
}

TEST_F(Schedule, ProlongsAHurry) {
  DueAt(0);
  schedule_.Hurry(At(0));
  schedule_.Hurry(At(90));
  EXPECT_EQ(DueAt(150), "si");
  EXPECT_EQ(DueAt(170), "si");
}

}  // namespace
}  // namespace Ostinet

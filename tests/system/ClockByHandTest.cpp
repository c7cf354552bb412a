// SPDX-License-Identifier: MIT
#include <thread>

#include "system/SimulatedTest.h"

namespace Ostinet::Impl::Simulated {
namespace {

class ClockByHand : public SimulatedTest {
 protected:
  REFERENCE_TIME Read() const {
    Held<IDirectMusic> music;
    Held<IReferenceClock> clock;
    Sys().CreateDirectMusic(music.Out());
    music->GetMasterClock(nullptr, clock.Out());
    REFERENCE_TIME time = -1;
    EXPECT_EQ(clock->GetTime(&time), S_OK);
    return time;
  }
};

TEST_F(ClockByHand, MovesOnlyWhenMoved) {
  EXPECT_EQ(Read(), 1000);
  EXPECT_EQ(Read(), 1000);
  EXPECT_TRUE(studio_.AdvanceClocks(250000));
  EXPECT_EQ(Read(), 251000);
  EXPECT_EQ(Sys().timeGetTime(), 25u);
  EXPECT_THROW(studio_.AdvanceClocks(-1), std::invalid_argument);
}

TEST_F(ClockByHand, CanStepWithEachReading) {
  studio_.SetStepPerReading(1);
  EXPECT_EQ(Read(), 1001);
  EXPECT_EQ(Read(), 1002);
  studio_.SetStepPerReading(0);
  EXPECT_EQ(Read(), 1002);
}

TEST_F(ClockByHand, TheMasterClockCanStandStillTickCoarselyOrBeAbsent) {
  studio_.SetMasterClockTick(300);
  EXPECT_EQ(Read(), 900);
  studio_.SetMasterClockTick(1);
  studio_.SetMasterClockStill(true);
  studio_.AdvanceClocks(77);
  EXPECT_EQ(Read(), 1000);
  studio_.SetMasterClockAbsent(true);
  EXPECT_EQ(Read(), 0);
  studio_.SetMasterClockAbsent(false);
  studio_.SetMasterClockStill(false);
  EXPECT_EQ(Read(), 1077);
}

TEST_F(ClockByHand, GoesOnFromThePresentReading) {
  studio_.UseRealTime();
  EXPECT_THROW(studio_.AdvanceClocks(1), std::logic_error);
  auto const before = studio_.Now();
  EXPECT_GE(before, 1000);
  studio_.MoveClockByHand();
  auto const after = studio_.Now();
  EXPECT_GE(after, before);
  EXPECT_EQ(studio_.Now(), after);
}

TEST_F(ClockByHand, TimersFireWhenTheHandReachesThem) {
  Waits& waits = Sys().GetWaits();
  HANDLE const early = waits.CreateWaitableTimerW();
  HANDLE const late = waits.CreateWaitableTimerW();
  waits.SetWaitableTimer(late, -200);
  waits.SetWaitableTimer(early, -100);
  EXPECT_EQ(waits.WaitForSingleObject(early, 0), DWORD{WAIT_TIMEOUT});
  studio_.AdvanceClocks(99);
  EXPECT_EQ(waits.WaitForSingleObject(early, 0), DWORD{WAIT_TIMEOUT});
  studio_.AdvanceClocks(1);
  EXPECT_EQ(waits.WaitForSingleObject(early, 60000), DWORD{WAIT_OBJECT_0});
  EXPECT_EQ(waits.WaitForSingleObject(late, 0), DWORD{WAIT_TIMEOUT});
  studio_.AdvanceClocks(1000);
  EXPECT_EQ(waits.WaitForSingleObject(late, 60000), DWORD{WAIT_OBJECT_0});
  waits.CloseHandle(early);
  waits.CloseHandle(late);
  EXPECT_EQ(studio_.CountWaitHandles(), 0);
}

TEST_F(ClockByHand, SetTimersFollowTheClockFromTheMachineToTheHand) {
  Waits& waits = Sys().GetWaits();
  studio_.UseRealTime();
  HANDLE const timer = waits.CreateWaitableTimerW();
  waits.SetWaitableTimer(timer, -36000000000);
  studio_.MoveClockByHand();
  studio_.AdvanceClocks(36000000000);
  EXPECT_EQ(waits.WaitForSingleObject(timer, 60000), DWORD{WAIT_OBJECT_0});
  waits.SetWaitableTimer(timer, -10000);
  studio_.UseRealTime();
  EXPECT_EQ(waits.WaitForSingleObject(timer, 60000), DWORD{WAIT_OBJECT_0});
  waits.CloseHandle(timer);
}

// The pattern of an output thread: items come through a semaphore, each waits for its time.
class OutputThread {
 public:
  OutputThread(System& system, HMIDIOUT out)
      : waits_(system.GetWaits()),
        items_(waits_.CreateSemaphoreW(0, 256)),
        quit_(waits_.CreateSemaphoreW(0, 1)),
        thread_([this, &system, out] { Run(system, out); }) {}
  ~OutputThread() {
    waits_.ReleaseSemaphore(quit_, 1);
    thread_.join();
    waits_.CloseHandle(items_);
    waits_.CloseHandle(quit_);
  }
  void Send() { waits_.ReleaseSemaphore(items_, 1); }

 private:
  void Run(System& system, HMIDIOUT out) {
    HANDLE const timer = waits_.CreateWaitableTimerW();
    HANDLE const objects[] = {quit_, items_};
    while (waits_.WaitForMultipleObjects(2, objects, INFINITE) == WAIT_OBJECT_0 + 1) {
      waits_.SetWaitableTimer(timer, -500);
      waits_.WaitForSingleObject(timer, INFINITE);
      system.midiOutShortMsg(out, 0x403C90);
    }
    waits_.CloseHandle(timer);
  }

  Waits& waits_;
  HANDLE const items_;
  HANDLE const quit_;
  std::thread thread_;
};

class ClockByHandThreads : public ClockByHand {};

TEST_F(ClockByHandThreads, AdvancingWaitsForTheThreadsThatItWakes) {
  studio_.AddPort(PortOf("Out", PortKind::kWinMMOut));
  HMIDIOUT out = nullptr;
  ASSERT_EQ(Sys().midiOutOpen(&out, 0, 0, 0, CALLBACK_NULL), 0u);
  {
    OutputThread thread(Sys(), out);
    for (int i = 0; i < 3; ++i) thread.Send();
    ASSERT_TRUE(studio_.AdvanceClocks(499));
    EXPECT_TRUE(studio_.Sent().empty());
    ASSERT_TRUE(studio_.AdvanceClocks(10000));
    auto const sent = studio_.Sent();
    ASSERT_EQ(sent.size(), 3u);
    // Each item waits 500 clocks from when the one before it was sent, to the clock.
    EXPECT_EQ(sent[0].left, 1500);
    EXPECT_EQ(sent[1].left, 2000);
    EXPECT_EQ(sent[2].left, 2500);
  }
  EXPECT_TRUE(studio_.Settle());
  Sys().midiOutClose(out);
}

TEST_F(ClockByHandThreads, SettleGivesUpAtItsTimeLimit) {
  Waits& waits = Sys().GetWaits();
  HANDLE const nobodyListens = waits.CreateSemaphoreW(0, 256);
  waits.ReleaseSemaphore(nobodyListens, 1);
  EXPECT_FALSE(studio_.Settle(1));
  waits.CloseHandle(nobodyListens);
  EXPECT_TRUE(studio_.Settle());
}

}  // namespace
}  // namespace Ostinet::Impl::Simulated

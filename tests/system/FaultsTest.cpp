// SPDX-License-Identifier: MIT
#include "ostinet/core/Error.h"
#include "system/SimulatedTest.h"

namespace Ostinet::Impl::Simulated {
namespace {

class Faults : public SimulatedTest {
 protected:
  Faults() { studio_.AddPort(PortOf("Out", PortKind::kWinMMOut)); }
  MMRESULT Open() {
    HMIDIOUT out = nullptr;
    MMRESULT const result = Sys().midiOutOpen(&out, 0, 0, 0, CALLBACK_NULL);
    if (result == 0) Sys().midiOutClose(out);
    return result;
  }
};

TEST_F(Faults, OneCallFailsAndTheNextDoesNot) {
  studio_.FailWith("midiOutOpen", MMSYSERR_ALLOCATED, 2);
  EXPECT_EQ(Open(), 0u);
  EXPECT_EQ(Open(), MMRESULT{MMSYSERR_ALLOCATED});
  EXPECT_EQ(Open(), 0u);
}

TEST_F(Faults, AllCallsFailFromOneOnUntilCleared) {
  studio_.FailFrom("midiOutOpen", 2);
  EXPECT_EQ(Open(), 0u);
  EXPECT_EQ(Open(), 1u);
  EXPECT_EQ(Open(), 1u);
  studio_.ClearFaults();
  EXPECT_EQ(Open(), 0u);
}

TEST_F(Faults, EachKindOfCallFailsInItsOwnWay) {
  Held<IDirectMusic> music;
  studio_.Fail("CreateDirectMusic");
  EXPECT_EQ(Sys().CreateDirectMusic(music.Out()), E_FAIL);
  EXPECT_EQ(music.Get(), nullptr);
  Waits& waits = Sys().GetWaits();
  studio_.Fail("CreateSemaphoreW");
  EXPECT_EQ(waits.CreateSemaphoreW(0, 1), nullptr);
  HANDLE const semaphore = waits.CreateSemaphoreW(1, 2);
  studio_.Fail("ReleaseSemaphore");
  EXPECT_FALSE(waits.ReleaseSemaphore(semaphore, 1));
  EXPECT_EQ(waits.GetLastError(), 298u);
  studio_.Fail("WaitForSingleObject");
  EXPECT_EQ(waits.WaitForSingleObject(semaphore, INFINITE), WAIT_FAILED);
  EXPECT_EQ(waits.WaitForSingleObject(semaphore, INFINITE), DWORD{WAIT_OBJECT_0});
  waits.CloseHandle(semaphore);
  studio_.Fail("SnapshotAudioSessions");
  EXPECT_THROW(Sys().SnapshotAudioSessions(), VantorError);
}

TEST_F(Faults, ASweepOverAnyCallComesToItsEnd) {
  // One call fails in each round, until a round has fewer calls than that.
  std::vector<std::pair<UINT, MMRESULT>> rounds;
  for (std::uint64_t nth = 1;; ++nth) {
    studio_.ResetCalls();
    studio_.ClearFaults();
    studio_.Fail("*", nth);
    MIDIOUTCAPSW caps{};
    UINT const count = Sys().midiOutGetNumDevs();
    rounds.push_back({count, Sys().midiOutGetDevCapsW(0, &caps, sizeof caps)});
    if (studio_.CountCalls() < nth) break;
  }
  EXPECT_EQ(rounds, (std::vector<std::pair<UINT, MMRESULT>>{{0, 0}, {1, 1}, {1, 0}}));
}

TEST_F(Faults, UnknownNamesAreRefused) {
  EXPECT_THROW(studio_.Fail("midiOutOpne"), std::invalid_argument);
  EXPECT_THROW(studio_.CountCalls("x"), std::invalid_argument);
  EXPECT_THROW(studio_.Fail("midiOutOpen", 0), std::invalid_argument);
  EXPECT_THROW(studio_.SetEndless("Flush", true), std::invalid_argument);
}

TEST_F(Faults, CallsAreCounted) {
  Open();
  Open();
  EXPECT_EQ(studio_.CountCalls("midiOutOpen"), 2u);
  EXPECT_EQ(studio_.CountCalls("midiOutClose"), 2u);
  EXPECT_EQ(studio_.CountCalls(), 4u);
}

TEST_F(Faults, TheLogHoldsEachCallInOrder) {
  Open();
  EXPECT_TRUE(studio_.TakeLog().empty());
  studio_.LogCalls(true);
  studio_.FailWith("midiOutOpen", 4, 2);
  Open();
  Open();
  auto const log = studio_.TakeLog();
  ASSERT_EQ(log.size(), 3u);
  EXPECT_EQ(log[0].operation, "midiOutOpen");
  EXPECT_EQ(log[0].port, "Out");
  EXPECT_EQ(log[0].arguments, (std::vector<long long>{0}));
  EXPECT_EQ(log[1].operation, "midiOutClose");
  EXPECT_EQ(log[2].operation, "midiOutOpen");
  EXPECT_EQ(log[2].result, 4);
  EXPECT_TRUE(studio_.TakeLog().empty());
}

TEST_F(Faults, AudioSessionsAreThoseThatWereSet) {
  EXPECT_TRUE(Sys().SnapshotAudioSessions().empty());
  studio_.SetAudioSessions({"one", "two"});
  auto const sessions = Sys().SnapshotAudioSessions();
  ASSERT_EQ(sessions.size(), 2u);
  EXPECT_EQ(sessions[1].identifier, u"two");
}

}  // namespace
}  // namespace Ostinet::Impl::Simulated

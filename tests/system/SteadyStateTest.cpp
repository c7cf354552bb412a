// SPDX-License-Identifier: MIT
#include "support/AllocationCounter.h"
#include "system/SimulatedTest.h"

namespace Ostinet::Impl::Simulated {
namespace {

// Tests count what the library allocates, so the system below it must not allocate itself.
class SteadyState : public SimulatedTest {
 protected:
  SteadyState() {
    studio_.AddPort(PortOf("Out", PortKind::kWinMMOut));
    studio_.ReserveRecording(1000);
  }
};

TEST_F(SteadyState, ShortMessagesAllocateNothing) {
  HMIDIOUT out = nullptr;
  ASSERT_EQ(Sys().midiOutOpen(&out, 0, 0, 0, CALLBACK_NULL), 0u);
  Sys().midiOutShortMsg(out, 0x403C90);
  Testing::AllocationCounter const allocations;
  for (int i = 0; i < 500; ++i) Sys().midiOutShortMsg(out, 0x403C90);
  EXPECT_EQ(allocations.Count(), 0u);
  Sys().midiOutClose(out);
}

TEST_F(SteadyState, PackingAndPlayingAllocateNothing) {
  Held<IDirectMusic> music;
  Held<IDirectMusicBuffer> buffer;
  Held<IDirectMusicPort> port;
  Sys().CreateDirectMusic(music.Out());
  DMUS_BUFFERDESC description{};
  description.dwSize = sizeof description;
  description.cbBuffer = 256;
  music->CreateMusicBuffer(&description, buffer.Out(), nullptr);
  DMUS_PORTCAPS caps{};
  caps.dwSize = sizeof caps;
  music->EnumPort(0, &caps);
  DMUS_PORTPARAMS8 params{};
  params.dwSize = sizeof params;
  ASSERT_EQ(music->CreatePort(caps.guidPort, &params, port.Out(), nullptr), S_OK);
  port->Activate(TRUE);
  Testing::AllocationCounter const allocations;
  for (int i = 0; i < 100; ++i) {
    buffer->PackStructured(900, 0, 0x403C90);
    buffer->PackStructured(1000000, 0, 0x003C90);
    ASSERT_EQ(port->PlayBuffer(buffer.Get()), S_OK);
    buffer->Flush();
  }
  EXPECT_EQ(allocations.Count(), 0u);
  EXPECT_EQ(studio_.CountScheduled(), 100);
}

TEST_F(SteadyState, SignallingAndWaitingAllocateNothing) {
  Waits& waits = Sys().GetWaits();
  HANDLE const semaphore = waits.CreateSemaphoreW(1, 256);
  waits.WaitForSingleObject(semaphore, INFINITE);
  Testing::AllocationCounter const allocations;
  for (int i = 0; i < 100; ++i) {
    waits.ReleaseSemaphore(semaphore, 1);
    waits.WaitForSingleObject(semaphore, INFINITE);
  }
  EXPECT_EQ(allocations.Count(), 0u);
  waits.CloseHandle(semaphore);
}

}  // namespace
}  // namespace Ostinet::Impl::Simulated

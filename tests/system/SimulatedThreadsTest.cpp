// SPDX-License-Identifier: MIT
//
// Everything at once, for the thread sanitizer and for deadlocks.

#include <atomic>
#include <condition_variable>
#include <thread>

#include "system/SimulatedTest.h"

namespace Ostinet::Impl::Simulated {
namespace {

TEST(SimulatedThreads, PortsComeAndGoWhileOthersSend) {
  SimulatedMIDI const studio;
  System& system = *studio.GetSystem();
  studio.AddPort(PortOf("Out", PortKind::kWinMMOut));
  studio.AddPort(PortOf("In", PortKind::kWinMMIn));
  studio.AddCable("Out", "In");
  std::atomic<bool> done{false};
  std::thread plugging([&] {
    for (int i = 0; i < 200; ++i) {
      studio.AddPort(PortOf("Guest", PortKind::kWinMMIn));
      studio.RenamePort("Guest", "Visitor");
      studio.RemovePort("Visitor");
    }
    done = true;
  });
  std::thread listing([&] {
    Held<IDirectMusic> music;
    system.CreateDirectMusic(music.Out());
    while (!done) {
      DMUS_PORTCAPS caps{};
      caps.dwSize = sizeof caps;
      for (DWORD i = 0; music->EnumPort(i, &caps) == S_OK; ++i) {
      }
      MIDIINCAPSW in{};
      for (UINT i = 0; i < system.midiInGetNumDevs(); ++i) {
        system.midiInGetDevCapsW(i, &in, sizeof in);
      }
    }
  });
  HMIDIOUT out = nullptr;
  ASSERT_EQ(system.midiOutOpen(&out, 0, 0, 0, CALLBACK_NULL), 0u);
  for (int i = 0; i < 100; ++i) {
    InputLog log;
    ASSERT_EQ(log.Open(system, 0), 0u);
    system.midiInStart(log.handle);
    for (int j = 0; j < 10; ++j) system.midiOutShortMsg(out, 0x403C90);
    system.midiInReset(log.handle);
    ASSERT_EQ(system.midiInClose(log.handle), 0u);
    EXPECT_EQ(log.Take().size(), 12u);
  }
  plugging.join();
  listing.join();
  system.midiOutClose(out);
}

TEST(SimulatedThreads, NoCallbackComesAfterClosing) {
  SimulatedMIDI const studio;
  System& system = *studio.GetSystem();
  studio.AddPort(PortOf("In", PortKind::kWinMMIn));
  std::atomic<bool> done{false};
  std::thread feeding([&] {
    while (!done) studio.Inject("In", {0x90, 1, 2});
  });
  for (int i = 0; i < 50; ++i) {
    auto log = std::make_unique<InputLog>();
    ASSERT_EQ(log->Open(system, 0), 0u);
    system.midiInStart(log->handle);
    ASSERT_EQ(system.midiInClose(log->handle), 0u);
    EXPECT_EQ(log->Take().back().message, UINT{MIM_CLOSE});
  }
  done = true;
  feeding.join();
}

TEST(SimulatedThreads, InRealTimeWhatIsScheduledLeavesByItself) {
  SimulatedMIDI const studio;
  System& system = *studio.GetSystem();
  auto port = PortOf("Out", PortKind::kDirectMusicOut);
  studio.AddPort(port);
  studio.AddPort(PortOf("In", PortKind::kWinMMIn));
  studio.AddCable("Out", "In");

  struct Latch {
    std::mutex mutex;
    std::condition_variable changed;
    bool arrived = false;
    static void CALLBACK Callback(HMIDIIN, UINT message, DWORD_PTR instance, DWORD_PTR, DWORD_PTR) {
      if (message != MIM_DATA) return;
      auto* const self = reinterpret_cast<Latch*>(instance);
      std::lock_guard lock(self->mutex);
      self->arrived = true;
      self->changed.notify_all();
    }
  } latch;
  HMIDIIN in = nullptr;
  ASSERT_EQ(system.midiInOpen(&in, 0, reinterpret_cast<DWORD_PTR>(&Latch::Callback),
                              reinterpret_cast<DWORD_PTR>(&latch), CALLBACK_FUNCTION),
            0u);
  system.midiInStart(in);

  Held<IDirectMusic> music;
  Held<IDirectMusicBuffer> buffer;
  Held<IDirectMusicPort> out;
  system.CreateDirectMusic(music.Out());
  DMUS_BUFFERDESC description{};
  description.dwSize = sizeof description;
  description.cbBuffer = 256;
  music->CreateMusicBuffer(&description, buffer.Out(), nullptr);
  DMUS_PORTCAPS caps{};
  caps.dwSize = sizeof caps;
  music->EnumPort(0, &caps);
  DMUS_PORTPARAMS8 params{};
  params.dwSize = sizeof params;
  ASSERT_EQ(music->CreatePort(caps.guidPort, &params, out.Out(), nullptr), S_OK);
  out->Activate(TRUE);
  long long const due = studio.Now() + 20000;
  buffer->PackStructured(due, 0, 0x403C90);
  ASSERT_EQ(out->PlayBuffer(buffer.Get()), S_OK);
  {
    std::unique_lock lock(latch.mutex);
    latch.changed.wait(lock, [&] { return latch.arrived; });
  }
  EXPECT_GE(studio.Sent()[0].left, due);
  system.midiInClose(in);
}

TEST(SimulatedThreads, AStudioEndsWithItsDevicesOpen) {
  HMIDIIN in = nullptr;
  InputLog log;
  {
    SimulatedMIDI const studio;
    studio.AddPort(PortOf("In", PortKind::kWinMMIn));
    ASSERT_EQ(log.Open(*studio.GetSystem(), 0), 0u);
    in = log.handle;
  }
  EXPECT_NE(in, nullptr);
}

}  // namespace
}  // namespace Ostinet::Impl::Simulated

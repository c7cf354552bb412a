// SPDX-License-Identifier: MIT

// What other threads may do while the polling thread takes the studio apart. ThreadSanitizer
// watches; the tests themselves see that nothing is lost, stuck or left open.

#include <atomic>
#include <thread>

#include "platform/PlatformTest.h"
#include "support/Latch.h"

namespace Ostinet::Testing {
namespace {

using Kind = SimulatedPort::Kind;
using Senders = std::vector<std::unique_ptr<Impl::Sender>>;

constexpr int kThreads = 3;
constexpr int kRounds = 12;

/// Threads that repeat their work until they are stopped.
class Background {
 public:
  explicit Background(std::vector<std::function<void()>> const& works)
      : started_(static_cast<std::ptrdiff_t>(works.size())) {
    for (auto const& work : works) {
      threads_.emplace_back([this, work] {
        work();
        started_.count_down();
        while (!done_) {
          work();
        }
      });
    }
    started_.wait();  // each has been through its work once
  }
  ~Background() { Stop(); }
  void Stop() {
    done_ = true;
    for (std::thread& thread : threads_) {
      if (thread.joinable()) {
        thread.join();
      }
    }
  }

 private:
  std::atomic<bool> done_{false};
  Testing::Latch started_;
  std::vector<std::thread> threads_;
};

class PlatformThreads : public PlatformTest {
 protected:
  PlatformThreads() {
    midi.ReserveRecording(1000);
    receiver.filter = [](Bytes const&) { return true; };
  }
  ~PlatformThreads() override {
    // The job thread works in order, so what it was asked before is over when this is.
    midi.SetNotifying(false);
    SignOut();
    SignIn();
    ListPorts();
    SignOut();
  }

  Senders MakeSenders(std::string const& name) {
    Destination const destination = Dest(name);
    Senders senders;
    for (int i = 0; i < kThreads; ++i) {
      senders.push_back(destination.MakeSender());
    }
    return senders;
  }

  /// Each sender on a thread of its own: a note for now, one for later, and a sysex.
  static std::vector<std::function<void()>> Sending(Senders const& senders) {
    std::vector<std::function<void()>> works;
    for (auto const& sender : senders) {
      works.push_back([&sender = *sender] {
        unsigned char const note[] = {0x90, 60, 64, 0};
        unsigned char const sysex[] = {0xF0, 1, 2, 3, 4, 0xF7};
        sender.Send({note, 3, kNoTimeStamp});
        sender.Send({note, 3, At(CurrentMIDITime().Value() + 1000)});
        sender.Send({sysex, sizeof sysex, kNoTimeStamp});
        sender.Flush();
        sender.CanSend();
      });
    }
    return works;
  }

  void UnplugAndReplug(std::function<void()> const& plug, std::string const& name) {
    for (int round = 0; round < kRounds; ++round) {
      midi.RemovePort(name);
      Rescan();
      EXPECT_FALSE(Dest(name).IsOnline());
      plug();
      Rescan();
      EXPECT_TRUE(Dest(name).IsOnline());
    }
  }
};

TEST_F(PlatformThreads, SendToALegacyPortThatComesAndGoes) {
  AddOut("Out");
  SignIn();
  Senders const senders = MakeSenders("Out");
  Background sending(Sending(senders));
  UnplugAndReplug([this] { AddOut("Out"); }, "Out");
  SignOut();
  sending.Stop();
  for (auto const& sender : senders) {
    EXPECT_FALSE(sender->CanSend());
  }
}

TEST_F(PlatformThreads, SendToADirectMusicPortThatComesAndGoes) {
  AddNative("Native", Kind::kDirectMusicOut);
  SignIn();
  Senders const senders = MakeSenders("Native");
  Background sending(Sending(senders));
  UnplugAndReplug([this] { AddNative("Native", Kind::kDirectMusicOut); }, "Native");
  SignOut();
  sending.Stop();
  for (auto const& sender : senders) {
    EXPECT_FALSE(sender->CanSend());
  }
}

TEST_F(PlatformThreads, KeepSendersBeyondEverything) {
  AddOut("Out");
  AddNative("Native", Kind::kDirectMusicOut);
  SignIn();
  Senders senders = MakeSenders("Out");
  for (auto& sender : MakeSenders("Native")) {
    senders.push_back(std::move(sender));
  }
  Background sending(Sending(senders));
  SignOut();
  SignIn();
  EXPECT_TRUE(Dest("Out").MakeSender()->CanSend());
  SignOut();
  sending.Stop();
  EXPECT_FALSE(senders.front()->CanSend());
  EXPECT_FALSE(senders.back()->CanSend());
}

TEST_F(PlatformThreads, TellOfDevicesDuringPollsAndSignOuts) {
  AddOut("Out");
  AddNative("Native", Kind::kDirectMusicOut);
  SignIn();
  Background telling({[this] { setup.DevicesChanged(); },
                      [this] {
                        midi.RemovePort("Guest");
                        AddOut("Guest");
                        std::this_thread::yield();
                      }});
  for (int round = 0; round < kRounds; ++round) {
    for (int poll = 0; poll < 10; ++poll) {
      setup.PollSetupChanges();
      setup.Poll();
      setup.ProcessInput();
    }
    EXPECT_TRUE(Dest("Out").IsOnline());
    SignOut();
    EXPECT_EQ(setup.CountDestinations(), 0);
    SignIn();
  }
}

TEST_F(PlatformThreads, BringInputDuringPollsDetachesAndSignOuts) {
  AddOut("Out");  // there are as many inputs of WinMM as outputs
  AddIn("In");
  AddNative("Native In", Kind::kDirectMusicIn);
  SignIn();
  std::atomic<int> delivered{0};
  receiver.onPacket = [&](Bytes const&) { ++delivered; };
  Background playing({[this] {
                        midi.Inject("In", {0x90, 60, 64});
                        std::this_thread::yield();
                      },
                      [this] {
                        midi.Inject("Native In", {0xF0, 1, 2, 3, 0xF7});
                        midi.Inject("In", {0xF0, 1, 2, 3, 0xF7});
                        std::this_thread::yield();
                      }});
  while (delivered < 10) {
    setup.ProcessInput();
  }
  for (int round = 0; round < kRounds; ++round) {
    setup.ProcessInput();
    midi.RemovePort("In");
    midi.RemovePort("Native In");
    Rescan();
    setup.ProcessInput();
    EXPECT_FALSE(Src("In").IsOnline());
    AddIn("In");
    AddNative("Native In", Kind::kDirectMusicIn);
    Rescan();
    setup.ProcessInput();
    if (round % 4 == 3) {
      SignOut();
      SignIn();
    }
    receiver.packets.clear();
  }
  SignOut();
  playing.Stop();
  receiver.packets.clear();
}

TEST_F(PlatformThreads, SendToAVirtualPairThatIsDeleted) {
  SignIn();
  for (int round = 0; round < kRounds; ++round) {
    auto const pair =
        setup.CreateVirtualEndpoint(UString("Loop"), Setup::kSourceEnd, Setup::kSourceEnd);
    Senders senders;
    for (int i = 0; i < kThreads; ++i) {
      senders.push_back(pair.second.MakeSender());
    }
    receiver.packets.clear();
    Background sending(Sending(senders));
    setup.ProcessInput();
    EXPECT_GE(receiver.packets.size(), 3u * kThreads);
    setup.DeleteVirtualEndpoint(pair.first);
    setup.PollSetupChanges();
    setup.ProcessInput();
    EXPECT_FALSE(pair.second.Exists());
  }
  receiver.packets.clear();
}

}  // namespace
}  // namespace Ostinet::Testing

// SPDX-License-Identifier: MIT

#include <algorithm>

#include "platform/PlatformTest.h"
#include "support/AllocationCounter.h"

namespace Ostinet::Testing {
namespace {

using Kind = SimulatedPort::Kind;

constexpr unsigned long long kStart = 50000000;
constexpr int kWarmUp = 300;
constexpr int kMessages = 500;
constexpr int kRounds = 3;
unsigned char const kNote[] = {0x90, 60, 64};

/// Takes packets without keeping them.
class CountingReceiver : public Receiver {
 public:
  bool WantsPacket(DataPacket const&, Source const&) override { return true; }
  void HandlePacket(DataPacket const&, Source const&) override { ++packets; }
  int packets = 0;
};

/// A host in the middle of a song: nothing that it plays or hears may allocate.
class PlatformAllocations : public PlatformTest {
 protected:
  PlatformAllocations() {
    AddOut("Out");
    AddIn("In");
    AddNative("Native", Kind::kDirectMusicOut);
    AddNative("Native In", Kind::kDirectMusicIn);
    midi.MoveClockByHand(1000000);
    midi.SetStepPerReading(1);
    EXPECT_EQ(setup.SignIn(UString("Test"), &counting, &prefs), Setup::kSignInOK);
    midi.SetStepPerReading(0);
    midi.MoveClockByHand(kStart);
    midi.ReserveRecording(100);
    midi.SetRecording(false);
  }
  ~PlatformAllocations() override { SignOut(); }

  /// The allocations of a round of `work`, after others that warm it up: the fewest of some
  /// rounds, for the threads of the simulated system start at a moment of their own.
  template <class Work>
  static std::size_t CountIn(Work work) {
    for (int i = 0; i < kWarmUp; ++i) {
      work();
    }
    std::size_t fewest = CountRound(work);
    for (int round = 1; round < kRounds; ++round) {
      fewest = std::min(fewest, CountRound(work));
    }
    return fewest;
  }

  template <class Work>
  static std::size_t CountRound(Work& work) {
    AllocationCounter const counter;
    for (int i = 0; i < kMessages; ++i) {
      work();
    }
    return counter.Count();
  }

  CountingReceiver counting;
};

TEST_F(PlatformAllocations, AreNoneForAShortMessageThroughAKeptLegacySender) {
  std::unique_ptr<Impl::Sender> const sender = Dest("Out").MakeSender();
  EXPECT_EQ(CountIn([&] {
              sender->Send({kNote, sizeof kNote, kNoTimeStamp});
              sender->Flush();
            }),
            0u);
}

TEST_F(PlatformAllocations, AreNoneForAShortMessageThroughAKeptDirectMusicSender) {
  std::unique_ptr<Impl::Sender> const sender = Dest("Native").MakeSender();
  EXPECT_EQ(CountIn([&] {
              sender->Send({kNote, sizeof kNote, kNoTimeStamp});
              sender->Flush();
              midi.Settle();
            }),
            0u);
}

TEST_F(PlatformAllocations, AreNoneForSendOnePacket) {
  Destination const out = Dest("Out");
  Destination const native = Dest("Native");
  EXPECT_EQ(CountIn([&] { out.SendOnePacket({kNote, sizeof kNote, kNoTimeStamp}); }), 0u);
  EXPECT_EQ(CountIn([&] {
              native.SendOnePacket({kNote, sizeof kNote, kNoTimeStamp});
              midi.Settle();  // one at a time: how many pile up is not ours to say
            }),
            0u);
}

TEST_F(PlatformAllocations, AreNoneForScheduledShortMessages) {
  std::unique_ptr<Impl::Sender> const sender = Dest("Out").MakeSender();
  auto const song = [&] {
    unsigned long long const now = CurrentMIDITime().Value();
    for (unsigned i = 1; i <= 100; ++i) {
      sender->Send({kNote, sizeof kNote, At(now + 10 * i)});
    }
    midi.Settle();
    midi.AdvanceClocks(2000);
  };
  EXPECT_EQ(CountIn(song), 0u);
  std::uint64_t const sent = midi.CountCalls("midiOutShortMsg");
  song();
  EXPECT_EQ(midi.CountCalls("midiOutShortMsg"), sent + 100);
}

class PlatformInputAllocations : public PlatformAllocations {
 protected:
  void Arrive(std::string const& port) {
    for (int i = 0; i < 50; ++i) {
      midi.Inject(port, note);
      midi.Settle();  // one at a time: how many pile up is not ours to say
    }
  }
  void WarmUp(std::string const& port) {
    for (int i = 0; i < 3; ++i) {
      Arrive(port);
      setup.ProcessInput();
    }
    counting.packets = 0;
  }
  Bytes const note{kNote, kNote + sizeof kNote};
};

TEST_F(PlatformInputAllocations, AreNoneFromTheCallbackToTheReceiver) {
  WarmUp("In");
  AllocationCounter const counter;
  Arrive("In");
  setup.ProcessInput();
  EXPECT_EQ(counter.Count(), 0u);
  EXPECT_EQ(counting.packets, 50);
}

// What arrives at a DirectMusic port is kept by the port, so the drain alone counts.
TEST_F(PlatformInputAllocations, AreNoneForADrainOfADirectMusicPort) {
  WarmUp("Native In");
  Arrive("Native In");
  AllocationCounter const counter;
  setup.ProcessInput();
  EXPECT_EQ(counter.Count(), 0u);
  EXPECT_EQ(counting.packets, 50);
}

TEST_F(PlatformAllocations, AreNoneForADrainOfNothing) {
  EXPECT_EQ(CountIn([&] { setup.ProcessInput(); }), 0u);
}

TEST_F(PlatformAllocations, AreNoneForAVirtualPair) {
  auto const pair =
      setup.CreateVirtualEndpoint(UString("Loop"), Setup::kSourceEnd, Setup::kSourceEnd);
  std::unique_ptr<Impl::Sender> const sender = pair.second.MakeSender();
  EXPECT_EQ(CountIn([&] {
              sender->Send({kNote, sizeof kNote, kNoTimeStamp});
              setup.ProcessInput();
            }),
            0u);
  EXPECT_EQ(counting.packets, kWarmUp + kRounds * kMessages);
}

}  // namespace
}  // namespace Ostinet::Testing

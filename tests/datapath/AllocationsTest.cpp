// SPDX-License-Identifier: MIT
#include <gtest/gtest.h>

#include "datapath/ChannelPatchState.h"
#include "datapath/MemorySysexStorage.h"
#include "datapath/PacketQueue.h"
#include "datapath/TimeBase.h"
#include "support/AllocationCounter.h"

namespace Ostinet::Impl {
namespace {

class CountingReceiver : public Receiver {
 public:
  bool WantsPacket(DataPacket const&, Source const&) override { return true; }
  void HandlePacket(DataPacket const&, Source const&) override { ++packets; }
  int packets = 0;
};

class FixedClock : public MasterClock {
 public:
  unsigned long long GetTime() const override { return 1; }
};

unsigned char const kBytes[16] = {0xB0, 0, 5, 0xB0, 32, 6, 0xC0, 7};

TEST(AllocationCounter, CountsWhatIsAllocated) {
  Testing::AllocationCounter const counter;
  delete new int;
  ::operator delete(::operator new(3));
  EXPECT_GE(counter.Count(), 1u);  // a compiler may leave the first out
}

TEST(Allocations, AreNoneForThePatchTracker) {
  ChannelPatchState state;
  Testing::AllocationCounter const counter;
  for (int i = 0; i < 1000; ++i) {
    state.Track({kBytes, sizeof kBytes, kNoTimeStamp});
    state.TakeChangedChannels();
  }
  EXPECT_EQ(counter.Count(), 0u);
}

TEST(Allocations, AreNoneForShortPacketsOnceTheQueueIsWarm) {
  PacketQueue queue;
  CountingReceiver receiver;
  Source const source;
  auto const round = [&] {
    for (int i = 0; i < 100; ++i) {
      queue.Enqueue({kBytes, sizeof kBytes, TimeStamp(1)});
    }
    queue.Drain(receiver, source, true);
  };
  round();
  Testing::AllocationCounter const counter;
  for (int i = 0; i < 100; ++i) {
    round();
  }
  EXPECT_EQ(counter.Count(), 0u);
  EXPECT_EQ(receiver.packets, 101 * 100);
}

TEST(Allocations, AreNoneForSysexMessagesOnceTheQueueIsWarm) {
  Testing::SysexSession session;
  SysexRef const message(500);
  PacketQueue queue;
  CountingReceiver receiver;
  Source const source;
  queue.Enqueue(kNoTimeStamp, message.GetImpl());
  queue.Drain(receiver, source, true);
  Testing::AllocationCounter const counter;
  queue.Enqueue(kNoTimeStamp, message.GetImpl());
  queue.Drain(receiver, source, true);
  EXPECT_EQ(counter.Count(), 0u);
}

TEST(Allocations, AreOneForALongerPacketInTheQueue) {
  PacketQueue queue;
  CountingReceiver receiver;
  Source const source;
  unsigned char const bytes[17] = {};
  queue.Enqueue({bytes, 1, kNoTimeStamp});
  queue.Drain(receiver, source, false);
  Testing::AllocationCounter const counter;
  queue.Enqueue({bytes, sizeof bytes, kNoTimeStamp});
  EXPECT_EQ(counter.Count(), 1u);
  queue.Drain(receiver, source, false);
}

TEST(Allocations, AreNoneForReadingAndConvertingTime) {
  SetMasterClock(std::make_unique<FixedClock>());
  Testing::AllocationCounter const counter;
  for (int i = 0; i < 100; ++i) {
    MIDITimeToHostClocks(EventTimeToMIDITime(MIDITimeToEventTime(CurrentMIDITime())));
  }
  EXPECT_EQ(counter.Count(), 0u);
  SetMasterClock(nullptr);
}

TEST(Allocations, AreFewForABufferOfPackets) {
  Testing::AllocationCounter const counter;
  DataBuffer buffer;
  for (int i = 0; i < 1024; ++i) {
    buffer.Add(kNoTimeStamp, kBytes, 3);
  }
  EXPECT_LE(counter.Count(), 40u);
}

}  // namespace
}  // namespace Ostinet::Impl

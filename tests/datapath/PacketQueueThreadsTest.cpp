// SPDX-License-Identifier: MIT
#include <gtest/gtest.h>

#include <array>
#include <atomic>
#include <cstring>
#include <thread>
#include <vector>

#include "datapath/ChannelPatchState.h"
#include "datapath/MemorySysexStorage.h"
#include "datapath/PacketQueue.h"
#include "support/Latch.h"

namespace Ostinet::Impl {
namespace {

// Checks that the numbers of each producer come in order and complete.
class OrderReceiver : public Receiver {
 public:
  bool WantsPacket(DataPacket const&, Source const&) override { return true; }
  void HandlePacket(DataPacket const& packet, Source const&) override {
    ASSERT_GE(packet.length, sizeof(unsigned));
    unsigned number = 0;
    std::memcpy(&number, packet.data, sizeof number);
    std::size_t const producer = static_cast<std::size_t>(packet.stamp.AsMIDITime().Value());
    ASSERT_EQ(number, next[producer]++);
    ++count;
  }

  std::array<unsigned, 4> next{};
  std::size_t count = 0;
};

TEST(PacketQueueThreads, LoseNothingAndKeepEachProducersOrder) {
  constexpr std::size_t kProducers = 3;
  constexpr unsigned kPackets = 5000;
  PacketQueue queue;
  Testing::Latch start(kProducers + 1);
  std::vector<std::thread> producers;
  for (std::size_t producer = 0; producer < kProducers; ++producer) {
    producers.emplace_back([&, producer] {
      start.arrive_and_wait();
      for (unsigned number = 0; number < kPackets; ++number) {
        unsigned char bytes[40] = {};
        std::memcpy(bytes, &number, sizeof number);
        // Every length is met: within the node and on the heap.
        std::size_t const length = sizeof number + number % (sizeof bytes - sizeof number);
        queue.Enqueue({bytes, length, TimeStamp(Clocks(producer))});
      }
    });
  }
  OrderReceiver receiver;
  Source const source;
  start.arrive_and_wait();
  while (receiver.count < kProducers * kPackets && !testing::Test::HasFailure()) {
    queue.Drain(receiver, source, false);
    std::this_thread::yield();
  }
  for (std::thread& thread : producers) {
    thread.join();
  }
  EXPECT_EQ(receiver.count, kProducers * kPackets);
}

// The pool of nodes is one for all queues, whichever thread takes and gives back.
TEST(PacketQueueThreads, ShareThePoolBetweenQueues) {
  Testing::Latch start(2);
  auto const run = [&start] {
    constexpr unsigned kPackets = 5000;
    PacketQueue queue;
    OrderReceiver receiver;
    Source const source;
    start.arrive_and_wait();
    for (unsigned number = 0; number < kPackets; ++number) {
      queue.Enqueue({reinterpret_cast<unsigned char const*>(&number), sizeof number, TimeStamp(1)});
      if (number % 7 == 0) {
        queue.Drain(receiver, source, false);
      }
    }
    queue.Drain(receiver, source, false);
    EXPECT_EQ(receiver.count, kPackets);
  };
  std::thread other(run);
  run();
  other.join();
}

TEST(SysexRefThreads, FreeAMessageOnWhicheverThreadIsLast) {
  Testing::SysexSession session;
  for (int round = 0; round < 200; ++round) {
    SysexRef ref(3);
    Testing::Latch start(2);
    std::thread other([&start, copy = ref]() mutable {
      start.arrive_and_wait();
      copy = SysexRef();
    });
    start.arrive_and_wait();
    ref = SysexRef();
    other.join();
    ASSERT_EQ(session.Record().alive, 0u);
  }
}

TEST(ChannelPatchStateThreads, ReportEveryLastPatch) {
  ChannelPatchState state;
  Testing::Latch start(2);
  std::thread sender([&] {
    start.arrive_and_wait();
    for (unsigned i = 0; i < 20000; ++i) {
      unsigned char const bytes[] = {0xB5, 0, static_cast<unsigned char>(i % 128), 0xC5,
                                     static_cast<unsigned char>(i % 128)};
      state.Track({bytes, sizeof bytes, kNoTimeStamp});
    }
  });
  start.arrive_and_wait();
  // Whenever the mark is taken, the patch behind it is there; the last one is never missed.
  constexpr int kLast = 19999 % 128;
  int seen = -1;
  int marks = 0;
  while (seen != kLast || marks == 0) {
    if (state.TakeChangedChannels() == 1 << 5) {
      ++marks;
      seen = state.GetPatch(5).program;
      ASSERT_NE(seen, 255);
    }
  }
  sender.join();
  EXPECT_EQ(state.GetPatch(5).program, kLast);
  EXPECT_EQ(state.GetPatch(5).bankMSB, kLast);
}

}  // namespace
}  // namespace Ostinet::Impl

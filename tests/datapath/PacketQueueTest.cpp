// SPDX-License-Identifier: MIT
#include <gtest/gtest.h>

#include <numeric>
#include <stdexcept>
#include <vector>

#include "datapath/MemorySysexStorage.h"
#include "datapath/PacketQueue.h"
#include "datapath/RecordingReceiver.h"

namespace Ostinet::Impl {
namespace {

using Bytes = std::vector<unsigned char>;
using Ints = std::vector<int>;

Bytes CountingBytes(std::size_t count) {
  Bytes bytes(count);
  std::iota(bytes.begin(), bytes.end(), static_cast<unsigned char>(1));
  return bytes;
}

class PacketQueueTest : public testing::Test {
 protected:
  void Enqueue(Bytes const& bytes, TimeStamp const& stamp = kNoTimeStamp) {
    queue_.Enqueue({bytes.data(), bytes.size(), stamp});
  }
  void EnqueueNumbers(std::initializer_list<unsigned char> numbers) {
    for (unsigned char number : numbers) {
      Enqueue({number});
    }
  }
  void Drain(bool applyFilter = false) { queue_.Drain(setup_, source_, applyFilter); }
  void DrainDirect(bool applyFilter) { queue_.Drain(&setup_, &direct_, source_, applyFilter); }

  Testing::RecordingReceiver setup_;
  Testing::RecordingReceiver direct_;
  Source const source_;
  PacketQueue queue_;
};

TEST_F(PacketQueueTest, DeliversNothingAtFirst) {
  Drain(true);
  EXPECT_TRUE(setup_.arrivals.empty());
  EXPECT_EQ(setup_.asked, 0);
}

TEST_F(PacketQueueTest, DeliversInOrderOfArrivalWithinAndAcrossDrains) {
  EnqueueNumbers({1, 2, 3});
  Drain();
  EnqueueNumbers({4, 5});
  Drain();
  EXPECT_EQ(setup_.FirstBytes(), (Ints{1, 2, 3, 4, 5}));
}

TEST_F(PacketQueueTest, CopiesBytesOfEveryLength) {
  for (std::size_t length : {0u, 1u, 3u, 15u, 16u, 17u, 256u, 5000u}) {
    Bytes bytes = CountingBytes(length);
    Enqueue(bytes, TimeStamp(Clocks(length), 0.5));
    std::fill(bytes.begin(), bytes.end(), static_cast<unsigned char>(0));
    Drain();
    ASSERT_FALSE(setup_.arrivals.empty());
    EXPECT_EQ(setup_.arrivals.back().bytes, CountingBytes(length));
    EXPECT_EQ(setup_.arrivals.back().stamp, TimeStamp(Clocks(length)));
    EXPECT_EQ(setup_.arrivals.back().stamp.AsSampleCount(), 0.5);
  }
  EXPECT_EQ(setup_.arrivals.size(), 8u);
}

TEST_F(PacketQueueTest, AcceptsAPacketWithoutBytes) {
  queue_.Enqueue(DataPacket{nullptr, 5, TimeStamp(1)});
  queue_.Enqueue(TimeStamp(2), RCPtrMT<SysexImpl>());
  Drain();
  ASSERT_EQ(setup_.arrivals.size(), 2u);
  EXPECT_TRUE(setup_.arrivals[0].bytes.empty());
  EXPECT_TRUE(setup_.arrivals[1].bytes.empty());
}

TEST_F(PacketQueueTest, HoldsASysexMessageUntilItIsDelivered) {
  Testing::SysexSession session;
  {
    Bytes const bytes = CountingBytes(40);
    SysexRef const ref(bytes.data(), bytes.size());
    queue_.Enqueue(TimeStamp(9), ref.GetImpl());
  }
  EXPECT_EQ(session.Record().alive, 1u);
  setup_.onPacket = [&](DataPacket const&) { EXPECT_EQ(session.Record().alive, 1u); };
  Drain();
  ASSERT_EQ(setup_.arrivals.size(), 1u);
  EXPECT_EQ(setup_.arrivals[0].bytes, CountingBytes(40));
  EXPECT_EQ(setup_.arrivals[0].stamp, TimeStamp(9));
  EXPECT_EQ(session.Record().alive, 0u);
}

TEST_F(PacketQueueTest, FreesWhatIsNeverDrained) {
  Testing::SysexSession session;
  {
    PacketQueue queue;
    queue.Enqueue(kNoTimeStamp, SysexRef(3).GetImpl());
    Bytes const bytes = CountingBytes(100);
    queue.Enqueue({bytes.data(), bytes.size(), kNoTimeStamp});
    EXPECT_EQ(session.Record().alive, 1u);
  }
  EXPECT_EQ(session.Record().alive, 0u);
}

TEST_F(PacketQueueTest, AsksTheFilterOnlyWhenTold) {
  setup_.wants = [](DataPacket const& packet) { return packet.data[0] % 2 == 0; };
  EnqueueNumbers({1, 2, 3, 4});
  Drain(true);
  EXPECT_EQ(setup_.FirstBytes(), (Ints{2, 4}));
  EXPECT_EQ(setup_.asked, 4);
  EnqueueNumbers({5});
  Drain(false);
  EXPECT_EQ(setup_.FirstBytes(), (Ints{2, 4, 5}));
  EXPECT_EQ(setup_.asked, 4);
}

// A direct receiver gets everything: nobody is asked, with the filter or without.
TEST_F(PacketQueueTest, DeliversUnfilteredToADirectReceiver) {
  setup_.wants = [](DataPacket const&) { return false; };
  direct_.wants = [](DataPacket const&) { return false; };
  EnqueueNumbers({1});
  DrainDirect(true);
  EnqueueNumbers({2});
  DrainDirect(false);
  EXPECT_EQ(direct_.FirstBytes(), (Ints{1, 2}));
  EXPECT_EQ(setup_.asked + direct_.asked, 0);
  EXPECT_TRUE(setup_.arrivals.empty());
}

TEST_F(PacketQueueTest, DropsThePacketsWhereNobodyReceives) {
  EnqueueNumbers({1, 2});
  queue_.Drain(nullptr, source_, true);
  EnqueueNumbers({3});
  queue_.Drain(nullptr, source_, false);
  Drain();
  EXPECT_TRUE(setup_.arrivals.empty());
}

TEST_F(PacketQueueTest, DeliversDirectlyWithoutAReceiverOfTheSetup) {
  EnqueueNumbers({1});
  queue_.Drain(nullptr, &direct_, source_, true);
  EXPECT_EQ(direct_.FirstBytes(), (Ints{1}));
}

TEST_F(PacketQueueTest, LeavesWhatArrivesDuringADrainToTheNext) {
  setup_.onPacket = [&](DataPacket const& packet) {
    if (packet.data[0] < 100) {
      Enqueue({static_cast<unsigned char>(packet.data[0] + 100)});
    }
  };
  EnqueueNumbers({1, 2});
  Drain();
  EXPECT_EQ(setup_.FirstBytes(), (Ints{1, 2}));
  Drain();
  EXPECT_EQ(setup_.FirstBytes(), (Ints{1, 2, 101, 102}));
}

TEST_F(PacketQueueTest, KeepsOrderAndMemoryWhenTheReceiverThrows) {
  Testing::SysexSession session;
  setup_.onPacket = [](DataPacket const& packet) {
    if (packet.data[0] == 2) {
      throw std::runtime_error("from the host");
    }
  };
  EnqueueNumbers({1, 2});
  {
    SysexEditRef const message(1);
    message[0] = 3;
    queue_.Enqueue(kNoTimeStamp, message.GetImpl());
  }
  EXPECT_THROW(Drain(), std::runtime_error);
  EXPECT_EQ(setup_.FirstBytes(), (Ints{1, 2}));
  EXPECT_EQ(session.Record().alive, 1u);
  EnqueueNumbers({4, 5});
  Drain();
  EXPECT_EQ(setup_.FirstBytes(), (Ints{1, 2, 3, 4, 5}));
  EXPECT_EQ(session.Record().alive, 0u);
}

TEST_F(PacketQueueTest, KeepsTheRestWhenTheFilterThrows) {
  setup_.wants = [](DataPacket const& packet) -> bool {
    if (packet.data[0] == 1) {
      throw std::runtime_error("from the host");
    }
    return true;
  };
  EnqueueNumbers({1, 2});
  EXPECT_THROW(Drain(true), std::runtime_error);
  Drain(true);
  EXPECT_EQ(setup_.FirstBytes(), (Ints{2}));
}

TEST_F(PacketQueueTest, FreesWhatAThrowingReceiverLeft) {
  Testing::SysexSession session;
  {
    PacketQueue queue;
    unsigned char const byte = 1;
    queue.Enqueue({&byte, 1, kNoTimeStamp});
    queue.Enqueue(kNoTimeStamp, SysexRef(3).GetImpl());
    setup_.onPacket = [](DataPacket const&) { throw std::runtime_error("from the host"); };
    EXPECT_THROW(queue.Drain(setup_, source_, false), std::runtime_error);
  }
  EXPECT_EQ(session.Record().alive, 0u);
}

// A host may poll from within its receiver.
TEST_F(PacketQueueTest, DeliversEachPacketOnceWhenDrainedFromWithin) {
  setup_.onPacket = [&](DataPacket const& packet) {
    if (packet.data[0] == 2) {
      Drain();
    }
  };
  EnqueueNumbers({1, 2, 3, 4});
  Drain();
  EXPECT_EQ(setup_.FirstBytes(), (Ints{1, 2, 3, 4}));
}

}  // namespace
}  // namespace Ostinet::Impl

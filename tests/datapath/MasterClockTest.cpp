// SPDX-License-Identifier: MIT
#include <gtest/gtest.h>

#include <atomic>
#include <memory>
#include <thread>
#include <vector>

#include "datapath/TimeBase.h"
#include "ostinet/core/Error.h"
#include "support/Latch.h"

namespace Ostinet::Impl {
namespace {

class FixedClock : public MasterClock {
 public:
  explicit FixedClock(unsigned long long time, int* destroyed = nullptr)
      : time_(time), destroyed_(destroyed) {}
  ~FixedClock() override {
    time_ = 0;
    if (destroyed_ != nullptr) {
      ++*destroyed_;
    }
  }
  unsigned long long GetTime() const override { return time_; }

 private:
  unsigned long long time_;
  int* destroyed_;
};

class FailingClock : public MasterClock {
 public:
  unsigned long long GetTime() const override {
    FailWinError(5);
    return 1;
  }
};

// Whatever a test leaves behind goes.
class MasterClockTest : public testing::Test {
 protected:
  ~MasterClockTest() override { SetMasterClock(nullptr); }
};

using MasterClockThreads = MasterClockTest;

TEST_F(MasterClockTest, ReadsZeroWithoutAClock) {
  EXPECT_EQ(CurrentMIDITime().Value(), 0u);
  SetMasterClock(nullptr);
  EXPECT_EQ(CurrentMIDITime().Value(), 0u);
}

TEST_F(MasterClockTest, ReadsTheClockThatWasInstalledLast) {
  SetMasterClock(std::make_unique<FixedClock>(17));
  EXPECT_EQ(CurrentMIDITime().Value(), 17u);
  SetMasterClock(std::make_unique<FixedClock>(0xFFFFFFFFFFFFFFFFu));
  EXPECT_EQ(CurrentMIDITime().Value(), 0xFFFFFFFFFFFFFFFFu);
  SetMasterClock(nullptr);
  EXPECT_EQ(CurrentMIDITime().Value(), 0u);
}

TEST_F(MasterClockTest, DestroysTheOldClockBeforeItReturns) {
  int destroyed = 0;
  SetMasterClock(std::make_unique<FixedClock>(1, &destroyed));
  SetMasterClock(std::make_unique<FixedClock>(2, &destroyed));
  EXPECT_EQ(destroyed, 1);
  SetMasterClock(nullptr);
  EXPECT_EQ(destroyed, 2);
}

TEST_F(MasterClockTest, ThrowsWhereTheClockFailsAndIsReplacedAllTheSame) {
  SetMasterClock(std::make_unique<FailingClock>());
  EXPECT_THROW(CurrentMIDITime(), VantorError);
  SetMasterClock(std::make_unique<FixedClock>(3));
  EXPECT_EQ(CurrentMIDITime().Value(), 3u);
}

// Blocks the one thread that asks for it.
thread_local bool tBlocksInGetTime = false;

class BlockingClock : public MasterClock {
 public:
  BlockingClock(Testing::Latch& entered, Testing::Latch& release, std::atomic<bool>& destroyed)
      : entered_(entered), release_(release), destroyed_(destroyed) {}
  ~BlockingClock() override { destroyed_ = true; }
  unsigned long long GetTime() const override {
    if (tBlocksInGetTime) {
      entered_.count_down();
      release_.wait();
    }
    return 1;
  }

 private:
  Testing::Latch& entered_;
  Testing::Latch& release_;
  std::atomic<bool>& destroyed_;
};

TEST_F(MasterClockThreads, KeepTheClockWhileAReaderIsInIt) {
  Testing::Latch entered(1);
  Testing::Latch release(1);
  std::atomic<bool> destroyed{false};
  SetMasterClock(std::make_unique<BlockingClock>(entered, release, destroyed));
  std::thread reader([] {
    tBlocksInGetTime = true;
    EXPECT_EQ(CurrentMIDITime().Value(), 1u);
  });
  entered.wait();
  std::thread writer([] { SetMasterClock(nullptr); });
  // New readers are past the old clock as soon as it is swapped out, and do not wait.
  while (CurrentMIDITime().Value() != 0) {
    std::this_thread::yield();
  }
  EXPECT_FALSE(destroyed);
  release.count_down();
  reader.join();
  writer.join();
  EXPECT_TRUE(destroyed);
}

TEST_F(MasterClockThreads, ReadWhileTheClockComesAndGoes) {
  constexpr int kReaders = 3;
  std::atomic<bool> quit{false};
  Testing::Latch started(kReaders + 1);
  std::vector<std::thread> readers;
  for (int i = 0; i < kReaders; ++i) {
    readers.emplace_back([&] {
      started.arrive_and_wait();
      while (!quit) {
        unsigned long long const time = CurrentMIDITime().Value();
        ASSERT_TRUE(time == 0 || (time >= 1000 && time < 2000)) << time;
      }
    });
  }
  started.arrive_and_wait();
  for (unsigned i = 0; i < 2000; ++i) {
    SetMasterClock(std::make_unique<FixedClock>(1000 + i % 1000));
    if (i % 3 == 0) {
      SetMasterClock(nullptr);
    }
  }
  quit = true;
  for (std::thread& reader : readers) {
    reader.join();
  }
}

}  // namespace
}  // namespace Ostinet::Impl

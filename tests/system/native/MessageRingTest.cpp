// SPDX-License-Identifier: MIT
#include <gtest/gtest.h>

#include <thread>

#include "platform/system/native/MessageRing.h"

namespace Ostinet::Impl {
namespace {

TEST(MessageRing, RefusesWhatHasNoRoomAndKeepsTheRest) {
  MessageRing ring;
  std::vector<unsigned char> const big(MessageRing::kCapacity - 8, 7);
  std::uint32_t time = 0;
  std::vector<unsigned char> taken;
  EXPECT_FALSE(ring.Pop(time, taken));
  EXPECT_TRUE(ring.Push(5, big.data(), big.size()));
  EXPECT_FALSE(ring.Push(6, big.data(), 1));
  ASSERT_TRUE(ring.Pop(time, taken));
  EXPECT_EQ(time, 5U);
  EXPECT_EQ(taken, big);
  EXPECT_FALSE(ring.Push(7, big.data(), MessageRing::kCapacity));
  EXPECT_FALSE(ring.Pop(time, taken));
}

TEST(MessageRing, HandsAMillionBytesFromThreadToThreadInOrder) {
  constexpr unsigned kMessages = 100000;
  MessageRing ring;
  std::thread writer([&ring] {
    for (unsigned i = 0; i < kMessages; ++i) {
      std::vector<unsigned char> const bytes(1 + i % 20, static_cast<unsigned char>(i));
      while (!ring.Push(i, bytes.data(), bytes.size())) std::this_thread::yield();
    }
  });
  for (unsigned i = 0; i < kMessages; ++i) {
    std::uint32_t time = 0;
    std::vector<unsigned char> taken;
    while (!ring.Pop(time, taken)) std::this_thread::yield();
    EXPECT_EQ(time, i);
    EXPECT_EQ(taken, std::vector<unsigned char>(1 + i % 20, static_cast<unsigned char>(i)));
  }
  writer.join();
}

}  // namespace
}  // namespace Ostinet::Impl

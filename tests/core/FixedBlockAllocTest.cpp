// SPDX-License-Identifier: MIT
#include <gtest/gtest.h>

#include <cstdint>
#include <cstring>
#include <set>
#include <vector>

#include "core/FixedBlockAlloc.h"
#include "support/Threads.h"

namespace Ostinet {
namespace {

constexpr std::size_t kBlockSize = 72;
constexpr std::size_t kChunk = 16;

TEST(FixedBlockAlloc, GivesBlocksThatDoNotOverlap) {
  FixedBlockAllocMT pool(kBlockSize, kChunk);
  std::set<unsigned char*> blocks;
  for (std::size_t i = 0; i < 10 * kChunk; ++i) {
    auto* const block = static_cast<unsigned char*>(pool.allocate(kBlockSize));
    EXPECT_EQ(reinterpret_cast<std::uintptr_t>(block) % alignof(std::max_align_t), 0U);
    std::memset(block, 0xEE, kBlockSize);
    blocks.insert(block);
  }
  ASSERT_EQ(blocks.size(), 10 * kChunk);
  unsigned char* before = nullptr;
  for (unsigned char* const block : blocks) {
    EXPECT_GE(static_cast<std::size_t>(block - before), kBlockSize);
    before = block;
  }
  for (unsigned char* const block : blocks) {
    pool.deallocate(block, kBlockSize);
  }
}

TEST(FixedBlockAlloc, GrowsOnlyWhenNoBlockIsFree) {
  FixedBlockAllocMT pool(kBlockSize, kChunk);
  EXPECT_EQ(pool.CountBlocks(), 0U);
  std::vector<void*> blocks;
  for (std::size_t i = 0; i < kChunk; ++i) {
    blocks.push_back(pool.allocate(kBlockSize));
  }
  EXPECT_EQ(pool.CountBlocks(), kChunk);
  blocks.push_back(pool.allocate(kBlockSize));
  EXPECT_EQ(pool.CountBlocks(), 2 * kChunk);
  for (int round = 0; round < 1000; ++round) {
    pool.deallocate(blocks.back(), kBlockSize);
    blocks.back() = pool.allocate(kBlockSize);
  }
  EXPECT_EQ(pool.CountBlocks(), 2 * kChunk);
}

TEST(FixedBlockAlloc, GivesTheBlockLastReturned) {
  FixedBlockAllocMT pool(kBlockSize, kChunk);
  void* const block = pool.allocate(kBlockSize);
  pool.deallocate(block, kBlockSize);
  EXPECT_EQ(pool.allocate(1), block);
}

TEST(FixedBlockAlloc, TakesLargerBlocksFromTheHeap) {
  FixedBlockAllocMT pool(kBlockSize, kChunk);
  void* const block = pool.allocate(kBlockSize + 1);
  std::memset(block, 0, kBlockSize + 1);
  pool.deallocate(block, kBlockSize + 1);
  EXPECT_EQ(pool.CountBlocks(), 0U);
}

TEST(FixedBlockAlloc, PassesOverNull) {
  FixedBlockAllocMT pool(kBlockSize, kChunk);
  pool.deallocate(nullptr, kBlockSize);
  EXPECT_EQ(pool.CountBlocks(), 0U);
}

TEST(FixedBlockAlloc, WorksWithTheSmallestSizes) {
  FixedBlockAllocMT pool(0, 0);
  void* const a = pool.allocate(0);
  void* const b = pool.allocate(0);
  EXPECT_NE(a, b);
}

TEST(FixedBlockAllocThreads, GiveEachBlockToOneThreadAtATime) {
  FixedBlockAllocMT pool(sizeof(int), 2);
  constexpr int kUsers = 4;
  std::vector<int> wrong(kUsers, 0);
  Testing::RunTogether(kUsers, [&](int thread) {
    for (int round = 0; round < 10000; ++round) {
      int* held[3];
      for (int*& block : held) {
        block = static_cast<int*>(pool.allocate(sizeof(int)));
        *block = thread;
      }
      for (int* const block : held) {
        wrong[static_cast<std::size_t>(thread)] += *block != thread ? 1 : 0;
        pool.deallocate(block, sizeof(int));
      }
    }
  });
  EXPECT_EQ(wrong, std::vector<int>(kUsers, 0));
  EXPECT_LE(pool.CountBlocks(), 16U);  // 4 threads with 3 blocks, in chunks that double
}

}  // namespace
}  // namespace Ostinet

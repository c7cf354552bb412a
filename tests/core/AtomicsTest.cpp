// SPDX-License-Identifier: MIT
#include <gtest/gtest.h>

#include <atomic>
#include <limits>
#include <memory>
#include <vector>

#include "core/Atomics.h"
#include "support/Threads.h"

namespace Ostinet {
namespace {

struct Node {
  void* link = nullptr;
  int value = 0;
};

int ValueOf(void* node) { return static_cast<Node*>(node)->value; }

std::vector<int> ValuesOf(void* chain) {
  std::vector<int> values;
  for (; chain != nullptr; chain = static_cast<Node*>(chain)->link) {
    values.push_back(ValueOf(chain));
  }
  return values;
}

TEST(Atomics, AddAndGiveTheSum) {
  std::int32_t word = 5;
  AtomicAdd32Implementation(&word, -7);
  EXPECT_EQ(word, -2);
  EXPECT_EQ(AtomicAddAndReturn32Implementation(&word, 3), 1);
}

TEST(Atomics, WrapRound) {
  std::int32_t word = std::numeric_limits<std::int32_t>::max();
  EXPECT_EQ(AtomicAddAndReturn32Implementation(&word, 1), std::numeric_limits<std::int32_t>::min());
}

TEST(Atomics, TestAndClear) {
  std::int32_t word = 4;
  EXPECT_TRUE(AtomicTestAndClear32(&word));
  EXPECT_EQ(word, 0);
  EXPECT_FALSE(AtomicTestAndClear32(&word));
}

TEST(AtomicStack, PopsTheLastPushedFirst) {
  void* head = nullptr;
  Node nodes[3];
  for (int i = 0; i < 3; ++i) {
    nodes[i].value = i;
    EnqueueAtomic(&head, &nodes[i]);
  }
  EXPECT_EQ(DequeueAtomic(&head), &nodes[2]);
  EXPECT_EQ(DequeueAtomic(&head), &nodes[1]);
  EXPECT_EQ(DequeueAtomic(&head), &nodes[0]);
  EXPECT_EQ(DequeueAtomic(&head), nullptr);
  EXPECT_EQ(head, nullptr);
}

TEST(AtomicStack, DetachesTheWholeChainLastPushedFirst) {
  void* head = nullptr;
  Node nodes[3];
  for (int i = 0; i < 3; ++i) {
    nodes[i].value = i;
    EnqueueAtomic(&head, &nodes[i]);
  }
  EXPECT_EQ(ValuesOf(DetachAtomic(&head)), (std::vector<int>{2, 1, 0}));
  EXPECT_EQ(DetachAtomic(&head), nullptr);
}

constexpr int kThreads = 4;
constexpr int kRounds = 20000;

TEST(AtomicsThreads, LoseNoAddition) {
  std::int32_t word = 0;
  Testing::RunTogether(kThreads, [&word](int) {
    for (int i = 0; i < kRounds; ++i) {
      AtomicAdd32Implementation(&word, 1);
      AtomicAddAndReturn32Implementation(&word, 1);
    }
  });
  EXPECT_EQ(word, 2 * kThreads * kRounds);
}

TEST(AtomicStackThreads, DetachGetsEachNodeOnceInTheOrderOfItsThread) {
  void* head = nullptr;
  std::vector<Node> nodes(kThreads * kRounds);
  std::atomic<int> running{kThreads};
  std::vector<int> last(kThreads, -1);
  int taken = 0;
  Testing::RunTogether(kThreads + 1, [&](int thread) {
    if (thread < kThreads) {
      for (int i = 0; i < kRounds; ++i) {
        Node& node = nodes[static_cast<std::size_t>(thread * kRounds + i)];
        node.value = thread * kRounds + i;
        EnqueueAtomic(&head, &node);
      }
      --running;
      return;
    }
    for (bool more = true; more;) {
      more = running.load() > 0;  // read before the detach that is to be the last
      std::vector<int> values = ValuesOf(DetachAtomic(&head));
      taken += static_cast<int>(values.size());
      for (auto value = values.rbegin(); value != values.rend(); ++value) {
        int& before = last[static_cast<std::size_t>(*value / kRounds)];
        EXPECT_LT(before, *value % kRounds);
        before = *value % kRounds;
      }
    }
  });
  EXPECT_EQ(taken, kThreads * kRounds);
}

// Nodes come and go at once, and are freed and made anew by whoever holds them: what an outdated
// link would lead to is gone.
TEST(AtomicStackThreads, PopsNodesThatAreFreedAndPushedAgainByOthers) {
  void* head = nullptr;
  constexpr int kNodes = 3;
  for (int i = 0; i < kNodes; ++i) {
    EnqueueAtomic(&head, new Node{nullptr, 1});
  }
  std::atomic<int> wrong{0};
  Testing::RunTogether(kThreads, [&](int) {
    for (int i = 0; i < kRounds; ++i) {
      std::unique_ptr<Node> node(static_cast<Node*>(DequeueAtomic(&head)));
      if (node == nullptr) {
        continue;
      }
      wrong += node->value != 1 ? 1 : 0;
      node->value = 0;
      node = std::make_unique<Node>();
      node->value = 1;
      EnqueueAtomic(&head, node.release());
    }
  });
  EXPECT_EQ(wrong.load(), 0);
  int left = 0;
  while (auto* const node = static_cast<Node*>(DequeueAtomic(&head))) {
    delete node;
    ++left;
  }
  EXPECT_EQ(left, kNodes);
}

}  // namespace
}  // namespace Ostinet

// SPDX-License-Identifier: MIT
#include <gtest/gtest.h>

#include "MessageJoiner.h"

namespace Ostinet::Tool {
namespace {

using Messages = std::vector<std::pair<unsigned long long, Bytes>>;

class Joining : public testing::Test {
 protected:
  void Take(unsigned long long clocks, Bytes const& packet) {
    joiner_.Take(clocks, packet, Sink());
  }
  void Finish() { joiner_.Finish(Sink()); }

  MessageJoiner::Sink Sink() {
    return [this](unsigned long long clocks, Bytes const& message) {
      messages_.emplace_back(clocks, message);
    };
  }

  MessageJoiner joiner_;
  Messages messages_;
};

TEST_F(Joining, PassesShortMessagesOn) {
  Take(5, {0x90, 0x3C, 0x40});
  EXPECT_EQ(messages_, (Messages{{5, {0x90, 0x3C, 0x40}}}));
}

// Ports hand every short message over as three bytes.
TEST_F(Joining, CutsWhatIsBehindAShortMessage) {
  Take(1, {0xC0, 0x05, 0x00});
  Take(2, {0xF8, 0x00, 0x00});
  EXPECT_EQ(messages_, (Messages{{1, {0xC0, 0x05}}, {2, {0xF8}}}));
}

TEST_F(Joining, PutsASysexTogetherUnderItsFirstStamp) {
  Take(1, {0xF0, 0x41});
  Take(2, {0x10, 0x11});
  EXPECT_TRUE(messages_.empty());
  Take(3, {0x12, 0xF7});
  EXPECT_EQ(messages_, (Messages{{1, {0xF0, 0x41, 0x10, 0x11, 0x12, 0xF7}}}));
}

TEST_F(Joining, TakesALastPieceThatIsTheEndAlone) {
  Take(1, {0xF0, 0x41});
  Take(2, {0xF7, 0x00, 0x00});
  EXPECT_EQ(messages_, (Messages{{1, {0xF0, 0x41, 0xF7}}}));
}

TEST_F(Joining, LetsRealTimePassThroughASysex) {
  Take(1, {0xF0, 0x41});
  Take(2, {0xF8, 0x00, 0x00});
  Take(3, {0x10, 0xFE, 0xF7});
  EXPECT_EQ(messages_, (Messages{{2, {0xF8}}, {3, {0xFE}}, {1, {0xF0, 0x41, 0x10, 0xF7}}}));
}

TEST_F(Joining, GivesAnInterruptedSysexOutAsItIs) {
  Take(1, {0xF0, 0x41});
  Take(2, {0x90, 0x3C, 0x40});
  EXPECT_EQ(messages_, (Messages{{1, {0xF0, 0x41}}, {2, {0x90, 0x3C, 0x40}}}));
}

TEST_F(Joining, StartsAnewAtTheNextSysex) {
  Take(1, {0xF0, 0x41});
  Take(2, {0xF0, 0x42, 0xF7});
  EXPECT_EQ(messages_, (Messages{{1, {0xF0, 0x41}}, {2, {0xF0, 0x42, 0xF7}}}));
}

TEST_F(Joining, TakesSeveralMessagesOfOnePacketApart) {
  Take(1, {0x90, 0x3C, 0x40, 0x80, 0x3C, 0x00});
  Take(2, {0xF0, 0x01, 0xF7, 0xF0, 0x02, 0xF7});
  EXPECT_EQ(messages_, (Messages{{1, {0x90, 0x3C, 0x40}},
                                 {1, {0x80, 0x3C, 0x00}},
                                 {2, {0xF0, 0x01, 0xF7}},
                                 {2, {0xF0, 0x02, 0xF7}}}));
}

TEST_F(Joining, GivesTheRestOutAtTheEnd) {
  Take(1, {0xF0, 0x41});
  Finish();
  Finish();
  EXPECT_EQ(messages_, (Messages{{1, {0xF0, 0x41}}}));
}

TEST_F(Joining, IgnoresEmptyPackets) {
  Take(1, {});
  EXPECT_TRUE(messages_.empty());
}

TEST_F(Joining, PassesStrayDataOn) {
  Take(1, {0x3C, 0x40});
  EXPECT_EQ(messages_, (Messages{{1, {0x3C, 0x40}}}));
}

}  // namespace
}  // namespace Ostinet::Tool

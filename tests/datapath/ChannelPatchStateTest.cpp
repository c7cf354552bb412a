// SPDX-License-Identifier: MIT
#include <gtest/gtest.h>

#include <initializer_list>
#include <vector>

#include "datapath/ChannelPatchState.h"

namespace Ostinet::Impl {
namespace {

class ChannelPatchStateTest : public testing::Test {
 protected:
  void Track(std::initializer_list<unsigned char> bytes) {
    std::vector<unsigned char> const copy(bytes);
    state_.Track({copy.data(), copy.size(), kNoTimeStamp});
  }

  std::vector<int> PatchOn(int channel) const {
    ChannelPatchState::Patch const patch = state_.GetPatch(channel);
    return {patch.bankMSB, patch.bankLSB, patch.program};
  }

  ChannelPatchState state_;
};

using Numbers = std::vector<int>;

TEST_F(ChannelPatchStateTest, KnowsNothingAtFirst) {
  for (int channel = 0; channel < 16; ++channel) {
    EXPECT_EQ(PatchOn(channel), (Numbers{255, 255, 255}));
  }
  EXPECT_EQ(state_.TakeChangedChannels(), 0);
}

TEST_F(ChannelPatchStateTest, GivesNoPatchForChannelsOutOfRange) {
  Track({0xC0, 1});
  EXPECT_EQ(PatchOn(-1), (Numbers{255, 255, 255}));
  EXPECT_EQ(PatchOn(16), (Numbers{255, 255, 255}));
}

TEST_F(ChannelPatchStateTest, CommitsBanksWithTheProgramChangeOfOnePacket) {
  Track({0xB3, 0, 5, 0xB3, 32, 6, 0xC3, 7});
  EXPECT_EQ(PatchOn(3), (Numbers{5, 6, 7}));
  EXPECT_EQ(state_.TakeChangedChannels(), 1 << 3);
}

TEST_F(ChannelPatchStateTest, KeepsPendingBanksFromPacketToPacket) {
  Track({0xB0, 0, 5});
  EXPECT_EQ(PatchOn(0), (Numbers{255, 255, 255}));
  EXPECT_EQ(state_.TakeChangedChannels(), 0);
  Track({0xB0, 32, 6});
  EXPECT_EQ(PatchOn(0), (Numbers{255, 255, 255}));
  Track({0xC0, 7});
  EXPECT_EQ(PatchOn(0), (Numbers{5, 6, 7}));
}

TEST_F(ChannelPatchStateTest, KeepsTheBanksForLaterProgramChanges) {
  Track({0xB0, 0, 5, 0xC0, 7});
  Track({0xC0, 8});
  EXPECT_EQ(PatchOn(0), (Numbers{5, 255, 8}));
}

TEST_F(ChannelPatchStateTest, KeepsPendingBanksByChannel) {
  Track({0xB0, 0, 5});
  Track({0xC1, 7});
  EXPECT_EQ(PatchOn(0), (Numbers{255, 255, 255}));
  EXPECT_EQ(PatchOn(1), (Numbers{255, 255, 7}));
}

// Hosts write out each status byte, so running status is not followed.
TEST_F(ChannelPatchStateTest, DoesNotSeeRunningStatus) {
  Track({0xB0, 0, 5, 0, 7});
  Track({0xC0, 1, 2});
  EXPECT_EQ(PatchOn(0), (Numbers{5, 255, 1}));
}

TEST_F(ChannelPatchStateTest, ForgetsAMessageThatIsCutByThePacketsEnd) {
  Track({0xC0});
  Track({9});
  EXPECT_EQ(PatchOn(0), (Numbers{255, 255, 255}));
  Track({0xB0, 0});
  Track({9});
  Track({0xC0, 1});
  EXPECT_EQ(PatchOn(0), (Numbers{255, 255, 1}));
}

TEST_F(ChannelPatchStateTest, PassesOverOtherMessages) {
  Track({0x90, 60, 100, 0xB0, 7, 100, 0xE0, 0, 64, 0xF0, 0, 32, 1, 0xF7, 32, 9});
  Track({0xC0, 1});
  EXPECT_EQ(PatchOn(0), (Numbers{255, 255, 1}));
}

// A real-time status in the middle of a message ends it for the tracker, and names a channel.
TEST_F(ChannelPatchStateTest, EndsAMessageAtAnyStatusByte) {
  Track({0xB0, 0, 0xF8, 5});
  Track({0xC0, 1});
  EXPECT_EQ(PatchOn(0), (Numbers{255, 255, 1}));
}

TEST_F(ChannelPatchStateTest, ReportsEachChangedChannelOnce) {
  Track({0xC0, 1, 0xCF, 2});
  Track({0xC0, 1});
  EXPECT_EQ(state_.TakeChangedChannels(), 0x8001);
  EXPECT_EQ(state_.TakeChangedChannels(), 0);
  Track({0xCF, 2});
  EXPECT_EQ(state_.TakeChangedChannels(), 0x8000);
}

TEST_F(ChannelPatchStateTest, AcceptsAnEmptyPacket) {
  state_.Track(DataPacket());
  EXPECT_EQ(state_.TakeChangedChannels(), 0);
}

}  // namespace
}  // namespace Ostinet::Impl

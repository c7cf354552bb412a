// SPDX-License-Identifier: MIT
#include <gtest/gtest.h>

#include "platform/system/native/OutputLane.h"
#include "system/native/FakeService.h"

namespace Ostinet::Testing {
namespace {

using Piece = FakeLine::Piece;
using Pieces = std::vector<Piece>;
using Flow = FakeLine::Flow;

class OutputLane : public ::testing::Test {
 protected:
  bool Push(Piece const& bytes) { return lane_->Push(bytes.data(), bytes.size()); }

  std::shared_ptr<FakeLine> const line_ = std::make_shared<FakeLine>();
  std::unique_ptr<Impl::OutputLane> lane_ =
      std::make_unique<Impl::OutputLane>(MakeFakeWire(line_, 4));
};

TEST_F(OutputLane, KeepsTheOrderOfWhatIsPushed) {
  EXPECT_TRUE(Push({0x90, 1, 2}));
  EXPECT_TRUE(Push({0xC0, 3, 0xF8}));
  EXPECT_EQ(line_->WaitForPieces(3), (Pieces{{0x90, 1, 2}, {0xC0, 3}, {0xF8}}));
}

TEST_F(OutputLane, CutsWhatIsLongerThanAPiece) {
  EXPECT_TRUE(Push({0xF0, 1, 2, 3, 4, 0xF7}));
  EXPECT_EQ(line_->WaitForPieces(2), (Pieces{{0xF0, 1, 2, 3}, {4, 0xF7}}));
}

TEST_F(OutputLane, RefusesWhatNeverEndsToWait) {
  line_->SetFlow(Flow::kHeld);
  EXPECT_TRUE(Push({0x90, 1, 2}));
  line_->WaitUntilHeld();
  Piece const half(Impl::OutputLane::kMaxWaiting / 2, 0xF8);
  EXPECT_TRUE(Push(half));
  EXPECT_FALSE(Push(half));
  EXPECT_TRUE(Push({0x90, 1, 0}));
  line_->SetFlow(Flow::kBroken);
}

TEST_F(OutputLane, RefusesAllOnceTheServiceIsGone) {
  line_->SetUsable(false);
  EXPECT_FALSE(Push({0x90, 1, 2}));
}

TEST_F(OutputLane, SilenceDropsWhatWaitsAndEndsWhatSounds) {
  Push({0x91, 60, 100, 0xB1, 64, 127});
  line_->WaitForPieces(2);
  line_->SetFlow(Flow::kHeld);
  Push({0x91, 62, 100});
  line_->WaitUntilHeld();
  Push({0x91, 64, 100});
  lane_->Silence();
  line_->SetFlow(Flow::kOpen);
  EXPECT_EQ(line_->WaitForPieces(6), (Pieces{{0x91, 60, 100},
                                             {0xB1, 64, 127},
                                             {0x91, 62, 100},
                                             {0x81, 60, 64},
                                             {0x81, 62, 64},
                                             {0xB1, 64, 0}}));
}

// A listener would take what follows for the rest of the sysex.
TEST_F(OutputLane, ASysexCutShortIsClosed) {
  line_->SetFlow(Flow::kHeld);
  Push({0xF0, 1, 2, 3, 4, 5, 6, 7, 0xF7});
  line_->WaitUntilHeld();
  lane_->Silence();
  line_->SetFlow(Flow::kOpen);
  EXPECT_EQ(line_->WaitForPieces(2), (Pieces{{0xF0, 1, 2, 3}, {0xF7}}));
}

TEST_F(OutputLane, WhatWaitedWhileTheServiceStoodStillIsDropped) {
  line_->SetFlow(Flow::kHeld);
  Push({0x90, 1, 2, 0x90, 3, 4});
  line_->WaitUntilHeld();
  Push({0x90, 5, 6});
  line_->SetFlow(Flow::kBroken);
  lane_->Finish(10000);
  line_->SetFlow(Flow::kOpen);
  Push({0x90, 7, 8});
  EXPECT_EQ(line_->WaitForPieces(1), (Pieces{{0x90, 7, 8}}));
}

TEST_F(OutputLane, FinishWaitsForTheLastPiece) {
  for (unsigned char i = 0; i < 100; ++i) Push({0x90, i, 1});
  lane_->Finish(10000);
  EXPECT_EQ(line_->WaitForPieces(0).size(), 100U);
}

TEST_F(OutputLane, EndsWhileMuchWaits) {
  line_->SetFlow(Flow::kHeld);
  for (int i = 0; i < 1000; ++i) Push({0x90, 1, 2});
  line_->WaitUntilHeld();
  line_->SetFlow(Flow::kBroken);
  lane_.reset();
  EXPECT_TRUE(line_->WaitForPieces(0).empty());
}

}  // namespace
}  // namespace Ostinet::Testing

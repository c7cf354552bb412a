// SPDX-License-Identifier: MIT
#include "system/SimulatedTest.h"

namespace Ostinet::Impl::Simulated {
namespace {

class InstrumentTest : public SimulatedTest {
 protected:
  InstrumentTest() {
    studio_.AddPort(PortOf("Port", PortKind::kWinMMOut));
    studio_.AddPort(PortOf("Port", PortKind::kWinMMIn));
    description_.out = description_.in = "Port";
    description_.deviceID = 16;
    description_.identity = "41 00 19 00 10";
    description_.replies = {{"F0 41 ?? 11 F7", "F0 41 10 12 F7"}};
  }
  void SetUp() override {
    index_ = studio_.AddInstrument(description_);
    ASSERT_EQ(log_.Open(Sys(), 0), 0u);
    Sys().midiInPrepareHeader(log_.handle, &answer_.header, kHeaderSize);
    Sys().midiInStart(log_.handle);
    ASSERT_EQ(Sys().midiOutOpen(&out_, 0, 0, 0, CALLBACK_NULL), 0u);
  }
  void TearDown() override {
    Sys().midiInReset(log_.handle);
    Sys().midiInClose(log_.handle);
    Sys().midiOutClose(out_);
  }
  /// Sends a sysex message in pieces of `piece` bytes; gives what comes back.
  Bytes Ask(Bytes const& question, std::size_t piece = 1000) {
    answer_.header.dwBytesRecorded = 0;
    Sys().midiInAddBuffer(log_.handle, &answer_.header, kHeaderSize);
    for (std::size_t i = 0; i < question.size(); i += piece) {
      auto const end = std::min(i + piece, question.size());
      Header header(Bytes(question.begin() + static_cast<std::ptrdiff_t>(i),
                          question.begin() + static_cast<std::ptrdiff_t>(end)));
      Sys().midiOutPrepareHeader(out_, &header.header, kHeaderSize);
      Sys().midiOutLongMsg(out_, &header.header, kHeaderSize);
      Sys().midiOutUnprepareHeader(out_, &header.header, kHeaderSize);
    }
    EXPECT_TRUE(studio_.Settle());
    Bytes const answer = answer_.Recorded();
    Sys().midiInReset(log_.handle);
    Sys().midiInStart(log_.handle);
    return answer;
  }

  SimulatedInstrument description_;
  int index_ = 0;
  InputLog log_;
  Header answer_{64};
  HMIDIOUT out_ = nullptr;
};

TEST_F(InstrumentTest, AnswersTheInquiryForItsDeviceAndForAll) {
  Bytes const identity = {0xF0, 0x7E, 16, 6, 2, 0x41, 0, 0x19, 0, 0x10, 0, 0, 0, 0, 0xF7};
  EXPECT_EQ(Ask({0xF0, 0x7E, 0x10, 6, 1, 0xF7}), identity);
  EXPECT_EQ(Ask({0xF0, 0x7E, 0x7F, 6, 1, 0xF7}), identity);
  EXPECT_EQ(Ask({0xF0, 0x7E, 0x11, 6, 1, 0xF7}), Bytes());
}

TEST_F(InstrumentTest, AnswersQuestionsThatComeInPieces) {
  EXPECT_EQ(Ask({0xF0, 0x7E, 0x7F, 6, 1, 0xF7}, 2).size(), 15u);
}

TEST_F(InstrumentTest, AnswersItsMakersRequests) {
  EXPECT_EQ(Ask({0xF0, 0x41, 0x10, 0x11, 0xF7}), (Bytes{0xF0, 0x41, 0x10, 0x12, 0xF7}));
  EXPECT_EQ(Ask({0xF0, 0x41, 0x33, 0x11, 0xF7}), (Bytes{0xF0, 0x41, 0x10, 0x12, 0xF7}));
  EXPECT_EQ(Ask({0xF0, 0x41, 0x10, 0x11, 0x00, 0xF7}), Bytes());
}

TEST_F(InstrumentTest, FollowsBankSelectAndProgramChange) {
  EXPECT_EQ(studio_.WhatPlays(index_, 2).program, -1);
  Sys().midiOutShortMsg(out_, 0x0500B2);
  Sys().midiOutShortMsg(out_, 0x0720B2);
  EXPECT_EQ(studio_.WhatPlays(index_, 2).bankMSB, -1);
  Sys().midiOutShortMsg(out_, 0x09C2);
  SimulatedChannel const channel = studio_.WhatPlays(index_, 2);
  EXPECT_EQ(channel.program, 9);
  EXPECT_EQ(channel.bankMSB, 5);
  EXPECT_EQ(channel.bankLSB, 7);
  EXPECT_EQ(studio_.WhatPlays(index_, 3).program, -1);
}

TEST_F(InstrumentTest, HoldsNotesUntilTheyAreReleased) {
  Sys().midiOutShortMsg(out_, 0x403C90);
  Sys().midiOutShortMsg(out_, 0x404090);
  Sys().midiOutShortMsg(out_, 0x404390);
  EXPECT_EQ(studio_.WhatPlays(index_, 0).notes, (std::vector<int>{0x3C, 0x40, 0x43}));
  Sys().midiOutShortMsg(out_, 0x404080);
  Sys().midiOutShortMsg(out_, 0x004390);
  EXPECT_EQ(studio_.WhatPlays(index_, 0).notes, (std::vector<int>{0x3C}));
  Sys().midiOutShortMsg(out_, 0x007BB0);
  EXPECT_TRUE(studio_.WhatPlays(index_, 0).notes.empty());
}

TEST_F(InstrumentTest, UnplayableDescriptionsAreRefused) {
  SimulatedInstrument wrong = description_;
  wrong.deviceID = 128;
  EXPECT_THROW(studio_.AddInstrument(wrong), std::invalid_argument);
  wrong = description_;
  wrong.identity = "4Z";
  EXPECT_THROW(studio_.AddInstrument(wrong), std::invalid_argument);
  wrong.identity = "4";
  EXPECT_THROW(studio_.AddInstrument(wrong), std::invalid_argument);
  wrong.identity = "??";
  EXPECT_THROW(studio_.AddInstrument(wrong), std::invalid_argument);
  EXPECT_THROW(studio_.WhatPlays(index_, 16), std::invalid_argument);
  EXPECT_THROW(studio_.WhatPlays(7, 0), std::invalid_argument);
  EXPECT_EQ(studio_.CountInstruments(), 1);
}

}  // namespace
}  // namespace Ostinet::Impl::Simulated

// SPDX-License-Identifier: MIT
#include "system/SimulatedTest.h"

namespace Ostinet::Impl::Simulated {
namespace {

class WinMMOutput : public SimulatedTest {
 protected:
  WinMMOutput() { studio_.AddPort(PortOf("Out", PortKind::kWinMMOut)); }

  MMRESULT Open(HMIDIOUT& handle, UINT device = 0) {
    return Sys().midiOutOpen(&handle, device, reinterpret_cast<DWORD_PTR>(&Callback),
                             reinterpret_cast<DWORD_PTR>(this), CALLBACK_FUNCTION);
  }
  void SetUp() override { ASSERT_EQ(Open(out_), 0u); }
  void TearDown() override { Sys().midiOutClose(out_); }

  static void CALLBACK Callback(HMIDIOUT, UINT message, DWORD_PTR instance, DWORD_PTR, DWORD_PTR) {
    reinterpret_cast<WinMMOutput*>(instance)->told_.push_back(message);
  }

  HMIDIOUT out_ = nullptr;
  std::vector<UINT> told_;
};

TEST_F(WinMMOutput, TellsOfOpeningAndClosing) {
  EXPECT_EQ(Sys().midiOutClose(out_), 0u);
  EXPECT_EQ(told_, (std::vector<UINT>{MOM_OPEN, MOM_CLOSE}));
  EXPECT_EQ(Sys().midiOutShortMsg(out_, 0x90), MMRESULT{MMSYSERR_INVALHANDLE});
}

TEST_F(WinMMOutput, OpensADeviceOnce) {
  HMIDIOUT second = nullptr;
  EXPECT_EQ(Open(second), MMRESULT{MMSYSERR_ALLOCATED});
  EXPECT_EQ(Open(second, 1), MMRESULT{MMSYSERR_BADDEVICEID});
}

TEST_F(WinMMOutput, RecordsMessagesInTheirTrueLengthWithTheirTime) {
  Sys().midiOutShortMsg(out_, 0x00403C90);
  studio_.AdvanceClocks(7);
  Sys().midiOutShortMsg(out_, 0x000005C3);
  Sys().midiOutShortMsg(out_, 0xF8);
  Sys().midiOutShortMsg(out_, 0xF70143F0);
  auto const sent = studio_.Sent("Out");
  EXPECT_EQ(
      BytesOf(sent),
      (std::vector<Bytes>{{0x90, 0x3C, 0x40}, {0xC3, 0x05}, {0xF8}, {0xF0, 0x43, 0x01, 0xF7}}));
  EXPECT_EQ(sent[0].left, 1000);
  EXPECT_EQ(sent[1].due, 1007);
}

TEST_F(WinMMOutput, FillsRunningStatusIn) {
  EXPECT_EQ(Sys().midiOutShortMsg(out_, 0x0102), MMRESULT{MMSYSERR_INVALPARAM});
  Sys().midiOutShortMsg(out_, 0x00403C90);
  Sys().midiOutShortMsg(out_, 0x0000003C);
  EXPECT_EQ(BytesOf(studio_.Sent()), (std::vector<Bytes>{{0x90, 0x3C, 0x40}, {0x90, 0x3C, 0}}));
}

TEST_F(WinMMOutput, PlaysOnlyPreparedLongMessages) {
  Header header(Bytes{0xF0, 1, 2, 3, 0xF7});
  EXPECT_EQ(Sys().midiOutLongMsg(out_, &header.header, kHeaderSize), MMRESULT{MIDIERR_UNPREPARED});
  EXPECT_EQ(Sys().midiOutPrepareHeader(out_, &header.header, kHeaderSize), 0u);
  EXPECT_EQ(Sys().midiOutLongMsg(out_, &header.header, kHeaderSize), 0u);
  EXPECT_EQ(Sys().midiOutUnprepareHeader(out_, &header.header, kHeaderSize), 0u);
  EXPECT_EQ(BytesOf(studio_.Sent()), (std::vector<Bytes>{{0xF0, 1, 2, 3, 0xF7}}));
  EXPECT_EQ(told_.back(), UINT{MOM_DONE});
}

TEST_F(WinMMOutput, HeldLongMessagesPlayUntilTriedOftenEnough) {
  studio_.HoldLongMessages(2);
  Header header(Bytes{0xF0, 1, 0xF7});
  Sys().midiOutPrepareHeader(out_, &header.header, kHeaderSize);
  Sys().midiOutLongMsg(out_, &header.header, kHeaderSize);
  EXPECT_EQ(Sys().midiOutClose(out_), MMRESULT{MIDIERR_STILLPLAYING});
  MMRESULT const still = MIDIERR_STILLPLAYING;
  EXPECT_EQ(Sys().midiOutUnprepareHeader(out_, &header.header, kHeaderSize), still);
  EXPECT_EQ(Sys().midiOutUnprepareHeader(out_, &header.header, kHeaderSize), still);
  EXPECT_EQ(Sys().midiOutUnprepareHeader(out_, &header.header, kHeaderSize), 0u);
}

TEST_F(WinMMOutput, ResetEndsLongMessages) {
  studio_.HoldLongMessages(1000);
  Header header(Bytes{0xF0, 1, 0xF7});
  Sys().midiOutPrepareHeader(out_, &header.header, kHeaderSize);
  Sys().midiOutLongMsg(out_, &header.header, kHeaderSize);
  EXPECT_EQ(Sys().midiOutReset(out_), 0u);
  EXPECT_EQ(told_.back(), UINT{MOM_DONE});
  EXPECT_EQ(Sys().midiOutUnprepareHeader(out_, &header.header, kHeaderSize), 0u);
}

TEST_F(WinMMOutput, ADeviceThatIsPulledOutTakesNothingAndCloses) {
  studio_.RemovePort("Out");
  EXPECT_EQ(Sys().midiOutShortMsg(out_, 0x403C90), 68u);
  EXPECT_EQ(Sys().midiOutReset(out_), 0u);
  EXPECT_EQ(Sys().midiOutClose(out_), 0u);
  EXPECT_TRUE(studio_.Sent().empty());
}

TEST_F(WinMMOutput, CablesLeadToTheInputsOfTheirName) {
  studio_.AddPort(PortOf("In", PortKind::kWinMMIn));
  studio_.AddCable("Out", "In");
  InputLog log;
  ASSERT_EQ(log.Open(Sys(), 0), 0u);
  Sys().midiInStart(log.handle);
  Sys().midiOutShortMsg(out_, 0x403C90);
  ASSERT_TRUE(studio_.Settle());
  auto const told = log.Take();
  ASSERT_EQ(told.size(), 2u);
  EXPECT_EQ(told[1].param1, 0x403C90u);
  EXPECT_TRUE(studio_.RemoveCable("Out", "In"));
  Sys().midiOutShortMsg(out_, 0x403C90);
  ASSERT_TRUE(studio_.Settle());
  EXPECT_TRUE(log.Take().empty());
  Sys().midiInClose(log.handle);
}

TEST_F(WinMMOutput, RecordingKeepsTheNewestAndCanBeSwitchedOff) {
  studio_.ReserveRecording(2);
  for (DWORD note = 1; note <= 3; ++note) Sys().midiOutShortMsg(out_, 0x400090 | note << 8);
  EXPECT_EQ(BytesOf(studio_.Sent()), (std::vector<Bytes>{{0x90, 2, 0x40}, {0x90, 3, 0x40}}));
  studio_.ClearSent();
  studio_.SetRecording(false);
  Sys().midiOutShortMsg(out_, 0x403C90);
  EXPECT_TRUE(studio_.Sent().empty());
}

}  // namespace
}  // namespace Ostinet::Impl::Simulated

// SPDX-License-Identifier: MIT
#include "system/SimulatedTest.h"

namespace Ostinet::Impl::Simulated {
namespace {

using Told = InputLog::Told;

class WinMMInput : public SimulatedTest {
 protected:
  WinMMInput() { studio_.AddPort(PortOf("In", PortKind::kWinMMIn)); }

  void OpenAndStart() {
    ASSERT_EQ(log_.Open(Sys(), 0), MMRESULT{MMSYSERR_NOERROR});
    ASSERT_EQ(Sys().midiInStart(log_.handle), MMRESULT{MMSYSERR_NOERROR});
    log_.Take();
  }
  void Give(Header& header) {
    ASSERT_EQ(Sys().midiInPrepareHeader(log_.handle, &header.header, kHeaderSize), 0u);
    ASSERT_EQ(Sys().midiInAddBuffer(log_.handle, &header.header, kHeaderSize), 0u);
  }
  void Close() {
    Sys().midiInReset(log_.handle);
    EXPECT_EQ(Sys().midiInClose(log_.handle), 0u);
  }
  std::vector<Told> Arrive(Bytes const& bytes) {
    EXPECT_TRUE(studio_.Inject("In", bytes));
    EXPECT_TRUE(studio_.Settle());
    return log_.Take();
  }

  InputLog log_;
};

TEST_F(WinMMInput, TellsOfOpeningAndClosingBeforeTheCallReturns) {
  EXPECT_EQ(log_.Open(Sys(), 0), 0u);
  EXPECT_EQ(log_.Take(), (std::vector<Told>{{MIM_OPEN, 0, 0}}));
  EXPECT_EQ(studio_.CountOpenDevices(), 1);
  EXPECT_EQ(Sys().midiInClose(log_.handle), 0u);
  EXPECT_EQ(log_.Take(), (std::vector<Told>{{MIM_CLOSE, 0, 0}}));
  EXPECT_EQ(studio_.CountOpenDevices(), 0);
}

TEST_F(WinMMInput, OpensADeviceOnceAndOnlyOneThatIsThere) {
  InputLog second;
  EXPECT_EQ(second.Open(Sys(), 1), MMRESULT{MMSYSERR_BADDEVICEID});
  EXPECT_EQ(log_.Open(Sys(), 0), 0u);
  EXPECT_EQ(second.Open(Sys(), 0), MMRESULT{MMSYSERR_ALLOCATED});
  Close();
  EXPECT_EQ(second.Open(Sys(), 0), 0u);
  EXPECT_EQ(Sys().midiInClose(second.handle), 0u);
}

TEST_F(WinMMInput, PacksShortMessagesWithTheirTimeSinceTheStart) {
  OpenAndStart();
  studio_.AdvanceClocks(25000);
  EXPECT_EQ(
      Arrive({0x90, 0x3C, 0x40, 0x3C, 0x00, 0xC1, 0x07}),
      (std::vector<Told>{{MIM_DATA, 0x403C90, 2}, {MIM_DATA, 0x3C90, 2}, {MIM_DATA, 0x07C1, 2}}));
  Close();
}

TEST_F(WinMMInput, HearsNothingBeforeTheStartAndAfterTheStop) {
  ASSERT_EQ(log_.Open(Sys(), 0), 0u);
  log_.Take();
  EXPECT_TRUE(Arrive({0x90, 1, 2}).empty());
  Sys().midiInStart(log_.handle);
  EXPECT_EQ(Arrive({0x90, 1, 2}).size(), 1u);
  Sys().midiInStop(log_.handle);
  EXPECT_TRUE(Arrive({0x90, 1, 2}).empty());
  Close();
}

TEST_F(WinMMInput, SplitsSysexOverBuffersOfExactlyTheirLength) {
  OpenAndStart();
  Header first(4), second(4), third(4);
  Give(first);
  Give(second);
  Give(third);
  EXPECT_EQ(Arrive({0xF0, 1, 2, 3, 4, 5, 6, 7, 8, 0xF7}),
            (std::vector<Told>{{MIM_LONGDATA, first.Address(), 0},
                               {MIM_LONGDATA, second.Address(), 0},
                               {MIM_LONGDATA, third.Address(), 0}}));
  EXPECT_EQ(first.Recorded(), (Bytes{0xF0, 1, 2, 3}));
  EXPECT_EQ(second.Recorded(), (Bytes{4, 5, 6, 7}));
  EXPECT_EQ(third.Recorded(), (Bytes{8, 0xF7}));
  Close();
}

TEST_F(WinMMInput, AMessageThatFillsItsBufferComesOnce) {
  OpenAndStart();
  Header first(4), second(4);
  Give(first);
  Give(second);
  EXPECT_EQ(Arrive({0xF0, 1, 2, 0xF7}).size(), 1u);
  Close();
  EXPECT_EQ(second.header.dwBytesRecorded, 0u);
}

TEST_F(WinMMInput, LosesSysexWithoutABufferAndKeepsTheRest) {
  OpenAndStart();
  EXPECT_EQ(Arrive({0xF0, 1, 0xF8, 2, 0xF7, 0x90, 1, 2}),
            (std::vector<Told>{{MIM_DATA, 0xF8, 0}, {MIM_DATA, 0x020190, 0}}));
  Header header(8);
  Give(header);
  EXPECT_EQ(Arrive({0xF0, 5, 0xF7}).size(), 1u);
  EXPECT_EQ(header.Recorded(), (Bytes{0xF0, 5, 0xF7}));
  Close();
}

TEST_F(WinMMInput, TellsOfStrayBytesAndOfSysexCutShort) {
  OpenAndStart();
  Header header(8);
  Give(header);
  EXPECT_EQ(Arrive({5, 0xF0, 1, 0x90, 2, 3}),
            (std::vector<Told>{
                {MIM_ERROR, 5, 0}, {MIM_LONGERROR, header.Address(), 0}, {MIM_DATA, 0x030290, 0}}));
  Close();
}

TEST_F(WinMMInput, ResetGivesEveryBufferBackEmptyAndInOrder) {
  OpenAndStart();
  Header first(8), second(8);
  Give(first);
  Give(second);
  Arrive({0xF0, 1, 2});
  EXPECT_EQ(Sys().midiInReset(log_.handle), 0u);
  EXPECT_EQ(log_.Take(), (std::vector<Told>{{MIM_LONGDATA, first.Address(), 0},
                                            {MIM_LONGDATA, second.Address(), 0}}));
  EXPECT_EQ(first.header.dwBytesRecorded, 0u);
  EXPECT_EQ(first.header.dwFlags & MHDR_DONE, DWORD{MHDR_DONE});
  Close();
}

TEST_F(WinMMInput, StopGivesAPartlyFilledBufferBack) {
  OpenAndStart();
  Header header(8);
  Give(header);
  Arrive({0xF0, 1, 2});
  Sys().midiInStop(log_.handle);
  EXPECT_EQ(log_.Take(), (std::vector<Told>{{MIM_LONGDATA, header.Address(), 0}}));
  EXPECT_EQ(header.Recorded(), (Bytes{0xF0, 1, 2}));
  Close();
}

TEST_F(WinMMInput, ClosesAndUnpreparesNothingThatIsQueued) {
  OpenAndStart();
  Header header(8);
  Give(header);
  EXPECT_EQ(Sys().midiInClose(log_.handle), MMRESULT{MIDIERR_STILLPLAYING});
  EXPECT_EQ(Sys().midiInUnprepareHeader(log_.handle, &header.header, kHeaderSize),
            MMRESULT{MIDIERR_STILLPLAYING});
  EXPECT_EQ(Sys().midiInAddBuffer(log_.handle, &header.header, kHeaderSize),
            MMRESULT{MIDIERR_STILLPLAYING});
  Sys().midiInReset(log_.handle);
  EXPECT_EQ(Sys().midiInUnprepareHeader(log_.handle, &header.header, kHeaderSize), 0u);
  EXPECT_EQ(Sys().midiInAddBuffer(log_.handle, &header.header, kHeaderSize),
            MMRESULT{MIDIERR_UNPREPARED});
  Close();
}

TEST_F(WinMMInput, RefusesWhatIsNoHandleOrNoHeader) {
  Header header(8);
  EXPECT_EQ(Sys().midiInStart(nullptr), MMRESULT{MMSYSERR_INVALHANDLE});
  EXPECT_EQ(Sys().midiInClose(nullptr), MMRESULT{MMSYSERR_INVALHANDLE});
  EXPECT_EQ(Sys().midiInAddBuffer(nullptr, &header.header, kHeaderSize),
            MMRESULT{MMSYSERR_INVALHANDLE});
  OpenAndStart();
  EXPECT_EQ(Sys().midiInPrepareHeader(log_.handle, nullptr, kHeaderSize),
            MMRESULT{MMSYSERR_INVALPARAM});
  EXPECT_EQ(Sys().midiInPrepareHeader(log_.handle, &header.header, kHeaderSize - 1),
            MMRESULT{MMSYSERR_INVALPARAM});
  HMIDIIN const stale = log_.handle;
  Close();
  EXPECT_EQ(Sys().midiInStart(stale), MMRESULT{MMSYSERR_INVALHANDLE});
}

TEST_F(WinMMInput, ADeviceThatIsPulledOutStaysSilentAndCloses) {
  OpenAndStart();
  studio_.RemovePort("In");
  EXPECT_FALSE(studio_.Inject("In", {0x90, 1, 2}));
  Close();
  EXPECT_EQ(studio_.CountOpenDevices(), 0);
}

}  // namespace
}  // namespace Ostinet::Impl::Simulated

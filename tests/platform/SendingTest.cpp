// SPDX-License-Identifier: MIT

#include "ostinet/SysexRef.h"
#include "platform/PlatformTest.h"

namespace Ostinet::Testing {
namespace {

using ::testing::ElementsAre;
using ::testing::IsEmpty;
using Kind = SimulatedPort::Kind;

constexpr unsigned long long kStart = 50000000;  // five seconds, in clocks

Bytes Sysex(std::size_t size) {
  Bytes bytes(size, 0x11);
  bytes.front() = 0xF0;
  bytes.back() = 0xF7;
  return bytes;
}

/// Signed in on a clock that is moved by hand and reads kStart.
class Sending : public PlatformTest {
 protected:
  Sending() {
    midi.MoveClockByHand(1000000);
    midi.SetStepPerReading(1);
  }
  void Start() {
    SignIn();
    midi.SetStepPerReading(0);
    midi.MoveClockByHand(kStart);
    midi.LogCalls(true);
    midi.TakeLog();
  }
  std::vector<std::string> Calls(std::vector<std::string> const& operations) {
    std::vector<std::string> result;
    for (SimulatedCall const& call : Log(operations)) {
      std::string text = call.operation;
      if (call.operation == "PackUnstructured") {
        text += " " + std::to_string(call.arguments.back());
      }
      result.push_back(text);
    }
    return result;
  }
  /// When the messages to a port left, in clocks after kStart.
  std::vector<long long> TimesLeft(std::string const& port) const {
    std::vector<long long> times;
    for (SimulatedMessage const& message : midi.Sent(port)) {
      times.push_back(message.left - static_cast<long long>(kStart));
    }
    return times;
  }
};

class DirectMusicSender : public Sending {
 protected:
  DirectMusicSender() {
    AddNative("Out", Kind::kDirectMusicOut);
    Start();
    out = Dest("Out");
  }
  std::vector<std::string> PackingCalls() {
    return Calls({"PackStructured", "PackUnstructured", "PlayBuffer", "Flush"});
  }
  Destination out;
};

TEST_F(DirectMusicSender, PlaysAShortMessageAsOneWord) {
  Send(out, {0x90, 60, 64});
  EXPECT_THAT(SentTo("Out"), ElementsAre(Bytes{0x90, 60, 64}));
}

TEST_F(DirectMusicSender, AnEmptyPacketSendsNothingAndFlushesNothing) {
  Send(out, {});
  EXPECT_EQ(midi.CountCalls("PlayBuffer"), 0u);
}

TEST_F(DirectMusicSender, CutsALongSysexToWhatABufferHolds) {
  std::unique_ptr<Impl::Sender> const sender = out.MakeSender();
  Bytes const sysex = Sysex(300);
  midi.TakeLog();
  sender->Send({sysex.data(), sysex.size(), kNoTimeStamp});
  EXPECT_THAT(PackingCalls(),
              ElementsAre("PackUnstructured 236", "PlayBuffer", "Flush", "PackUnstructured 64"));
  sender->Flush();
  EXPECT_THAT(PackingCalls(), ElementsAre("PlayBuffer", "Flush"));
}

// The first chunk leaves room for the header and later ones do not, so 236 bytes travel whole and
// hosts send longer messages in several packets.
TEST_F(DirectMusicSender, LosesALaterChunkThatFillsABuffer) {
  Send(out, Sysex(236));
  EXPECT_THAT(SentTo("Out"), ElementsAre(Sysex(236)));
  midi.ClearSent();
  Send(out, Sysex(236 + 256 + 10));
  std::size_t arrived = 0;
  for (Bytes const& bytes : SentTo("Out")) {
    arrived += bytes.size();
  }
  EXPECT_EQ(arrived, 236u + 10u);
}

TEST_F(DirectMusicSender, CutsAPacketBehindEachFurtherStatusByte) {
  midi.LogCalls(true);
  std::unique_ptr<Impl::Sender> const sender = out.MakeSender();
  Bytes const two{0x90, 0x3C, 0x40, 0x80, 0x3C, 0x00};
  sender->Send({two.data(), two.size(), kNoTimeStamp});
  std::vector<long long> words;
  for (SimulatedCall const& call : Log({"PackStructured"})) {
    words.push_back(call.arguments.back());
  }
  EXPECT_THAT(words, ElementsAre(0x80403C90LL, 0x0000003CLL));
}

TEST_F(DirectMusicSender, PacksATwoByteTailWithZerosBehindIt) {
  std::unique_ptr<Impl::Sender> const sender = out.MakeSender();
  // On the heap and of its exact size, so that a read past its end is seen.
  auto const packet = std::make_unique<Bytes>(Bytes{0xC0, 5});
  packet->shrink_to_fit();
  sender->Send({packet->data(), packet->size(), kNoTimeStamp});
  sender->Flush();
  EXPECT_EQ(Log({"PackStructured"}).front().arguments.back(), 0x05C0);
}

TEST_F(DirectMusicSender, KeepsPacketsTogetherUntilTheFlush) {
  std::unique_ptr<Impl::Sender> const sender = out.MakeSender();
  Bytes const note{0x90, 60, 64};
  midi.TakeLog();
  for (int i = 0; i < 10; ++i) {
    sender->Send({note.data(), note.size(), kNoTimeStamp});
  }
  EXPECT_THAT(Calls({"PlayBuffer"}), IsEmpty());
  sender->Send({note.data(), note.size(), kNoTimeStamp});  // the eleventh finds no room
  EXPECT_THAT(Calls({"PlayBuffer"}), ElementsAre("PlayBuffer"));
  sender->Flush();
  EXPECT_EQ(SentTo("Out").size(), 11u);
}

TEST_F(DirectMusicSender, WhatIsNotFlushedIsNotSentByAnyoneElse) {
  Bytes const note{0x90, 60, 64};
  for (int i = 0; i < 30; ++i) {  // as often as there are buffers, and more
    std::unique_ptr<Impl::Sender> const sender = out.MakeSender();
    sender->Send({note.data(), note.size(), kNoTimeStamp});
  }
  Send(out, {0xC0, 1});
  EXPECT_THAT(SentTo("Out"), ElementsAre(Bytes{0xC0, 1}));
}

TEST_F(DirectMusicSender, ScheduledMessagesLeaveAtTheirExactClock) {
  Send(out, {0x90, 60, 64}, kStart + 1000);
  Send(out, {0x90, 61, 64}, kStart + 1001);
  EXPECT_EQ(midi.CountScheduled(), 2);
  midi.AdvanceClocks(2000);
  EXPECT_THAT(TimesLeft("Out"), ElementsAre(1000, 1001));
}

TEST_F(DirectMusicSender, AStampInThePastLeavesAtOnce) {
  Send(out, {0x90, 60, 64}, kStart - 1);
  EXPECT_THAT(TimesLeft("Out"), ElementsAre(0));
}

TEST_F(DirectMusicSender, SendsALongMessageWithoutLimitOfItsKind) {
  SysexRef const sysex(Sysex(200).data(), 200);
  out.SendSysex(kNoTimeStamp, sysex);
  EXPECT_THAT(SentTo("Out"), ElementsAre(Sysex(200)));
  EXPECT_FALSE(sysex.IsSending());
  out.SendSysex(kNoTimeStamp, SysexRef());
  EXPECT_EQ(SentTo("Out").size(), 1u);
}

TEST_F(DirectMusicSender, WithoutALatencyClockCannotSend) {
  midi.Fail("GetLatencyClock");
  std::unique_ptr<Impl::Sender> const sender = out.MakeSender();
  EXPECT_FALSE(sender->CanSend());
  Bytes const note{0x90, 60, 64};
  sender->Send({note.data(), note.size(), kNoTimeStamp});
  sender->Flush();
  EXPECT_THAT(SentTo("Out"), IsEmpty());
}

TEST_F(DirectMusicSender, MakesABufferWhenThePoolIsEmpty) {
  midi.ResetCalls();
  std::vector<std::unique_ptr<Impl::Sender>> senders;
  for (int i = 0; i < 21; ++i) {
    senders.push_back(out.MakeSender());
    EXPECT_TRUE(senders.back()->CanSend());
  }
  EXPECT_EQ(midi.CountCalls("CreateMusicBuffer"), 1u);
}

TEST_F(DirectMusicSender, ThatIsKeptTooLongSendsNothing) {
  std::unique_ptr<Impl::Sender> const sender = out.MakeSender();
  midi.RemovePort("Out");
  Rescan();
  Bytes const note{0x90, 60, 64};
  EXPECT_FALSE(sender->CanSend());
  sender->Send({note.data(), note.size(), kNoTimeStamp});
  sender->Flush();
  SignOut();
  sender->Send({note.data(), note.size(), kNoTimeStamp});
  sender->Flush();
  EXPECT_THAT(SentTo("Out"), IsEmpty());
}

class LegacySender : public Sending {
 protected:
  LegacySender() {
    AddOut("Out");
    Start();
    out = Dest("Out");
    midi.Settle();
    midi.TakeLog();
  }
  Destination out;
};

TEST_F(LegacySender, SendsUpToFourBytesAsOneWord) {
  Send(out, {0x90, 60, 64});
  EXPECT_THAT(Log({"midiOutShortMsg"}).front().arguments.back(), 0x403C90);
  Send(out, {0xF0, 1, 2, 0xF7});
  EXPECT_THAT(Log({"midiOutShortMsg"}).front().arguments.back(), 0xF70201F0LL);
}

TEST_F(LegacySender, SendsFiveBytesAsALongMessageWhateverTheyAre) {
  Send(out, {0x90, 60, 64, 61, 64});
  EXPECT_THAT(Names(Log({"midiOutPrepareHeader", "midiOutLongMsg", "midiOutUnprepareHeader",
                         "midiOutShortMsg"})),
              ElementsAre("midiOutPrepareHeader", "midiOutLongMsg", "midiOutUnprepareHeader"));
}

TEST_F(LegacySender, AnEmptyPacketSendsNothing) {
  Send(out, {});
  EXPECT_THAT(Log({"midiOutShortMsg", "midiOutPrepareHeader"}), IsEmpty());
}

TEST_F(LegacySender, AHeaderThatCannotBePreparedIsNotSent) {
  midi.Fail("midiOutPrepareHeader");
  Send(out, Sysex(10));
  EXPECT_EQ(midi.CountCalls("midiOutLongMsg"), 0u);
}

TEST_F(LegacySender, WaitsUntilTheDriverLetsGoOfALongMessage) {
  midi.HoldLongMessages(3);
  Send(out, Sysex(10));
  EXPECT_EQ(Log({"midiOutUnprepareHeader"}).size(), 4u);
  EXPECT_THAT(SentTo("Out"), ElementsAre(Sysex(10)));
}

TEST_F(LegacySender, ADriverThatNeverLetsGoOfALongMessageIsReset) {
  constexpr int kForEver = 1000000;
  midi.HoldLongMessages(kForEver);
  Send(out, Sysex(10));
  std::vector<std::string> const calls =
      Names(Log({"midiOutLongMsg", "midiOutUnprepareHeader", "midiOutReset"}));
  EXPECT_EQ(calls.front(), "midiOutLongMsg");
  EXPECT_THAT(std::vector<std::string>(calls.end() - 2, calls.end()),
              ElementsAre("midiOutReset", "midiOutUnprepareHeader"));
}

TEST_F(LegacySender, AClockThatFailsHoldsNothingBack) {
  midi.FailFrom("GetTime");
  Send(out, {0x90, 1, 1}, kStart + 1000);
  EXPECT_THAT(SentTo("Out"), ElementsAre(Bytes{0x90, 1, 1}));
  midi.ClearFaults();
  Send(out, {0x90, 2, 1}, kStart + 1000);
  midi.Settle();
  EXPECT_EQ(SentTo("Out").size(), 1u);
}

TEST_F(LegacySender, ScheduledMessagesLeaveAtTheirExactClock) {
  Send(out, {0x90, 60, 64}, kStart + 1000);
  Send(out, {0x80, 60, 64}, kStart + 2500);
  midi.Settle();
  EXPECT_THAT(SentTo("Out"), IsEmpty());
  midi.AdvanceClocks(999);
  EXPECT_THAT(SentTo("Out"), IsEmpty());
  midi.AdvanceClocks(10000);
  EXPECT_THAT(TimesLeft("Out"), ElementsAre(1000, 2500));
}

TEST_F(LegacySender, TheQueueKeepsTheOrderOfArrival) {
  Send(out, {0x90, 1, 1}, kStart + 2000);
  Send(out, {0x90, 2, 1}, kStart + 1000);
  midi.Settle();
  midi.AdvanceClocks(3000);
  EXPECT_THAT(SentTo("Out"), ElementsAre(Bytes{0x90, 1, 1}, Bytes{0x90, 2, 1}));
  EXPECT_THAT(TimesLeft("Out"), ElementsAre(2000, 2000));
}

TEST_F(LegacySender, AMessageForNowOvertakesWhatWaits) {
  Send(out, {0x90, 1, 1}, kStart + 1000);
  Send(out, {0x90, 2, 1}, 0);
  EXPECT_THAT(SentTo("Out"), ElementsAre(Bytes{0x90, 2, 1}));
  midi.Settle();
  midi.AdvanceClocks(1000);
  EXPECT_EQ(SentTo("Out").size(), 2u);
}

TEST_F(LegacySender, AStampInThePastLeavesAtOnce) {
  Send(out, {0x90, 1, 1}, kStart - 1);
  Send(out, {0x90, 2, 1}, kStart);
  EXPECT_THAT(TimesLeft("Out"), ElementsAre(0, 0));
}

TEST_F(LegacySender, AStampHalfTheRangeAheadWaits) {
  Send(out, {0x90, 1, 1}, kStart + (1ull << 63));
  midi.Settle();
  EXPECT_THAT(SentTo("Out"), IsEmpty());
  Send(out, {0x90, 2, 1}, kStart + (1ull << 63) + 1);  // nearer backwards: in the past
  EXPECT_THAT(SentTo("Out"), ElementsAre(Bytes{0x90, 2, 1}));
}

TEST_F(LegacySender, AFullQueueLosesTheNewest) {
  Send(out, {0x90, 0, 1}, kStart + 1000);
  midi.Settle();  // the output thread has taken the first one's place in the count
  for (int i = 1; i <= 258; ++i) {
    Send(out, {0x90, static_cast<unsigned char>(i & 0x7F), 1}, kStart + 1000);
  }
  midi.Settle();
  midi.AdvanceClocks(2000);
  EXPECT_EQ(SentTo("Out").size(), 257u);
  EXPECT_EQ(SentTo("Out").back(), (Bytes{0x90, 256 & 0x7F, 1}));
}

TEST_F(LegacySender, QueuedBytesAreCopies) {
  Bytes bytes{0x90, 60, 64};
  Send(out, bytes, kStart + 10);
  bytes.assign(3, 0);
  SysexRef sysex(Sysex(20).data(), 20);
  out.SendSysex(At(kStart + 20), sysex);
  sysex = SysexRef();
  midi.Settle();
  midi.AdvanceClocks(100);
  EXPECT_THAT(SentTo("Out"), ElementsAre(Bytes{0x90, 60, 64}, Sysex(20)));
}

TEST_F(LegacySender, ClosingDropsWhatWaits) {
  Send(out, {0x90, 60, 64}, kStart + 1000);
  midi.Settle();
  midi.RemovePort("Out");
  Rescan();
  midi.AdvanceClocks(5000);
  EXPECT_THAT(SentTo("Out"), IsEmpty());
}

TEST_F(LegacySender, ThatIsKeptTooLongSendsNothing) {
  std::unique_ptr<Impl::Sender> const sender = out.MakeSender();
  EXPECT_TRUE(sender->CanSend());
  midi.RemovePort("Out");
  Rescan();
  EXPECT_FALSE(sender->CanSend());
  Bytes const note{0x90, 60, 64};
  sender->Send({note.data(), note.size(), kNoTimeStamp});
  sender->Send({note.data(), note.size(), At(kStart + 5)});
  SignOut();
  sender->Send({note.data(), note.size(), kNoTimeStamp});
  EXPECT_THAT(SentTo("Out"), IsEmpty());
}

TEST_F(LegacySender, ADeviceInUseLeavesTheEndpointMute) {
  AddOut("Busy");
  midi.FailWith("midiOutOpen", 4);  // MMSYSERR_ALLOCATED
  Rescan();
  Destination const busy = Dest("Busy");
  EXPECT_TRUE(busy.IsOnline());
  EXPECT_FALSE(busy.MakeSender()->CanSend());
  Send(busy, {0x90, 1, 1});
  EXPECT_THAT(SentTo("Busy"), IsEmpty());
}

TEST_F(LegacySender, ClosesInOrderAndOnlyAfterAReset) {
  midi.TakeLog();
  SignOut();
  EXPECT_THAT(Names(Log({"ReleaseSemaphore", "midiOutReset", "midiOutClose"})),
              ElementsAre("ReleaseSemaphore", "midiOutReset", "midiOutClose"));
}

class Panic : public Sending {};

TEST_F(Panic, SilencesEachChannelOfEachOnlinePort) {
  AddOut("Out");
  AddOut("Gone");
  AddNative("Native", Kind::kDirectMusicOut);
  Start();
  setup.CreateDevice(UString("Synth"));
  midi.RemovePort("Gone");
  Rescan();
  setup.Panic();
  std::vector<Bytes> expected;
  for (unsigned char channel = 0; channel < 16; ++channel) {
    auto const status = static_cast<unsigned char>(0xB0 + channel);
    expected.push_back({status, 120, 0});
    expected.push_back({status, 64, 0});
  }
  EXPECT_EQ(SentTo("Out"), expected);
  EXPECT_EQ(SentTo("Native"), expected);
  EXPECT_THAT(SentTo("Gone"), IsEmpty());
}

class PatchTracking : public Sending {};

TEST_F(PatchTracking, OnePollTellsOfTheInstrumentsFirstAndOfThePortLast) {
  AddOut("Out");
  Start();
  Destination const out = Dest("Out");
  Device const synths = setup.CreateDevice(UString("Synths"));
  setup.SetEntityDestinations(synths.GetEntity(0), 2);
  Destination const first = synths.GetEntity(0).GetDestination(0);
  Destination const second = synths.GetEntity(0).GetDestination(1);
  out.AddConnectedDestination(first);
  out.AddConnectedDestination(second);
  Send(first, {0xC2, 5});
  Send(second, {0xC0, 6});
  listener.patches.clear();
  setup.Poll();
  using Patch = RecordingListener::Patch;
  EXPECT_THAT(listener.patches, ElementsAre(Patch(first, 5), Patch(second, 5), Patch(out, 5)));
  setup.Poll();
  EXPECT_EQ(listener.patches.size(), 3u);
}

}  // namespace
}  // namespace Ostinet::Testing

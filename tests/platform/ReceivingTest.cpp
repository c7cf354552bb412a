// SPDX-License-Identifier: MIT

#include <stdexcept>

#include "model/EndpointImpl.h"
#include "ostinet/SysexRef.h"
#include "platform/PlatformTest.h"

namespace Ostinet::Testing {
namespace {

using ::testing::ElementsAre;
using ::testing::IsEmpty;
using Kind = SimulatedPort::Kind;

Bytes CountingSysex(std::size_t size) {
  Bytes bytes(size);
  for (std::size_t i = 0; i < size; ++i) {
    bytes[i] = static_cast<unsigned char>(i & 0x7F);
  }
  bytes.front() = 0xF0;
  bytes.back() = 0xF7;
  return bytes;
}

void ThrowAtNoteTwo(Bytes const& bytes) {
  if (bytes[1] == 2) {
    throw std::runtime_error("host");
  }
}

class LegacyInput : public PlatformTest {
 protected:
  LegacyInput() {
    AddOut("Out");
    AddIn("In");
    SignIn();
  }
  /// The bytes arrive, and the system's callback is done with them.
  void Arrive(Bytes const& bytes) {
    EXPECT_TRUE(midi.Inject("In", bytes));
    EXPECT_TRUE(midi.Settle());
  }
};

TEST_F(LegacyInput, WaitsForThePoll) {
  Arrive({0x90, 60, 64});
  EXPECT_THAT(receiver.packets, IsEmpty());
  EXPECT_EQ(receiver.asked, 1);
  setup.ProcessInput();
  EXPECT_THAT(receiver.packets, ElementsAre(Received{"In", {0x90, 60, 64}, 0}));
}

// Hosts count on three bytes: a shorter message ends in zeros.
TEST_F(LegacyInput, ShortMessagesAreThreeBytesLong) {
  Arrive({0xC3, 7});
  Arrive({0xF8});
  setup.ProcessInput();
  EXPECT_THAT(receiver.AllBytes(), ElementsAre(Bytes{0xC3, 7, 0}, Bytes{0xF8, 0, 0}));
}

TEST_F(LegacyInput, WhatTheFilterRefusesIsNeverDelivered) {
  receiver.filter = [](Bytes const& bytes) { return bytes[0] != 0xFE; };
  Arrive({0xFE});
  Arrive({0x90, 1, 1});
  setup.ProcessInput();
  EXPECT_THAT(receiver.AllBytes(), ElementsAre(Bytes{0x90, 1, 1}));
}

TEST_F(LegacyInput, KeepsTheOrderOfArrivalAcrossPolls) {
  std::vector<Bytes> expected;
  for (unsigned char i = 0; i < 100; ++i) {
    expected.push_back({0x90, i, 1});
    Arrive(expected.back());
    if (i % 7 == 0) {
      setup.ProcessInput();
    }
  }
  setup.ProcessInput();
  EXPECT_EQ(receiver.AllBytes(), expected);
}

TEST_F(LegacyInput, ADirectReceiverGetsWhatTheFilterLetThrough) {
  TestReceiver direct;
  Src("In").setDirectReceiver(&direct);
  receiver.filter = [](Bytes const& bytes) { return bytes[1] != 2; };
  Arrive({0x90, 1, 1});
  Arrive({0x90, 2, 1});
  setup.ProcessInput();
  EXPECT_THAT(direct.AllBytes(), ElementsAre(Bytes{0x90, 1, 1}));
  EXPECT_EQ(direct.asked, 0);
  EXPECT_THAT(receiver.packets, IsEmpty());
  Src("In").setDirectReceiver(nullptr);
}

TEST_F(LegacyInput, ALongSysexArrivesInBufferfuls) {
  Bytes const sysex = CountingSysex(600);
  Arrive(sysex);
  setup.ProcessInput();
  ASSERT_EQ(receiver.packets.size(), 3u);
  EXPECT_EQ(receiver.packets[0].bytes.size(), 256u);
  EXPECT_EQ(receiver.packets[1].bytes.size(), 256u);
  Bytes joined;
  for (Received const& packet : receiver.packets) {
    joined.insert(joined.end(), packet.bytes.begin(), packet.bytes.end());
  }
  EXPECT_EQ(joined, sysex);
}

TEST_F(LegacyInput, GivesItsBuffersBackForEver) {
  for (int i = 0; i < 200; ++i) {  // many times what 32 buffers take
    Arrive(CountingSysex(250));
  }
  setup.ProcessInput();
  EXPECT_EQ(receiver.packets.size(), 200u);
}

TEST_F(LegacyInput, AReceiverThatThrowsLosesOnePacket) {
  for (unsigned char i = 1; i <= 3; ++i) {
    Arrive({0x90, i, 1});
  }
  receiver.onPacket = ThrowAtNoteTwo;
  EXPECT_THROW(setup.ProcessInput(), std::runtime_error);
  setup.ProcessInput();
  EXPECT_EQ(receiver.AllBytes().back(), (Bytes{0x90, 3, 1}));
}

TEST_F(LegacyInput, AFilterThatThrowsLosesThePacketOnly) {
  receiver.filter = [](Bytes const& bytes) -> bool {
    if (bytes[1] == 1) {
      throw std::runtime_error("host");
    }
    return true;
  };
  Arrive({0x90, 1, 1});
  Arrive({0x90, 2, 1});
  setup.ProcessInput();
  EXPECT_THAT(receiver.AllBytes(), ElementsAre(Bytes{0x90, 2, 1}));
}

// The system counts milliseconds from the start of the input, the stamp from the host's zero.
TEST_F(LegacyInput, IsStampedFromItsStart) {
  constexpr long long kMillisecond = 10000;
  SignOut();
  midi.MoveClockByHand(1000 * kMillisecond);
  midi.SetStepPerReading(1);
  SignIn();
  midi.SetStepPerReading(0);
  ASSERT_LT(midi.Now(), 1001 * kMillisecond) << "the sign-in took a reading too many for this test";
  auto const stampAfter = [](long long milliseconds) {
    double const start = 1000 / 1000.0;
    return EventTimeToMIDITime(start + static_cast<double>(milliseconds) / 1000.0).Value();
  };
  ASSERT_TRUE(midi.AdvanceClocks(5 * kMillisecond));
  Arrive({0x90, 1, 1});
  ASSERT_TRUE(midi.AdvanceClocks(250 * kMillisecond));
  Arrive({0x90, 2, 1});
  ASSERT_TRUE(midi.AdvanceClocks(kMillisecond));
  setup.ProcessInput();  // later, which no stamp shows
  ASSERT_EQ(receiver.packets.size(), 2u);
  EXPECT_EQ(receiver.packets[0].clocks, stampAfter(5));
  EXPECT_EQ(receiver.packets[1].clocks, stampAfter(255));
}

TEST_F(LegacyInput, OpensAndClosesInOrder) {
  SignOut();
  midi.LogCalls(true);
  SignIn();
  std::vector<std::string> const inputCalls{
      "midiInOpen", "midiInPrepareHeader", "midiInAddBuffer", "midiInStart",
      "midiInStop", "midiInReset",         "midiInClose",     "midiInUnprepareHeader"};
  std::vector<std::string> expected{"midiInOpen"};
  for (int i = 0; i < 32; ++i) {
    expected.insert(expected.end(), {"midiInPrepareHeader", "midiInAddBuffer"});
  }
  expected.push_back("midiInStart");
  EXPECT_EQ(Names(Log(inputCalls)), expected);
  SignOut();
  expected = {"midiInStop", "midiInReset", "midiInClose"};
  expected.insert(expected.end(), 32, "midiInUnprepareHeader");
  EXPECT_EQ(Names(Log(inputCalls)), expected);
}

TEST_F(LegacyInput, ABufferThatCannotBePreparedIsLeftOut) {
  SignOut();
  midi.ResetCalls();
  midi.Fail("midiInPrepareHeader", 3);
  SignIn();
  EXPECT_EQ(midi.CountCalls("midiInAddBuffer"), 31u);
  Arrive(CountingSysex(100));
  setup.ProcessInput();
  EXPECT_EQ(receiver.packets.size(), 1u);
}

TEST_F(LegacyInput, WithoutAReceiverIsDropped) {
  SignOut();
  setup.SignIn(UString("Test"), nullptr, &prefs);
  Arrive({0x90, 1, 1});
  setup.ProcessInput();
}

TEST_F(LegacyInput, AnUnpluggedInputIsPassedOverAndComesBack) {
  midi.RemovePort("In");
  Rescan();
  setup.ProcessInput();
  AddIn("In");
  Rescan();
  Arrive({0x90, 1, 1});
  setup.ProcessInput();
  EXPECT_THAT(receiver.AllBytes(), ElementsAre(Bytes{0x90, 1, 1}));
}

TEST_F(LegacyInput, ItsReceiverMaySignOut) {
  Arrive({0x90, 1, 1});
  receiver.onPacket = [this](Bytes const&) { SignOut(); };
  setup.ProcessInput();
  EXPECT_FALSE(setup.IsSignedIn());
}

class DirectMusicInput : public PlatformTest {
 protected:
  DirectMusicInput() {
    AddNative("In", Kind::kDirectMusicIn);
    SignIn();
  }
};

TEST_F(DirectMusicInput, IsFilteredAndDeliveredAtThePoll) {
  receiver.filter = [](Bytes const& bytes) { return bytes[0] != 0xFE; };
  midi.Inject("In", {0x90, 60, 64});
  midi.Inject("In", {0xFE});
  midi.Inject("In", {0xC0, 3});
  EXPECT_EQ(receiver.asked, 0);
  setup.ProcessInput();
  EXPECT_THAT(receiver.AllBytes(), ElementsAre(Bytes{0x90, 60, 64}, Bytes{0xC0, 3}));
}

// Unlike the drain of the other inputs, this one knows the receiver of the studio alone.
TEST_F(DirectMusicInput, PassesADirectReceiverBy) {
  TestReceiver direct;
  Src("In").setDirectReceiver(&direct);
  midi.Inject("In", {0x90, 60, 64});
  setup.ProcessInput();
  EXPECT_THAT(direct.packets, IsEmpty());
  EXPECT_EQ(receiver.packets.size(), 1u);
  Src("In").setDirectReceiver(nullptr);
}

TEST_F(DirectMusicInput, AReceiverThatThrowsDoesNotEndThePoll) {
  receiver.onPacket = [](Bytes const&) { throw std::runtime_error("host"); };
  midi.Inject("In", {0x90, 1, 1});
  EXPECT_NO_THROW(setup.ProcessInput());
  receiver.onPacket = nullptr;
  midi.Inject("In", {0x90, 2, 1});
  setup.ProcessInput();
  EXPECT_EQ(receiver.AllBytes().back(), (Bytes{0x90, 2, 1}));
}

TEST_F(DirectMusicInput, IsNeverReadWithoutItsEvent) {
  SignOut();
  midi.Fail("SetReadNotificationHandle");
  SignIn();
  midi.Inject("In", {0x90, 1, 1});
  setup.ProcessInput();
  EXPECT_THAT(receiver.packets, IsEmpty());
}

TEST_F(DirectMusicInput, AnEndlessDriverDoesNotHangThePoll) {
  midi.Inject("In", {0x90, 1, 1});
  midi.SetEndless("Read", true);
  setup.ProcessInput();
  midi.SetEndless("Read", false);
}

// What stood behind the packet in the same buffer goes with the port.
TEST_F(DirectMusicInput, ItsReceiverMaySignOut) {
  midi.Inject("In", {0x90, 1, 1});
  midi.Inject("In", {0x90, 2, 1});
  receiver.onPacket = [this](Bytes const&) { SignOut(); };
  setup.ProcessInput();
  EXPECT_FALSE(setup.IsSignedIn());
  EXPECT_THAT(receiver.AllBytes(), ElementsAre(Bytes{0x90, 1, 1}));
}

TEST_F(DirectMusicInput, ItsReceiverMayPollWhileThePortGoes) {
  midi.Inject("In", {0x90, 1, 1});
  midi.Inject("In", {0x90, 2, 1});
  Source const in = Src("In");
  receiver.onPacket = [this](Bytes const&) {
    midi.RemovePort("In");
    Rescan();
  };
  setup.ProcessInput();
  EXPECT_FALSE(in.IsOnline());
  EXPECT_THAT(receiver.AllBytes(), ElementsAre(Bytes{0x90, 1, 1}));
}

class VirtualPair : public PlatformTest {
 protected:
  VirtualPair() {
    SignIn();
    auto const pair =
        setup.CreateVirtualEndpoint(UString("Bus"), Setup::kSourceEnd, Setup::kSourceEnd);
    source = pair.first;
    destination = pair.second;
  }
  Source source;
  Destination destination;
};

TEST_F(VirtualPair, ArrivesAtTheNextPollWithItsStampHoweverFarAhead) {
  Send(destination, {0x90, 60, 64}, 1ull << 60);
  setup.ProcessInput();
  ASSERT_EQ(receiver.packets.size(), 1u);
  EXPECT_EQ(receiver.packets[0].clocks, 1ull << 60);
  EXPECT_EQ(receiver.asked, 1);
}

TEST_F(VirtualPair, ADirectReceiverGetsEverythingUnfiltered) {
  TestReceiver direct;
  source.setDirectReceiver(&direct);
  Send(destination, {0x90, 60, 64});
  setup.ProcessInput();
  EXPECT_EQ(direct.packets.size(), 1u);
  EXPECT_EQ(receiver.asked, 0);
  source.setDirectReceiver(nullptr);
}

TEST_F(VirtualPair, CarriesLongMessagesByReference) {
  Bytes const sysex = CountingSysex(5000);
  destination.SendSysex(At(9), SysexRef(sysex.data(), sysex.size()));
  setup.ProcessInput();
  EXPECT_THAT(receiver.AllBytes(), ElementsAre(sysex));
}

TEST_F(VirtualPair, AReceiverThatThrowsIsHeardAndLosesOnePacket) {
  for (unsigned char i = 1; i <= 3; ++i) {
    Send(destination, {0x90, i, 1});
  }
  receiver.onPacket = ThrowAtNoteTwo;
  EXPECT_THROW(setup.ProcessInput(), std::runtime_error);
  setup.ProcessInput();
  EXPECT_EQ(receiver.AllBytes().back(), (Bytes{0x90, 3, 1}));
  EXPECT_EQ(receiver.packets.size(), 3u);
}

TEST_F(VirtualPair, OnlyTheWantedEndIsPublic) {
  EXPECT_EQ(setup.CountSources(), 1);
  EXPECT_EQ(setup.CountPrivateDestinations(), 1);
  EXPECT_FALSE(source.IsPrivate());
  EXPECT_TRUE(destination.IsPrivate());
  EXPECT_TRUE(source.IsVirtual() && source.IsSoftware() && !source.IsInternalSoftware());
  EXPECT_EQ(source.GetMatchingVirtualDestination(), destination);
  EXPECT_EQ(destination.GetMatchingVirtualSource(), source);
  auto const neither =
      setup.CreateVirtualEndpoint(UString("Hidden"), Setup::SrcOrDest(7), Setup::kDestinationEnd);
  EXPECT_TRUE(neither.first.IsPrivate());
  EXPECT_TRUE(neither.second.IsPrivate());
}

TEST_F(VirtualPair, ItsEndsShareTheirProperties) {
  destination.SetManufacturer(UString("Acme"));
  EXPECT_EQ(source.GetManufacturer(), UString("Acme"));
  EXPECT_EQ(source.GetName(), UString("Bus"));
  EXPECT_EQ(destination.GetName(), UString("Bus"));
}

TEST_F(VirtualPair, RemovingAPropertyOnEitherEndRemovesItOnBoth) {
  source.SetManufacturer(UString("Acme"));
  Impl::ImplImpl& end =
      *static_cast<Impl::EndpointImpl*>(static_cast<Impl::ObjectImpl*>(destination.GetImplPtr()))
           ->Peer();
  end.RemoveProperty("manufacturer");
  EXPECT_EQ(source.GetManufacturer(), UString());
  EXPECT_TRUE(end.IsFake());
  EXPECT_FALSE(end.IsPregen());
  EXPECT_EQ(end.GetSynapMIDIPort(), nullptr);
}

// Whoever still holds the destination may go on writing to it.
TEST_F(VirtualPair, ADestinationWhoseSourceWentFirstKeepsItsOwnProperties) {
  setup.DeleteVirtualEndpoint(source);
  source = Source();
  setup.PollSetupChanges();  // which lets go of what it had noted
  ASSERT_EQ(destination.GetRawName(), UString());
  destination.SetRawName(UString("Left over"));
  EXPECT_EQ(destination.GetRawName(), UString("Left over"));
  Send(destination, {0x90, 60, 64});
  destination.FlushOutput();
  setup.ProcessInput();
  EXPECT_THAT(receiver.packets, IsEmpty());
}

TEST_F(VirtualPair, FlushingTakesNothingBack) {
  Send(destination, {0x90, 60, 64});
  destination.FlushOutput();
  setup.ProcessInput();
  EXPECT_EQ(receiver.packets.size(), 1u);
}

TEST_F(VirtualPair, IsDeletedByEitherEnd) {
  setup.DeleteVirtualEndpoint(destination);
  EXPECT_FALSE(source.Exists());
  EXPECT_FALSE(destination.Exists());
  EXPECT_EQ(source.GetMatchingVirtualDestination(), Destination::kNoDestination);
  EXPECT_EQ(setup.CountSources() + setup.CountPrivateDestinations(), 0);
  destination.SetModel(UString("kept alive by its handle"));
  setup.ProcessInput();
}

TEST_F(VirtualPair, AReceiverMayMakeAndDeletePairs) {
  receiver.onPacket = [this](Bytes const&) {
    setup.DeleteVirtualEndpoint(source);
    setup.CreateVirtualEndpoint(UString("Next"), Setup::kSourceEnd, Setup::kSourceEnd);
  };
  Send(destination, {0x90, 1, 1});
  setup.ProcessInput();
  EXPECT_THAT(SourceNames(), ElementsAre("Next"));
}

// What it was to hear may be gone with it.
TEST_F(VirtualPair, APairThatAReceiverDeletedIsSilent) {
  auto const other =
      setup.CreateVirtualEndpoint(UString("Other"), Setup::kSourceEnd, Setup::kSourceEnd);
  auto gone = std::make_unique<TestReceiver>();
  other.first.setDirectReceiver(gone.get());
  receiver.onPacket = [&](Bytes const&) {
    setup.DeleteVirtualEndpoint(other.first);
    gone.reset();
  };
  Send(destination, {0x90, 1, 1});
  Send(other.second, {0x90, 2, 2});
  setup.ProcessInput();
  EXPECT_EQ(receiver.packets.size(), 1u);
}

TEST_F(VirtualPair, MadeAnewFromItsReferenceHasItsIDWhereThatIsFree) {
  for (Setup::SrcOrDest const end : {Setup::kSourceEnd, Setup::kDestinationEnd}) {
    auto const shown = [end](std::pair<Source, Destination> const& pair) {
      return end == Setup::kSourceEnd ? Endpoint(pair.first) : Endpoint(pair.second);
    };
    Endpoint const first = shown(setup.CreateVirtualEndpoint(UString("Mine"), end, end));
    MatchData const reference = first.GetMatchData();
    int const id = first.GetUniqueID();
    Endpoint const twin = shown(setup.CreateVirtualEndpoint(reference, end, end));
    EXPECT_EQ(twin.GetName(), UString("Mine"));
    EXPECT_NE(twin.GetUniqueID(), id);
    EXPECT_NE(twin.GetUniqueID(), 0);
    setup.DeleteVirtualEndpoint(first);
    setup.DeleteVirtualEndpoint(twin);
    Endpoint const again = shown(setup.CreateVirtualEndpoint(reference, end, end));
    EXPECT_EQ(again.GetUniqueID(), id);
    setup.DeleteVirtualEndpoint(again);
    // An ID belongs to the end that shows.
    auto const hidden = setup.CreateVirtualEndpoint(reference, Setup::kNeitherEnd, end);
    EXPECT_NE(hidden.first.GetUniqueID(), id);
    EXPECT_NE(hidden.second.GetUniqueID(), id);
  }
}

TEST_F(VirtualPair, WithoutAReceiverIsDropped) {
  SignOut();
  setup.SignIn(UString("Test"), nullptr, nullptr);
  auto const pair =
      setup.CreateVirtualEndpoint(UString("Bus"), Setup::kSourceEnd, Setup::kSourceEnd);
  Send(pair.second, {0x90, 1, 1});
  setup.ProcessInput();
}

}  // namespace
}  // namespace Ostinet::Testing

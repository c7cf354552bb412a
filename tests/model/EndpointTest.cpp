// SPDX-License-Identifier: MIT
#include <boost/optional/optional_io.hpp>

#include "core/SystemServices.h"
#include "model/PropertyKeys.h"
#include "model/StandaloneDevices.h"
#include "support/StudioTest.h"

namespace Ostinet::Testing {
namespace {

using Impl::EndpointKind;
using Impl::ImplOf;
using ::testing::Contains;
using ::testing::ElementsAre;
using ::testing::IsEmpty;

// The list of standalone devices is read once, so the folder is chosen before any test runs.
bool const kResourcesAreChosen = [] {
  SystemServices::SetEnvironment("OSTINET_RESOURCES", OSTINET_MODEL_TEST_DATA);
  return true;
}();

class EndpointTest : public StudioTest {
 protected:
  /// A port in an entity of a direct device.
  Destination MakeDirectDestination(UString const& deviceName) {
    return setup.MakeEntity(setup.MakeDevice(deviceName, true), "Port 1", 0, 1).GetDestination(0);
  }
  void MakeStandalone(Destination const& destination) {
    destination.SetManufacturer("Maker");
    destination.SetModel("Piano");
    setup.PollSetupChanges();
  }
};

TEST(StandaloneDevices, AreThoseOfTheResourceWithBothNames) {
  ASSERT_TRUE(kResourcesAreChosen);
  EXPECT_TRUE(Impl::IsStandaloneDevice("Maker", "Piano"));
  EXPECT_FALSE(Impl::IsStandaloneDevice("maker", "Piano"));
  EXPECT_FALSE(Impl::IsStandaloneDevice("", "No maker"));
  EXPECT_FALSE(Impl::IsStandaloneDevice("", ""));
}

TEST_F(EndpointTest, APortWithSomethingOnItIsAnInterface) {
  Destination const port = MakeDirectDestination("Box");
  Destination const first = setup.MakeInstrument("One");
  Destination const second = setup.MakeInstrument("Two");
  EXPECT_FALSE(port.IsInterface().is_initialized());
  port.AddConnectedDestination(first);
  port.AddConnectedDestination(second);
  EXPECT_EQ(port.IsInterface(), boost::optional<bool>(true));
  port.RemoveConnectedDestination(first);
  port.RemoveConnectedDestination(second);
  EXPECT_FALSE(port.IsInterface().is_initialized());
}

TEST_F(EndpointTest, ADeviceWhoseNameSaysSoIsAnInterface) {
  EXPECT_EQ(MakeDirectDestination("INTERFACE 8x8").IsInterface(), boost::optional<bool>(true));
  EXPECT_FALSE(MakeDirectDestination("Interface 8x8").IsInterface().is_initialized());
  EXPECT_FALSE(MakeDirectDestination("My INTERFACE").IsInterface().is_initialized());
  EXPECT_FALSE(MakeDirectDestination("INTERFAC").IsInterface().is_initialized());
}

TEST_F(EndpointTest, AStandaloneDeviceIsNoInterfaceWhateverHangsOnIt) {
  Destination const port = MakeDirectDestination("INTERFACE");
  port.AddConnectedDestination(setup.MakeInstrument("One"));
  ASSERT_EQ(port.IsInterface(), boost::optional<bool>(true));
  MakeStandalone(port);
  EXPECT_EQ(port.IsInterface(), boost::optional<bool>(false));
  EXPECT_EQ(port.CountConnectedDestinations(), 1);
}

TEST_F(EndpointTest, TheStandaloneFlagIsThatOfTheDeviceAtConstruction) {
  Device const device = setup.MakeDevice("Box", true);
  device.SetManufacturer("Maker");
  device.SetModel("Piano");
  EXPECT_EQ(setup.MakeEntity(device, "Port 1", 0, 1).GetDestination(0).IsInterface(),
            boost::optional<bool>(false));
}

// Hosts that rename and retype a device in one go see it keep its kind until the next change.
TEST_F(EndpointTest, AChangeOfNameAndModelTogetherLeavesTheStandaloneFlag) {
  Destination const port = MakeDirectDestination("Box");
  port.SetRawName("Other");
  MakeStandalone(port);
  EXPECT_FALSE(port.IsInterface().is_initialized());
  port.SetModel("Piano");
  setup.PollSetupChanges();
  EXPECT_EQ(port.IsInterface(), boost::optional<bool>(false));
}

TEST_F(EndpointTest, ABarePortAndSoftwareAreNoInterfaces) {
  EXPECT_EQ(setup.MakePort("Port").IsInterface(), boost::optional<bool>(false));
  Destination const software = setup.MakeDestination("Soft", EndpointKind::Software(false, false));
  EXPECT_FALSE(software.HasConnections());
  EXPECT_EQ(software.IsInterface(), boost::optional<bool>(false));
}

TEST_F(EndpointTest, OnlyARealPortHasConnections) {
  EXPECT_TRUE(setup.MakePort("Port").HasConnections());
  EXPECT_FALSE(setup.MakeInstrument("Synth").HasConnections());
  Destination const embedded = setup.MakePort("Embedded");
  TestSetup::SetInt(embedded, "embedded", 1);
  EXPECT_FALSE(embedded.HasConnections());
}

TEST_F(EndpointTest, AUsersEndpointIsOnlineExactlyWhenItsPortIs) {
  Destination const instrument = setup.MakeInstrument("Synth");
  EXPECT_FALSE(instrument.IsOnline());
  Destination const port = setup.MakePort("Port");
  port.AddConnectedDestination(instrument);
  EXPECT_TRUE(instrument.IsOnline());
  TestSetup::SetInt(port, "offline", 1);
  EXPECT_FALSE(instrument.IsOnline());
  TestSetup::SetInt(port, "offline", 0);
  TestSetup::SetInt(instrument, "offline", 1);
  EXPECT_FALSE(instrument.IsOnline());
}

TEST_F(EndpointTest, ChannelsAreTheMaskElseTheCountElseAll) {
  Destination const port = setup.MakePort("Port");
  EXPECT_EQ(port.GetChannels(), 65535);
  struct {
    int count;
    int mask;
  } const kCounts[] = {{4, 0x000F},  {0, 0},       {-5, 0},      {1, 1},
                       {15, 0x7FFF}, {16, 0xFFFF}, {20, 0xFFFF}, {2147483647, 0xFFFF}};
  for (auto const& one : kCounts) {
    TestSetup::SetInt(port, "max receive channels", one.count);
    EXPECT_EQ(port.GetChannels(), one.mask) << one.count;
  }
  TestSetup::SetInt(port, "receiveChannels", 0);
  TestSetup::SetInt(port, "max receive channels", 4);
  EXPECT_EQ(port.GetChannels(), 0x000F);
  TestSetup::SetInt(port, "receiveChannels", 0x0100);
  EXPECT_EQ(port.GetChannels(), 0x0100);
}

TEST_F(EndpointTest, ASourceReadsWhatItTransmits) {
  Source const source = setup.MakeSourcePort("Port");
  TestSetup::SetInt(source, "receiveChannels", 1);
  EXPECT_EQ(source.GetChannels(), 65535);
  TestSetup::SetInt(source, "max transmit channels", 2);
  EXPECT_EQ(source.GetChannels(), 3);
  TestSetup::SetInt(source, "transmitChannels", 8);
  EXPECT_EQ(source.GetChannels(), 8);
}

struct Support {
  bool (Endpoint::*get)() const;
  char const* destinationKey;
  char const* sourceKey;
  bool fallback;
};

constexpr Support kSupports[] = {
    {&Endpoint::SupportsBankSelect0, "receives bank select MSB", "transmits bank select MSB",
     false},
    {&Endpoint::SupportsBankSelect32, "receives bank select LSB", "transmits bank select LSB",
     false},
    {&Endpoint::SupportsClock, "receives clock", "transmits clock", false},
    {&Endpoint::SupportsMTC, "receives MTC", "transmits MTC", false},
    {&Endpoint::SupportsNotes, "receives notes", "transmits notes", true},
    {&Endpoint::SupportsProgramChange, "receives program changes", "transmits program changes",
     true},
};

TEST_F(EndpointTest, ADestinationAnswersByWhatItReceivesASourceByWhatItTransmits) {
  Destination const destination = setup.MakePort("Out");
  Source const source = setup.MakeSourcePort("In");
  for (Support const& support : kSupports) {
    EXPECT_EQ((destination.*support.get)(), support.fallback) << support.destinationKey;
    EXPECT_EQ((source.*support.get)(), support.fallback) << support.sourceKey;
    int const other = support.fallback ? 0 : 1;
    TestSetup::SetInt(destination, support.sourceKey, other);
    TestSetup::SetInt(source, support.destinationKey, other);
    EXPECT_EQ((destination.*support.get)(), support.fallback) << support.destinationKey;
    EXPECT_EQ((source.*support.get)(), support.fallback) << support.sourceKey;
    TestSetup::SetInt(destination, support.destinationKey, other);
    TestSetup::SetInt(source, support.sourceKey, other);
    EXPECT_NE((destination.*support.get)(), support.fallback) << support.destinationKey;
    EXPECT_NE((source.*support.get)(), support.fallback) << support.sourceKey;
  }
}

TEST_F(EndpointTest, AChannelWithoutANameBearsItsNumber) {
  Destination const port = setup.MakePort("Port");
  EXPECT_EQ(port.GetChannelName(0), UString("1"));
  EXPECT_EQ(port.GetChannelName(15), UString("16"));
}

TEST_F(EndpointTest, ASlotNeedsSixNumbers) {
  Destination const port = setup.MakePort("Port");
  TestSetup::PeerOf(port).SetIntList("slotDescriptor", {1, 2, 3, 4, 5});
  EXPECT_TRUE(port.GetSlotID() == SlotID());
  TestSetup::PeerOf(port).SetIntList("slotDescriptor", {1, 2, 3, 4, 5, -1, 7});
  SlotID const slot = port.GetSlotID();
  EXPECT_THAT(slot.words, ElementsAre(1U, 2U, 3U, 4U, 5U, 0xFFFFFFFFU));
  EXPECT_TRUE(slot != SlotID());
}

TEST_F(EndpointTest, ALoopIsKnownByItsDriver) {
  Destination const port = setup.MakePort("Port");
  EXPECT_FALSE(port.IsLoop());
  TestSetup::PeerOf(port).SetString("driver", "com.apple.AppleMIDIIACDriver");
  EXPECT_TRUE(port.IsLoop());
  TestSetup::PeerOf(port).SetString("driver", "com.apple.applemidiiacdriver");
  EXPECT_FALSE(port.IsLoop());
}

TEST_F(EndpointTest, BroadcastAndPregenComeFromThePropertyAndThePeer) {
  Destination const port = setup.MakePort("Port");
  EXPECT_FALSE(port.IsBroadcast());
  TestSetup::SetInt(port, "broadcast", 1);
  EXPECT_TRUE(port.IsBroadcast());
  EXPECT_FALSE(port.IsPregen());
  TestSetup::PeerOf(port).isPregen = true;
  EXPECT_TRUE(port.IsPregen());
  Destination const instrument = setup.MakeInstrument("Synth");
  TestSetup::PeerOf(instrument).isPregen = true;
  EXPECT_FALSE(instrument.IsPregen());
}

TEST_F(EndpointTest, TheKindsDifferInTheirFlags) {
  Destination const software = setup.MakeDestination("S", EndpointKind::Software(true, true));
  EXPECT_TRUE(software.IsDirect() && software.IsSoftware() && software.IsInternalSoftware() &&
              software.IsPrivate() && !software.IsVirtual());
  Destination const bare = setup.MakeDestination("B", EndpointKind::Bare(false, false));
  EXPECT_FALSE(bare.IsDirect() || bare.IsSoftware() || bare.IsInternalSoftware() ||
               bare.IsPrivate() || bare.IsVirtual());
  Source const virtualSource = setup.MakeSource("V", EndpointKind::Virtual(nullptr, false, false));
  EXPECT_TRUE(virtualSource.IsDirect() && virtualSource.IsSoftware() && virtualSource.IsVirtual() &&
              !virtualSource.IsInternalSoftware());
  EXPECT_EQ(ImplOf(software)->GetObjectID(), Destination::kObjectID);
  EXPECT_EQ(ImplOf(virtualSource)->GetObjectID(), Source::kObjectID);
}

TEST_F(EndpointTest, ADirectReceiverIsSharedByAllHandlesOfTheSource) {
  Source const source = setup.MakeSourcePort("In");
  RecordingReceiver receiver;
  EXPECT_FALSE(source.hasDirectReceiver());
  source.setDirectReceiver(&receiver);
  EXPECT_TRUE(setup.GetSource(0).hasDirectReceiver());
  EXPECT_EQ(setup.GetSource(0).getDirectReceiver(), &receiver);
  source.setDirectReceiver(nullptr);
  EXPECT_FALSE(source.hasDirectReceiver());
}

class VirtualPairTest : public StudioTest {
 protected:
  std::pair<Source, Destination> const pair =
      setup.CreateVirtualEndpoint("Pair", Setup::kSourceEnd, Setup::kDestinationEnd);
};

TEST_F(VirtualPairTest, TheEndsFindEachOther) {
  EXPECT_THAT(setup.calls, ElementsAre("CreateVirtualEndpoint Pair 0 0 1"));
  EXPECT_TRUE(pair.first.GetMatchingVirtualDestination() == pair.second);
  EXPECT_TRUE(pair.second.GetMatchingVirtualSource() == pair.first);
}

TEST_F(VirtualPairTest, DeletingEitherEndDeletesBoth) {
  setup.DeleteVirtualEndpoint(pair.second);
  EXPECT_FALSE(pair.first.Exists());
  EXPECT_FALSE(pair.second.Exists());
  EXPECT_THAT(setup.calls, Contains("DeleteVirtualEndpoint source destination"));
  auto const other = setup.CreateVirtualEndpoint("Other", Setup::kSourceEnd, Setup::kNeitherEnd);
  setup.DeleteVirtualEndpoint(other.first);
  EXPECT_FALSE(other.second.Exists());
  EXPECT_EQ(setup.CountPrivateDestinations(), 0);
}

TEST_F(VirtualPairTest, AnEndThatGoesAloneLeavesNoLinkBehind) {
  setup.RemoveSource(ImplOf(pair.first));
  EXPECT_TRUE(pair.second.GetMatchingVirtualSource() == Source::kNoSource);
  EXPECT_TRUE(pair.first.GetMatchingVirtualDestination() == Destination::kNoDestination);
  setup.calls.clear();
  setup.DeleteVirtualEndpoint(pair.second);
  EXPECT_THAT(setup.calls, ElementsAre("DeleteVirtualEndpoint destination"));
  EXPECT_FALSE(pair.second.Exists());
}

TEST_F(VirtualPairTest, ChangesOfTheOneEndAreChangesOfItsFakeOne) {
  EXPECT_EQ(pair.second.GetName(), UString("Pair"));
  TestSetup::PeerOf(pair.second).SetString("name", "New");
  setup.pending.clear();
  TestSetup::PeerOf(pair.first).SetString("name", "New");
  setup.PollSetupChanges();
  EXPECT_EQ(pair.first.GetName(), UString("New"));
  EXPECT_EQ(pair.second.GetName(), UString("New"));
}

TEST_F(VirtualPairTest, ChangesOfTheFakeEndAreItsOwn) {
  EXPECT_EQ(pair.first.GetName(), UString("Pair"));
  TestSetup::PeerOf(pair.first).SetString("name", "New");
  setup.pending.clear();
  TestSetup::PeerOf(pair.second).SetString("name", "New");
  setup.PollSetupChanges();
  EXPECT_EQ(pair.first.GetName(), UString("Pair"));
}

TEST_F(VirtualPairTest, OnlyVirtualEndpointsAreDeletedAsSuch) {
  Destination const port = setup.MakePort("Port");
  setup.calls.clear();
  setup.DeleteVirtualEndpoint(port);
  EXPECT_TRUE(port.Exists());
  EXPECT_THAT(setup.calls, IsEmpty());
}

TEST_F(EndpointTest, ABarePortGoesOnlyWhileItIsOffline) {
  Destination const port = setup.MakePort("Port");
  Source const source = setup.MakeSourcePort("Port");
  setup.DeleteBareEndpoint(port);
  EXPECT_TRUE(port.Exists());
  TestSetup::SetInt(port, "offline", 1);
  TestSetup::SetInt(source, "offline", 1);
  setup.DeleteBareEndpoint(port);
  setup.DeleteBareEndpoint(source);
  EXPECT_FALSE(port.Exists());
  EXPECT_FALSE(source.Exists());
  EXPECT_EQ(setup.CountDestinations(), 0);
  EXPECT_EQ(setup.CountSources(), 0);
  EXPECT_THAT(setup.calls, ElementsAre("WillDeleteBareEndpoint", "WillDeleteBareEndpoint"));
}

TEST_F(EndpointTest, EndpointsOfEntitiesAndUsersAreNotDeletedAsBareOnes) {
  Destination const inEntity = MakeDirectDestination("Box");
  TestSetup::SetInt(inEntity, "offline", 1);
  Destination const users = setup.MakeDestination("User", EndpointKind::Bare(false, false));
  setup.DeleteBareEndpoint(inEntity);
  setup.DeleteBareEndpoint(users);
  EXPECT_TRUE(inEntity.Exists());
  EXPECT_TRUE(users.Exists());
}

TEST_F(EndpointTest, AChangeRoundTellsWhetherConnectionsDependOnIt) {
  Destination const port = setup.MakePort("Port");
  for (char const* key : {"connUniqueID", "uniqueID", "embedded"}) {
    EXPECT_TRUE(ImplOf(port)->HandlePropertyChanges({UString(key)})) << key;
  }
  EXPECT_FALSE(ImplOf(port)->HandlePropertyChanges({UString("name"), UString("offline")}));
  Device const device = setup.MakeDevice("Synth");
  EXPECT_FALSE(ImplOf(device)->HandlePropertyChanges({UString("uniqueID")}));
  setup.MakeEntity(device, "Port 1", 1, 1);
  EXPECT_TRUE(ImplOf(device)->HandlePropertyChanges({UString("uniqueID")}));
}

TEST_F(EndpointTest, ADestinationSendsThroughThePortItHangsOn) {
  Destination const port = setup.MakePort("Port");
  Destination const instrument = setup.MakeInstrument("Synth");
  EXPECT_EQ(instrument.MakeSender(), nullptr);
  port.AddConnectedDestination(instrument);
  SentLog const& sent = *TestSetup::PeerOf(port).sent;

  unsigned char const bytes[] = {0x90, 60, 64};
  instrument.SendOnePacket(DataPacket{bytes, 3, TimeStamp(Clocks(5))});
  ASSERT_EQ(sent.packets.size(), 1U);
  EXPECT_THAT(sent.packets[0].bytes, ElementsAre(0x90, 60, 64));
  EXPECT_EQ(sent.packets[0].clocks, 5U);
  EXPECT_EQ(sent.flushes, 1);
  EXPECT_EQ(sent.sendersAlive, 0);
  EXPECT_THAT(sent.sendersMadeFor, ElementsAre(ImplOf(instrument)));

  instrument.FlushOutput();
  EXPECT_EQ(sent.outputFlushes, 1);
  instrument.SendSysex(kNoTimeStamp, SysexRef());
  EXPECT_EQ(sent.sysexes, 1);
}

TEST_F(EndpointTest, WhatCannotBeSentIsDropped) {
  Destination const port = setup.MakePort("Port");
  unsigned char const bytes[] = {0x90, 60, 64};
  TestSetup::PeerOf(port).canSend = false;
  port.SendOnePacket(DataPacket{bytes, 3, kNoTimeStamp});
  TestSetup::PeerOf(port).makesSenders = false;
  port.SendOnePacket(DataPacket{bytes, 3, kNoTimeStamp});
  EXPECT_THAT(TestSetup::PeerOf(port).sent->packets, IsEmpty());
  EXPECT_EQ(TestSetup::PeerOf(port).sent->flushes, 0);
}

TEST_F(EndpointTest, TheAdvanceIsGivenInSeconds) {
  Destination const port = setup.MakePort("Port");
  EXPECT_EQ(port.GetAdvanceScheduleTime(), 0.0);
  port.SetAdvanceScheduleMicroseconds(2500);
  EXPECT_EQ(port.GetAdvanceScheduleTime(), 0.0025);
}

}  // namespace
}  // namespace Ostinet::Testing

// SPDX-License-Identifier: MIT
//
// Destinations that are plug-ins of the host's engine.
#include <gmock/gmock.h>

#include <fstream>
#include <iterator>

#include "model/DestinationImpl.h"
#include "model/Handles.h"
#include "model/PropertyKeys.h"
#include "platform/PlatformTest.h"
#include "support/FakePlugin.h"

namespace Ostinet::Testing {
namespace {

using ::testing::ElementsAre;
using ::testing::IsEmpty;
namespace Keys = Impl::Keys;

class PluginDestination : public PlatformTest {
 protected:
  PluginDestination() { SignIn(); }
  // Nothing of the library may name a plug-in that is gone.
  ~PluginDestination() override { SignOut(); }

  Destination Make(bool isPrivate = false) {
    return setup.CreateSYNAPPluginDestination(&plugin, isPrivate);
  }
  static void SetSlot(Destination const& destination, std::vector<int> const& words) {
    Impl::ImplOf(destination)->Peer()->SetIntList(Keys::kSlotDescriptor, words);
  }

  FakePlugin plugin;
};

TEST_F(PluginDestination, IsInternalSoftwareOnThePublicList) {
  Destination const destination = Make();
  ASSERT_TRUE(destination.Exists());
  EXPECT_EQ(setup.CountDestinations(), 1);
  EXPECT_EQ(setup.GetDestination(0), destination);
  EXPECT_TRUE(destination.IsDirect());
  EXPECT_TRUE(destination.IsSoftware());
  EXPECT_TRUE(destination.IsInternalSoftware());
  EXPECT_TRUE(destination.IsOnline());
  EXPECT_FALSE(destination.IsPrivate());
  EXPECT_FALSE(destination.IsVirtual());
  EXPECT_FALSE(destination.HasConnections());
  EXPECT_FALSE(destination.GetEntity().Exists());
  EXPECT_NE(destination.GetUniqueID(), 0);
  EXPECT_EQ(destination.GetImplementation(), 4);
  EXPECT_EQ(destination._get_impl_obj_ref(Properties::kPluginHostImplementation), nullptr);
}

TEST_F(PluginDestination, APrivateOneIsOnThePrivateList) {
  Destination const destination = Make(true);
  EXPECT_EQ(setup.CountDestinations(), 0);
  EXPECT_EQ(setup.GetPrivateDestination(0), destination);
  EXPECT_TRUE(destination.IsPrivate());
}

TEST_F(PluginDestination, ThePlugInHearsOfItsPeerAndThenOfNull) {
  Destination destination = Make();
  ASSERT_EQ(plugin.told.size(), 1u);
  ASSERT_NE(plugin.told[0], nullptr);
  EXPECT_EQ(plugin.Peer().GetSynapMIDIPort(), &plugin);
  EXPECT_EQ(plugin.Peer().GetUniqueID(), destination.GetUniqueID());
  setup.DeleteSYNAPPluginDestination(destination);
  ASSERT_EQ(plugin.told.size(), 2u);
  EXPECT_EQ(plugin.told[1], nullptr);
}

TEST_F(PluginDestination, ComingAndGoingTellTheHost) {
  setup.PollSetupChanges();
  listener.setupChanges = 0;
  Destination destination = Make();
  setup.PollSetupChanges();
  EXPECT_EQ(listener.setupChanges, 1);
  setup.PollSetupChanges();
  EXPECT_EQ(listener.setupChanges, 1);
  setup.DeleteSYNAPPluginDestination(destination);
  setup.PollSetupChanges();
  EXPECT_EQ(listener.setupChanges, 2);
}

TEST_F(PluginDestination, DeletedItDoesNotExistAndIsLetGo) {
  Destination destination = Make();
  EXPECT_EQ(plugin.end.references, 1);
  setup.DeleteSYNAPPluginDestination(destination);
  EXPECT_FALSE(destination.Exists());
  EXPECT_EQ(setup.CountDestinations(), 0);
  EXPECT_EQ(plugin.end.references, 0);
  setup.DeleteSYNAPPluginDestination(destination);  // again
  EXPECT_EQ(plugin.told.size(), 2u);
  EXPECT_EQ(plugin.end.references, 0);
}

TEST_F(PluginDestination, SigningOutLetsItGo) {
  Destination const destination = Make();
  Make(true);
  SignOut();
  EXPECT_FALSE(destination.Exists());
  EXPECT_EQ(plugin.end.references, 0);
  EXPECT_EQ(plugin.told.size(), 4u);
}

TEST_F(PluginDestination, APlugInMayDeleteItsDestinationWhileItHearsOfItsEnd) {
  Destination destination = Make();
  plugin.onTold = [&](Impl::SYNAP_MIDIDestImplImpl*) {
    setup.DeleteSYNAPPluginDestination(destination);
  };
  setup.DeleteSYNAPPluginDestination(destination);
  EXPECT_EQ(plugin.told.size(), 2u);
  EXPECT_EQ(plugin.end.references, 0);
  EXPECT_EQ(setup.CountDestinations(), 0);
}

TEST_F(PluginDestination, SendsAtOnceWithSampleTimes) {
  Destination const destination = Make();
  Bytes const note{0x93, 60, 64};
  std::unique_ptr<Impl::Sender> const sender = destination.MakeSender();
  ASSERT_NE(sender, nullptr);
  EXPECT_TRUE(sender->CanSend());
  sender->Send({note.data(), note.size(), TimeStamp(Clocks(99999999), 4410.0)});
  ASSERT_EQ(plugin.end.records.size(), 1u);
  EXPECT_EQ(plugin.end.records[0].Bytes(), note);
  EXPECT_EQ(plugin.end.records[0].SampleTime(), 4410);
  EXPECT_EQ(plugin.end.records[0].Kind(), 2);
  sender->Flush();
  EXPECT_EQ(plugin.end.sends, 1);
  EXPECT_EQ(plugin.end.flushes, 0) << "a sender's flush is for packets that it packed";
}

TEST_F(PluginDestination, TakesLongMessagesAndFlushes) {
  Destination const destination = Make();
  Bytes bytes(300, 1);
  bytes.front() = 0xF0;
  bytes.back() = 0xF7;
  destination.SendSysex(TimeStamp(Clocks(1), 5.0), SysexRef(bytes.data(), bytes.size()));
  EXPECT_EQ(plugin.end.sends, 1);
  ASSERT_EQ(plugin.end.records.size(), 2u);
  EXPECT_EQ(plugin.end.records[1].Count(), 44u);
  destination.SendSysex(kNoTimeStamp, SysexRef());
  EXPECT_EQ(plugin.end.sends, 1);
  destination.FlushOutput();
  EXPECT_EQ(plugin.end.flushes, 1);
}

TEST_F(PluginDestination, AfterItsEndNothingIsSentAndNoSenderMade) {
  Destination destination = Make();
  setup.DeleteSYNAPPluginDestination(destination);
  EXPECT_EQ(destination.MakeSender(), nullptr);
  unsigned char const bytes[] = {0xF0, 0xF7};
  destination.SendOnePacket({bytes, 2, kNoTimeStamp});
  destination.SendSysex(kNoTimeStamp, SysexRef(bytes, 2));
  destination.FlushOutput();
  EXPECT_EQ(plugin.end.sends + plugin.end.flushes, 0);
}

TEST_F(PluginDestination, AnOldSenderStillHoldsItsReference) {
  Destination destination = Make();
  std::unique_ptr<Impl::Sender> sender = destination.MakeSender();
  EXPECT_EQ(plugin.end.references, 2);
  setup.DeleteSYNAPPluginDestination(destination);
  EXPECT_EQ(plugin.end.references, 1);
  EXPECT_TRUE(sender->CanSend());
  unsigned char const clock = 0xF8;
  sender->Send({&clock, 1, kNoTimeStamp});
  EXPECT_EQ(plugin.end.records.size(), 1u);
  sender.reset();
  EXPECT_EQ(plugin.end.references, 0);
}

// The host's engine knows what its plug-in plays, so nothing is followed on the way there.
TEST_F(PluginDestination, ProgramChangesAreNotFollowed) {
  Destination const destination = Make();
  Send(destination, {0xC0, 5});
  setup.Poll();
  EXPECT_EQ(plugin.end.records.size(), 1u);
  EXPECT_THAT(listener.patches, IsEmpty());
}

TEST_F(PluginDestination, PanicReachesIt) {
  Make();
  setup.Panic();
  EXPECT_EQ(plugin.end.records.size(), 32u);
  EXPECT_THAT(plugin.end.records.at(0).Bytes(), ElementsAre(0xB0, 120, 0));
}

TEST_F(PluginDestination, WithoutAnEndItExistsAndCannotBeSentTo) {
  plugin.hasEnd = false;
  Destination const destination = Make();
  EXPECT_TRUE(destination.Exists());
  EXPECT_EQ(destination.MakeSender(), nullptr);
  Send(destination, {0xF8});
  destination.FlushOutput();
  setup.Panic();
}

TEST_F(PluginDestination, WithoutAPlugInItExistsAndCannotBeSentTo) {
  Destination destination = setup.CreateSYNAPPluginDestination(nullptr, false);
  EXPECT_TRUE(destination.Exists());
  EXPECT_FALSE(destination.IsPregen());
  EXPECT_EQ(destination.MakeSender(), nullptr);
  setup.DeleteSYNAPPluginDestination(destination);
  EXPECT_FALSE(destination.Exists());
}

TEST_F(PluginDestination, IsPregenIsAskedEachTime) {
  Destination destination = Make();
  EXPECT_FALSE(destination.IsPregen());
  EXPECT_FALSE(plugin.Peer().IsPregen());
  plugin.isPregen = true;
  EXPECT_TRUE(destination.IsPregen());
  EXPECT_TRUE(plugin.Peer().IsPregen());
  setup.DeleteSYNAPPluginDestination(destination);
  EXPECT_FALSE(destination.IsPregen());
}

TEST_F(PluginDestination, ThePeerTellsWhatTheHandleWasGivenAndTheReverse) {
  Destination const destination = Make();
  SynapPeer const peer = plugin.Peer();
  destination.SetRawName(UString("Piano"));
  EXPECT_EQ(peer.GetName(), UString("Piano"));
  peer.SetManufAndModel(UString("Acme"), UString("P-1"));
  EXPECT_EQ(destination.GetManufacturer(), UString("Acme"));
  EXPECT_EQ(destination.GetModel(), UString("P-1"));
  UString manufacturer, model;
  peer.GetManufAndModel(manufacturer, model);
  EXPECT_EQ(manufacturer, UString("Acme"));
  EXPECT_EQ(model, UString("P-1"));
  peer.SetAdvanceScheduleTime(1500);
  EXPECT_EQ(destination.GetAdvanceScheduleMicroseconds(), 1500);
  peer.SetChanMask(5);
  EXPECT_EQ(destination.GetChannels(), 5);
  peer.SetChanName(15, UString("Strings"));
  EXPECT_EQ(static_cast<DeviceObject const&>(destination).GetChannelName(15), UString("Strings"));
}

TEST_F(PluginDestination, AChannelThatIsNoneGetsNoName) {
  Destination const destination = Make();
  setup.PollSetupChanges();
  listener.setupChanges = 0;
  plugin.Peer().SetChanName(16, UString("x"));
  plugin.Peer().SetChanName(-1, UString("x"));
  setup.PollSetupChanges();
  EXPECT_EQ(listener.setupChanges, 0);
}

TEST_F(PluginDestination, AFreshPeerGivesEmptyTextsForWhatItLacks) {
  Make();
  UString manufacturer("old"), model("old"), path("old");
  plugin.Peer().GetManufAndModel(manufacturer, model);
  plugin.Peer().GetMasterNamesProperty(path);
  EXPECT_EQ(manufacturer + model + path + plugin.Peer().GetName(), UString());
}

TEST_F(PluginDestination, TheMasterDocumentIsOneEntryAmongOthers) {
  Destination const destination = Make();
  Impl::ImplImpl& properties = *Impl::ImplOf(destination)->Peer();
  Impl::PropertyDict configuration;
  configuration.entries["currentDeviceMode"] = UString("Live");
  properties.SetDict(Keys::kNameConfiguration, configuration);
  UString const file = prefs.MakeFile("piano.midnam");

  plugin.Peer().SetMasterNamesProperty(file);
  UString path;
  plugin.Peer().GetMasterNamesProperty(path);
  EXPECT_EQ(path, file);
  ASSERT_TRUE(properties.GetDict(Keys::kNameConfiguration, configuration));
  EXPECT_EQ(configuration.entries.size(), 2u);
  EXPECT_EQ(boost::get<Impl::PropertyPath>(configuration.entries["master"]).path, file);

  plugin.Peer().SetMasterNamesProperty(UString());
  plugin.Peer().GetMasterNamesProperty(path);
  EXPECT_EQ(path, UString());
  ASSERT_TRUE(properties.GetDict(Keys::kNameConfiguration, configuration));
  EXPECT_EQ(configuration.entries.count("currentDeviceMode"), 1u);
  EXPECT_EQ(configuration.entries.count("master"), 0u);
}

TEST_F(PluginDestination, AMasterThatIsNoFileReadsAsNone) {
  Destination const destination = Make();
  Impl::PropertyDict configuration;
  configuration.entries["master"] = UString("/not/a/file/value");
  Impl::ImplOf(destination)->Peer()->SetDict(Keys::kNameConfiguration, configuration);
  UString path;
  plugin.Peer().GetMasterNamesProperty(path);
  EXPECT_EQ(path, UString());
}

TEST_F(PluginDestination, TheSlotNeedsSixNumbers) {
  Destination const destination = Make();
  SetSlot(destination, {1, 2, 3, 4, 5});
  EXPECT_EQ(plugin.Peer().GetSlotID(), SlotID());
  SetSlot(destination, {1, 2, 3, 4, 5, -6, 7});
  SlotID const slot = plugin.Peer().GetSlotID();
  EXPECT_EQ(slot, destination.GetSlotID());
  EXPECT_THAT(slot.words, ElementsAre(1u, 2u, 3u, 4u, 5u, 4294967290u));
}

TEST_F(PluginDestination, APropertyThatThePlugInWritesReachesTheHost) {
  Make();
  setup.PollSetupChanges();
  listener.setupChanges = 0;
  plugin.Peer().SetChanMask(3);
  setup.PollSetupChanges();
  EXPECT_EQ(listener.setupChanges, 1);
}

TEST_F(PluginDestination, APlugInMayDescribeItselfWhileItIsBeingMade) {
  plugin.onTold = [](Impl::SYNAP_MIDIDestImplImpl* peer) {
    SynapPeer(peer).SetManufAndModel(UString("Acme"), UString("P-1"));
  };
  Destination const destination = Make();
  EXPECT_EQ(destination.GetModel(), UString("P-1"));
  setup.PollSetupChanges();
  EXPECT_TRUE(destination.Exists());
}

TEST_F(PluginDestination, OnlySoftwareHasAnImplementationToGive) {
  AddOut("Port");
  Rescan();
  Destination port = Dest("Port");
  Destination plugged = Make();
  Destination none;
  EXPECT_EQ(setup.GetSynapPluginDestinationImpl(port), nullptr);
  EXPECT_EQ(setup.GetSynapPluginDestinationImpl(none), nullptr);
  EXPECT_EQ(setup.GetSynapPluginDestinationImpl(plugged), plugged.GetImplPtr());
}

TEST_F(PluginDestination, NullHandlesAreNoHarm) {
  setup.PollSetupChanges();
  listener.setupChanges = 0;
  Destination none;
  setup.DeleteSYNAPPluginDestination(none);
  setup.UpdateNameSetsForSYNAPPluginDestination(none);
  setup.PollSetupChanges();
  EXPECT_EQ(listener.setupChanges, 0);
}

TEST_F(PluginDestination, APortOfItsNameIsAnotherEndpoint) {
  Destination const destination = Make();
  destination.SetRawName(UString("Piano"));
  AddOut("Piano");
  Rescan();
  EXPECT_EQ(setup.CountDestinations(), 2);
  EXPECT_TRUE(destination.IsOnline());
  midi.RemovePort("Piano");
  Rescan();
  EXPECT_TRUE(destination.IsOnline());
  EXPECT_EQ(OfflineProperty(destination), -1);
}

TEST_F(PluginDestination, IsNotSavedAmongThePorts) {
  Make().SetRawName(UString("Piano"));
  SignOut(true);
  std::ifstream stream(prefs.folder / "Ostinet.xml", std::ios::binary);
  std::string const saved{std::istreambuf_iterator<char>(stream), std::istreambuf_iterator<char>()};
  EXPECT_NE(saved.find("<Ostinet"), std::string::npos);
  EXPECT_EQ(saved.find("Piano"), std::string::npos);
}

/// A renewal that only counts.
class CountingNames : public Impl::DestinationNames {
 public:
  explicit CountingNames(int& renewals) : renewals_(renewals) {}
  bool Renew() override { return ++renewals_ % 2 == 1; }
  void SaveEditedBanks() override {}
  void WillRemove() override {}

 private:
  int& renewals_;
};

// Who asks for it knows, so nobody is told.
TEST_F(PluginDestination, NamesAreRenewedOnRequest) {
  Destination destination = Make();
  int renewals = 0;
  Impl::ImplOf(destination)->SetNames(std::make_unique<CountingNames>(renewals));
  setup.UpdateNameSetsForSYNAPPluginDestination(destination);
  EXPECT_EQ(renewals, 1);
  EXPECT_THAT(listener.names, IsEmpty());
}

TEST(SynapPeerHandle, OfNullGivesNothingAndDoesNothing) {
  SynapPeer const none(nullptr);
  UString one("old"), two("old");
  none.SetManufAndModel(one, two);
  none.SetMasterNamesProperty(one);
  none.SetAdvanceScheduleTime(1);
  none.SetChanMask(1);
  none.SetChanName(1, one);
  EXPECT_EQ(none.GetSynapMIDIPort(), nullptr);
  EXPECT_FALSE(none.IsPregen());
  EXPECT_EQ(none.GetName(), UString());
  EXPECT_EQ(none.GetSlotID(), SlotID());
  EXPECT_EQ(none.GetUniqueID(), 0);
  none.GetManufAndModel(one, two);
  EXPECT_EQ(one + two, UString());
  one = UString("old");
  none.GetMasterNamesProperty(one);
  EXPECT_EQ(one, UString());
}

}  // namespace
}  // namespace Ostinet::Testing

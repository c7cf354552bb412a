// SPDX-License-Identifier: MIT
#include <memory>

#include "model/NamesHooks.h"
#include "model/PropertyKeys.h"
#include "ostinet/core/Error.h"
#include "support/StudioTest.h"

namespace Ostinet::Testing {
namespace {

using Impl::EndpointKind;
using Impl::ImplOf;
using ::testing::Contains;
using ::testing::Each;
using ::testing::ElementsAre;
using ::testing::IsEmpty;
using ::testing::Not;

using Setup = TestSetup;

class CountingNames : public Impl::DestinationNames {
 public:
  struct Counts {
    int saves = 0;
    int renewals = 0;
    int removals = 0;
    bool changes = true;  // what a renewal answers
  };
  explicit CountingNames(std::shared_ptr<Counts> counts) : counts_(std::move(counts)) {}
  bool Renew() override {
    ++counts_->renewals;
    return counts_->changes;
  }
  void SaveEditedBanks() override { ++counts_->saves; }
  void WillRemove() override { ++counts_->removals; }

 private:
  std::shared_ptr<Counts> const counts_;  // the studio outlives the test's own variables
};

class SetupTest : public StudioTest {
 protected:
  using Counts = std::shared_ptr<CountingNames::Counts>;

  Destination MakePortWithNames(Counts const& counts, bool isPrivate = false) {
    Destination const port = setup.MakeDestination("Named", EndpointKind::Bare(true, isPrivate));
    ImplOf(port)->SetNames(std::make_unique<CountingNames>(counts));
    return port;
  }
  /// A program change on `channel` goes out to `port`.
  static void ChangePatch(Destination const& port, int channel) {
    unsigned char const bytes[] = {static_cast<unsigned char>(0xC0 + channel), 5};
    ImplOf(port)->GetChannelState()->Track(DataPacket{bytes, 2, kNoTimeStamp});
  }

  RecordingReceiver receiver;
};

TEST_F(SetupTest, SignInLoadsTheStudioAndTellsTheListener) {
  setup.onLoad = [this] {
    Destination const port = setup.MakePort("Port");
    Destination const synth = setup.MakeInstrument("Synth");
    TestSetup::PeerOf(port).SetIntList("connUniqueID", {synth.GetUniqueID()});
  };
  int connectedWhenTold = -1;
  listener.onSetupChanged = [&] {
    connectedWhenTold = setup.GetDestination(0).CountConnectedDestinations();
  };
  EXPECT_EQ(setup.SignIn("host", &receiver, &prefs), Setup::kSignInOK);
  EXPECT_THAT(setup.calls, ElementsAre("SignIn", "LoadSetup"));
  EXPECT_EQ(connectedWhenTold, 1);
  EXPECT_EQ(listener.setupChanges, 1);
  EXPECT_EQ(setup.SignInName(), UString("host"));
  EXPECT_EQ(setup.GetReceiver(), &receiver);
  EXPECT_EQ(setup.GetPrefsHandler(), &prefs);
  EXPECT_EQ(setup.GetListener(), &listener);
}

// The catalog's steps stand between the files in use and the studio, which needs the catalog.
class CatalogHooks : public Impl::NamesHooks {
 public:
  CatalogHooks() { Impl::InstallNamesHooks(this); }
  ~CatalogHooks() { Impl::InstallNamesHooks(nullptr); }
  std::unique_ptr<Impl::DestinationNames> MakeNames(Impl::DestinationImpl&) const override {
    return std::make_unique<CountingNames>(counts);
  }
  void LoadCatalog(PrefsHandler&) const override { calls.push_back("LoadCatalog"); }
  void SaveCatalog(PrefsHandler&) const override { calls.push_back("SaveCatalog"); }

  std::vector<std::string>& calls = TestSetup::Get().calls;
  std::shared_ptr<CountingNames::Counts> const counts = std::make_shared<CountingNames::Counts>();
};

TEST_F(SetupTest, TheCatalogIsThereBeforeTheStudioAndSavedBeforeIt) {
  CatalogHooks const hooks;
  setup.SignIn("host", &receiver, &prefs);
  EXPECT_THAT(setup.calls, ElementsAre("SignIn", "LoadCatalog", "LoadSetup"));
  setup.calls.clear();
  setup.SignOut(true);
  EXPECT_THAT(setup.calls, ElementsAre("SaveCatalog", "SaveDevices", "SignOut"));
}

TEST_F(SetupTest, TheCatalogIsLeftAloneWithoutAHandlerAndWhereItWasNotLoaded) {
  CatalogHooks const hooks;
  setup.SignIn("host", &receiver, nullptr);
  setup.SignOut(false);
  setup.signInResult = Setup::kSignInPlatformError;
  setup.SignIn("host", &receiver, &prefs);
  setup.SignOut(false);
  EXPECT_THAT(setup.calls, Not(Contains("LoadCatalog")));
  EXPECT_THAT(setup.calls, Not(Contains("SaveCatalog")));
  setup.signInResult = Setup::kSignInOK;
  setup.SignIn("host", &receiver, &prefs);
  setup.SignOut(false);
  setup.calls.clear();
  setup.SignOut(false);  // the host's handler may be gone by now
  EXPECT_THAT(setup.calls, Not(Contains("SaveCatalog")));
}

TEST_F(SetupTest, EveryDestinationIsMadeWithItsNames) {
  CatalogHooks const hooks;
  Destination const port = setup.MakePort("Port");
  ASSERT_NE(ImplOf(port)->GetNames(), nullptr);
  ImplOf(port)->RenewNames();
  EXPECT_EQ(hooks.counts->renewals, 1);
}

class FailingNames : public CountingNames {
 public:
  using CountingNames::CountingNames;
  void SaveEditedBanks() override {
    CountingNames::SaveEditedBanks();
    FailOSErr(-34);  // the disk is full
  }
};

TEST_F(SetupTest, AFailingSaveStopsNeitherTheOthersNorTheRoundsNorSignOut) {
  auto const counts = std::make_shared<CountingNames::Counts>();
  setup.SignIn("host", &receiver, &prefs);
  ImplOf(setup.MakePort("Full"))->SetNames(std::make_unique<FailingNames>(counts));
  MakePortWithNames(counts);
  EXPECT_THROW(setup.SaveEditedDestBanks(), VantorError);
  EXPECT_EQ(counts->saves, 2);
  for (int round = 0; round < 30; ++round) {
    ASSERT_NO_THROW(setup.PollSetupChanges());
  }
  EXPECT_EQ(counts->saves, 4);
  EXPECT_NO_THROW(setup.SignOut(false));
  EXPECT_FALSE(setup.IsSignedIn());
}

TEST_F(SetupTest, ASecondSignInChangesNothing) {
  setup.SignIn("host", &receiver, &prefs);
  EXPECT_EQ(setup.SignIn("other", nullptr, nullptr), Setup::kSignInAlreadySignedIn);
  EXPECT_EQ(setup.SignInName(), UString("host"));
  EXPECT_EQ(setup.GetReceiver(), &receiver);
  EXPECT_EQ(setup.GetPrefsHandler(), &prefs);
  EXPECT_EQ(listener.setupChanges, 1);
}

TEST_F(SetupTest, AFailedSignInStoresWhoAskedAndLoadsNothing) {
  for (int const result : {10, 12, 13}) {
    setup.calls.clear();
    setup.signInResult = result;
    EXPECT_EQ(setup.SignIn("host", &receiver, &prefs), result);
    EXPECT_THAT(setup.calls, ElementsAre("SignIn"));
    EXPECT_EQ(listener.setupChanges, 0);
    EXPECT_EQ(setup.SignInName(), UString("host"));
    EXPECT_EQ(setup.GetReceiver(), &receiver);
    EXPECT_NE(setup.GetNameFileStore(), nullptr);
  }
  setup.signInResult = 0;
  EXPECT_EQ(setup.SignIn("host", &receiver, &prefs), Setup::kSignInOK);
}

TEST_F(SetupTest, AFailedSignInNeverOverwritesWhatIsSaved) {
  prefs.blocks[0] = {1, 2, 3};
  setup.signInResult = 10;
  setup.SignIn("host", &receiver, &prefs);
  setup.SignOut(false);
  EXPECT_THAT(prefs.blocks[0], ElementsAre(1, 2, 3));
}

TEST_F(SetupTest, SignOutWithoutSavingDoesNotWriteTheStudio) {
  setup.SignIn("host", &receiver, &prefs);
  setup.SignOut(false);
  EXPECT_THAT(setup.calls, Not(Contains("SaveDevices")));
  EXPECT_EQ(setup.GetNameFileStore(), nullptr);
}

TEST_F(SetupTest, SignOutSavesBeforeTheListsEmpty) {
  setup.SignIn("host", &receiver, &prefs);
  Device const device = setup.CreateDevice("Synth");
  Source const hidden = setup.MakeSource("H", EndpointKind::Bare(true, true));
  Destination const hiddenToo = setup.MakeDestination("H", EndpointKind::Bare(true, true));
  int devices = 0;
  int saves = 0;
  Counts const counts = std::make_shared<CountingNames::Counts>();
  MakePortWithNames(counts);
  setup.onSaveDevices = [&] {
    devices = setup.CountDevices();
    saves = counts->saves;
  };
  setup.calls.clear();
  setup.SignOut(true);
  EXPECT_EQ(devices, 1);
  EXPECT_EQ(saves, 1);
  EXPECT_THAT(setup.calls, ElementsAre("SaveDevices", "SignOut"));
  EXPECT_EQ(setup.CountDevices() + setup.CountEntities() + setup.CountSources() +
                setup.CountDestinations() + setup.CountPrivateSources() +
                setup.CountPrivateDestinations(),
            0);
  EXPECT_FALSE(device.Exists() || hidden.Exists() || hiddenToo.Exists());
  EXPECT_EQ(setup.GetReceiver(), nullptr);
  EXPECT_EQ(setup.SignInName(), UString("host"));
  EXPECT_EQ(setup.GetPrefsHandler(), &prefs);
  EXPECT_EQ(setup.GetListener(), &listener);
}

TEST_F(SetupTest, EverythingIsHarmlessWhileSignedOutAndWithoutPrefs) {
  setup.SignOut(true);
  setup.Poll();
  setup.PollSetupChanges();
  setup.Panic();
  EXPECT_EQ(setup.SignIn("host", nullptr, nullptr), Setup::kSignInOK);
  setup.SignOut(true);
  EXPECT_TRUE(prefs.blocks.empty());
}

TEST_F(SetupTest, TheIntervalsAreOneAndTwoSeconds) {
  EXPECT_EQ(setup.PollInterval(), 1.0);
  EXPECT_EQ(setup.PollSetupChangesInterval(), 2.0);
}

TEST_F(SetupTest, SuspendAndResumeChangeNothing) {
  Destination const port = setup.MakePort("Port");
  setup.Suspend();
  EXPECT_TRUE(port.IsOnline());
  setup.changed = true;
  setup.PollSetupChanges();
  setup.Poll();
  EXPECT_EQ(listener.setupChanges, 1);
  setup.Resume();
  EXPECT_THAT(setup.calls, ElementsAre("PollSetupChanges", "PollImpl"));
}

TEST_F(SetupTest, ARoundWithoutNewsTellsNobody) {
  setup.PollSetupChanges();
  EXPECT_EQ(listener.setupChanges, 0);
  setup.changed = true;
  setup.PollSetupChanges();
  setup.PollSetupChanges();
  EXPECT_EQ(listener.setupChanges, 1);
}

TEST_F(SetupTest, EveryThirtiethRoundSavesEditedBanksAlsoWithoutAListener) {
  Counts const counts = std::make_shared<CountingNames::Counts>();
  Counts const privateCounts = std::make_shared<CountingNames::Counts>();
  MakePortWithNames(counts);
  MakePortWithNames(privateCounts, true);
  setup.SetListener(nullptr);
  while (counts->saves == 0) {  // to a known place in the count
    setup.PollSetupChanges();
  }
  for (int round = 1; round < 30; ++round) {
    setup.changed = true;
    setup.PollSetupChanges();
    EXPECT_FALSE(setup.changed);
    ASSERT_EQ(counts->saves, 1) << round;
  }
  setup.PollSetupChanges();
  EXPECT_EQ(counts->saves, 2);
  EXPECT_EQ(privateCounts->saves, counts->saves);
}

TEST_F(SetupTest, ADeferralMovesTheSavingOfBanks) {
  Counts const counts = std::make_shared<CountingNames::Counts>();
  MakePortWithNames(counts);
  while (counts->saves == 0) {
    setup.PollSetupChanges();
  }
  for (int round = 1; round < 29; ++round) {
    setup.PollSetupChanges();
  }
  {
    WithSetupChangesCompleteAndDeferred const deferred;  // the 29th round
    for (int i = 0; i < 5; ++i) {
      setup.PollSetupChanges();
    }
    EXPECT_EQ(counts->saves, 1);
  }
  setup.PollSetupChanges();
  EXPECT_EQ(counts->saves, 2);
}

TEST_F(SetupTest, ADeferralLetsPendingChangesLandFirst) {
  setup.changed = true;
  {
    WithSetupChangesCompleteAndDeferred const deferred;
    EXPECT_EQ(listener.setupChanges, 1);
    setup.changed = true;
    setup.PollSetupChanges();
    EXPECT_EQ(listener.setupChanges, 1);
  }
  setup.PollSetupChanges();
  EXPECT_EQ(listener.setupChanges, 2);
}

// The scopes are not counted. Hosts nest them by accident, and the studio must not stand still.
TEST_F(SetupTest, TheInnerOfTwoDeferralsEndsBoth) {
  WithSetupChangesCompleteAndDeferred const outer;
  { WithSetupChangesCompleteAndDeferred const inner; }
  setup.changed = true;
  setup.PollSetupChanges();
  EXPECT_EQ(listener.setupChanges, 1);
}

TEST_F(SetupTest, APatchChangeIsToldForWhatHangsOnThePortAndLastForThePort) {
  Destination const port = setup.MakePort("Port");
  Destination const one = setup.MakeInstrument("One");
  Destination const two = setup.MakeInstrument("Two");
  port.AddConnectedDestination(one);
  port.AddConnectedDestination(two);
  ChangePatch(port, 0);
  ChangePatch(port, 9);
  setup.Poll();
  using Patch = RecordingListener::Patch;
  EXPECT_THAT(listener.patches,
              ElementsAre(Patch(one, 0x0201), Patch(two, 0x0201), Patch(port, 0x0201)));
  setup.Poll();
  EXPECT_EQ(listener.patches.size(), 3U);
  EXPECT_THAT(setup.calls, ElementsAre("PollImpl", "PollImpl"));
}

TEST_F(SetupTest, APatchChangeThatNobodyHeardIsGone) {
  Destination const port = setup.MakePort("Port");
  ChangePatch(port, 0);
  setup.SetListener(nullptr);
  setup.Poll();
  setup.SetListener(&listener);
  setup.Poll();
  EXPECT_THAT(listener.patches, IsEmpty());
}

TEST_F(SetupTest, PatchChangesOfPrivateDestinationsAreDropped) {
  Destination const hidden = setup.MakeDestination("H", EndpointKind::Bare(true, true));
  ChangePatch(hidden, 0);
  setup.Poll();
  EXPECT_THAT(listener.patches, IsEmpty());
  EXPECT_EQ(ImplOf(hidden)->TakeChangedChannels(), 0);
}

TEST_F(SetupTest, OnlyADirectDestinationFollowsPatches) {
  EXPECT_EQ(ImplOf(setup.MakeInstrument("Synth"))->GetChannelState().get(), nullptr);
  EXPECT_EQ(ImplOf(setup.GetDestination(0))->TakeChangedChannels(), 0);
}

TEST_F(SetupTest, AListenerMayDeleteAndCreateInACallback) {
  Destination const first = setup.MakePort("First");
  Destination const second = setup.MakePort("Second");
  Destination const synth = setup.MakeInstrument("Synth");
  first.AddConnectedDestination(synth);
  ChangePatch(first, 0);
  ChangePatch(second, 0);
  listener.onPatchChanged = [&] {
    setup.RemoveDestination(ImplOf(second));
    setup.DeleteDevice(synth.GetEntity().GetDevice());
    setup.MakePort("New");
  };
  setup.Poll();
  using Patch = RecordingListener::Patch;
  EXPECT_THAT(listener.patches, ElementsAre(Patch(synth, 1), Patch(first, 1)));
}

TEST_F(SetupTest, PanicSilencesEachChannelOfEachPublicPortThatIsOnline) {
  Destination const port = setup.MakePort("Port");
  Destination const offline = setup.MakePort("Offline");
  TestSetup::SetInt(offline, "offline", 1);
  Destination const hidden = setup.MakeDestination("H", EndpointKind::Bare(true, true));
  Destination const synth = setup.MakeInstrument("Synth");
  port.AddConnectedDestination(synth);
  setup.Panic();
  SentLog const& sent = *TestSetup::PeerOf(port).sent;
  ASSERT_EQ(sent.packets.size(), 32U);
  for (unsigned channel = 0; channel < 16; ++channel) {
    auto const status = static_cast<unsigned char>(0xB0 + channel);
    EXPECT_THAT(sent.packets[2 * channel].bytes, ElementsAre(status, 120, 0));
    EXPECT_THAT(sent.packets[2 * channel + 1].bytes, ElementsAre(status, 64, 0));
    EXPECT_EQ(sent.packets[2 * channel].clocks, 0U);
  }
  EXPECT_EQ(sent.flushes, 1);
  EXPECT_EQ(sent.sendersAlive, 0);
  for (Destination const& silent : {offline, hidden, synth}) {
    EXPECT_THAT(TestSetup::PeerOf(silent).sent->packets, IsEmpty());
  }
}

TEST_F(SetupTest, PanicWithoutPortsStillReachesTheBackend) {
  setup.Panic();
  EXPECT_THAT(setup.calls, ElementsAre("Panic"));
}

TEST_F(SetupTest, PanicPassesOverPortsThatCannotSend) {
  Destination const closed = setup.MakePort("Closed");
  TestSetup::PeerOf(closed).canSend = false;
  Destination const none = setup.MakePort("None");
  TestSetup::PeerOf(none).makesSenders = false;
  setup.Panic();
  EXPECT_THAT(TestSetup::PeerOf(closed).sent->packets, IsEmpty());
  EXPECT_EQ(TestSetup::PeerOf(closed).sent->flushes, 0);
}

TEST_F(SetupTest, NamesAreRenewedWhenWhatTheyFollowFromChanges) {
  Counts const counts = std::make_shared<CountingNames::Counts>();
  Destination const port = MakePortWithNames(counts);
  for (char const* key : {"manufacturer", "model", "nameConfiguration", "supports General MIDI"}) {
    listener.names.clear();
    TestSetup::PeerOf(port).SetInt(key, 1);
    setup.PollSetupChanges();
    EXPECT_THAT(listener.names, ElementsAre(RecordingListener::Patch(port, 65535))) << key;
  }
  EXPECT_EQ(counts->renewals, 4);
  port.SetRawName("Other");
  setup.PollSetupChanges();
  EXPECT_EQ(counts->renewals, 4);
  counts->changes = false;
  listener.names.clear();
  port.SetModel("Other");
  setup.PollSetupChanges();
  EXPECT_EQ(counts->renewals, 5);
  EXPECT_THAT(listener.names, IsEmpty());
}

TEST_F(SetupTest, TheNamesHearThatTheirDestinationGoes) {
  Counts const counts = std::make_shared<CountingNames::Counts>();
  Destination const port = MakePortWithNames(counts);
  setup.RemoveDestination(ImplOf(port));
  EXPECT_EQ(counts->removals, 1);
}

TEST_F(SetupTest, TheListsGiveNullHandlesOutOfRange) {
  setup.CreateDevice("Synth");
  setup.MakeSource("H", EndpointKind::Bare(true, true));
  setup.MakeDestination("H", EndpointKind::Bare(true, true));
  EXPECT_TRUE(setup.GetDevice(0).Exists());
  EXPECT_TRUE(setup.GetEntity(0).Exists());
  EXPECT_TRUE(setup.GetSource(0).Exists());
  EXPECT_TRUE(setup.GetDestination(0).Exists());
  EXPECT_TRUE(setup.GetPrivateSource(0).Exists());
  EXPECT_TRUE(setup.GetPrivateDestination(0).Exists());
  for (int const index : {-1, 1, 2147483647}) {
    EXPECT_TRUE(setup.GetDevice(index) == Device());
    EXPECT_TRUE(setup.GetEntity(index) == Entity());
    EXPECT_TRUE(setup.GetSource(index) == Source());
    EXPECT_TRUE(setup.GetDestination(index) == Destination());
    EXPECT_TRUE(setup.GetPrivateSource(index) == Source());
    EXPECT_TRUE(setup.GetPrivateDestination(index) == Destination());
  }
}

}  // namespace
}  // namespace Ostinet::Testing

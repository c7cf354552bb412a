// SPDX-License-Identifier: MIT
#include "names/NamedStudioTest.h"
#include "ostinet/core/Error.h"

namespace Ostinet::Testing {
namespace {

using Impl::ImplOf;
using Impl::NameConfiguration;
using Impl::PropertyDict;
using Impl::PropertyPath;
using ::testing::ElementsAre;
using ::testing::IsEmpty;

namespace Keys = Impl::Keys;

class DestinationNamesTest : public NamedStudioTest {
 protected:
  FileSpecification FileOf(char const* path) const {
    return FileSpecification(Impl::FromPath(folders.PathOf(path)));
  }
  static UString SavedMaster(Destination const& destination) {
    return ImplOf(destination)->GetString(Keys::kSavedMasterNameFile);
  }
  /// The choice of a user in an earlier session.
  static void StoreMaster(Destination const& destination, FileSpecification const& file) {
    PropertyDict dict = DictOf(destination);
    dict.entries["master"] = PropertyPath{file.GetFullPath()};
    SetDict(destination, dict);
  }
  File WriteTwo() const {
    return folders.Write(
        "user/Two.midnam",
        NameDocument(Master("Acme", "Two",
                            ModeWith("Other", "Set") + NameSetWith("Set", {"Preset", "Only"}))));
  }
};

TEST_F(DestinationNamesTest, AreTheDefaultOnesForADeviceThatNobodyKnows) {
  Destination const destination = MakeNamed();
  EXPECT_EQ(KindOf(destination), NameConfiguration::kDefaultNames);
  EXPECT_EQ(destination.CountModes(), 1);
  EXPECT_TRUE(destination.GetMode(0).IsStandardMode());
  EXPECT_EQ(destination.GetNames(),
            Names(Names::kStandardModeNames, FileOf("system/Standard.midnam"), "Default Names"));
  EXPECT_TRUE(DictOf(destination).entries.empty());
}

TEST_F(DestinationNamesTest, AreThoseOfTheMasterDocumentOfItsModel) {
  Destination const destination = MakeOne();
  EXPECT_EQ(KindOf(destination), NameConfiguration::kAutomaticMaster);
  EXPECT_EQ(destination.GetNames(), Names(Names::kMasterNames, FileOf("user/One.midnam")));
  EXPECT_EQ(destination.CountModes(), 2);
  EXPECT_EQ(destination.CountNameSets(), 2);
  EXPECT_EQ(destination.GetCurrentMode().GetName(), UString("Normal"));
  EXPECT_EQ(destination.GetCurrentNameSet(15).GetName(), UString("Main"));
  EXPECT_EQ(SavedMaster(destination), FileOf("user/One.midnam").GetFullPath());
  EXPECT_EQ(boost::get<PropertyPath>(DictOf(destination).entries.at("master")).path,
            FileOf("user/One.midnam").GetFullPath());
}

TEST_F(DestinationNamesTest, BecomeGeneralMIDIWhereThatIsSupported) {
  Destination const destination = MakeNamed();
  destination.SetSupportsGeneralMIDI(true);
  EXPECT_TRUE(Renew(destination));
  EXPECT_EQ(KindOf(destination), NameConfiguration::kGeneralMIDI);
  EXPECT_EQ(destination.GetNames(),
            Names(Names::kStandardModeNames, FileOf("system/Standard.midnam"), "General MIDI"));
  EXPECT_EQ(BankOf(destination).GetPatch(0).GetName(), UString("GM 1"));
}

TEST_F(DestinationNamesTest, ChangeAtTheNextRoundAfterAPropertyDid) {
  Destination const destination = MakeNamed();
  destination.SetManufacturer("Acme");
  destination.SetModel("One");
  EXPECT_EQ(destination.CountModes(), 1);
  listener.names.clear();
  setup.PollSetupChanges();
  EXPECT_EQ(destination.CountModes(), 2);
  EXPECT_THAT(listener.names, ElementsAre(RecordingListener::Patch(destination, 65535)));
  // What the round stored is no change of its own.
  setup.PollSetupChanges();
  setup.PollSetupChanges();
  EXPECT_EQ(listener.names.size(), 1U);
}

TEST_F(DestinationNamesTest, StayWhereTheyAreOnAPortOnWhichThingsHang) {
  Entity const entity = setup.MakeEntity(setup.MakeDevice("Interface", true), "Port", 0, 1);
  Destination const port = entity.GetDestination(0);
  port.AddConnectedDestination(setup.MakeInstrument("Synth"));
  EXPECT_FALSE(Renew(port));
  EXPECT_EQ(KindOf(port), NameConfiguration::kNoConfiguration);
  EXPECT_FALSE(port.GetNames().Exists());
  port.RemoveConnectedDestination(port.GetConnectedDestination(0));
  EXPECT_TRUE(Renew(port));
}

TEST_F(DestinationNamesTest, AChosenMasterStaysWhenTheModelChanges) {
  File const two = WriteTwo();
  Destination const destination = MakeNamed();
  StoreMaster(destination, two);
  destination.SetManufacturer("Acme");
  destination.SetModel("One");
  EXPECT_TRUE(Renew(destination));
  EXPECT_EQ(KindOf(destination), NameConfiguration::kChosenMaster);
  EXPECT_EQ(destination.GetNames().GetFile(), two);
}

TEST_F(DestinationNamesTest, AnAutomaticMasterIsLookedForAnewAndLosesItsOverrides) {
  File const two = WriteTwo();
  File const extra = folders.Write("user/Extra.midnam",
                                   NameDocument(Extender("Acme", "One", ListOf("list", "Mine"))));
  Destination const destination = MakeOne();
  destination.SetOverrideNames(BankOf(destination), Names(Names::kOverrideNames, extra, "list"));
  ASSERT_EQ(ConfigurationOf(destination).overrides.size(), 1U);
  folders.PassSeconds(60);
  destination.SetModel("Two");
  EXPECT_TRUE(Renew(destination));
  EXPECT_EQ(destination.GetNames().GetFile(), two);
  EXPECT_TRUE(ConfigurationOf(destination).overrides.empty());
  EXPECT_EQ(DictOf(destination).entries.count("banks"), 0U);

  destination.SetModel("Unknown");
  EXPECT_TRUE(Renew(destination));
  EXPECT_EQ(KindOf(destination), NameConfiguration::kDefaultNames);
  EXPECT_EQ(DictOf(destination).entries.count("master"), 0U);
  EXPECT_EQ(SavedMaster(destination), UString());
}

TEST_F(DestinationNamesTest, AMasterIsAutomaticIfItIsTheOneThatTheLibrarySaved) {
  File const two = WriteTwo();
  Destination const destination = MakeNamed();
  StoreMaster(destination, two);
  TestSetup::PeerOf(destination).SetString(Keys::kSavedMasterNameFile, two.GetFullPath());
  Renew(destination);
  EXPECT_EQ(KindOf(destination), NameConfiguration::kAutomaticMaster);
  TestSetup::PeerOf(destination).SetString(Keys::kSavedMasterNameFile, "elsewhere");
  EXPECT_TRUE(Renew(destination));
  EXPECT_EQ(KindOf(destination), NameConfiguration::kChosenMaster);
  // Some files have it as a path.
  TestSetup::PeerOf(destination).SetFile(Keys::kSavedMasterNameFile, two.GetFullPath());
  Renew(destination);
  EXPECT_EQ(KindOf(destination), NameConfiguration::kAutomaticMaster);
}

TEST_F(DestinationNamesTest, ATouchedDocumentIsReadAgain) {
  Destination const destination = MakeOne();
  EXPECT_EQ(destination.GetMode(0).GetName(), UString("Normal"));
  EXPECT_FALSE(Renew(destination));
  folders.Write("user/One.midnam", OneDocument("Changed"));
  folders.Touch("user/One.midnam");
  EXPECT_TRUE(Renew(destination));
  EXPECT_EQ(destination.GetMode(0).GetName(), UString("Changed"));
}

// The documents are replaced by others of the same date: who opens one, shows it.
TEST_F(DestinationNamesTest, ARenewalThatChangesNothingOpensNoFile) {
  Destination const destination = MakeOne();
  EXPECT_EQ(destination.GetMode(0).GetName(), UString("Normal"));
  for (char const* path : {"user/One.midnam", "system/Standard.midnam"}) {
    auto const date = std::filesystem::last_write_time(folders.PathOf(path));
    folders.Write(path, OneDocument("Changed"));
    std::filesystem::last_write_time(folders.PathOf(path), date);
  }
  int const parsed = Impl::NamesCatalogImpl::Instance().CountParsed();
  for (int i = 0; i < 3; ++i) {
    EXPECT_FALSE(Renew(destination));
  }
  EXPECT_EQ(Impl::NamesCatalogImpl::Instance().CountParsed(), parsed);
  EXPECT_EQ(destination.GetMode(0).GetName(), UString("Normal"));
}

TEST_F(DestinationNamesTest, AreReadWhenSomebodyFirstLooks) {
  Destination const destination = MakeOne();
  folders.Write("user/One.midnam", OneDocument("Looked at"));
  EXPECT_EQ(destination.GetMode(0).GetName(), UString("Looked at"));
  folders.Write("user/One.midnam", OneDocument("Later"));
  EXPECT_EQ(destination.GetMode(0).GetName(), UString("Looked at"));
}

TEST_F(DestinationNamesTest, AMasterThatIsGoneStaysChosenWithoutNames) {
  Destination const destination = MakeNamed();
  StoreMaster(destination, FileSpecification(UString("/nowhere/Gone.midnam")));
  EXPECT_TRUE(Renew(destination));
  EXPECT_EQ(destination.CountModes(), 0);
  EXPECT_EQ(destination.GetNames().GetName(), UString("Gone"));
}

TEST_F(DestinationNamesTest, ABrokenDocumentGivesWhatStandsBeforeTheFault) {
  std::string const whole = OneDocument();
  folders.Write("user/One.midnam", NameDocument(Master("Acme", "One")));
  NamesCatalog::Instance().FindMaster("Acme", "One");
  folders.Write("user/One.midnam", whole.substr(0, whole.find("'User'")));
  Destination const destination = MakeNamed();
  StoreMaster(destination, FileOf("user/One.midnam"));
  destination.SetManufacturer("Acme");
  destination.SetModel("One");
  EXPECT_TRUE(Renew(destination));
  EXPECT_EQ(destination.CountModes(), 2);
  EXPECT_EQ(BankOf(destination).GetBankName(), UString("Preset"));
}

TEST_F(DestinationNamesTest, WithoutADocumentOfTheDefaultNamesThereAreNone) {
  folders.Remove("system/Standard.midnam");
  Destination const destination = MakeNamed();
  EXPECT_EQ(KindOf(destination), NameConfiguration::kDefaultNames);
  EXPECT_EQ(destination.CountModes(), 0);
  EXPECT_FALSE(destination.GetNames().Exists());
}

TEST_F(DestinationNamesTest, AMasterBringsTheStandardModesThatItSupports) {
  folders.Write(
      "user/Two.midnam",
      NameDocument(Master("Acme", "Two",
                          "<SupportsStandardDeviceMode Name='General MIDI'/>" +
                              ModeWith("Own", "Own set") + NameSetWith("Own set", {"Own bank"}))));
  Destination const destination = MakeNamed("Acme", "Two");
  ASSERT_EQ(destination.CountModes(), 2);
  EXPECT_EQ(destination.GetMode(0).GetName(), UString("Own"));
  EXPECT_EQ(destination.GetMode(1).GetName(), UString("General MIDI"));
  EXPECT_EQ(destination.GetMode(1).GetNameSet(0).GetBank(0).GetPatch(1).GetName(), UString("GM 2"));
}

// What a session left behind, of which the document has something else by now.
TEST_F(DestinationNamesTest, AStoredModeThatIsGoneLeavesNone) {
  Destination const destination = MakeNamed("Acme", "One");
  PropertyDict dict = DictOf(destination);
  dict.entries["currentDeviceMode"] = UString("gone");
  SetDict(destination, dict);
  folders.Touch("user/One.midnam");
  EXPECT_TRUE(Renew(destination));
  EXPECT_EQ(destination.GetCurrentMode(), DestinationMode::kNoDestinationMode);
  // Without stored name sets the channels have those of the first mode, current or not.
  EXPECT_EQ(destination.GetCurrentNameSet(3).GetName(), UString("Main"));
}

TEST_F(DestinationNamesTest, TheStoredSelectionComesBack) {
  Destination const destination = MakeOne();
  destination.SendModeChange(destination.GetMode(1));
  EXPECT_EQ(destination.GetCurrentNameSet(0).GetName(), UString("Drums"));
  EXPECT_EQ(DictOf(destination).entries.count("master"), 1U);
  folders.Touch("user/One.midnam");
  EXPECT_TRUE(Renew(destination));
  EXPECT_EQ(destination.GetCurrentMode().GetName(), UString("Multi"));
  EXPECT_EQ(destination.GetCurrentNameSet(0).GetName(), UString("Drums"));
}

TEST_F(DestinationNamesTest, AStoredSelectionIsAppliedToTheNamesAtHand) {
  Destination const destination = MakeOne();
  DestinationMode const multi = destination.GetMode(1);
  PropertyDict dict = DictOf(destination);
  dict.entries["currentDeviceMode"] = UString("MUL ti");  // case and blanks do not count
  dict.entries["currentChannelNameSets"] = std::vector<UString>{"drums", "gone"};
  SetDict(destination, dict);
  EXPECT_TRUE(Renew(destination));
  EXPECT_EQ(destination.GetCurrentMode(), multi);
  EXPECT_EQ(destination.GetCurrentNameSet(0).GetName(), UString("Drums"));
  EXPECT_EQ(destination.GetCurrentNameSet(1).GetName(), UString("Main"));
  EXPECT_FALSE(Renew(destination));
}

TEST_F(DestinationNamesTest, AStoredSelectionOfMoreThan16ChannelsIsCutOff) {
  Destination const destination = MakeOne();
  PropertyDict dict = DictOf(destination);
  dict.entries["currentChannelNameSets"] = std::vector<UString>(20, "Drums");
  SetDict(destination, dict);
  ASSERT_EQ(destination.GetCurrentNameSet(15).GetName(), UString("Drums"));
  EXPECT_EQ(destination.GetCurrentNameSet(16), DestinationNameSet::kNoDestinationNameSet);
}

TEST_F(DestinationNamesTest, OldHandlesAnswerFromTheOldTree) {
  Destination const destination = MakeOne();
  PatchBank const bank = BankOf(destination);
  DestinationMode const mode = destination.GetMode(0);
  folders.Touch("user/One.midnam");
  Renew(destination);
  EXPECT_NE(BankOf(destination), bank);
  EXPECT_EQ(bank.CountPatches(), 2);
  EXPECT_EQ(mode.GetName(), UString("Normal"));
  EXPECT_EQ(mode.GetDestination(), Destination::kNoDestination);
}

TEST_F(DestinationNamesTest, HandlesOfADestinationThatIsGoneKnowNoDestination) {
  Destination destination = MakeOne();
  PatchBank const bank = BankOf(destination);
  DestinationMode const mode = destination.GetMode(0);
  setup.RemoveDestination(ImplOf(destination));
  EXPECT_EQ(mode.GetDestination(), Destination::kNoDestination);
  destination = MakeOne();
  PatchBank const second = BankOf(destination);
  destination = Destination();
  setup.SignOut(false);
  listener.names.clear();
  EXPECT_EQ(second.GetNameSet().GetDestination(), Destination::kNoDestination);
  EXPECT_EQ(bank.CountPatches(), 2);
  // Nobody hears of an edit any more.
  EditNote(second, "Bell");
}

TEST_F(DestinationNamesTest, ChannelsOutOfRangeHaveNone) {
  Destination const destination = MakeOne();
  for (short const channel : std::initializer_list<short>{-1, 16, 1000}) {
    EXPECT_EQ(destination.GetCurrentNameSet(channel), DestinationNameSet::kNoDestinationNameSet);
    EXPECT_EQ(destination.GetCurrentPatch(channel), Patch::kNoPatch);
  }
}

TEST_F(DestinationNamesTest, AnExactPatchIsFoundInTheNameSetOfItsChannel) {
  Destination const destination = MakeOne();
  EXPECT_EQ(destination.GetPatch(4, PatchNumbers(1, 1, 1)).GetName(), UString("User 2"));
  EXPECT_EQ(destination.GetPatch(4, PatchNumbers(1, 9, 9)), Patch::kNoPatch);
}

class PlayingPatchTest : public NamedStudioTest {
 protected:
  PlayingPatchTest() { port.AddConnectedDestination(synth); }
  UString Playing(short channel = 0) const { return synth.GetCurrentPatch(channel).GetName(); }

  Destination const port = setup.MakePort("Port");
  Destination const synth = MakeOne();
};

TEST_F(PlayingPatchTest, ABankCountsFromTheNextProgramChange) {
  Sent(port, {0xB0, 0, 0});
  Sent(port, {0xB0, 32, 1});
  Sent(port, {0xC0, 1});
  EXPECT_EQ(Playing(), UString("Preset 2"));
  EXPECT_EQ(synth.GetCurrentBank(0).GetBankName(), UString("Preset"));
  Sent(port, {0xB0, 0, 1});
  EXPECT_EQ(Playing(), UString("Preset 2"));
  Sent(port, {0xC0, 0});
  EXPECT_EQ(Playing(), UString("User 1"));
}

TEST_F(PlayingPatchTest, RunningStatusIsNotFollowed) {
  Sent(port, {0xB0, 32, 1});
  Sent(port, {0xB0, 0, 0, 0, 1});
  Sent(port, {0xC0, 0});
  EXPECT_EQ(Playing(), UString("Preset 1"));
}

TEST_F(PlayingPatchTest, IsThatOfThePortForWhatHangsOnIt) {
  Sent(port, {0xC2, 1});
  EXPECT_EQ(Playing(2), UString("Preset 2"));
  EXPECT_EQ(Playing(0), UString());
  port.RemoveConnectedDestination(synth);
  EXPECT_EQ(Playing(2), UString());
}

class ChosenNamesTest : public DestinationNamesTest {};

TEST_F(ChosenNamesTest, AMasterOfTheHostsChoiceIsSetByTheLibrary) {
  File const two = WriteTwo();
  Destination const destination = MakeOne();
  listener.names.clear();
  destination.SetNames(Names(Names::kMasterNames, two));
  EXPECT_EQ(KindOf(destination), NameConfiguration::kAutomaticMaster);
  EXPECT_EQ(SavedMaster(destination), two.GetFullPath());
  EXPECT_THAT(listener.names, ElementsAre(RecordingListener::Patch(destination, 65535)));
  EXPECT_FALSE(Renew(destination));
  EXPECT_EQ(destination.GetNames(), Names(Names::kMasterNames, two));
}

TEST_F(ChosenNamesTest, AStandardModeIsPointedAtByADocumentOfOurs) {
  Destination const destination = MakeOne();
  destination.SetNames(Names(Names::kStandardModeNames, FileSpecification(), "General MIDI"));
  EXPECT_EQ(KindOf(destination), NameConfiguration::kAutomaticMaster);
  ASSERT_EQ(destination.CountModes(), 1);
  EXPECT_EQ(BankOf(destination).GetPatch(0).GetName(), UString("GM 1"));
  EXPECT_EQ(destination.GetNames(),
            Names(Names::kStandardModeNames, FileOf("system/Standard.midnam"), "General MIDI"));
  FileSpecification const written = ConfigurationOf(destination).masterFile;
  EXPECT_EQ(written, FileSpecification(prefs.FolderPath() + "/MIDINameDocuments/Synth.midnam"));
  destination.SetNames(Names(Names::kMasterNames, FileOf("user/One.midnam")));
  EXPECT_TRUE(written.IsFile());
  setup.SignOut(false);
  EXPECT_FALSE(written.IsFile());
}

// What is no master document points at a standard mode of its name, whatever that is.
TEST_F(ChosenNamesTest, OfNoKindPointAtAModeWithoutAName) {
  Destination const destination = MakeOne();
  listener.names.clear();
  destination.SetNames(Names());
  EXPECT_EQ(KindOf(destination), NameConfiguration::kAutomaticMaster);
  EXPECT_TRUE(ConfigurationOf(destination).masterFile.IsFile());
  EXPECT_EQ(destination.CountModes(), 0);
  EXPECT_EQ(listener.names.size(), 1U);
}

// What was selected is kept by name, and other names have it or not.
TEST_F(ChosenNamesTest, KeepTheStoredSelectionAsFarAsTheyHaveIt) {
  Destination const destination = MakeOne();
  destination.SendModeChange(destination.GetMode(1));
  destination.SetNames(Names(Names::kStandardModeNames, FileSpecification(), "General MIDI"));
  EXPECT_EQ(destination.GetCurrentMode(), DestinationMode::kNoDestinationMode);
  EXPECT_EQ(destination.GetCurrentNameSet(0), DestinationNameSet::kNoDestinationNameSet);
  EXPECT_EQ(boost::get<UString>(DictOf(destination).entries["currentDeviceMode"]),
            UString("Multi"));
  destination.SetNames(Names(Names::kMasterNames, FileOf("user/One.midnam")));
  EXPECT_EQ(destination.GetCurrentMode().GetName(), UString("Multi"));
  EXPECT_EQ(destination.GetCurrentNameSet(15).GetName(), UString("Drums"));
}

TEST_F(ChosenNamesTest, DropEditsThatAreNotSaved) {
  Destination const destination = MakeOne();
  EditNote(BankOf(destination), "Bell");
  destination.SetNames(destination.GetNames());
  setup.SaveEditedDestBanks();
  EXPECT_TRUE(ConfigurationOf(destination).overrides.empty());
  EXPECT_EQ(BankOf(destination).GetPatch(0).GetNoteNames().GetNoteNameForPitch(60), UString());
}

TEST_F(ChosenNamesTest, DoNothingOnADestinationThatIsGone) {
  Destination const destination = MakeOne();
  setup.RemoveDestination(ImplOf(destination));
  listener.names.clear();
  destination.SetNames(Names(Names::kStandardModeNames, FileSpecification(), "General MIDI"));
  EXPECT_THAT(listener.names, IsEmpty());
  EXPECT_EQ(destination.CountModes(), 0);
  EXPECT_FALSE(Renew(destination));
}

TEST_F(ChosenNamesTest, WithoutAFolderOfTheHostNothingChanges) {
  setup.SignOut(false);
  setup.SignIn("host", nullptr, nullptr);
  Destination const destination = MakeOne();
  EXPECT_THROW(
      destination.SetNames(Names(Names::kStandardModeNames, FileSpecification(), "General MIDI")),
      VantorError);
  EXPECT_EQ(destination.GetNames().GetFile(), FileOf("user/One.midnam"));
  EXPECT_EQ(destination.CountModes(), 2);
}

}  // namespace
}  // namespace Ostinet::Testing

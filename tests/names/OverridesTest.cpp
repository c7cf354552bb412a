// SPDX-License-Identifier: MIT
#include "names/NamedStudioTest.h"
#include "ostinet/core/Error.h"

namespace Ostinet::Testing {
namespace {

using Impl::NameConfiguration;
using ::testing::ElementsAre;
using ::testing::IsEmpty;

class OverridesTest : public NamedStudioTest {
 protected:
  /// Lists "first" and "second", of one patch each.
  File WriteLists(char const* path = "user/Lists.midnam") const {
    return folders.Write(
        path,
        NameDocument(Extender("Acme", "One", ListOf("first", "Mine") + ListOf("second", "Yours"))));
  }
  static UString FirstPatch(Destination const& destination, int bank) {
    return BankOf(destination, bank).GetPatch(0).GetName();
  }
  static UString NoteOf(PatchBank const& bank) {
    return bank.GetPatch(0).GetNoteNames().GetNoteNameForPitch(60);
  }
  std::vector<std::string> WrittenDocuments() const {
    std::vector<std::string> names;
    auto const folder = prefs.folder / "MIDINameDocuments";
    if (std::filesystem::exists(folder)) {
      for (auto const& entry : std::filesystem::directory_iterator(folder)) {
        names.push_back(entry.path().filename().string());
      }
    }
    std::sort(names.begin(), names.end());
    return names;
  }
};

TEST_F(OverridesTest, ABankTakesItsPatchesFromAnotherDocument) {
  File const lists = WriteLists();
  Destination const destination = MakeOne();
  PatchBank const bank = BankOf(destination);
  EXPECT_FALSE(destination.GetOverrideNames(bank).Exists());
  listener.names.clear();
  destination.SetOverrideNames(bank, Names(Names::kOverrideNames, lists, "second"));
  EXPECT_THAT(listener.names, ElementsAre(RecordingListener::Patch(destination, 65535)));
  EXPECT_EQ(FirstPatch(destination, 0), UString("Yours"));
  EXPECT_EQ(FirstPatch(destination, 1), UString("User 1"));
  EXPECT_EQ(BankOf(destination).GetName(), UString("second"));
  EXPECT_EQ(destination.GetOverrideNames(BankOf(destination)),
            Names(Names::kOverrideNames, lists, "second"));
  EXPECT_FALSE(Renew(destination));
}

TEST_F(OverridesTest, AreStoredAndReadBack) {
  File const lists = WriteLists();
  Destination const destination = MakeOne();
  destination.SetOverrideNames(BankOf(destination, 0),
                               Names(Names::kOverrideNames, lists, "first"));
  destination.SetOverrideNames(BankOf(destination, 1),
                               Names(Names::kOverrideNames, lists, "second"));
  EXPECT_EQ(NameConfiguration::Read(TestSetup::PeerOf(destination)), ConfigurationOf(destination));
  folders.Touch("user/Lists.midnam");
  EXPECT_TRUE(Renew(destination));
  EXPECT_EQ(FirstPatch(destination, 0), UString("Mine"));
  EXPECT_EQ(FirstPatch(destination, 1), UString("Yours"));
}

// Anything may stand in a user's file.
TEST_F(OverridesTest, EntriesWithoutAFileDoNotCount) {
  File const lists = WriteLists();
  Destination const destination = MakeOne();
  Impl::PropertyDict whole;
  whole.entries["file"] = Impl::PropertyPath{lists.GetFullPath()};
  Impl::PropertyDict withoutFile;
  withoutFile.entries["patchNameList"] = UString("first");
  Impl::PropertyDict banks;
  banks.entries["Preset"] = whole;
  banks.entries["User"] = withoutFile;
  banks.entries["Text"] = UString("first");
  Impl::PropertyDict dict = DictOf(destination);
  dict.entries["banks"] = banks;
  SetDict(destination, dict);
  EXPECT_TRUE(Renew(destination));
  ASSERT_EQ(ConfigurationOf(destination).overrides.size(), 1U);
  EXPECT_EQ(ConfigurationOf(destination).overrides.begin()->first, UString("Preset"));
  EXPECT_EQ(FirstPatch(destination, 0), UString("Preset 1")) << "no list of an empty name is there";
}

TEST_F(OverridesTest, NoNamesTakeTheOverrideAwayAndEmptyTheBank) {
  File const lists = WriteLists();
  Destination const destination = MakeOne();
  destination.SetOverrideNames(BankOf(destination), Names(Names::kOverrideNames, lists, "first"));
  DestinationMode const mode = destination.GetMode(0);
  listener.names.clear();
  destination.SetOverrideNames(BankOf(destination), Names());
  EXPECT_EQ(destination.GetMode(0), mode);
  EXPECT_EQ(BankOf(destination).CountPatches(), 0);
  EXPECT_TRUE(ConfigurationOf(destination).overrides.empty());
  EXPECT_EQ(listener.names.size(), 1U);
  EXPECT_TRUE(lists.IsFile());
}

TEST_F(OverridesTest, ANullBankIsNoBank) {
  Destination const destination = MakeOne();
  listener.names.clear();
  destination.SetOverrideNames(PatchBank(), Names());
  EXPECT_THAT(listener.names, IsEmpty());
  EXPECT_FALSE(destination.GetOverrideNames(PatchBank()).Exists());
}

TEST_F(OverridesTest, OnDefaultNamesTheyStandBesideADocumentOfOurs) {
  File const lists = folders.Write(
      "user/L.midnam", NameDocument("<ExtendingDeviceNames><Device Name='x' UniqueID='" +
                                    std::to_string(MakeNamed().GetUniqueID() + 1) + "'/>" +
                                    ListOf("first", "Mine") + "</ExtendingDeviceNames>"));
  Destination const destination = MakeNamed();
  destination.SetOverrideNames(BankOf(destination), Names(Names::kOverrideNames, lists, "first"));
  EXPECT_EQ(ConfigurationOf(destination).kind, NameConfiguration::kAutomaticMaster);
  EXPECT_THAT(WrittenDocuments(), ElementsAre("Synth.midnam"));
  EXPECT_EQ(FirstPatch(destination, 0), UString("Mine"));
}

TEST_F(OverridesTest, AnEditedNoteIsFoundAgain) {
  Destination const destination = MakeOne();
  EditNote(BankOf(destination, 1), "Bell");
  setup.SaveEditedDestBanks();
  EXPECT_THAT(WrittenDocuments(), ElementsAre("Synth.midnam"));
  EXPECT_EQ(ConfigurationOf(destination).overrides.count("User"), 1U);
  folders.Touch("user/One.midnam");
  EXPECT_TRUE(Renew(destination));
  EXPECT_EQ(NoteOf(BankOf(destination, 1)), UString("Bell"));
  EXPECT_EQ(destination.GetOverrideNames(BankOf(destination, 1)).GetType(),
            Names::kEditedOverrideNames);
  EXPECT_EQ(FirstPatch(destination, 1), UString("User 1"));
}

TEST_F(OverridesTest, EditsOfDefaultNamesBringAMasterToo) {
  Destination const destination = MakeNamed();
  EditNote(BankOf(destination), "Bell");
  setup.SaveEditedDestBanks();
  EXPECT_EQ(ConfigurationOf(destination).kind, NameConfiguration::kAutomaticMaster);
  EXPECT_THAT(WrittenDocuments(), ElementsAre("Synth 2.midnam", "Synth.midnam"));
  Impl::PropertyDict dict = DictOf(destination);
  EXPECT_FALSE(Renew(destination));
  EXPECT_EQ(NoteOf(BankOf(destination)), UString("Bell"));
  EXPECT_EQ(destination.GetNames().GetName(), UString("Default Names"));
}

// A patch marks its bank at its first edit after a load only, so each save here needs another one.
TEST_F(OverridesTest, EachSaveReplacesTheDocumentBefore) {
  Destination const destination = MakeOne();
  EditNote(BankOf(destination, 0), "Bell");
  EditNote(BankOf(destination, 1), "Bell");
  setup.SaveEditedDestBanks();
  EditNote(BankOf(destination, 0), "Gong", 1);
  setup.SaveEditedDestBanks();
  EXPECT_THAT(WrittenDocuments(), ElementsAre("Synth 2.midnam", "Synth.midnam"));
  EditNote(BankOf(destination, 1), "Gong", 1);
  setup.SaveEditedDestBanks();
  EXPECT_THAT(WrittenDocuments(), ElementsAre("Synth 2.midnam", "Synth 3.midnam"));
  setup.SaveEditedDestBanks();
  EXPECT_THAT(WrittenDocuments(), ElementsAre("Synth 2.midnam", "Synth 3.midnam"));
}

// Hosts count on a save writing just what they marked: the list of a patch that was edited before
// stays open, and what goes into it later is written with the bank's next mark.
TEST_F(OverridesTest, ASecondEditOfAPatchWaitsForAnotherMarkOfItsBank) {
  Destination const destination = MakeOne();
  EditNote(BankOf(destination), "Bell");
  setup.SaveEditedDestBanks();
  EditNote(BankOf(destination), "Gong");
  setup.SaveEditedDestBanks();
  EXPECT_THAT(WrittenDocuments(), ElementsAre("Synth.midnam"));
  EditNote(BankOf(destination), "Other", 1);
  setup.SaveEditedDestBanks();
  folders.Touch("user/One.midnam");
  Renew(destination);
  EXPECT_EQ(NoteOf(BankOf(destination)), UString("Gong"));
}

TEST_F(OverridesTest, AnOverrideSavesTheEditsOfTheOtherBanksAndDropsItsOwn) {
  File const lists = WriteLists();
  Destination const destination = MakeOne();
  EditNote(BankOf(destination, 0), "Bell");
  EditNote(BankOf(destination, 1), "Gong");
  destination.SetOverrideNames(BankOf(destination, 0),
                               Names(Names::kOverrideNames, lists, "first"));
  EXPECT_EQ(FirstPatch(destination, 0), UString("Mine"));
  EXPECT_EQ(NoteOf(BankOf(destination, 0)), UString());
  EXPECT_EQ(NoteOf(BankOf(destination, 1)), UString("Gong"));
}

// The document is claimed anew before the old claim goes.
TEST_F(OverridesTest, AnOverrideByWhatItAlreadyIsDeletesNothing) {
  Destination const destination = MakeOne();
  EditNote(BankOf(destination), "Bell");
  setup.SaveEditedDestBanks();
  destination.SetOverrideNames(BankOf(destination),
                               destination.GetOverrideNames(BankOf(destination)));
  EXPECT_THAT(WrittenDocuments(), ElementsAre("Synth.midnam"));
  EXPECT_EQ(NoteOf(BankOf(destination)), UString("Bell"));
  destination.SetNames(Names(Names::kStandardModeNames, FileSpecification(), "General MIDI"));
  FileSpecification const master = ConfigurationOf(destination).masterFile;
  destination.SetNames(Names(Names::kMasterNames, master));
  setup.SignOut(false);
  EXPECT_TRUE(master.IsFile());
}

TEST_F(OverridesTest, ASaveThatFailsLeavesConfigurationAndEdits) {
  Destination const destination = MakeNamed();
  EditNote(BankOf(destination), "Bell");
  NameConfiguration const before = ConfigurationOf(destination);
  auto const inTheWay = prefs.folder / "MIDINameDocuments";
  std::ofstream(inTheWay) << "no folder";
  EXPECT_THROW(setup.SaveEditedDestBanks(), VantorError);
  EXPECT_EQ(ConfigurationOf(destination), before);
  EXPECT_NO_THROW(setup.PollSetupChanges());
  std::filesystem::remove(inTheWay);
  setup.SaveEditedDestBanks();
  EXPECT_EQ(ConfigurationOf(destination).overrides.size(), 1U);
}

TEST_F(OverridesTest, OfADestinationThatGoesAreDeletedAtSignOut) {
  Destination const destination = MakeOne();
  EditNote(BankOf(destination), "Bell");
  setup.SaveEditedDestBanks();
  EditNote(BankOf(destination, 1), "Gong");
  setup.RemoveDestination(Impl::ImplOf(destination));
  EXPECT_THAT(WrittenDocuments(), ElementsAre("Synth.midnam"));
  setup.SignOut(false);
  EXPECT_THAT(WrittenDocuments(), IsEmpty());
}

}  // namespace
}  // namespace Ostinet::Testing

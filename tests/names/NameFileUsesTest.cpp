// SPDX-License-Identifier: MIT
//
// Random sequences of choices, edits, sign-ins and sign-outs: no document in use is ever deleted,
// and none that nobody uses is left behind.
#include <random>
#include <set>

#include "model/NameFileStore.h"
#include "names/NamedStudioTest.h"

namespace Ostinet::Testing {
namespace {

using Impl::ImplOf;

using Files = std::set<FileSpecification>;

class NameFileUsesTest : public NamedStudioTest {
 protected:
  NameFileUsesTest() {
    lists = folders.Write("user/Lists.midnam",
                          NameDocument(Extender("Acme", "One", ListOf("first", "Mine"))));
    folders.Write(
        "user/Two.midnam",
        NameDocument(Master("Acme", "Two",
                            ModeWith("Other", "Set") + NameSetWith("Set", {"Preset", "Only"}))));
    setup.onLoad = [this] { LoadStudio(); };
  }

  int Draw(int count) { return std::uniform_int_distribution<int>(0, count - 1)(random); }
  Destination AnyDestination() { return setup.GetDestination(Draw(setup.CountDestinations())); }
  PatchBank AnyBank(Destination const& destination) {
    DestinationNameSet const nameSet = destination.GetNameSet(0);
    return nameSet.CountBanks() > 0 ? nameSet.GetBank(Draw(nameSet.CountBanks())) : PatchBank();
  }

  void AddDestination() {
    setup.MakeDestination("Synth", Impl::EndpointKind::Bare(true, Draw(4) == 0));
  }
  /// What the setup file would bring back.
  void SaveStudio() {
    saved.clear();
    for (auto const* list :
         {&setup.GetStudio().destinations, &setup.GetStudio().privateDestinations}) {
      for (auto const& destination : *list) {
        saved.push_back(static_cast<TestPeer*>(destination->Peer())->OwnProperties());
      }
    }
  }
  void LoadStudio() {
    for (auto const& properties : saved) {
      Destination const destination =
          setup.MakeDestination("Synth", Impl::EndpointKind::Bare(true, false));
      for (auto const& [key, value] : properties) {
        Restore(TestSetup::PeerOf(destination), key, value);
      }
      Renew(destination);
    }
  }
  static void Restore(TestPeer& peer, UString const& key, Impl::PropertyValue const& value) {
    if (auto const* const text = boost::get<UString>(&value)) {
      peer.SetString(key, *text);
    } else if (auto const* const number = boost::get<int>(&value)) {
      peer.SetInt(key, *number);
    } else if (auto const* const dict = boost::get<Impl::PropertyDict>(&value)) {
      peer.SetDict(key, *dict);
    }
  }

  void Choose(Destination const& destination) {
    switch (Draw(4)) {
      case 0:
        return destination.SetNames(Names(Names::kMasterNames, Written("user/Two.midnam")));
      case 1:
        return destination.SetNames(
            Names(Names::kStandardModeNames, FileSpecification(), "General MIDI"));
      case 2:
        return destination.SetNames(destination.GetNames());
      default:  // a document that another destination may use, and that the library may have
                // written
        return destination.SetNames(
            Names(Names::kMasterNames, ConfigurationOf(AnyDestination()).masterFile));
    }
  }
  void Override(Destination const& destination) {
    PatchBank const bank = AnyBank(destination);
    Destination const other = AnyDestination();
    switch (Draw(3)) {
      case 0:
        return destination.SetOverrideNames(bank, Names());
      case 1:
        return destination.SetOverrideNames(bank, Names(Names::kOverrideNames, lists, "first"));
      default:
        return destination.SetOverrideNames(bank, other.GetOverrideNames(AnyBank(other)));
    }
  }
  void Edit(Destination const& destination) {
    PatchBank const bank = AnyBank(destination);
    if (bank.CountPatches() > 0) {
      EditNote(bank, "Bell");
    }
  }
  void ChangeDevice(Destination const& destination) {
    destination.SetManufacturer("Acme");
    destination.SetModel(Draw(2) == 0 ? "One" : "Two");
    destination.SetSupportsGeneralMIDI(Draw(2) == 0);
  }
  void Step() {
    if (setup.CountDestinations() == 0) {
      return AddDestination();
    }
    switch (Draw(12)) {
      case 0:
        return AddDestination();
      case 1:
        return setup.RemoveDestination(ImplOf(AnyDestination()));
      case 2:
        return ChangeDevice(AnyDestination());
      case 3:
        return setup.SaveEditedDestBanks();
      case 4:
        return SignOutAndIn();
      case 5:
      case 6:
        return Choose(AnyDestination());
      case 7:
      case 8:
        return Override(AnyDestination());
      default:
        return Edit(AnyDestination());
    }
  }
  void SignOutAndIn() {
    setup.SaveEditedDestBanks();
    SaveStudio();
    Files const used = Used();
    setup.SignOut(false);
    EXPECT_EQ(InFolder(), used) << "after a sign-out there are those in use and no others";
    NameFolders::PassSeconds(60);
    setup.SignIn("host", nullptr, &prefs);
  }

  FileSpecification Written(char const* path) const {
    return FileSpecification(Impl::FromPath(folders.PathOf(path)));
  }
  /// The documents in the library's own folder.
  Files InFolder() const {
    Files files;
    for (FolderIterator entry(OwnFolder()); !entry.AtEnd(); ++entry) {
      files.insert(*entry);
    }
    return files;
  }
  Folder OwnFolder() const {
    return Folder(FileSpecification(prefs.FolderPath())).DemandSubFolder("MIDINameDocuments");
  }
  /// Those of them that some destination refers to.
  Files Used() {
    Files files;
    for (auto const* list :
         {&setup.GetStudio().destinations, &setup.GetStudio().privateDestinations}) {
      for (auto const& destination : *list) {
        for (FileSpecification const& file : ConfigurationOf(Destination(destination)).GetFiles()) {
          if (Folder(OwnFolder()).GetFile(file.GetName()) == file) {
            files.insert(file);
          }
        }
      }
    }
    return files;
  }

  std::mt19937 random;
  File lists;
  std::vector<Impl::SelfStorageImplImpl::Store> saved;
};

class NameFileUses : public NameFileUsesTest, public ::testing::WithParamInterface<unsigned> {};

TEST_P(NameFileUses, NoneInUseIsDeletedAndNoneUnusedIsLeft) {
  random.seed(GetParam());
  for (int step = 0; step < 60; ++step) {
    Step();
    setup.PollSetupChanges();
    Files const there = InFolder();
    for (FileSpecification const& file : Used()) {
      ASSERT_EQ(there.count(file), 1U)
          << "step " << step << ": " << file.GetFullPath().string() << " is in use";
    }
  }
}

INSTANTIATE_TEST_SUITE_P(Seeds, NameFileUses, ::testing::Range(1U, 13U));

}  // namespace
}  // namespace Ostinet::Testing

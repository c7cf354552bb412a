// SPDX-License-Identifier: MIT
#include <gmock/gmock.h>

#include "names/SmallTree.h"

namespace Ostinet::Testing {
namespace {

using Impl::DestModeImpl;
using Impl::DestNameSetImpl;
using Impl::NameTree;
using Impl::PatchBankImpl;
using Impl::PatchImpl;
using Impl::PatchNameListData;
using ::testing::ElementsAre;

RCPtrMT<DestNameSetImpl> NewNameSet(char const* name) { return new DestNameSetImpl(nullptr, name); }
RCPtrMT<DestModeImpl> NewMode(char const* name) { return new DestModeImpl(nullptr, name, false); }

unsigned Mask(DestNameSetImpl const& nameSet, std::size_t index) {
  return nameSet.GetModes().at(index).second;
}

TEST(Mode, AndItsNameSetsAgree) {
  RCPtrMT<DestNameSetImpl> const a = NewNameSet("A");
  RCPtrMT<DestNameSetImpl> const b = NewNameSet("B");
  RCPtrMT<DestModeImpl> const first = NewMode("1");
  RCPtrMT<DestModeImpl> const second = NewMode("2");
  second->SetNameSet(15, a);
  first->SetNameSet(0, a);
  first->SetNameSet(9, a);
  ASSERT_EQ(a->GetModes().size(), 2u);
  EXPECT_EQ(a->GetModes()[0].first, second.get());
  EXPECT_EQ(Mask(*a, 0), 0x8000u);
  EXPECT_EQ(Mask(*a, 1), 0x0201u);

  first->SetNameSet(9, b);
  EXPECT_EQ(Mask(*a, 1), 0x0001u);
  EXPECT_EQ(Mask(*b, 0), 0x0200u);
  first->SetNameSet(0, nullptr);
  ASSERT_EQ(a->GetModes().size(), 1u);
  EXPECT_EQ(a->GetModes()[0].first, second.get());
}

TEST(Mode, GivenTheSameNameSetTwiceCountsOnce) {
  RCPtrMT<DestNameSetImpl> const a = NewNameSet("A");
  RCPtrMT<DestModeImpl> const mode = NewMode("1");
  mode->SetNameSet(3, a);
  mode->SetNameSet(3, a);
  ASSERT_EQ(a->GetModes().size(), 1u);
  EXPECT_EQ(Mask(*a, 0), 0x0008u);
}

TEST(Mode, TakesItselfOutOfItsNameSetsWhenItGoes) {
  RCPtrMT<DestNameSetImpl> const a = NewNameSet("A");
  {
    RCPtrMT<DestModeImpl> const mode = NewMode("1");
    for (int channel = 0; channel < 16; ++channel) {
      mode->SetNameSet(channel, a);
    }
    EXPECT_EQ(Mask(*a, 0), 0xFFFFu);
  }
  EXPECT_TRUE(a->GetModes().empty());
}

TEST(Mode, KeepsItsNameSets) {
  RCPtrMT<DestModeImpl> const mode = NewMode("1");
  mode->SetNameSet(4, NewNameSet("A"));
  DestinationNameSet const nameSet = DestinationMode(mode).GetNameSet(4);
  EXPECT_EQ(nameSet.GetName(), UString("A"));
  ASSERT_EQ(nameSet.CountModes(), 1);
  EXPECT_EQ(nameSet.GetMode(0).first, DestinationMode(mode));
  EXPECT_EQ(nameSet.GetMode(0).second, 1 << 4);
  EXPECT_FALSE(DestinationMode(mode).GetNameSet(5).Exists());
  EXPECT_FALSE(DestinationMode(mode).GetNameSet(16).Exists());
  EXPECT_FALSE(DestinationMode(mode).GetNameSet(-1).Exists());
}

TEST(Mode, OfNumbersAloneIsSentButNotCalledSelectable) {
  RCPtrMT<DestModeImpl> const mode = NewMode("1");
  Record(mode->EnableCommands(), 1, 2, 3);
  DataBuffer buffer;
  DestinationMode(mode).GetEnablingCommand(buffer, Clocks(5), 0);
  EXPECT_THAT(Packets(buffer), ElementsAre(Bytes{0xB0, 0, 1}, Bytes{0xB0, 32, 2}, Bytes{0xC0, 3}));
  EXPECT_FALSE(DestinationMode(mode).SelectableWithMIDI());
  mode->EnableCommands().AddThreeBytes(0xB0, 7, 0);
  EXPECT_TRUE(DestinationMode(mode).SelectableWithMIDI());
}

TEST(Mode, IsSelectableByADelayAlone) {
  RCPtrMT<DestModeImpl> const mode = NewMode("1");
  mode->EnableCommands().AddDelay(1);
  EXPECT_TRUE(DestinationMode(mode).SelectableWithMIDI());
}

TEST(Mode, SendsItsEndsOnChannelZero) {
  RCPtrMT<DestModeImpl> const mode = NewMode("1");
  mode->DisableCommands().BeginSysex();
  mode->DisableCommands().AddSysexMarker(Impl::SysexByte::kDeviceIDMarker, 1, 1);
  mode->DisableCommands().AddSysexMarker(Impl::SysexByte::kChannelMarker, 1, 1);
  DataBuffer buffer;
  DestinationMode(mode).GetDisablingCommand(buffer, Clocks(5), 255);
  EXPECT_THAT(Packets(buffer), ElementsAre(Bytes{0, 1}));
}

TEST(NameSet, HasTheChannelsThatItWasGiven) {
  RCPtrMT<DestNameSetImpl> const nameSet = NewNameSet("A");
  EXPECT_EQ(DestinationNameSet(nameSet).GetChannels(), 0);
  nameSet->SetChannelAvailable(0, true);
  nameSet->SetChannelAvailable(15, true);
  nameSet->SetChannelAvailable(9, true);
  nameSet->SetChannelAvailable(9, false);
  EXPECT_EQ(DestinationNameSet(nameSet).GetChannels(), 0x8001);
}

TEST(Bank, IsCalledAfterTheListInUse) {
  RCPtrMT<PatchBankImpl> const bank(new PatchBankImpl("Preset"));
  EXPECT_EQ(PatchBank(bank).GetName(), UString("Preset"));
  bank->SetListName("Mine");
  EXPECT_EQ(PatchBank(bank).GetName(), UString("Mine"));
  EXPECT_EQ(PatchBank(bank).GetBankName(), UString("Preset"));
}

TEST(Bank, HasTheNumbersOfAPlainBankSelect) {
  RCPtrMT<PatchBankImpl> const bank(new PatchBankImpl("Preset"));
  Record(bank->Commands(), 1, 2);
  EXPECT_EQ(PatchBank(bank).GetController0Number(), 1);
  EXPECT_EQ(PatchBank(bank).GetController32Number(), 2);
  bank->Commands().AddDelay(1);
  EXPECT_EQ(PatchBank(bank).GetController0Number(), 255);
  EXPECT_EQ(PatchBank(bank).GetController32Number(), 255);
  EXPECT_THAT(Packets(PatchBank(bank).GetCommand(Clocks(1), 4, 0)),
              ElementsAre(Bytes{0xB4, 0, 1}, Bytes{0xB4, 32, 2}));
}

TEST(PatchText, IsNumberBlankName) {
  Patch const patch(new PatchImpl("A 1", "Grand Piano"));
  EXPECT_EQ(patch.GetNumberAndName(), UString("A 1 Grand Piano"));
  EXPECT_EQ(patch.GetNumber(), UString("A 1"));
  EXPECT_EQ(patch.GetName(), UString("Grand Piano"));
  Patch const bare(new PatchImpl("", ""));
  EXPECT_EQ(bare.GetNumberAndName(), UString(" "));
  EXPECT_EQ(bare.GetNumber(), UString());
  EXPECT_EQ(bare.GetName(), UString());
}

TEST(PatchNumbersOfAPatch, AreCompletedByTheBank) {
  RCPtrMT<DestNameSetImpl> nameSet = NewNameSet("A");
  RCPtrMT<PatchBankImpl> const bank = AddBank(*nameSet, "Bank", 1, 2);
  Patch const patch(AddPatch(*bank, 5));
  Patch const own(AddPatch(*bank, kNoNumber, kNoNumber, 7));
  EXPECT_EQ(patch.GetPatchNumbers().program, 5);
  EXPECT_EQ(patch.GetPatchNumbers().msb, 1);
  EXPECT_EQ(patch.GetPatchNumbers().lsb, 2);
  EXPECT_EQ(own.GetPatchNumbers().program, 255);
  EXPECT_EQ(own.GetPatchNumbers().msb, 1);
  EXPECT_EQ(own.GetPatchNumbers().lsb, 7);
}

TEST(PatchNumbersOfAPatch, AreItsOwnOnceTheBankIsGone) {
  RCPtrMT<DestNameSetImpl> nameSet = NewNameSet("A");
  Patch const patch(AddPatch(*AddBank(*nameSet, "Bank", 1, 2), 5));
  EXPECT_EQ(patch.GetBank().GetName(), UString("Bank"));
  nameSet = nullptr;
  EXPECT_FALSE(patch.GetBank().Exists());
  EXPECT_EQ(patch.GetPatchNumbers().program, 5);
  EXPECT_EQ(patch.GetPatchNumbers().msb, 255);
  EXPECT_EQ(patch.GetPatchNumbers().lsb, 255);
  EXPECT_EQ(patch.GetName(), UString("Patch 5"));
}

TEST(PatchNumbersOfAPatch, OfItsOwnBankSelectItHasNoPlainProgramChange) {
  EXPECT_EQ(Patch(MakePatch(5)).GetProgramChange(), 5);
  EXPECT_EQ(Patch(MakePatch(5, 1)).GetProgramChange(), 255);
  EXPECT_EQ(Patch(MakePatch(5, kNoNumber, 0)).GetProgramChange(), 255);
  RCPtrMT<DestNameSetImpl> const nameSet = NewNameSet("A");
  EXPECT_EQ(Patch(AddPatch(*AddBank(*nameSet, "Bank", 1, 2), 5)).GetProgramChange(), 5);
}

TEST(PatchCommand, IsThePatchsOwnAlone) {
  RCPtrMT<DestNameSetImpl> const nameSet = NewNameSet("A");
  Patch const patch(AddPatch(*AddBank(*nameSet, "Bank", 1, 2), 5));
  EXPECT_THAT(Packets(patch.GetCommand(Clocks(1), 9, 0)), ElementsAre(Bytes{0xC9, 5}));
}

TEST(Bank, OutlivesItsNameSetInAHandle) {
  RCPtrMT<DestNameSetImpl> nameSet = NewNameSet("A");
  PatchBank const bank(AddBank(*nameSet, "Bank", 1, 2));
  EXPECT_EQ(bank.GetNameSet(), DestinationNameSet(nameSet));
  nameSet = nullptr;
  EXPECT_FALSE(bank.GetNameSet().Exists());
  EXPECT_EQ(bank.GetController0Number(), 1);
}

TEST(Handles, OutOfRangeAreNull) {
  RCPtrMT<DestNameSetImpl> const nameSet = NewNameSet("A");
  RCPtrMT<PatchBankImpl> const bank = AddBank(*nameSet, "Bank", 1, 2);
  EXPECT_FALSE(DestinationNameSet(nameSet).GetBank(1).Exists());
  EXPECT_FALSE(DestinationNameSet(nameSet).GetBank(-1).Exists());
  EXPECT_FALSE(DestinationNameSet(nameSet).GetMode(0).first.Exists());
  EXPECT_EQ(DestinationNameSet(nameSet).GetMode(-1).second, 0);
  EXPECT_FALSE(PatchBank(bank).GetPatch(0).Exists());
  EXPECT_FALSE(PatchBank(bank).GetPatch(-1).Exists());
}

// Sharing a list of patches.

class SharedPatchList : public ::testing::Test {
 protected:
  SharedPatchList() {
    list->patches = {MakePatch(5), MakePatch(6)};
    list->banks = {first, second, third};
  }

  RCPtrMT<DestNameSetImpl> const nameSet = NewNameSet("A");
  RCPtrMT<PatchBankImpl> const first = AddBank(*nameSet, "1", 1, 0);
  RCPtrMT<PatchBankImpl> const second = AddBank(*nameSet, "2", 2, 0);
  RCPtrMT<PatchBankImpl> const third = AddBank(*nameSet, "3", 3, 0);
  RCPtrMT<PatchNameListData> const list{new PatchNameListData("List")};
  Impl::NameListUses uses;
};

TEST_F(SharedPatchList, GivesEachBankPatchesOfItsOwn) {
  RCPtrMT<PatchImpl> const original = list->patches[1];
  list->Attach(false, uses);
  EXPECT_EQ(first->GetPatches()[1], original);
  for (RCPtrMT<PatchBankImpl> const& bank : nameSet->GetBanks()) {
    ASSERT_EQ(bank->GetPatches().size(), 2u);
    EXPECT_EQ(PatchBank(bank).GetName(), UString("List"));
    EXPECT_FALSE(bank->IsTemporary());
    Patch const patch(bank->GetPatches()[1]);
    EXPECT_EQ(patch.GetNumberAndName(), UString("A1 Patch 6"));
    EXPECT_EQ(patch.GetName(), UString("Patch 6"));
    EXPECT_EQ(patch.GetBank(), PatchBank(bank));
    EXPECT_EQ(patch.GetPatchNumbers().program, 6);
    EXPECT_EQ(patch.GetPatchNumbers().msb, bank->Commands().PendingMSB());
  }
  EXPECT_TRUE(list->patches.empty());
  EXPECT_TRUE(list->banks.empty());
}

TEST_F(SharedPatchList, ReplacesWhatTheBanksHad) {
  Patch const old(AddPatch(*second, 9));
  list->Attach(true, uses);
  EXPECT_EQ(second->GetPatches().size(), 2u);
  EXPECT_TRUE(second->IsTemporary());
  EXPECT_FALSE(old.GetBank().Exists());
}

TEST_F(SharedPatchList, OfNoPatchesLeavesTheBanksAsTheyAre) {
  AddPatch(*second, 9);
  list->patches.clear();
  list->Attach(true, uses);
  EXPECT_EQ(second->GetPatches().size(), 1u);
  EXPECT_FALSE(second->IsTemporary());
  EXPECT_EQ(PatchBank(second).GetName(), UString("2"));
}

TEST_F(SharedPatchList, SharesTheListsOfNotesAndControls) {
  RCPtrMT<Impl::NoteNameData> const notes(new Impl::NoteNameData("N"));
  RCPtrMT<Impl::ControlNameData> const controls(new Impl::ControlNameData("C"));
  notes->SetNote(36, "Kick", 0);
  uses.patchNotes[list->patches[0]] = notes;
  uses.patchControls[list->patches[1]] = controls;
  list->Attach(false, uses);
  NameTree tree;
  tree.nameSets.push_back(nameSet);
  AssignLists(tree, uses);
  Impl::NoteNameTable const* const table = first->GetPatches()[0]->GetNoteNames().get();
  ASSERT_NE(table, nullptr);
  EXPECT_EQ(second->GetPatches()[0]->GetNoteNames().get(), table);
  EXPECT_EQ(third->GetPatches()[0]->GetNoteNames().get(), table);
  EXPECT_EQ(first->GetPatches()[1]->GetNoteNames().get(), nullptr);
  EXPECT_NE(third->GetPatches()[1]->GetControls().get(), nullptr);
  EXPECT_EQ(third->GetPatches()[0]->GetControls().get(), nullptr);
}

// Copies take the table of name sets away from what they are copied from, so the second bank ends
// up with it. Written documents show which bank had it.
TEST_F(SharedPatchList, LeavesTheTableOfNameSetsWithTheSecondBank) {
  list->patches[0]->DemandChannelNameSets()[3] = NewNameSet("Other");
  list->Attach(false, uses);
  EXPECT_EQ(first->GetPatches()[0]->GetChannelNameSets(), nullptr);
  ASSERT_NE(second->GetPatches()[0]->GetChannelNameSets(), nullptr);
  EXPECT_EQ((*second->GetPatches()[0]->GetChannelNameSets())[3]->GetName(), UString("Other"));
  EXPECT_EQ(third->GetPatches()[0]->GetChannelNameSets(), nullptr);
}

// Who keeps whom.

int gAlive = 0;

class CountedNameSet : public DestNameSetImpl {
 public:
  explicit CountedNameSet(Impl::DestinationImpl* destination)
      : DestNameSetImpl(destination, "Counted") {
    ++gAlive;
  }
  ~CountedNameSet() override { --gAlive; }
};

class NameTreeTest : public StudioTest {
 protected:
  NameTreeTest() : port(setup.MakePort("Port")), names(PlainNames::For(port)) {
    nameSet = new CountedNameSet(ImplOf(port));
    mode = new DestModeImpl(ImplOf(port), "Mode", true);
    mode->SetNameSet(0, nameSet);
    patch = AddPatch(*AddBank(*nameSet, "Bank", 1, 2), 5);
    patch->DemandChannelNameSets()[0] = nameSet;  // a ring
    names.Tree().modes.push_back(mode);
    names.Tree().nameSets.push_back(nameSet);
    names.Tree().currentMode = mode;
    names.Tree().currentNameSets[0] = nameSet;
  }
  void Forget() {
    patch = nullptr;
    mode = nullptr;
    nameSet = nullptr;
  }

  Destination const port;
  PlainNames& names;
  RCPtrMT<DestNameSetImpl> nameSet;
  RCPtrMT<DestModeImpl> mode;
  RCPtrMT<PatchImpl> patch;
};

TEST_F(NameTreeTest, KnowsItsDestination) {
  EXPECT_EQ(DestinationMode(mode).GetDestination(), port);
  EXPECT_EQ(DestinationNameSet(nameSet).GetDestination(), port);
  EXPECT_TRUE(DestinationMode(mode).IsStandardMode());
}

TEST_F(NameTreeTest, LeavesNothingBehindInSpiteOfRings) {
  ASSERT_EQ(gAlive, 1);
  Forget();
  names.Tree() = NameTree();
  EXPECT_EQ(gAlive, 0);
}

TEST_F(NameTreeTest, GoesWithItsDestination) {
  RCPtrMT<Impl::DestinationImpl> const loose(new Impl::DestinationImpl(
      std::make_unique<TestPeer>(setup), setup, Impl::EndpointKind::Bare(true, false)));
  Destination const other(loose);
  RCPtrMT<DestNameSetImpl> kept(new CountedNameSet(loose.get()));
  PlainNames::For(other).Tree().nameSets.push_back(kept);
  EXPECT_EQ(DestinationNameSet(kept).GetDestination(), other);
  loose->SetNames(nullptr);
  EXPECT_FALSE(DestinationNameSet(kept).GetDestination().Exists());
}

TEST_F(NameTreeTest, AnswersFromAnOldHandleWhatItStillHolds) {
  DestinationMode const oldMode(mode);
  Patch const oldPatch(patch);
  Forget();
  names.Tree() = NameTree();
  EXPECT_FALSE(oldMode.GetDestination().Exists());
  ASSERT_TRUE(oldMode.GetNameSet(0).Exists());
  EXPECT_FALSE(oldMode.GetNameSet(0).GetDestination().Exists());
  EXPECT_EQ(oldMode.GetNameSet(0).GetBank(0).GetPatch(0), oldPatch);
  EXPECT_EQ(oldPatch.GetPatchNumbers().msb, 1);
  EXPECT_EQ(gAlive, 1);
}

TEST_F(NameTreeTest, ANameSetDoesNotKeepItsMode) {
  DestinationNameSet const old(nameSet);
  Forget();
  EXPECT_EQ(old.CountModes(), 1);
  names.Tree() = NameTree();
  EXPECT_EQ(old.CountModes(), 0);
}

TEST_F(NameTreeTest, AnEditOfAnOldPatchMarksNothing) {
  Patch const old(patch);
  names.Tree() = NameTree();
  old.GetNoteNames().SetNoteName(36, "Kick");
  EXPECT_EQ(old.GetNoteNames().GetNoteNameForPitch(36), UString("Kick"));
  EXPECT_TRUE(names.GetEditedBanks().empty());
}

TEST_F(NameTreeTest, AppendsModesAndNameSetsOfAnother) {
  NameTree other;
  other.modes.push_back(NewMode("2"));
  other.nameSets.push_back(new CountedNameSet(ImplOf(port)));
  names.Tree().Append(std::move(other));
  EXPECT_EQ(names.Tree().modes.size(), 2u);
  ASSERT_EQ(names.Tree().nameSets.size(), 2u);
  other = NameTree();
  EXPECT_EQ(names.Tree().nameSets[1]->GetDestination(), ImplOf(port));
  EXPECT_EQ(names.Tree().currentMode, mode);
}

}  // namespace
}  // namespace Ostinet::Testing

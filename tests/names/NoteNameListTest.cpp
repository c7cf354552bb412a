// SPDX-License-Identifier: MIT
#include <gmock/gmock.h>

#include "names/SmallTree.h"

namespace Ostinet::Testing {
namespace {

using Impl::NoteEntry;
using Impl::NoteNameData;
using Impl::NoteNameTable;
using ::testing::ElementsAre;
using ::testing::IsEmpty;

using Table = RCPtrMT<NoteNameTable>;

// What a note is in one line: name, group, d for one that has a default, i for an inherited one.
std::string Line(NoteEntry const& note) {
  return std::to_string(note.pitch) + " " + note.name.string() + " " + std::to_string(note.group) +
         (note.hasDefault ? " d" : "") + (note.inherited ? "i" : "");
}

std::vector<std::string> Notes(NoteNameTable const& table) {
  std::vector<std::string> lines;
  for (NoteEntry const& note : table.GetNotes()) {
    lines.push_back(Line(note));
  }
  return lines;
}

std::vector<std::string> Groups(NoteNameTable const& table) {
  std::vector<std::string> lines;
  for (Impl::NoteGroupEntry const& group : table.GetGroups()) {
    std::string line = std::to_string(group.id) + " " + group.name.string() + ":";
    for (unsigned char const pitch : group.pitches) {
      line += " " + std::to_string(pitch);
    }
    lines.push_back(line + (group.inherited ? " i" : ""));
  }
  return lines;
}

class NoteNameMerge : public ::testing::Test {
 protected:
  RCPtrMT<NoteNameData> const defaults{new NoteNameData("Default", false)};
  RCPtrMT<NoteNameData> const own{new NoteNameData("Own", false)};
};

TEST_F(NoteNameMerge, OfAPatchsListAloneIsThatList) {
  own->SetNote(38, "Snare", 0);
  own->SetNote(36, "Kick", 0);
  own->SetNote(40, "", 0);
  Table const table = NoteNameTable::Merge(nullptr, own.get());
  EXPECT_EQ(table->GetName(), UString("Own"));
  EXPECT_FALSE(table->IsShared());
  EXPECT_FALSE(table->IsEditable());
  EXPECT_THAT(Notes(*table), ElementsAre("36 Kick 0", "38 Snare 0"));
  EXPECT_THAT(table->GetHiddenPitches(), IsEmpty());
}

TEST_F(NoteNameMerge, OfAPatchsNamedListAloneIsShared) {
  RCPtrMT<NoteNameData> const named(new NoteNameData("Own", true));
  EXPECT_TRUE(NoteNameTable::Merge(nullptr, named.get())->IsShared());
}

TEST_F(NoteNameMerge, OfTheDefaultsAloneIsInheritedAndShared) {
  defaults->SetNote(36, "Kick", 0);
  defaults->SetNote(38, "", 0);
  Table const table = NoteNameTable::Merge(defaults.get(), nullptr);
  EXPECT_EQ(table->GetName(), UString("Default"));
  EXPECT_TRUE(table->IsShared());
  EXPECT_THAT(Notes(*table), ElementsAre("36 Kick 0 di"));
}

TEST_F(NoteNameMerge, PutsTheDefaultsBeneathThePatchsList) {
  defaults->SetNote(35, "Low Kick", 0);
  defaults->SetNote(36, "Kick", 0);
  defaults->SetNote(38, "Snare", 0);
  defaults->SetNote(39, "", 0);
  own->SetNote(34, "Below", 0);
  own->SetNote(36, "My Kick", 0);
  own->SetNote(38, "", 0);
  own->SetNote(50, "Above", 0);
  own->SetNote(51, "", 0);
  Table const table = NoteNameTable::Merge(defaults.get(), own.get());
  EXPECT_EQ(table->GetName(), UString("Own"));
  EXPECT_TRUE(table->IsShared());
  EXPECT_THAT(Notes(*table),
              ElementsAre("34 Below 0", "35 Low Kick 0 di", "36 My Kick 0 d", "50 Above 0"));
  EXPECT_THAT(table->GetHiddenPitches(), ElementsAre(38));
}

TEST_F(NoteNameMerge, NumbersGroupsByTheirFirstNote) {
  defaults->groupNames = {"Cymbals", "Kicks"};
  defaults->SetNote(35, "a", 2);
  defaults->SetNote(36, "b", 2);
  defaults->SetNote(49, "c", 1);
  defaults->SetNote(51, "d", 1);
  own->groupNames = {"Toms"};
  own->SetNote(41, "e", 1);
  own->SetNote(43, "f", 1);
  Table const table = NoteNameTable::Merge(defaults.get(), own.get());
  EXPECT_THAT(Groups(*table),
              ElementsAre("1 Kicks: 35 36 i", "2 Toms: 41 43", "3 Cymbals: 49 51 i"));
  EXPECT_THAT(Notes(*table),
              ElementsAre("35 a 1 di", "36 b 1 di", "41 e 2", "43 f 2", "49 c 3 di", "51 d 3 di"));
}

TEST_F(NoteNameMerge, ANoteWithoutNameMakesNoGroup) {
  own->groupNames = {"Kicks"};
  own->SetNote(35, "", 1);
  own->SetNote(36, "b", 1);
  own->SetNote(37, "c", 1);
  Table const table = NoteNameTable::Merge(nullptr, own.get());
  EXPECT_THAT(Groups(*table), ElementsAre("1 Kicks: 36 37"));
}

TEST_F(NoteNameMerge, AGroupOfOneDoesNotSurvive) {
  own->groupNames = {"Kicks", "Toms"};
  own->SetNote(36, "b", 1);
  own->SetNote(41, "c", 2);
  own->SetNote(43, "d", 2);
  Table const table = NoteNameTable::Merge(nullptr, own.get());
  EXPECT_THAT(Groups(*table), ElementsAre("2 Toms: 41 43"));
  EXPECT_THAT(Notes(*table), ElementsAre("36 b 0", "41 c 2", "43 d 2"));
}

// Its note is the patch's own from then on, so that a document that is written has it.
TEST_F(NoteNameMerge, TheNoteOfADissolvedDefaultGroupIsNotInherited) {
  defaults->groupNames = {"Kicks"};
  defaults->SetNote(35, "a", 1);
  defaults->SetNote(36, "b", 1);
  own->SetNote(36, "Mine", 0);
  Table const table = NoteNameTable::Merge(defaults.get(), own.get());
  EXPECT_THAT(Groups(*table), IsEmpty());
  EXPECT_THAT(Notes(*table), ElementsAre("35 a 0 d", "36 Mine 0 d"));
}

TEST(NoteNameData, ALaterNoteOfAPitchReplacesNameAndGroup) {
  NoteNameData data;
  data.SetNote(60, "a", 1);
  data.SetNote(60, "b", 0);
  ASSERT_EQ(data.notes.size(), 1u);
  EXPECT_EQ(data.notes[0].name, UString("b"));
  EXPECT_EQ(data.notes[0].group, 0);
}

// Editing.

class NoteNameEditing : public StudioTest {
 protected:
  NoteNameEditing()
      : names(PlainNames::For(setup.MakePort("Port"))),
        nameSet(new Impl::DestNameSetImpl(&names.GetDestination(), "Set")),
        bank(AddBank(*nameSet, "Bank")),
        patch(AddPatch(*bank, 5)),
        other(AddPatch(*bank, 6)) {
    names.Tree().nameSets.push_back(nameSet);
    defaults->groupNames = {"Kicks"};
    defaults->SetNote(35, "a", 1);
    defaults->SetNote(36, "b", 1);
    defaults->SetNote(38, "c", 0);
    defaults->SetNote(39, "hidden", 0);
    own->SetNote(39, "", 0);
    own->SetNote(60, "mine", 0);
  }
  void Load() {
    Impl::NameListUses uses;
    uses.nameSetNotes[nameSet] = defaults;
    uses.patchNotes[patch] = own;
    uses.patchNotes[other] = own;
    AssignLists(names.Tree(), uses);
    list = Patch(patch).GetNoteNames();
  }
  NoteNameTable const& TableOf(RCPtrMT<Impl::PatchImpl> const& which) const {
    return *which->GetNoteNames();
  }

  PlainNames& names;
  RCPtrMT<Impl::DestNameSetImpl> const nameSet;
  RCPtrMT<Impl::PatchBankImpl> const bank;
  RCPtrMT<Impl::PatchImpl> const patch;
  RCPtrMT<Impl::PatchImpl> const other;
  RCPtrMT<NoteNameData> const defaults{new NoteNameData("Default", false)};
  RCPtrMT<NoteNameData> const own{new NoteNameData("Own", true)};
  NoteNameList list;
};

TEST_F(NoteNameEditing, ReadsWhatTheTableHas) {
  Load();
  EXPECT_TRUE(list.HasNames());
  EXPECT_EQ(list.GetName(), UString("Own"));
  ASSERT_EQ(list.CountNoteNames(), 4);
  EXPECT_EQ(list.GetNoteName(3), std::make_pair(static_cast<unsigned char>(60), UString("mine")));
  EXPECT_EQ(list.GetNoteNameForPitch(38), UString("c"));
  EXPECT_EQ(list.GetNoteNameForPitch(39), UString());
  EXPECT_EQ(list.GetNoteGroupForPitch(36), 1);
  EXPECT_EQ(list.GetNoteGroupForPitch(38), 0);
  EXPECT_EQ(list.GetNoteGroupForPitch(61), 0);
  ASSERT_EQ(list.CountNoteGroups(), 1);
  EXPECT_EQ(list.GetNoteGroup(0).name, UString("Kicks"));
  EXPECT_THAT(list.GetNoteGroupForID(1).pitches, ElementsAre(35, 36));
  EXPECT_EQ(list.GetNoteGroupForID(2).id, 0);
  EXPECT_EQ(list.GetNoteGroup(1).id, 0);
  EXPECT_EQ(list.GetNoteName(4).second, UString());
  EXPECT_EQ(list.GetNoteName(-1).second, UString());
  EXPECT_EQ(list.GetPatch(), Patch(patch));
}

TEST_F(NoteNameEditing, TheDefaultListIsTheNameSets) {
  Load();
  DefaultNoteNameList const ofNameSet(nameSet);
  EXPECT_EQ(ofNameSet.GetName(), UString("Default"));
  EXPECT_EQ(ofNameSet.CountNoteNames(), 4);
  EXPECT_EQ(ofNameSet.GetNoteNameForPitch(39), UString("hidden"));
  EXPECT_EQ(ofNameSet.GetNameSet(), DestinationNameSet(nameSet));
}

TEST_F(NoteNameEditing, PatchesWithoutAListShareTheDefaults) {
  RCPtrMT<Impl::PatchImpl> const plain = AddPatch(*bank, 7);
  Load();
  EXPECT_EQ(plain->GetNoteNames(), nameSet->GetDefaultNotes());
  EXPECT_EQ(patch->GetNoteNames(), other->GetNoteNames());
  Patch(plain).GetNoteNames().SetNoteName(39, "shown");
  EXPECT_EQ(DefaultNoteNameList(nameSet).GetNoteNameForPitch(39), UString("hidden"));
}

TEST_F(NoteNameEditing, AListIsAViewOfItsPatch) {
  NoteNameList const early = Patch(patch).GetNoteNames();
  EXPECT_FALSE(early.HasNames());
  Load();
  EXPECT_TRUE(early.HasNames());
}

TEST_F(NoteNameEditing, SplitsTheTableOffAtTheFirstEdit) {
  Load();
  list.SetNoteName(38, "new");
  EXPECT_EQ(list.GetNoteNameForPitch(38), UString("new"));
  EXPECT_EQ(Patch(other).GetNoteNames().GetNoteNameForPitch(38), UString("c"));
  EXPECT_TRUE(TableOf(patch).IsEditable());
  EXPECT_FALSE(TableOf(patch).IsShared());
  EXPECT_FALSE(TableOf(other).IsEditable());
  EXPECT_TRUE(TableOf(other).IsShared());
  EXPECT_EQ(TableOf(patch).GetName(), UString("Own"));

  NoteNameTable const* const table = patch->GetNoteNames().get();
  list.SetNoteName(38, "newer");
  EXPECT_EQ(patch->GetNoteNames().get(), table);
}

TEST_F(NoteNameEditing, MakesATableWithoutNameWhereThereIsNone) {
  NoteNameList const fresh = Patch(patch).GetNoteNames();
  EXPECT_EQ(fresh.GetUnusedGroupID(), 1);
  fresh.SetNoteName(60, "C");
  EXPECT_EQ(fresh.GetName(), UString());
  EXPECT_EQ(fresh.CountNoteNames(), 1);
  EXPECT_THAT(Notes(TableOf(patch)), ElementsAre("60 C 0"));
  EXPECT_TRUE(TableOf(patch).IsEditable());
  EXPECT_FALSE(TableOf(patch).IsShared());
}

TEST_F(NoteNameEditing, MarksTheBankOnce) {
  Load();
  list.SetNoteName(38, "new");
  Patch(other).GetNoteNames().SetNoteName(38, "new");
  ASSERT_EQ(names.GetEditedBanks().size(), 1u);
  EXPECT_EQ(*names.GetEditedBanks().begin(), bank);
}

// A saved bank stays saved: the table is the patch's own by then.
TEST_F(NoteNameEditing, DoesNotMarkTheBankAgainAfterASave) {
  Load();
  list.SetNoteName(38, "new");
  names.SaveEditedBanks();
  list.SetNoteName(38, "newer");
  EXPECT_TRUE(names.GetEditedBanks().empty());
}

TEST_F(NoteNameEditing, OfAPatchInNoBankMarksNothing) {
  NoteNameList const loose(MakePatch(5));
  loose.SetNoteName(38, "new");
  EXPECT_EQ(loose.GetNoteNameForPitch(38), UString("new"));
  EXPECT_TRUE(names.GetEditedBanks().empty());
}

// An edit that changes nothing is an edit all the same.
TEST_F(NoteNameEditing, MarksTheBankForAnEditThatChangesNothing) {
  Load();
  list.ClearNoteName(100);
  EXPECT_EQ(names.GetEditedBanks().size(), 1u);
  EXPECT_NE(patch->GetNoteNames(), other->GetNoteNames());
}

TEST_F(NoteNameEditing, ANewNameOfAnInheritedNoteIsThePatchsOwn) {
  Load();
  list.SetNoteName(38, "new");
  EXPECT_THAT(Notes(TableOf(patch)),
              ElementsAre("35 a 1 di", "36 b 1 di", "38 new 0 d", "60 mine 0"));
}

// Groups are written whole, so one changed note takes the others with it.
TEST_F(NoteNameEditing, ANewNameInAnInheritedGroupOwnsTheWholeGroup) {
  Load();
  list.SetNoteName(36, "new");
  EXPECT_THAT(Notes(TableOf(patch)),
              ElementsAre("35 a 1 d", "36 new 1 d", "38 c 0 di", "60 mine 0"));
  EXPECT_THAT(Groups(TableOf(patch)), ElementsAre("1 Kicks: 35 36"));
}

TEST_F(NoteNameEditing, ANewNoteHasNoDefault) {
  Load();
  list.SetNoteName(61, "new");
  EXPECT_EQ(Line(*TableOf(patch).FindNote(61)), "61 new 0");
}

TEST_F(NoteNameEditing, ANameForAHiddenPitchShowsItAgain) {
  Load();
  EXPECT_THAT(TableOf(patch).GetHiddenPitches(), ElementsAre(39));
  list.SetNoteName(39, "shown");
  EXPECT_THAT(TableOf(patch).GetHiddenPitches(), IsEmpty());
  EXPECT_EQ(Line(*TableOf(patch).FindNote(39)), "39 shown 0 d");
}

TEST_F(NoteNameEditing, AClearedDefaultIsHidden) {
  Load();
  list.ClearNoteName(38);
  EXPECT_EQ(list.GetNoteNameForPitch(38), UString());
  EXPECT_THAT(TableOf(patch).GetHiddenPitches(), ElementsAre(38, 39));
  list.SetNoteName(38, "back");
  EXPECT_EQ(Line(*TableOf(patch).FindNote(38)), "38 back 0 d");
  EXPECT_THAT(TableOf(patch).GetHiddenPitches(), ElementsAre(39));
}

TEST_F(NoteNameEditing, AClearedNoteOfThePatchIsGone) {
  Load();
  list.ClearNoteName(60);
  EXPECT_THAT(TableOf(patch).GetHiddenPitches(), ElementsAre(39));
  EXPECT_EQ(list.CountNoteNames(), 3);
}

// Clearing leaves a group of one, moving does not.
TEST_F(NoteNameEditing, ClearingOneOfTwoLeavesAGroupOfOne) {
  Load();
  list.ClearNoteName(35);
  EXPECT_THAT(Groups(TableOf(patch)), ElementsAre("1 Kicks: 36 i"));
  EXPECT_EQ(list.GetNoteGroupForPitch(36), 1);
  list.ClearNoteName(36);
  EXPECT_THAT(Groups(TableOf(patch)), IsEmpty());
}

TEST_F(NoteNameEditing, MovingOneOfTwoDissolvesTheGroup) {
  Load();
  list.PutNoteInGroup(35, 0, "");
  EXPECT_THAT(Groups(TableOf(patch)), IsEmpty());
  EXPECT_THAT(Notes(TableOf(patch)), ElementsAre("35 a 0 d", "36 b 0 d", "38 c 0 di", "60 mine 0"));
}

TEST_F(NoteNameEditing, AGroupIsMadeOnceAndKeepsItsName) {
  Load();
  list.PutNoteInGroup(60, 7, "X");
  list.PutNoteInGroup(61, 7, "Y");
  EXPECT_THAT(Groups(TableOf(patch)), ElementsAre("1 Kicks: 35 36 i", "7 X: 60 61"));
  EXPECT_EQ(Line(*TableOf(patch).FindNote(60)), "60 mine 7");
  EXPECT_EQ(Line(*TableOf(patch).FindNote(61)), "61  7");
}

TEST_F(NoteNameEditing, GroupsStaySortedByID) {
  Load();
  list.PutNoteInGroup(60, 7, "X");
  list.PutNoteInGroup(61, 3, "Y");
  EXPECT_THAT(Groups(TableOf(patch)), ElementsAre("1 Kicks: 35 36 i", "3 Y: 61", "7 X: 60"));
}

TEST_F(NoteNameEditing, JoiningAnInheritedGroupOwnsIt) {
  Load();
  list.PutNoteInGroup(38, 1, "");
  EXPECT_THAT(Groups(TableOf(patch)), ElementsAre("1 Kicks: 35 36 38"));
  EXPECT_THAT(Notes(TableOf(patch)), ElementsAre("35 a 1 d", "36 b 1 d", "38 c 1 d", "60 mine 0"));
}

TEST_F(NoteNameEditing, JoiningTheGroupWhereItIsChangesNothing) {
  Load();
  list.PutNoteInGroup(35, 1, "Y");
  list.PutNoteInGroup(38, 0, "");
  EXPECT_THAT(Groups(TableOf(patch)), ElementsAre("1 Kicks: 35 36 i"));
  EXPECT_EQ(Line(*TableOf(patch).FindNote(38)), "38 c 0 di");
}

TEST_F(NoteNameEditing, MovingFromOneGroupToAnother) {
  Load();
  list.PutNoteInGroup(38, 2, "Snares");
  list.PutNoteInGroup(36, 2, "");
  EXPECT_THAT(Groups(TableOf(patch)), ElementsAre("2 Snares: 38 36"));
  EXPECT_THAT(Notes(TableOf(patch)), ElementsAre("35 a 0 d", "36 b 2 d", "38 c 2 d", "60 mine 0"));
}

// A note put in a group without a name first is new to the list, hidden default or not.
TEST_F(NoteNameEditing, GroupingAHiddenPitchLeavesItHidden) {
  Load();
  list.PutNoteInGroup(39, 2, "X");
  EXPECT_THAT(TableOf(patch).GetHiddenPitches(), ElementsAre(39));
  EXPECT_EQ(Line(*TableOf(patch).FindNote(39)), "39  2");
}

TEST_F(NoteNameEditing, GroupingNowhereStillMakesTheNote) {
  Load();
  list.PutNoteInGroup(61, 0, "");
  EXPECT_EQ(Line(*TableOf(patch).FindNote(61)), "61  0");
}

TEST_F(NoteNameEditing, ARemovedGroupLeavesItsNotesOrTakesThemAlong) {
  Load();
  list.RemoveNoteGroup(2, true);
  EXPECT_EQ(list.CountNoteNames(), 4);
  list.RemoveNoteGroup(1, false);
  EXPECT_THAT(Notes(TableOf(patch)), ElementsAre("35 a 0 d", "36 b 0 d", "38 c 0 di", "60 mine 0"));
  EXPECT_THAT(Groups(TableOf(patch)), IsEmpty());

  NoteNameList const second = Patch(other).GetNoteNames();
  second.PutNoteInGroup(60, 1, "");
  second.RemoveNoteGroup(1, true);
  EXPECT_THAT(Notes(TableOf(other)), ElementsAre("38 c 0 di"));
  EXPECT_THAT(TableOf(other).GetHiddenPitches(), ElementsAre(35, 36, 39));
  EXPECT_EQ(second.CountNoteGroups(), 0);
}

TEST_F(NoteNameEditing, TheUnusedIDIsTheFirstGap) {
  NoteNameList const fresh = Patch(patch).GetNoteNames();
  fresh.PutNoteInGroup(60, 1, "a");
  fresh.PutNoteInGroup(61, 2, "b");
  fresh.PutNoteInGroup(62, 4, "c");
  EXPECT_EQ(fresh.GetUnusedGroupID(), 3);
  fresh.PutNoteInGroup(63, 3, "d");
  EXPECT_EQ(fresh.GetUnusedGroupID(), 5);
}

TEST_F(NoteNameEditing, IDsBelowOneDoNotCountAsUsed) {
  NoteNameList const fresh = Patch(patch).GetNoteNames();
  fresh.PutNoteInGroup(60, -1, "a");
  EXPECT_EQ(fresh.GetNoteGroupForID(-1).name, UString("a"));
  EXPECT_EQ(fresh.GetUnusedGroupID(), 1);
}

}  // namespace
}  // namespace Ostinet::Testing

// SPDX-License-Identifier: MIT
#include <gmock/gmock.h>

#include "names/SmallTree.h"

namespace Ostinet::Testing {
namespace {

using Impl::ControlEntry;
using Impl::ControlNameData;
using Impl::ControlTable;
using ::testing::ElementsAre;
using ::testing::IsEmpty;

constexpr ControlType k7Bit = kControl7Bit;
constexpr ControlType kNRPN = kControlNRPN;

TEST(Control, HasWhatItsConstructorTook) {
  Control const none;
  EXPECT_EQ(none.GetType(), k7Bit);
  EXPECT_EQ(none.GetNumber(), 0);
  EXPECT_EQ(none.GetName(), UString());
  EXPECT_FALSE(none.HasValueRange());
  EXPECT_FALSE(none.HasDefaultValue());
  EXPECT_FALSE(none.HasUnits());

  Control const named(kNRPN, 16383, "Cutoff");
  EXPECT_EQ(named.GetType(), kNRPN);
  EXPECT_EQ(named.GetNumber(), 16383);
  EXPECT_EQ(named.GetName(), UString("Cutoff"));
  EXPECT_FALSE(named.HasValueRange());

  Control const full(k7Bit, 7, "Volume", 1.5, 127, 100, "dB");
  EXPECT_TRUE(full.HasValueRange());
  EXPECT_EQ(full.GetMinValue(), 1.5);
  EXPECT_EQ(full.GetMaxValue(), 127);
  EXPECT_TRUE(full.HasDefaultValue());
  EXPECT_EQ(full.GetDefaultValue(), 100);
  EXPECT_TRUE(full.HasUnits());
  EXPECT_EQ(full.GetUnits(), UString("dB"));
}

TEST(Control, OfARangeAloneHasNoDefault) {
  Control const control(k7Bit, 7, "Volume", 0, 127);
  EXPECT_TRUE(control.HasValueRange());
  EXPECT_FALSE(control.HasDefaultValue());
  EXPECT_EQ(control.GetDefaultValue(), 0);
  Control const withUnits(k7Bit, 7, "Volume", 0, 127, UString("dB"));
  EXPECT_FALSE(withUnits.HasDefaultValue());
  EXPECT_TRUE(withUnits.HasUnits());
  Control const withDefault(k7Bit, 7, "Volume", 0, 127, 64.0);
  EXPECT_TRUE(withDefault.HasDefaultValue());
  EXPECT_FALSE(withDefault.HasUnits());
}

TEST(Control, OfNamedValuesRangesOverThem) {
  Control::ValueMap values;
  values[10] = "Sine";
  values[20] = "Saw";
  values[5] = "Noise";
  Control const control(k7Bit, 70, "Wave", values);
  EXPECT_TRUE(control.HasValueRange());
  EXPECT_EQ(control.GetMinValue(), 5);
  EXPECT_EQ(control.GetMaxValue(), 20);
  EXPECT_FALSE(control.HasDefaultValue());
  ASSERT_EQ(control.CountValueNames(), 3);
  EXPECT_EQ(control.GetValueName(1),
            std::make_pair(static_cast<unsigned short>(10), UString("Sine")));
  EXPECT_EQ(control.GetValueName(3).second, UString());
  EXPECT_EQ(control.GetValueName(-1).second, UString());
  EXPECT_EQ(control.GetNameForValue(20), UString("Saw"));
  EXPECT_EQ(control.GetNameForValue(15), UString());

  Control const copy(control);
  EXPECT_EQ(&copy, &copy);
  EXPECT_EQ(Impl::ControlParts::ValueNames(copy), Impl::ControlParts::ValueNames(control));
  Control const withDefault(k7Bit, 70, "Wave", values, 10);
  EXPECT_TRUE(withDefault.HasDefaultValue());
  EXPECT_EQ(withDefault.GetDefaultValue(), 10);
}

TEST(Control, OfAnEmptyMapHasNeitherRangeNorDefault) {
  Control const control(k7Bit, 70, "Wave", Control::ValueMap());
  EXPECT_FALSE(control.HasValueRange());
  EXPECT_EQ(control.GetMinValue(), 0);
  EXPECT_EQ(control.GetMaxValue(), 0);
  Control const withDefault(k7Bit, 70, "Wave", Control::ValueMap(), 10);
  EXPECT_FALSE(withDefault.HasValueRange());
  EXPECT_FALSE(withDefault.HasDefaultValue());
  EXPECT_EQ(withDefault.CountValueNames(), 0);
}

TEST(Control, WithoutValueNamesNamesNoValue) {
  Control const control(k7Bit, 7, "Volume", 0, 127);
  EXPECT_EQ(control.CountValueNames(), 0);
  EXPECT_EQ(control.GetValueName(0).second, UString());
  EXPECT_EQ(control.GetNameForValue(0), UString());
}

TEST(ValueList, KeepsTheFirstNameOfANumber) {
  Impl::ValueListImpl list("L", true);
  list.Add(3, "b");
  list.Add(1, "a");
  list.Add(3, "c");
  ASSERT_EQ(list.GetValues().size(), 2u);
  EXPECT_EQ(list.GetValues().at(3), UString("b"));
}

// What a control is in one line: type and number, name, d for one that has a default, i for an
// inherited one.
std::vector<std::string> Controls(ControlTable const& table) {
  std::vector<std::string> lines;
  for (ControlEntry const& entry : table.GetControls()) {
    lines.push_back(std::to_string(entry.control.GetType()) + "/" +
                    std::to_string(entry.control.GetNumber()) + " " +
                    entry.control.GetName().string() + (entry.hasDefault ? " d" : "") +
                    (entry.inherited ? "i" : ""));
  }
  return lines;
}

std::vector<std::string> Hidden(ControlTable const& table) {
  std::vector<std::string> lines;
  for (Impl::ControlKey const& key : table.GetHidden()) {
    lines.push_back(std::to_string(key.type) + "/" + std::to_string(key.number));
  }
  return lines;
}

class ControlEditing : public StudioTest {
 protected:
  ControlEditing()
      : names(PlainNames::For(setup.MakePort("Port"))),
        nameSet(new Impl::DestNameSetImpl(&names.GetDestination(), "Set")),
        bank(AddBank(*nameSet, "Bank")),
        patch(AddPatch(*bank, 5)),
        other(AddPatch(*bank, 6)) {
    names.Tree().nameSets.push_back(nameSet);
    defaults->controls.insert(Control(k7Bit, 1, "Mod"));
    defaults->controls.insert(Control(k7Bit, 7, "Volume", 0, 127));
    defaults->controls.insert(Control(k7Bit, 10, "Pan"));
    defaults->controls.insert(Control(k7Bit, 99, ""));
    own->controls.insert(Control(kNRPN, 7, "Cutoff"));
    own->controls.insert(Control(k7Bit, 7, "Loudness"));
    own->controls.insert(Control(k7Bit, 10, ""));
    own->controls.insert(Control(k7Bit, 11, ""));
    own->controls.insert(Control(k7Bit, 12, "", 0, 1));
  }
  void Load() {
    Impl::NameListUses uses;
    uses.nameSetControls[nameSet] = defaults;
    uses.patchControls[patch] = own;
    uses.patchControls[other] = own;
    AssignLists(names.Tree(), uses);
    list = Patch(patch).GetControlNames();
  }
  ControlTable const& TableOf(RCPtrMT<Impl::PatchImpl> const& which) const {
    return *which->GetControls();
  }

  PlainNames& names;
  RCPtrMT<Impl::DestNameSetImpl> const nameSet;
  RCPtrMT<Impl::PatchBankImpl> const bank;
  RCPtrMT<Impl::PatchImpl> const patch;
  RCPtrMT<Impl::PatchImpl> const other;
  RCPtrMT<ControlNameData> const defaults{new ControlNameData("Default", false)};
  RCPtrMT<ControlNameData> const own{new ControlNameData("Own", false)};
  ControlList list;
};

TEST_F(ControlEditing, PutsTheDefaultsBeneathThePatchsList) {
  Load();
  EXPECT_THAT(Controls(TableOf(patch)),
              ElementsAre("0/1 Mod di", "0/7 Loudness d", "0/12 ", "3/7 Cutoff"));
  EXPECT_THAT(Hidden(TableOf(patch)), ElementsAre("0/10"));
  EXPECT_TRUE(TableOf(patch).IsShared());
  EXPECT_EQ(list.GetName(), UString("Own"));
  EXPECT_EQ(patch->GetControls(), other->GetControls());
}

TEST_F(ControlEditing, OfOneListAloneItHasThatList) {
  RCPtrMT<ControlTable> const ofDefault = ControlTable::Merge(defaults.get(), nullptr);
  EXPECT_THAT(Controls(*ofDefault), ElementsAre("0/1 Mod di", "0/7 Volume di", "0/10 Pan di"));
  EXPECT_TRUE(ofDefault->IsShared());
  EXPECT_EQ(ofDefault->GetName(), UString("Default"));
  RCPtrMT<ControlTable> const ofPatch = ControlTable::Merge(nullptr, own.get());
  EXPECT_THAT(Controls(*ofPatch), ElementsAre("0/7 Loudness", "0/12 ", "3/7 Cutoff"));
  EXPECT_THAT(Hidden(*ofPatch), IsEmpty());
  EXPECT_FALSE(ofPatch->IsShared());
  RCPtrMT<ControlNameData> const named(new ControlNameData("N", true));
  EXPECT_TRUE(ControlTable::Merge(nullptr, named.get())->IsShared());
}

TEST_F(ControlEditing, ReadsWhatTheTableHas) {
  Load();
  ASSERT_EQ(list.CountControls(), 4);
  EXPECT_EQ(list.GetControl(3).GetName(), UString("Cutoff"));
  EXPECT_EQ(list.GetControl(4).GetName(), UString());
  EXPECT_EQ(list.GetControl(-1).GetName(), UString());
  EXPECT_EQ(list.GetControl(k7Bit, 7).GetName(), UString("Loudness"));
  EXPECT_EQ(list.GetControl(kNRPN, 7).GetName(), UString("Cutoff"));
  EXPECT_FALSE(list.HasControl(kControlRPN, 7));
  EXPECT_FALSE(list.HasControl(k7Bit, 10));
  EXPECT_EQ(list.GetControl(k7Bit, 10).GetName(), UString());
  EXPECT_EQ(list.GetPatch(), Patch(patch));
  DefaultControlList const ofNameSet(nameSet);
  EXPECT_EQ(ofNameSet.GetName(), UString("Default"));
  EXPECT_TRUE(ofNameSet.HasControl(k7Bit, 10));
  EXPECT_EQ(ofNameSet.GetNameSet(), DestinationNameSet(nameSet));
}

TEST_F(ControlEditing, SplitsTheTableOffAtTheFirstEdit) {
  Load();
  list.SetControl(Control(k7Bit, 1, "Wheel"));
  EXPECT_EQ(list.GetControl(k7Bit, 1).GetName(), UString("Wheel"));
  EXPECT_EQ(Patch(other).GetControlNames().GetControl(k7Bit, 1).GetName(), UString("Mod"));
  EXPECT_TRUE(TableOf(patch).IsEditable());
  EXPECT_FALSE(TableOf(patch).IsShared());
  EXPECT_TRUE(TableOf(other).IsShared());
  ASSERT_EQ(names.GetEditedBanks().size(), 1u);
  EXPECT_EQ(*names.GetEditedBanks().begin(), bank);
  names.SaveEditedBanks();
  list.ClearControl(k7Bit, 1);
  EXPECT_TRUE(names.GetEditedBanks().empty());
}

TEST_F(ControlEditing, NotesAndControlsMarkEachForItself) {
  Load();
  list.SetControl(Control(k7Bit, 1, "Wheel"));
  names.SaveEditedBanks();
  Patch(patch).GetNoteNames().SetNoteName(60, "C");
  EXPECT_EQ(names.GetEditedBanks().size(), 1u);
}

TEST_F(ControlEditing, MakesATableWithoutNameWhereThereIsNone) {
  ControlList const fresh = Patch(patch).GetControlNames();
  EXPECT_EQ(fresh.CountControls(), 0);
  fresh.SetControl(Control(k7Bit, 1, "Wheel"));
  EXPECT_EQ(fresh.GetName(), UString());
  EXPECT_THAT(Controls(TableOf(patch)), ElementsAre("0/1 Wheel"));
}

TEST_F(ControlEditing, AChangedDefaultIsThePatchsOwn) {
  Load();
  list.SetControl(Control(k7Bit, 1, "Wheel"));
  EXPECT_THAT(Controls(TableOf(patch)),
              ElementsAre("0/1 Wheel d", "0/7 Loudness d", "0/12 ", "3/7 Cutoff"));
}

TEST_F(ControlEditing, AClearedDefaultIsHiddenUntilItIsSet) {
  Load();
  list.ClearControl(k7Bit, 1);
  EXPECT_FALSE(list.HasControl(k7Bit, 1));
  EXPECT_THAT(Hidden(TableOf(patch)), ElementsAre("0/1", "0/10"));
  list.ClearControl(k7Bit, 1);
  list.SetControl(Control(k7Bit, 1, "Back"));
  list.SetControl(Control(k7Bit, 10, "Panorama"));
  EXPECT_THAT(Hidden(TableOf(patch)), IsEmpty());
  EXPECT_THAT(Controls(TableOf(patch)), ElementsAre("0/1 Back d", "0/7 Loudness d",
                                                    "0/10 Panorama d", "0/12 ", "3/7 Cutoff"));
}

TEST_F(ControlEditing, AClearedControlOfThePatchIsGone) {
  Load();
  list.ClearControl(kNRPN, 7);
  list.ClearControl(kNRPN, 8);
  EXPECT_THAT(Hidden(TableOf(patch)), ElementsAre("0/10"));
  EXPECT_EQ(list.CountControls(), 3);
}

TEST_F(ControlEditing, ANewControlHasNoDefault) {
  Load();
  list.SetControl(Control(kControl14Bit, 1, "Fine"));
  EXPECT_THAT(Controls(TableOf(patch)),
              ElementsAre("0/1 Mod di", "0/7 Loudness d", "0/12 ", "1/1 Fine", "3/7 Cutoff"));
}

}  // namespace
}  // namespace Ostinet::Testing

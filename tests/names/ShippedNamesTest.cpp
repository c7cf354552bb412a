// SPDX-License-Identifier: MIT
//
// The documents that ship.
#include <gtest/gtest.h>

#include <set>

#include "ReadDocument.h"
#include "ostinet/NameDocument.h"

namespace Ostinet::Testing {
namespace {

File ShippedFile(char const* name) {
  return Folder(FileSpecification(UString(OSTINET_SHIPPED_NAMES))).GetFile(name);
}

class ShippedNamesTest : public ::testing::TestWithParam<char const*> {};

TEST_P(ShippedNamesTest, AreStandardAndReadWhole) {
  NameDocumentCheck const check = CheckNameDocument(ShippedFile(GetParam()));
  EXPECT_TRUE(check.isStandard);
  for (NameDocumentFinding const& finding : check.findings) {
    ADD_FAILURE() << "line " << finding.line << ": " << finding.text.string();
  }
}

INSTANTIATE_TEST_SUITE_P(Files, ShippedNamesTest,
                         ::testing::Values("General-MIDI.midnam", "Default-Names.midnam"));

class StandardMode {
 public:
  StandardMode(char const* file, char const* mode) : reader_(Impl::NameDocumentOwner()) {
    EXPECT_TRUE(reader_.LoadStandardMode(ShippedFile(file), mode));
    Impl::AssignLists(reader_.tree, reader_.uses);
  }

  DestinationNameSet On(int channel) const {
    return DestinationNameSet(
        RCPtrMT<Impl::DestNameSetImpl>(reader_.tree.modes.at(0)->GetNameSet(channel)));
  }

 private:
  Impl::NameDocumentReader reader_;
};

TEST(GeneralMIDI, HasItsProgramsInGroups) {
  StandardMode const mode("General-MIDI.midnam", "General MIDI");
  DestinationNameSet const nameSet = mode.On(0);
  EXPECT_EQ(nameSet.GetChannels(), 0xFDFF);
  ASSERT_EQ(nameSet.CountBanks(), 16);
  std::set<int> programs;
  for (int i = 0; i < nameSet.CountBanks(); ++i) {
    EXPECT_EQ(nameSet.GetBank(i).CountPatches(), 8);
    for (int k = 0; k < nameSet.GetBank(i).CountPatches(); ++k) {
      programs.insert(nameSet.GetBank(i).GetPatch(k).GetProgramChange());
    }
  }
  EXPECT_EQ(programs.size(), 128U);
  EXPECT_EQ(nameSet.GetBank(0).GetBankName(), UString("Piano"));
  EXPECT_EQ(nameSet.GetBank(0).GetPatch(0).GetNumberAndName(), UString("1 Acoustic Grand Piano"));
  EXPECT_EQ(nameSet.GetBank(15).GetPatch(7).GetNumberAndName(), UString("128 Gunshot"));
  for (int channel = 1; channel < 16; ++channel) {
    EXPECT_EQ(mode.On(channel) == nameSet, channel != 9) << channel;
  }
}

TEST(GeneralMIDI, HasPercussionOnChannel10) {
  StandardMode const mode("General-MIDI.midnam", "General MIDI");
  DestinationNameSet const nameSet = mode.On(9);
  EXPECT_EQ(nameSet.GetChannels(), 0x0200);
  NoteNameList const notes = nameSet.GetBank(0).GetPatch(0).GetNoteNames();
  EXPECT_EQ(notes.CountNoteNames(), 47);
  EXPECT_EQ(notes.GetNoteNameForPitch(35), UString("Acoustic Bass Drum"));
  EXPECT_EQ(notes.GetNoteNameForPitch(81), UString("Open Triangle"));
  EXPECT_FALSE(mode.On(0).GetBank(0).GetPatch(0).GetNoteNames().HasNames());
}

TEST(DefaultNames, NumberPatchesAndNamePitches) {
  StandardMode const mode("Default-Names.midnam", "Default Names");
  DestinationNameSet const nameSet = mode.On(15);
  EXPECT_EQ(nameSet.GetChannels(), 0xFFFF);
  PatchBank const bank = nameSet.GetBank(255, 255);
  ASSERT_EQ(bank.CountPatches(), 128);
  EXPECT_EQ(bank.GetPatch(127).GetProgramChange(), 127);
  EXPECT_EQ(bank.GetPatch(4).GetNumber(), UString("5"));
  NoteNameList const notes = bank.GetPatch(0).GetNoteNames();
  EXPECT_EQ(notes.CountNoteNames(), 128);
  EXPECT_EQ(notes.GetNoteNameForPitch(0), UString("C-1"));
  EXPECT_EQ(notes.GetNoteNameForPitch(60), UString("C4"));
  EXPECT_EQ(notes.GetNoteNameForPitch(127), UString("G9"));
}

TEST(DefaultNames, NameTheControlsOfTheStandard) {
  StandardMode const mode("Default-Names.midnam", "Default Names");
  ControlList const controls = mode.On(0).GetBank(0).GetPatch(0).GetControlNames();
  Control const wheel = controls.GetControl(ControlType(0), 1);
  EXPECT_EQ(wheel.GetName(), UString("Modulation Wheel"));
  EXPECT_EQ(wheel.GetMaxValue(), 127);
  EXPECT_EQ(controls.GetControl(ControlType(1), 7).GetMaxValue(), 16383);
  EXPECT_EQ(controls.GetControl(ControlType(2), 0).GetName(), UString("Pitch Bend Sensitivity"));
  EXPECT_TRUE(controls.HasControl(ControlType(0), 124));
  EXPECT_FALSE(controls.HasControl(ControlType(0), 3)) << "nothing is defined for it";
}

}  // namespace
}  // namespace Ostinet::Testing

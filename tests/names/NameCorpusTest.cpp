// SPDX-License-Identifier: MIT
//
// Documents that users made for real instruments. They are not part of the tree: the environment
// variable OSTINET_NAME_CORPUS names their folder, or the CMake setting of that name.
#include <gtest/gtest.h>

#include <algorithm>

#include "core/SystemServices.h"
#include "ostinet/NameDocument.h"
#include "support/Printers.h"

namespace Ostinet::Testing {
namespace {

struct Totals {
  int modes = 0, nameSets = 0, banks = 0, patches = 0, notes = 0, controls = 0;
};

class NameCorpusTest : public ::testing::Test {
 protected:
  void SetUp() override {
    auto const variable = SystemServices::Environment("OSTINET_NAME_CORPUS");
    folder = Folder(FileSpecification(variable ? *variable : UString(OSTINET_NAME_CORPUS)));
    for (FolderIterator it(folder, FolderIterator::kFilesOnly); !it.AtEnd(); ++it) {
      if (it->GetName().ends_with(".midnam")) {
        files.push_back(*it);
      }
    }
    if (files.empty()) {
      GTEST_SKIP() << "no documents in OSTINET_NAME_CORPUS, " << folder.GetFullPath().string();
    }
  }

  NameDocument Read(char const* name) const { return NameDocument(folder.GetFile(name)); }

  Folder folder;
  std::vector<FileSpecification> files;
};

PatchBank BankNamed(NameDocument const& document, char const* name) {
  for (int i = 0; i < document.CountNameSets(); ++i) {
    DestinationNameSet const nameSet = document.GetNameSet(i);
    for (int k = 0; k < nameSet.CountBanks(); ++k) {
      if (nameSet.GetBank(k).GetBankName() == UString(name)) {
        return nameSet.GetBank(k);
      }
    }
  }
  return {};
}

TEST_F(NameCorpusTest, AllAreReadWhole) {
  Totals totals;
  for (FileSpecification const& file : files) {
    SCOPED_TRACE(file.GetName().string());
    NameDocument const document(file);
    EXPECT_TRUE(document.IsWhole());
    EXPECT_EQ(document.CountModes(), 1);
    totals.modes += document.CountModes();
    totals.nameSets += document.CountNameSets();
    for (int i = 0; i < document.CountNameSets(); ++i) {
      DestinationNameSet const nameSet = document.GetNameSet(i);
      totals.notes += NameDocument::GetDefaultNotes(nameSet).CountNoteNames();
      totals.controls += NameDocument::GetDefaultControls(nameSet).CountControls();
      totals.banks += nameSet.CountBanks();
      for (int k = 0; k < nameSet.CountBanks(); ++k) {
        totals.patches += nameSet.GetBank(k).CountPatches();
      }
    }
  }
  EXPECT_EQ(files.size(), 40U);
  EXPECT_EQ(totals.modes, 40);
  EXPECT_EQ(totals.nameSets, 41 + 1) << "one mode refers to a set that is not there";
  EXPECT_EQ(totals.banks, 204);
  EXPECT_EQ(totals.patches, 9717);
  EXPECT_EQ(totals.notes, 17 + 59 + 53 + 85);
  EXPECT_EQ(totals.controls, 348 - 30 - 2) << "a list is misspelled, and two controls stand twice";
}

TEST_F(NameCorpusTest, BanksHaveTheirNumbers) {
  NameDocument const document = Read("Roland_SonicCell.midnam");
  PatchBank const bank = BankNamed(document, "Preset F");
  EXPECT_EQ(bank.GetController0Number(), 87);
  EXPECT_EQ(bank.GetController32Number(), 69);
  EXPECT_EQ(bank.CountPatches(), 128);
  EXPECT_EQ(bank.GetPatch(0).GetNumberAndName(), UString("001 ResoSweep Dn"));
  EXPECT_EQ(bank.GetPatch(127).GetPatchNumbers().program, 127);
  DestinationNameSet const nameSet = document.GetNameSet(0);
  EXPECT_EQ(nameSet.GetBank(87, 69), bank);
  EXPECT_EQ(nameSet.GetChannels(), 0xFFFF);
}

TEST_F(NameCorpusTest, ListsStandBehindTheBanksThatUseThem) {
  NameDocument const document = Read("DSI_Evolver.midnam");
  PatchBank const bank = BankNamed(document, "User Patches Bank 2");
  EXPECT_EQ(bank.GetController0Number(), 255);
  EXPECT_EQ(bank.GetController32Number(), 1);
  EXPECT_EQ(bank.CountPatches(), 128);
}

TEST_F(NameCorpusTest, PatchesHaveBankSelectsOfTheirOwn) {
  NameDocument const document = Read("Yamaha_PSR_275.midnam");
  DestinationNameSet const nameSet = document.GetNameSet(0);
  bool found = false;
  for (int i = 0; i < nameSet.CountBanks(); ++i) {
    for (int k = 0; k < nameSet.GetBank(i).CountPatches(); ++k) {
      Patch const patch = nameSet.GetBank(i).GetPatch(k);
      if (patch.GetNumber() == UString("297")) {
        found = true;
        EXPECT_EQ(patch.GetName(), UString("Trumpet & Trombone Sect."));
        PatchNumbers const numbers = patch.GetPatchNumbers();
        EXPECT_EQ(numbers.program, 61);
        EXPECT_EQ(numbers.msb, 0);
        EXPECT_EQ(numbers.lsb, 35);
        EXPECT_EQ(patch.GetProgramChange(), 255);
        EXPECT_EQ(patch.GetNoteNames().CountNoteNames(), 0) << "it names a list without a name";
      }
    }
  }
  EXPECT_TRUE(found);
}

TEST_F(NameCorpusTest, KitsHaveTheirNotes) {
  NameDocument const document = Read("MFB_503.midnam");
  DestinationNameSet const nameSet = document.GetNameSet(0);
  DefaultNoteNameList const notes = NameDocument::GetDefaultNotes(nameSet);
  EXPECT_EQ(notes.GetName(), UString("Standard Notes"));
  EXPECT_EQ(notes.GetNoteNameForPitch(36), UString("Bass Drum"));
  EXPECT_EQ(notes.GetNoteNameForPitch(38), UString("Snare Drum"));
  EXPECT_EQ(nameSet.GetBank(0).CountPatches(), 100);
}

TEST_F(NameCorpusTest, ModesHaveCommands) {
  NameDocument const document = Read("Yamaha_SY85.midnam");
  DestinationMode const mode = document.GetMode(0);
  EXPECT_TRUE(mode.SelectableWithMIDI());
  DataBuffer buffer;
  mode.GetEnablingCommand(buffer, TimeStamp(), 0);
  ASSERT_EQ(buffer.size(), 5U);
  std::vector<unsigned char> const last(buffer.back().data,
                                        buffer.back().data + buffer.back().length);
  EXPECT_EQ(last, (std::vector<unsigned char>{0xF0, 0x43, 0x10, 0x29, 0x04, 0x00, 0x00, 0x07, 0x00,
                                              0x02, 0xF7}));
  EXPECT_EQ(document.GetNameSet(0).GetBank(0).GetPatch(0).GetName(), UString("A1: SP Makro "));
}

TEST_F(NameCorpusTest, ControlsAreReadWithoutBanks) {
  NameDocument const document = Read("Moog_Grandmother.midnam");
  EXPECT_EQ(document.GetNameSet(0).CountBanks(), 0);
  DefaultControlList const controls = NameDocument::GetDefaultControls(document.GetNameSet(0));
  EXPECT_EQ(controls.CountControls(), 30);
}

TEST_F(NameCorpusTest, MisspelledReferencesAreFound) {
  NameDocumentCheck const check = CheckNameDocument(folder.GetFile("MFB_503.midnam"));
  EXPECT_TRUE(check.isStandard);
  ASSERT_FALSE(check.findings.empty());
  EXPECT_EQ(check.findings[0].line, 48);
  EXPECT_EQ(check.findings[0].text,
            UString("UsesControlNameList \"Standard Control\" names a list without controls"));
}

TEST_F(NameCorpusTest, AllButTwoAreStandard) {
  std::vector<std::string> others;
  for (FileSpecification const& file : files) {
    NameDocumentCheck const check = CheckNameDocument(file);
    EXPECT_TRUE(check.isWellFormed) << file.GetName().string();
    if (!check.isStandard) {
      others.push_back(file.GetName().string());
    }
  }
  EXPECT_EQ(others,
            (std::vector<std::string>{"Arturia_DrumBrute.midnam", "Moog_Grandmother.midnam"}));
}

}  // namespace
}  // namespace Ostinet::Testing

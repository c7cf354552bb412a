// SPDX-License-Identifier: MIT
#include "names/SmallTree.h"

namespace Ostinet::Testing {
namespace {

using Impl::DestNameSetImpl;
using Impl::PatchBankImpl;
using Impl::PatchImpl;

class PatchLookup : public ::testing::Test {
 protected:
  PatchBank GetBank(unsigned char msb, unsigned char lsb) const {
    return DestinationNameSet(nameSet).GetBank(msb, lsb);
  }
  Patch Find(unsigned char program, unsigned char msb, unsigned char lsb) const {
    return Patch(nameSet->FindPatch(PatchNumbers(program, msb, lsb)));
  }
  Patch Playing(unsigned char program, unsigned char msb, unsigned char lsb) const {
    return Patch(nameSet->FindPlayingPatch(PatchNumbers(program, msb, lsb)));
  }

  RCPtrMT<DestNameSetImpl> const nameSet{new DestNameSetImpl(nullptr, "Set")};
};

TEST_F(PatchLookup, ABankIsFoundByItsNumbers) {
  AddBank(*nameSet, "A", 1, 2);
  PatchBank const second(AddBank(*nameSet, "B", 1, 3));
  AddBank(*nameSet, "C", 1, 3);
  EXPECT_EQ(GetBank(1, 3), second);
  EXPECT_FALSE(GetBank(1, 4).Exists());
  EXPECT_FALSE(GetBank(1, kNoNumber).Exists());
}

TEST_F(PatchLookup, TheCurrentBankComesFirst) {
  AddBank(*nameSet, "A", 1, 2);
  RCPtrMT<PatchBankImpl> const second = AddBank(*nameSet, "B", 1, 2);
  nameSet->SetCurrentBank(second);
  EXPECT_EQ(GetBank(1, 2), PatchBank(second));
}

TEST_F(PatchLookup, WithoutNumbersOnlyALoneBankIsFound) {
  EXPECT_FALSE(GetBank(kNoNumber, kNoNumber).Exists());
  RCPtrMT<PatchBankImpl> const bank = AddBank(*nameSet, "A");
  EXPECT_EQ(GetBank(kNoNumber, kNoNumber), PatchBank(bank));
  AddBank(*nameSet, "B");
  EXPECT_FALSE(GetBank(kNoNumber, kNoNumber).Exists());
  nameSet->SetCurrentBank(bank);
  EXPECT_EQ(GetBank(kNoNumber, kNoNumber), PatchBank(bank));
}

TEST_F(PatchLookup, WithoutNumbersALoneBankWithNumbersIsNotFound) {
  AddBank(*nameSet, "A", 1, 2);
  EXPECT_FALSE(GetBank(kNoNumber, kNoNumber).Exists());
}

TEST_F(PatchLookup, APatchIsFoundInTheBankOfItsNumbers) {
  RCPtrMT<PatchBankImpl> const first = AddBank(*nameSet, "A", 1, 2);
  RCPtrMT<PatchBankImpl> const second = AddBank(*nameSet, "B", 1, 3);
  AddPatch(*first, 5);
  Patch const patch(AddPatch(*second, 5));
  AddPatch(*second, 5);
  EXPECT_EQ(Find(5, 1, 3), patch);
  EXPECT_FALSE(Find(6, 1, 3).Exists());
  EXPECT_FALSE(Find(5, kNoNumber, kNoNumber).Exists());
}

TEST_F(PatchLookup, APatchWithItsOwnBankSelectIsFoundInAnyBank) {
  RCPtrMT<PatchBankImpl> const first = AddBank(*nameSet, "A", 1, 2);
  AddBank(*nameSet, "B", 3, 4);
  Patch const patch(AddPatch(*first, 5, 9));
  EXPECT_EQ(patch.GetPatchNumbers().msb, 9);
  EXPECT_EQ(patch.GetPatchNumbers().lsb, 2);
  EXPECT_FALSE(GetBank(9, 2).Exists());
  EXPECT_EQ(Find(5, 9, 2), patch);
}

TEST_F(PatchLookup, TheCurrentBankIsSearchedBeforeTheOthers) {
  RCPtrMT<PatchBankImpl> const first = AddBank(*nameSet, "A", 1, 2);
  RCPtrMT<PatchBankImpl> const second = AddBank(*nameSet, "B", 3, 4);
  Patch const inFirst(AddPatch(*first, 5, 9, 9));
  Patch const inSecond(AddPatch(*second, 5, 9, 9));
  EXPECT_EQ(Find(5, 9, 9), inFirst);
  nameSet->SetCurrentBank(second);
  EXPECT_EQ(Find(5, 9, 9), inSecond);
}

TEST_F(PatchLookup, ABankOfTheRightNumbersWithoutThePatchIsNotTheEnd) {
  RCPtrMT<PatchBankImpl> const first = AddBank(*nameSet, "A", 1, 2);
  RCPtrMT<PatchBankImpl> const second = AddBank(*nameSet, "B", 3, 4);
  AddPatch(*first, 1);
  Patch const patch(AddPatch(*second, 5, 1, 2));
  EXPECT_EQ(Find(5, 1, 2), patch);
}

TEST_F(PatchLookup, TheCurrentBankMayBelongElsewhere) {
  RCPtrMT<DestNameSetImpl> const other(new DestNameSetImpl(nullptr, "Other"));
  RCPtrMT<PatchBankImpl> const bank = AddBank(*other, "A", 1, 2);
  Patch const patch(AddPatch(*bank, 5));
  nameSet->SetCurrentBank(bank);
  EXPECT_EQ(GetBank(1, 2), PatchBank(bank));
  EXPECT_EQ(Find(5, 1, 2), patch);
  EXPECT_FALSE(Playing(5, 1, 2).Exists());  // the banks of the name set alone
}

TEST_F(PatchLookup, ThePlayingPatchIsOfTheProgramSeen) {
  RCPtrMT<PatchBankImpl> const bank = AddBank(*nameSet, "A", 1, 2);
  AddPatch(*bank, 4);
  Patch const patch(AddPatch(*bank, 5));
  EXPECT_EQ(Playing(5, 1, 2), patch);
  EXPECT_EQ(Playing(5, kNoNumber, kNoNumber), patch);
  EXPECT_FALSE(Playing(6, 1, 2).Exists());
}

TEST_F(PatchLookup, APatchThatFitsInNothingElseStillPlays) {
  RCPtrMT<PatchBankImpl> const bank = AddBank(*nameSet, "A", 1, 2);
  Patch const patch(AddPatch(*bank, 5));
  EXPECT_EQ(Playing(5, 9, 9), patch);
}

TEST_F(PatchLookup, TheNumbersOfTheBankDecideWhatPlays) {
  AddPatch(*AddBank(*nameSet, "A", 1, 2), 5);
  AddPatch(*AddBank(*nameSet, "B", 1, 3), 5);
  Patch const patch(AddPatch(*AddBank(*nameSet, "C", 2, 3), 5));
  EXPECT_EQ(Playing(5, 2, 3), patch);
}

TEST_F(PatchLookup, OfEqualsTheFirstPlays) {
  RCPtrMT<PatchBankImpl> const first = AddBank(*nameSet, "A", 1, 2);
  Patch const patch(AddPatch(*first, 5));
  AddPatch(*first, 5);
  AddPatch(*AddBank(*nameSet, "B", 1, 2), 5);
  EXPECT_EQ(Playing(5, 1, 2), patch);
}

TEST_F(PatchLookup, TheCurrentBankWinsAmongEquals) {
  AddPatch(*AddBank(*nameSet, "A"), 5);
  RCPtrMT<PatchBankImpl> const current = AddBank(*nameSet, "B");
  Patch const patch(AddPatch(*current, 5));
  nameSet->SetCurrentBank(current);
  EXPECT_EQ(Playing(5, kNoNumber, kNoNumber), patch);
}

// A bank that fits is worth less than the patch's own numbers that do.
TEST_F(PatchLookup, ThePatchsOwnNumbersCountMoreThanItsBanks) {
  AddPatch(*AddBank(*nameSet, "A", 1, 2), 5, 8, 8);
  Patch const patch(AddPatch(*AddBank(*nameSet, "B", 7, 7), 5, 1, 2));
  EXPECT_EQ(Playing(5, 1, 2), patch);
}

TEST_F(PatchLookup, TheCurrentBankDoesNotOutweighANumber) {
  RCPtrMT<PatchBankImpl> const current = AddBank(*nameSet, "A", 1, 2);
  AddPatch(*current, 5);
  Patch const patch(AddPatch(*AddBank(*nameSet, "B", 1, 3), 5));
  nameSet->SetCurrentBank(current);
  EXPECT_EQ(Playing(5, 1, 3), patch);
}

// Nothing was sent on the channel: what has no program is as good as anything.
TEST_F(PatchLookup, BeforeAnyProgramChangeAPatchWithoutProgramPlays) {
  RCPtrMT<PatchBankImpl> const bank = AddBank(*nameSet, "A", 1, 2);
  AddPatch(*bank, 5);
  EXPECT_FALSE(Playing(kNoNumber, kNoNumber, kNoNumber).Exists());
  Patch const patch(AddPatch(*bank, kNoNumber));
  EXPECT_EQ(Playing(kNoNumber, kNoNumber, kNoNumber), patch);
}

}  // namespace
}  // namespace Ostinet::Testing

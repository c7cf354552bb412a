// SPDX-License-Identifier: MIT
#include <gtest/gtest.h>

#include <stdexcept>

#include "matching/HexBytes.h"
#include "ostinet/Endpoint.h"

namespace Ostinet {
namespace {

using Testing::FirstBytes;
using Testing::FromHex;

SlotID Slot(unsigned int first) {
  SlotID slot;
  for (unsigned int& word : slot.words) {
    word = first++;
  }
  return slot;
}

// Bytes of no meaning: every query answers, and a change of the slot stays within them.
void AskEverything(MatchData data) {
  EXPECT_NO_THROW({
    data.GetObjectName();
    data.GetObjectType();
    data.ObjectIsSoftware();
    data.ObjectIsInternalSoftware();
    data.GetContents();
    std::size_t const size = data.size();
    SlotID const slot = data.GetSlotID();
    data.SetSlotID(Slot(100));
    SlotID const changed = data.GetSlotID();
    EXPECT_TRUE(changed == Slot(100) || changed == SlotID()) << Testing::ToHex(data);
    data.SetSlotID(slot);
    EXPECT_EQ(data.GetSlotID(), slot);
    EXPECT_EQ(data.size(), size);
  });
}

TEST(MatchDataQueries, TellWhatAnInternalEndpointIs) {
  MatchData const data = FromHex(Testing::kInternalSource);
  EXPECT_EQ(data.GetObjectName(), UString("FX"));
  EXPECT_EQ(data.GetObjectType(), Source::kObjectID);
  EXPECT_TRUE(data.ObjectIsSoftware());
  EXPECT_TRUE(data.ObjectIsInternalSoftware());
  EXPECT_EQ(data.GetSlotID(), Slot(1));
}

TEST(MatchDataQueries, TellWhatAnExternalEndpointIs) {
  MatchData const data = FromHex(Testing::kExternalDestination);
  EXPECT_EQ(data.GetObjectName(), UString("Pad"));
  EXPECT_FALSE(data.ObjectIsSoftware());
  EXPECT_FALSE(data.ObjectIsInternalSoftware());
  EXPECT_EQ(data.GetSlotID(), SlotID());
}

TEST(MatchDataQueries, GiveAllContents) {
  MatchContents const contents = FromHex(Testing::kExternalDestination).GetContents();
  EXPECT_TRUE(contents.isValid);
  EXPECT_EQ(contents.implementation, Properties::kPlatformImplementation);
  EXPECT_EQ(contents.objectType, Destination::kObjectID);
  EXPECT_EQ(contents.name, UString("Pad"));
  EXPECT_TRUE(contents.nameIsFull);
  EXPECT_EQ(contents.uniqueID, 0x01020304);
  EXPECT_EQ(contents.connectionUniqueID, 0x0A0B0C0D);
  EXPECT_EQ(contents.manufacturer, UString("Ac"));
  EXPECT_EQ(contents.model, UString("S"));
  EXPECT_EQ(contents.isDirect, false);
  EXPECT_EQ(contents.isSoftware, false);
  EXPECT_EQ(contents.supportsGeneralMIDI, true);
  EXPECT_EQ(contents.isInternalSoftware, false);
  EXPECT_EQ(contents.slot, SlotID());
}

TEST(MatchDataQueries, SayNothingOfWhatABareNameLeavesOut) {
  MatchContents const contents = FromHex(Testing::kNameOnly).GetContents();
  EXPECT_TRUE(contents.isValid);
  EXPECT_EQ(contents.supportsGeneralMIDI, false);
  EXPECT_FALSE(contents.isInternalSoftware.has_value());
  EXPECT_FALSE(contents.slot.has_value());
  EXPECT_FALSE(FromHex(Testing::kNameOnly).ObjectIsInternalSoftware());
}

// What another backend wrote in its own section means nothing here.
TEST(MatchDataQueries, ReadTheIDsOfThisBackendOnly) {
  EXPECT_EQ(FromHex(Testing::kOlderSoftware).GetContents().uniqueID, 0);
  EXPECT_EQ(FromHex(Testing::kInternalSource).GetContents().uniqueID, 7);
}

TEST(MatchDataQueries, AnEmptyReferenceNamesNothing) {
  MatchData const data;
  EXPECT_EQ(data.GetObjectType(), MatchObjectID(0));
  EXPECT_EQ(data.GetObjectName(), UString());
  EXPECT_FALSE(data.GetContents().isValid);
  EXPECT_THROW(
      {
        try {
          data.at(0);
        } catch (std::out_of_range const& error) {
          EXPECT_STREQ(error.what(), "Ostinet::MatchData");
          throw;
        }
      },
      std::out_of_range);
}

TEST(MatchDataQueries, ANameNeedsAnObjectType) {
  MatchData data = FromHex(Testing::kInternalSource);
  data[11] = 0;
  EXPECT_EQ(data.GetObjectName(), UString());
}

TEST(MatchDataQueries, ANameSurvivesWithoutWhatFollows) {
  constexpr std::size_t kBehindName = 20;
  MatchData const data = FromHex(Testing::kInternalSource);
  EXPECT_EQ(FirstBytes(data, kBehindName).GetObjectName(), UString("FX"));
  EXPECT_EQ(FirstBytes(data, kBehindName - 1).GetObjectName(), UString());
  EXPECT_EQ(FirstBytes(data, kBehindName - 1).GetObjectType(), Source::kObjectID);
}

TEST(MatchDataQueries, AnotherVersionOfTheSecondSectionIsLeftAlone) {
  MatchData data = FromHex(Testing::kInternalSource);
  constexpr std::size_t kVersion2 = 20 + 4 + 13 + 4 - 1 + 3;
  ASSERT_EQ(data[kVersion2], 0);
  data[kVersion2] = 1;
  EXPECT_FALSE(data.ObjectIsSoftware());
  EXPECT_FALSE(data.ObjectIsInternalSoftware());
  MatchData const before = data;
  data.SetSlotID(Slot(9));
  EXPECT_EQ(data, before);
}

TEST(MatchDataQueries, OnlyEndpointsAreSoftware) {
  MatchData data = FromHex(Testing::kInternalSource);
  for (char const type : {'\1', '\2', '\5', '\6', '\7'}) {
    data[11] = type;
    EXPECT_FALSE(data.ObjectIsSoftware());
    EXPECT_EQ(data.GetSlotID(), SlotID());
  }
}

TEST(MatchDataQueries, SetTheSlotInPlace) {
  MatchData data = FromHex(Testing::kInternalSource);
  data.SetSlotID(Slot(0x01020304));
  EXPECT_EQ(data.GetSlotID(), Slot(0x01020304));
  EXPECT_EQ(data.size(), FromHex(Testing::kInternalSource).size());
  EXPECT_EQ(data.GetObjectName(), UString("FX"));
}

TEST(MatchDataQueries, SetNoSlotWhereThereIsNone) {
  for (char const* const layout : {Testing::kNameOnly, Testing::kOlderSoftware}) {
    MatchData data = FromHex(layout);
    MatchData const before = data;
    data.SetSlotID(Slot(1));
    EXPECT_EQ(data, before);
    EXPECT_EQ(data.GetSlotID(), SlotID());
  }
}

TEST(MatchDataQueries, AnswerForEveryPrefix) {
  for (char const* const layout : Testing::kAllLayouts) {
    MatchData const data = FromHex(layout);
    for (std::size_t count = 0; count < data.size(); ++count) {
      MatchData const part = FirstBytes(data, count);
      EXPECT_FALSE(part.GetContents().isValid) << count;
      EXPECT_FALSE(part.ObjectIsSoftware()) << count;
      EXPECT_EQ(part.GetSlotID(), SlotID()) << count;
      AskEverything(part);
    }
    EXPECT_TRUE(data.GetContents().isValid);
  }
}

TEST(MatchDataQueries, AnswerForEveryChangedByte) {
  for (char const* const layout : Testing::kAllLayouts) {
    MatchData const data = FromHex(layout);
    for (std::size_t i = 0; i < data.size(); ++i) {
      for (int value = 0; value < 256; ++value) {
        MatchData changed = data;
        changed[i] = static_cast<char>(value);
        AskEverything(changed);
      }
    }
  }
}

TEST(MatchDataQueries, LongFormsAndShortFormsAreNotConfused) {
  MatchData const data = FromHex("01 00 00 00  03 00 00 00  04 00 00 00  07 00 00 00");
  EXPECT_EQ(data.GetObjectType(), MatchObjectID(0));
}

}  // namespace
}  // namespace Ostinet

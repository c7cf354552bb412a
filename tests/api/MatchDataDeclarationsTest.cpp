// SPDX-License-Identifier: MIT
#include <gtest/gtest.h>

#include <cstddef>

#include "api/Link.h"
#include "ostinet/MatchData.h"

namespace Ostinet::Testing {
namespace {

TEST(Declarations, OfReferencesAreComplete) {
  Link<Const<SlotID, bool, SlotID const&>>(&SlotID::operator==);
  Link<Const<SlotID, bool, SlotID const&>>(&SlotID::operator!=);

  Link<Mutable<MatchData, MatchData&, MatchData const&>>(&MatchData::operator=);
  Link<Const<MatchData, bool, MatchData const&>>(&MatchData::operator==);
  Link<Const<MatchData, bool, MatchData const&>>(&MatchData::operator!=);
  Link<Const<MatchData, size_t>>(&MatchData::size);
  Link<Const<MatchData, bool>>(&MatchData::empty);
  Link<Mutable<MatchData, char*>>(&MatchData::begin);
  Link<Const<MatchData, char const*>>(&MatchData::begin);
  Link<Mutable<MatchData, char*>>(&MatchData::end);
  Link<Const<MatchData, char const*>>(&MatchData::end);
  Link<Mutable<MatchData, std::reverse_iterator<char*>>>(&MatchData::rbegin);
  Link<Const<MatchData, std::reverse_iterator<char const*>>>(&MatchData::rbegin);
  Link<Mutable<MatchData, std::reverse_iterator<char*>>>(&MatchData::rend);
  Link<Const<MatchData, std::reverse_iterator<char const*>>>(&MatchData::rend);
  Link<Mutable<MatchData, char&, size_t>>(&MatchData::operator[]);
  Link<Const<MatchData, char const&, size_t>>(&MatchData::operator[]);
  Link<Mutable<MatchData, char&, size_t>>(&MatchData::at);
  Link<Const<MatchData, char const&, size_t>>(&MatchData::at);
  Link<Const<MatchData, UString>>(&MatchData::GetObjectName);
  Link<Const<MatchData, MatchObjectID>>(&MatchData::GetObjectType);
  Link<Const<MatchData, bool>>(&MatchData::ObjectIsSoftware);
  Link<Const<MatchData, bool>>(&MatchData::ObjectIsInternalSoftware);
  Link<Const<MatchData, SlotID>>(&MatchData::GetSlotID);
  Link<Mutable<MatchData, void, SlotID const&>>(&MatchData::SetSlotID);

  Link<Const<ObjectMatch, int, ObjectMatch::MatchType>>(&ObjectMatch::GetRank);
  Link<Mutable<ObjectMatch, void, ObjectMatch::MatchType, int>>(&ObjectMatch::SetRank);
  Link<Const<ObjectMatch, bool, ObjectMatch::MatchType>>(&ObjectMatch::HasValidRank);
  Link<Const<ObjectMatch, bool, ObjectMatch const&>>(&ObjectMatch::operator==);
  Link<Const<ObjectMatch, bool, ObjectMatch const&>>(&ObjectMatch::operator!=);

  Link<Mutable<MatchTranslator, MatchData, BreviaDestinationMatch const&, bool>>(
      &MatchTranslator::TranslateFromBrevia);
  Link<Mutable<MatchTranslator, BreviaDestinationMatch, MatchData const&, bool&>>(
      &MatchTranslator::TranslateToBrevia);
  Link<Mutable<MatchTranslator, MatchData, MatchObjectID, UString const&>>(
      &MatchTranslator::TranslateFromNameOnly);

  Link<std::vector<MatchLevel> const& (*)()>(&StandardMatch);
  Link<std::vector<MatchLevel> const& (*)()>(&IDAndNameMatch);
  Link<std::vector<MatchLevel> const& (*)()>(&NameAndIDMatch);
}

static_assert(kIsExplicit<size_t, MatchData>, "");
static_assert(MatchData::kMaxSize == 1048576, "");
static_assert(sizeof(SlotID) == 6 * sizeof(unsigned int), "");
static_assert(ObjectMatch::kUniqueIDMatch == 0 && ObjectMatch::kGeneralMIDIMatch == 4, "");

// Hosts have this record in their documents.
static_assert(sizeof(BreviaDestinationMatch) == 278, "");
static_assert(offsetof(BreviaDestinationMatch, fields.name) == 22, "");
static_assert(offsetof(BreviaDestinationMatch, software.long2) == 2, "");

TEST(Declarations, LevelsAreMadeOfTheirParts) {
  MatchLevel const level = {ObjectMatch::kNameMatch, 1, 2};
  EXPECT_EQ(level.matchType, ObjectMatch::kNameMatch);
  EXPECT_FALSE(StandardMatch().empty());
  EXPECT_FALSE(ObjectMatch().HasValidRank(ObjectMatch::kNameMatch));
}

TEST(Declarations, TheOlderFormIsReachedByEachOfItsNames) {
  BreviaDestinationMatch record = {};
  record.fields.manufacturerCode = 1;
  record.fields.modelCode = 2;
  record.fields.word2 = 3;
  record.fields.long4 = 4;
  record.fields.word8 = record.fields.word10 = record.fields.word20 = 5;
  record.fields.name[0] = 0;
  record.software.long2 = 6;
  record.kind = 7;
  EXPECT_EQ(record.fields.kind_, record.software.kind_);
  EXPECT_EQ(sizeof record.bytes, 278u);
  bool isSource = false;
  MatchTranslator translator;
  MatchData const data = translator.TranslateFromNameOnly(MatchObjectID(4), UString("A"));
  EXPECT_EQ(data.GetObjectName(), UString("A"));
  translator.TranslateToBrevia(data, isSource);
  EXPECT_FALSE(isSource);
}

}  // namespace
}  // namespace Ostinet::Testing

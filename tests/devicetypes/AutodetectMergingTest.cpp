// SPDX-License-Identifier: MIT
#include "AutodetectTables.h"
#include "devicetypes/AutodetectMerging.h"

namespace Ostinet {
namespace {

using namespace Testing;
using Impl::AutodetectRequests;
using Impl::ResponsesConflict;

bool Conflict(std::string const& a, std::string const& b) {
  bool const result = ResponsesConflict(*Answer(a), *Answer(b));
  EXPECT_EQ(ResponsesConflict(*Answer(b), *Answer(a)), result);
  return result;
}

// A request with so many answers that conflict with none of another family.
RCPtrMT<Impl::AutodetectRequestImpl> QuestionWith(int answers, int family) {
  auto const request = Question("F0 41 F7");
  for (int i = 0; i < answers; ++i) {
    auto const answer = Answer("F0");
    answer->table.push_back({0, static_cast<unsigned char>(family)});
    answer->table.push_back({0, static_cast<unsigned char>(i)});
    request->responses.push_back(answer);
  }
  return request;
}

// The requests with the inquiry in front, as merging sees them.
AutodetectRequests Merge(AutodetectRequests const& requests) {
  AutodetectRequests merged = {Question("F0 7E F7")};
  for (auto const& request : requests) {
    MergeRequest(merged, request);
  }
  return merged;
}

TEST(AutodetectMerging, SeesNoConflictWhereBytesDiffer) {
  EXPECT_FALSE(Conflict("F0 41 F8 F7", "F0 42 F8 F7"));
  EXPECT_FALSE(Conflict("F0 41 10 20", "F0 41 10 21 30"));
}

TEST(AutodetectMerging, SeesAConflictAtTheEndOfTheShorter) {
  EXPECT_TRUE(Conflict("F0 41", "F0 41 10"));
  EXPECT_TRUE(Conflict("F0 41 10", "F0 41 10"));
  EXPECT_TRUE(Conflict("", "F0 41"));
}

TEST(AutodetectMerging, PassesOverDeviceIDsAndBytesThatMayBeAnything) {
  EXPECT_TRUE(Conflict("F0 ID 10", "F0 42 10"));
  EXPECT_TRUE(Conflict("F0 F8 10", "F0 42 10"));
  EXPECT_TRUE(Conflict("F0 FF 10", "F0 F9 10"));
  EXPECT_FALSE(Conflict("F0 F7 10", "F0 F6 10")) << "F7 is a byte like others";
}

TEST(AutodetectMerging, SeesNoConflictWithAStrictAnswerOfAnotherLength) {
  auto const strict = Answer("F0 41");
  strict->strict = true;
  EXPECT_FALSE(ResponsesConflict(*strict, *Answer("F0 41 10")));
  EXPECT_FALSE(ResponsesConflict(*Answer("F0 41 10"), *strict));
  EXPECT_TRUE(ResponsesConflict(*strict, *Answer("F0 41")));
}

TEST(AutodetectMerging, MergesUpToTenAnswers) {
  AutodetectRequests const merged = Merge({QuestionWith(5, 0x41), QuestionWith(5, 0x42)});
  ASSERT_EQ(merged.size(), 2u);
  EXPECT_EQ(merged[1]->responses.size(), 10u);
  EXPECT_EQ(merged[1]->messages.size(), 2u);
  EXPECT_EQ(Merge({QuestionWith(6, 0x41), QuestionWith(6, 0x42)}).size(), 3u);
}

TEST(AutodetectMerging, KeepsRequestsApartWhoseAnswersConflict) {
  AutodetectRequests const merged = Merge({QuestionWith(1, 0x41), QuestionWith(1, 0x41)});
  ASSERT_EQ(merged.size(), 3u);
  EXPECT_EQ(merged[1]->messages.size(), 1u);
}

TEST(AutodetectMerging, PutsARequestIntoTheFirstThatCanTakeIt) {
  AutodetectRequests const merged = Merge(
      {QuestionWith(9, 0x41), QuestionWith(9, 0x42), QuestionWith(1, 0x43), QuestionWith(1, 0x44)});
  ASSERT_EQ(merged.size(), 3u);
  EXPECT_EQ(merged[1]->responses.size(), 10u);
  EXPECT_EQ(merged[2]->responses.size(), 10u);
  EXPECT_EQ(merged[1]->responses.back()->table, TableOf("F0 43 0"));
}

TEST(AutodetectMerging, LeavesTheInquiryAlone) {
  AutodetectRequests const merged = Merge({QuestionWith(1, 0x41)});
  ASSERT_EQ(merged.size(), 2u);
  EXPECT_TRUE(merged[0]->responses.empty());
}

TEST(AutodetectMerging, MergesARequestWithoutAnswersIntoAnyOther) {
  AutodetectRequests const merged =
      Merge({QuestionWith(0, 0), QuestionWith(10, 0x41), QuestionWith(0, 0)});
  ASSERT_EQ(merged.size(), 2u);
  EXPECT_EQ(merged[1]->messages.size(), 3u);
  EXPECT_EQ(merged[1]->responses.size(), 10u);
}

TEST(AutodetectMerging, ButTenAnswersAreTheMostAlsoForAnEmptyRequest) {
  AutodetectRequests const merged = Merge({QuestionWith(0, 0), QuestionWith(11, 0x41)});
  EXPECT_EQ(merged.size(), 3u);
}

TEST(AutodetectRange, SpansTheTypesOfAllAnswers) {
  auto const request = QuestionWith(2, 0x41);
  request->responses[0]->deviceTypes = {TypeWithIDs("A", 16, 31), SomeType("B")};
  request->responses[1]->deviceTypes = {TypeWithIDs("C", 4, 20)};
  ComputeDeviceIDRange(*request, 127);
  EXPECT_EQ(request->minDeviceID, 4);
  EXPECT_EQ(request->maxDeviceID, 31);
}

TEST(AutodetectRange, IsTheCallToAllWhereNoTypeTells) {
  auto const request = QuestionWith(1, 0x41);
  request->responses[0]->deviceTypes = {SomeType("A")};
  ComputeDeviceIDRange(*request, 127);
  EXPECT_EQ(request->minDeviceID, 127);
  EXPECT_EQ(request->maxDeviceID, 127);
  ComputeDeviceIDRange(*request, 126);
  EXPECT_EQ(request->minDeviceID, 126);
  EXPECT_EQ(request->maxDeviceID, 126);
}

TEST(AutodetectRange, BeginsNoHigherThanTheCallToAll) {
  auto const request = QuestionWith(1, 0x41);
  request->responses[0]->deviceTypes = {TypeWithIDs("A", 200, 210)};
  ComputeDeviceIDRange(*request, 127);
  EXPECT_EQ(request->minDeviceID, 127);
  EXPECT_EQ(request->maxDeviceID, 210);
}

TEST(AutodetectRange, OfFollowUpsStandsAlone) {
  auto const request = QuestionWith(1, 0x41);
  auto const next = QuestionWith(1, 0x42);
  auto const last = QuestionWith(1, 0x43);
  next->responses[0]->deviceTypes = {TypeWithIDs("A", 0, 15)};
  next->responses[0]->requests = {last};
  request->responses[0]->requests = {next};
  ComputeDeviceIDRange(*request, 127);
  EXPECT_EQ(request->minDeviceID, 127);
  EXPECT_EQ(request->maxDeviceID, 127);
  EXPECT_EQ(next->minDeviceID, 0);
  EXPECT_EQ(next->maxDeviceID, 15);
  EXPECT_EQ(last->minDeviceID, 127);
}

}  // namespace
}  // namespace Ostinet

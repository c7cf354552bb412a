// SPDX-License-Identifier: MIT
#include "AutodetectTables.h"

namespace Ostinet {
namespace {

using namespace Testing;
using Autodetect::Request;
using Autodetect::Response;
using testing::ElementsAre;

std::vector<Bytes> Sweep(Request const& request, TimeStamp stamp = Clocks(1)) {
  std::vector<Bytes> messages;
  DataBuffer const buffer = request.GetMessageW(stamp);
  for (std::size_t i = 0; i < buffer.size(); ++i) {
    messages.emplace_back(buffer[i].data, buffer[i].data + buffer[i].length);
  }
  return messages;
}

RCPtrMT<Impl::AutodetectRequestImpl> QuestionTo(std::string const& message, int first, int last) {
  auto const request = Question(message);
  request->minDeviceID = static_cast<unsigned char>(first);
  request->maxDeviceID = static_cast<unsigned char>(last);
  return request;
}

TEST(AutodetectRequest, AsksEachDeviceID) {
  EXPECT_THAT(Sweep(QuestionTo("F0 41 ID F7", 14, 16)),
              ElementsAre(BytesOf("F0 41 0E F7"), BytesOf("F0 41 0F F7"), BytesOf("F0 41 10 F7")));
}

TEST(AutodetectRequest, AsksOnceWhereNoByteHoldsTheDeviceID) {
  EXPECT_THAT(Sweep(QuestionTo("F0 41 10 F7", 0, 15)), ElementsAre(BytesOf("F0 41 10 F7")));
}

TEST(AutodetectRequest, StopsWhereAByteWouldExceed127) {
  auto const sweep = Sweep(QuestionTo("F0 ID+78 F7", 0, 126));  // 120
  ASSERT_EQ(sweep.size(), 8u);
  EXPECT_EQ(sweep.back(), BytesOf("F0 7F F7"));
}

TEST(AutodetectRequest, StopsAtTheGreatestOffsetOfAMessage) {
  EXPECT_EQ(Sweep(QuestionTo("F0 ID ID+7E ID+70 F7", 0, 15)).size(), 2u);
}

TEST(AutodetectRequest, AsksNothingWhereNoDeviceIDFits) {
  EXPECT_THAT(Sweep(QuestionTo("F0 ID+70 F7", 127, 127)), ElementsAre());
  // An offset that no byte of a message can hold: the bound lies below 0 and does not wrap.
  EXPECT_THAT(Sweep(QuestionTo("F0 ID+C8 F7", 0, 15)), ElementsAre());
}

TEST(AutodetectRequest, EndsItsSweepAlsoAtTheHighestDeviceID) {
  EXPECT_EQ(Sweep(QuestionTo("F0 ID F7", 0, 255)).size(), 128u);
}

TEST(AutodetectRequest, SendsItsMessagesOneBehindTheOtherEachInItsOwnRange) {
  auto const request = QuestionTo("F0 ID F7", 1, 2);
  request->messages.push_back(TableOf("F0 41 F7"));
  request->messages.push_back(TableOf("F0 ID+7E F7"));
  EXPECT_THAT(Sweep(request), ElementsAre(BytesOf("F0 01 F7"), BytesOf("F0 02 F7"),
                                          BytesOf("F0 41 F7"), BytesOf("F0 7F F7")));
}

TEST(AutodetectRequest, StampsAllPacketsAlike) {
  auto const request = QuestionTo("F0 ID F7", 0, 2);
  request->messages.push_back(TableOf("F0 41 F7"));
  DataBuffer const buffer = Request(request).GetMessageW(Clocks(1234));
  ASSERT_EQ(buffer.size(), 4u);
  for (std::size_t i = 0; i < buffer.size(); ++i) {
    EXPECT_EQ(buffer[i].stamp.AsMIDITime().Value(), 1234u);
  }
}

TEST(AutodetectRequest, WaitsLongerForEachFurtherMessage) {
  auto const request = Question("F0 41 F7");
  EXPECT_DOUBLE_EQ(Request(request).GetTimeout(), 1.0);
  request->messages.push_back(TableOf("F0 42 F7"));
  EXPECT_DOUBLE_EQ(Request(request).GetTimeout(), 1.2);
  request->messages.clear();
  EXPECT_DOUBLE_EQ(Request(request).GetTimeout(), 0.8);
}

// The time to wait counts messages, not the packets that they are sent as.
TEST(AutodetectRequest, WaitsNoLongerForASweep) {
  EXPECT_DOUBLE_EQ(Request(QuestionTo("F0 ID F7", 0, 127)).GetTimeout(), 1.0);
}

TEST(AutodetectRequest, GivesItsResponses) {
  auto const request = Question("F0 41 F7");
  request->responses = {Answer("F0 41 10"), Answer("F0 42")};
  Request const handle(request);
  EXPECT_EQ(handle.CountResponses(), 2);
  EXPECT_EQ(handle.GetResponse(0).GetMatcher().Success(), 3u);
  EXPECT_EQ(handle.GetResponse(1).GetMatcher().Success(), 2u);
}

TEST(AutodetectRequest, IsEmptyOutOfRange) {
  auto const request = Question("F0 41 F7");
  request->responses = {Answer("F0 41 10")};
  for (int const index : {-1, 1}) {
    Response const none = Request(request).GetResponse(index);
    EXPECT_EQ(none.CountDeviceTypeInfos(), 0);
    EXPECT_EQ(none.CountRequests(), 0);
    EXPECT_EQ(none.GetMatcher().Success(), 0u);
    EXPECT_FALSE(none.GetMatchedDeviceTypeInfo(Untouched()).Exists());
    EXPECT_FALSE(none.GetDeviceTypeInfo(0).Exists());
    Request const noRequest = none.GetRequest(0);
    EXPECT_TRUE(noRequest.GetMessageW(kNoTimeStamp).empty());
    EXPECT_EQ(noRequest.CountResponses(), 0);
    EXPECT_EQ(noRequest.GetTimeout(), 0.0);
  }
}

TEST(AutodetectResponse, GivesTheRequestsToAskNext) {
  auto const response = Answer("F0 41");
  response->requests = {Question("F0 01 F7"), Question("F0 02 F7")};
  Response const handle(response);
  ASSERT_EQ(handle.CountRequests(), 2);
  EXPECT_THAT(Sweep(handle.GetRequest(1)), ElementsAre(BytesOf("F0 02 F7")));
}

TEST(AutodetectResponse, MeansItsOnlyTypeWhereNothingWasCaptured) {
  auto const response = Answer("F0 41");
  response->deviceTypes = {TypeWithIdentity("A", "41 FF FF 00 19 00 10")};
  EXPECT_EQ(Response(response).GetMatchedDeviceTypeInfo(Untouched()).GetModelName(), "A");
}

TEST(AutodetectResponse, MeansTheTypeWhoseIdentityWasCaptured) {
  auto const response = Answer("F0 41");
  response->deviceTypes = {TypeWithIdentity("A", "41 FF FF 00 19 00 10"),
                           TypeWithIdentity("B", "41 FF FF 00 19 00 11"),
                           TypeWithIdentity("C", "41 FF FF 00 19 00 11")};
  Captured captured = Untouched();
  Bytes const bytes = BytesOf("41 FF FF 00 19 00 11");
  std::copy(bytes.begin(), bytes.end(), captured.elements);
  EXPECT_EQ(Response(response).GetMatchedDeviceTypeInfo(captured).GetModelName(), "B")
      << "the first of those that share it";
  captured[6] = 0x12;
  EXPECT_FALSE(Response(response).GetMatchedDeviceTypeInfo(captured).Exists());
}

TEST(AutodetectResponse, MeansNoneOfSeveralTypesWhereNothingWasCaptured) {
  auto const response = Answer("F0 41");
  response->deviceTypes = {TypeWithIdentity("A", "41 FF FF 00 19 00 10"),
                           TypeWithIdentity("B", "41 FF FF 00 19 00 11")};
  EXPECT_FALSE(Response(response).GetMatchedDeviceTypeInfo(Untouched()).Exists());
  // Bytes that nobody captured are those of a type that has no identity.
  response->deviceTypes.push_back(SomeType("C"));
  EXPECT_EQ(Response(response).GetMatchedDeviceTypeInfo(Untouched()).GetModelName(), "C");
}

// A single type is no answer by itself once bytes were captured that are not its own.
TEST(AutodetectResponse, DoesNotMeanItsOnlyTypeWithAnotherIdentity) {
  auto const response = Answer("F0 41");
  response->deviceTypes = {SomeType("A")};
  Captured captured = Untouched();
  captured[6] = 0x00;
  EXPECT_FALSE(Response(response).GetMatchedDeviceTypeInfo(captured).Exists());
}

}  // namespace
}  // namespace Ostinet

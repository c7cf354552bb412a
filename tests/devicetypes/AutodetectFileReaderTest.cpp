// SPDX-License-Identifier: MIT
#include "AutodetectTables.h"
#include "devicetypes/AutodetectFileReader.h"
#include "ostinet/core/Error.h"

namespace Ostinet {
namespace {

using namespace Testing;
using testing::ElementsAre;
using testing::IsEmpty;

class AutodetectFile : public testing::Test {
 protected:
  // Reads a whole document.
  void ReadDocument(std::string const& document) {
    XMLLib::Parser parser(document.data(), document.size());
    Impl::AutodetectFileReader(parser, types).ReadRequests(requests);
  }
  void Read(std::string const& content) {
    ReadDocument("<MIDIAutoDetect>" + content + "</MIDIAutoDetect>");
  }
  Table MessageOf(std::string const& content) {
    requests.clear();
    Read("<Request><RequestMIDI>" + content + "</RequestMIDI></Request>");
    return requests.at(0)->messages.front();
  }
  Table AnswerOf(std::string const& content) {
    requests.clear();
    Read("<Request><RequestMIDI/><Response><ResponseMIDI>" + content +
         "</ResponseMIDI></Response></Request>");
    return requests.at(0)->responses.at(0)->table;
  }
  std::vector<std::string> TypesOf(std::string const& devices) {
    requests.clear();
    Read("<Request><RequestMIDI/><Response><ResponseMIDI/>" + devices + "</Response></Request>");
    std::vector<std::string> names;
    for (auto const& type : requests.at(0)->responses.at(0)->deviceTypes) {
      names.push_back(type->manufacturer.string() + "/" + type->model.string());
    }
    return names;
  }

  Impl::DeviceTypes types;
  Impl::AutodetectRequests requests;
};

TEST_F(AutodetectFile, HoldsRequestsWithTheirAnswers) {
  Read(
      "<Request><RequestMIDI>F0 41 F7</RequestMIDI>"
      "<Response><ResponseMIDI>F0 41 01</ResponseMIDI></Response>"
      "<Response><ResponseMIDI>F0 41 02</ResponseMIDI></Response></Request>"
      "<Request><RequestMIDI>F0 42 F7</RequestMIDI></Request>");
  ASSERT_EQ(requests.size(), 2u);
  EXPECT_THAT(requests[0]->messages, ElementsAre(TableOf("F0 41 F7")));
  ASSERT_EQ(requests[0]->responses.size(), 2u);
  EXPECT_EQ(requests[0]->responses[1]->table, TableOf("F0 41 02"));
  EXPECT_FALSE(requests[0]->responses[1]->strict);
  EXPECT_THAT(requests[1]->messages, ElementsAre(TableOf("F0 42 F7")));
}

TEST_F(AutodetectFile, WithAnotherRootHoldsNothing) {
  ReadDocument("<AutoDetect><Request><RequestMIDI>F0</RequestMIDI></Request></AutoDetect>");
  EXPECT_THAT(requests, IsEmpty());
}

TEST_F(AutodetectFile, SkipsUnknownElements) {
  Read(
      "<What/><Request><What><RequestMIDI>00</RequestMIDI></What><RequestMIDI>F0</RequestMIDI>"
      "<What/><Response><What/><ResponseMIDI>F0</ResponseMIDI><What><Device/></What></Response>"
      "</Request>");
  ASSERT_EQ(requests.size(), 1u);
  EXPECT_THAT(requests[0]->messages, ElementsAre(TableOf("F0")));
  ASSERT_EQ(requests[0]->responses.size(), 1u);
  EXPECT_THAT(requests[0]->responses[0]->deviceTypes, IsEmpty());
}

TEST_F(AutodetectFile, CountsResponsesOnlyBehindTheMessage) {
  Read(
      "<Request><Response><ResponseMIDI>01</ResponseMIDI></Response><RequestMIDI>F0</RequestMIDI>"
      "<Response><ResponseMIDI>02</ResponseMIDI></Response></Request>");
  ASSERT_EQ(requests[0]->responses.size(), 1u);
  EXPECT_EQ(requests[0]->responses[0]->table, TableOf("02"));
}

TEST_F(AutodetectFile, TakesOneMessageOfARequest) {
  Read("<Request><RequestMIDI>F0</RequestMIDI><RequestMIDI>F1</RequestMIDI></Request>");
  EXPECT_THAT(requests[0]->messages, ElementsAre(TableOf("F0")));
}

TEST_F(AutodetectFile, KeepsARequestWithoutAMessage) {
  Read("<Request><Response><ResponseMIDI>F0</ResponseMIDI></Response></Request>");
  ASSERT_EQ(requests.size(), 1u);
  EXPECT_THAT(requests[0]->messages, IsEmpty());
  EXPECT_THAT(requests[0]->responses, IsEmpty());
}

TEST_F(AutodetectFile, KeepsAResponseWithoutAnAnswer) {
  Read(
      "<Request><RequestMIDI/><Response><Device Manufacturer='M' Model='A'/></Response>"
      "</Request>");
  ASSERT_EQ(requests[0]->responses.size(), 1u);
  EXPECT_THAT(requests[0]->responses[0]->table, IsEmpty());
  EXPECT_THAT(requests[0]->responses[0]->deviceTypes, IsEmpty())
      << "the search for the answer passed over it";
}

TEST_F(AutodetectFile, NestsFollowUpsUnderAnswers) {
  Read(
      "<Request><RequestMIDI>F0</RequestMIDI><Response><ResponseMIDI>F0</ResponseMIDI>"
      "<Request><RequestMIDI>01</RequestMIDI></Request><Device Manufacturer='M' Model='A'/>"
      "<Request><RequestMIDI>02</RequestMIDI><Response><ResponseMIDI>03</ResponseMIDI></Response>"
      "</Request></Response></Request>");
  ASSERT_EQ(requests.size(), 1u);
  auto const& response = *requests[0]->responses.at(0);
  ASSERT_EQ(response.requests.size(), 2u);
  EXPECT_THAT(response.requests[0]->messages, ElementsAre(TableOf("01")));
  EXPECT_EQ(response.requests[1]->responses.at(0)->table, TableOf("03"));
  EXPECT_EQ(response.deviceTypes.size(), 1u);
}

TEST_F(AutodetectFile, SpellsBytesInPairsOfDigitsOfEitherCaseWithWhiteSpaceAnywhere) {
  EXPECT_EQ(MessageOf(" F 0\n7e\t0 6 aB "), TableOf("F0 7E 06 AB"));
}

// Files in the field hold such slips, and what they mean has not changed since.
TEST_F(AutodetectFile, TakesAnyOtherCharacterForTheDigitBeforeIt) {
  EXPECT_EQ(MessageOf("4G 10"), TableOf("44 10"));
  EXPECT_EQ(MessageOf("G1"), TableOf("01"));
  EXPECT_EQ(MessageOf("F0,41"), TableOf("F0 04")) << "the comma is a 0 and the last 1 stands alone";
  EXPECT_EQ(MessageOf("1--F"), TableOf("11 1F"));
  EXPECT_EQ(MessageOf("1 &#xe9; 2"), TableOf("11"));
}

TEST_F(AutodetectFile, DropsADigitWithoutPartner) {
  EXPECT_EQ(MessageOf("F0 4"), TableOf("F0"));
  EXPECT_EQ(MessageOf("F0 4<DeviceID/>1 10"), TableOf("F0 ID 11"));
  EXPECT_EQ(MessageOf("4<DeviceID/>G1"), TableOf("ID 01")) << "each run begins at 0";
}

TEST_F(AutodetectFile, MarksTheDeviceIDWithItsOffset) {
  EXPECT_EQ(MessageOf("F0<DeviceID/>10<DeviceID Offset='48'/>F7"), TableOf("F0 ID 10 ID+30 F7"));
  EXPECT_EQ(MessageOf("<DeviceID Offset='255'/><DeviceID Offset='256'/><DeviceID Offset='x'/>"),
            TableOf("ID+FF ID ID"));
  EXPECT_EQ(MessageOf("<DeviceID>55</DeviceID>F7"), TableOf("ID F7")) << "its content is nothing";
}

TEST_F(AutodetectFile, TakesAnyForTheLastSlotInAnswersOnly) {
  EXPECT_EQ(AnswerOf("F0<Any/>10"), TableOf("F0 FF 10"));
  EXPECT_EQ(MessageOf("F0<Any/>10"), TableOf("F0 10"));
}

TEST_F(AutodetectFile, SkipsOtherChildrenOfATemplate) {
  EXPECT_EQ(AnswerOf("F0<What>11</What>10"), TableOf("F0 10"));
}

TEST_F(AutodetectFile, LetsTheEndOfAnAnswerBeAnything) {
  EXPECT_EQ(AnswerOf("F0 F7 10 F7"), TableOf("F0 F7 10 F8")) << "only the last byte";
  EXPECT_EQ(AnswerOf("F0<DeviceID Offset='247'/>"), TableOf("F0 ID+F7"));
  EXPECT_EQ(MessageOf("F0 F7"), TableOf("F0 F7"));
}

TEST_F(AutodetectFile, NamesTypesOfTheCatalogWithoutRegardToCaseAndWhiteSpace) {
  types.push_back(SomeType("Model 1"));
  EXPECT_THAT(TypesOf("<Device Manufacturer='MAKER' Model='model1'/>"),
              ElementsAre("Maker/Model 1"));
  EXPECT_EQ(types.size(), 1u);
  EXPECT_EQ(requests[0]->responses[0]->deviceTypes[0], types[0]);
}

TEST_F(AutodetectFile, AddsTypesThatNoFileDescribes) {
  types.push_back(SomeType("A"));
  EXPECT_THAT(TypesOf("<Device Manufacturer='Maker' Model='Z'/>"
                      "<Device Manufacturer='Maker' Model='B'/>"
                      "<Device Manufacturer='maker' Model='z'/>"),
              ElementsAre("Maker/Z", "Maker/B", "Maker/Z"));
  ASSERT_EQ(types.size(), 3u);
  EXPECT_EQ(types[1]->model, "Z");
  EXPECT_FALSE(types[1]->hasDeviceID);
  EXPECT_EQ(types[1]->inquiryResponse, ModelInfo());
}

TEST_F(AutodetectFile, AddsATypeOfItsOwnForEachDeviceThatLacksAName) {
  EXPECT_THAT(TypesOf("<Device Manufacturer='Maker'/><Device Model='A'/><Device/>"),
              ElementsAre("Maker/", "/", "/"));
  EXPECT_EQ(types.size(), 3u);
}

TEST_F(AutodetectFile, CountsUpToAFault) {
  EXPECT_THROW(Read("<Request><RequestMIDI>F0</RequestMIDI></Request>"
                    "<Request><RequestMIDI>F1</RequestMIDI><Response><ResponseMIDI/>"
                    "<Device Manufacturer='M' Model='A'/></Request>"),
               VantorError);
  ASSERT_EQ(requests.size(), 1u);
  EXPECT_THAT(requests[0]->messages, ElementsAre(TableOf("F0")));
  EXPECT_EQ(types.size(), 1u) << "a type that was named stays";
}

TEST_F(AutodetectFile, ReadsADeepNestOfFollowUps) {
  std::string open;
  std::string close;
  for (int i = 0; i < 60; ++i) {
    open += "<Request><RequestMIDI>F0</RequestMIDI><Response><ResponseMIDI/>";
    close += "</Response></Request>";
  }
  Read(open + close);
  EXPECT_EQ(requests.size(), 1u);
}

}  // namespace
}  // namespace Ostinet

// SPDX-License-Identifier: MIT
#include <gtest/gtest.h>

#include <cstddef>
#include <cstdlib>
#include <cstring>
#include <string>

#include "core/Paths.h"
#include "core/SystemServices.h"
#include "matching/HexBytes.h"
#include "ostinet/Endpoint.h"
#include "ostinet/core/Files.h"
#include "support/TemporaryFolder.h"

namespace Ostinet {
namespace {

using Testing::FromHex;
using Testing::Hex;
using Testing::ToHex;

static_assert(sizeof(BreviaDestinationMatch) == 278);
static_assert(offsetof(BreviaDestinationMatch, fields.name) == 22);
static_assert(offsetof(BreviaDestinationMatch, software.long2) == 2);

BreviaDestinationMatch Record(short kind, std::string const& name) {
  BreviaDestinationMatch record;
  std::memset(&record, 0, sizeof record);
  record.kind = kind;
  record.fields.name[0] = static_cast<unsigned char>(name.size());
  std::memcpy(record.fields.name + 1, name.data(), name.size());
  return record;
}

BreviaDestinationMatch PortRecord(short kind, std::string const& name) {
  BreviaDestinationMatch record = Record(kind, name);
  record.fields.word2 = 0x1234;
  record.fields.long4 = 0x89ABCDEF;
  record.fields.word8 = -2;
  record.fields.word10 = 5;
  return record;
}

BreviaDestinationMatch DeviceRecord(std::string const& name) {
  BreviaDestinationMatch record = PortRecord(0, name);
  record.fields.manufacturerCode = 0x2A00;
  record.fields.modelCode = 0x1F;
  record.fields.word20 = -32768;
  return record;
}

bool AreEqual(BreviaDestinationMatch const& a, BreviaDestinationMatch const& b) {
  return std::memcmp(&a, &b, sizeof a) == 0;
}

std::string NameOf(BreviaDestinationMatch const& record) {
  return {record.fields.name + 1, record.fields.name + 1 + record.fields.name[0]};
}

// The codes of one maker lie where the library looks for its resources.
class MatchTranslatorTest : public testing::Test {
 protected:
  MatchTranslatorTest() {
    folder_.Write("BVDevices.xml",
                  "<BVDevices><Manufacturer name='A' code='2A'><Model name='B' code='1F'/>"
                  "</Manufacturer></BVDevices>");
    SystemServices::SetEnvironment("OSTINET_RESOURCES", Impl::FromPath(folder_.Path()));
  }
  ~MatchTranslatorTest() override {
    SystemServices::SetEnvironment("OSTINET_RESOURCES", UString());
  }

  // There and back, as a source if `isSource`.
  BreviaDestinationMatch RoundTrip(BreviaDestinationMatch const& record, bool isSource) {
    bool comesBackAsSource = !isSource;
    auto const result = translator_.TranslateToBrevia(
        translator_.TranslateFromBrevia(record, isSource), comesBackAsSource);
    EXPECT_EQ(comesBackAsSource, isSource);
    return result;
  }

  Testing::TemporaryFolder const folder_;
  MatchTranslator translator_;
  bool isSource_ = false;
};

TEST_F(MatchTranslatorTest, WritesABareName) {
  EXPECT_EQ(ToHex(translator_.TranslateFromNameOnly(Destination::kObjectID, "AB")),
            Hex(Testing::kNameOnly));
  MatchData const patch = translator_.TranslateFromNameOnly(MatchObjectID(7), "Piano");
  EXPECT_EQ(patch.GetObjectType(), MatchObjectID(7));
  EXPECT_EQ(patch.GetObjectName(), UString("Piano"));
}

TEST_F(MatchTranslatorTest, WritesEachKindOfOlderRecord) {
  BreviaDestinationMatch software = Record(2, "S");
  software.software.long2 = 0x89ABCDEF;
  EXPECT_EQ(ToHex(translator_.TranslateFromBrevia(software, true)), Hex(Testing::kOlderSoftware));
  EXPECT_EQ(ToHex(translator_.TranslateFromBrevia(PortRecord(3, "P"), false)),
            Hex(Testing::kOlderPort));
  EXPECT_EQ(ToHex(translator_.TranslateFromBrevia(DeviceRecord("D"), false)),
            Hex(Testing::kOlderDevice));
}

TEST_F(MatchTranslatorTest, WritesAnEmptyRecordAndKindsWithoutFields) {
  EXPECT_EQ(ToHex(translator_.TranslateFromBrevia(Record(-1, ""), false)),
            Hex("00 00 00 00  00 00 00 02  00 00 00 04  00 00 00 00 "
                "00 00 00 08  00 00 00 00  FF FF FF FF "
                "00 00 00 0F  00 00 00 00  00 00 00 00  00 00 00 00  00 00 00"));
  EXPECT_EQ(ToHex(translator_.TranslateFromBrevia(Record(1, ""), false)),
            Hex("00 00 00 00  00 00 00 02  00 00 00 04  00 00 00 00 "
                "00 00 00 08  00 00 00 00  00 00 00 01 "
                "00 00 00 0F  00 00 00 00  00 00 00 00  00 00 00 00  01 00 00"));
}

TEST_F(MatchTranslatorTest, ARecordComesBackAsItWent) {
  for (short const kind : {short{2}, short{4}}) {
    BreviaDestinationMatch record = Record(kind, "Soft");
    record.software.long2 = 0xFEDCBA98;
    EXPECT_TRUE(AreEqual(RoundTrip(record, true), record));
  }
  EXPECT_TRUE(AreEqual(RoundTrip(PortRecord(3, "Port"), false), PortRecord(3, "Port")));
  EXPECT_TRUE(AreEqual(RoundTrip(DeviceRecord("Device"), false), DeviceRecord("Device")));
  EXPECT_TRUE(AreEqual(RoundTrip(Record(1, "One"), false), Record(1, "One")));
  EXPECT_TRUE(AreEqual(RoundTrip(Record(-1, "None"), false), Record(-1, "None")));
  EXPECT_TRUE(AreEqual(RoundTrip(Record(9, "Nine"), false), Record(9, "Nine")));
}

TEST_F(MatchTranslatorTest, CodesThatTheFileDoesNotKnowComeBackToo) {
  BreviaDestinationMatch record = DeviceRecord("Device");
  record.fields.manufacturerCode = 0x7700;
  MatchContents const contents = translator_.TranslateFromBrevia(record, false).GetContents();
  EXPECT_TRUE(contents.manufacturer.empty());
  EXPECT_TRUE(contents.model.empty());
  EXPECT_TRUE(AreEqual(RoundTrip(record, false), record));
}

TEST_F(MatchTranslatorTest, APortOfThisSystemComesBackAsAPort) {
  MatchData const port = FromHex(
      "00 00 00 00  00 00 00 03  00 00 00 04  00 00 00 01  00 50 "
      "00 00 00 0D  00 00 00 00  00 00 00 07  00 00 00 00  01 "
      "00 00 00 28  00 00 00 00  00 00 00 00  00 00 00 00  01 00 00 00 "
      "00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00");
  EXPECT_TRUE(AreEqual(translator_.TranslateToBrevia(port, isSource_), Record(3, "P")));
  EXPECT_TRUE(AreEqual(translator_.TranslateToBrevia(FromHex(Testing::kInternalSource), isSource_),
                       Record(2, "FX")));
  EXPECT_TRUE(isSource_);
}

TEST_F(MatchTranslatorTest, ADeviceOfThisSystemGetsTheCodesOfItsTexts) {
  MatchData data = FromHex(Testing::kOlderDevice);
  data[7] = 3;  // section 1 is another backend's now
  BreviaDestinationMatch expected = Record(0, "D");
  expected.fields.manufacturerCode = 0x2A00;
  expected.fields.modelCode = 0x1F;
  EXPECT_TRUE(AreEqual(translator_.TranslateToBrevia(data, isSource_), expected));
  data[data.size() - 4] = 'C';  // a model that the file does not know
  expected.fields.modelCode = 0;
  EXPECT_TRUE(AreEqual(translator_.TranslateToBrevia(data, isSource_), expected));
}

TEST_F(MatchTranslatorTest, WhatIsNoEndpointGivesNothing) {
  for (bool const before : {false, true}) {
    bool isSource = before;
    MatchData const device = translator_.TranslateFromNameOnly(MatchObjectID(1), "Box");
    EXPECT_TRUE(AreEqual(translator_.TranslateToBrevia(device, isSource), Record(-1, "")));
    EXPECT_EQ(isSource, before);
    EXPECT_TRUE(AreEqual(translator_.TranslateToBrevia(MatchData(), isSource), Record(-1, "")));
    EXPECT_EQ(isSource, before);
  }
}

TEST_F(MatchTranslatorTest, ANameIsCutAndItsForeignCharactersReplaced) {
  std::string const longName(300, 'x');
  MatchData const cut = translator_.TranslateFromNameOnly(Source::kObjectID, longName.c_str());
  EXPECT_EQ(NameOf(translator_.TranslateToBrevia(cut, isSource_)), longName.substr(0, 255));
  MatchData const foreign =
      translator_.TranslateFromNameOnly(Source::kObjectID, UString(u"\u00E9\u2126\u00FF"));
  EXPECT_EQ(NameOf(translator_.TranslateToBrevia(foreign, isSource_)), "\xE9?\xFF");
}

TEST_F(MatchTranslatorTest, FieldsThatAreCutOffStayAsTheDescriptionHasThem) {
  // Section 1 ends behind word8: its length counts what is left of it.
  MatchData const data = FromHex(
      "00 00 00 00  00 00 00 02  00 00 00 04  00 00 00 01  00 44 "
      "00 00 00 10  00 00 00 00  00 00 00 00  12 34  89 AB CD EF  FF FE "
      "00 00 00 13  00 00 00 00  00 00 00 01 00 41  00 00 00 01 00 42  00 00 00");
  BreviaDestinationMatch expected = DeviceRecord("D");
  expected.fields.word10 = 0;
  expected.fields.word20 = 0;
  EXPECT_TRUE(AreEqual(translator_.TranslateToBrevia(data, isSource_), expected));
}

TEST_F(MatchTranslatorTest, EveryPrefixGivesARecordOfAKnownKind) {
  for (char const* const layout : Testing::kAllLayouts) {
    MatchData const data = FromHex(layout);
    for (std::size_t count = 0; count <= data.size(); ++count) {
      auto const record =
          translator_.TranslateToBrevia(Testing::FirstBytes(data, count), isSource_);
      EXPECT_TRUE(record.kind >= -1 && record.kind <= 3) << record.kind;
      EXPECT_TRUE(count >= 12 || AreEqual(record, Record(-1, ""))) << count;
    }
  }
}

}  // namespace
}  // namespace Ostinet

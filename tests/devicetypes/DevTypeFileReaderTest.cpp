// SPDX-License-Identifier: MIT
#include "devicetypes/DevTypeFileReader.h"
#include "devicetypes/TypeFolders.h"
#include "ostinet/core/Error.h"

namespace Ostinet::Testing {
namespace {

using ::testing::Each;
using ::testing::ElementsAre;
using ::testing::IsEmpty;
using ::testing::SizeIs;

constexpr auto kFalse = Impl::TriBool::kFalse;
constexpr auto kTrue = Impl::TriBool::kTrue;
constexpr auto kUnset = Impl::TriBool::kUnset;

class DeviceTypeFile : public TypeFolders {
 protected:
  std::vector<int> InquiryOf(std::string const& content) const {
    ModelInfo const info = ReadType(content)->inquiryResponse;
    return {info.bytes, info.bytes + 7};
  }
  static std::string Inquiry(std::string const& manufacturer, std::string const& family,
                             std::string const& member) {
    return "<InquiryResponse Manufacturer=\"" + manufacturer + "\" Family=\"" + family +
           "\" Member=\"" + member + "\"/>";
  }
  static std::vector<int> const kNone;
};

std::vector<int> const DeviceTypeFile::kNone(7, 0xFF);

TEST_F(DeviceTypeFile, ABareTypeHasTheDefaults) {
  auto const type = ReadType("");
  EXPECT_EQ(type->manufacturer, UString("Acme"));
  EXPECT_EQ(type->model, UString("Synth"));
  EXPECT_EQ(type->image, UString());
  EXPECT_EQ(type->inquiryResponse, ModelInfo());
  EXPECT_THAT(type->capabilities, Each(kUnset));
  EXPECT_FALSE(type->hasDeviceID);
  EXPECT_EQ(type->defaultDeviceID, 0xFF);
  EXPECT_EQ(type->minDeviceID, 0xFF);
  EXPECT_EQ(type->maxDeviceID, 0xFF);
  EXPECT_EQ(type->receives.maxChannels, 16);
  EXPECT_THAT(type->receives.flags, Each(kUnset));
  EXPECT_EQ(type->transmits.maxChannels, 16);
  EXPECT_THAT(type->transmits.flags, Each(kUnset));
  EXPECT_THAT(type->portGroups, IsEmpty());
}

TEST_F(DeviceTypeFile, ATypeNeedsMakerAndModel) {
  auto const types = ReadTypes(
      "<MIDIDeviceType Model=\"A\"><MIDIPortGroup/></MIDIDeviceType>"
      "<MIDIDeviceType Manufacturer=\"Acme\"/><MIDIDeviceType/>" +
      TypeElement("Acme", "B") + TypeElement("", ""));
  ASSERT_THAT(types, SizeIs(2));
  EXPECT_EQ(types[0]->model, UString("B"));
  EXPECT_EQ(types[1]->model, UString());
}

TEST_F(DeviceTypeFile, CapabilitiesKeepUnstatedApartFromDenied) {
  auto const type = ReadType("",
                             "SupportsGeneralMIDI='true' SupportsMMC='false' IsMixer='yes' "
                             "IsSampler='TRUE' IsEffectUnit='true' Image='synth.png'");
  EXPECT_THAT(type->capabilities,
              ElementsAre(kTrue, kFalse, kUnset, kUnset, kUnset, kUnset, kTrue));
  EXPECT_EQ(type->image, UString("synth.png"));
}

TEST_F(DeviceTypeFile, NamesAreCaseSensitiveAndUnknownOnesSkipped) {
  auto const types = ReadTypes(
      "<mididevicetype Manufacturer='Acme' Model='No'/><Stranger><MIDIDeviceType "
      "Manufacturer='Acme' Model='Inner'/></Stranger>" +
      TypeElement("Acme", "Yes", "<deviceID Default='1' Min='1' Max='1' Base='1'/><Other/>",
                  "ismixer='true'"));
  ASSERT_THAT(types, SizeIs(1));
  EXPECT_EQ(types[0]->model, UString("Yes"));
  EXPECT_FALSE(types[0]->hasDeviceID);
  EXPECT_THAT(types[0]->capabilities, Each(kUnset));
}

TEST_F(DeviceTypeFile, AnotherRootYieldsNothing) {
  Impl::DevTypeFileReader reader(
      Write("elsewhere/a.middev", "<Types>" + TypeElement("Acme", "Synth") + "</Types>"));
  reader.Read();
  EXPECT_THAT(reader.Types(), IsEmpty());
}

TEST_F(DeviceTypeFile, TheLastAuthorCounts) {
  Impl::DevTypeFileReader reader(Write(
      "elsewhere/a.middev",
      TypesFile("<Author>One</Author>" + TypeElement("Acme", "Synth") + "<Author>Two</Author>")));
  reader.Read();
  EXPECT_EQ(reader.Author(), UString("Two"));
}

TEST_F(DeviceTypeFile, InquiryTakesOneByteOfManufacturerOrThree) {
  EXPECT_THAT(InquiryOf(Inquiry("41", "00 19", "00 10")),
              ElementsAre(0x41, 0xFF, 0xFF, 0x00, 0x19, 0x00, 0x10));
  EXPECT_THAT(InquiryOf(Inquiry("00 01 02", "0304", "0 5 0 6")), ElementsAre(0, 1, 2, 3, 4, 5, 6));
  for (char const* manufacturer : {"00 01", "4a", "80", "", "41 4", "00 01 02 03"}) {
    EXPECT_EQ(InquiryOf(Inquiry(manufacturer, "00 19", "00 10")), kNone) << manufacturer;
  }
}

TEST_F(DeviceTypeFile, InquiryIsWholeOrNothing) {
  EXPECT_EQ(InquiryOf(Inquiry("41", "19", "00 10")), kNone);
  EXPECT_EQ(InquiryOf(Inquiry("41", "00 19 00", "00 10")), kNone);
  EXPECT_EQ(InquiryOf(Inquiry("41", "00 19", "")), kNone);
  EXPECT_EQ(InquiryOf("<InquiryResponse Manufacturer='41' Family='00 19'/>"), kNone);
}

TEST_F(DeviceTypeFile, TheFirstValidInquiryCounts) {
  EXPECT_THAT(InquiryOf(Inquiry("80", "00 19", "00 10") + Inquiry("42", "01 02", "03 04") +
                        Inquiry("43", "05 06", "07 08")),
              ElementsAre(0x42, 0xFF, 0xFF, 1, 2, 3, 4));
}

TEST_F(DeviceTypeFile, BaseMovesDeviceNumbersToTheWire) {
  auto const type = ReadType("<DeviceID Default='1' Min='1' Max='16' Base='1'/>");
  EXPECT_TRUE(type->hasDeviceID);
  EXPECT_EQ(type->defaultDeviceID, 0);
  EXPECT_EQ(type->minDeviceID, 0);
  EXPECT_EQ(type->maxDeviceID, 15);
}

TEST_F(DeviceTypeFile, DeviceNumbersWrapAtEightBits) {
  auto const type = ReadType("<DeviceID Default='0' Min='1x' Max='255' Base='3'/>");
  EXPECT_EQ(type->defaultDeviceID, 253);
  EXPECT_EQ(type->minDeviceID, 254);
  EXPECT_EQ(type->maxDeviceID, 252);
}

TEST_F(DeviceTypeFile, ADeviceIDNeedsAllFourNumbersInRange) {
  for (char const* element : {"<DeviceID Default='1' Min='1' Max='16'/>",
                              "<DeviceID Default='1' Min='1' Max='256' Base='1'/>",
                              "<DeviceID Default='' Min='1' Max='16' Base='1'/>",
                              "<DeviceID Default='-1' Min='1' Max='16' Base='1'/>"}) {
    auto const type = ReadType(element);
    EXPECT_FALSE(type->hasDeviceID) << element;
    EXPECT_EQ(type->minDeviceID, 0xFF) << element;
  }
}

TEST_F(DeviceTypeFile, TheFirstAcceptedDeviceIDCounts) {
  auto const type = ReadType(
      "<DeviceID Default='9'/><DeviceID Default='2' Min='1' Max='3' Base='0'/>"
      "<DeviceID Default='5' Min='4' Max='6' Base='0'/>");
  EXPECT_EQ(type->defaultDeviceID, 2);
  EXPECT_EQ(type->maxDeviceID, 3);
}

TEST_F(DeviceTypeFile, MaxChannelsAboveSixteenAreIgnored) {
  auto const type = ReadType("<Receives MaxChannels='17'/><Transmits MaxChannels='0'/>");
  EXPECT_EQ(type->receives.maxChannels, 16);
  EXPECT_EQ(type->transmits.maxChannels, 0);
  EXPECT_EQ(ReadType("<Receives MaxChannels='4'/>")->receives.maxChannels, 4);
}

TEST_F(DeviceTypeFile, ReceivesAndTransmitsStateTheirFlags) {
  auto const type = ReadType(
      "<Receives MTC='true' Notes='false' ProgramChanges='true' BankSelectMSB='true' "
      "BankSelectLSB='false' PanDisruptsStereo='true'/>"
      "<Transmits MTC='false' Notes='true' ProgramChanges='false' BankSelectMSB='true' "
      "BankSelectLSB='true' PanDisruptsStereo='true'/>");
  EXPECT_THAT(type->receives.flags,
              ElementsAre(kTrue, kUnset, kFalse, kTrue, kTrue, kFalse, kTrue));
  EXPECT_THAT(type->transmits.flags, ElementsAre(kFalse, kUnset, kTrue, kFalse, kTrue, kTrue));
}

// A device follows the clock unless its user says otherwise, so no file can state it.
TEST_F(DeviceTypeFile, NoAttributeStatesTheClock) {
  auto const type = ReadType(
      "<Receives Clock='true' clock='true' MIDIClock='true' BeatClock='true'/>"
      "<Transmits Clock='true' clock='true' MIDIClock='true' BeatClock='true'/>");
  EXPECT_EQ(type->receives.flags[1], kUnset);
  EXPECT_EQ(type->transmits.flags[1], kUnset);
}

TEST_F(DeviceTypeFile, ALaterReceivesAddsToTheEarlier) {
  auto const type =
      ReadType("<Receives MaxChannels='4' MTC='true'/><Receives Notes='true' MTC='maybe'/>");
  EXPECT_EQ(type->receives.maxChannels, 4);
  EXPECT_EQ(type->receives.flags[0], kTrue);
  EXPECT_EQ(type->receives.flags[2], kTrue);
}

TEST_F(DeviceTypeFile, PortGroupsKeepTheirOrderAndTheirNames) {
  auto const groups =
      ReadType(
          "<MIDIPortGroup Name='A'><MIDIOut Name='Out 1'/><MIDIIn Name='In 1'/>"
          "<MIDIOut Name='Out 2'/><Other/></MIDIPortGroup><MIDIPortGroup Name='B'/>")
          ->portGroups;
  ASSERT_THAT(groups, SizeIs(2));
  EXPECT_EQ(groups[0].name, UString("A"));
  EXPECT_THAT(groups[0].ins, ElementsAre(UString("In 1")));
  EXPECT_THAT(groups[0].outs, ElementsAre(UString("Out 1"), UString("Out 2")));
  EXPECT_EQ(groups[1].name, UString("B"));
  EXPECT_THAT(groups[1].ins, IsEmpty());
}

// Group and ports are read into one text, which an absent attribute clears: no port inherits the
// name of the one before it.
TEST_F(DeviceTypeFile, ANamelessPortHasAnEmptyName) {
  auto const groups = ReadType(
                          "<MIDIPortGroup Name='A'><MIDIIn/><MIDIIn Name='Second'/><MIDIIn/>"
                          "</MIDIPortGroup><MIDIPortGroup><MIDIOut/></MIDIPortGroup>")
                          ->portGroups;
  ASSERT_THAT(groups, SizeIs(2));
  EXPECT_THAT(groups[0].ins, ElementsAre(UString(), UString("Second"), UString()));
  EXPECT_EQ(groups[1].name, UString());
  EXPECT_THAT(groups[1].outs, ElementsAre(UString()));
}

TEST_F(DeviceTypeFile, AFaultKeepsTheTypesBeforeIt) {
  Impl::DevTypeFileReader reader(Write(
      "elsewhere/a.middev", "<MIDIDeviceTypes><Author>Acme</Author>" + TypeElement("Acme", "A") +
                                "<MIDIDeviceType Manufacturer='Acme' Model='B'><MIDIPortGroup></"));
  EXPECT_THROW(reader.Read(), VantorError);
  ASSERT_THAT(reader.Types(), SizeIs(1));
  EXPECT_EQ(reader.Types()[0]->model, UString("A"));
  EXPECT_EQ(reader.Author(), UString("Acme"));
}

TEST_F(DeviceTypeFile, FindsItsPicturesBesideItAndInImages) {
  Impl::DevTypeFileReader const reader(Write("elsewhere/a.middev", TypesFile("")));
  EXPECT_EQ(reader.FindImage("a.png"), UString());
  File const inImages = Write("elsewhere/Images/a.png", "");
  EXPECT_EQ(reader.FindImage("a.png"), inImages.GetFullPath());
  File const beside = Write("elsewhere/a.png", "");
  EXPECT_EQ(reader.FindImage("a.png"), beside.GetFullPath());
  EXPECT_EQ(reader.FindImage(""), UString());
}

}  // namespace
}  // namespace Ostinet::Testing

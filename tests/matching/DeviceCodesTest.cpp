// SPDX-License-Identifier: MIT
#include <gtest/gtest.h>

#include "matching/DeviceCodes.h"
#include "support/Printers.h"
#include "support/TemporaryFolder.h"

namespace Ostinet::Impl {
namespace {

class DeviceCodes : public testing::Test {
 protected:
  File Write(std::string const& content) { return folder_.Write("codes.xml", content); }

  // "maker/model" of a pair of codes.
  std::string TextsOf(std::string const& content, int manufacturer, int model) {
    DeviceTexts const texts = DeviceTextsByCode(Write(content)).Find({manufacturer, model});
    return texts.manufacturer.string() + "/" + texts.model.string();
  }

  // The maker's code of a "code" attribute.
  int CodeOf(std::string const& code) {
    File const file = Write("<BVDevices><Manufacturer name='A' code='" + code + "'/></BVDevices>");
    return DeviceCodesByText(file).Find({"A", ""}).manufacturer;
  }

  Testing::TemporaryFolder const folder_;
};

constexpr char kTwoMakers[] =
    "<BVDevices>"
    "<Manufacturer name='Acme' code='2A'><Model name='One' code='1F'/>"
    "<Model name='Two' code='20'/></Manufacturer>"
    "<Manufacturer name='Best' code='1'><Model name='One' code='1F'/></Manufacturer>"
    "</BVDevices>";

TEST_F(DeviceCodes, RelateCodesToTexts) {
  EXPECT_EQ(TextsOf(kTwoMakers, 0x2A00, 0x1F), "Acme/One");
  EXPECT_EQ(TextsOf(kTwoMakers, 0x2A00, 0x20), "Acme/Two");
  EXPECT_EQ(TextsOf(kTwoMakers, 0x0100, 0x1F), "Best/One");
}

TEST_F(DeviceCodes, AnUnknownModelLeavesTheMaker) {
  EXPECT_EQ(TextsOf(kTwoMakers, 0x2A00, 0x99), "Acme/");
  EXPECT_EQ(TextsOf(kTwoMakers, 0x2A00, 0), "Acme/");
  EXPECT_EQ(TextsOf(kTwoMakers, 0x9900, 0x1F), "/");
  EXPECT_EQ(TextsOf(kTwoMakers, 0, 0x1F), "/");
}

TEST_F(DeviceCodes, RelateTextsToCodes) {
  DeviceCodesByText const codes(Write(kTwoMakers));
  EXPECT_EQ(codes.Find({"Acme", "Two"}).manufacturer, 0x2A00);
  EXPECT_EQ(codes.Find({"Acme", "Two"}).model, 0x20);
  EXPECT_EQ(codes.Find({"Acme", "Three"}).manufacturer, 0x2A00);
  EXPECT_EQ(codes.Find({"Acme", "Three"}).model, 0);
  EXPECT_EQ(codes.Find({"Acme", ""}).model, 0);
  EXPECT_EQ(codes.Find({"acme", "Two"}).manufacturer, 0);
  EXPECT_EQ(codes.Find({"", "Two"}).model, 0);
}

// Files in use hold such codes.
TEST_F(DeviceCodes, ACodeIsReadFromItsEnd) {
  EXPECT_EQ(CodeOf("2A"), 0x2A00);
  EXPECT_EQ(CodeOf("2a"), 0x2A00);
  EXPECT_EQ(CodeOf(" 2 A\t"), 0x2A00);
  EXPECT_EQ(CodeOf("2xA"), 0x20A00);  // no digit, but in the place of one
  EXPECT_EQ(CodeOf("0x2A"), 0x2A00);
  EXPECT_EQ(CodeOf("FFFFFF"), static_cast<int>(0xFFFFFF00));
  EXPECT_EQ(CodeOf("7000000"), 0x7);  // the seventh digit wraps around to the lowest bits
  EXPECT_EQ(CodeOf(""), 0);
}

TEST_F(DeviceCodes, DropElementsThatLackAnAttribute) {
  constexpr char kFaulty[] =
      "<BVDevices><Other/>"
      "<Manufacturer name='NoCode'><Model name='M' code='1'/></Manufacturer>"
      "<Manufacturer code='3'><Model name='M' code='1'/></Manufacturer>"
      "<Manufacturer name='Acme' code='2'><Model name='M'/><Other/><Model code='1'/>"
      "<Model name='N' code='2'/></Manufacturer></BVDevices>";
  EXPECT_EQ(TextsOf(kFaulty, 0x200, 2), "Acme/N");
  EXPECT_EQ(TextsOf(kFaulty, 0x200, 1), "Acme/");
  EXPECT_EQ(TextsOf(kFaulty, 0x300, 1), "/");
}

TEST_F(DeviceCodes, TheLastElementOfAKeyCounts) {
  constexpr char kDoubled[] =
      "<BVDevices><Manufacturer name='Old' code='2'><Model name='M' code='1'/></Manufacturer>"
      "<Manufacturer name='New' code='2'><Model name='X' code='3'/><Model name='Y' code='3'/>"
      "</Manufacturer></BVDevices>";
  EXPECT_EQ(TextsOf(kDoubled, 0x200, 3), "New/Y");
  EXPECT_EQ(TextsOf(kDoubled, 0x200, 1), "New/");
}

TEST_F(DeviceCodes, KeepWhatStandsBeforeAFault) {
  EXPECT_EQ(TextsOf("<BVDevices><Manufacturer name='Acme' code='2'><Model name='M' code='1'/><",
                    0x200, 1),
            "Acme/M");
}

TEST_F(DeviceCodes, AMissingOrForeignFileKnowsNothing) {
  EXPECT_EQ(TextsOf("<Other><Manufacturer name='Acme' code='2'/></Other>", 0x200, 1), "/");
  EXPECT_EQ(TextsOf("", 0x200, 1), "/");
  DeviceTextsByCode const none(folder_.GetFolder().GetFile("nowhere.xml"));
  EXPECT_TRUE(none.Find({0x200, 1}).manufacturer.empty());
}

}  // namespace
}  // namespace Ostinet::Impl

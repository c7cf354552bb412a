// SPDX-License-Identifier: MIT
#include "devicetypes/DeviceTypeApplication.h"
#include "devicetypes/TypeFolders.h"
#include "support/TestSetup.h"

namespace Ostinet::Testing {
namespace {

using Impl::ImplOf;
using ::testing::Contains;
using ::testing::ElementsAre;
using ::testing::Not;

/// A studio whose one device is made over to types.
class ChangingType : public TypeFolders {
 protected:
  ~ChangingType() override { setup.Reset(); }

  DeviceTypeInfo Type(std::string const& content, std::string const& attributes = "") const {
    return ReadType(content, attributes);
  }
  static std::string Ports(int groups) {
    std::string ports;
    for (int i = 0; i < groups; ++i) {
      ports += "<MIDIPortGroup><MIDIIn/><MIDIOut/></MIDIPortGroup>";
    }
    return ports;
  }
  /// The keys that the device was told to change since the last call, in order.
  std::vector<UString> TakeChangedKeys() const {
    return std::exchange(TestSetup::PeerOf(device).changedKeys, {});
  }
  UString Text(char const* key) const { return ImplOf(device)->GetString(key, "(none)"); }
  int Number(char const* key) const { return ImplOf(device)->GetInt(key, -1); }
  std::vector<std::string> EntityNames() const {
    std::vector<std::string> names;
    for (int i = 0; i < device.CountEntities(); ++i) {
      names.push_back(device.GetEntity(i).GetRawName().string());
    }
    return names;
  }

  TestSetup& setup = TestSetup::Get();
  Device const device = (setup.Reset(), setup.MakeDevice("Lead"));
};

TEST_F(ChangingType, SetsMakerAndModelThenTheFactsInTheirOrder) {
  DeviceTypeInfo const type = Type(
      "<DeviceID Default='17' Min='17' Max='32' Base='1'/>"
      "<Receives MaxChannels='4' MTC='true' Notes='true' ProgramChanges='true' "
      "BankSelectMSB='true' BankSelectLSB='false' PanDisruptsStereo='true'/>"
      "<Transmits MaxChannels='0' MTC='false' Notes='true' ProgramChanges='true' "
      "BankSelectMSB='true' BankSelectLSB='true'/>",
      "SupportsGeneralMIDI='true' SupportsMMC='true' CanRoute='true' IsSampler='true' "
      "IsDrumMachine='false' IsMixer='true' IsEffectUnit='true'");
  TakeChangedKeys();
  setup.ChangeDeviceType(device, type);
  EXPECT_THAT(
      TakeChangedKeys(),
      ElementsAre(UString("manufacturer"), UString("model"), UString("image"),
                  UString("supports General MIDI"), UString("supports MMC"), UString("can route"),
                  UString("is sampler"), UString("is drum machine"), UString("is mixer"),
                  UString("is effect unit"), UString("deviceID"), UString("max receive channels"),
                  UString("receiveChannels"), UString("receives MTC"), UString("receives notes"),
                  UString("receives program changes"), UString("receives bank select MSB"),
                  UString("receives bank select LSB"), UString("pan disrupts stereo"),
                  UString("max transmit channels"), UString("transmitChannels"),
                  UString("transmits MTC"), UString("transmits notes"),
                  UString("transmits program changes"), UString("transmits bank select MSB"),
                  UString("transmits bank select LSB")));
  EXPECT_EQ(device.GetManufacturer(), UString("Acme"));
  EXPECT_EQ(device.GetModel(), UString("Synth"));
  EXPECT_EQ(Number("deviceID"), 16);
  EXPECT_EQ(Number("is drum machine"), 0);
  EXPECT_EQ(Number("can route"), 1);
  EXPECT_EQ(Number("max receive channels"), 4);
  EXPECT_EQ(Number("receiveChannels"), 0x000F);
  EXPECT_EQ(Number("receives bank select LSB"), 0);
  EXPECT_EQ(Number("max transmit channels"), 0);
  EXPECT_EQ(Number("transmitChannels"), 0);
  EXPECT_EQ(Number("transmits MTC"), 0);
}

TEST_F(ChangingType, ABareTypeStillReportsPictureAndChannels) {
  DeviceTypeInfo const type = Type("");
  setup.ChangeDeviceType(device, type);
  TakeChangedKeys();
  setup.ChangeDeviceType(device, type);
  // The same values again are reported all the same, the missing picture too.
  EXPECT_THAT(TakeChangedKeys(),
              ElementsAre(UString("manufacturer"), UString("model"), UString("image"),
                          UString("max receive channels"), UString("receiveChannels"),
                          UString("max transmit channels"), UString("transmitChannels")));
  EXPECT_EQ(Number("receiveChannels"), 0xFFFF);
  EXPECT_EQ(Number("transmitChannels"), 0xFFFF);
}

TEST_F(ChangingType, WhatTheNewTypeLeavesUnsetKeepsItsValue) {
  setup.ChangeDeviceType(
      device, Type("<DeviceID Default='5' Min='0' Max='15' Base='0'/><Receives MTC='true'/>",
                   "IsMixer='true'"));
  setup.ChangeDeviceType(device, Type(""));
  EXPECT_EQ(Number("is mixer"), 1);
  EXPECT_EQ(Number("receives MTC"), 1);
  EXPECT_EQ(Number("deviceID"), 5);
}

// The user decides about the clock, whatever the type.
TEST_F(ChangingType, NeverTouchesTheClock) {
  device.SetReceivesClock(true);
  device.SetTransmitsClock(false);
  TakeChangedKeys();
  setup.ChangeDeviceType(device, Type("<Receives Clock='false'/><Transmits Clock='true'/>"));
  EXPECT_TRUE(device.ReceivesClock());
  EXPECT_FALSE(device.TransmitsClock());
  auto const keys = TakeChangedKeys();
  EXPECT_THAT(keys, Not(Contains(UString("receives clock"))));
  EXPECT_THAT(keys, Not(Contains(UString("transmits clock"))));
}

TEST_F(ChangingType, ThePictureIsSoughtInTheMachinesFolderOnly) {
  Write("user/only.png", "");
  File const picture = Write("system/deep/er/synth.png", "");
  setup.ChangeDeviceType(device, Type("", "Image='synth.png'"));
  EXPECT_EQ(Text("image"), picture.GetFullPath());
  setup.ChangeDeviceType(device, Type("", "Image='only.png'"));
  EXPECT_EQ(Text("image"), UString("(none)"));
}

TEST_F(ChangingType, ATypeWithoutPictureTakesTheOldOneAway) {
  Write("system/synth.png", "");
  setup.ChangeDeviceType(device, Type("", "Image='synth.png'"));
  ASSERT_NE(Text("image"), UString("(none)"));
  setup.ChangeDeviceType(device, Type(""));
  EXPECT_EQ(Text("image"), UString("(none)"));
}

TEST_F(ChangingType, FewerPortsDeleteTheLastEntitiesAndKeepTheFirst) {
  setup.ChangeDeviceType(device, Type(Ports(5)));
  ASSERT_EQ(device.CountEntities(), 5);
  std::vector<Entity> before;
  for (int i = 0; i < 5; ++i) {
    before.push_back(device.GetEntity(i));
  }
  Destination const first = before[0].GetDestination(0);
  setup.ChangeDeviceType(device, Type(Ports(2)));
  ASSERT_EQ(device.CountEntities(), 2);
  EXPECT_EQ(device.GetEntity(0), before[0]);
  EXPECT_EQ(device.GetEntity(1), before[1]);
  EXPECT_EQ(device.GetEntity(0).GetDestination(0), first);
  EXPECT_FALSE(before[2].Exists());
  EXPECT_FALSE(before[4].Exists());
}

TEST_F(ChangingType, EntitiesAreDeletedFromTheLast) {
  setup.ChangeDeviceType(device, Type(Ports(3)));
  setup.calls.clear();
  setup.ChangeDeviceType(device, Type(Ports(1)));
  EXPECT_THAT(setup.calls, ElementsAre("WillDeleteEntity", "WillDeleteEntity", "SetEntitySources 1",
                                       "SetEntityDestinations 1"));
}

TEST_F(ChangingType, ATypeWithoutPortsLeavesOneEntityWithOnePortEachWay) {
  setup.ChangeDeviceType(device, Type(Ports(3)));
  Entity const first = device.GetEntity(0);
  setup.ChangeDeviceType(device, Type(""));
  EXPECT_THAT(EntityNames(), ElementsAre("Port 1"));
  EXPECT_EQ(device.GetEntity(0), first);
  EXPECT_EQ(first.CountSources(), 1);
  EXPECT_EQ(first.CountDestinations(), 1);
}

TEST_F(ChangingType, AnInOfTheInstrumentIsADestination) {
  setup.ChangeDeviceType(
      device,
      Type("<MIDIPortGroup Name='Main'><MIDIIn Name='In A'/><MIDIIn Name='In B'/>"
           "<MIDIOut Name='Out'/></MIDIPortGroup><MIDIPortGroup><MIDIIn/></MIDIPortGroup>"));
  EXPECT_THAT(EntityNames(), ElementsAre("Main", "Port 2"));
  Entity const main = device.GetEntity(0);
  ASSERT_EQ(main.CountDestinations(), 2);
  ASSERT_EQ(main.CountSources(), 1);
  EXPECT_EQ(main.GetDestination(0).GetRawName(), UString("In A"));
  EXPECT_EQ(main.GetDestination(1).GetRawName(), UString("In B"));
  EXPECT_EQ(main.GetSource(0).GetRawName(), UString("Out"));
  EXPECT_EQ(device.GetEntity(1).CountSources(), 0);
}

TEST_F(ChangingType, APortWithoutANameKeepsTheNameItHas) {
  setup.ChangeDeviceType(device, Type("<MIDIPortGroup><MIDIIn Name='Old'/></MIDIPortGroup>"));
  device.GetEntity(0).SetRawName("Old entity");
  setup.ChangeDeviceType(device, Type("<MIDIPortGroup><MIDIIn/></MIDIPortGroup>"));
  EXPECT_EQ(device.GetEntity(0).GetDestination(0).GetRawName(), UString("Old"));
  // The entity itself always gets the type's name.
  EXPECT_EQ(device.GetEntity(0).GetRawName(), UString("Port 1"));
}

TEST_F(ChangingType, DoesNothingToWhatItMayNotChange) {
  DeviceTypeInfo const type = Type(Ports(2));
  Device const direct = setup.MakeDevice("Direct", true);
  setup.ChangeDeviceType(direct, type);
  EXPECT_EQ(direct.GetManufacturer(), UString());
  EXPECT_EQ(direct.CountEntities(), 0);

  TakeChangedKeys();
  setup.ChangeDeviceType(device, DeviceTypeInfo());
  EXPECT_EQ(TakeChangedKeys().size(), 0U);
  setup.ChangeDeviceType(Device(), type);

  setup.DeleteDevice(device);
  setup.ChangeDeviceType(device, type);
  EXPECT_EQ(device.CountEntities(), 0);
}

TEST(PortGroups, OfATypeWithoutAnyAreOneNamelessPair) {
  RCPtrMT<Impl::DeviceTypeInfoImpl> const type(new Impl::DeviceTypeInfoImpl("Acme", "Synth"));
  for (Impl::DeviceTypeInfoImpl* one : {type.get(), static_cast<Impl::DeviceTypeInfoImpl*>(0)}) {
    auto const groups = Impl::PortGroupsOf(one);
    ASSERT_EQ(groups.size(), 1U);
    EXPECT_EQ(groups[0].name, UString());
    EXPECT_THAT(groups[0].ins, ElementsAre(UString()));
    EXPECT_THAT(groups[0].outs, ElementsAre(UString()));
  }
}

}  // namespace
}  // namespace Ostinet::Testing

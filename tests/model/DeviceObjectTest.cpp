// SPDX-License-Identifier: MIT
#include <set>

#include "model/PropertyKeys.h"
#include "support/StudioTest.h"

namespace Ostinet::Testing {
namespace {

using Impl::ImplOf;
namespace Keys = Impl::Keys;

class DeviceObjectTest : public StudioTest {
 protected:
  Device const device = setup.MakeDevice("Synth");
  Entity const entity = setup.MakeEntity(device, "Port 1", 1, 1);
  Source const source = entity.GetSource(0);
  Destination const destination = entity.GetDestination(0);
};

struct Flag {
  char const* key;
  bool fallback;
  bool (DeviceObject::*get)() const;
  void (DeviceObject::*set)(bool) const;
};

void PrintTo(Flag const& flag, std::ostream* out) { *out << flag.key; }

class DeviceObjectFlag : public StudioTest, public ::testing::WithParamInterface<Flag> {};

TEST_P(DeviceObjectFlag, IsStoredAsANumberUnderItsKey) {
  Flag const& flag = GetParam();
  Device const device = setup.MakeDevice("Synth");
  EXPECT_EQ((device.*flag.get)(), flag.fallback);
  int stored = -1;
  (device.*flag.set)(true);
  ASSERT_TRUE(ImplOf(device)->Peer()->GetInt(flag.key, stored));
  EXPECT_EQ(stored, 1);
  EXPECT_TRUE((device.*flag.get)());
  (device.*flag.set)(false);
  ASSERT_TRUE(ImplOf(device)->Peer()->GetInt(flag.key, stored));
  EXPECT_EQ(stored, 0);
  EXPECT_FALSE((device.*flag.get)());
}

using D = DeviceObject;
INSTANTIATE_TEST_SUITE_P(
    All, DeviceObjectFlag,
    ::testing::Values(Flag{"is drum machine", false, &D::IsADrumMachine, &D::SetIsADrumMachine},
                      Flag{"is mixer", false, &D::IsAMixer, &D::SetIsAMixer},
                      Flag{"is sampler", false, &D::IsASampler, &D::SetIsASampler},
                      Flag{"is effect unit", false, &D::IsAnEffectsUnit, &D::SetIsAnEffectsUnit},
                      Flag{"receives bank select MSB", false, &D::ReceivesBankSelect0,
                           &D::SetReceivesBankSelect0},
                      Flag{"receives bank select LSB", false, &D::ReceivesBankSelect32,
                           &D::SetReceivesBankSelect32},
                      Flag{"receives clock", false, &D::ReceivesClock, &D::SetReceivesClock},
                      Flag{"receives MTC", false, &D::ReceivesMTC, &D::SetReceivesMTC},
                      Flag{"receives notes", true, &D::ReceivesNotes, &D::SetReceivesNotes},
                      Flag{"receives program changes", true, &D::ReceivesProgramChange,
                           &D::SetReceivesProgramChange},
                      Flag{"transmits bank select MSB", false, &D::TransmitsBankSelect0,
                           &D::SetTransmitsBankSelect0},
                      Flag{"transmits bank select LSB", false, &D::TransmitsBankSelect32,
                           &D::SetTransmitsBankSelect32},
                      Flag{"transmits clock", false, &D::TransmitsClock, &D::SetTransmitsClock},
                      Flag{"transmits MTC", false, &D::TransmitsMTC, &D::SetTransmitsMTC},
                      Flag{"transmits notes", true, &D::TransmitsNotes, &D::SetTransmitsNotes},
                      Flag{"transmits program changes", true, &D::TransmitsProgramChange,
                           &D::SetTransmitsProgramChange},
                      Flag{"supports General MIDI", false, &D::SupportsGeneralMIDI,
                           &D::SetSupportsGeneralMIDI},
                      Flag{"supports MMC", false, &D::SupportsMMC, &D::SetSupportsMMC}));

TEST_F(DeviceObjectTest, TheMonitorFlagIsStoredUnderItsKey) {
  EXPECT_FALSE(device.IsOpenInMIDIMonitor());
  device.OpenInMIDIMonitor(true);
  EXPECT_TRUE(device.IsOpenInMIDIMonitor());
  EXPECT_EQ(ImplOf(device)->GetInt("com_vantor_lm_MIDIMonitorListOpenFlag", 0), 1);
}

TEST_F(DeviceObjectTest, WhatADeviceSaysHoldsForItsParts) {
  device.SetReceiveChannels(0x00FF);
  EXPECT_EQ(entity.ReceiveChannels(), 0x00FF);
  EXPECT_EQ(destination.ReceiveChannels(), 0x00FF);
}

TEST_F(DeviceObjectTest, APartsOwnValueHidesTheDevicesUntilItGoes) {
  device.SetReceiveChannels(0x00FF);
  destination.SetReceiveChannels(0x0F00);
  EXPECT_EQ(destination.ReceiveChannels(), 0x0F00);
  EXPECT_EQ(device.ReceiveChannels(), 0x00FF);
  TestSetup::PeerOf(destination).RemoveProperty(Keys::kReceiveChannels);
  EXPECT_EQ(destination.ReceiveChannels(), 0x00FF);
}

// A key of another type is no value, and the parent is not asked.
TEST_F(DeviceObjectTest, AValueOfAnotherTypeGivesTheDefault) {
  TestSetup::PeerOf(device).SetInt(Keys::kName, 7);
  TestSetup::PeerOf(destination).SetString(Keys::kName, "Own");
  int value = 0;
  EXPECT_FALSE(ImplOf(destination)->Peer()->GetInt(Keys::kName, value));
  EXPECT_EQ(ImplOf(destination)->GetInt(Keys::kName, 42), 42);
}

TEST_F(DeviceObjectTest, SysexDeviceIDIsZeroTo127OrNone) {
  EXPECT_EQ(static_cast<signed char>(device.GetSysexDeviceID()), -1);
  for (int const stored : {128, -1, 256, 0x10000010}) {
    TestSetup::SetInt(device, "deviceID", stored);
    EXPECT_EQ(static_cast<signed char>(device.GetSysexDeviceID()), -1) << stored;
  }
  for (int const stored : {0, 16, 127}) {
    TestSetup::SetInt(device, "deviceID", stored);
    EXPECT_EQ(device.GetSysexDeviceID(), stored);
  }
}

TEST_F(DeviceObjectTest, ASysexDeviceIDWithItsTopBitSetIsStoredAsMinusOne) {
  device.SetSysexDeviceID(static_cast<char>(-1));
  EXPECT_EQ(ImplOf(device)->GetInt("deviceID", 0), -1);
  device.SetSysexDeviceID(static_cast<char>(0x90));
  EXPECT_EQ(ImplOf(device)->GetInt("deviceID", 0), -1);
  device.SetSysexDeviceID(127);
  EXPECT_EQ(ImplOf(device)->GetInt("deviceID", 0), 127);
}

TEST_F(DeviceObjectTest, AFreshObjectHasTheDefaults) {
  EXPECT_TRUE(device.ReceivesNotes());
  EXPECT_FALSE(device.ReceivesClock());
  EXPECT_EQ(device.ReceiveChannels(), 65535);
  EXPECT_EQ(device.TransmitChannels(), 65535);
  EXPECT_EQ(device.GetAdvanceScheduleMicroseconds(), 0);
  EXPECT_EQ(device.GetManufacturer(), UString());
}

TEST_F(DeviceObjectTest, AnEndpointNamesItsChannelsByNumberWhereADeviceDoesNot) {
  EXPECT_EQ(device.GetChannelName(3), UString());
  EXPECT_EQ(destination.GetChannelName(3), UString("4"));
  device.SetChannelName(3, "Bass");
  EXPECT_EQ(device.GetChannelName(3), UString("Bass"));
  EXPECT_EQ(destination.GetChannelName(3), UString("Bass"));
  EXPECT_EQ(ImplOf(device)->GetString("com_vantor_ChannelName3"), UString("Bass"));
}

TEST_F(DeviceObjectTest, ChannelsOutsideZeroTo15HaveNoNames) {
  for (int const channel : {-1, 16, 100000}) {
    device.SetChannelName(channel, "x");
    EXPECT_EQ(device.GetChannelName(channel), UString());
  }
  EXPECT_EQ(destination.GetChannelName(16), UString());
  EXPECT_EQ(destination.GetChannelName(-1), UString());
}

TEST_F(DeviceObjectTest, TheModelInfoFollowsFromTheDeviceType) {
  struct {
    int type;
    unsigned char bytes[7];
  } const kCases[] = {{0, {255, 255, 255, 255, 255, 255, 255}}, {3, {0, 0, 0x33, 0, 7, 0x10, 0}},
                      {4, {255, 255, 255, 255, 255, 255, 255}}, {5, {0, 0, 0x33, 0, 7, 0x11, 0}},
                      {6, {0, 0, 0x33, 0, 7, 0x12, 0}},         {7, {0, 0, 0x33, 1, 0, 1, 0}}};
  EXPECT_TRUE(device.GetModelInfo() == ModelInfo());
  for (auto const& one : kCases) {
    TestSetup::SetInt(device, "com_vantor_DeviceType", one.type);
    ModelInfo expected;
    std::copy(std::begin(one.bytes), std::end(one.bytes), expected.bytes);
    EXPECT_TRUE(device.GetModelInfo() == expected) << one.type;
  }
}

TEST_F(DeviceObjectTest, ThePlatformsReferenceIsComparedInTheObjectsOwnBackend) {
  int thing = 0;
  TestSetup::PeerOf(device).implObjRef = &thing;
  EXPECT_EQ(device.GetImplementation(), Properties::kPlatformImplementation);
  EXPECT_EQ(device._get_impl_obj_ref(Properties::kPlatformImplementation), &thing);
  EXPECT_EQ(device._get_impl_obj_ref(Properties::kPluginHostImplementation), nullptr);
  EXPECT_TRUE(device.matches_impl_obj_ref(&thing));
  EXPECT_FALSE(device.matches_impl_obj_ref(nullptr));
}

TEST_F(DeviceObjectTest, IsOnlineWhileItExistsAndIsNotMarkedOffline) {
  EXPECT_TRUE(device.IsOnline());
  TestSetup::SetInt(device, "offline", 1);
  EXPECT_FALSE(device.IsOnline());
  TestSetup::SetInt(device, "offline", 0);
  setup.DeleteDevice(device);
  EXPECT_FALSE(device.IsOnline());
}

TEST(PropertyKeys, AreAllDifferent) {
  std::set<UString> const keys = {Keys::kName,
                                  Keys::kManufacturer,
                                  Keys::kModel,
                                  Keys::kUniqueID,
                                  Keys::kConnUniqueID,
                                  Keys::kSlotDescriptor,
                                  Keys::kDeviceType,
                                  Keys::kPortNumber,
                                  Keys::kImage,
                                  Keys::kDeviceID,
                                  Keys::kScheduleAheadMuSec,
                                  Keys::kOffline,
                                  Keys::kWhichAPI,
                                  Keys::kEmbedded,
                                  Keys::kBroadcast,
                                  Keys::kDriver,
                                  Keys::kReceiveChannels,
                                  Keys::kTransmitChannels,
                                  Keys::kMaxReceiveChannels,
                                  Keys::kMaxTransmitChannels,
                                  Keys::kSingleRealtimeEntity,
                                  Keys::kCanRoute,
                                  Keys::kPanDisruptsStereo,
                                  Keys::kNameConfiguration,
                                  Keys::kSavedManufacturer,
                                  Keys::kSavedModel,
                                  Keys::kSavedMasterNameFile,
                                  Keys::kDriverVersion,
                                  Keys::kMaxSysExSpeed,
                                  Keys::kPrivate};
  EXPECT_EQ(keys.size(), 30U);
  EXPECT_EQ(std::set<UString>(Keys::kChannelNames.begin(), Keys::kChannelNames.end()).size(), 16U);
  EXPECT_EQ(Keys::kChannelNames[15], UString("com_vantor_ChannelName15"));
}

TEST(Properties, TellOfThePlatformBackend) {
  Properties const& properties = TestSetup::Get().GetProperties();
  EXPECT_EQ(properties.GetImplementation(), 3);
  EXPECT_EQ(properties.GetImplementationName(), UString("WinMIDI"));
  EXPECT_EQ(properties.GetImplementationVersion(), 0U);
  EXPECT_FALSE(properties.ConfigUtilityExists());
  EXPECT_EQ(properties.GetConfigUtilityName(), UString("No MIDI Utility"));
  EXPECT_EQ(properties.RunConfigUtility(), 3);
}

}  // namespace
}  // namespace Ostinet::Testing

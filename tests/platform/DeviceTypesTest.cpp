// SPDX-License-Identifier: MIT
#include "devicetypes/DeviceTypeInfoImpl.h"
#include "model/Handles.h"
#include "model/PropertyKeys.h"
#include "platform/PlatformTest.h"

namespace Ostinet::Testing {
namespace {

using ::testing::ElementsAre;

/// Devices of the studio that are made after a type, or made over to another one.
class DeviceTypes : public PlatformTest {
 protected:
  DeviceTypes() {
    AddOut("Out");
    AddIn("In");
    SignIn();
  }

  /// The type "Acme" "Synth" with so many groups of one port each way.
  static DeviceTypeInfo TypeOf(int groups) {
    RCPtrMT<Impl::DeviceTypeInfoImpl> const type(new Impl::DeviceTypeInfoImpl("Acme", "Synth"));
    for (int i = 0; i < groups; ++i) {
      type->portGroups.push_back({UString(), {UString()}, {UString()}});
    }
    return type;
  }
  static int Number(DeviceObject const& object, UString const& key) {
    return Impl::ImplOf(object)->GetInt(key, -1);
  }
  static std::vector<std::string> EntityNames(Device const& device) {
    std::vector<std::string> names;
    for (int i = 0; i < device.CountEntities(); ++i) {
      names.push_back(device.GetEntity(i).GetRawName().string());
    }
    return names;
  }
};

TEST_F(DeviceTypes, ANewDeviceGetsTheFactsButNeitherMakerNorModel) {
  DeviceTypeInfo const type = TypeOf(1);
  type.GetImplPtr()->hasDeviceID = true;
  type.GetImplPtr()->defaultDeviceID = 16;
  type.GetImplPtr()->receives.maxChannels = 4;
  Device const device = setup.CreateDevice(type, "Lead");
  EXPECT_EQ(device.GetName(), UString("Lead"));
  EXPECT_EQ(device.GetSysexDeviceID(), 16);
  EXPECT_EQ(device.ReceiveChannels(), 0x000F);
  EXPECT_NE(Number(device, Impl::Keys::kUniqueID), -1);
  // A host that wants these sets them.
  EXPECT_EQ(device.GetManufacturer(), UString());
  EXPECT_EQ(device.GetModel(), UString());
}

TEST_F(DeviceTypes, ANewDeviceHasTheEntitiesOfItsType) {
  DeviceTypeInfo const type = TypeOf(1);
  type.GetImplPtr()->portGroups.push_back({"Main", {"In A", "", "In C"}, {}});
  Device const device = setup.CreateDevice(type, "Lead");
  EXPECT_THAT(EntityNames(device), ElementsAre("Port 1", "Main"));
  Entity const main = device.GetEntity(1);
  EXPECT_EQ(main.CountSources(), 0);
  ASSERT_EQ(main.CountDestinations(), 3);
  EXPECT_EQ(main.GetDestination(0).GetRawName(), UString("In A"));
  EXPECT_EQ(main.GetDestination(2).GetRawName(), UString("In C"));
  // The nameless one has the name that its entity gave it.
  EXPECT_EQ(main.GetDestination(1).GetRawName(), UString("Main"));
}

TEST_F(DeviceTypes, ANewDeviceWithoutTypeOrPortsHasOnePair) {
  for (DeviceTypeInfo const& type : {DeviceTypeInfo(), TypeOf(0)}) {
    Device const device = setup.CreateDevice(type, "Lead");
    EXPECT_THAT(EntityNames(device), ElementsAre("Port 1"));
    EXPECT_EQ(device.GetEntity(0).CountSources(), 1);
    EXPECT_EQ(device.GetEntity(0).CountDestinations(), 1);
  }
  EXPECT_EQ(setup.GetDevice(1).GetName(), UString("Lead 2"));
}

TEST_F(DeviceTypes, AnotherTypeKeepsTheFirstEntitiesWithTheirConnections) {
  Device const device = setup.CreateDevice(TypeOf(5), "Lead");
  Entity const first = device.GetEntity(0);
  Destination const kept = first.GetDestination(0);
  Destination const lost = device.GetEntity(4).GetDestination(0);
  Dest("Out").AddConnectedDestination(kept);
  ASSERT_EQ(Dest("Out").GetConnectedDestination(0), kept);
  setup.ChangeDeviceType(device, TypeOf(2));
  ASSERT_EQ(device.CountEntities(), 2);
  EXPECT_EQ(device.GetEntity(0), first);
  EXPECT_EQ(device.GetManufacturer(), UString("Acme"));
  EXPECT_TRUE(kept.Exists());
  ASSERT_EQ(Dest("Out").CountConnectedDestinations(), 1);
  EXPECT_EQ(Dest("Out").GetConnectedDestination(0), kept);
  EXPECT_FALSE(lost.Exists());
}

TEST_F(DeviceTypes, APortThatGoesWithItsEntityLeavesWhatItHungOn) {
  Device const device = setup.CreateDevice(TypeOf(2), "Lead");
  Dest("Out").AddConnectedDestination(device.GetEntity(1).GetDestination(0));
  ASSERT_EQ(Dest("Out").CountConnectedDestinations(), 1);
  setup.ChangeDeviceType(device, TypeOf(1));
  EXPECT_EQ(Dest("Out").CountConnectedDestinations(), 0);
}

TEST_F(DeviceTypes, TheListenerHearsOfTheChange) {
  Device const device = setup.CreateDevice(TypeOf(1), "Lead");
  setup.PollSetupChanges();
  int const before = listener.setupChanges;
  setup.PollSetupChanges();
  ASSERT_EQ(listener.setupChanges, before);
  setup.ChangeDeviceType(device, TypeOf(1));
  setup.PollSetupChanges();
  EXPECT_EQ(listener.setupChanges, before + 1);
}

TEST_F(DeviceTypes, AnEmptyTypeChangesNothing) {
  Device const device = setup.CreateDevice(TypeOf(3), "Lead");
  setup.ChangeDeviceType(device, DeviceTypeInfo());
  EXPECT_EQ(device.CountEntities(), 3);
}

}  // namespace
}  // namespace Ostinet::Testing

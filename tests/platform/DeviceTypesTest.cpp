// SPDX-License-Identifier: MIT
#include "devicetypes/DeviceTypeInfoImpl.h"
#include "model/Handles.h"
#include "model/PropertyKeys.h"
#include "ostinet/Autodetect.h"
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
  static std::vector<std::string> DestinationNames(Entity const& entity) {
    std::vector<std::string> names;
    for (int i = 0; i < entity.CountDestinations(); ++i) {
      names.push_back(entity.GetDestination(i).GetRawName().string());
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
  type.GetImplPtr()->portGroups.push_back({"Main", {"In A", "In B"}, {}});
  type.GetImplPtr()->portGroups.push_back({"Out", {}, {"Out A", "", "Out C"}});
  Device const device = setup.CreateDevice(type, "Lead");
  EXPECT_THAT(EntityNames(device), ElementsAre("Port 1", "Main", "Out"));
  Entity const main = device.GetEntity(1);
  EXPECT_EQ(main.CountSources(), 0);
  EXPECT_THAT(DestinationNames(main), ElementsAre("In A", "In B"));
  Entity const out = device.GetEntity(2);
  EXPECT_EQ(out.CountDestinations(), 0);
  ASSERT_EQ(out.CountSources(), 3);
  EXPECT_EQ(out.GetSource(0).GetRawName(), UString("Out A"));
  EXPECT_EQ(out.GetSource(2).GetRawName(), UString("Out C"));
  // The nameless one has the name that its entity gave it.
  EXPECT_EQ(out.GetSource(1).GetRawName(), UString("Out"));
}

// Type files are written around this, so it must stay as it is: the input at the entity's own place
// among the entities says for all of them whether they take their names.
TEST_F(DeviceTypes, OneInputOfANewEntitySaysForAllWhetherTheyAreNamed) {
  DeviceTypeInfo const type = TypeOf(0);
  type.GetImplPtr()->portGroups = {{"First", {"", "In B"}, {}},
                                   {"Second", {"", "In B", "In C"}, {}},
                                   {"Third", {"In A", "In B", ""}, {}}};
  Device const device = setup.CreateDevice(type, "Lead");
  EXPECT_THAT(DestinationNames(device.GetEntity(0)), ElementsAre("First", "First"));
  // Where it has a name, those without one become nameless.
  EXPECT_THAT(DestinationNames(device.GetEntity(1)), ElementsAre("", "In B", "In C"));
  EXPECT_THAT(DestinationNames(device.GetEntity(2)), ElementsAre("Third", "Third", "Third"));
}

TEST_F(DeviceTypes, WithoutAnInputAtThePlaceOfTheEntityEachSaysItForItself) {
  DeviceTypeInfo const type = TypeOf(1);
  type.GetImplPtr()->portGroups.push_back({"Second", {"In A"}, {}});
  type.GetImplPtr()->portGroups.push_back({"Third", {"", "In B"}, {}});
  Device const device = setup.CreateDevice(type, "Lead");
  EXPECT_THAT(DestinationNames(device.GetEntity(1)), ElementsAre("In A"));
  EXPECT_THAT(DestinationNames(device.GetEntity(2)), ElementsAre("Third", "In B"));
}

TEST_F(DeviceTypes, ADeviceThatIsMadeOverNamesEachInputByItself) {
  Device const device = setup.CreateDevice(TypeOf(1), "Lead");
  DeviceTypeInfo const type = TypeOf(0);
  type.GetImplPtr()->portGroups = {{"First", {"", "In B"}, {}}, {"Second", {"In A", ""}, {}}};
  setup.ChangeDeviceType(device, type);
  EXPECT_THAT(DestinationNames(device.GetEntity(0)), ElementsAre("First", "In B"));
  EXPECT_THAT(DestinationNames(device.GetEntity(1)), ElementsAre("In A", "Second"));
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

TEST_F(DeviceTypes, AQuestionWithoutATimeIsStampedWithThePresent) {
  Autodetect::Request const inquiry = DeviceTypeCatalog::Instance().GetAutodetectRequest(0);
  auto const before = CurrentMIDITime().Value();
  DataBuffer const sweep = inquiry.GetMessageW(kNoTimeStamp);
  auto const after = CurrentMIDITime().Value();
  ASSERT_GT(before, 0u);
  ASSERT_FALSE(sweep.empty());
  auto const stamp = sweep[0].stamp.AsMIDITime().Value();
  EXPECT_GE(stamp, before);
  EXPECT_LE(stamp, after);
  for (std::size_t i = 0; i < sweep.size(); ++i) {
    EXPECT_EQ(sweep[i].stamp.AsMIDITime().Value(), stamp);
  }
}

TEST_F(DeviceTypes, AnEmptyTypeChangesNothing) {
  Device const device = setup.CreateDevice(TypeOf(3), "Lead");
  setup.ChangeDeviceType(device, DeviceTypeInfo());
  EXPECT_EQ(device.CountEntities(), 3);
}

}  // namespace
}  // namespace Ostinet::Testing

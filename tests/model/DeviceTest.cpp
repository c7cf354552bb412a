// SPDX-License-Identifier: MIT
#include <algorithm>
#include <cstdlib>

#include "model/PropertyKeys.h"
#include "support/StudioTest.h"

namespace Ostinet::Testing {
namespace {

using Impl::ImplOf;
using ::testing::Contains;
using ::testing::ElementsAre;
using ::testing::IsEmpty;
using ::testing::Not;

class DeviceTest : public StudioTest {};

TEST_F(DeviceTest, ATakenNameGetsTheFirstFreeNumber) {
  setup.CreateDevice("Synth");
  EXPECT_EQ(setup.CreateDevice("Synth").GetName(), UString("Synth 2"));
  EXPECT_EQ(setup.CreateDevice("Synth").GetName(), UString("Synth 3"));
}

TEST_F(DeviceTest, GapsInTheNumbersAreFilled) {
  setup.CreateDevice("Synth");
  Device const second = setup.CreateDevice("Synth");
  setup.CreateDevice("Synth");
  second.SetRawName("Bass");
  EXPECT_EQ(setup.CreateDevice("Synth").GetName(), UString("Synth 2"));
}

TEST_F(DeviceTest, NamesThatDifferInCaseAndWhiteSpaceAreTheSame) {
  setup.MakeDevice("My Synth");
  EXPECT_TRUE(setup.HaveDeviceWithName("MY  SYNTH"));
  EXPECT_TRUE(setup.HaveDeviceWithName("mysynth"));
  EXPECT_FALSE(setup.HaveDeviceWithName("My Synth 2"));
  EXPECT_EQ(setup.MakeUniqueDevName("mysynth"), UString("mysynth 2"));
}

TEST_F(DeviceTest, AnImportedDeviceComesFromTheBackend) {
  char const text[] = "<Device/>";
  XMLLib::Parser parser(text, sizeof text - 1);
  EXPECT_EQ(setup.CreateDevice(parser).GetName(), UString("Imported"));
}

TEST_F(DeviceTest, AnObjectKeepsTheUniqueIDThatItHas) {
  Device const device = setup.MakeDevice("Synth");
  TestSetup::SetInt(device, "uniqueID", 4711);
  setup.MaybeAssignUniqueID(*ImplOf(device));
  EXPECT_EQ(device._get_impl_id(), 4711);
  TestSetup::SetInt(device, "uniqueID", 0);
  setup.MaybeAssignUniqueID(*ImplOf(device));
  EXPECT_EQ(device._get_impl_id(), 0);
}

// Parts made after their device bear its ID: setups of that form are in use.
TEST_F(DeviceTest, APartThatInheritsAnIDGetsNoneOfItsOwn) {
  Device const device = setup.MakeDevice("Synth");
  Entity const entity = setup.MakeEntity(device, "Port 1", 1, 1);
  EXPECT_EQ(entity._get_impl_id(), device._get_impl_id());
  EXPECT_EQ(entity.GetSource(0).GetUniqueID(), device._get_impl_id());
  EXPECT_EQ(TestSetup::PeerOf(entity).OwnProperties().count("uniqueID"), 0U);
}

TEST_F(DeviceTest, ANewIDIsPositiveAndNotInUse) {
  std::srand(1);
  Device const first = setup.MakeDevice("One");
  std::srand(1);  // the same numbers come again
  Device const second = setup.MakeDevice("Two");
  EXPECT_GT(first._get_impl_id(), 0);
  EXPECT_GT(second._get_impl_id(), 0);
  EXPECT_NE(first._get_impl_id(), second._get_impl_id());
}

TEST_F(DeviceTest, AnIDIsInUseAsLongAsAnObjectOfAnyListHasIt) {
  Device const device = setup.MakeDevice("Synth");
  Source const hidden = setup.MakeSource("x", Impl::EndpointKind::Bare(true, true));
  TestSetup::SetInt(device, "uniqueID", 1001);
  TestSetup::SetInt(hidden, "uniqueID", 1002);
  EXPECT_TRUE(setup.UniqueIDInUse(1001));
  EXPECT_TRUE(setup.UniqueIDInUse(1002));
  EXPECT_FALSE(setup.UniqueIDInUse(1003));
  TestSetup::SetInt(device, "uniqueID", 1003);
  EXPECT_FALSE(setup.UniqueIDInUse(1001));
  EXPECT_TRUE(setup.UniqueIDInUse(1003));
  setup.DeleteDevice(device);  // the handle keeps the object, but not in the studio
  EXPECT_FALSE(setup.UniqueIDInUse(1003));
  EXPECT_EQ(device._get_impl_id(), 1003);
  TestSetup::PeerOf(hidden).SetString("uniqueID", "none");
  EXPECT_FALSE(setup.UniqueIDInUse(1002));
  EXPECT_TRUE(setup.UniqueIDInUse(0));  // as what has no ID reads
}

TEST_F(DeviceTest, AnIDThatReachedAStoreByCopyingIsInUse) {
  Device const device = setup.MakeDevice("Synth");
  {
    TestPeer other(setup);
    other.SetInt("uniqueID", 77);
    TestSetup::PeerOf(device).CopyProperty(other, "uniqueID");
    EXPECT_TRUE(setup.UniqueIDInUse(77));
    TestSetup::PeerOf(device).RemoveProperty("uniqueID");
    EXPECT_FALSE(setup.UniqueIDInUse(77));
    TestSetup::PeerOf(device).AdoptMissingProperties(other);
  }
  EXPECT_TRUE(setup.UniqueIDInUse(77));
}

TEST_F(DeviceTest, ALoneEntityBearsTheDevicesName) {
  Device const device = setup.MakeDevice("Synth");
  Entity const first = setup.MakeEntity(device, "Left", 1, 1);
  EXPECT_EQ(first.GetName(), UString("Synth"));
  Entity const second = setup.MakeEntity(device, "Right", 1, 1);
  EXPECT_EQ(first.GetName(), UString("Synth Left"));
  EXPECT_EQ(second.GetName(), UString("Synth Right"));
  setup.DeleteEntity(second);
  EXPECT_EQ(first.GetName(), UString("Synth"));
  EXPECT_EQ(second.GetName(), UString("Right"));
}

TEST_F(DeviceTest, DeletingADeviceTakesItsEndpointsOutFirst) {
  Device const device = setup.CreateDevice("Synth");
  Destination const destination = device.GetEntity(0).GetDestination(0);
  struct Names : Impl::DestinationNames {
    explicit Names(std::function<void()> call) : onRemove(std::move(call)) {}
    bool Renew() override { return false; }
    void SaveEditedBanks() override {}
    void WillRemove() override { onRemove(); }
    std::function<void()> onRemove;
  };
  bool wasAlive = false;
  ImplOf(destination)->SetNames(std::make_unique<Names>([&] {
    wasAlive = device.Exists() && setup.CountDevices() == 0 && setup.CountEntities() == 0 &&
               setup.CountSources() == 0 && setup.CountDestinations() == 1;
  }));
  setup.DeleteDevice(device);
  EXPECT_TRUE(wasAlive);
  EXPECT_EQ(setup.CountDestinations(), 0);
  EXPECT_THAT(setup.calls, Contains("WillDeleteDevice"));
}

TEST_F(DeviceTest, ADirectDeviceGoesOnlyWhileItIsOffline) {
  Device const device = setup.MakeDevice("Interface", true);
  setup.DeleteDevice(device);
  EXPECT_TRUE(device.Exists());
  EXPECT_THAT(setup.calls, IsEmpty());
  TestSetup::SetInt(device, "offline", 1);
  setup.DeleteDevice(device);
  EXPECT_FALSE(device.Exists());
}

TEST_F(DeviceTest, DirectObjectsCannotBeEdited) {
  Device const device = setup.MakeDevice("Interface", true);
  Entity const entity = setup.MakeEntity(device, "Port 1", 1, 1);
  EXPECT_FALSE(setup.CreateEntity(device, "Port 2", 1, 1).Exists());
  setup.DeleteEntity(entity);
  setup.SetEntitySources(entity, 5);
  setup.SetEntityDestinations(entity, 5);
  EXPECT_TRUE(entity.Exists());
  EXPECT_EQ(entity.CountSources(), 1);
  EXPECT_EQ(entity.CountDestinations(), 1);
  EXPECT_THAT(setup.calls, IsEmpty());
}

TEST_F(DeviceTest, DeadObjectsCannotBeEdited) {
  Device const device = setup.CreateDevice("Synth");
  Entity const entity = device.GetEntity(0);
  setup.DeleteDevice(device);
  setup.calls.clear();
  EXPECT_FALSE(setup.CreateEntity(device, "Port 2", 1, 1).Exists());
  setup.DeleteDevice(device);
  setup.DeleteEntity(entity);
  setup.SetEntitySources(entity, 5);
  EXPECT_THAT(setup.calls, IsEmpty());
}

TEST_F(DeviceTest, EndpointsOfAnEntityAreMadeAndDeletedFromTheEnd) {
  Device const device = setup.CreateDevice("Synth");
  Entity const entity = setup.CreateEntity(device, "Port 2", 2, -3);
  EXPECT_EQ(entity.CountSources(), 2);
  EXPECT_EQ(entity.CountDestinations(), 0);
  Source const first = entity.GetSource(0);
  Source const second = entity.GetSource(1);
  setup.SetEntitySources(entity, 1);
  EXPECT_TRUE(first.Exists());
  EXPECT_FALSE(second.Exists());
  setup.SetEntitySources(entity, -1);
  EXPECT_FALSE(first.Exists());
  EXPECT_THAT(setup.calls, Contains("SetEntitySources 0"));
  setup.SetEntityDestinations(entity, 3);
  EXPECT_EQ(entity.CountDestinations(), 3);
}

TEST_F(DeviceTest, IndexesOutOfRangeGiveNullHandles) {
  Device const device = setup.CreateDevice("Synth");
  Entity const entity = device.GetEntity(0);
  for (int const index : {-1, 1, 1000}) {
    EXPECT_TRUE(device.GetEntity(index) == Entity());
    EXPECT_TRUE(entity.GetSource(index) == Source());
    EXPECT_TRUE(entity.GetDestination(index) == Destination());
  }
}

class SpecialEntityTest : public StudioTest {
 protected:
  SpecialEntityTest() {
    for (int const port : {0, 17, 99, 17}) {
      Entity const entity = setup.MakeEntity(device, "Port", 0, 1);
      TestSetup::SetInt(entity, "com_vantor_PortNumber", port);
    }
  }
  /// The index of the special entity, or -1.
  int Special(int deviceType, int special) {
    TestSetup::SetInt(device, "com_vantor_DeviceType", deviceType);
    Entity const found = device.GetSpecialEntity(Device::SpecialEntityType(special));
    for (int i = 0; i < device.CountEntities(); ++i) {
      if (device.GetEntity(i) == found) {
        return i;
      }
    }
    return -1;
  }

  Device const device = setup.MakeDevice("Interface", true);
};

TEST_F(SpecialEntityTest, IsFoundByPortNumberForDevicesOfCertainTypes) {
  EXPECT_EQ(Special(3, 0), 0);
  EXPECT_EQ(Special(5, 0), 0);
  EXPECT_EQ(Special(6, 0), 0);
  EXPECT_EQ(Special(7, 0), -1);
  EXPECT_EQ(Special(3, 1), 1);  // the first of two
  EXPECT_EQ(Special(3, 2), 2);
  EXPECT_EQ(Special(5, 1), -1);
  EXPECT_EQ(Special(6, 2), -1);
  EXPECT_EQ(Special(3, 4), -1);
  EXPECT_EQ(Special(3, -1), -1);
}

TEST_F(SpecialEntityTest, TheRealtimeEntityIsGivenByIndex) {
  EXPECT_EQ(Special(0, 3), -1);
  for (int const index : {0, 3}) {
    TestSetup::SetInt(device, "single realtime entity", index);
    EXPECT_EQ(Special(0, 3), index);
  }
  for (int const index : {-1, 4}) {
    TestSetup::SetInt(device, "single realtime entity", index);
    EXPECT_EQ(Special(0, 3), -1);
  }
}

TEST_F(SpecialEntityTest, TheCommonEntitysEndpointsSpeakForTheDevice) {
  EXPECT_FALSE(device.GetEntity(0).GetDestination(0).IsDeviceCommon());
  TestSetup::SetInt(device, "com_vantor_DeviceType", 5);
  EXPECT_TRUE(device.GetEntity(0).GetDestination(0).IsDeviceCommon());
  EXPECT_FALSE(device.GetEntity(1).GetDestination(0).IsDeviceCommon());
  EXPECT_FALSE(setup.MakePort("Bare").IsDeviceCommon());
}

}  // namespace
}  // namespace Ostinet::Testing

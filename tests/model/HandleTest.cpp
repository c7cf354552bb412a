// SPDX-License-Identifier: MIT
#include <set>
#include <utility>

#include "model/PropertyKeys.h"
#include "ostinet/NamesCatalog.h"
#include "support/StudioTest.h"

namespace Ostinet::Testing {
namespace {

using Impl::ImplOf;
using ::testing::Contains;
using ::testing::IsEmpty;

class HandleTest : public StudioTest {};

static_assert(sizeof(Device) == 2 * sizeof(void*) && sizeof(Destination) == 2 * sizeof(void*),
              "a handle is two machine words");

TEST(Handle, ANullHandleEqualsTheNullConstantAndDoesNotExist) {
  EXPECT_TRUE(Device::kNoDevice == Device());
  EXPECT_FALSE(Device::kNoDevice.Exists());
  EXPECT_EQ(Device::kNoDevice.GetName(), UString());
}

TEST(Handle, NullHandlesOfDifferentClassesAreEqual) {
  EXPECT_TRUE(Source() == Destination());
  EXPECT_FALSE(Source() != Destination());
  EXPECT_FALSE(Source() < Destination());
}

// Hosts' documents hold these tags; a patch has always had its bank's.
TEST(Handle, ObjectTagsAreTheStoredOnes) {
  EXPECT_EQ(Device::kObjectID, 1);
  EXPECT_EQ(Entity::kObjectID, 2);
  EXPECT_EQ(Source::kObjectID, 3);
  EXPECT_EQ(Destination::kObjectID, 4);
  EXPECT_EQ(MatchObjectID(DestinationMode::kObjectID), 5);
  EXPECT_EQ(MatchObjectID(DestinationNameSet::kObjectID), 6);
  EXPECT_EQ(MatchObjectID(PatchBank::kObjectID), 7);
  EXPECT_EQ(MatchObjectID(Patch::kObjectID), 7);
  EXPECT_EQ(MatchObjectID(NoteNameList::kObjectID), 9);
  EXPECT_EQ(MatchObjectID(DefaultNoteNameList::kObjectID), 10);
  EXPECT_EQ(MatchObjectID(ControlList::kObjectID), 11);
  EXPECT_EQ(MatchObjectID(DefaultControlList::kObjectID), 12);
}

TEST_F(HandleTest, CopiesFromBeforeAndAfterRemovalAreEqualAndDead) {
  Device const device = setup.MakeDevice("Synth");
  Device const before = device;
  setup.DeleteDevice(device);
  Device const after = device;
  EXPECT_TRUE(before == after);
  EXPECT_FALSE(before.Exists());
  EXPECT_FALSE(after.Exists());
  EXPECT_FALSE(before == Device::kNoDevice);
}

TEST_F(HandleTest, TheLastHandleOfARemovedObjectFreesItAndItsPeer) {
  int const alive = TestPeer::sAlive;
  {
    Device device = setup.MakeDevice("Synth");
    EXPECT_EQ(TestPeer::sAlive, alive + 1);
    setup.DeleteDevice(device);
    setup.pending.clear();
    EXPECT_EQ(TestPeer::sAlive, alive + 1);
    device = Device();
    EXPECT_EQ(TestPeer::sAlive, alive);
  }
}

TEST_F(HandleTest, ReleasingAHandleOfAnObjectInTheStudioFreesNothing) {
  int const alive = TestPeer::sAlive;
  setup.MakeDevice("Synth");
  EXPECT_EQ(TestPeer::sAlive, alive + 1);
  EXPECT_TRUE(setup.GetDevice(0).Exists());
}

TEST_F(HandleTest, AssigningAHandleToItselfKeepsItsObject) {
  int const alive = TestPeer::sAlive;
  Device device = setup.MakeDevice("Synth");
  setup.DeleteDevice(device);
  setup.pending.clear();
  Device const& same = device;
  device = same;
  EXPECT_EQ(TestPeer::sAlive, alive + 1);
  EXPECT_EQ(device.GetRawName(), UString("Synth"));
  device = Device();
  EXPECT_EQ(TestPeer::sAlive, alive);
}

TEST_F(HandleTest, ASetKeepsItsOrderWhileObjectsDie) {
  std::set<Device> devices;
  for (int i = 0; i < 10; ++i) {
    devices.insert(setup.MakeDevice("Synth"));
  }
  std::vector<unsigned long long> keys;
  for (Device const& device : devices) {
    keys.push_back(device.GetKey());
  }
  setup.DeleteDevice(setup.GetDevice(3));
  setup.DeleteDevice(setup.GetDevice(6));
  std::vector<unsigned long long> later;
  for (Device const& device : devices) {
    later.push_back(device.GetKey());
    EXPECT_EQ(devices.count(device), 1U);
  }
  EXPECT_EQ(keys, later);
  EXPECT_EQ(devices.size(), 10U);
}

TEST_F(HandleTest, ADeadEndpointHasLostItsLinks) {
  Device const device = setup.MakeDevice("Synth");
  Entity const entity = setup.MakeEntity(device, "Port 1", 1, 1);
  Source const source = entity.GetSource(0);
  Destination const destination = entity.GetDestination(0);
  Destination const port = setup.MakePort("Out");
  port.AddConnectedDestination(destination);
  ASSERT_TRUE(destination.GetDirectDestination() == port);
  setup.DeleteDevice(device);

  EXPECT_FALSE(entity.Exists());
  EXPECT_FALSE(source.Exists());
  EXPECT_FALSE(destination.Exists());
  EXPECT_TRUE(source.GetEntity() == Entity::kNoEntity);
  EXPECT_TRUE(entity.GetDevice() == Device::kNoDevice);
  EXPECT_TRUE(destination.GetDirectDestination() == Destination::kNoDestination);
  EXPECT_EQ(device.CountEntities(), 0);
  EXPECT_EQ(entity.CountSources(), 0);
  EXPECT_EQ(entity.CountDestinations(), 0);
  EXPECT_EQ(port.CountConnectedDestinations(), 0);
}

TEST_F(HandleTest, ADeadHandleStillReadsAndWritesButNobodyHears) {
  Device const device = setup.MakeDevice("Synth");
  device.SetModel("One");
  setup.DeleteDevice(device);
  setup.pending.clear();
  EXPECT_EQ(device.GetModel(), UString("One"));
  device.SetModel("Two");
  EXPECT_EQ(device.GetModel(), UString("Two"));
  EXPECT_THAT(setup.pending, IsEmpty());
}

TEST_F(HandleTest, HandlesOutliveTheStudioTheyCameFrom) {
  Device const device = setup.MakeDevice("Synth");
  Entity const entity = setup.MakeEntity(device, "Port 1", 1, 1);
  Source const source = entity.GetSource(0);
  setup.SignOut(false);
  EXPECT_FALSE(device.Exists());
  EXPECT_FALSE(entity.Exists());
  EXPECT_FALSE(source.Exists());
  EXPECT_EQ(device.GetName(), UString("Synth"));
  EXPECT_TRUE(source.GetEntity() == Entity::kNoEntity);
}

// A process that ends without signing out frees devices while hosts still hold their parts.
TEST_F(HandleTest, PartsOfADeviceThatWasFreedWithoutDeactivationHaveNoDanglingLinks) {
  Source source;
  {
    RCPtrMT<Impl::DeviceImpl> device(
        new Impl::DeviceImpl(std::make_unique<TestPeer>(setup), false));
    RCPtrMT<Impl::EntityImpl> entity(
        new Impl::EntityImpl(std::make_unique<TestPeer>(setup), device.get()));
    device->AddEntity(entity);
    RCPtrMT<Impl::EndpointImpl> endpoint(new Impl::EndpointImpl(
        std::make_unique<TestPeer>(setup), setup, Impl::EndpointKind::InEntity(*entity)));
    entity->AddSource(endpoint);
    source = endpoint;
  }
  EXPECT_TRUE(source.GetEntity() == Entity::kNoEntity);
  EXPECT_EQ(source.GetName(), UString());
}

class Counted : public RCObjectMT<Counted> {
 public:
  explicit Counted(int& alive) : alive_(alive) { ++alive_; }
  ~Counted() override { --alive_; }
  RCPtrMT<Counted> next;

 private:
  int& alive_;
};

TEST(CountedPointer, FreesTheObjectWithTheLastPointer) {
  int alive = 0;
  {
    RCPtrMT<Counted> const one(new Counted(alive));
    RCPtrMT<Counted> two = one;
    two = nullptr;
    EXPECT_EQ(alive, 1);
  }
  EXPECT_EQ(alive, 0);
}

TEST(CountedPointer, MayBeAssignedAPointerHeldByItsOwnObject) {
  int alive = 0;
  RCPtrMT<Counted> head(new Counted(alive));
  head->next = new Counted(alive);
  head = head->next;
  EXPECT_EQ(alive, 1);
  RCPtrMT<Counted> const& same = head;
  head = same;
  EXPECT_EQ(alive, 1);
  head = nullptr;
  EXPECT_EQ(alive, 0);
}

}  // namespace
}  // namespace Ostinet::Testing

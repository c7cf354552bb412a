// SPDX-License-Identifier: MIT
#include "model/PropertyKeys.h"
#include "support/StudioTest.h"

namespace Ostinet::Testing {
namespace {

using Impl::ImplOf;

class EndpointNameTest : public StudioTest {
 protected:
  Device const device = setup.MakeDevice("Synth");
};

TEST_F(EndpointNameTest, ALonePortBearsTheDevicesName) {
  Entity const entity = setup.MakeEntity(device, "Port 1", 1, 1);
  entity.GetSource(0).SetRawName("Out");
  EXPECT_EQ(entity.GetSource(0).GetName(), UString("Synth"));
  EXPECT_EQ(entity.GetDestination(0).GetName(), UString("Synth"));
}

TEST_F(EndpointNameTest, PortsOfSeveralEntitiesBearTheEntitysNameToo) {
  Entity const one = setup.MakeEntity(device, "Port 1", 0, 1);
  Entity const two = setup.MakeEntity(device, "Port 2", 0, 1);
  EXPECT_EQ(one.GetDestination(0).GetName(), UString("Synth Port 1"));
  EXPECT_EQ(two.GetDestination(0).GetName(), UString("Synth Port 2"));
}

TEST_F(EndpointNameTest, NamedPortsOfOneEntityBearTheirOwnNames) {
  Entity const entity = setup.MakeEntity(device, "Port 1", 2, 0);
  entity.GetSource(0).SetRawName("A");
  entity.GetSource(1).SetRawName("B");
  EXPECT_EQ(entity.GetSource(0).GetName(), UString("Synth A"));
  EXPECT_EQ(entity.GetSource(1).GetName(), UString("Synth B"));
}

TEST_F(EndpointNameTest, PortsNamedAsTheirEntityBearANumber) {
  Entity const entity = setup.MakeEntity(device, "Port 1", 2, 0);
  EXPECT_EQ(entity.GetSource(0).GetName(), UString("Synth (1)"));
  EXPECT_EQ(entity.GetSource(1).GetName(), UString("Synth (2)"));
}

TEST_F(EndpointNameTest, SiblingsCountByDirection) {
  Entity const entity = setup.MakeEntity(device, "Port 1", 2, 1);
  EXPECT_EQ(entity.GetSource(1).GetName(), UString("Synth (2)"));
  EXPECT_EQ(entity.GetDestination(0).GetName(), UString("Synth"));
}

TEST_F(EndpointNameTest, SeveralPortsOfSeveralEntitiesBearAllThree) {
  Entity const one = setup.MakeEntity(device, "Port 1", 0, 2);
  setup.MakeEntity(device, "Synth", 0, 2);
  one.GetDestination(0).SetRawName("A");
  EXPECT_EQ(one.GetDestination(0).GetName(), UString("Synth Port 1 A"));
  EXPECT_EQ(one.GetDestination(1).GetName(), UString("Synth Port 1 (2)"));
  // An entity that is named as the device adds nothing.
  EXPECT_EQ(device.GetEntity(1).GetDestination(1).GetName(), UString("Synth (2)"));
}

TEST_F(EndpointNameTest, ANamedLonePortOfSeveralEntitiesLeavesTheEntityOut) {
  Entity const one = setup.MakeEntity(device, "Port 1", 0, 1);
  setup.MakeEntity(device, "Port 2", 0, 1);
  one.GetDestination(0).SetRawName("Main");
  EXPECT_EQ(one.GetDestination(0).GetName(), UString("Synth Main"));
}

TEST_F(EndpointNameTest, WithoutADeviceItIsTheRawName) {
  EXPECT_EQ(setup.MakePort("USB MIDI").GetName(), UString("USB MIDI"));
  EXPECT_EQ(setup.MakePort("USB MIDI").GetEntityAndEndpointName(), UString("USB MIDI"));
}

TEST_F(EndpointNameTest, ADeviceWithAnEmptyNameGivesWayToTheRawName) {
  device.SetRawName("");
  Entity const entity = setup.MakeEntity(device, "Port 1", 1, 0);
  entity.GetSource(0).SetRawName("Own");
  EXPECT_EQ(entity.GetSource(0).GetName(), UString("Own"));
}

TEST_F(EndpointNameTest, EntityAndEndpointNameNumbersSiblingsAndIgnoresTheirNames) {
  Entity const entity = setup.MakeEntity(device, "Port 1", 1, 2);
  entity.GetDestination(1).SetRawName("Own");
  entity.GetSource(0).SetRawName("Own");
  EXPECT_EQ(entity.GetSource(0).GetEntityAndEndpointName(), UString("Port 1"));
  EXPECT_EQ(entity.GetDestination(0).GetEntityAndEndpointName(), UString("Port 1 (1)"));
  EXPECT_EQ(entity.GetDestination(1).GetEntityAndEndpointName(), UString("Port 1 (2)"));
}

TEST_F(EndpointNameTest, ANewNameIsSeenAtOnce) {
  Destination const port = setup.MakePort("Old");
  EXPECT_EQ(port.GetName(), UString("Old"));
  EXPECT_EQ(port.GetEntityAndEndpointName(), UString("Old"));
  port.SetRawName("New");
  EXPECT_EQ(port.GetName(), UString("New"));
  EXPECT_EQ(port.GetEntityAndEndpointName(), UString("New"));
}

TEST_F(EndpointNameTest, NewSiblingsAreSeenAtOnce) {
  Entity const one = setup.MakeEntity(device, "Port 1", 1, 1);
  EXPECT_EQ(one.GetDestination(0).GetName(), UString("Synth"));
  EXPECT_EQ(one.GetDestination(0).GetEntityAndEndpointName(), UString("Port 1"));
  setup.MakeDestinationIn(one);
  EXPECT_EQ(one.GetDestination(0).GetName(), UString("Synth (1)"));
  EXPECT_EQ(one.GetDestination(0).GetEntityAndEndpointName(), UString("Port 1 (1)"));
  EXPECT_EQ(one.GetSource(0).GetName(), UString("Synth"));
  Entity const two = setup.MakeEntity(device, "Port 2", 1, 1);
  EXPECT_EQ(one.GetSource(0).GetName(), UString("Synth Port 1"));
  setup.DeleteEntity(two);
  EXPECT_EQ(one.GetSource(0).GetName(), UString("Synth"));
}

// Hosts that list a device while one of its ports goes rely on the names of the others staying.
TEST_F(EndpointNameTest, ASiblingThatTakesItselfOutLeavesTheOthersNames) {
  Entity const entity = setup.MakeEntity(device, "Port 1", 0, 2);
  Destination const stays = entity.GetDestination(0);
  ASSERT_EQ(stays.GetName(), UString("Synth (1)"));
  setup.RemoveDestination(ImplOf(entity.GetDestination(1)));
  ASSERT_EQ(entity.CountDestinations(), 1);
  EXPECT_EQ(stays.GetName(), UString("Synth (1)"));
}

TEST_F(EndpointNameTest, ASiblingTakenOutByItsEntityRenewsTheOthersNames) {
  Entity const entity = setup.MakeEntity(device, "Port 1", 2, 2);
  Destination const stays = entity.GetDestination(0);
  Source const source = entity.GetSource(1);
  ASSERT_EQ(stays.GetName(), UString("Synth (1)"));
  ASSERT_EQ(source.GetName(), UString("Synth (2)"));
  Destination const goes = entity.GetDestination(1);
  ImplOf(entity)->RemoveDestination(ImplOf(goes));
  ImplOf(entity)->RemoveSource(ImplOf(entity.GetSource(0)));
  EXPECT_EQ(stays.GetName(), UString("Synth"));
  EXPECT_EQ(source.GetName(), UString("Synth"));
}

TEST_F(EndpointNameTest, AChangeRoundClearsTheFullNameOnly) {
  Destination const port = setup.MakePort("Old");
  EXPECT_EQ(port.GetName(), UString("Old"));
  EXPECT_EQ(port.GetEntityAndEndpointName(), UString("Old"));
  TestSetup::PeerOf(port).SetString("name", "New");  // past the endpoint's own SetName
  EXPECT_EQ(port.GetName(), UString("Old"));
  setup.PollSetupChanges();
  EXPECT_EQ(port.GetName(), UString("New"));
  EXPECT_EQ(port.GetEntityAndEndpointName(), UString("Old"));
}

TEST_F(EndpointNameTest, SortsWithoutRegardToCase) {
  Destination const a = setup.MakePort("alpha");
  Destination const b = setup.MakePort("BETA");
  EXPECT_TRUE(CompMIDIEndpointNames(a, b));
  EXPECT_FALSE(CompMIDIEndpointNames(b, a));
  EXPECT_FALSE(CompMIDIEndpointNames(a, setup.MakePort("ALPHA")));
}

}  // namespace
}  // namespace Ostinet::Testing

// SPDX-License-Identifier: MIT
#include <gtest/gtest.h>

#include "api/Link.h"
#include "ostinet/DeviceObject.h"
#include "ostinet/Endpoint.h"

namespace Ostinet::Testing {
namespace {

TEST(Declarations, OfObjectsAreComplete) {
  Link<Const<ModelInfo, bool, ModelInfo const&>>(&ModelInfo::operator==);

  Link<Mutable<Object, Object&, Object const&>>(&Object::operator=);
  Link<Const<Object, bool>>(&Object::Exists);
  Link<Const<Object, UString>>(&Object::GetName);
  Link<Const<Object, void*>>(&Object::GetImplPtr);
  Link<Const<Object, unsigned long long>>(&Object::GetKey);
  Link<Const<Object, bool, Object const&>>(&Object::operator==);
  Link<Const<Object, bool, Object const&>>(&Object::operator<);

  Link<Const<DeviceObject, bool>>(&DeviceObject::Exists);
  Link<Const<DeviceObject, bool>>(&DeviceObject::IsDirect);
  Link<Const<DeviceObject, bool>>(&DeviceObject::IsOnline);
  Link<Const<DeviceObject, UString>>(&DeviceObject::GetRawName);
  Link<Const<DeviceObject, void, UString const&>>(&DeviceObject::SetRawName);
  Link<Const<DeviceObject, UString>>(&DeviceObject::GetManufacturer);
  Link<Const<DeviceObject, void, UString const&>>(&DeviceObject::SetManufacturer);
  Link<Const<DeviceObject, UString>>(&DeviceObject::GetModel);
  Link<Const<DeviceObject, void, UString const&>>(&DeviceObject::SetModel);
  Link<Const<DeviceObject, char>>(&DeviceObject::GetSysexDeviceID);
  Link<Const<DeviceObject, void, char>>(&DeviceObject::SetSysexDeviceID);
  Link<Const<DeviceObject, int>>(&DeviceObject::GetAdvanceScheduleMicroseconds);
  Link<Const<DeviceObject, void, int>>(&DeviceObject::SetAdvanceScheduleMicroseconds);
  Link<Const<DeviceObject, unsigned short>>(&DeviceObject::ReceiveChannels);
  Link<Const<DeviceObject, void, unsigned short>>(&DeviceObject::SetReceiveChannels);
  Link<Const<DeviceObject, unsigned short>>(&DeviceObject::TransmitChannels);
  Link<Const<DeviceObject, void, unsigned short>>(&DeviceObject::SetTransmitChannels);
  Link<Const<DeviceObject, bool>>(&DeviceObject::IsADrumMachine);
  Link<Const<DeviceObject, void, bool>>(&DeviceObject::SetIsADrumMachine);
  Link<Const<DeviceObject, bool>>(&DeviceObject::IsAMixer);
  Link<Const<DeviceObject, void, bool>>(&DeviceObject::SetIsAMixer);
  Link<Const<DeviceObject, bool>>(&DeviceObject::IsASampler);
  Link<Const<DeviceObject, void, bool>>(&DeviceObject::SetIsASampler);
  Link<Const<DeviceObject, bool>>(&DeviceObject::IsAnEffectsUnit);
  Link<Const<DeviceObject, void, bool>>(&DeviceObject::SetIsAnEffectsUnit);
  Link<Const<DeviceObject, bool>>(&DeviceObject::ReceivesBankSelect0);
  Link<Const<DeviceObject, void, bool>>(&DeviceObject::SetReceivesBankSelect0);
  Link<Const<DeviceObject, bool>>(&DeviceObject::ReceivesBankSelect32);
  Link<Const<DeviceObject, void, bool>>(&DeviceObject::SetReceivesBankSelect32);
  Link<Const<DeviceObject, bool>>(&DeviceObject::ReceivesClock);
  Link<Const<DeviceObject, void, bool>>(&DeviceObject::SetReceivesClock);
  Link<Const<DeviceObject, bool>>(&DeviceObject::ReceivesMTC);
  Link<Const<DeviceObject, void, bool>>(&DeviceObject::SetReceivesMTC);
  Link<Const<DeviceObject, bool>>(&DeviceObject::ReceivesNotes);
  Link<Const<DeviceObject, void, bool>>(&DeviceObject::SetReceivesNotes);
  Link<Const<DeviceObject, bool>>(&DeviceObject::ReceivesProgramChange);
  Link<Const<DeviceObject, void, bool>>(&DeviceObject::SetReceivesProgramChange);
  Link<Const<DeviceObject, bool>>(&DeviceObject::TransmitsBankSelect0);
  Link<Const<DeviceObject, void, bool>>(&DeviceObject::SetTransmitsBankSelect0);
  Link<Const<DeviceObject, bool>>(&DeviceObject::TransmitsBankSelect32);
  Link<Const<DeviceObject, void, bool>>(&DeviceObject::SetTransmitsBankSelect32);
  Link<Const<DeviceObject, bool>>(&DeviceObject::TransmitsClock);
  Link<Const<DeviceObject, void, bool>>(&DeviceObject::SetTransmitsClock);
  Link<Const<DeviceObject, bool>>(&DeviceObject::TransmitsMTC);
  Link<Const<DeviceObject, void, bool>>(&DeviceObject::SetTransmitsMTC);
  Link<Const<DeviceObject, bool>>(&DeviceObject::TransmitsNotes);
  Link<Const<DeviceObject, void, bool>>(&DeviceObject::SetTransmitsNotes);
  Link<Const<DeviceObject, bool>>(&DeviceObject::TransmitsProgramChange);
  Link<Const<DeviceObject, void, bool>>(&DeviceObject::SetTransmitsProgramChange);
  Link<Const<DeviceObject, bool>>(&DeviceObject::SupportsGeneralMIDI);
  Link<Const<DeviceObject, void, bool>>(&DeviceObject::SetSupportsGeneralMIDI);
  Link<Const<DeviceObject, bool>>(&DeviceObject::SupportsMMC);
  Link<Const<DeviceObject, void, bool>>(&DeviceObject::SetSupportsMMC);
  Link<Const<DeviceObject, UString, int>>(&DeviceObject::GetChannelName);
  Link<Const<DeviceObject, void, int, UString const&>>(&DeviceObject::SetChannelName);
  Link<Const<DeviceObject, ModelInfo>>(&DeviceObject::GetModelInfo);
  Link<Const<DeviceObject, Properties::Implementation>>(&DeviceObject::GetImplementation);
  Link<Const<DeviceObject, void, XMLLib::Writer&>>(&DeviceObject::ExportToXML);
  Link<Const<DeviceObject, int>>(&DeviceObject::_get_impl_id);
  Link<Const<DeviceObject, void*, Properties::Implementation>>(&DeviceObject::_get_impl_obj_ref);
  Link<Const<DeviceObject, bool, void*>>(&DeviceObject::matches_impl_obj_ref);

  Link<Const<Device, int>>(&Device::CountEntities);
  Link<Const<Device, Entity, int>>(&Device::GetEntity);
  Link<Const<Device, Entity, Device::SpecialEntityType>>(&Device::GetSpecialEntity);
  Link<Const<Device, bool>>(&Device::IsOpenInMIDIMonitor);
  Link<Const<Device, void, bool>>(&Device::OpenInMIDIMonitor);

  Link<Const<Entity, int>>(&Entity::CountSources);
  Link<Const<Entity, Source, int>>(&Entity::GetSource);
  Link<Const<Entity, int>>(&Entity::CountDestinations);
  Link<Const<Entity, Destination, int>>(&Entity::GetDestination);
  Link<Const<Entity, Device>>(&Entity::GetDevice);
}

TEST(Declarations, OfPropertiesAreComplete) {
  Link<Const<Properties, Properties::Implementation>>(&Properties::GetImplementation);
  Link<Const<Properties, UString>>(&Properties::GetImplementationName);
  Link<Const<Properties, unsigned int>>(&Properties::GetImplementationVersion);
  Link<Const<Properties, bool>>(&Properties::ConfigUtilityExists);
  Link<Const<Properties, UString>>(&Properties::GetConfigUtilityName);
  Link<Const<Properties, Properties::RunConfigResult>>(&Properties::RunConfigUtility);
  EXPECT_EQ(Properties().GetImplementation(), Properties::Implementation(3));
}

static_assert(kIsImplicit<RCPtrMT<Impl::DeviceObjectImpl>, DeviceObject>, "");
static_assert(kIsImplicit<RCPtrMT<Impl::DeviceImpl>, Device>, "");
static_assert(kIsImplicit<RCPtrMT<Impl::EntityImpl>, Entity>, "");
static_assert(sizeof(Object) == kHandleSize, "");
static_assert(sizeof(DeviceObject) == kHandleSize, "");
static_assert(sizeof(Device) == kHandleSize, "");
static_assert(sizeof(Entity) == kHandleSize, "");
static_assert(Device::kObjectID == MatchObjectID(1), "");
static_assert(Entity::kObjectID == MatchObjectID(2), "");
static_assert(!std::is_default_constructible<Object>::value, "");
static_assert(sizeof(ModelInfo) == 7, "");
static_assert(std::has_virtual_destructor<Properties>::value, "");

/// Seven bytes, so that a host can tell whether it is all 0xFF.
TEST(Declarations, OfTheModelInfoOfANullHandleIsAllOnes) {
  EXPECT_TRUE(Device().GetModelInfo() == ModelInfo());
  EXPECT_EQ(ModelInfo().bytes[0], 0xFF);
  EXPECT_EQ(ModelInfo().bytes[6], 0xFF);
}

TEST(Declarations, HandlesOfAllClassesCompare) {
  Device const device;
  EXPECT_TRUE(device == Entity::kNoEntity);
  EXPECT_TRUE(Source() == Destination());
  EXPECT_FALSE(Device::kNoDevice != Source::kNoSource);
  EXPECT_FALSE(Source() < Destination());
  EXPECT_TRUE(Source() <= Destination());
  EXPECT_TRUE(Source() >= Destination());
  EXPECT_FALSE(Source() > Destination());
}

class OwnObject : public RCObjectMT<OwnObject> {
 public:
  explicit OwnObject(bool& isGone) : isGone_(isGone) {}
  ~OwnObject() override { isGone_ = true; }

 private:
  bool& isGone_;
};

TEST(Declarations, CountedPointersServeAHostsOwnObjects) {
  bool isGone = false;
  {
    RCPtrMT<OwnObject> pointer(new OwnObject(isGone));
    RCPtrMT<OwnObject const> const other(pointer);
    EXPECT_FALSE(other < RCPtrMT<OwnObject const>(pointer));
    EXPECT_TRUE(RCPtrMT<OwnObject>(pointer) == pointer);
    EXPECT_EQ(&*pointer, pointer.get());
    pointer = nullptr;
    EXPECT_TRUE(pointer != RCPtrMT<OwnObject>(const_cast<OwnObject*>(other.operator->())));
    EXPECT_FALSE(isGone);
  }
  EXPECT_TRUE(isGone);
}

// The classes behind the handles are known to hosts by name alone.
TEST(Declarations, CountedPointersServeTheLibrarysOwnObjects) {
  RCPtrMT<Impl::DeviceImpl> device;
  RCPtrMT<Impl::DeviceImpl> const other(device);
  device = other;
  device = nullptr;
  RCPtrMT<Impl::ObjectImpl> const object;
  RCPtrMT<Impl::DeviceObjectImpl> const deviceObject;
  RCPtrMT<Impl::EntityImpl> const entity;
  RCPtrMT<Impl::EndpointImpl> const endpoint;
  RCPtrMT<Impl::DestinationImpl> const destination;
  RCPtrMT<Impl::SysexImpl> const sysex;
  EXPECT_TRUE(device == other);
  EXPECT_FALSE(Device(device).Exists());
  EXPECT_FALSE(Entity(entity).Exists());
  EXPECT_FALSE(Source(endpoint).Exists());
  EXPECT_FALSE(Destination(destination).Exists());
  EXPECT_EQ(object.get(), nullptr);
  EXPECT_EQ(deviceObject.get(), nullptr);
  EXPECT_EQ(sysex.get(), nullptr);
}

}  // namespace
}  // namespace Ostinet::Testing

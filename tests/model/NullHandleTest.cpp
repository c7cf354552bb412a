// SPDX-License-Identifier: MIT
//
// Every operation of every handle class on a null handle.
#include <functional>
#include <ostream>

#include "support/StudioTest.h"

namespace Ostinet::Testing {
namespace {

struct NullCase {
  char const* name;
  std::function<bool()> holds;
};

void PrintTo(NullCase const& nullCase, std::ostream* out) { *out << nullCase.name; }

class NullHandle : public ::testing::TestWithParam<NullCase> {};

TEST_P(NullHandle, GivesTheDefinedValue) { EXPECT_TRUE(GetParam().holds()); }

bool DoesNothing() { return TestSetup::Get().pending.empty(); }

struct FlagOperations {
  bool (DeviceObject::*get)() const;
  void (DeviceObject::*set)(bool) const;
};

constexpr FlagOperations kFlags[] = {
    {&DeviceObject::IsADrumMachine, &DeviceObject::SetIsADrumMachine},
    {&DeviceObject::IsAMixer, &DeviceObject::SetIsAMixer},
    {&DeviceObject::IsASampler, &DeviceObject::SetIsASampler},
    {&DeviceObject::IsAnEffectsUnit, &DeviceObject::SetIsAnEffectsUnit},
    {&DeviceObject::ReceivesBankSelect0, &DeviceObject::SetReceivesBankSelect0},
    {&DeviceObject::ReceivesBankSelect32, &DeviceObject::SetReceivesBankSelect32},
    {&DeviceObject::ReceivesClock, &DeviceObject::SetReceivesClock},
    {&DeviceObject::ReceivesMTC, &DeviceObject::SetReceivesMTC},
    {&DeviceObject::ReceivesNotes, &DeviceObject::SetReceivesNotes},
    {&DeviceObject::ReceivesProgramChange, &DeviceObject::SetReceivesProgramChange},
    {&DeviceObject::TransmitsBankSelect0, &DeviceObject::SetTransmitsBankSelect0},
    {&DeviceObject::TransmitsBankSelect32, &DeviceObject::SetTransmitsBankSelect32},
    {&DeviceObject::TransmitsClock, &DeviceObject::SetTransmitsClock},
    {&DeviceObject::TransmitsMTC, &DeviceObject::SetTransmitsMTC},
    {&DeviceObject::TransmitsNotes, &DeviceObject::SetTransmitsNotes},
    {&DeviceObject::TransmitsProgramChange, &DeviceObject::SetTransmitsProgramChange},
    {&DeviceObject::SupportsGeneralMIDI, &DeviceObject::SetSupportsGeneralMIDI},
    {&DeviceObject::SupportsMMC, &DeviceObject::SetSupportsMMC},
};

bool FlagsAreFalse() {
  for (FlagOperations const& flag : kFlags) {
    (DeviceObject().*flag.set)(true);
    if ((DeviceObject().*flag.get)()) {
      return false;
    }
  }
  return true;
}

#define CASE(expression)                   \
  NullCase {                               \
#expression, [] { return expression; } \
  }
// For an operation that gives nothing: it returns, and tells nobody.
#define QUIET(statement) \
  NullCase {             \
#statement, [] { \
             statement; \
             return DoesNothing(); \
           }       \
  }

UString const kNone;

INSTANTIATE_TEST_SUITE_P(
    DeviceObject, NullHandle,
    ::testing::Values(
        CASE(FlagsAreFalse()), CASE(!DeviceObject().Exists()), CASE(!DeviceObject().IsDirect()),
        CASE(!DeviceObject().IsOnline()), CASE(DeviceObject().GetName() == kNone),
        CASE(DeviceObject().GetImplPtr() == nullptr), CASE(DeviceObject().GetKey() == 0),
        CASE(DeviceObject().GetRawName() == kNone), QUIET(DeviceObject().SetRawName("x")),
        CASE(DeviceObject().GetManufacturer() == kNone), QUIET(DeviceObject().SetManufacturer("x")),
        CASE(DeviceObject().GetModel() == kNone), QUIET(DeviceObject().SetModel("x")),
        CASE(static_cast<signed char>(DeviceObject().GetSysexDeviceID()) == -1),
        QUIET(DeviceObject().SetSysexDeviceID(3)),
        CASE(DeviceObject().GetAdvanceScheduleMicroseconds() == 0),
        QUIET(DeviceObject().SetAdvanceScheduleMicroseconds(3)),
        CASE(DeviceObject().ReceiveChannels() == 0), QUIET(DeviceObject().SetReceiveChannels(3)),
        CASE(DeviceObject().TransmitChannels() == 0), QUIET(DeviceObject().SetTransmitChannels(3)),
        CASE(DeviceObject().GetChannelName(0) == kNone),
        QUIET(DeviceObject().SetChannelName(0, "x")),
        CASE(DeviceObject().GetModelInfo() == ModelInfo()),
        CASE(DeviceObject().GetImplementation() == 0), CASE(DeviceObject()._get_impl_id() == 0),
        CASE(DeviceObject()._get_impl_obj_ref(Properties::kPlatformImplementation) == nullptr),
        CASE(!DeviceObject().matches_impl_obj_ref(nullptr))));

INSTANTIATE_TEST_SUITE_P(
    DeviceAndEntity, NullHandle,
    ::testing::Values(CASE(Device().CountEntities() == 0), CASE(!Device().GetEntity(0).Exists()),
                      CASE(Device().GetSpecialEntity(Device::kRealtimeEntity) == Entity()),
                      CASE(!Device().IsOpenInMIDIMonitor()),
                      QUIET(Device().OpenInMIDIMonitor(true)), CASE(Entity().CountSources() == 0),
                      CASE(Entity().GetSource(0) == Source()),
                      CASE(Entity().CountDestinations() == 0),
                      CASE(Entity().GetDestination(0) == Destination()),
                      CASE(Entity().GetDevice() == Device())));

INSTANTIATE_TEST_SUITE_P(
    Endpoint, NullHandle,
    ::testing::Values(CASE(Endpoint().GetUniqueID() == 0), CASE(Endpoint().GetEntity() == Entity()),
                      CASE(Endpoint().GetChannelName(0) == kNone),
                      CASE(Endpoint().GetChannels() == 0),
                      CASE(Endpoint().GetEntityAndEndpointName() == kNone),
                      CASE(Endpoint().GetSlotID() == SlotID()), CASE(!Endpoint().HasConnections()),
                      CASE(!Endpoint().IsDeviceCommon()),
                      CASE(!Endpoint().IsInterface().is_initialized()),
                      CASE(!Endpoint().IsInternalSoftware()), CASE(!Endpoint().IsLoop()),
                      CASE(!Endpoint().IsPrivate()), CASE(!Endpoint().IsSoftware()),
                      CASE(!Endpoint().IsVirtual()), CASE(!Endpoint().SupportsBankSelect0()),
                      CASE(!Endpoint().SupportsBankSelect32()), CASE(!Endpoint().SupportsClock()),
                      CASE(!Endpoint().SupportsMTC()), CASE(!Endpoint().SupportsNotes()),
                      CASE(!Endpoint().SupportsProgramChange()),
                      CASE(!CompMIDIEndpointNames(Endpoint(), Endpoint()))));

INSTANTIATE_TEST_SUITE_P(Source, NullHandle,
                         ::testing::Values(CASE(Source().GetDirectSource() == Source()),
                                           CASE(Source().GetMatchingVirtualDestination() ==
                                                Destination()),
                                           QUIET(Source().AddConnectedSource(Source())),
                                           QUIET(Source().RemoveConnectedSource(Source())),
                                           CASE(Source().CountConnectedSources() == 0),
                                           CASE(Source().GetConnectedSource(0) == Source()),
                                           CASE(Source().getDirectReceiver() == nullptr),
                                           CASE(!Source().hasDirectReceiver()),
                                           QUIET(Source().setDirectReceiver(nullptr))));

INSTANTIATE_TEST_SUITE_P(
    Destination, NullHandle,
    ::testing::Values(CASE(Destination().GetDirectDestination() == Destination()),
                      CASE(Destination().GetMatchingVirtualSource() == Source()),
                      CASE(!Destination().IsBroadcast()), CASE(!Destination().IsPregen()),
                      QUIET(Destination().AddConnectedDestination(Destination())),
                      QUIET(Destination().RemoveConnectedDestination(Destination())),
                      CASE(Destination().CountConnectedDestinations() == 0),
                      CASE(Destination().GetConnectedDestination(0) == Destination()),
                      CASE(Destination().MakeSender() == nullptr),
                      QUIET(Destination().SendOnePacket(DataPacket{nullptr, 0, kNoTimeStamp})),
                      QUIET(Destination().SendSysex(kNoTimeStamp, SysexRef())),
                      QUIET(Destination().FlushOutput()),
                      CASE(Destination().GetAdvanceScheduleTime() == 0.0)));

INSTANTIATE_TEST_SUITE_P(
    Setup, NullHandle,
    ::testing::Values(CASE(TestSetup::Get().CreateEntity(Device(), "x", 1, 1) == Entity()),
                      QUIET(TestSetup::Get().DeleteDevice(Device())),
                      QUIET(TestSetup::Get().DeleteEntity(Entity())),
                      QUIET(TestSetup::Get().SetEntitySources(Entity(), 1)),
                      QUIET(TestSetup::Get().SetEntityDestinations(Entity(), 1)),
                      QUIET(TestSetup::Get().DeleteVirtualEndpoint(Endpoint())),
                      QUIET(TestSetup::Get().DeleteBareEndpoint(Endpoint())),
                      CASE(TestSetup::Get().GetDevice(0) == Device()),
                      CASE(TestSetup::Get().GetDevice(-1) == Device()),
                      CASE(TestSetup::Get().GetEntity(0) == Entity()),
                      CASE(TestSetup::Get().GetSource(0) == Source()),
                      CASE(TestSetup::Get().GetDestination(0) == Destination()),
                      CASE(TestSetup::Get().GetPrivateSource(0) == Source()),
                      CASE(TestSetup::Get().GetPrivateDestination(0) == Destination())));

TEST(NullHandle, WritesNothingToXML) {
  MemoryPrefs prefs;
  FileSpecification const path(prefs.FolderPath() + "/null.xml");
  {
    XMLLib::Writer writer{File(path)};
    writer.StartElement("Root");
    DeviceObject().ExportToXML(writer);
    writer.Close();
  }
  XMLLib::Parser parser{File(path)};
  ASSERT_TRUE(parser.DownToChild("Root"));
  EXPECT_FALSE(parser.DownToChild());
}

}  // namespace
}  // namespace Ostinet::Testing

// SPDX-License-Identifier: MIT
#include <gtest/gtest.h>

#include "api/Link.h"
#include "ostinet/Setup.h"

namespace Ostinet::Testing {
namespace {

// GoogleTest has a Setup of its own, so this stands outside of a test.
void LinkSetup() {
  Link<Mutable<SetupListener, void>>(&SetupListener::SetupChanged);
  Link<Mutable<SetupListener, void, Destination, unsigned short>>(
      &SetupListener::CurrentPatchChanged);
  Link<Mutable<SetupListener, void, Destination, unsigned short>>(
      &SetupListener::DestinationNamesChanged);

  Link<Mutable<PrefsHandler, void, int, const std::vector<unsigned char>&>>(&PrefsHandler::Save);
  Link<Mutable<PrefsHandler, void, int, std::vector<unsigned char>&>>(&PrefsHandler::Load);
  Link<Mutable<PrefsHandler, void, Folder&>>(&PrefsHandler::GetFolder);

  Link<Mutable<OstinetCallbackAPI, double, unsigned long long>>(&OstinetCallbackAPI::GetSampleTime);
  Link<Mutable<OstinetCallbackAPI, Provider<Impl::WinMIDIDevicesListener>*>>(
      &OstinetCallbackAPI::GetDevicesProvider);

  Link<Mutable<Impl::WinMIDIDevicesListener, void>>(&Impl::WinMIDIDevicesListener::DevicesChanged);

  Link<Static<Setup&>>(&Setup::Instance);
  Link<Mutable<Setup, Setup::SignInResult, UString const&, Receiver*, PrefsHandler*>>(
      &Setup::SignIn);
  Link<Mutable<Setup, void, bool>>(&Setup::SignOut);
  Link<Const<Setup, UString const&>>(&Setup::SignInName);
  Link<Const<Setup, Receiver*>>(&Setup::GetReceiver);
  Link<Const<Setup, PrefsHandler*>>(&Setup::GetPrefsHandler);
  Link<Const<Setup, SetupListener*>>(&Setup::GetListener);
  Link<Mutable<Setup, void, SetupListener*>>(&Setup::SetListener);
  Link<Const<Setup, Properties const&>>(&Setup::GetProperties);
  Link<Mutable<Setup, void>>(&Setup::Poll);
  Link<Mutable<Setup, void>>(&Setup::PollSetupChanges);
  Link<Const<Setup, double>>(&Setup::PollInterval);
  Link<Const<Setup, double>>(&Setup::PollSetupChangesInterval);
  Link<Mutable<Setup, void>>(&Setup::Suspend);
  Link<Mutable<Setup, void>>(&Setup::Resume);
  Link<Mutable<Setup, void>>(&Setup::Panic);
  Link<Const<Setup, int>>(&Setup::CountDevices);
  Link<Const<Setup, Device, int>>(&Setup::GetDevice);
  Link<Const<Setup, int>>(&Setup::CountEntities);
  Link<Const<Setup, Entity, int>>(&Setup::GetEntity);
  Link<Const<Setup, int>>(&Setup::CountSources);
  Link<Const<Setup, Source, int>>(&Setup::GetSource);
  Link<Const<Setup, int>>(&Setup::CountDestinations);
  Link<Const<Setup, Destination, int>>(&Setup::GetDestination);
  Link<Const<Setup, int>>(&Setup::CountPrivateSources);
  Link<Const<Setup, Source, int>>(&Setup::GetPrivateSource);
  Link<Const<Setup, int>>(&Setup::CountPrivateDestinations);
  Link<Const<Setup, Destination, int>>(&Setup::GetPrivateDestination);
  Link<Mutable<Setup, Device, UString const&>>(&Setup::CreateDevice);
  static_assert(sizeof(Link<Mutable<Setup, Device, DeviceTypeInfo const&, UString const&>>(
                    &Setup::CreateDevice)) > 0,
                "");
  Link<Mutable<Setup, Device, XMLLib::Parser&>>(&Setup::CreateDevice);
  Link<Mutable<Setup, Entity, Device const&, UString const&, int, int>>(&Setup::CreateEntity);
  Link<Mutable<Setup, void, Device const&>>(&Setup::DeleteDevice);
  Link<Mutable<Setup, void, Entity const&>>(&Setup::DeleteEntity);
  Link<Mutable<Setup, void, Entity const&, int>>(&Setup::SetEntitySources);
  Link<Mutable<Setup, void, Entity const&, int>>(&Setup::SetEntityDestinations);
  static_assert(sizeof(Link<Mutable<Setup, void, Device const&, DeviceTypeInfo const&>>(
                    &Setup::ChangeDeviceType)) > 0,
                "");
  Link<Mutable<Setup, std::pair<Source, Destination>, UString const&, Setup::SrcOrDest,
               Setup::SrcOrDest>>(&Setup::CreateVirtualEndpoint);
  Link<Mutable<Setup, std::pair<Source, Destination>, MatchData const&, Setup::SrcOrDest,
               Setup::SrcOrDest>>(&Setup::CreateVirtualEndpoint);
  Link<Mutable<Setup, void, Endpoint const&>>(&Setup::DeleteVirtualEndpoint);
  Link<Mutable<Setup, void, Endpoint const&>>(&Setup::DeleteBareEndpoint);
  Link<Mutable<Setup, void>>(&Setup::SaveEditedDestBanks);
  static_assert(sizeof(Link<Mutable<Setup, Destination, SynapMidiPort*, bool>>(
                    &Setup::CreateSYNAPPluginDestination)) > 0,
                "");
  static_assert(sizeof(Link<Mutable<Setup, Impl::DestinationImpl*, Destination&>>(
                    &Setup::GetSynapPluginDestinationImpl)) > 0,
                "");
  static_assert(
      sizeof(Link<Mutable<Setup, void, Destination&>>(&Setup::DeleteSYNAPPluginDestination)) > 0,
      "");
  static_assert(sizeof(Link<Mutable<Setup, void, Destination&>>(
                    &Setup::UpdateNameSetsForSYNAPPluginDestination)) > 0,
                "");
  Link<Mutable<Setup, bool>>(&Setup::IsSignedIn);
  Link<Mutable<Setup, void>>(&Setup::ProcessInput);
  Link<Mutable<Setup, void, Impl::DeviceObjectImpl*, UString const&>>(&Setup::PropChanged);
}

TEST(Declarations, OfTheSetupAreComplete) { LinkSetup(); }

static_assert(std::has_virtual_destructor<SetupListener>::value, "");
static_assert(std::has_virtual_destructor<OstinetCallbackAPI>::value, "");
static_assert(std::is_same<decltype(OstinetCallbackAPI::gInstance), OstinetCallbackAPI*>::value,
              "");
static_assert(
    std::is_base_of<Dependent<Impl::WinMIDIDevicesListener>, Impl::WinMIDIDevicesListener>::value,
    "");
static_assert(Setup::kSignInAlreadySignedIn == 2 && Setup::kSignInPlatformError == 10, "");
static_assert(Setup::kSignInNoMasterClock == 12 && Setup::kSignInCoarseMasterClock == 13, "");

/// A backend without anything behind it, as a host may write one.
class EmptySetup : public Setup {
 public:
  bool IsSignedIn() override { return isSignedIn; }
  void ProcessInput() override {}
  void PropChanged(Impl::DeviceObjectImpl*, UString const&) override {}

  /// What the base class lends a backend.
  void LinkHelpers() {
    Link<Mutable<Setup, UString, UString const&>>(&EmptySetup::MakeUniqueDevName);
    Link<Const<Setup, bool, UString const&>>(&EmptySetup::HaveDeviceWithName);
    Link<Mutable<Setup, void, Impl::DeviceObjectImpl&>>(&EmptySetup::MaybeAssignUniqueID);
    Link<Const<Setup, bool, int>>(&EmptySetup::UniqueIDInUse);
    Link<Mutable<Setup, void, RCPtrMT<Impl::DeviceImpl>>>(&EmptySetup::RemoveDevice);
    Link<Mutable<Setup, void, RCPtrMT<Impl::EntityImpl>>>(&EmptySetup::RemoveEntity);
    Link<Mutable<Setup, void, RCPtrMT<Impl::EndpointImpl>>>(&EmptySetup::RemoveSource);
    Link<Mutable<Setup, void, RCPtrMT<Impl::DestinationImpl>>>(&EmptySetup::RemoveDestination);
    Link<Mutable<Setup, void>>(&EmptySetup::UpdateConnections);
    Link<Mutable<Setup, void, RCPtrMT<Impl::EndpointImpl> const&, Used<Impl::EndpointImpl>&>>(
        &EmptySetup::UpdateSourceConnections);
    Link<Mutable<Setup, void, RCPtrMT<Impl::DestinationImpl> const&, Used<Impl::DestinationImpl>&>>(
        &EmptySetup::UpdateDestConnections);
    Link<Mutable<Setup, void, XMLLib::Parser&, Impl::ImplImpl&, bool>>(
        &EmptySetup::HandleImportConnection);
  }
  void CallDefaults() {
    Setup::SaveDevices();
    Setup::PlatformPollImpl();
  }

  bool isSignedIn = false;

 protected:
  template <class Impl>
  using Used = sorted_vector_set<RCPtrMT<Impl>, std::less<RCPtrMT<Impl>>>;

  int PlatformSignIn(UString const&) override {
    isSignedIn = true;
    return kSignInOK;
  }
  void SaveDevices() override {}
  void PlatformSignOut() override { isSignedIn = false; }
  void PlatformLoadSetup() override {}
  bool PlatformPollSetupChanges(bool&) override { return false; }
  void PlatformPollImpl() override {}
  void PlatformPanic() override {}
  RCPtrMT<Impl::DeviceImpl> PlatformCreateDevice(XMLLib::Parser&) override { return nullptr; }
  RCPtrMT<Impl::DeviceImpl> PlatformCreateDevice(Impl::DeviceTypeInfoImpl*,
                                                 UString const&) override {
    return nullptr;
  }
  void PlatformWillDeleteDevice(RCPtrMT<Impl::DeviceImpl>&) override {}
  RCPtrMT<Impl::EntityImpl> PlatformCreateEntity(RCPtrMT<Impl::DeviceImpl>&, UString const&, int,
                                                 int) override {
    return nullptr;
  }
  void PlatformWillDeleteEntity(RCPtrMT<Impl::EntityImpl>&) override {}
  void PlatformSetEntitySources(RCPtrMT<Impl::EntityImpl>&, int) override {}
  void PlatformSetEntityDestinations(RCPtrMT<Impl::EntityImpl>&, int) override {}
  void PlatformWillDeleteBareEndpoint(RCPtrMT<Impl::EndpointImpl>&) override {}
  std::pair<RCPtrMT<Impl::EndpointImpl>, RCPtrMT<Impl::DestinationImpl>>
  PlatformCreateVirtualEndpoint(UString const&, int, SrcOrDest, SrcOrDest) override {
    return {};
  }
  void PlatformDeleteVirtualEndpoint(RCPtrMT<Impl::EndpointImpl>&,
                                     RCPtrMT<Impl::DestinationImpl>&) override {}
  void PlatformPluginDestinationsChanged() override {}
};

TEST(Declarations, AHostMayWriteABackendOfItsOwn) {
  EmptySetup setup;
  EXPECT_EQ(setup.SignIn(UString("Host"), nullptr, nullptr), Setup::kSignInOK);
  EXPECT_EQ(setup.CountDestinations(), 0);
  EXPECT_FALSE(setup.CreateDevice(UString("Synth")).Exists());
  setup.LinkHelpers();
  setup.CallDefaults();
  setup.SignOut(true);
  EXPECT_FALSE(setup.IsSignedIn());
}

/// A host's prefs handler and receiver need no destructor.
class Prefs : public PrefsHandler {
 public:
  void Save(int, std::vector<unsigned char> const&) override {}
  void Load(int, std::vector<unsigned char>&) override {}
  void GetFolder(Folder&) override {}
};
static_assert(!std::has_virtual_destructor<PrefsHandler>::value, "");
static_assert(!std::has_virtual_destructor<Receiver>::value, "");
static_assert(std::is_default_constructible<Prefs>::value, "");

}  // namespace
}  // namespace Ostinet::Testing

// SPDX-License-Identifier: MIT
#pragma once

#include <functional>
#include <map>
#include <string>
#include <vector>

#include "model/DestinationImpl.h"
#include "model/DeviceImpl.h"
#include "model/EntityImpl.h"
#include "model/Handles.h"
#include "model/NameFileStore.h"
#include "model/Studio.h"
#include "support/TestPeer.h"

namespace Ostinet::Testing {

/// A backend without a platform, for the model's own tests: it makes whatever is asked for, also
/// what the real backend never has, as direct devices with entities. It is the process's Setup.
class TestSetup : public Setup {
 public:
  static TestSetup& Get();

  /// Back to the state after construction.
  void Reset();

  // Builders. Each object joins the lists of the studio and gets a unique ID.
  Device MakeDevice(UString const& name, bool isDirect = false);
  Entity MakeEntity(Device const& device, UString const& name, int sources, int destinations);
  Source MakeSourceIn(Entity const& entity);
  Destination MakeDestinationIn(Entity const& entity);
  Source MakeSource(UString const& name, Impl::EndpointKind const& kind);
  Destination MakeDestination(UString const& name, Impl::EndpointKind const& kind);
  /// A bare port, direct and online.
  Source MakeSourcePort(UString const& name) {
    return MakeSource(name, Impl::EndpointKind::Bare(true, false));
  }
  Destination MakePort(UString const& name) {
    return MakeDestination(name, Impl::EndpointKind::Bare(true, false));
  }
  /// An instrument of one destination, hanging nowhere.
  Destination MakeInstrument(UString const& name);
  Source MakeSourceInstrument(UString const& name);

  static TestPeer& PeerOf(DeviceObject const& object);
  static void SetInt(DeviceObject const& object, char const* key, int value);
  static std::vector<int> GetIntList(DeviceObject const& object, char const* key);

  // Setup's insides.
  using Setup::GetNameFileStore;
  using Setup::GetStudio;
  using Setup::HandleImportConnection;
  using Setup::HaveDeviceWithName;
  using Setup::MakeUniqueDevName;
  using Setup::MaybeAssignUniqueID;
  using Setup::RemoveDestination;
  using Setup::RemoveDevice;
  using Setup::RemoveEntity;
  using Setup::RemoveSource;
  using Setup::UniqueIDInUse;
  using Setup::UpdateConnections;
  using Setup::UpdateDestConnections;
  using Setup::UpdateSourceConnections;

  // What the hooks do beyond recording their names in `calls`.
  int signInResult = 0;
  std::function<void()> onLoad;
  std::function<void()> onSaveDevices;
  bool changed = false;  // the next round of changes tells the host
  std::vector<std::string> calls;
  std::map<RCPtrMT<Impl::DeviceObjectImpl>, Impl::PropertyKeys> pending;

  bool IsSignedIn() override { return isSignedIn_; }
  void ProcessInput() override {}
  void PropChanged(Impl::DeviceObjectImpl* object, UString const& key) override;

 protected:
  int PlatformSignIn(UString const& name) override;
  void SaveDevices() override;
  void PlatformSignOut() override;
  void PlatformLoadSetup() override;
  bool PlatformPollSetupChanges(bool& connectionsChanged) override;
  void PlatformPollImpl() override { calls.push_back("PollImpl"); }
  void PlatformPanic() override { calls.push_back("Panic"); }
  RCPtrMT<Impl::DeviceImpl> PlatformCreateDevice(XMLLib::Parser&) override;
  RCPtrMT<Impl::DeviceImpl> PlatformCreateDevice(Impl::DeviceTypeInfoImpl*,
                                                 UString const& name) override;
  void PlatformWillDeleteDevice(RCPtrMT<Impl::DeviceImpl>&) override;
  RCPtrMT<Impl::EntityImpl> PlatformCreateEntity(RCPtrMT<Impl::DeviceImpl>&, UString const& name,
                                                 int sources, int destinations) override;
  void PlatformWillDeleteEntity(RCPtrMT<Impl::EntityImpl>&) override;
  void PlatformSetEntitySources(RCPtrMT<Impl::EntityImpl>&, int count) override;
  void PlatformSetEntityDestinations(RCPtrMT<Impl::EntityImpl>&, int count) override;
  void PlatformWillDeleteBareEndpoint(RCPtrMT<Impl::EndpointImpl>&) override;
  std::pair<RCPtrMT<Impl::EndpointImpl>, RCPtrMT<Impl::DestinationImpl>>
  PlatformCreateVirtualEndpoint(UString const& name, int uniqueID, SrcOrDest source,
                                SrcOrDest destination) override;
  void PlatformDeleteVirtualEndpoint(RCPtrMT<Impl::EndpointImpl>&,
                                     RCPtrMT<Impl::DestinationImpl>&) override;
  void PlatformPluginDestinationsChanged() override { changed = true; }

 private:
  bool isSignedIn_ = false;
};

}  // namespace Ostinet::Testing

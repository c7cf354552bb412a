// SPDX-License-Identifier: MIT
#pragma once

#include <memory>
#include <optional>
#include <unordered_set>

#include "core/JobThread.h"
#include "core/Mutex.h"
#include "model/DeviceObjectImpl.h"
#include "model/Studio.h"
#include "ostinet/Setup.h"
#include "platform/PendingChanges.h"
#include "platform/PortList.h"
#include "platform/Session.h"

namespace Ostinet::Impl {

/// The one concrete Setup. It finds the ports of the system, attaches them to the direct endpoints
/// of the model, and keeps the model right while ports come and go.
///
/// Threads  The host's polling thread owns all of it. The job thread lists ports and touches no
///          object of the model; its answer comes back through a future. DevicesChanged may come
///          on any thread, which is why the session and the future have a lock of their own.
class WinMIDISetup : public Setup, public WinMIDIDevicesListener {
 public:
  WinMIDISetup();
  ~WinMIDISetup() override;

  // For the port classes and the steps of reconciliation.
  void MarkChanged() { setupChanged_ = true; }
  Studio& Lists() { return GetStudio(); }
  void AssignUniqueID(DeviceObjectImpl& object) { MaybeAssignUniqueID(object); }
  void ImportConnection(XMLLib::Parser& parser, ImplImpl& peer, bool isSource) {
    HandleImportConnection(parser, peer, isSource);
  }
  /// Puts a source on the list that ProcessInput walks, once.
  void AddActiveSource(RCPtrMT<EndpointImpl> const& source);

  /// Whether a list of ports waits for the next PollSetupChanges. [any thread]
  bool HasListedPorts() const;

  bool IsSignedIn() override;
  void ProcessInput() override;
  void PropChanged(DeviceObjectImpl* object, UString const& key) override;
  void DevicesChanged() override;

 protected:
  int PlatformSignIn(UString const& name) override;
  void SaveDevices() override;
  void PlatformSignOut() override;
  void PlatformLoadSetup() override;
  bool PlatformPollSetupChanges(bool& connectionsChanged) override;
  void PlatformPollImpl() override;
  void PlatformPanic() override {}
  RCPtrMT<DeviceImpl> PlatformCreateDevice(XMLLib::Parser& parser) override;
  RCPtrMT<DeviceImpl> PlatformCreateDevice(DeviceTypeInfoImpl* type, UString const& name) override;
  void PlatformWillDeleteDevice(RCPtrMT<DeviceImpl>&) override {}
  RCPtrMT<EntityImpl> PlatformCreateEntity(RCPtrMT<DeviceImpl>& device, UString const& name,
                                           int sources, int destinations) override;
  void PlatformWillDeleteEntity(RCPtrMT<EntityImpl>&) override {}
  void PlatformSetEntitySources(RCPtrMT<EntityImpl>& entity, int count) override;
  void PlatformSetEntityDestinations(RCPtrMT<EntityImpl>& entity, int count) override;
  void PlatformWillDeleteBareEndpoint(RCPtrMT<EndpointImpl>&) override {}
  std::pair<RCPtrMT<EndpointImpl>, RCPtrMT<DestinationImpl>> PlatformCreateVirtualEndpoint(
      UString const& name, int uniqueID, SrcOrDest source, SrcOrDest destination) override;
  void PlatformDeleteVirtualEndpoint(RCPtrMT<EndpointImpl>& source,
                                     RCPtrMT<DestinationImpl>& destination) override;
  void PlatformPluginDestinationsChanged() override { MarkChanged(); }

 private:
  using Sources = std::vector<RCPtrMT<EndpointImpl>>;

  std::shared_ptr<Session> GetSession() const;
  void StartSession();
  void StopSession();
  void MarkOfflinePorts();
  void DrainPorts();
  void DrainVirtualSources();
  Sources CopyForDrain(Sources const& sources);
  void GiveBackCopy(Sources copy);
  std::optional<PortList> CollectPorts();
  /// Hands the collected keys to their objects. True if an object in the studio changed.
  bool HandlePendingChanges(bool& connectionsChanged);
  void DropRemovedSources();
  /// The public end takes the wanted ID if it is free.
  void NameVirtualEnd(EndpointImpl& end, UString const& name, int wantedID, bool isPublic);

  mutable VantorCoreMutex sessionMutex_;
  std::shared_ptr<Session> session_ OSTINET_GUARDED_BY(sessionMutex_);
  std::shared_ptr<VantorFuture<PortList>> pollFuture_ OSTINET_GUARDED_BY(sessionMutex_);

  VantorCoreMutex virtualSourcesMutex_;
  Sources virtualSources_ OSTINET_GUARDED_BY(virtualSourcesMutex_);

  Sources activeSources_;                                    // in the order in which they came
  std::unordered_set<EndpointImpl const*> inActiveSources_;  // the same
  Sources roomForCopy_;
  PendingChanges pendingChanges_;
  bool setupChanged_ = false;
  bool isLoaded_ = false;  // in this signed-in period
  std::shared_ptr<VantorJobThread> pollThread_;
};

}  // namespace Ostinet::Impl

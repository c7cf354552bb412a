// SPDX-License-Identifier: MIT
#pragma once

#include <utility>
#include <vector>

#include "ostinet/Common.h"
#include "ostinet/DeviceObject.h"
#include "ostinet/DeviceTypeCatalog.h"
#include "ostinet/Endpoint.h"
#include "ostinet/MatchData.h"
#include "ostinet/core/Files.h"
#include "ostinet/core/Noncopyable.h"
#include "ostinet/core/Provider.h"
#include "ostinet/core/SortedVector.h"
#include "ostinet/core/XML.h"

class SynapMidiPort;
namespace Ostinet {
class SetupListener {
 public:
  virtual ~SetupListener();
  virtual void SetupChanged() = 0;
  virtual void CurrentPatchChanged(Destination, unsigned short channels) = 0;
  virtual void DestinationNamesChanged(Destination, unsigned short channels) = 0;
};
class PrefsHandler {
 public:
  virtual void Save(int id, const std::vector<unsigned char>& bytes) = 0;
  virtual void Load(int id, std::vector<unsigned char>& bytes) = 0;
  virtual void GetFolder(Folder& out) = 0;

 protected:
  ~PrefsHandler() {}
};
class OstinetCallbackAPI {
 public:
  static OstinetCallbackAPI* gInstance;
  virtual ~OstinetCallbackAPI();
  virtual double GetSampleTime(unsigned long long hostClocks) = 0;
  virtual Provider<Impl::WinMIDIDevicesListener>* GetDevicesProvider() = 0;
};
namespace Impl {
class WinMIDIDevicesListener : public Dependent<WinMIDIDevicesListener> {
 public:
  virtual ~WinMIDIDevicesListener();
  virtual void DevicesChanged() = 0;
};
}  // namespace Impl
class WithSetupChangesCompleteAndDeferred {
 public:
  WithSetupChangesCompleteAndDeferred();
  ~WithSetupChangesCompleteAndDeferred();
};
class Setup {
 public:
  enum SignInResult : int {
    kSignInOK = 0,
    kSignInAlreadySignedIn = 2,
    kSignInPlatformError = 10,
    kSignInNoMasterClock = 12,
    kSignInCoarseMasterClock = 13
  };
  /// Which end of a virtual pair hosts see in the public lists; the other end is private.
  enum SrcOrDest : int { kSourceEnd = 0, kDestinationEnd = 1, kNeitherEnd = 2 };
  static Setup& Instance();
  SignInResult SignIn(UString const& name, Receiver*, PrefsHandler*);
  void SignOut(bool save);
  UString const& SignInName() const;
  Receiver* GetReceiver() const;
  PrefsHandler* GetPrefsHandler() const;
  SetupListener* GetListener() const;
  void SetListener(SetupListener*);
  Properties const& GetProperties() const;
  void Poll();
  void PollSetupChanges();
  double PollInterval() const;
  double PollSetupChangesInterval() const;
  void Suspend();
  void Resume();
  void Panic();
  int CountDevices() const;
  Device GetDevice(int) const;
  int CountEntities() const;
  Entity GetEntity(int) const;
  int CountSources() const;
  Source GetSource(int) const;
  int CountDestinations() const;
  Destination GetDestination(int) const;
  int CountPrivateSources() const;
  Source GetPrivateSource(int) const;
  int CountPrivateDestinations() const;
  Destination GetPrivateDestination(int) const;
  Device CreateDevice(UString const& name);
  Device CreateDevice(DeviceTypeInfo const&, UString const& name);
  Device CreateDevice(XMLLib::Parser&);
  Entity CreateEntity(Device const&, UString const& name, int sources, int destinations);
  void DeleteDevice(Device const&);
  void DeleteEntity(Entity const&);
  void SetEntitySources(Entity const&, int);
  void SetEntityDestinations(Entity const&, int);
  void ChangeDeviceType(Device const&, DeviceTypeInfo const&);
  std::pair<Source, Destination> CreateVirtualEndpoint(UString const& name, SrcOrDest, SrcOrDest);
  std::pair<Source, Destination> CreateVirtualEndpoint(MatchData const&, SrcOrDest, SrcOrDest);
  void DeleteVirtualEndpoint(Endpoint const&);
  void DeleteBareEndpoint(Endpoint const&);
  void SaveEditedDestBanks();
  Destination CreateSYNAPPluginDestination(SynapMidiPort*, bool isPrivate);
  Impl::DestinationImpl* GetSynapPluginDestinationImpl(Destination&);
  void DeleteSYNAPPluginDestination(Destination&);
  void UpdateNameSetsForSYNAPPluginDestination(Destination&);

  virtual bool IsSignedIn() = 0;
  virtual void ProcessInput() = 0;
  virtual void PropChanged(Impl::DeviceObjectImpl* object, UString const& key) = 0;

 protected:
  Setup();
  virtual ~Setup();
  virtual int PlatformSignIn(UString const& name) = 0;
  virtual void SaveDevices();
  virtual void PlatformSignOut() = 0;
  virtual void PlatformLoadSetup() = 0;
  virtual bool PlatformPollSetupChanges(bool& connectionsChanged) = 0;
  virtual void PlatformPollImpl();
  virtual void PlatformPanic() = 0;
  virtual RCPtrMT<Impl::DeviceImpl> PlatformCreateDevice(XMLLib::Parser&) = 0;
  virtual RCPtrMT<Impl::DeviceImpl> PlatformCreateDevice(Impl::DeviceTypeInfoImpl*,
                                                         UString const& name) = 0;
  virtual void PlatformWillDeleteDevice(RCPtrMT<Impl::DeviceImpl>&) = 0;
  virtual RCPtrMT<Impl::EntityImpl> PlatformCreateEntity(RCPtrMT<Impl::DeviceImpl>&,
                                                         UString const& name, int sources,
                                                         int destinations) = 0;
  virtual void PlatformWillDeleteEntity(RCPtrMT<Impl::EntityImpl>&) = 0;
  virtual void PlatformSetEntitySources(RCPtrMT<Impl::EntityImpl>&, int count) = 0;
  virtual void PlatformSetEntityDestinations(RCPtrMT<Impl::EntityImpl>&, int count) = 0;
  virtual void PlatformWillDeleteBareEndpoint(RCPtrMT<Impl::EndpointImpl>&) = 0;
  virtual std::pair<RCPtrMT<Impl::EndpointImpl>, RCPtrMT<Impl::DestinationImpl> >
  PlatformCreateVirtualEndpoint(UString const& name, int uniqueID, SrcOrDest source,
                                SrcOrDest destination) = 0;
  virtual void PlatformDeleteVirtualEndpoint(RCPtrMT<Impl::EndpointImpl>&,
                                             RCPtrMT<Impl::DestinationImpl>&) = 0;
  virtual void PlatformPluginDestinationsChanged() = 0;

  UString MakeUniqueDevName(UString const&);
  bool HaveDeviceWithName(UString const&) const;
  void MaybeAssignUniqueID(Impl::DeviceObjectImpl&);
  bool UniqueIDInUse(int) const;
  void RemoveDevice(RCPtrMT<Impl::DeviceImpl>);
  void RemoveEntity(RCPtrMT<Impl::EntityImpl>);
  void RemoveSource(RCPtrMT<Impl::EndpointImpl>);
  void RemoveDestination(RCPtrMT<Impl::DestinationImpl>);
  void UpdateConnections();
  void UpdateSourceConnections(RCPtrMT<Impl::EndpointImpl> const&,
                               sorted_vector_set<RCPtrMT<Impl::EndpointImpl>,
                                                 std::less<RCPtrMT<Impl::EndpointImpl> > >& used);
  void UpdateDestConnections(RCPtrMT<Impl::DestinationImpl> const&,
                             sorted_vector_set<RCPtrMT<Impl::DestinationImpl>,
                                               std::less<RCPtrMT<Impl::DestinationImpl> > >& used);
  void HandleImportConnection(XMLLib::Parser&, Impl::ImplImpl&, bool isSource);
};
}  // namespace Ostinet

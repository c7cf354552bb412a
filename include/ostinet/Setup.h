// SPDX-License-Identifier: MIT
#pragma once

#include <memory>
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

namespace Impl {
struct Studio;
class NameFileStore;
}  // namespace Impl

/// What the host hears of the studio.
///
/// Ownership    The host's; set it with Setup::SetListener and take it away before it goes.
/// Threads      The host's polling thread, within Setup::Poll, PollSetupChanges and SignIn.
class OSTINET_EXPORT SetupListener {
 public:
  virtual ~SetupListener();
  /// Devices, ports or connections changed: show them anew, drop senders.
  virtual void SetupChanged() = 0;
  /// A patch change went out to `destination` on `channels`; bit n is channel n of 0 to 15.
  virtual void CurrentPatchChanged(Destination destination, unsigned short channels) = 0;
  /// What the patches, notes or controls of `destination` are called changed; all bits are set.
  virtual void DestinationNamesChanged(Destination destination, unsigned short channels) = 0;
};

/// Where the host keeps settings for the library.
///
/// Ownership    The host's; it outlives the session.
/// Threads      The host's polling thread, within SignIn and SignOut and the operations on names.
class OSTINET_EXPORT PrefsHandler {
 public:
  /// Stores a block under a small number.
  virtual void Save(int id, const std::vector<unsigned char>& bytes) = 0;
  /// Fetches that block; leaves `bytes` empty if there is none.
  virtual void Load(int id, std::vector<unsigned char>& bytes) = 0;
  /// Names the folder of the host's settings, in which the studio is kept.
  virtual void GetFolder(Folder& out) = 0;

 protected:
  ~PrefsHandler() {}
};

/// What the library asks of the application as a whole.
///
/// Ownership    The host's, for the life of the process.
class OSTINET_EXPORT OstinetCallbackAPI {
 public:
  /// To be set before the first call of Setup::Instance.
  static OstinetCallbackAPI* gInstance;

  virtual ~OstinetCallbackAPI();
  /// The sample position of a time in the host's clocks of 100 ns. [any thread]
  virtual double GetSampleTime(unsigned long long hostClocks) = 0;
  /// Tells of devices that come and go; asked once.
  virtual Provider<Impl::WinMIDIDevicesListener>* GetDevicesProvider() = 0;
};

namespace Impl {

/// Hears that the system's devices changed.
class OSTINET_EXPORT WinMIDIDevicesListener : public Dependent<WinMIDIDevicesListener> {
 public:
  virtual ~WinMIDIDevicesListener();
  /// [any thread]
  virtual void DevicesChanged() = 0;
};

}  // namespace Impl

/// Holds the studio still for a scope: brings it up to date first, then keeps PollSetupChanges
/// from changing it. The scopes are not counted: the first to end lets the studio go.
///
/// Threads      The host's polling thread.
class OSTINET_EXPORT WithSetupChangesCompleteAndDeferred {
 public:
  WithSetupChangesCompleteAndDeferred();
  ~WithSetupChangesCompleteAndDeferred();
  WithSetupChangesCompleteAndDeferred(WithSetupChangesCompleteAndDeferred const&) = delete;
  WithSetupChangesCompleteAndDeferred& operator=(WithSetupChangesCompleteAndDeferred const&) =
      delete;
};

/// The MIDI studio: what there is, and the sign-in that brings it to life.
///
/// The host signs in, sets a listener, and from then on calls Poll and PollSetupChanges at the
/// rates that this class names, and ProcessInput as often as it wants input. The library starts
/// no timer for the host and changes nothing outside these calls and the editing operations.
///
/// Ownership    One object, made by the first call of Instance, gone at the end of the process.
///              It owns the studio; listener, receiver and prefs handler stay the host's.
/// Threads      The host's polling thread, for every operation.
/// Errors       What the host's own objects throw travels on. Operations on null or dead handles
///              do nothing and give null handles.
class OSTINET_EXPORT Setup : private Noncopyable<Setup> {
 public:
  enum SignInResult : int {
    kSignInOK = 0,
    kSignInAlreadySignedIn = 2,    ///< nothing was changed
    kSignInPlatformError = 10,     ///< the MIDI system did not start; sign-in can be tried anew
    kSignInNoMasterClock = 12,     ///< no clock to stamp with; signed in, but with no lists
    kSignInCoarseMasterClock = 13  ///< a clock coarser than 1 ms; signed in, but with no lists
  };
  /// Which end of a virtual pair hosts see in the public lists; the other end is private.
  enum SrcOrDest : int { kSourceEnd = 0, kDestinationEnd = 1, kNeitherEnd = 2 };

  static Setup& Instance();

  /// Starts the session under `name`. `receiver` takes the input; `prefs` may be null, then
  /// nothing is kept from one session to the next. On success the lists are filled and the
  /// listener hears SetupChanged.
  SignInResult SignIn(UString const& name, Receiver* receiver, PrefsHandler* prefs);
  /// Ends the session and empties the lists, after saving the studio if `save` is true. Harmless
  /// while signed out.
  void SignOut(bool save);
  /// As given to the last SignIn, also after sign-out.
  UString const& SignInName() const;
  /// Null while signed out.
  Receiver* GetReceiver() const;
  PrefsHandler* GetPrefsHandler() const;
  SetupListener* GetListener() const;
  /// At any time; null silences the notifications.
  void SetListener(SetupListener* listener);
  Properties const& GetProperties() const;

  /// The small round: tells of patch changes, calibrates the time line.
  void Poll();
  /// The large round: brings the studio up to date and tells of it. Does nothing while a
  /// WithSetupChangesCompleteAndDeferred holds the studio.
  void PollSetupChanges();
  /// Seconds from one Poll to the next: 1.0.
  double PollInterval() const;
  /// Seconds from one PollSetupChanges to the next: 2.0.
  double PollSetupChangesInterval() const;
  /// Both do nothing with this backend: ports stay open while the host is in the background.
  void Suspend();
  void Resume();
  /// Silences everything: All Sound Off and sustain up, on each channel of each public port that
  /// is online.
  void Panic();

  /// The lists, each in order of creation. An index out of range gives a null handle.
  int CountDevices() const;
  Device GetDevice(int index) const;
  int CountEntities() const;
  Entity GetEntity(int index) const;
  int CountSources() const;
  Source GetSource(int index) const;
  int CountDestinations() const;
  Destination GetDestination(int index) const;
  int CountPrivateSources() const;
  Source GetPrivateSource(int index) const;
  int CountPrivateDestinations() const;
  Destination GetPrivateDestination(int index) const;

  /// Makes a device; if the name is taken, a number is added, "Synth 2".
  Device CreateDevice(UString const& name);
  /// The same with the properties and ports of a device type.
  Device CreateDevice(DeviceTypeInfo const& type, UString const& name);
  /// Imports a device; `parser` stands on its "Device" element.
  Device CreateDevice(XMLLib::Parser& parser);
  /// Makes an entity in a device that is not direct. Negative counts are taken for 0.
  Entity CreateEntity(Device const& device, UString const& name, int sources, int destinations);
  /// Deletes a device with all its parts, unless it is direct and online.
  void DeleteDevice(Device const& device);
  /// Deletes an entity that is not direct, with its endpoints.
  void DeleteEntity(Entity const& entity);
  /// Makes or deletes endpoints, the last first, until an entity that is not direct has `count`.
  /// A negative count is taken for 0.
  void SetEntitySources(Entity const& entity, int count);
  void SetEntityDestinations(Entity const& entity, int count);
  /// Gives a device that is not direct the properties and ports of a type.
  void ChangeDeviceType(Device const& device, DeviceTypeInfo const& type);
  /// Makes a pair of ends that are tied together: what is sent to the destination comes out of
  /// the source. The values tell which end is public.
  std::pair<Source, Destination> CreateVirtualEndpoint(UString const& name, SrcOrDest source,
                                                       SrcOrDest destination);
  /// The same with name and unique ID of a reference to an endpoint; two null handles for any
  /// other reference.
  std::pair<Source, Destination> CreateVirtualEndpoint(MatchData const& reference, SrcOrDest source,
                                                       SrcOrDest destination);
  /// Deletes both ends of a virtual pair.
  void DeleteVirtualEndpoint(Endpoint const& endpoint);
  /// Forgets a port that is not there any more.
  void DeleteBareEndpoint(Endpoint const& endpoint);
  /// Writes the edited names of all destinations. Throws a VantorError if the host has no folder
  /// or the disk refuses; the edits stay then. Once a minute, and at sign-out, the library does it
  /// by itself, and tries again later where it cannot.
  void SaveEditedDestBanks();

  /// Destinations of the host's plug-in engine.
  Destination CreateSYNAPPluginDestination(SynapMidiPort* port, bool isPrivate);
  Impl::DestinationImpl* GetSynapPluginDestinationImpl(Destination& destination);
  void DeleteSYNAPPluginDestination(Destination& destination);
  void UpdateNameSetsForSYNAPPluginDestination(Destination& destination);

  virtual bool IsSignedIn() = 0;
  /// Hands what came in since the last call to the receiver.
  virtual void ProcessInput() = 0;
  /// Notes that a property of an object in the studio changed, for the next PollSetupChanges.
  virtual void PropChanged(Impl::DeviceObjectImpl* object, UString const& key) = 0;

 protected:
  Setup();
  virtual ~Setup();

  // What a backend fills in. Each hook that makes an object puts it in the lists.

  /// Starts the backend; a SignInResult.
  virtual int PlatformSignIn(UString const& name) = 0;
  /// Writes the studio to the host's folder. Here: nothing.
  virtual void SaveDevices();
  /// Stops the backend; the last step of sign-out.
  virtual void PlatformSignOut() = 0;
  /// Fills the lists at sign-in.
  virtual void PlatformLoadSetup() = 0;
  /// Applies what happened since the last round: true if the host must hear of it. Sets its
  /// argument if connections must be worked out anew.
  virtual bool PlatformPollSetupChanges(bool& connectionsChanged) = 0;
  /// The backend's part of Poll, its last step. Here: nothing.
  virtual void PlatformPollImpl();
  /// The backend's part of Panic, its first step.
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

  /// `name`, or with the first number from 2 on that makes it unlike every device's.
  UString MakeUniqueDevName(UString const& name);
  /// Case and white space do not tell names apart.
  bool HaveDeviceWithName(UString const& name) const;
  /// Draws an ID for an object that neither has nor inherits one.
  void MaybeAssignUniqueID(Impl::DeviceObjectImpl& object);
  bool UniqueIDInUse(int id) const;

  /// Takes an object, with its parts, out of the lists and out of the studio. Null is ignored.
  void RemoveDevice(RCPtrMT<Impl::DeviceImpl> device);
  void RemoveEntity(RCPtrMT<Impl::EntityImpl> entity);
  void RemoveSource(RCPtrMT<Impl::EndpointImpl> source);
  void RemoveDestination(RCPtrMT<Impl::DestinationImpl> destination);

  /// Ties endpoints to ports as their properties say.
  void UpdateConnections();
  /// The same for one port. What `used` holds is taken; what is tied joins it.
  void UpdateSourceConnections(RCPtrMT<Impl::EndpointImpl> const& source,
                               sorted_vector_set<RCPtrMT<Impl::EndpointImpl>,
                                                 std::less<RCPtrMT<Impl::EndpointImpl> > >& used);
  void UpdateDestConnections(RCPtrMT<Impl::DestinationImpl> const& destination,
                             sorted_vector_set<RCPtrMT<Impl::DestinationImpl>,
                                               std::less<RCPtrMT<Impl::DestinationImpl> > >& used);
  /// Stores the connection that an imported endpoint's "Connection" element asks for, if the port
  /// is there. `parser` stands on that element, `peer` holds the endpoint's properties.
  void HandleImportConnection(XMLLib::Parser& parser, Impl::ImplImpl& peer, bool isSource);

  /// The six lists.
  Impl::Studio& GetStudio();
  Impl::Studio const& GetStudio() const;
  /// The written name documents in use; null while signed out.
  Impl::NameFileStore* GetNameFileStore() const;

 private:
  friend class WithSetupChangesCompleteAndDeferred;
  friend class Impl::DestinationImpl;

  void LoadNamesCatalog();
  void SaveNamesCatalog();
  void TrySavingEditedBanks();

  struct State;
  std::unique_ptr<State> const state_;
};

}  // namespace Ostinet

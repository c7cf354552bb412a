// SPDX-License-Identifier: MIT
#pragma once

#include <boost/operators.hpp>

#include "ostinet/Common.h"
#include "ostinet/MatchData.h"
#include "ostinet/core/XML.h"

namespace Ostinet {

/// The sysex identity of a device: three bytes of manufacturer, two of family, two of member.
/// 0xFF in all seven means that none is known.
struct OSTINET_EXPORT ModelInfo {
  unsigned char bytes[7];

  /// All 0xFF.
  ModelInfo();
  bool operator==(ModelInfo const& other) const;
};

/// What every handle is: a small value that names one thing of the studio.
///
/// Ownership    Counted. A copy names the same object, which stays in memory while the studio or
///              any handle holds it; memory is never pulled from under a handle.
/// Null handle  Default-constructed: equal to every other null handle, of any class.
/// Threads      The host's polling thread. Copying, comparing and destroying: [any thread].
/// Errors       None are thrown.
class OSTINET_EXPORT Object : public boost::totally_ordered1<Object> {
 public:
  Object(Object const& other);
  Object& operator=(Object const& other);

  /// True unless the handle is null.
  virtual bool Exists() const;
  /// The name to show, or an empty text for a null handle.
  virtual UString GetName() const;

  /// The address of the object behind the handle, null for a null handle. [any thread]
  void* GetImplPtr() const;
  /// The same address as a number: it identifies the object among the living ones of this
  /// process and means nothing in another. Persistent references are MatchData. [any thread]
  unsigned long long GetKey() const;

  /// True if both name the same object, whatever the classes of the handles. [any thread]
  bool operator==(Object const& other) const;
  /// An arbitrary order that stays while objects live and die. [any thread]
  bool operator<(Object const& other) const;

 protected:
  Object();
  explicit Object(RCPtrMT<Impl::ObjectImpl> const& impl);
  virtual ~Object();

 private:
  RCPtrMT<Impl::ObjectImpl> impl_;
};

/// What devices, entities and endpoints have in common: named properties. One that an object does
/// not hold itself comes from its parent, an endpoint's from its entity and an entity's from its
/// device, so what is said of a device holds for its parts until a part says otherwise. Setters
/// write to the object itself only.
///
/// Ownership    Counted, as Object.
/// Null handle  Getters give false, 0, an empty text or what is named below; setters do nothing.
/// Threads      The host's polling thread.
/// Errors       None are thrown: a property that is missing or of another type gives its default.
///              A dead handle (its object left the studio) reads and writes what the object held
///              last, and nobody is told.
class OSTINET_EXPORT DeviceObject : public Object {
 public:
  /// A null handle.
  DeviceObject();
  DeviceObject(RCPtrMT<Impl::DeviceObjectImpl> const& impl);

  /// True while the object is in the studio. It never turns true again: a device that comes back
  /// is a new object.
  bool Exists() const override;
  /// True for what the platform has (a port), false for what the user described (an instrument).
  bool IsDirect() const;
  /// True if MIDI can flow: a port is there; a user's device hangs on a port that is there.
  bool IsOnline() const;

  /// The name as it was given, where GetName may build it from those of device and entity.
  UString GetRawName() const;
  void SetRawName(UString const& name) const;
  /// Default: empty.
  UString GetManufacturer() const;
  void SetManufacturer(UString const& manufacturer) const;
  /// Default: empty.
  UString GetModel() const;
  void SetModel(UString const& model) const;
  /// The device number in sysex messages, 0 to 127, or -1 for none (the default, and a null
  /// handle).
  char GetSysexDeviceID() const;
  /// Stores `id`; any value with its top bit set is stored as -1.
  void SetSysexDeviceID(char id) const;
  /// By how many microseconds the host should stamp its output ahead. Default: 0.
  int GetAdvanceScheduleMicroseconds() const;
  void SetAdvanceScheduleMicroseconds(int microseconds) const;

  /// Channel masks, bit n for channel n of 0 to 15. Default: 65535, all channels.
  unsigned short ReceiveChannels() const;
  void SetReceiveChannels(unsigned short mask) const;
  unsigned short TransmitChannels() const;
  void SetTransmitChannels(unsigned short mask) const;

  /// What kind of thing it is. Default: false.
  bool IsADrumMachine() const;
  void SetIsADrumMachine(bool is) const;
  bool IsAMixer() const;
  void SetIsAMixer(bool is) const;
  bool IsASampler() const;
  void SetIsASampler(bool is) const;
  bool IsAnEffectsUnit() const;
  void SetIsAnEffectsUnit(bool is) const;

  /// What it understands. Default: notes and program changes, nothing else. BankSelect0 is the
  /// coarse bank number (controller 0), BankSelect32 the fine one (controller 32).
  bool ReceivesBankSelect0() const;
  void SetReceivesBankSelect0(bool receives) const;
  bool ReceivesBankSelect32() const;
  void SetReceivesBankSelect32(bool receives) const;
  bool ReceivesClock() const;
  void SetReceivesClock(bool receives) const;
  bool ReceivesMTC() const;
  void SetReceivesMTC(bool receives) const;
  bool ReceivesNotes() const;
  void SetReceivesNotes(bool receives) const;
  bool ReceivesProgramChange() const;
  void SetReceivesProgramChange(bool receives) const;

  /// What it sends. Default: notes and program changes, nothing else.
  bool TransmitsBankSelect0() const;
  void SetTransmitsBankSelect0(bool transmits) const;
  bool TransmitsBankSelect32() const;
  void SetTransmitsBankSelect32(bool transmits) const;
  bool TransmitsClock() const;
  void SetTransmitsClock(bool transmits) const;
  bool TransmitsMTC() const;
  void SetTransmitsMTC(bool transmits) const;
  bool TransmitsNotes() const;
  void SetTransmitsNotes(bool transmits) const;
  bool TransmitsProgramChange() const;
  void SetTransmitsProgramChange(bool transmits) const;

  /// Default: false.
  bool SupportsGeneralMIDI() const;
  void SetSupportsGeneralMIDI(bool supports) const;
  /// MIDI machine control. Default: false.
  bool SupportsMMC() const;
  void SetSupportsMMC(bool supports) const;

  /// The user's name of `channel`, 0 to 15. Default, and for any other channel: empty.
  UString GetChannelName(int channel) const;
  /// Does nothing for a channel outside 0 to 15.
  void SetChannelName(int channel, UString const& name) const;

  /// The sysex identity that follows from the stored device type; all 0xFF where it says nothing.
  ModelInfo GetModelInfo() const;
  /// The backend that the object belongs to; 0 for a null handle.
  Properties::Implementation GetImplementation() const;
  /// Writes the object's attributes and children into the element that `writer` has just opened.
  void ExportToXML(XMLLib::Writer& writer) const;

  /// The unique ID; 0 means none.
  int _get_impl_id() const;
  /// The platform's own reference to the object in backend `implementation`, or null.
  void* _get_impl_obj_ref(Properties::Implementation implementation) const;
  /// True if `ref` is the object's reference in its own backend.
  bool matches_impl_obj_ref(void* ref) const;
};

class Entity;

/// A box of the studio: an instrument or an interface that the user described.
///
/// Ownership    Counted, as Object.
/// Null handle  kNoDevice.
/// Threads      The host's polling thread.
/// Errors       None are thrown.
class OSTINET_EXPORT Device : public DeviceObject {
 public:
  /// The tag of devices in persistent references.
  static const MatchObjectID kObjectID = MatchObjectID(1);
  static Device const kNoDevice;

  /// Entities that have a part of their own in devices of certain types.
  enum SpecialEntityType : int {
    kDeviceCommonEntity = 0,  ///< speaks for the whole device
    kSecondCommonEntity = 1,
    kThirdCommonEntity = 2,
    kRealtimeEntity = 3,  ///< the one that carries clock and time code
  };

  /// A null handle.
  Device();
  Device(RCPtrMT<Impl::DeviceImpl> const& impl);

  int CountEntities() const;
  /// The entity at `index`, in order of creation, or a null handle out of range.
  Entity GetEntity(int index) const;
  /// A null handle where the device has no such entity.
  Entity GetSpecialEntity(SpecialEntityType type) const;
  /// Whether a monitor window shows the device; kept for the host. Default: false.
  bool IsOpenInMIDIMonitor() const;
  void OpenInMIDIMonitor(bool open) const;
};

class Source;
class Destination;

/// One group of ports of a device: its "Port 1", its "Port 2".
///
/// Ownership    Counted, as Object.
/// Null handle  kNoEntity.
/// Threads      The host's polling thread.
/// Errors       None are thrown.
class OSTINET_EXPORT Entity : public DeviceObject {
 public:
  /// The tag of entities in persistent references.
  static const MatchObjectID kObjectID = MatchObjectID(2);
  static Entity const kNoEntity;

  /// A null handle.
  Entity();
  Entity(RCPtrMT<Impl::EntityImpl> const& impl);

  int CountSources() const;
  /// The source at `index`, in order of creation, or a null handle out of range.
  Source GetSource(int index) const;
  int CountDestinations() const;
  /// The destination at `index`, in order of creation, or a null handle out of range.
  Destination GetDestination(int index) const;
  /// A null handle once the entity left its device.
  Device GetDevice() const;
};

}  // namespace Ostinet

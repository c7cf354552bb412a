// SPDX-License-Identifier: MIT
#pragma once

#include <boost/operators.hpp>

#include "ostinet/Common.h"
#include "ostinet/MatchData.h"
#include "ostinet/core/XML.h"

namespace Ostinet {
struct ModelInfo {
  unsigned char bytes[7];
  ModelInfo();
  bool operator==(ModelInfo const&) const;
};
class Object : public boost::totally_ordered1<Object> {
 public:
  Object(Object const&);
  Object& operator=(Object const&);
  virtual bool Exists() const;
  virtual UString GetName() const;
  void* GetImplPtr() const;
  unsigned long long GetKey() const;
  bool operator==(Object const&) const;
  bool operator<(Object const&) const;

 protected:
  Object();
  explicit Object(RCPtrMT<Impl::ObjectImpl> const&);
  virtual ~Object();
};
class DeviceObject : public Object {
 public:
  DeviceObject();
  DeviceObject(RCPtrMT<Impl::DeviceObjectImpl> const&);
  virtual bool Exists() const;
  bool IsDirect() const;
  bool IsOnline() const;
  UString GetRawName() const;
  void SetRawName(UString const&) const;
  UString GetManufacturer() const;
  void SetManufacturer(UString const&) const;
  UString GetModel() const;
  void SetModel(UString const&) const;
  char GetSysexDeviceID() const;
  void SetSysexDeviceID(char) const;
  int GetAdvanceScheduleMicroseconds() const;
  void SetAdvanceScheduleMicroseconds(int) const;
  unsigned short ReceiveChannels() const;
  void SetReceiveChannels(unsigned short) const;
  unsigned short TransmitChannels() const;
  void SetTransmitChannels(unsigned short) const;
  bool IsADrumMachine() const;
  void SetIsADrumMachine(bool) const;
  bool IsAMixer() const;
  void SetIsAMixer(bool) const;
  bool IsASampler() const;
  void SetIsASampler(bool) const;
  bool IsAnEffectsUnit() const;
  void SetIsAnEffectsUnit(bool) const;
  bool ReceivesBankSelect0() const;
  void SetReceivesBankSelect0(bool) const;
  bool ReceivesBankSelect32() const;
  void SetReceivesBankSelect32(bool) const;
  bool ReceivesClock() const;
  void SetReceivesClock(bool) const;
  bool ReceivesMTC() const;
  void SetReceivesMTC(bool) const;
  bool ReceivesNotes() const;
  void SetReceivesNotes(bool) const;
  bool ReceivesProgramChange() const;
  void SetReceivesProgramChange(bool) const;
  bool TransmitsBankSelect0() const;
  void SetTransmitsBankSelect0(bool) const;
  bool TransmitsBankSelect32() const;
  void SetTransmitsBankSelect32(bool) const;
  bool TransmitsClock() const;
  void SetTransmitsClock(bool) const;
  bool TransmitsMTC() const;
  void SetTransmitsMTC(bool) const;
  bool TransmitsNotes() const;
  void SetTransmitsNotes(bool) const;
  bool TransmitsProgramChange() const;
  void SetTransmitsProgramChange(bool) const;
  bool SupportsGeneralMIDI() const;
  void SetSupportsGeneralMIDI(bool) const;
  bool SupportsMMC() const;
  void SetSupportsMMC(bool) const;
  UString GetChannelName(int channel) const;
  void SetChannelName(int channel, UString const&) const;
  ModelInfo GetModelInfo() const;
  Properties::Implementation GetImplementation() const;
  void ExportToXML(XMLLib::Writer&) const;
  int _get_impl_id() const;
  void* _get_impl_obj_ref(Properties::Implementation) const;
  bool matches_impl_obj_ref(void* ref) const;
};
class Entity;
class Device : public DeviceObject {
 public:
  static const MatchObjectID kObjectID = MatchObjectID(1);
  static Device const kNoDevice;
  enum SpecialEntityType : int {
    kDeviceCommonEntity = 0,
    kSecondCommonEntity = 1,
    kThirdCommonEntity = 2,
    kRealtimeEntity = 3,
  };
  Device();
  Device(RCPtrMT<Impl::DeviceImpl> const&);
  int CountEntities() const;
  Entity GetEntity(int) const;
  Entity GetSpecialEntity(SpecialEntityType) const;
  bool IsOpenInMIDIMonitor() const;
  void OpenInMIDIMonitor(bool) const;
};
class Source;
class Destination;
class Entity : public DeviceObject {
 public:
  static const MatchObjectID kObjectID = MatchObjectID(2);
  static Entity const kNoEntity;
  Entity();
  Entity(RCPtrMT<Impl::EntityImpl> const&);
  int CountSources() const;
  Source GetSource(int) const;
  int CountDestinations() const;
  Destination GetDestination(int) const;
  Device GetDevice() const;
};
}  // namespace Ostinet

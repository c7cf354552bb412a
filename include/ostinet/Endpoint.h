// SPDX-License-Identifier: MIT
#pragma once

#include <boost/function.hpp>
#include <boost/optional.hpp>
#include <memory>
#include <vector>

#include "ostinet/DeviceObject.h"
#include "ostinet/MatchData.h"
#include "ostinet/SysexRef.h"
#include "ostinet/TimeStamp.h"

namespace Ostinet {
class SysexRef;
class Names;
class DestinationMode;
class DestinationNameSet;
class PatchBank;
class Patch;
struct PatchNumbers;
class Receiver {
 public:
  virtual bool WantsPacket(DataPacket const&, Source const&) = 0;
  virtual void HandlePacket(DataPacket const&, Source const&) = 0;

 protected:
  ~Receiver() {}
};
namespace Impl {
class Sender {
 public:
  virtual ~Sender();
  virtual void Send(DataPacket const&) = 0;
  virtual void Flush() = 0;
  virtual bool CanSend() const = 0;
};
}  // namespace Impl
class Endpoint : public DeviceObject {
 public:
  Endpoint();
  Endpoint(RCPtrMT<Impl::EndpointImpl> const&);
  int GetUniqueID() const;
  Entity GetEntity() const;
  UString GetChannelName(short channel) const;
  unsigned short GetChannels() const;
  UString GetEntityAndEndpointName() const;
  SlotID GetSlotID() const;
  bool HasConnections() const;
  bool IsDeviceCommon() const;
  boost::optional<bool> IsInterface() const;
  bool IsInternalSoftware() const;
  bool IsLoop() const;
  bool IsPrivate() const;
  bool IsSoftware() const;
  bool IsVirtual() const;
  bool SupportsBankSelect0() const;
  bool SupportsBankSelect32() const;
  bool SupportsClock() const;
  bool SupportsMTC() const;
  bool SupportsNotes() const;
  bool SupportsProgramChange() const;
  MatchData GetMatchData() const;
  MatchData GetShortMatchData() const;
  ObjectMatch MatchToData(MatchData const&) const;
  bool MatchToShortData(MatchData const&) const;
  static bool MatchOpposingNames(UString const& name1, UString const& name2, UString& joinedName);
  static bool MatchRelatedNames(UString const& name1, UString const& name2, UString& commonName,
                                UString& rest1, UString& rest2);
};
bool CompMIDIEndpointNames(Endpoint const& a, Endpoint const& b);
class Source : public Endpoint {
 public:
  static const MatchObjectID kObjectID = MatchObjectID(3);
  static Source const kNoSource;
  Source();
  Source(RCPtrMT<Impl::EndpointImpl> const&);
  Source GetDirectSource() const;
  Destination GetMatchingVirtualDestination() const;
  void AddConnectedSource(Source const&) const;
  void RemoveConnectedSource(Source const&) const;
  int CountConnectedSources() const;
  Source GetConnectedSource(int) const;
  Receiver* getDirectReceiver() const;
  bool hasDirectReceiver() const;
  void setDirectReceiver(Receiver*) const;
};
class Destination : public Endpoint {
 public:
  static const MatchObjectID kObjectID = MatchObjectID(4);
  static Destination const kNoDestination;
  Destination();
  Destination(RCPtrMT<Impl::DestinationImpl> const&);
  Destination GetDirectDestination() const;
  Source GetMatchingVirtualSource() const;
  bool IsBroadcast() const;
  bool IsPregen() const;
  void AddConnectedDestination(Destination const&) const;
  void RemoveConnectedDestination(Destination const&) const;
  int CountConnectedDestinations() const;
  Destination GetConnectedDestination(int) const;
  std::unique_ptr<Impl::Sender> MakeSender() const;
  void SendOnePacket(DataPacket const&) const;
  void SendSysex(TimeStamp, SysexRef const&) const;
  void FlushOutput() const;
  double GetAdvanceScheduleTime() const;
  int CountModes() const;
  DestinationMode GetMode(int) const;
  int CountNameSets() const;
  DestinationNameSet GetNameSet(int) const;
  DestinationMode GetCurrentMode() const;
  DestinationNameSet GetCurrentNameSet(short channel) const;
  Patch GetCurrentPatch(short channel) const;
  PatchBank GetCurrentBank(short channel) const;
  Patch GetPatch(short channel, PatchNumbers const&) const;
  Names GetNames() const;
  void SetNames(Names const&) const;
  Names GetOverrideNames(PatchBank const&) const;
  void SetOverrideNames(PatchBank const&, Names const&) const;
  void SendModeChange(DestinationMode const&) const;
  void SendPatchChange(short channel, Patch const&) const;
};
template <class T>
class ObjectFilter {
 public:
  ObjectFilter();
  explicit ObjectFilter(bool constant);
  ObjectFilter(boost::function<bool(T const&)> const& predicate);
  bool operator()(T const&) const;
  ObjectFilter& operator&=(ObjectFilter const&);
  ObjectFilter& operator|=(ObjectFilter const&);
  ObjectFilter operator&(ObjectFilter const&) const;
  ObjectFilter operator|(ObjectFilter const&) const;
  ObjectFilter operator!() const;
};
ObjectFilter<Endpoint>& DirectEndpoint();
ObjectFilter<Endpoint>& OnlineEndpoint();
ObjectFilter<Endpoint>& PublicEndpoint();
ObjectFilter<Endpoint>& SoftwareEndpoint();
ObjectFilter<Endpoint>& DefinitelyInterfaceEndpoint();
ObjectFilter<Endpoint>& DefinitelyNonInterfaceEndpoint();
ObjectFilter<Endpoint>& CouldBeInterfaceEndpoint();
ObjectFilter<Endpoint>& CouldBeNonInterfaceEndpoint();
ObjectFilter<Endpoint>& EntitylessNonSoftwareEndpoint();
ObjectFilter<Device>& DirectDevice();
class DestinationList : public std::vector<Destination> {
 public:
  static std::vector<ObjectFilter<Endpoint> > sDefaultSortFilters;
  DestinationList();
  explicit DestinationList(ObjectFilter<Endpoint> const&);
  void Reset(ObjectFilter<Endpoint> const&);
  void Sort(std::vector<ObjectFilter<Endpoint> >&);
};
class SourceList : public std::vector<Source> {
 public:
  static std::vector<ObjectFilter<Endpoint> > sDefaultSortFilters;
  SourceList();
  explicit SourceList(ObjectFilter<Endpoint> const&);
  void Reset(ObjectFilter<Endpoint> const&);
  void Sort(std::vector<ObjectFilter<Endpoint> >&);
};
class DeviceList : public std::vector<Device> {
 public:
  DeviceList();
  explicit DeviceList(ObjectFilter<Device> const&);
  void Reset(ObjectFilter<Device> const&);
};
}  // namespace Ostinet

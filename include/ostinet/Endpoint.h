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

/// The host's input callback.
///
/// Ownership    The host's; it outlives the session, or the source, that it was given to.
/// Threads      Told with each operation.
class OSTINET_EXPORT Receiver {
 public:
  /// True to keep the packet. [any thread] It may run in a callback of the system: be quick and do
  /// not block.
  virtual bool WantsPacket(DataPacket const& packet, Source const& source) = 0;
  /// Takes a packet, whose bytes are valid during the call only. The host's polling thread.
  virtual void HandlePacket(DataPacket const& packet, Source const& source) = 0;

 protected:
  ~Receiver() {}
};

namespace Impl {

/// A way out for stamped packets, made by Destination::MakeSender.
///
/// Ownership    The caller's.
/// Threads      One at a time; any number of senders may exist for one destination.
/// Errors       None are thrown. What cannot be sent is dropped: latency counts, not delivery.
class OSTINET_EXPORT Sender {
 public:
  virtual ~Sender();
  /// Sends, or gathers for Flush, one packet that holds one MIDI message. [realtime]
  virtual void Send(DataPacket const& packet) = 0;
  /// Sends what was gathered. The destructor does not. [realtime]
  virtual void Flush() = 0;
  /// True if there is somewhere to send to. [realtime]
  virtual bool CanSend() const = 0;
};

}  // namespace Impl

/// Where MIDI leaves (Source) or enters (Destination) the studio.
///
/// Ownership    Counted, as Object.
/// Null handle  Getters give false, 0, an empty text or value, or a null handle.
/// Threads      The host's polling thread.
/// Errors       None are thrown.
class OSTINET_EXPORT Endpoint : public DeviceObject {
 public:
  /// A null handle.
  Endpoint();
  Endpoint(RCPtrMT<Impl::EndpointImpl> const& impl);

  /// The number that names the endpoint in connections and references; 0 means none.
  int GetUniqueID() const;
  /// A null handle for a port of the system and for a virtual endpoint.
  Entity GetEntity() const;
  /// The user's name of `channel`, 0 to 15, or else its number as text, "1" to "16". Empty for any
  /// other channel.
  UString GetChannelName(short channel) const;
  /// The channels that are in use, as a mask: bit n for channel n of 0 to 15. What was set, else
  /// as many of the lowest as the device has, else all.
  unsigned short GetChannels() const;
  /// The name without the device's: the entity's, with a number where the entity has several
  /// endpoints of this direction.
  UString GetEntityAndEndpointName() const;
  /// All zeros where the endpoint has none.
  SlotID GetSlotID() const;
  /// True for a real port, on which things can hang.
  bool HasConnections() const;
  /// True if the endpoint belongs to the entity that speaks for its whole device.
  bool IsDeviceCommon() const;
  /// Whether this is an interface, on which instruments hang, or an instrument itself; no value
  /// where that cannot be told.
  boost::optional<bool> IsInterface() const;
  /// True for software inside the host.
  bool IsInternalSoftware() const;
  /// True for a port of the driver that loops output back to other programs.
  bool IsLoop() const;
  /// True if the endpoint stands in the private lists of Setup.
  bool IsPrivate() const;
  /// True if software made it, and not a port.
  bool IsSoftware() const;
  /// True for one end of a virtual pair.
  bool IsVirtual() const;

  /// What can be sent through a destination, or comes out of a source: a destination answers by
  /// what it receives, a source by what it transmits.
  bool SupportsBankSelect0() const;
  bool SupportsBankSelect32() const;
  bool SupportsClock() const;
  bool SupportsMTC() const;
  bool SupportsNotes() const;
  bool SupportsProgramChange() const;

  /// A persistent reference to this endpoint, to be kept in the host's documents.
  MatchData GetMatchData() const;
  /// The older, short form of the reference.
  MatchData GetShortMatchData() const;
  /// How well this endpoint fits a reference.
  ObjectMatch MatchToData(MatchData const& reference) const;
  bool MatchToShortData(MatchData const& reference) const;
  /// True if two names differ only in telling In from Out; `joinedName` is then one for both.
  static bool MatchOpposingNames(UString const& name1, UString const& name2, UString& joinedName);
  /// True if two names begin alike; `commonName` is then the part that they share.
  static bool MatchRelatedNames(UString const& name1, UString const& name2, UString& commonName,
                                UString& rest1, UString& rest2);
};

/// True if the name of `a` sorts before that of `b`, case ignored. For sorting.
OSTINET_EXPORT bool CompMIDIEndpointNames(Endpoint const& a, Endpoint const& b);

/// One output of the studio, where MIDI comes from: a port, or an instrument that hangs on one.
///
/// Ownership    Counted, as Object.
/// Null handle  kNoSource.
/// Threads      The host's polling thread.
/// Errors       None are thrown.
class OSTINET_EXPORT Source : public Endpoint {
 public:
  /// The tag of sources in persistent references.
  static const MatchObjectID kObjectID = MatchObjectID(3);
  static Source const kNoSource;

  /// A null handle.
  Source();
  Source(RCPtrMT<Impl::EndpointImpl> const& impl);

  /// The port that this source hangs on, or a null handle.
  Source GetDirectSource() const;
  /// The other end of a virtual pair, or a null handle.
  Destination GetMatchingVirtualDestination() const;
  /// Hangs a user's source on this port and stores that in both. Does nothing unless this
  /// HasConnections and `source` is one that is not direct.
  void AddConnectedSource(Source const& source) const;
  /// Takes `source` off this port and stores that in both. What `source` stored goes even where
  /// it hangs elsewhere.
  void RemoveConnectedSource(Source const& source) const;
  int CountConnectedSources() const;
  /// A null handle out of range.
  Source GetConnectedSource(int index) const;

  /// The receiver of this source alone, shared by all handles of the source; null for none.
  Receiver* getDirectReceiver() const;
  bool hasDirectReceiver() const;
  /// From now on `receiver` gets what comes from this source, in place of the receiver given at
  /// sign-in; null ends that. It stays the host's and must live while it is set.
  void setDirectReceiver(Receiver* receiver) const;
};

/// One input of the studio, where MIDI goes to: a port, or an instrument that hangs on one.
///
/// Ownership    Counted, as Object.
/// Null handle  kNoDestination. Sending does nothing.
/// Threads      The host's polling thread.
/// Errors       None are thrown. What cannot be sent is dropped: latency counts, not delivery.
class OSTINET_EXPORT Destination : public Endpoint {
 public:
  /// The tag of destinations in persistent references.
  static const MatchObjectID kObjectID = MatchObjectID(4);
  static Destination const kNoDestination;

  /// A null handle.
  Destination();
  Destination(RCPtrMT<Impl::DestinationImpl> const& impl);

  /// The port that this destination hangs on, or a null handle.
  Destination GetDirectDestination() const;
  /// The other end of a virtual pair, or a null handle.
  Source GetMatchingVirtualSource() const;
  /// True for a destination that stands for several ports at once.
  bool IsBroadcast() const;
  /// True for a direct destination whose output is generated in advance.
  bool IsPregen() const;
  /// Hangs a user's destination on this port and stores that in both. Does nothing unless this
  /// HasConnections and `destination` is one that is not direct.
  void AddConnectedDestination(Destination const& destination) const;
  /// Takes `destination` off this port and stores that in both. What `destination` stored goes
  /// even where it hangs elsewhere.
  void RemoveConnectedDestination(Destination const& destination) const;
  int CountConnectedDestinations() const;
  /// A null handle out of range.
  Destination GetConnectedDestination(int index) const;

  /// The way out for stamped packets, or null if there is none: null handle, or an instrument that
  /// hangs on no port. The sender keeps the port that it was made with, so drop it when
  /// SetupChanged arrives.
  std::unique_ptr<Impl::Sender> MakeSender() const;
  /// Makes a sender, sends `packet` and flushes.
  void SendOnePacket(DataPacket const& packet) const;
  /// Sends a whole long message at `stamp`.
  void SendSysex(TimeStamp stamp, SysexRef const& sysex) const;
  /// Drops what is waiting to go out, where the port can.
  void FlushOutput() const;
  /// By how many seconds the host should stamp its output ahead. Default: 0.
  double GetAdvanceScheduleTime() const;

  // What the destination's modes, banks and patches are called. Channels are 0 to 15; out of range,
  // and where nothing is known, there is a null handle. Names stay until other ones are chosen, by
  // SetNames or because the device became another; DestinationNamesChanged tells that.

  int CountModes() const;
  DestinationMode GetMode(int index) const;
  int CountNameSets() const;
  DestinationNameSet GetNameSet(int index) const;
  /// The mode in which the device is taken to be.
  DestinationMode GetCurrentMode() const;
  DestinationNameSet GetCurrentNameSet(short channel) const;
  /// The patch that fits best what was sent on the channel, through this destination or another
  /// that hangs on the same port.
  Patch GetCurrentPatch(short channel) const;
  /// The bank of that patch.
  PatchBank GetCurrentBank(short channel) const;
  /// The patch of just these numbers in the channel's name set.
  Patch GetPatch(short channel, PatchNumbers const& numbers) const;
  /// The document in use; no names if there is none.
  Names GetNames() const;
  /// Uses another document or standard mode from now on. Edits that are not saved are lost: call
  /// Setup::SaveEditedDestBanks before it to keep them.
  void SetNames(Names const& names) const;
  /// What takes the place of the bank's own patches; no names if nothing does.
  Names GetOverrideNames(PatchBank const& bank) const;
  /// Puts the patches of another document in the place of the bank's own. No names take that away;
  /// the bank is empty until the names are loaded anew.
  void SetOverrideNames(PatchBank const& bank, Names const& names) const;

  /// Sends what leaves the current mode and what selects `mode`, which then is the current one with
  /// its name sets, also if nothing can be sent. CurrentPatchChanged tells it for all channels. The
  /// device's own ID is put into long messages, or 126, to which all answer. Does nothing for the
  /// current mode and for a null handle.
  void SendModeChange(DestinationMode const& mode) const;
  /// Sends the bank select and the program change of a patch that the channel's name set offers.
  /// CurrentPatchChanged tells it at once, and Setup::Poll again when it has seen what went out.
  /// Does nothing for a null handle.
  void SendPatchChange(short channel, Patch const& patch) const;
};

}  // namespace Ostinet

#include "ostinet/ObjectFilter.h"

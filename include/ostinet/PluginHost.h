// SPDX-License-Identifier: MIT
#pragma once

#include "ostinet/Common.h"
#include "ostinet/Endpoint.h"
#include "ostinet/MatchData.h"
#include "ostinet/TimeStamp.h"

// What the host's plug-in engine implements, so that an instrument plug-in stands in the studio as
// a destination (Setup::CreateSYNAPPluginDestination) and is sent to with times in samples.

namespace Ostinet {
namespace Impl {
class SYNAP_MIDIDestImplImpl;
}
}  // namespace Ostinet

/// Where the MIDI of one plug-in goes.
///
/// What arrives is an array of records of 270 bytes each, integers with the low byte first:
///
///     offset  bytes  field
///          0      8  sample time, signed: the stamp's sample count, truncated
///          8      1  0
///          9      1  0
///         10      2  count of bytes, 0 to 256
///         12      2  kind: 0 first piece of a long message, 1 later piece, 2 short message
///         14    256  the bytes; those behind the count are 0
///
/// Ownership    The host's. The library holds references by Retain and Release.
/// Threads      Whatever thread sends: each call of a sender arrives at once, on its own thread,
///              and no queue stands in between.
class ISynapMIDIDestination {
 public:
  /// The host's own; the library calls neither.
  virtual void HostOperation1() = 0;
  virtual void HostOperation2() = 0;
  virtual void Retain() = 0;
  virtual void Release() = 0;
  /// Takes `count` records, which are gone when it returns. The records of a long message come in
  /// one call, the first at the start of a memory page.
  virtual void Send(void const* records, int count) = 0;
  /// Forgets what was sent and has not sounded yet.
  virtual void Flush() = 0;

 protected:
  ~ISynapMIDIDestination() {}
};

/// The MIDI side of one plug-in in the host's engine.
///
/// Ownership    The host's. It outlives the destination that is made for it; that is, it is kept
///              until SetActivatedObject hears null.
/// Threads      The host's polling thread.
class SynapMidiPort {
 public:
  /// Hears of the peer of its destination while that is being made, and of null when it leaves the
  /// studio. See Ostinet::SynapPeer for what can be done with it in between.
  virtual void SetActivatedObject(Ostinet::Impl::SYNAP_MIDIDestImplImpl* peer) = 0;
  /// Whether the plug-in is rendered ahead of time; Destination::IsPregen gives it on.
  virtual bool IsPregen() = 0;
  /// Where its MIDI goes; null for a plug-in that takes none. Asked once, when the destination is
  /// made.
  virtual ISynapMIDIDestination* GetDestination() = 0;

 protected:
  ~SynapMidiPort() {}
};

namespace Ostinet {

/// Sends one packet as one record of the kind "short message". What is longer than a record holds
/// is cut after 256 bytes. An empty packet or a null destination sends nothing. [any thread]
OSTINET_EXPORT void SendMIDIPacketToSYNAPDestination(DataPacket const& packet,
                                                     ISynapMIDIDestination* destination);

/// Sends a long message of `length` bytes as records of up to 256 bytes each, in one call. A length
/// below 1 or a null destination sends nothing, and so does a message for which there is no memory.
/// [any thread]
OSTINET_EXPORT void SendSysexToSYNAPDestination(TimeStamp stamp, unsigned char* bytes, int length,
                                                ISynapMIDIDestination* destination);

/// What a host's engine may ask and tell of its destination by the peer that SetActivatedObject
/// gave it.
///
/// Ownership    None: it is good until SetActivatedObject hears null.
/// Null handle  Made from null. Getters give false, 0 or empty values, the rest do nothing.
/// Threads      The host's polling thread.
/// Errors       None are thrown.
class OSTINET_EXPORT SynapPeer {
 public:
  SynapPeer() = default;
  explicit SynapPeer(Impl::SYNAP_MIDIDestImplImpl* peer) : peer_(peer) {}

  SynapMidiPort* GetSynapMIDIPort() const;
  bool IsPregen() const;
  /// As stored, without the numbers that tell endpoints of one name apart.
  UString GetName() const;
  void GetManufAndModel(UString& manufacturer, UString& model) const;
  void SetManufAndModel(UString const& manufacturer, UString const& model) const;
  /// The full path of the document that names the patches; empty if there is none.
  void GetMasterNamesProperty(UString& path) const;
  /// An empty path takes the document away.
  void SetMasterNamesProperty(UString const& path) const;
  /// Where the plug-in sits in the host, by which stored references find it again.
  SlotID GetSlotID() const;
  int GetUniqueID() const;
  /// How far ahead of time packets are wanted, in microseconds.
  void SetAdvanceScheduleTime(int microseconds) const;
  /// The channels that it listens to; bit n is channel n of 0 to 15.
  void SetChanMask(int mask) const;
  /// What a channel of 0 to 15 is called; nothing for any other.
  void SetChanName(int channel, UString const& name) const;

 private:
  Impl::SYNAP_MIDIDestImplImpl* peer_ = nullptr;  // the studio's
};

}  // namespace Ostinet

// SPDX-License-Identifier: MIT
#pragma once

#include <cstdint>
#include <vector>

#include "ostinet/TimeStamp.h"

namespace Ostinet::Impl {

/// One step of a script of MIDI messages.
struct MIDICommandItem {
  enum Kind : std::int32_t { kDelay = 0, kMessage = 1, kSysex = 2 };

  Kind kind = kDelay;
  Clocks delay;              ///< kDelay only
  std::uint32_t length = 0;  ///< kMessage: its bytes; kSysex: its logical bytes
  std::uint32_t stored = 0;  ///< how many of the list's bytes belong to the item
};

/// One byte of a sysex item as it was recorded: the byte itself, or what to put in its place.
struct SysexByte {
  static constexpr unsigned char kDeviceIDMarker = 254;
  static constexpr unsigned char kChannelMarker = 255;

  unsigned char value = 0;  ///< the byte, or one of the markers
  unsigned char offset = 0, multiplier = 0;

  bool IsMarker() const { return value >= kDeviceIDMarker; }
};

/// What a bank, a patch or either end of a mode sends: a channel-free recording of messages.
///
/// Most lists are a bank select and a program change. Those stay three pending numbers and no
/// bytes, because banks and patches are asked for their numbers; anything else becomes a script,
/// and a list with a script has no numbers.
class MIDICommandList {
 public:
  static constexpr unsigned char kNone = 255;

  // Recording, in the order of the document. Status bytes carry no channel; data is 0 to 127.

  void AddDelay(unsigned long long milliseconds);
  void AddTwoBytes(unsigned char status, unsigned char data);
  void AddThreeBytes(unsigned char status, unsigned char data1, unsigned char data2);
  /// Starts a sysex item, which takes the sysex bytes and markers up to the next other call.
  void BeginSysex();
  /// There is no escape: 254 or 255 here acts as a marker, the two bytes behind it as its operands.
  void AddSysexByte(unsigned char byte);
  /// `marker` is one of SysexByte's.
  void AddSysexMarker(unsigned char marker, unsigned char offset, unsigned char multiplier);

  // 255 means none.

  unsigned char PendingProgram() const { return pendingProgram_; }
  unsigned char PendingMSB() const { return pendingMSB_; }
  unsigned char PendingLSB() const { return pendingLSB_; }

  /// The script. Empty while there are only pending numbers.
  std::vector<MIDICommandItem> const& Items() const { return items_; }
  std::vector<unsigned char> const& Bytes() const { return bytes_; }
  /// True if there is nothing to send.
  bool IsEmpty() const;

  /// Adds the messages to `buffer`, the first at `stamp`. Of `channel` the low byte is used;
  /// `deviceID` is put in as it is.
  void GenerateCommands(DataBuffer& buffer, TimeStamp const& stamp, short channel,
                        unsigned char deviceID) const;

 private:
  void Flush();
  void Store(unsigned char const* bytes, std::uint32_t count);
  void GeneratePending(DataBuffer& buffer, TimeStamp const& stamp, unsigned char channel) const;
  void GenerateScript(DataBuffer& buffer, TimeStamp const& stamp, unsigned char channel,
                      unsigned char deviceID) const;

  std::vector<unsigned char> bytes_;
  std::vector<MIDICommandItem> items_;
  unsigned char pendingProgram_ = kNone;
  unsigned char pendingMSB_ = kNone;
  unsigned char pendingLSB_ = kNone;
};

/// Walks the script of a list, item by item, and inside a sysex item byte by byte. The list must
/// outlive the walk and stay as it is.
class MIDICommandWalk {
 public:
  explicit MIDICommandWalk(MIDICommandList const& list);

  /// Goes to the next item, at first to the first; false behind the last.
  bool Next();
  MIDICommandItem const& Item() const { return *item_; }
  /// The bytes of a message; as many as the item's length.
  unsigned char const* Message() const { return position_; }
  /// The next byte of a sysex item; false behind the last. A marker whose operands are missing
  /// ends the item.
  bool NextSysexByte(SysexByte& out);

 private:
  MIDICommandItem const* next_;
  MIDICommandItem const* const itemsEnd_;
  MIDICommandItem const* item_ = nullptr;
  unsigned char const* position_;
  unsigned char const* end_;  // of the item's bytes
  std::uint32_t left_ = 0;    // logical bytes of the item
};

}  // namespace Ostinet::Impl

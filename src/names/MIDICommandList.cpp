// SPDX-License-Identifier: MIT
//
// MIDICommandList: three numbers as long as they say it all, a script from then on. Whatever moves
// pending numbers into the script moves all of them, in the order in which instruments want them:
// bank by its coarse and fine half, then program.
#include "names/MIDICommandList.h"

#include <algorithm>

namespace Ostinet::Impl {

namespace {

constexpr unsigned char kControlChange = 0xB0;
constexpr unsigned char kProgramChange = 0xC0;
constexpr unsigned char kBankMSB = 0;
constexpr unsigned char kBankLSB = 32;

// Eight bits and no more: what goes beyond wraps around, as in the documents' authors' machines.
unsigned char Substitute(SysexByte const& byte, unsigned char substitute) {
  unsigned const sum = (byte.offset + substitute) & 0xFFU;
  return static_cast<unsigned char>(sum * byte.multiplier);
}

}  // namespace

void MIDICommandList::AddDelay(unsigned long long milliseconds) {
  constexpr unsigned long long kNanosecondsInOne = 1000000;
  Flush();
  MIDICommandItem item;
  item.delay = NanosecondsToMIDITime(milliseconds * kNanosecondsInOne);
  items_.push_back(item);
}

void MIDICommandList::AddTwoBytes(unsigned char status, unsigned char data) {
  if (items_.empty() && status == kProgramChange && pendingProgram_ == kNone) {
    pendingProgram_ = data;
    return;
  }
  Flush();
  unsigned char const bytes[] = {status, data};
  Store(bytes, sizeof bytes);
}

void MIDICommandList::AddThreeBytes(unsigned char status, unsigned char data1,
                                    unsigned char data2) {
  if (items_.empty() && status == kControlChange && pendingProgram_ == kNone) {
    if (data1 == kBankMSB && pendingMSB_ == kNone) {
      pendingMSB_ = data2;
      return;
    }
    if (data1 == kBankLSB && pendingLSB_ == kNone) {
      pendingLSB_ = data2;
      return;
    }
  }
  Flush();
  unsigned char const bytes[] = {status, data1, data2};
  Store(bytes, sizeof bytes);
}

void MIDICommandList::BeginSysex() {
  Flush();
  MIDICommandItem item;
  item.kind = MIDICommandItem::kSysex;
  items_.push_back(item);
}

void MIDICommandList::AddSysexByte(unsigned char byte) {
  bytes_.push_back(byte);
  items_.back().length += 1;
  items_.back().stored += 1;
}

void MIDICommandList::AddSysexMarker(unsigned char marker, unsigned char offset,
                                     unsigned char multiplier) {
  bytes_.insert(bytes_.end(), {marker, offset, multiplier});
  items_.back().length += 1;
  items_.back().stored += 3;
}

bool MIDICommandList::IsEmpty() const {
  return items_.empty() && pendingProgram_ == kNone && pendingMSB_ == kNone && pendingLSB_ == kNone;
}

void MIDICommandList::Flush() {
  unsigned char const msb[] = {kControlChange, kBankMSB, pendingMSB_};
  unsigned char const lsb[] = {kControlChange, kBankLSB, pendingLSB_};
  unsigned char const program[] = {kProgramChange, pendingProgram_};
  if (pendingMSB_ != kNone) {
    Store(msb, sizeof msb);
  }
  if (pendingLSB_ != kNone) {
    Store(lsb, sizeof lsb);
  }
  if (pendingProgram_ != kNone) {
    Store(program, sizeof program);
  }
  pendingProgram_ = pendingMSB_ = pendingLSB_ = kNone;
}

void MIDICommandList::Store(unsigned char const* bytes, std::uint32_t count) {
  bytes_.insert(bytes_.end(), bytes, bytes + count);
  MIDICommandItem item;
  item.kind = MIDICommandItem::kMessage;
  item.length = item.stored = count;
  items_.push_back(item);
}

void MIDICommandList::GenerateCommands(DataBuffer& buffer, TimeStamp const& stamp, short channel,
                                       unsigned char deviceID) const {
  auto const channelByte = static_cast<unsigned char>(channel);
  if (bytes_.empty()) {
    GeneratePending(buffer, stamp, channelByte);
  } else {
    GenerateScript(buffer, stamp, channelByte, deviceID);
  }
}

void MIDICommandList::GeneratePending(DataBuffer& buffer, TimeStamp const& stamp,
                                      unsigned char channel) const {
  auto const control = static_cast<unsigned char>(kControlChange | channel);
  auto const program = static_cast<unsigned char>(kProgramChange | channel);
  unsigned char const msb[] = {control, kBankMSB, pendingMSB_};
  unsigned char const lsb[] = {control, kBankLSB, pendingLSB_};
  unsigned char const patch[] = {program, pendingProgram_};
  if (pendingMSB_ != kNone) {
    buffer.Add(stamp, msb, sizeof msb);
  }
  if (pendingLSB_ != kNone) {
    buffer.Add(stamp, lsb, sizeof lsb);
  }
  if (pendingProgram_ != kNone) {
    buffer.Add(stamp, patch, sizeof patch);
  }
}

void MIDICommandList::GenerateScript(DataBuffer& buffer, TimeStamp const& stamp,
                                     unsigned char channel, unsigned char deviceID) const {
  unsigned long long time = stamp.AsMIDITime().Value();
  MIDICommandWalk walk(*this);
  while (walk.Next()) {
    MIDICommandItem const& item = walk.Item();
    if (item.kind == MIDICommandItem::kDelay) {
      time += item.delay.Value();
    } else if (item.kind == MIDICommandItem::kMessage) {
      unsigned char message[3] = {};
      std::copy(walk.Message(), walk.Message() + item.length, message);
      message[0] = static_cast<unsigned char>(message[0] | channel);
      buffer.Add(TimeStamp(Clocks(time)), message, item.length);
    } else {
      buffer.Add(TimeStamp(Clocks(time)), nullptr, 0);
      SysexByte byte;
      while (walk.NextSysexByte(byte)) {
        bool const isDevice = byte.value == SysexByte::kDeviceIDMarker;
        buffer.AppendByte(byte.IsMarker() ? Substitute(byte, isDevice ? deviceID : channel)
                                          : byte.value);
      }
    }
  }
}

MIDICommandWalk::MIDICommandWalk(MIDICommandList const& list)
    : next_(list.Items().data()),
      itemsEnd_(next_ + list.Items().size()),
      position_(list.Bytes().data()),
      end_(position_) {}

bool MIDICommandWalk::Next() {
  if (next_ == itemsEnd_) {
    return false;
  }
  item_ = next_++;
  position_ = end_;
  end_ = position_ + item_->stored;
  left_ = item_->length;
  return true;
}

bool MIDICommandWalk::NextSysexByte(SysexByte& out) {
  if (left_ == 0 || position_ == end_) {
    return false;
  }
  out = SysexByte();
  out.value = *position_++;
  if (out.IsMarker()) {
    if (end_ - position_ < 2) {
      left_ = 0;
      return false;
    }
    out.offset = *position_++;
    out.multiplier = *position_++;
  }
  --left_;
  return true;
}

}  // namespace Ostinet::Impl

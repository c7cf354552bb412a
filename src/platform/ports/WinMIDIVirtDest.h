// SPDX-License-Identifier: MIT
#pragma once

#include "platform/ports/WinMIDIVirtSource.h"

namespace Ostinet::Impl {

/// The destination of a virtual pair. It has no properties of its own: both ends share those of
/// the source. Once the source is gone it keeps its own.
class WinMIDIVirtDest : public WinMIDIImplImpl {
 public:
  WinMIDIVirtDest(WinMIDISetup& setup, WinMIDIVirtSource& source)
      : WinMIDIImplImpl(setup, &source), queue_(source.Queue()) {}

  bool IsFake() const override { return true; }
  bool SetFile(UString const& key, UString const& path) override;
  bool SetDict(UString const& key, PropertyDict const& value) override;
  bool SetIntList(UString const& key, std::vector<int> const& value) override;
  bool SetString(UString const& key, UString const& value) override;
  bool SetInt(UString const& key, int value) override;
  void RemoveProperty(UString const& key) override;
  void SendSysex(TimeStamp stamp, RCPtrMT<SysexImpl> const& sysex) override;

  std::shared_ptr<PacketQueue> const& Queue() const { return queue_; }

 private:
  std::shared_ptr<PacketQueue> const queue_;
};

}  // namespace Ostinet::Impl

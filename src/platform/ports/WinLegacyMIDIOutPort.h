// SPDX-License-Identifier: MIT
#pragma once

#include <memory>

#include "platform/WinMIDIImplImpl.h"
#include "platform/ports/LegacyOutDevice.h"

namespace Ostinet::Impl {

/// An output port of WinMM, whose scheduling ahead is this library's business.
class WinLegacyMIDIOutPort : public WinMIDIImplImpl {
 public:
  /// Throws a VantorError when the output thread cannot be started.
  WinLegacyMIDIOutPort(WinMIDISetup& setup, std::shared_ptr<Session> session);
  ~WinLegacyMIDIOutPort() override;

  /// Opens the system's device of that index, which was listed with `caps`. A failure is not told:
  /// nothing is sent then.
  void Open(UINT device, MIDIOUTCAPSW caps);
  void Deactivate() override;
  void SendSysex(TimeStamp stamp, RCPtrMT<SysexImpl> const& sysex) override;

  /// Never null; senders share it.
  std::shared_ptr<LegacyOutDevice> const& Device() const { return device_; }

 private:
  std::shared_ptr<Session> const session_;
  std::shared_ptr<LegacyOutDevice> const device_;
};

}  // namespace Ostinet::Impl

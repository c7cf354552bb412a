// SPDX-License-Identifier: MIT
#pragma once

#include <vector>

#include "platform/ports/WinDMusMIDIPort.h"

namespace Ostinet::Impl {

/// An output port of DirectMusic, which schedules stamped events itself. A synthesizer is given
/// the default set of instruments at each opening.
class WinDMusMIDIOutPort : public WinDMusMIDIPort {
 public:
  using WinDMusMIDIPort::WinDMusMIDIPort;
  ~WinDMusMIDIOutPort() override;

  void Open(DMUS_PORTCAPS const& caps) override;
  /// Takes the instruments out and lets the port itself be: it stays open and active until the
  /// object dies, so that notes still ring out. No sender reaches it any more.
  void Deactivate() override;
  void SendSysex(TimeStamp stamp, RCPtrMT<SysexImpl> const& sysex) override;

 private:
  int MeasureLatency() const;
  void DownloadDefaultSet();

  std::vector<ComPtr<IDirectMusicDownloadedInstrument>> instruments_;
};

}  // namespace Ostinet::Impl

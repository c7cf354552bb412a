// SPDX-License-Identifier: MIT
#pragma once

#include "platform/ports/WinDMusMIDIPort.h"

namespace Ostinet::Impl {

/// An input port of DirectMusic, read when its notification event says that there is something.
class WinDMusMIDIInPort : public WinDMusMIDIPort {
 public:
  using WinDMusMIDIPort::WinDMusMIDIPort;
  ~WinDMusMIDIInPort() override;

  void Open(DMUS_PORTCAPS const& caps) override;
  void Deactivate() override;
  /// Hands everything that has come in to the receiver of the studio, which may be null: then
  /// the input is lost. A direct receiver of the source has no part in this. A receiver that
  /// throws loses the rest of what has come in, and nothing else.
  void DrainInput(Receiver* receiver, Source const& source);

 private:
  void CloseEvent();

  HANDLE notification_ = nullptr;
};

}  // namespace Ostinet::Impl

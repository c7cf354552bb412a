// SPDX-License-Identifier: MIT
#pragma once

#include <memory>

#include "platform/WinMIDIImplImpl.h"
#include "platform/ports/LegacyInDevice.h"

namespace Ostinet::Impl {

/// An input port of WinMM.
class WinLegacyMIDIInPort : public WinMIDIImplImpl {
 public:
  WinLegacyMIDIInPort(WinMIDISetup& setup, std::shared_ptr<Session> session);
  ~WinLegacyMIDIInPort() override;

  /// Opens the system's device of that index, which was listed with `caps`. A failure is not told:
  /// nothing comes in then.
  void Open(UINT device, MIDIINCAPSW caps);
  void Deactivate() override;
  /// Input is kept from here on, as far as the receiver, which may be null, wants it.
  void SetTarget(Source const& source, Receiver* receiver);
  /// Hands what was kept to the direct receiver of the source, else to the receiver.
  void DrainInput();

 private:
  std::shared_ptr<Session> const session_;
  std::shared_ptr<LegacyInDevice> const device_;
};

}  // namespace Ostinet::Impl

// SPDX-License-Identifier: MIT
#pragma once

#include <memory>

#include "platform/system/WindowsTypes.h"
#include "platform/system/native/DeviceCallback.h"
#include "platform/system/native/OutputLane.h"

namespace Ostinet::Impl {

/// An open WinMM output over a port of the machine.
///
/// Threads  Any.
class NativeOutput {
 public:
  NativeOutput(std::unique_ptr<OutputWire> wire, DeviceCallback callback);

  void ReportOpen(HMIDIOUT handle);
  /// Sends what still waits, for a bounded time, then reports the closing.
  void Close(HMIDIOUT handle);
  MMRESULT Reset();
  MMRESULT ShortMessage(DWORD message);
  /// The bytes are copied, so the header is done at once and MOM_DONE comes from within the call.
  MMRESULT LongMessage(HMIDIOUT handle, MIDIHDR* header, UINT size);

 private:
  std::unique_ptr<OutputLane> lane_;
  DeviceCallback callback_;
};

}  // namespace Ostinet::Impl

// SPDX-License-Identifier: MIT
#pragma once

#include <map>

#include "platform/system/WindowsTypes.h"
#include "platform/system/simulated/Studio.h"

namespace Ostinet::Impl::Simulated {

/// An output device that WinMM has open.
///
/// Threads  Guarded by the studio's mutex; callbacks run outside of it.
struct OpenOutput {
  using Callback = void CALLBACK(HMIDIOUT, UINT, DWORD_PTR, DWORD_PTR, DWORD_PTR);

  PortPtr port;
  HMIDIOUT handle = nullptr;
  Callback* callback = nullptr;
  DWORD_PTR instance = 0;
  std::uint8_t runningStatus = 0;
  /// Long messages that the device still plays, with the tries to unprepare them that are in vain.
  std::map<MIDIHDR*, int> playing;

  void Tell(UINT message, DWORD_PTR param1) const {
    if (callback != nullptr) callback(handle, message, instance, param1, 0);
  }
};

}  // namespace Ostinet::Impl::Simulated

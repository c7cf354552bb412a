// SPDX-License-Identifier: MIT
#include "platform/system/native/SteadyReferenceClock.h"

#include <chrono>

namespace Ostinet::Impl {

LONGLONG SteadyClocks() {
  auto const since = std::chrono::steady_clock::now().time_since_epoch();
  return std::chrono::duration_cast<std::chrono::nanoseconds>(since).count() / 100;
}

HRESULT SteadyReferenceClock::GetTime(REFERENCE_TIME* time) {
  if (time == nullptr) return E_POINTER;
  *time = SteadyClocks();
  return S_OK;
}

HRESULT SteadyReferenceClock::AdviseTime(REFERENCE_TIME, REFERENCE_TIME, HANDLE, DWORD*) {
  return E_NOTIMPL;
}

HRESULT SteadyReferenceClock::AdvisePeriodic(REFERENCE_TIME, REFERENCE_TIME, HANDLE, DWORD*) {
  return E_NOTIMPL;
}

HRESULT SteadyReferenceClock::Unadvise(DWORD) { return E_NOTIMPL; }

}  // namespace Ostinet::Impl

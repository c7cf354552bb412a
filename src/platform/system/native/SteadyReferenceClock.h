// SPDX-License-Identifier: MIT
#pragma once

#include "platform/system/native/ComObject.h"

namespace Ostinet::Impl {

/// The machine's steady clock in units of 100 ns.
class SteadyReferenceClock final : public ComObject<IReferenceClock, IID_IReferenceClock> {
 public:
  HRESULT GetTime(REFERENCE_TIME* time) override;
  // Nobody asks this clock to wake them; all three fail.
  HRESULT AdviseTime(REFERENCE_TIME base, REFERENCE_TIME stream, HANDLE event,
                     DWORD* cookie) override;
  HRESULT AdvisePeriodic(REFERENCE_TIME start, REFERENCE_TIME period, HANDLE semaphore,
                         DWORD* cookie) override;
  HRESULT Unadvise(DWORD cookie) override;
};

/// The clock that the above and timeGetTime read, in units of 100 ns, greater than 0.
LONGLONG SteadyClocks();

}  // namespace Ostinet::Impl

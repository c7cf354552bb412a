// SPDX-License-Identifier: MIT
#pragma once

#include <memory>

#include "ostinet/TimeStamp.h"

namespace Ostinet::Impl {

/// The clock that all MIDI time is read from, in ticks of 100 ns.
///
/// Threads  Any.
class MasterClock {
 public:
  virtual ~MasterClock() = default;
  /// Throws a VantorError where the system cannot tell the time.
  virtual unsigned long long GetTime() const = 0;
};

/// The backend installs its clock at sign-in and takes it away, with null, at sign-out. When this
/// returns, no thread reads the old clock any more.
void SetMasterClock(std::unique_ptr<MasterClock> clock);

/// One round of calibration: `now` of the master clock, the host's counter in 100 ns, and the
/// system's milliseconds, all read together. Moves both offsets 5 % of the way. Polling thread.
void CalibrateTimeBase(Clocks now, unsigned long long hostClocks, unsigned int milliseconds);

}  // namespace Ostinet::Impl

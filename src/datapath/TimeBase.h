// SPDX-License-Identifier: MIT
#pragma once

#include <memory>

#include "ostinet/Clocks.h"

namespace Ostinet::Impl {

/// The clock that all MIDI time is read from, in ticks of 100 ns.
///
/// Threads  Any.
class MasterClock {
 public:
  virtual ~MasterClock() = default;
  /// Throws through FailWinError where the system cannot tell the time. [realtime]
  virtual unsigned long long GetTime() const = 0;
};

/// The backend installs its clock at sign-in and takes it away, with null, at sign-out. When this
/// returns, no thread reads the old clock any more. Not to be called from within GetTime.
void SetMasterClock(std::unique_ptr<MasterClock> clock);

/// One round of calibration: `now` of the master clock, the host's counter in 100 ns, and the
/// system's milliseconds, all read together. Moves both offsets 5 % of the way. Polling thread.
void CalibrateTimeBase(Clocks now, unsigned long long hostClocks, unsigned int milliseconds);

/// How far the host's two clocks are ahead of MIDI time.
struct TimeBaseOffsets {
  double eventTime = 0.0;   ///< in seconds
  double hostClocks = 0.0;  ///< in ticks of 100 ns
};
TimeBaseOffsets GetTimeBaseOffsets();
/// For tests, which want to begin at a known place. Polling thread.
void SetTimeBaseOffsets(TimeBaseOffsets const& offsets);

}  // namespace Ostinet::Impl

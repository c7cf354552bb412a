// SPDX-License-Identifier: MIT
#pragma once

#include <memory>

#include "platform/BufferPool.h"
#include "platform/ComPtr.h"
#include "platform/system/System.h"

namespace Ostinet::Impl {

/// What one signed-in period holds of the system: its DirectMusic session, loader, master clock
/// and the pool of buffers. Ports and senders share it, so what they use outlives a sign-out.
///
/// Threads  Any; nothing changes after construction.
class Session {
 public:
  /// Starts the session; throws a VantorError at the first step that fails.
  explicit Session(std::shared_ptr<System> system);

  System& GetSystem() const { return *system_; }
  std::shared_ptr<System> const& SharedSystem() const { return system_; }
  Waits& GetWaits() const { return system_->GetWaits(); }
  ComPtr<IDirectMusic> const& DirectMusic() const { return directMusic_; }
  ComPtr<IDirectMusicLoader> const& Loader() const { return loader_; }
  ComPtr<IReferenceClock> const& Clock() const { return clock_; }
  std::shared_ptr<BufferPool> const& Pool() const { return pool_; }

 private:
  std::shared_ptr<System> const system_;
  ComPtr<IDirectMusic> directMusic_;
  ComPtr<IDirectMusicLoader> loader_;
  std::shared_ptr<BufferPool> pool_;
  ComPtr<IReferenceClock> clock_;
};

/// Hands the session's clock and buffers to the time base and to long messages, and takes them
/// away again.
void InstallSession(std::shared_ptr<Session> const& session);
void UninstallSession();

/// The step of the master clock in clocks of 100 ns, rounded up; 0 where the clock reads 0.
/// Throws a VantorError with the system error -36 where the clock stands still.
unsigned long long MeasureClockTick();

}  // namespace Ostinet::Impl

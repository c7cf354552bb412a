// SPDX-License-Identifier: MIT
#pragma once

#include <functional>

#include "ostinet/DeviceChanges.h"
#include "ostinet/Setup.h"
#include "ostinet/core/Noncopyable.h"
#include "ostinet/core/Provider.h"

namespace Ostinet {

/// Owns the provider that OstinetCallbackAPI::GetDevicesProvider gives to the library, and tells
/// it whenever the machine's MIDI ports change.
///
/// Ownership    The host's. It may die before or after the library's listeners.
/// Threads      Made and destroyed on the host's polling thread. Changes come on a thread of the
///              system's own; destruction waits for a change that is being told.
/// Errors       What a listener throws is dropped: the system's thread has no use for it.
class DeviceWatcher : private Noncopyable<DeviceWatcher> {
 public:
  using Listeners = Provider<Impl::WinMIDIDevicesListener>;

  /// Watches the MIDI system that is in use now. `afterwards`, where given, is called after the
  /// listeners on the same thread; it has to be short and must not throw.
  explicit DeviceWatcher(std::function<void()> afterwards = nullptr);
  ~DeviceWatcher();

  Listeners& GetProvider() { return listeners_; }

  /// False where the system tells nothing of its changes; then call DevicesChanged at will.
  bool IsWatching() const { return subscription_.IsActive(); }

  /// Tells the listeners as if the ports had changed. [any thread]
  void DevicesChanged();

 private:
  Listeners listeners_;
  std::function<void()> afterwards_;
  DeviceChangeSubscription subscription_;  // Last: gone first, so that no change meets the rest.
};

}  // namespace Ostinet

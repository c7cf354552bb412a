// SPDX-License-Identifier: MIT
#pragma once

#include <functional>
#include <memory>
#include <utility>

#include "ostinet/Export.h"

namespace Ostinet {

/// A place on the list of those who are told that the machine's MIDI ports changed.
///
/// Ownership    Move-only; the place is given up when the subscription dies or is reset.
/// Null handle  Default-constructed, or from a system that tells nothing: `IsActive` is false.
/// Threads      Any. Giving up waits for a call that is running, unless it is made from within
///              that call; afterwards no call comes.
/// Errors       None.
class DeviceChangeSubscription {
 public:
  DeviceChangeSubscription() = default;
  /// `place` gives the place up when its last copy goes.
  explicit DeviceChangeSubscription(std::shared_ptr<void> place) : place_(std::move(place)) {}
  DeviceChangeSubscription(DeviceChangeSubscription&&) = default;
  DeviceChangeSubscription& operator=(DeviceChangeSubscription&&) = default;
  DeviceChangeSubscription(DeviceChangeSubscription const&) = delete;
  DeviceChangeSubscription& operator=(DeviceChangeSubscription const&) = delete;

  bool IsActive() const { return place_ != nullptr; }
  void Reset() { place_.reset(); }

 private:
  std::shared_ptr<void> place_;
};

/// Calls `changed` after MIDI ports came, went or were renamed: on Windows when the list of devices
/// reads differently, on Linux as the JACK server tells it or within two seconds, on a simulated
/// studio at each of its changes. The call comes on a thread of the system's own and may come once
/// for several changes; it has to be short and must not throw. What it does as a rule is to tell
/// the provider that the host gave to the library (`OstinetCallbackAPI::GetDevicesProvider`).
///
/// The subscription belongs to the system in use at the time of the call: subscribe anew after
/// another one was installed. [any thread]
OSTINET_EXPORT DeviceChangeSubscription WatchDeviceChanges(std::function<void()> changed);

}  // namespace Ostinet

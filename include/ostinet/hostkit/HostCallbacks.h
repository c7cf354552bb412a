// SPDX-License-Identifier: MIT
#pragma once

#include <functional>

#include "ostinet/Setup.h"
#include "ostinet/hostkit/DeviceWatcher.h"

namespace Ostinet {

/// A ready OstinetCallbackAPI: it watches the machine's ports, and counts samples from a rate.
/// Make one before the first Setup::Instance, and keep it until the program ends or the setup is
/// signed out for good.
///
/// Ownership    The host's. It installs itself as OstinetCallbackAPI::gInstance, and takes itself
///              away again when it dies.
/// Threads      Made and destroyed on the host's polling thread; GetSampleTime [any thread].
class HostCallbacks : public OstinetCallbackAPI, private Noncopyable<HostCallbacks> {
 public:
  /// The position in samples, of whatever origin the host likes, at a time in host clocks of
  /// 100 ns. Has to be callable on any thread.
  using SampleTime = std::function<double(unsigned long long hostClocks)>;

  /// Samples since the clock's start, at `sampleRate` samples a second, above 0.
  static SampleTime AtRate(double sampleRate);

  /// `devicesChanged`, where given, is called after the library heard of changed ports, on a
  /// thread of the system's own: hand PollLoop::Hurry on to it.
  explicit HostCallbacks(std::function<void()> devicesChanged = nullptr,
                         SampleTime sampleTime = AtRate(48000.0));
  ~HostCallbacks() override;

  double GetSampleTime(unsigned long long hostClocks) override;
  Provider<Impl::WinMIDIDevicesListener>* GetDevicesProvider() override;

  DeviceWatcher& GetDeviceWatcher() { return watcher_; }

 private:
  SampleTime sampleTime_;
  DeviceWatcher watcher_;
};

}  // namespace Ostinet

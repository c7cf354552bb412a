// SPDX-License-Identifier: MIT
#include "ostinet/hostkit/HostCallbacks.h"

#include <utility>

namespace Ostinet {
namespace {

constexpr double kHostClocksPerSecond = 1e7;

}  // namespace

HostCallbacks::SampleTime HostCallbacks::AtRate(double sampleRate) {
  return [sampleRate](unsigned long long hostClocks) {
    return static_cast<double>(hostClocks) / kHostClocksPerSecond * sampleRate;
  };
}

HostCallbacks::HostCallbacks(std::function<void()> devicesChanged, SampleTime sampleTime)
    : sampleTime_(std::move(sampleTime)), watcher_(std::move(devicesChanged)) {
  gInstance = this;
}

HostCallbacks::~HostCallbacks() {
  if (gInstance == this) {
    gInstance = nullptr;
  }
}

double HostCallbacks::GetSampleTime(unsigned long long hostClocks) {
  return sampleTime_(hostClocks);
}

Provider<Impl::WinMIDIDevicesListener>* HostCallbacks::GetDevicesProvider() {
  return &watcher_.GetProvider();
}

}  // namespace Ostinet

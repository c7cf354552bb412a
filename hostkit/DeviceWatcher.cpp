// SPDX-License-Identifier: MIT
#include "ostinet/hostkit/DeviceWatcher.h"

#include <exception>
#include <utility>

namespace Ostinet {

DeviceWatcher::DeviceWatcher(std::function<void()> afterwards)
    : afterwards_(std::move(afterwards)),
      subscription_(WatchDeviceChanges([this] { DevicesChanged(); })) {}

DeviceWatcher::~DeviceWatcher() { subscription_.Reset(); }

void DeviceWatcher::DevicesChanged() {
  try {
    listeners_.ForEach([](Impl::WinMIDIDevicesListener& listener) { listener.DevicesChanged(); });
  } catch (std::exception const&) {
    // The library answers the next change; there is nobody here to tell.
  }
  if (afterwards_) {
    afterwards_();
  }
}

}  // namespace Ostinet

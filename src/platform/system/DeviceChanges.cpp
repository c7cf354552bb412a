// SPDX-License-Identifier: MIT
#include "ostinet/DeviceChanges.h"

#include "platform/system/System.h"

namespace Ostinet {

DeviceChangeSubscription WatchDeviceChanges(std::function<void()> changed) {
  return DeviceChangeSubscription(Impl::CurrentSystem()->WatchDeviceChanges(std::move(changed)));
}

}  // namespace Ostinet

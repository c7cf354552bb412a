// SPDX-License-Identifier: MIT
#include <gtest/gtest.h>

#include "ostinet/DeviceChanges.h"
#include "ostinet/SimulatedMIDI.h"

namespace Ostinet {
namespace {

TEST(DeviceChanges, ASubscriptionHearsOfChangesUntilItIsReset) {
  SimulatedMIDI const studio;
  studio.Install();
  int calls = 0;
  DeviceChangeSubscription subscription = WatchDeviceChanges([&calls] { ++calls; });
  EXPECT_TRUE(subscription.IsActive());
  SimulatedPort port;
  port.name = "Keys";
  studio.AddPort(port);
  EXPECT_EQ(calls, 1);
  DeviceChangeSubscription moved = std::move(subscription);
  studio.RenamePort("Keys", "Pads");
  EXPECT_EQ(calls, 2);
  moved.Reset();
  EXPECT_FALSE(moved.IsActive());
  studio.RemovePort("Pads");
  EXPECT_EQ(calls, 2);
  studio.Remove();
}

TEST(DeviceChanges, ANullSubscriptionIsHarmless) {
  DeviceChangeSubscription subscription;
  EXPECT_FALSE(subscription.IsActive());
  subscription.Reset();
}

}  // namespace
}  // namespace Ostinet

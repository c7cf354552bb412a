// SPDX-License-Identifier: MIT
#include "ostinet/DeviceChanges.h"
#include "system/SimulatedTest.h"

namespace Ostinet::Impl::Simulated {
namespace {

class DeviceChanges : public SimulatedTest {
 protected:
  DeviceChangeSubscription Watch() {
    return studio_.WatchDevices([this] { ++count_; });
  }
  int count_ = 0;
};

TEST_F(DeviceChanges, EachChangeOfAPortIsTold) {
  auto const watching = Watch();
  studio_.AddPort(PortOf("A", PortKind::kWinMMOut));
  studio_.RenamePort("A", "B");
  studio_.DuplicatePort("B");
  studio_.RemovePort("B");
  EXPECT_EQ(count_, 4);
}

TEST_F(DeviceChanges, WhatChangesNothingIsNotTold) {
  auto const watching = Watch();
  studio_.RemovePort("A");
  studio_.RenamePort("A", "B");
  studio_.AddCable("A", "B");
  EXPECT_EQ(count_, 0);
}

TEST_F(DeviceChanges, TellingCanBeLeftToTheHost) {
  auto const watching = Watch();
  studio_.SetNotifying(false);
  studio_.AddPort(PortOf("A", PortKind::kWinMMOut));
  EXPECT_EQ(count_, 0);
  studio_.NotifyDevicesChanged();
  EXPECT_EQ(count_, 1);
}

TEST_F(DeviceChanges, NobodyIsToldAfterTheSubscriptionEnds) {
  auto watching = Watch();
  watching.Reset();
  studio_.AddPort(PortOf("A", PortKind::kWinMMOut));
  EXPECT_EQ(count_, 0);
}

TEST_F(DeviceChanges, TheLibrarysSubscriptionLeadsToTheInstalledStudio) {
  studio_.Install();
  {
    auto const watching = WatchDeviceChanges([this] { ++count_; });
    EXPECT_TRUE(watching.IsActive());
    studio_.AddPort(PortOf("A", PortKind::kWinMMOut));
    EXPECT_EQ(count_, 1);
  }
  studio_.Remove();
}

}  // namespace
}  // namespace Ostinet::Impl::Simulated

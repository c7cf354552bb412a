// SPDX-License-Identifier: MIT
#include <gtest/gtest.h>

#include "ostinet/SimulatedMIDI.h"
#include "ostinet/hostkit/HostCallbacks.h"

namespace Ostinet {
namespace {

class Callbacks : public testing::Test {
 protected:
  Callbacks() { studio.Install(); }
  ~Callbacks() override { studio.Remove(); }

  SimulatedMIDI studio;
};

TEST_F(Callbacks, AreInstalledAsLongAsTheyLive) {
  EXPECT_EQ(OstinetCallbackAPI::gInstance, nullptr);
  {
    HostCallbacks callbacks;
    EXPECT_EQ(OstinetCallbackAPI::gInstance, &callbacks);
    EXPECT_EQ(callbacks.GetDevicesProvider(), &callbacks.GetDeviceWatcher().GetProvider());
  }
  EXPECT_EQ(OstinetCallbackAPI::gInstance, nullptr);
}

TEST_F(Callbacks, LeaveAnotherHostsCallbacksAlone) {
  HostCallbacks other;
  {
    HostCallbacks callbacks;
    OstinetCallbackAPI::gInstance = &other;
  }
  EXPECT_EQ(OstinetCallbackAPI::gInstance, &other);
}

TEST_F(Callbacks, CountSamplesFromTheRate) {
  HostCallbacks callbacks(nullptr, HostCallbacks::AtRate(44100));
  EXPECT_DOUBLE_EQ(callbacks.GetSampleTime(0), 0);
  EXPECT_DOUBLE_EQ(callbacks.GetSampleTime(10000000), 44100);
  EXPECT_DOUBLE_EQ(HostCallbacks().GetSampleTime(5000000), 24000);
}

TEST_F(Callbacks, PassDeviceChangesOnToTheHost) {
  int told = 0;
  HostCallbacks callbacks([&] { ++told; });
  studio.NotifyDevicesChanged();
  EXPECT_EQ(told, 1);
}

}  // namespace
}  // namespace Ostinet

// SPDX-License-Identifier: MIT
#include <gtest/gtest.h>

#include <atomic>
#include <stdexcept>

#include "ostinet/SimulatedMIDI.h"
#include "ostinet/hostkit/DeviceWatcher.h"

namespace Ostinet {
namespace {

class Listener : public Impl::WinMIDIDevicesListener {
 public:
  ~Listener() override { LeaveProviders(); }
  void DevicesChanged() override {
    ++calls;
    if (throws) {
      throw std::runtime_error("listener");
    }
  }
  std::atomic<int> calls{0};
  bool throws = false;
};

class Watching : public testing::Test {
 protected:
  Watching() {
    studio.SetNotifying(false);
    studio.Install();
  }
  ~Watching() override { studio.Remove(); }

  // Returns when all listeners have been called.
  void Change() { studio.NotifyDevicesChanged(); }

  SimulatedMIDI studio;
  Listener listener;
};

TEST_F(Watching, TellsTheListenersOfChanges) {
  DeviceWatcher watcher;
  ASSERT_TRUE(watcher.IsWatching());
  watcher.GetProvider().AddDependent(listener);
  Change();
  EXPECT_EQ(listener.calls, 1);
  Change();
  EXPECT_EQ(listener.calls, 2);
}

TEST_F(Watching, CallsTheHostAfterTheListeners) {
  int heardBefore = -1;
  DeviceWatcher watcher([&] { heardBefore = listener.calls; });
  watcher.GetProvider().AddDependent(listener);
  Change();
  EXPECT_EQ(heardBefore, 1);
}

TEST_F(Watching, EndsWithTheWatcher) {
  {
    DeviceWatcher watcher;
    watcher.GetProvider().AddDependent(listener);
  }
  Change();
  EXPECT_EQ(listener.calls, 0);
}

TEST_F(Watching, OutlivesItsListeners) {
  int told = 0;
  DeviceWatcher watcher([&] { ++told; });
  {
    Listener brief;
    watcher.GetProvider().AddDependent(brief);
  }
  Change();
  EXPECT_EQ(told, 1);
}

TEST_F(Watching, DropsWhatAListenerThrows) {
  int told = 0;
  DeviceWatcher watcher([&] { ++told; });
  watcher.GetProvider().AddDependent(listener);
  listener.throws = true;
  EXPECT_NO_THROW(Change());
  EXPECT_EQ(told, 1);
}

TEST_F(Watching, TellsByHandToo) {
  DeviceWatcher watcher;
  watcher.GetProvider().AddDependent(listener);
  watcher.DevicesChanged();
  EXPECT_EQ(listener.calls, 1);
}

}  // namespace
}  // namespace Ostinet

// SPDX-License-Identifier: MIT
#pragma once

#include "support/Recorders.h"
#include "support/TestSetup.h"

namespace Ostinet::Testing {

/// A studio in its first state, with a listener.
class StudioTest : public ::testing::Test {
 protected:
  StudioTest() {
    setup.Reset();
    setup.SetListener(&listener);
  }
  ~StudioTest() override { setup.Reset(); }

  RecordingListener listener;
  MemoryPrefs prefs;
  TestSetup& setup = TestSetup::Get();
};

}  // namespace Ostinet::Testing

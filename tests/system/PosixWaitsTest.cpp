// SPDX-License-Identifier: MIT
#include <gtest/gtest.h>

#include <thread>

#include "platform/system/SystemWaits.h"

namespace Ostinet::Impl {
namespace {

// Windows leaves it open what such a waiter sees; here it fails at once instead of for ever.
TEST(SystemWaitsThreads, ClosingAnObjectEndsTheWaitForIt) {
  auto const waits = MakeSystemWaits();
  HANDLE const objects[] = {waits->CreateSemaphoreW(0, 1), waits->CreateSemaphoreW(0, 1)};
  DWORD result = 0;
  std::thread waiter([&] { result = waits->WaitForMultipleObjects(2, objects, INFINITE); });
  waits->CloseHandle(objects[1]);
  waiter.join();
  EXPECT_EQ(result, WAIT_FAILED);
  waits->CloseHandle(objects[0]);
}

}  // namespace
}  // namespace Ostinet::Impl

// SPDX-License-Identifier: MIT
#include "platform/system/SystemWaits.h"

namespace Ostinet::Impl {

namespace {

class WindowsWaits final : public Waits {
 public:
  HANDLE CreateSemaphoreW(LONG initial, LONG maximum) override {
    return ::CreateSemaphoreW(nullptr, initial, maximum, nullptr);
  }
  BOOL ReleaseSemaphore(HANDLE semaphore, LONG count) override {
    return ::ReleaseSemaphore(semaphore, count, nullptr);
  }
  HANDLE CreateEventW() override { return ::CreateEventW(nullptr, FALSE, FALSE, nullptr); }
  BOOL SetEvent(HANDLE event) override { return ::SetEvent(event); }
  HANDLE CreateWaitableTimerW() override { return ::CreateWaitableTimerW(nullptr, TRUE, nullptr); }
  BOOL SetWaitableTimer(HANDLE timer, LONGLONG due) override {
    LARGE_INTEGER time;
    time.QuadPart = due;
    return ::SetWaitableTimer(timer, &time, 0, nullptr, nullptr, FALSE);
  }
  DWORD WaitForSingleObject(HANDLE object, DWORD milliseconds) override {
    return ::WaitForSingleObject(object, milliseconds);
  }
  DWORD WaitForMultipleObjects(DWORD count, HANDLE const* objects, DWORD milliseconds) override {
    return ::WaitForMultipleObjects(count, objects, FALSE, milliseconds);
  }
  BOOL CloseHandle(HANDLE object) override { return ::CloseHandle(object); }
  DWORD GetLastError() override { return ::GetLastError(); }
};

}  // namespace

std::unique_ptr<Waits> MakeSystemWaits() { return std::make_unique<WindowsWaits>(); }

}  // namespace Ostinet::Impl

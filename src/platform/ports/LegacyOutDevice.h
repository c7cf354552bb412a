// SPDX-License-Identifier: MIT
#pragma once

#include <atomic>
#include <memory>
#include <thread>

#include "core/Mutex.h"
#include "ostinet/TimeStamp.h"
#include "platform/Session.h"
#include "platform/ports/PacketRing.h"

namespace Ostinet::Impl {

/// One output device of WinMM, with the queue of packets that wait for their time and the thread
/// that sends them. Shared by its port object and by senders; once closed it sends nothing.
///
/// Threads  Open and Close on the polling thread, SendPacket on any.
class LegacyOutDevice : public std::enable_shared_from_this<LegacyOutDevice> {
 public:
  /// The packets that may wait; one more is lost.
  static constexpr LONG kMostWaiting = 256;

  /// Starts the thread, which Close ends. Throws a VantorError when the system gives no semaphore
  /// or no thread.
  static std::shared_ptr<LegacyOutDevice> Make(std::shared_ptr<Session> session);
  ~LegacyOutDevice();
  LegacyOutDevice(LegacyOutDevice const&) = delete;
  LegacyOutDevice& operator=(LegacyOutDevice const&) = delete;

  /// A device that does not open leaves this one closed: IsOpen tells.
  void Open(UINT device);
  /// Ends the thread, waits for senders, and closes the device unless its reset fails: then the
  /// system keeps it open.
  void Close();
  bool IsOpen() const { return !isClosing_ && handle_ != nullptr; }

  /// Sends the packet now, or queues a copy of its bytes when its stamp lies ahead. [realtime]
  /// for short messages whose time has come; a stamp that lies ahead takes the queue's lock.
  void SendPacket(DataPacket const& packet);

 private:
  explicit LegacyOutDevice(std::shared_ptr<Session> session);
  static void CALLBACK OnMessage(HMIDIOUT handle, UINT message, DWORD_PTR instance, DWORD_PTR,
                                 DWORD_PTR);

  void Run();
  void SendNext(PacketRing::Packet& packet);
  bool WaitForItem();
  /// False when the wait was cut short because the device closes.
  bool WaitForTime(HANDLE timer);
  void Enqueue(DataPacket const& packet);
  TimeStamp FrontStamp();
  bool TakeFront(PacketRing::Packet& packet);
  void StopThread();
  void SendNow(unsigned char const* data, unsigned long long length);
  void SendLong(HMIDIOUT handle, unsigned char const* data, DWORD length);

  std::shared_ptr<Session> const session_;
  Waits& waits_;
  HANDLE itemsSemaphore_ = nullptr;
  HANDLE quitSemaphore_ = nullptr;

  // Cleared by the system's callback at closing, read by senders. A sender announces itself in
  // sending_ before it looks at isClosing_, and Close sets isClosing_ before it looks at
  // sending_; both orders are sequentially consistent, so one of the two sees the other.
  std::atomic<HMIDIOUT> handle_{nullptr};
  std::atomic<bool> isClosing_{false};
  std::atomic<int> sending_{0};

  VantorMutexLite queueMutex_;
  PacketRing queue_ OSTINET_GUARDED_BY(queueMutex_);
  std::thread thread_;
};

}  // namespace Ostinet::Impl

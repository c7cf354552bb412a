// SPDX-License-Identifier: MIT
#pragma once

#include <atomic>
#include <memory>
#include <vector>

#include "datapath/PacketQueue.h"
#include "platform/Session.h"

namespace Ostinet::Impl {

/// One input device of WinMM: its long-message buffers, the callback on the system's thread, and
/// the queue between that and the poll.
///
/// Threads  Open, SetTarget, Close and Drain on the polling thread; the callback on the system's,
///          where it takes no lock and, for short messages, no memory once warm.
class LegacyInDevice : public std::enable_shared_from_this<LegacyInDevice> {
 public:
  static constexpr DWORD kBufferBytes = 256;
  static constexpr std::size_t kBufferCount = 32;

  explicit LegacyInDevice(std::shared_ptr<Session> session);
  ~LegacyInDevice();
  LegacyInDevice(LegacyInDevice const&) = delete;
  LegacyInDevice& operator=(LegacyInDevice const&) = delete;

  /// Opens and starts the system's device of that index. No failure is told: a device that does
  /// not open delivers nothing, a buffer that cannot be prepared is left out.
  void Open(UINT device);
  /// Whose input this is, and who filters it; all input before is dropped. Once, after Open.
  void SetTarget(Source const& source, Receiver* receiver);
  /// Stops input, waits for the callback, and lets go of the target.
  void Close();
  void Drain();

 private:
  struct Target {
    Source source;
    Receiver* receiver = nullptr;  // the host's
  };

  static void CALLBACK OnMessage(HMIDIIN handle, UINT message, DWORD_PTR instance,
                                 DWORD_PTR parameter1, DWORD_PTR parameter2);
  void AddBuffers();
  void UnprepareBuffers();
  void OnShortMessage(DWORD message, DWORD milliseconds);
  void OnLongMessage(MIDIHDR& header, DWORD milliseconds);
  void Keep(unsigned char const* data, DWORD length, DWORD milliseconds) noexcept;

  std::shared_ptr<Session> const session_;
  PacketQueue queue_;
  std::vector<char> bufferBytes_;
  std::vector<MIDIHDR> headers_;
  HMIDIIN bufferDevice_ = nullptr;        // as it was when the buffers were added
  std::atomic<HMIDIIN> handle_{nullptr};  // cleared by the callback at closing
  // Stored before input starts, read by the callback; the start of the device orders the two.
  double startEventTime_ = 0;

  // The callback counts itself in before it loads target_, and Close clears target_ before it
  // looks at the count; both sequentially consistent, so no callback keeps what Close frees.
  std::atomic<int> inUseCount_{0};
  std::atomic<Target*> target_{nullptr};
  std::unique_ptr<Target> ownedTarget_;
};

}  // namespace Ostinet::Impl

// SPDX-License-Identifier: MIT
#pragma once

#include <atomic>
#include <cstdint>
#include <deque>
#include <functional>
#include <memory>
#include <mutex>
#include <semaphore>
#include <thread>
#include <vector>

#include "platform/system/WindowsTypes.h"
#include "platform/system/native/DeviceCallback.h"
#include "platform/system/native/MessageRing.h"
#include "platform/system/native/MidiService.h"

namespace Ostinet::Impl {

/// An open WinMM input over a port of the machine.
///
/// The service's realtime thread only stamps a message and puts it in a ring; a thread of this
/// device's own hands it to the host, whose callback may take its time.
///
/// Threads  Any. The host's callback is called without a lock, so it may call back.
class NativeInput {
 public:
  /// Opens the wire that brings messages to the sink; null on failure.
  using Opener = std::function<std::unique_ptr<InputWire>(InputSink)>;

  explicit NativeInput(DeviceCallback callback);
  ~NativeInput();
  NativeInput(NativeInput const&) = delete;
  NativeInput& operator=(NativeInput const&) = delete;

  /// False when the port does not open.
  bool Open(HMIDIIN handle, Opener const& open);
  /// MIDIERR_STILLPLAYING while buffers wait in the device, or from within its callback.
  MMRESULT Close();
  MMRESULT Start();
  MMRESULT Stop();
  /// Stops, and gives all buffers back empty, in their order.
  MMRESULT Reset();
  MMRESULT AddBuffer(MIDIHDR* header, UINT size);

 private:
  void TakeFromService(unsigned char const* bytes, std::size_t count);
  void Run();
  void Deliver(std::uint32_t time, std::vector<unsigned char> const& bytes);
  void DeliverLong(std::uint32_t time, std::vector<unsigned char> const& bytes);
  MIDIHDR* TakeBuffer();
  void GiveBack(MIDIHDR* header, DWORD recorded, std::uint32_t time);

  DeviceCallback const callback_;
  HMIDIIN handle_ = nullptr;
  // Microseconds of the steady clock at the last start; negative while stopped. Stored by the
  // host's thread, loaded by the service's; a message on the border may fall on either side.
  std::atomic<std::int64_t> startedAt_{-1};
  MessageRing ring_;
  std::counting_semaphore<> arrived_{0};
  std::atomic<bool> ending_{false};
  // Held while the host's callback runs, so that a stop waits for it; recursive because the
  // callback may stop its device itself. Before mutex_.
  std::recursive_mutex delivering_;
  std::mutex mutex_;
  std::deque<MIDIHDR*> buffers_;  // guarded by mutex_; the host's
  std::thread thread_;
  std::unique_ptr<InputWire> wire_;  // last: the flow ends first
};

}  // namespace Ostinet::Impl

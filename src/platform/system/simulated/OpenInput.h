// SPDX-License-Identifier: MIT
#pragma once

// An input device that WinMM has open. Bytes that arrive become messages, and those are told to
// the host by a thread of the device's own, in order; the studio's mutex guards everything here
// and is never held while the host's callback runs.

#include <condition_variable>
#include <cstdint>
#include <deque>
#include <thread>
#include <vector>

#include "platform/system/WindowsTypes.h"
#include "platform/system/simulated/StreamParser.h"
#include "platform/system/simulated/Studio.h"

namespace Ostinet::Impl::Simulated {

class OpenInput final : public InputSink, private StreamParser::Sink {
 public:
  using Callback = void CALLBACK(HMIDIIN, UINT, DWORD_PTR, DWORD_PTR, DWORD_PTR);

  OpenInput(Studio& studio, PortPtr port, HMIDIIN handle, Callback* callback, DWORD_PTR instance);
  ~OpenInput();

  // All with the studio's mutex held; those that take the lock give it up while they wait for the
  // device's thread, and do not wait when that is the thread that calls.

  /// Tells MIM_OPEN and waits until the host has heard it.
  void Open(std::unique_lock<std::mutex>& lock);
  /// Tells MIM_CLOSE; when this returns the thread has ended and no callback comes any more.
  void Close(std::unique_lock<std::mutex>& lock);
  void Start();
  void Stop(std::unique_lock<std::mutex>& lock);
  void Reset(std::unique_lock<std::mutex>& lock);
  void AddBuffer(MIDIHDR* header);
  bool HasBuffers() const { return !buffers_.empty(); }
  bool IsIdle() const { return pending_.empty() && !calling_; }
  bool IsOwnThread() const { return thread_.get_id() == std::this_thread::get_id(); }
  Port const& GetPort() const { return *port_; }

  void Take(std::uint8_t const* bytes, std::size_t size) override;

 private:
  struct Message {
    UINT message;
    DWORD_PTR param1;
    DWORD_PTR param2;
  };

  void Short(std::uint8_t const (&bytes)[3], int length) override;
  void SysexByte(std::uint8_t byte) override;
  void SysexEnd(bool whole) override;
  void Stray(std::uint8_t byte) override;

  void Tell(UINT message, DWORD_PTR param1);
  void GiveBack(UINT message);
  void WaitUntilTold(std::unique_lock<std::mutex>& lock);
  void Run();

  Studio& studio_;
  PortPtr const port_;
  HMIDIIN const handle_;
  Callback* const callback_;
  DWORD_PTR const instance_;

  StreamParser parser_;
  bool started_ = false;
  std::int64_t startTime_ = 0;
  std::deque<MIDIHDR*> buffers_;
  std::vector<Message> pending_;
  bool calling_ = false;
  bool quit_ = false;
  std::condition_variable work_;
  std::thread thread_;
};

}  // namespace Ostinet::Impl::Simulated

// SPDX-License-Identifier: MIT
#pragma once

#include <condition_variable>
#include <cstddef>
#include <cstdint>
#include <memory>
#include <mutex>
#include <thread>
#include <vector>

#include "platform/system/native/MidiService.h"
#include "platform/system/native/NoteMemory.h"

namespace Ostinet::Impl {

/// Carries messages from any thread to one port at the port's own pace, on a thread of its own.
///
/// Ownership  Owns its wire.
/// Threads    Any. No call waits for the port but Finish, and that for a bounded time.
/// Errors     Push gives false where the message is not taken: the service has gone, or more waits
///            already than kMaxWaiting bytes.
class OutputLane {
 public:
  /// Enough for the longest dumps of instruments, little enough for a port that stands still.
  static constexpr std::size_t kMaxWaiting = 4U << 20;

  explicit OutputLane(std::unique_ptr<OutputWire> wire);
  /// Drops what still waits.
  ~OutputLane();
  OutputLane(OutputLane const&) = delete;
  OutputLane& operator=(OutputLane const&) = delete;

  /// `bytes` may hold several messages; they are copied.
  bool Push(unsigned char const* bytes, std::size_t count);
  /// Drops what waits, and ends the notes that sound.
  void Silence();
  /// Waits until all is sent, at most `milliseconds`.
  void Finish(unsigned milliseconds);

 private:
  using Bytes = std::vector<unsigned char>;

  void Run();
  void SendBlocks(Bytes const& blocks);
  void SendMessage(unsigned char const* bytes, std::size_t count);
  bool SendPieces(unsigned char const* bytes, std::size_t count);
  void SendReleases();
  bool IsInterrupted();
  void GiveUpWaiting();

  std::unique_ptr<OutputWire> const wire_;
  NoteMemory notes_;          // of the lane's thread alone
  bool standsStill_ = false;  // likewise: the wire refused a message of the present blocks

  std::mutex mutex_;
  std::condition_variable changed_;
  Bytes waiting_;  // blocks, each behind its size; guarded by mutex_, as is all below
  bool silencing_ = false;
  bool sending_ = false;
  bool ending_ = false;

  std::thread thread_;  // last: it uses all of the above
};

}  // namespace Ostinet::Impl

// SPDX-License-Identifier: MIT
#pragma once

#include <condition_variable>
#include <list>
#include <mutex>
#include <string>
#include <vector>

#include "platform/system/System.h"

namespace Ostinet::Testing {

/// What the library above the seam does with one input: keeps 256-byte buffers in it and takes what
/// comes.
class InputHost {
 public:
  struct Piece {
    std::vector<unsigned char> bytes;
    DWORD time = 0;
    bool isLong = false;
  };

  InputHost(Impl::System& system, UINT device, int buffers = 32);
  ~InputHost() { Close(); }

  MMRESULT OpenResult() const { return opened_; }
  HMIDIIN Handle() const { return handle_; }
  /// Stops, resets, closes; the result of closing.
  MMRESULT Close();
  /// All pieces so far, once they are at least `count` or half a minute has passed.
  std::vector<Piece> WaitForPieces(std::size_t count);
  /// Messages other than data, in their order.
  std::vector<UINT> Events();

 private:
  static void CALLBACK OnMessage(HDRVR handle, UINT message, DWORD_PTR self, DWORD_PTR param1,
                                 DWORD_PTR param2);
  void Take(UINT message, DWORD_PTR param1, DWORD_PTR param2);

  Impl::System& system_;
  HMIDIIN handle_ = nullptr;
  MMRESULT opened_ = 0;
  struct Buffer {
    MIDIHDR header{};
    char bytes[256] = {};
  };
  std::list<Buffer> buffers_;
  std::mutex mutex_;
  std::condition_variable arrived_;
  std::vector<Piece> pieces_;
  std::vector<UINT> events_;
};

/// The numbers of the devices that are there, by name; -1 when there is none.
int FindOutput(Impl::System& system, std::u16string const& name);
int FindInput(Impl::System& system, std::u16string const& name);
std::vector<std::u16string> OutputNames(Impl::System& system);
std::vector<std::u16string> InputNames(Impl::System& system);

/// Prepares, sends and unprepares; the result of sending.
MMRESULT SendLong(Impl::System& system, HMIDIOUT output, std::vector<unsigned char> bytes);

}  // namespace Ostinet::Testing

// SPDX-License-Identifier: MIT
#pragma once

#include <array>
#include <atomic>

#include "ostinet/TimeStamp.h"

namespace Ostinet::Impl {

/// Follows the bank selects and program changes that go out to one destination.
///
/// Threads  Track runs on whatever thread sends; the rest on the polling thread. Each field is an
///          atomic of its own: a reader wants the newest patch, not a consistent triple.
class ChannelPatchState : public RCObjectMT<ChannelPatchState> {
 public:
  struct Patch {
    unsigned char program, bankMSB, bankLSB;  // 255: nothing was sent
  };

  /// Scans the packet. The scan starts anew with each packet; a bank that was selected in an
  /// earlier one still counts. [realtime]
  void Track(DataPacket const& packet);
  /// The patch last committed on `channel`, 0 to 15; all 255 for any other channel.
  Patch GetPatch(int channel) const;
  /// Bit n: a program change was sent on channel n since the last call.
  unsigned short TakeChangedChannels();

 private:
  struct Record {
    void Commit(unsigned char newProgram);

    std::atomic<unsigned> changed{0};  // stored by the sender, taken by the polling thread
    std::atomic<unsigned char> pendingMSB{255}, pendingLSB{255};
    std::atomic<unsigned char> program{255}, bankMSB{255}, bankLSB{255};
  };
  std::array<Record, 16> records_;
};

}  // namespace Ostinet::Impl

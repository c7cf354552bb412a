// SPDX-License-Identifier: MIT

// DMusSender: from packets to DirectMusic's buffers.
//
// A packet is cut behind each status byte but its first, so a sysex is one piece, and a short
// message is one piece only if it stands alone in its packet: of 90 3C 40 80 3C 00 come the
// pieces 90 3C 40 80 and 3C 00. A long sysex is cut to what a buffer holds: its first chunk
// leaves room for the header of 20 bytes and the later ones, of up to 256 bytes, do not, so one
// that fills a buffer gets lost. Hosts know the limit of 236 bytes and send longer messages in
// several packets.

#include "platform/ports/DMusSender.h"

#include <algorithm>
#include <cstring>

#include "ostinet/core/Error.h"

namespace Ostinet::Impl {

namespace {

constexpr DWORD kHeaderBytes = 20;
constexpr DWORD kShortMessageBytes = 4;

/// What an event with `n` bytes of MIDI takes in a buffer: the header and padding included.
DWORD EventBytes(DWORD n) { return (n + 27u) & ~7u; }

/// The first four bytes of a piece, the status in the low byte; what the piece has not is 0.
DWORD WordOf(unsigned char const* data, unsigned long long length) {
  DWORD word = 0;
  for (unsigned i = 0; i < kShortMessageBytes && i < length; ++i) {
    word |= static_cast<DWORD>(data[i]) << (8 * i);
  }
  return word;
}

}  // namespace

/// Packs the pieces of one packet, all for one time.
class DMusSender::Packer {
 public:
  Packer(DMusSender& sender, REFERENCE_TIME time, unsigned char const* packetEnd)
      : sender_(sender),
        buffer_(*sender.loan_->buffer.get()),
        time_(time),
        end_(packetEnd),
        used_(sender.bufferUsed_),
        max_(sender.bufferMax_) {}

  void Pack(unsigned char const* piece, unsigned long long length) {
    bool const isSysex = *piece == 0xF0;
    unsigned long long const total = isSysex ? length : kShortMessageBytes;
    unsigned long long start = 0;
    unsigned long long stop = std::min<unsigned long long>(total, max_ - kHeaderBytes);
    while (start < total) {
      auto const n = static_cast<DWORD>(stop - start);
      MakeRoom(EventBytes(n));
      auto const left = static_cast<unsigned long long>(end_ - piece) - start;
      sender_.NotePacked(
          isSysex ? buffer_.PackUnstructured(time_, 0, n, const_cast<BYTE*>(piece + start))
                  : buffer_.PackStructured(time_, 0, WordOf(piece + start, left)),
          EventBytes(n));
      start = stop;
      stop = std::min<unsigned long long>(total, stop + max_);
    }
  }

 private:
  void MakeRoom(DWORD bytes) {
    if (max_ - used_ < bytes) {
      sender_.PlayAndFlush();
      used_ = 0;
    }
    used_ += bytes;
  }

  DMusSender& sender_;
  IDirectMusicBuffer& buffer_;
  REFERENCE_TIME const time_;
  unsigned char const* const end_;
  DWORD used_;  // with what did not get through: room is planned for each piece
  DWORD const max_;
};

DMusSender::DMusSender(RCPtrMT<ChannelPatchState> const& tracker, std::shared_ptr<DMusLine> line)
    : TrackingSender(tracker), line_(std::move(line)) {
  if (!line_) {
    return;
  }
  line_->port->GetLatencyClock(latencyClock_.Receive());
  try {
    loan_ = BufferPool::Borrow(line_->session->Pool());
  } catch (VantorError const&) {
    return;  // no buffer: CanSend tells
  }
  loan_->buffer->GetUsedBytes(&bufferUsed_);
  loan_->buffer->GetMaxBytes(&bufferMax_);
}

DMusSender::~DMusSender() {
  // What was not flushed is not sent; nor may it reach the port of the next borrower.
  if (loan_) {
    loan_->buffer->Flush();
  }
}

bool DMusSender::CanSend() const { return line_ && line_->isOpen && latencyClock_ && loan_; }

void DMusSender::Transmit(DataPacket const& packet) {
  if (!CanSend()) {
    return;
  }
  auto time = static_cast<REFERENCE_TIME>(packet.stamp.AsMIDITime().Value());
  if (time == 0) {
    latencyClock_->GetTime(&time);
  }
  unsigned char const* const end = packet.data + packet.length;
  unsigned char const* start = packet.data;
  Packer packer(*this, time, end);
  for (unsigned char const* p = packet.data; p != end; ++p) {
    if (p != start && *p >= 0x80) {
      packer.Pack(start, static_cast<unsigned long long>(p + 1 - start));
      start = p + 1;
    }
  }
  if (start != end) {
    packer.Pack(start, static_cast<unsigned long long>(end - start));
  }
}

void DMusSender::Flush() {
  if (!CanSend()) {
    return;
  }
  if (bufferUsed_ > 0) {
    PlayAndFlush();
  }
}

void DMusSender::NotePacked(HRESULT result, DWORD bytes) {
  if (result == S_OK) {
    bufferUsed_ += bytes;
  } else {
    loan_->buffer->GetUsedBytes(&bufferUsed_);
  }
}

void DMusSender::PlayAndFlush() {
  line_->port->PlayBuffer(loan_->buffer.get());
  if (loan_->buffer->Flush() == S_OK) {
    bufferUsed_ = 0;
  }
}

}  // namespace Ostinet::Impl

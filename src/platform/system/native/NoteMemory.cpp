// SPDX-License-Identifier: MIT
#include "platform/system/native/NoteMemory.h"

namespace Ostinet::Impl {

constexpr unsigned char kNoteOff = 0x80;
constexpr unsigned char kNoteOn = 0x90;
constexpr unsigned char kControlChange = 0xB0;
constexpr unsigned char kSustainPedal = 64;
constexpr unsigned char kPedalDown = 64;

void NoteMemory::Note(unsigned char const* bytes, std::size_t count) {
  if (count != 3) return;
  std::size_t const channel = bytes[0] & 0x0F;
  std::size_t const number = bytes[1] & 0x7F;
  switch (bytes[0] & 0xF0) {
    case kNoteOn:
      sounding_[channel][number] = bytes[2] != 0;
      break;
    case kNoteOff:
      sounding_[channel][number] = false;
      break;
    case kControlChange:
      if (number == kSustainPedal) sustained_[channel] = bytes[2] >= kPedalDown;
      break;
    default:
      break;
  }
}

void NoteMemory::Release(std::function<void(unsigned char const* bytes)> const& send) {
  for (std::size_t channel = 0; channel < sounding_.size(); ++channel) {
    for (std::size_t note = 0; note < 128; ++note) {
      if (!sounding_[channel][note]) continue;
      unsigned char const off[3] = {static_cast<unsigned char>(kNoteOff | channel),
                                    static_cast<unsigned char>(note), 64};
      send(off);
    }
    if (sustained_[channel]) {
      unsigned char const up[3] = {static_cast<unsigned char>(kControlChange | channel),
                                   kSustainPedal, 0};
      send(up);
    }
  }
  sounding_ = {};
  sustained_.reset();
}

}  // namespace Ostinet::Impl

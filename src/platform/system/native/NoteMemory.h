// SPDX-License-Identifier: MIT
#pragma once

#include <array>
#include <bitset>
#include <cstddef>
#include <functional>

namespace Ostinet::Impl {

/// What sounds on a port, so that a reset can end just that.
class NoteMemory {
 public:
  /// Remembers a short message of `count` bytes.
  void Note(unsigned char const* bytes, std::size_t count);
  /// Gives a note-off for each sounding note and a pedal-up for each held sustain pedal, as three
  /// bytes each, and forgets them.
  void Release(std::function<void(unsigned char const* bytes)> const& send);

 private:
  std::array<std::bitset<128>, 16> sounding_;
  std::bitset<16> sustained_;
};

}  // namespace Ostinet::Impl

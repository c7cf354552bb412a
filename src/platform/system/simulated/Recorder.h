// SPDX-License-Identifier: MIT
#pragma once

#include <array>
#include <cstdint>
#include <string>
#include <vector>

#include "ostinet/SimulatedMIDI.h"

namespace Ostinet::Impl::Simulated {

/// What left through the outputs, the newest `capacity` messages. Once its room is made, a message
/// of up to 24 bytes costs no allocation.
///
/// Threads  Guarded by the studio's mutex.
class Recorder {
 public:
  static constexpr std::size_t kDefaultCapacity = 65536;
  static constexpr std::size_t kInlineBytes = 24;

  struct Times {
    std::int64_t handedOver;
    std::int64_t due;
    std::int64_t left;
  };

  void SetOn(bool on) { on_ = on; }
  /// Forgets everything and makes room at once.
  void Reserve(std::size_t capacity);
  void Clear();
  /// `port` must outlive the record; the studio never forgets a port's names.
  void Add(std::string const& port, std::uint8_t const* bytes, std::size_t size,
           Times const& times);
  /// Oldest first; of one port, or of all when null.
  std::vector<SimulatedMessage> Read(std::string const* port) const;

 private:
  struct Entry {
    std::string const* port = nullptr;
    std::size_t size = 0;
    std::array<std::uint8_t, kInlineBytes> inlineBytes{};
    std::vector<std::uint8_t> moreBytes;  // instead, of a longer message
    Times times{};
  };

  bool on_ = true;
  std::size_t capacity_ = kDefaultCapacity;
  std::size_t oldest_ = 0;  // once entries_ is full
  std::size_t count_ = 0;
  std::vector<Entry> entries_;
};

}  // namespace Ostinet::Impl::Simulated

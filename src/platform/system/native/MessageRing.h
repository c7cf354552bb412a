// SPDX-License-Identifier: MIT
#pragma once

#include <atomic>
#include <cstddef>
#include <cstdint>
#include <memory>
#include <vector>

namespace Ostinet::Impl {

/// Messages with their time, from a realtime thread to another. One thread pushes, one pops; no
/// lock, and pushing allocates nothing.
class MessageRing {
 public:
  /// A burst of the longest usual dump fits.
  static constexpr std::size_t kCapacity = 256U << 10;

  MessageRing();

  /// False, and nothing is taken, when there is no room. [realtime]
  bool Push(std::uint32_t time, unsigned char const* bytes, std::size_t count);
  /// False when it is empty.
  bool Pop(std::uint32_t& time, std::vector<unsigned char>& bytes);

 private:
  struct Head {
    std::uint32_t time;
    std::uint32_t count;
  };

  void Copy(std::size_t at, void const* from, std::size_t count);
  void CopyOut(std::size_t at, void* to, std::size_t count) const;

  std::unique_ptr<unsigned char[]> const bytes_;
  // Running totals. Each is stored by one side with release, after it is done with the bytes, and
  // loaded by the other with acquire, before it touches them.
  std::atomic<std::size_t> pushed_{0};
  std::atomic<std::size_t> popped_{0};
};

}  // namespace Ostinet::Impl

// SPDX-License-Identifier: MIT
#pragma once

#include <cstddef>
#include <memory>

#include "datapath/SysexStorage.h"
#include "ostinet/Common.h"

namespace Ostinet::Impl {

/// One long message, in a buffer of the system with the event header ahead of it, so that it can
/// be played without a copy.
///
/// Threads  The count is atomic, the last one may fall on any thread. Nothing guards the bytes.
/// Errors   What makes storage throws a VantorError and leaves the message as it was.
class SysexImpl : public RCObjectMT<SysexImpl> {
 public:
  /// The event header's size: the message starts behind it.
  static constexpr std::size_t kHeaderBytes = 20;
  /// The header counts bytes in 32 bits, and the buffer is rounded up.
  static constexpr std::size_t kMaxBytes = 0xFFFFFFFFu - 27;

  /// A message of `size` bytes, 1 to kMaxBytes, with undefined contents.
  explicit SysexImpl(std::size_t size);

  unsigned char* begin() const { return begin_; }
  unsigned char* end() const { return end_; }
  std::size_t Size() const { return static_cast<std::size_t>(end_ - begin_); }
  std::size_t Capacity() const { return static_cast<std::size_t>(capacityEnd_ - begin_); }
  /// The buffer that the system plays.
  SysexStorage& Storage() const { return *storage_; }

  void Resize(std::size_t size);
  /// Puts `count` times `byte` before `offset`, 0 to Size().
  void Insert(std::size_t offset, std::size_t count, unsigned char byte);
  /// Takes `count` bytes away from `offset` on; all of them are there.
  void Erase(std::size_t offset, std::size_t count);

 private:
  void TakeStorage(std::unique_ptr<SysexStorage> storage, std::size_t capacity);
  void SetSize(std::size_t size);
  std::size_t GrownCapacity(std::size_t size) const;

  std::unique_ptr<SysexStorage> storage_;
  unsigned char* begin_ = nullptr;
  unsigned char* end_ = nullptr;
  unsigned char* capacityEnd_ = nullptr;
};

/// The size of the system's buffer for a message: header and bytes, rounded up to eight.
constexpr std::size_t SysexBufferBytes(std::size_t messageBytes) {
  return (messageBytes + 27) & ~std::size_t{7};
}

}  // namespace Ostinet::Impl

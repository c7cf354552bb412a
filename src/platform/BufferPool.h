// SPDX-License-Identifier: MIT
#pragma once

#include <memory>

#include "core/Atomics.h"
#include "platform/ComPtr.h"
#include "platform/system/System.h"

namespace Ostinet::Impl {

/// Makes one DirectMusic buffer of `bytes`, or throws a VantorError.
ComPtr<IDirectMusicBuffer> MakeMusicBuffer(IDirectMusic& directMusic, DWORD bytes);

/// The small DirectMusic buffers that senders and input drains borrow, on a lock-free stack.
///
/// Threads  Any. A sender kept beyond sign-out keeps the pool that it borrowed from alive.
class BufferPool {
 public:
  static constexpr DWORD kBufferBytes = 256;
  static constexpr int kInitialCount = 20;

  struct Entry {
    void* next = nullptr;  // the link of the stack: must stand first
    ComPtr<IDirectMusicBuffer> buffer;
  };
  /// Gives the entry back to its pool.
  struct Return {
    std::shared_ptr<BufferPool> pool;
    void operator()(Entry* entry) const { pool->Push(entry); }
  };
  using Loan = std::unique_ptr<Entry, Return>;

  /// Fills the pool; throws a VantorError when a buffer cannot be made.
  explicit BufferPool(ComPtr<IDirectMusic> directMusic);
  ~BufferPool();

  /// An entry for the caller alone; a new one when the pool is empty. Throws a VantorError when
  /// that cannot be made.
  static Loan Borrow(std::shared_ptr<BufferPool> const& pool);

 private:
  void Push(Entry* entry);
  Entry* Pop();
  std::unique_ptr<Entry> MakeEntry() const;

  ComPtr<IDirectMusic> const directMusic_;
  void* head_ = nullptr;  // the top of the stack
};

}  // namespace Ostinet::Impl

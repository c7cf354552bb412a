// SPDX-License-Identifier: MIT

#include "platform/BufferPool.h"

#include "ostinet/core/Error.h"

namespace Ostinet::Impl {

ComPtr<IDirectMusicBuffer> MakeMusicBuffer(IDirectMusic& directMusic, DWORD bytes) {
  DMUS_BUFFERDESC description{};
  description.dwSize = sizeof description;
  description.cbBuffer = bytes;
  ComPtr<IDirectMusicBuffer> buffer;
  FailWinError(directMusic.CreateMusicBuffer(&description, buffer.Receive(), nullptr));
  return buffer;
}

BufferPool::BufferPool(ComPtr<IDirectMusic> directMusic) : directMusic_(std::move(directMusic)) {
  try {
    for (int i = 0; i < kInitialCount; ++i) {
      Push(MakeEntry().release());
    }
  } catch (...) {
    while (Entry* const entry = Pop()) {
      delete entry;
    }
    throw;
  }
}

BufferPool::~BufferPool() {
  while (Entry* const entry = Pop()) {
    delete entry;
  }
}

BufferPool::Loan BufferPool::Borrow(std::shared_ptr<BufferPool> const& pool) {
  Entry* entry = pool->Pop();
  if (entry == nullptr) {
    entry = pool->MakeEntry().release();
  }
  return Loan(entry, Return{pool});
}

void BufferPool::Push(Entry* entry) { EnqueueAtomic(&head_, entry); }

BufferPool::Entry* BufferPool::Pop() { return static_cast<Entry*>(DequeueAtomic(&head_)); }

std::unique_ptr<BufferPool::Entry> BufferPool::MakeEntry() const {
  auto entry = std::make_unique<Entry>();
  entry->buffer = MakeMusicBuffer(*directMusic_.get(), kBufferBytes);
  return entry;
}

}  // namespace Ostinet::Impl

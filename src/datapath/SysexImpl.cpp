// SPDX-License-Identifier: MIT
#include "datapath/SysexImpl.h"

#include <algorithm>
#include <cstdint>
#include <cstring>
#include <utility>

#include "ostinet/core/Error.h"

namespace Ostinet {

template class RCPtrMT<Impl::SysexImpl>;

namespace Impl {
namespace {

// The header ahead of the message, as the system's player reads it, little-endian:
//
//   Offset  Size  Field           Value
//   0       4     cbEvent         the message's length
//   4       4     dwChannelGroup  0
//   8       8     rtDelta         0
//   16      4     dwFlags         0
//   20      n     the message
void WriteHeader(unsigned char* header, std::size_t messageBytes) {
  std::fill_n(header, SysexImpl::kHeaderBytes, static_cast<unsigned char>(0));
  auto const length = static_cast<std::uint32_t>(messageBytes);
  for (int i = 0; i < 4; ++i) {
    header[i] = static_cast<unsigned char>(length >> (8 * i));
  }
}

std::unique_ptr<SysexStorage> MakeStorageForMessage(std::size_t messageBytes) {
  if (messageBytes > SysexImpl::kMaxBytes) {
    FailMemFullError();
  }
  return MakeSysexStorage(SysexBufferBytes(messageBytes));
}

// std::memmove, but safe for the null pointers of no bytes at all.
void MoveBytes(unsigned char* to, unsigned char const* from, std::size_t count) {
  if (count > 0) {
    std::memmove(to, from, count);
  }
}

}  // namespace

SysexImpl::SysexImpl(std::size_t size) {
  TakeStorage(MakeStorageForMessage(size), size);
  SetSize(size);
}

void SysexImpl::TakeStorage(std::unique_ptr<SysexStorage> storage, std::size_t capacity) {
  storage_ = std::move(storage);
  begin_ = storage_->RawBytes() + kHeaderBytes;
  capacityEnd_ = begin_ + capacity;
}

void SysexImpl::SetSize(std::size_t size) {
  end_ = begin_ + size;
  WriteHeader(storage_->RawBytes(), size);
  storage_->SetUsedBytes(SysexBufferBytes(size));
}

void SysexImpl::Resize(std::size_t size) {
  if (size > Capacity()) {
    std::unique_ptr<SysexStorage> grown = MakeStorageForMessage(size);
    MoveBytes(grown->RawBytes() + kHeaderBytes, begin_, Size());
    TakeStorage(std::move(grown), size);
  }
  SetSize(size);
}

void SysexImpl::Insert(std::size_t offset, std::size_t count, unsigned char byte) {
  std::size_t const oldSize = Size();
  if (count > kMaxBytes - oldSize) {
    FailMemFullError();
  }
  std::size_t const tail = oldSize - offset;
  if (oldSize + count <= Capacity()) {
    MoveBytes(begin_ + offset + count, begin_ + offset, tail);
  } else {
    std::size_t const capacity = GrownCapacity(oldSize + count);
    std::unique_ptr<SysexStorage> grown = MakeStorageForMessage(capacity);
    unsigned char* const message = grown->RawBytes() + kHeaderBytes;
    MoveBytes(message, begin_, offset);
    MoveBytes(message + offset + count, begin_ + offset, tail);
    TakeStorage(std::move(grown), capacity);
  }
  std::fill_n(begin_ + offset, count, byte);
  SetSize(oldSize + count);
}

// Doubling, so that a message built byte by byte is not copied for each of them.
std::size_t SysexImpl::GrownCapacity(std::size_t size) const {
  std::size_t capacity = std::max<std::size_t>(Capacity(), 1);
  while (capacity < size) {
    capacity *= 2;
  }
  return std::min(capacity, kMaxBytes);
}

void SysexImpl::Erase(std::size_t offset, std::size_t count) {
  MoveBytes(begin_ + offset, begin_ + offset + count, Size() - offset - count);
  SetSize(Size() - count);
}

}  // namespace Impl
}  // namespace Ostinet

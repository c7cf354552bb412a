// SPDX-License-Identifier: MIT
#include "platform/system/native/MemoryMusicBuffer.h"

#include <algorithm>
#include <cstring>

#include "platform/system/native/MessageSplitter.h"

namespace Ostinet::Impl {
namespace {

constexpr DWORD kHeaderSize = sizeof(DMUS_EVENTHEADER);
constexpr DWORD kStatusBit = 0x80;

// In 64 bits, since a size from a raw buffer may be anything.
constexpr ULONGLONG RoomFor(DWORD size) { return (ULONGLONG{size} + 27) & ~ULONGLONG{7}; }
static_assert(RoomFor(4) == 24 && RoomFor(6) == 32);

template <class Value>
HRESULT Answer(Value* target, Value value) {
  if (target == nullptr) return E_POINTER;
  *target = value;
  return S_OK;
}

}  // namespace

MemoryMusicBuffer::MemoryMusicBuffer(DWORD size, GUID const& format)
    : format_(format), bytes_(size) {}

HRESULT MemoryMusicBuffer::Flush() {
  used_ = read_ = 0;
  start_ = total_ = 0;
  return S_OK;
}

HRESULT MemoryMusicBuffer::TotalTime(LPREFERENCE_TIME time) { return Answer(time, total_); }

HRESULT MemoryMusicBuffer::PackStructured(REFERENCE_TIME time, DWORD group, DWORD message) {
  if ((message & kStatusBit) == 0) return DMUS_E_INVALID_EVENT;
  BYTE const bytes[4] = {static_cast<BYTE>(message), static_cast<BYTE>(message >> 8),
                         static_cast<BYTE>(message >> 16), 0};
  auto const length = static_cast<DWORD>(std::max<std::size_t>(1, MessageLength(bytes[0])));
  return Append(time, group, DMUS_EVENT_STRUCTURED, bytes, length, sizeof bytes);
}

HRESULT MemoryMusicBuffer::PackUnstructured(REFERENCE_TIME time, DWORD group, DWORD size,
                                            LPBYTE data) {
  if (data == nullptr) return E_POINTER;
  return Append(time, group, 0, data, size, size);
}

HRESULT MemoryMusicBuffer::Append(REFERENCE_TIME time, DWORD group, DWORD flags, void const* data,
                                  DWORD size, DWORD room) {
  if (RoomFor(room) > bytes_.size() - used_) return DMUS_E_BUFFER_FULL;
  if (used_ == 0) start_ = time;
  DMUS_EVENTHEADER const header{size, group, time - start_, flags};
  std::memcpy(bytes_.data() + used_, &header, kHeaderSize);
  if (size > 0) std::memcpy(bytes_.data() + used_ + kHeaderSize, data, size);
  used_ += static_cast<DWORD>(RoomFor(room));
  total_ = std::max(total_, time - start_);
  return S_OK;
}

HRESULT MemoryMusicBuffer::ResetReadPtr() {
  read_ = 0;
  return S_OK;
}

HRESULT MemoryMusicBuffer::GetNextEvent(LPREFERENCE_TIME time, LPDWORD group, LPDWORD length,
                                        LPBYTE* data) {
  if (used_ - read_ < kHeaderSize) return S_FALSE;
  DMUS_EVENTHEADER header{};
  std::memcpy(&header, bytes_.data() + read_, kHeaderSize);
  DWORD const room = (header.dwFlags & DMUS_EVENT_STRUCTURED) != 0 ? 4 : header.cbEvent;
  if (RoomFor(room) > used_ - read_ || header.cbEvent > room) return S_FALSE;
  if (time != nullptr) *time = start_ + header.rtDelta;
  if (group != nullptr) *group = header.dwChannelGroup;
  if (length != nullptr) *length = header.cbEvent;
  if (data != nullptr) *data = bytes_.data() + read_ + kHeaderSize;
  read_ += static_cast<DWORD>(RoomFor(room));
  return S_OK;
}

HRESULT MemoryMusicBuffer::GetRawBufferPtr(LPBYTE* data) { return Answer(data, bytes_.data()); }

HRESULT MemoryMusicBuffer::GetStartTime(LPREFERENCE_TIME time) { return Answer(time, start_); }

HRESULT MemoryMusicBuffer::GetUsedBytes(LPDWORD bytes) { return Answer(bytes, used_); }

HRESULT MemoryMusicBuffer::GetMaxBytes(LPDWORD bytes) {
  return Answer(bytes, static_cast<DWORD>(bytes_.size()));
}

HRESULT MemoryMusicBuffer::GetBufferFormat(LPGUID format) { return Answer(format, format_); }

HRESULT MemoryMusicBuffer::SetStartTime(REFERENCE_TIME time) {
  start_ = time;
  return S_OK;
}

HRESULT MemoryMusicBuffer::SetUsedBytes(DWORD bytes) {
  if (bytes > bytes_.size()) return DMUS_E_BUFFER_FULL;
  used_ = bytes;
  read_ = std::min(read_, used_);
  return S_OK;
}

}  // namespace Ostinet::Impl

// SPDX-License-Identifier: MIT
#include "platform/system/simulated/MusicBuffer.h"

#include <algorithm>
#include <cstring>

namespace Ostinet::Impl::Simulated {

namespace {

constexpr DWORD kHeader = sizeof(DMUS_EVENTHEADER);

DWORD LengthOf(std::uint8_t status) {
  if (status < 0xF0) return (status & 0xE0) == 0xC0 ? 2 : 3;
  if (status == 0xF2) return 3;
  return status == 0xF1 || status == 0xF3 ? 2 : 1;
}

}  // namespace

MusicBuffer::MusicBuffer(std::shared_ptr<Studio> studio, DWORD size)
    : ComObject(std::move(studio), ObjectCounts::kBuffer, IID_IDirectMusicBuffer),
      bytes_((size + 3) & ~DWORD{3}) {}

HRESULT MusicBuffer::Append(REFERENCE_TIME time, DWORD group, DWORD flags, std::uint8_t const* data,
                            DWORD size) {
  // Compared so that no size, however large, wraps around.
  if (size > bytes_.size() || Footprint(size) > Room()) return DMUS_E_BUFFER_FULL;
  if (used_ == 0) start_ = time;
  DMUS_EVENTHEADER header{};
  header.cbEvent = size;
  header.dwChannelGroup = group;
  header.rtDelta = time - start_;
  header.dwFlags = flags;
  std::uint8_t* const to = bytes_.data() + used_;
  std::memcpy(to, &header, kHeader);
  std::copy_n(data, size, to + kHeader);
  used_ += Footprint(size);
  return S_OK;
}

bool MusicBuffer::Next(DWORD& offset, Event& event) {
  if (used_ < kHeader || offset > used_ - kHeader) return false;
  DMUS_EVENTHEADER header{};
  std::memcpy(&header, bytes_.data() + offset, kHeader);
  // The host may have written this.
  if (header.cbEvent > used_ - kHeader - offset) return false;
  event.time = start_ + header.rtDelta;
  event.group = header.dwChannelGroup;
  event.size = header.cbEvent;
  event.data = bytes_.data() + offset + kHeader;
  offset += Footprint(header.cbEvent);
  return true;
}

HRESULT MusicBuffer::Flush() {
  HRESULT result = S_OK;
  if (Fails(Op::kFlush, result)) return result;
  used_ = read_ = 0;
  start_ = 0;
  return Log(Op::kFlush, S_OK);
}

HRESULT MusicBuffer::TotalTime(LPREFERENCE_TIME time) {
  if (time == nullptr) return E_POINTER;
  *time = 0;
  DWORD offset = 0;
  for (Event event; Next(offset, event);) *time = std::max(*time, event.time - start_);
  return S_OK;
}

HRESULT MusicBuffer::PackStructured(REFERENCE_TIME time, DWORD group, DWORD message) {
  HRESULT result = S_OK;
  if (Fails(Op::kPackStructured, result)) return result;
  std::uint8_t const bytes[3] = {static_cast<std::uint8_t>(message),
                                 static_cast<std::uint8_t>(message >> 8),
                                 static_cast<std::uint8_t>(message >> 16)};
  result = bytes[0] < 0x80 ? DMUS_E_INVALID_EVENT
                           : Append(time, group, DMUS_EVENT_STRUCTURED, bytes, LengthOf(bytes[0]));
  return Log(Op::kPackStructured, result, {time, group, message});
}

HRESULT MusicBuffer::PackUnstructured(REFERENCE_TIME time, DWORD group, DWORD size, LPBYTE data) {
  HRESULT result = S_OK;
  if (Fails(Op::kPackUnstructured, result)) return result;
  result = data == nullptr ? E_POINTER : Append(time, group, 0, data, size);
  return Log(Op::kPackUnstructured, result, {time, group, size});
}

HRESULT MusicBuffer::ResetReadPtr() {
  HRESULT result = S_OK;
  if (Fails(Op::kResetReadPtr, result)) return result;
  read_ = 0;
  return Log(Op::kResetReadPtr, S_OK);
}

HRESULT MusicBuffer::GetNextEvent(LPREFERENCE_TIME time, LPDWORD group, LPDWORD length,
                                  LPBYTE* data) {
  HRESULT result = S_OK;
  if (Fails(Op::kGetNextEvent, result)) return result;
  Event event;
  if (!Next(read_, event)) return Log(Op::kGetNextEvent, S_FALSE);
  if (time != nullptr) *time = event.time;
  if (group != nullptr) *group = event.group;
  if (length != nullptr) *length = event.size;
  if (data != nullptr) *data = event.data;
  return Log(Op::kGetNextEvent, S_OK, {event.time, event.size});
}

HRESULT MusicBuffer::GetRawBufferPtr(LPBYTE* data) {
  HRESULT result = S_OK;
  if (Fails(Op::kGetRawBufferPtr, result)) return result;
  if (data == nullptr) return E_POINTER;
  *data = bytes_.data();
  return Log(Op::kGetRawBufferPtr, S_OK);
}

HRESULT MusicBuffer::GetStartTime(LPREFERENCE_TIME time) {
  HRESULT result = S_OK;
  if (Fails(Op::kGetStartTime, result)) return result;
  if (time == nullptr) return E_POINTER;
  *time = start_;
  return Log(Op::kGetStartTime, S_OK, {start_});
}

HRESULT MusicBuffer::GetUsedBytes(LPDWORD bytes) {
  HRESULT result = S_OK;
  if (Fails(Op::kGetUsedBytes, result)) return result;
  if (bytes == nullptr) return E_POINTER;
  *bytes = used_;
  return Log(Op::kGetUsedBytes, S_OK, {used_});
}

HRESULT MusicBuffer::GetMaxBytes(LPDWORD bytes) {
  HRESULT result = S_OK;
  if (Fails(Op::kGetMaxBytes, result)) return result;
  if (bytes == nullptr) return E_POINTER;
  *bytes = static_cast<DWORD>(bytes_.size());
  return Log(Op::kGetMaxBytes, S_OK, {*bytes});
}

HRESULT MusicBuffer::GetBufferFormat(LPGUID format) {
  if (format == nullptr) return E_POINTER;
  *format = {};
  return S_OK;
}

HRESULT MusicBuffer::SetStartTime(REFERENCE_TIME time) {
  HRESULT result = S_OK;
  if (Fails(Op::kSetStartTime, result)) return result;
  start_ = time;
  return Log(Op::kSetStartTime, S_OK, {time});
}

HRESULT MusicBuffer::SetUsedBytes(DWORD bytes) {
  HRESULT result = S_OK;
  if (Fails(Op::kSetUsedBytes, result)) return result;
  if (bytes > bytes_.size()) return Log(Op::kSetUsedBytes, DMUS_E_BUFFER_FULL, {bytes});
  used_ = bytes;
  return Log(Op::kSetUsedBytes, S_OK, {bytes});
}

}  // namespace Ostinet::Impl::Simulated
